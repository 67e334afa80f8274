// Reads ASCII DXF group by group with one group of look-ahead. Every line is bounded and every
// value checked as it is read, so a damaged or hostile file ends in a DxfReadError naming the
// line, never in a crash, a hang or a sheet with values the writers would refuse.
#include "workbench/draft/dxf_reader.h"

#include <array>
#include <cctype>
#include <charconv>
#include <cmath>
#include <fstream>
#include <map>
#include <new>
#include <optional>
#include <string>
#include <vector>

#include "workbench/draft/dxf_writer.h"

namespace wb::draft {
namespace {

struct Group {
  int code = 0;
  std::string value;
  std::size_t line = 0;  // of the value
};

// Hostile bytes stay out of messages; a long value is cut.
std::string Quoted(std::string_view text) {
  constexpr std::size_t kShown = 40;
  std::string quoted = "\"";
  for (const char c : text.substr(0, kShown)) quoted.push_back(c >= 0x20 && c < 0x7F ? c : '?');
  return quoted + (text.size() > kShown ? "...\"" : "\"");
}

std::string_view TrimBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

class GroupReader {
 public:
  GroupReader(std::istream& in, std::string_view source) : in_(in), source_(source) {}

  // The next group, comments skipped; nothing where the stream ends.
  std::optional<Group> Next() {
    if (pushedBack_) {
      std::optional<Group> group = std::move(pushedBack_);
      pushedBack_.reset();
      return group;
    }
    std::string codeLine;
    while (ReadLine(codeLine)) {
      Group group{ParseCode(codeLine), {}, 0};
      if (!ReadLine(group.value)) Fail("the file ends between a group code and its value");
      group.line = line_;
      if (group.code != 999) return group;
    }
    return std::nullopt;
  }

  // The next group of a file that must go on.
  Group Expect() {
    std::optional<Group> group = Next();
    if (!group) Fail("the file is truncated: it ends before EOF");
    return std::move(*group);
  }

  void PushBack(Group group) { pushedBack_ = std::move(group); }

  // The groups up to the next 0 group, which is left to be read.
  std::vector<Group> GroupsOfEntry() {
    std::vector<Group> groups;
    Group group = Expect();
    for (; group.code != 0; group = Expect()) groups.push_back(std::move(group));
    PushBack(std::move(group));
    return groups;
  }

  [[noreturn]] void Fail(const std::string& message) const { FailAt(line_, message); }
  // For a group read earlier: the reader may be a group further on.
  [[noreturn]] void FailAt(std::size_t line, const std::string& message) const {
    throw DxfReadError(source_ + ", line " + std::to_string(line) + ": " + message);
  }

 private:
  bool ReadLine(std::string& line) {
    line.clear();
    std::streambuf& buffer = *in_.rdbuf();
    bool any = false;
    for (int c = buffer.sbumpc(); c != std::char_traits<char>::eof(); c = buffer.sbumpc()) {
      any = true;
      if (c == '\n') break;
      // One byte more than the limit for the CR of a CR LF line end.
      if (line.size() > kMaxDxfLineLength) Fail("a line is longer than " + std::to_string(kMaxDxfLineLength) + " bytes");
      line.push_back(static_cast<char>(c));
    }
    if (!any) return false;
    ++line_;
    if (!line.empty() && line.back() == '\r') line.pop_back();
    return true;
  }

  int ParseCode(const std::string& line) const {
    const std::string_view text = TrimBlanks(line);
    int code = -1;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), code);
    if (text.empty() || result.ec != std::errc() || result.ptr != text.data() + text.size() || code < 0 || code > 1071) {
      Fail("expected a group code, found " + Quoted(line));
    }
    return code;
  }

  std::istream& in_;
  std::string source_;
  std::size_t line_ = 0;
  std::optional<Group> pushedBack_;
};

// Undoes EncodeDxfText (and, without the percent rule, the encoding of layer names): \U+XXXX
// escapes, runs of 3k percent signs, and code page 1252 unless the file is UTF-8 (AC1021 on).
std::string DecodeDxfString(std::string_view raw, bool utf8, bool isText) {
  const auto isHex = [](char c) { return std::isxdigit(static_cast<unsigned char>(c)) != 0; };
  std::string out;
  for (std::size_t i = 0; i < raw.size();) {
    if (raw[i] == '\\' && i + 7 <= raw.size() && (raw[i + 1] == 'U' || raw[i + 1] == 'u') && raw[i + 2] == '+' &&
        isHex(raw[i + 3]) && isHex(raw[i + 4]) && isHex(raw[i + 5]) && isHex(raw[i + 6])) {
      unsigned point = 0;
      std::from_chars(raw.data() + i + 3, raw.data() + i + 7, point, 16);
      AppendUtf8(out, point);
      i += 7;
    } else if (isText && raw[i] == '%') {
      std::size_t run = 1;
      while (i + run < raw.size() && raw[i + run] == '%') ++run;
      out.append(run >= 3 && run % 3 == 0 ? run / 3 : run, '%');
      i += run;
    } else {
      const auto byte = static_cast<unsigned char>(raw[i]);
      if (byte < 0x80 || utf8) {
        out.push_back(raw[i]);
      } else {
        AppendUtf8(out, FromCp1252(byte));
      }
      ++i;
    }
  }
  return out;
}

// A stroke or label whose sheet layer is known only once every layer has been seen.
template <typename Item>
struct Pending {
  Item item;
  std::size_t layer = 0;  // into SheetParser::layers_
  bool byLayer = false;
};

// A layer as the entities name it, with the sheet index the first of them carried.
struct LayerUse {
  std::string name;
  std::optional<int> index;
};

// What every entity has: layer, colour and this application's extended data.
struct EntityCommon {
  std::string layer = "0";
  std::optional<int> color;
  std::vector<int> ours;
};

class SheetParser {
 public:
  SheetParser(std::istream& in, std::string_view source) : reader_(in, source), source_(source) {}

  Sheet Parse() {
    for (Group group = reader_.Expect(); !Is(group, "EOF"); group = reader_.Expect()) {
      if (!Is(group, "SECTION")) reader_.Fail("expected a section, found " + Quoted(group.value));
      const Group name = reader_.Expect();
      if (name.code != 2) reader_.Fail("a section without a name");
      if (name.value == "HEADER") {
        ParseHeader();
      } else if (name.value == "TABLES") {
        ParseTables();
      } else if (name.value == "ENTITIES") {
        ParseEntities();
      } else {
        SkipSection(name.value);
      }
    }
    return Assemble();
  }

 private:
  void ParseHeader() {
    std::string variable;
    std::string version;
    std::string codePage;
    Group group = reader_.Expect();
    for (; group.code != 0; group = reader_.Expect()) {
      if (group.code == 9) {
        variable = group.value;
      } else if (variable == "$ACADVER" && group.code == 1) {
        version = TrimBlanks(group.value);
      } else if (variable == "$DWGCODEPAGE" && group.code == 3) {
        codePage = TrimBlanks(group.value);
      }
    }
    if (group.value != "ENDSEC") reader_.Fail("the HEADER section is not closed");
    utf8_ = version >= "AC1021";
    if (!utf8_ && !codePage.empty() && DxfNameKey(codePage) != "ansi_1252") {
      reader_.Fail("texts in code page " + Quoted(codePage) + " cannot be read, only ANSI_1252");
    }
  }

  static bool Is(const Group& group, std::string_view marker) { return group.code == 0 && group.value == marker; }

  void SkipSection(const std::string& name) {
    for (Group group = reader_.Expect(); !Is(group, "ENDSEC"); group = reader_.Expect()) {
      if (Is(group, "EOF") || Is(group, "SECTION")) {
        reader_.Fail("section " + Quoted(name) + " is not closed");
      }
    }
  }

  void ParseTables() {
    for (Group group = reader_.Expect(); !Is(group, "ENDSEC"); group = reader_.Expect()) {
      if (!Is(group, "TABLE")) reader_.Fail("expected a table, found " + Quoted(group.value));
      std::string table;
      for (const Group& field : reader_.GroupsOfEntry()) {
        if (field.code == 2) table = field.value;
      }
      for (Group entry = reader_.Expect(); entry.value != "ENDTAB"; entry = reader_.Expect()) {
        if (entry.value == "ENDSEC" || entry.value == "EOF" || entry.value == "TABLE" || entry.value == "SECTION") {
          reader_.FailAt(entry.line, "table " + Quoted(table) + " is not closed");
        }
        entryLine_ = entry.line;
        const std::vector<Group> fields = reader_.GroupsOfEntry();
        if (table == "LAYER" && entry.value == "LAYER") ReadLayerEntry(fields);
      }
    }
  }

  void ReadLayerEntry(const std::vector<Group>& fields) {
    std::optional<std::string> name;
    int color = 7;
    for (const Group& field : fields) {
      if (field.code == 2) name = DecodeDxfString(field.value, utf8_, false);
      // A negative colour only says the layer is off.
      if (field.code == 62) color = std::abs(Integer(field, -255, 255));
    }
    if (!name) reader_.FailAt(entryLine_, "a layer without a name");
    layerColors_[DxfNameKey(*name)] = color == 0 ? 7 : color;
  }

  void ParseEntities() {
    for (Group group = reader_.Expect(); !Is(group, "ENDSEC"); group = reader_.Expect()) {
      if (group.code != 0) reader_.Fail("expected an entity, found " + Quoted(group.value));
      entryLine_ = group.line;
      const std::vector<Group> fields = reader_.GroupsOfEntry();
      if (group.value == "LINE") {
        ReadLine(fields);
      } else if (group.value == "TEXT") {
        ReadText(fields);
      } else if (group.value == "EOF" || group.value == "SECTION") {
        reader_.FailAt(entryLine_, "the ENTITIES section is not closed");
      } else {
        // Merging would lose it without a word.
        reader_.FailAt(entryLine_, "a " + Quoted(group.value) + " entity cannot be read back, only LINE and TEXT");
      }
    }
  }

  EntityCommon ReadCommon(const std::vector<Group>& fields) {
    EntityCommon common;
    bool inOurs = false;
    for (const Group& field : fields) {
      if (field.code == 8) common.layer = DecodeDxfString(field.value, utf8_, false);
      if (field.code == 62) common.color = Integer(field, 0, 256);
      if (field.code == 67 && Integer(field, 0, 1) == 1) {
        reader_.FailAt(field.line, "entities in paper space cannot be read back");
      }
      if (field.code == 1001) inOurs = DxfNameKey(TrimBlanks(field.value)) == DxfNameKey(kDxfApplication);
      if (inOurs && field.code == 1070) common.ours.push_back(Integer(field, -32768, 32767));
    }
    if (!common.ours.empty() && (common.ours[0] < 0 || common.ours[0] >= kSheetLayerCount)) {
      reader_.FailAt(entryLine_, "the layer index " + std::to_string(common.ours[0]) + " is out of range");
    }
    return common;
  }

  std::size_t LayerOf(const EntityCommon& common) {
    const std::string key = DxfNameKey(common.layer);
    auto [entry, added] = layerIds_.try_emplace(key, layers_.size());
    if (added) layers_.push_back({common.layer, std::nullopt});
    LayerUse& use = layers_[entry->second];
    if (!use.index && !common.ours.empty()) use.index = common.ours[0];
    return entry->second;
  }

  static std::uint8_t ColorOf(const EntityCommon& common) {
    return static_cast<std::uint8_t>(common.color && *common.color != 256 ? *common.color : 0);
  }
  static bool IsByLayer(const EntityCommon& common) { return !common.color || *common.color == 256; }

  void ReadLine(const std::vector<Group>& fields) {
    const EntityCommon common = ReadCommon(fields);
    Stroke stroke;
    for (const Group& field : fields) {
      if (field.code == 10) stroke.a.x = Number(field);
      if (field.code == 20) stroke.a.y = Number(field);
      if (field.code == 11) stroke.b.x = Number(field);
      if (field.code == 21) stroke.b.y = Number(field);
    }
    if (common.ours.size() > 1) {
      if (common.ours[1] < 0 || common.ours[1] > static_cast<int>(StrokeKind::Preserved)) {
        reader_.FailAt(entryLine_, "the stroke kind " + std::to_string(common.ours[1]) + " is unknown");
      }
      stroke.kind = static_cast<StrokeKind>(common.ours[1]);
    }
    stroke.color = ColorOf(common);
    strokes_.push_back({stroke, LayerOf(common), IsByLayer(common)});
  }

  void ReadText(const std::vector<Group>& fields) {
    const EntityCommon common = ReadCommon(fields);
    Label label;
    bool hasHeight = false;
    for (const Group& field : fields) {
      if (field.code == 10) label.at.x = Number(field);
      if (field.code == 20) label.at.y = Number(field);
      if (field.code == 40) {
        label.height = Number(field);
        hasHeight = true;
      }
      if (field.code == 50) label.angle = Number(field);
      if (field.code == 1) label.text = DecodeDxfString(field.value, utf8_, true);
    }
    if (!hasHeight || !(label.height > 0.0)) reader_.FailAt(entryLine_, "a TEXT without a positive height");
    label.color = ColorOf(common);
    labels_.push_back({std::move(label), LayerOf(common), IsByLayer(common)});
  }

  double Number(const Group& field) const {
    std::string_view text = TrimBlanks(field.value);
    if (text.starts_with('+')) text.remove_prefix(1);
    double value = 0.0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    if (text.empty() || result.ec != std::errc() || result.ptr != text.data() + text.size() || !std::isfinite(value) ||
        std::fabs(value) > kMaxSheetCoordinate) {
      reader_.FailAt(field.line, "group " + std::to_string(field.code) + ": " + Quoted(field.value) +
                                     " is not a number within 1e15");
    }
    return value;
  }

  int Integer(const Group& field, int least, int most) const {
    const std::string_view text = TrimBlanks(field.value);
    int value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    if (text.empty() || result.ec != std::errc() || result.ptr != text.data() + text.size() || value < least ||
        value > most) {
      reader_.FailAt(field.line, "group " + std::to_string(field.code) + ": " + Quoted(field.value) +
                                     " is not a whole number from " + std::to_string(least) + " to " + std::to_string(most));
    }
    return value;
  }

  // The index a name of the form "Layer n" stands for, when it is one.
  static std::optional<int> DefaultIndexOf(const std::string& name) {
    for (int index = 0; index < kSheetLayerCount; ++index) {
      if (name == DefaultLayerName(index)) return index;
    }
    return std::nullopt;
  }

  // Each layer keeps the index its entities carried when no other layer took it first; then
  // "Layer n" names go to n - 1; the rest fill the free indices in the order they appear.
  std::vector<int> AssignIndices() const {
    std::vector<int> slots(layers_.size(), -1);
    std::array<bool, kSheetLayerCount> taken{};
    const auto claim = [&](std::size_t layer, std::optional<int> index) {
      if (slots[layer] < 0 && index && !taken[static_cast<std::size_t>(*index)]) {
        slots[layer] = *index;
        taken[static_cast<std::size_t>(*index)] = true;
      }
    };
    for (std::size_t i = 0; i < layers_.size(); ++i) claim(i, layers_[i].index);
    for (std::size_t i = 0; i < layers_.size(); ++i) claim(i, DefaultIndexOf(layers_[i].name));
    for (std::size_t i = 0; i < layers_.size(); ++i) {
      for (int index = 0; index < kSheetLayerCount && slots[i] < 0; ++index) claim(i, index);
      if (slots[i] < 0) throw DxfReadError(source_ + ": more than 256 layers cannot be read into one sheet");
    }
    return slots;
  }

  Sheet Assemble() {
    const std::vector<int> slots = AssignIndices();
    Sheet sheet;
    for (std::size_t i = 0; i < layers_.size(); ++i) {
      if (layers_[i].name != DefaultLayerName(slots[i])) sheet.layerNames[static_cast<std::size_t>(slots[i])] = layers_[i].name;
    }
    Place(strokes_, slots, sheet.strokes);
    Place(labels_, slots, sheet.labels);
    return sheet;
  }

  // Gives each item its sheet layer and, when it is drawn by layer, the layer's colour.
  template <typename Item>
  void Place(std::vector<Pending<Item>>& pending, const std::vector<int>& slots, std::vector<Item>& placed) const {
    placed.reserve(pending.size());
    for (Pending<Item>& entry : pending) {
      Item& item = placed.emplace_back(std::move(entry.item));
      item.layer = static_cast<std::uint8_t>(slots[entry.layer]);
      if (!entry.byLayer) continue;
      const auto found = layerColors_.find(DxfNameKey(layers_[entry.layer].name));
      item.color = static_cast<std::uint8_t>(found == layerColors_.end() ? 7 : found->second);
    }
  }

  GroupReader reader_;
  std::string source_;
  bool utf8_ = false;
  std::size_t entryLine_ = 0;  // where the entity or table entry being read starts
  std::map<std::string, int> layerColors_;  // by name key
  std::map<std::string, std::size_t> layerIds_;
  std::vector<LayerUse> layers_;
  std::vector<Pending<Stroke>> strokes_;
  std::vector<Pending<Label>> labels_;
};

}  // namespace

Sheet ParseDxfSheet(std::istream& in, std::string_view source) {
  try {
    return SheetParser(in, source).Parse();
  } catch (const std::bad_alloc&) {
    throw DxfReadError(std::string(source) + ": the drawing does not fit in memory");
  }
}

Sheet ReadDxfSheet(const std::filesystem::path& path) {
  std::error_code error;
  const std::uintmax_t size = std::filesystem::file_size(path, error);
  if (error) throw DxfReadError(path.string() + ": cannot be read: " + error.message());
  if (size > kMaxDxfFileBytes) throw DxfReadError(path.string() + ": is too large for a 2D drawing");
  std::ifstream in(path, std::ios::binary);
  if (!in) throw DxfReadError(path.string() + ": cannot be opened");
  return ParseDxfSheet(in, path.string());
}

}  // namespace wb::draft
