// Attribute records are stored as a sequence of (name, type, format, value) with u32 lengths
// and counts; only the value member that the type selects is kept.
#include "workbench/drawing_file_blobs.h"

#include <bit>
#include <concepts>
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
    for (std::size_t i = 0; i < sizeof(T); ++i) out_.push_back(static_cast<std::uint8_t>(bits >> (8 * i)));
  }
  void Put(float value) { Put(std::bit_cast<std::uint32_t>(value)); }

  void PutCount(std::size_t count) {
    if (count > std::numeric_limits<std::uint32_t>::max()) throw BadContent("an attribute value is too long to store");
    Put(static_cast<std::uint32_t>(count));
  }
  void PutText(const std::string& text) {
    PutCount(text.size());
    out_.insert(out_.end(), text.begin(), text.end());
  }
  template <typename T>
  void PutArray(const std::vector<T>& values) {
    PutCount(values.size());
    for (T value : values) Put(value);
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
    if (count > (bytes_.size() - position_) / elementSize) throw BadContent("an attribute record is cut short");
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
    for (T& value : values) {
      if constexpr (std::is_same_v<T, float>) {
        value = GetFloat();
      } else {
        value = Get<T>();
      }
    }
  }

 private:
  void Need(std::size_t count) const {
    if (count > bytes_.size() - position_) throw BadContent("an attribute record is cut short");
  }

  std::span<const std::uint8_t> bytes_;
  std::size_t position_ = 0;
};

constexpr std::uint8_t kFirstAttributeType = static_cast<std::uint8_t>(AttributeType::String);
constexpr std::uint8_t kLastAttributeType = static_cast<std::uint8_t>(AttributeType::LongVector);

std::string UnknownType(std::size_t index, std::uint8_t type) {
  return "attribute " + std::to_string(index + 1) + " has the unknown type " + std::to_string(type);
}

}  // namespace

void EncodeMembers(const std::vector<host::EntityHandle>& members, std::vector<std::uint8_t>& out) {
  ByteWriter writer(out);
  for (host::EntityHandle member : members) writer.Put(member);
}

void DecodeMembers(std::span<const std::uint8_t> bytes, std::vector<host::EntityHandle>& members) {
  if (bytes.size() % sizeof(host::EntityHandle) != 0) throw BadContent("a member list is cut short");
  ByteReader reader(bytes);
  members.resize(bytes.size() / sizeof(host::EntityHandle));
  for (host::EntityHandle& member : members) member = reader.Get<host::EntityHandle>();
}

void EncodeAttributes(const std::vector<Attribute>& attributes, std::vector<std::uint8_t>& out) {
  ByteWriter writer(out);
  for (std::size_t i = 0; i < attributes.size(); ++i) {
    const Attribute& attribute = attributes[i];
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
      default: throw BadContent(UnknownType(i, static_cast<std::uint8_t>(attribute.type)));
    }
  }
}

void DecodeAttributes(std::span<const std::uint8_t> bytes, std::vector<Attribute>& attributes) {
  attributes.clear();
  ByteReader reader(bytes);
  while (!reader.AtEnd()) {
    Attribute& attribute = attributes.emplace_back();
    attribute.name = reader.GetText();
    const auto type = reader.Get<std::uint8_t>();
    if (type < kFirstAttributeType || type > kLastAttributeType) {
      throw BadContent(UnknownType(attributes.size() - 1, type));
    }
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
}

}  // namespace wb::drawing_file
