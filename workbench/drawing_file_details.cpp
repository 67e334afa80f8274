// Details are, in this order: the name, configuration path and element name (u32 length and
// bytes each), the members (u32 count and i32 handles), then the attributes (u32 count, then
// each as name, type byte, i16 format and the one value its type selects), and nothing after.
// Little-endian whatever the machine, so files move between machines.
#include "workbench/drawing_file_details.h"

#include <array>
#include <bit>
#include <concepts>
#include <cstring>
#include <limits>
#include <string>
#include <type_traits>

#include "workbench/drawing_file_format.h"

namespace wb::drawing_file {
namespace {

class ByteWriter {
 public:
  explicit ByteWriter(std::vector<std::uint8_t>& out) : out_(out) {}

  template <std::integral T>
  void Put(T value) {
    const auto bits = static_cast<std::make_unsigned_t<T>>(value);
    std::array<std::uint8_t, sizeof(T)> bytes{};
    for (std::size_t i = 0; i < sizeof(T); ++i) bytes[i] = static_cast<std::uint8_t>(bits >> (8 * i));
    out_.insert(out_.end(), bytes.begin(), bytes.end());
  }
  void Put(float value) { Put(std::bit_cast<std::uint32_t>(value)); }

  void PutCount(std::size_t count) {
    if (count > std::numeric_limits<std::uint32_t>::max()) throw BadContent("a value is too long to store");
    Put(static_cast<std::uint32_t>(count));
  }
  void PutText(const std::string& text) {
    PutCount(text.size());
    out_.insert(out_.end(), text.begin(), text.end());
  }
  template <typename T>
  void PutArray(const std::vector<T>& values) {
    PutCount(values.size());
    if constexpr (std::endian::native == std::endian::little) {
      // The stored bytes are the values' own bytes: one copy for the whole vector.
      const auto* bytes = reinterpret_cast<const std::uint8_t*>(values.data());
      out_.insert(out_.end(), bytes, bytes + values.size() * sizeof(T));
    } else {
      for (T value : values) Put(value);
    }
  }

 private:
  std::vector<std::uint8_t>& out_;
};

class ByteReader {
 public:
  explicit ByteReader(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}
  bool AtEnd() const { return position_ == bytes_.size(); }

  template <std::integral T>
  T Get() {
    using Bits = std::make_unsigned_t<T>;
    Need(sizeof(T));
    Bits bits = 0;
    for (std::size_t i = 0; i < sizeof(T); ++i) {
      bits = static_cast<Bits>(bits | (static_cast<Bits>(bytes_[position_ + i]) << (8 * i)));
    }
    position_ += sizeof(T);
    return static_cast<T>(bits);
  }
  float GetFloat() { return std::bit_cast<float>(Get<std::uint32_t>()); }

  // A count of elements of the given size that the remaining bytes can really hold, so that a
  // forged count never sizes an allocation.
  std::size_t GetCount(std::size_t elementSize) {
    const std::size_t count = Get<std::uint32_t>();
    Need(count * elementSize);  // cannot overflow: both factors are below 2^32
    return count;
  }
  std::string GetText() {
    const std::size_t length = GetCount(1);
    std::string text(reinterpret_cast<const char*>(bytes_.data() + position_), length);
    position_ += length;
    return text;
  }
  template <typename T>
  void GetArray(std::vector<T>& values) {
    values.resize(GetCount(sizeof(T)));
    if constexpr (std::endian::native == std::endian::little) {
      if (!values.empty()) std::memcpy(values.data(), bytes_.data() + position_, values.size() * sizeof(T));
      position_ += values.size() * sizeof(T);
    } else {
      for (T& value : values) {
        if constexpr (std::is_same_v<T, float>) {
          value = GetFloat();
        } else {
          value = Get<T>();
        }
      }
    }
  }

 private:
  void Need(std::size_t count) const {
    if (count > bytes_.size() - position_) throw BadContent("its details are cut short");
  }

  std::span<const std::uint8_t> bytes_;
  std::size_t position_ = 0;
};

// Name length, type, format and the smallest value (a short): what bounds a forged count.
constexpr std::size_t kSmallestAttribute = 4 + 1 + 2 + 2;
constexpr std::uint8_t kFirstAttributeType = static_cast<std::uint8_t>(AttributeType::String);
constexpr std::uint8_t kLastAttributeType = static_cast<std::uint8_t>(AttributeType::LongVector);

std::string UnknownType(std::size_t index, std::uint8_t type) {
  return "attribute " + std::to_string(index + 1) + " has the unknown type " + std::to_string(type);
}

void PutAttribute(ByteWriter& writer, const Attribute& attribute, std::size_t index) {
  writer.PutText(attribute.name);
  writer.Put(static_cast<std::uint8_t>(attribute.type));
  writer.Put(attribute.format);
  switch (attribute.type) {
    case AttributeType::String: writer.PutText(attribute.text); break;
    case AttributeType::Short: writer.Put(attribute.shortValue); break;
    case AttributeType::Float: writer.Put(attribute.floatValue); break;
    case AttributeType::FloatVector: writer.PutArray(attribute.floats); break;
    case AttributeType::ShortVector: writer.PutArray(attribute.shorts); break;
    case AttributeType::LongVector: writer.PutArray(attribute.longs); break;
    default: throw BadContent(UnknownType(index, static_cast<std::uint8_t>(attribute.type)));
  }
}

void GetAttribute(ByteReader& reader, Attribute& attribute, std::size_t index) {
  attribute.name = reader.GetText();
  const auto type = reader.Get<std::uint8_t>();
  if (type < kFirstAttributeType || type > kLastAttributeType) throw BadContent(UnknownType(index, type));
  attribute.type = static_cast<AttributeType>(type);
  attribute.format = reader.Get<std::int16_t>();
  switch (attribute.type) {
    case AttributeType::String: attribute.text = reader.GetText(); break;
    case AttributeType::Short: attribute.shortValue = reader.Get<std::int16_t>(); break;
    case AttributeType::Float: attribute.floatValue = reader.GetFloat(); break;
    case AttributeType::FloatVector: reader.GetArray(attribute.floats); break;
    case AttributeType::ShortVector: reader.GetArray(attribute.shorts); break;
    case AttributeType::LongVector: reader.GetArray(attribute.longs); break;
  }
}

}  // namespace

bool HasDetails(const Entity& entity) {
  return !entity.name.empty() || !entity.configPath.empty() || !entity.elementName.empty() ||
         !entity.members.empty() || !entity.attributes.empty();
}

void EncodeDetails(const Entity& entity, std::vector<std::uint8_t>& out) {
  ByteWriter writer(out);
  writer.PutText(entity.name);
  writer.PutText(entity.configPath);
  writer.PutText(entity.elementName);
  writer.PutArray(entity.members);
  writer.PutCount(entity.attributes.size());
  for (std::size_t i = 0; i < entity.attributes.size(); ++i) PutAttribute(writer, entity.attributes[i], i);
}

void DecodeDetails(std::span<const std::uint8_t> bytes, Entity& entity) {
  ByteReader reader(bytes);
  entity.name = reader.GetText();
  entity.configPath = reader.GetText();
  entity.elementName = reader.GetText();
  reader.GetArray(entity.members);
  entity.attributes.resize(reader.GetCount(kSmallestAttribute));
  for (std::size_t i = 0; i < entity.attributes.size(); ++i) GetAttribute(reader, entity.attributes[i], i);
  if (!reader.AtEnd()) throw BadContent("its details run on past their end");
}

}  // namespace wb::drawing_file
