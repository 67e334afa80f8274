// Release 12 ASCII DXF: HEADER, the LTYPE, LAYER, STYLE and APPID tables, then one LINE per
// stroke and one TEXT per label. Groups come in their customary order, and lines end in CR LF,
// which every reader accepts.
#include "workbench/draft/dxf_writer.h"

#include <cstdio>
#include <set>
#include <stdexcept>
#include <vector>

namespace wb::draft {
namespace {

// Code points of the bytes 0x80 to 0x9F; zero where the code page leaves a byte undefined.
constexpr char32_t kCp1252High[32] = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

bool IsControl(char32_t c) { return c < 0x20 || c == 0x7F || (c >= 0x80 && c <= 0x9F); }

bool IsReservedInNames(char32_t c) {
  return c < 0x80 && std::string_view("<>/\\\":;?*|=`',").find(static_cast<char>(c)) != std::string_view::npos;
}

std::u32string_view TrimBlanks(std::u32string_view text) {
  const std::size_t first = text.find_first_not_of(U' ');
  if (first == std::u32string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(U' ') - first + 1);
}

std::string ToUtf8(std::u32string_view text) {
  std::string out;
  for (const char32_t c : text) AppendUtf8(out, c);
  return out;
}

std::string ToCp1252Text(std::string_view utf8) {
  std::string out;
  for (const char32_t c : DecodeUtf8(utf8)) out.push_back(static_cast<char>(ToCp1252(c).value_or('_')));
  return out;
}

class GroupWriter {
 public:
  explicit GroupWriter(std::ostream& out) : out_(out) {}

  void Put(int code, std::string_view value) {
    char field[8];
    std::snprintf(field, sizeof field, "%3d", code);
    out_ << field << "\r\n" << value << "\r\n";
  }
  void Put(int code, double value) { Put(code, FormatNumber(value)); }
  void PutInt(int code, int value) { Put(code, std::to_string(value)); }
  void PutPoint(int code, Point2 point) {
    Put(code, point.x);
    Put(code + 10, point.y);
    Put(code + 20, 0.0);
  }
  void BeginTable(std::string_view name, int entries) {
    Put(0, "TABLE");
    Put(2, name);
    PutInt(70, entries);
  }
  void EndTable() { Put(0, "ENDTAB"); }

 private:
  std::ostream& out_;
};

void WriteHeader(GroupWriter& dxf, const Sheet& sheet) {
  const Box2 extent = SheetExtent(sheet).value_or(Box2{});
  dxf.Put(0, "SECTION");
  dxf.Put(2, "HEADER");
  dxf.Put(9, "$ACADVER");
  dxf.Put(1, "AC1009");
  dxf.Put(9, "$DWGCODEPAGE");
  dxf.Put(3, "ANSI_1252");
  dxf.Put(9, "$EXTMIN");
  dxf.PutPoint(10, extent.min);
  dxf.Put(9, "$EXTMAX");
  dxf.PutPoint(10, extent.max);
  dxf.Put(0, "ENDSEC");
}

void WriteLayerEntry(GroupWriter& dxf, std::string_view name) {
  dxf.Put(0, "LAYER");
  dxf.Put(2, ToCp1252Text(name));
  dxf.PutInt(70, 0);
  // Entities carry their own colour; the layer's only matters to entities added later by hand.
  dxf.PutInt(62, 7);
  dxf.Put(6, "CONTINUOUS");
}

void WriteTables(GroupWriter& dxf, const std::array<std::string, kSheetLayerCount>& names) {
  dxf.Put(0, "SECTION");
  dxf.Put(2, "TABLES");

  dxf.BeginTable("LTYPE", 1);
  dxf.Put(0, "LTYPE");
  dxf.Put(2, "CONTINUOUS");
  dxf.PutInt(70, 0);
  dxf.Put(3, "Solid line");
  dxf.PutInt(72, 65);
  dxf.PutInt(73, 0);
  dxf.Put(40, 0.0);
  dxf.EndTable();

  // Layer "0" exists in every drawing; programs add it when it is missing, some with a warning.
  bool zeroUsed = false;
  int entries = 0;
  for (const std::string& name : names) {
    zeroUsed = zeroUsed || name == "0";
    entries += name.empty() ? 0 : 1;
  }
  dxf.BeginTable("LAYER", entries + (zeroUsed ? 0 : 1));
  if (!zeroUsed) WriteLayerEntry(dxf, "0");
  for (const std::string& name : names) {
    if (!name.empty()) WriteLayerEntry(dxf, name);
  }
  dxf.EndTable();

  dxf.BeginTable("STYLE", 1);
  dxf.Put(0, "STYLE");
  dxf.Put(2, "STANDARD");
  dxf.PutInt(70, 0);
  dxf.Put(40, 0.0);
  dxf.Put(41, 1.0);
  dxf.Put(50, 0.0);
  dxf.PutInt(71, 0);
  dxf.Put(42, 2.5);
  dxf.Put(3, "txt");
  dxf.Put(4, "");
  dxf.EndTable();

  dxf.BeginTable("APPID", 1);
  dxf.Put(0, "APPID");
  dxf.Put(2, kDxfApplication);
  dxf.PutInt(70, 0);
  dxf.EndTable();

  dxf.Put(0, "ENDSEC");
}

void WriteEntities(GroupWriter& dxf, const Sheet& sheet, const std::array<std::string, kSheetLayerCount>& names,
                   const std::vector<std::string>& texts) {
  std::array<std::string, kSheetLayerCount> encodedNames;
  for (std::size_t i = 0; i < names.size(); ++i) encodedNames[i] = ToCp1252Text(names[i]);

  dxf.Put(0, "SECTION");
  dxf.Put(2, "ENTITIES");
  for (const Stroke& stroke : sheet.strokes) {
    dxf.Put(0, "LINE");
    dxf.Put(8, encodedNames[stroke.layer]);
    // Colour 0 stays 0 ("by block"), which outside a block shows in the foreground colour.
    dxf.PutInt(62, stroke.color);
    dxf.PutPoint(10, stroke.a);
    dxf.PutPoint(11, stroke.b);
    dxf.Put(1001, kDxfApplication);
    dxf.PutInt(1070, stroke.layer);
    dxf.PutInt(1070, static_cast<int>(stroke.kind));
  }
  for (std::size_t i = 0; i < sheet.labels.size(); ++i) {
    const Label& label = sheet.labels[i];
    dxf.Put(0, "TEXT");
    dxf.Put(8, encodedNames[label.layer]);
    dxf.PutInt(62, label.color);
    dxf.PutPoint(10, label.at);
    dxf.Put(40, label.height);
    dxf.Put(1, texts[i]);
    dxf.Put(50, label.angle);
    dxf.Put(1001, kDxfApplication);
    dxf.PutInt(1070, label.layer);
  }
  dxf.Put(0, "ENDSEC");
}

}  // namespace

std::optional<unsigned char> ToCp1252(char32_t codePoint) {
  if (codePoint < 0x80 || (codePoint >= 0xA0 && codePoint <= 0xFF)) return static_cast<unsigned char>(codePoint);
  for (unsigned char i = 0; i < 32; ++i) {
    if (kCp1252High[i] != 0 && kCp1252High[i] == codePoint) return static_cast<unsigned char>(0x80 + i);
  }
  return std::nullopt;
}

char32_t FromCp1252(unsigned char byte) {
  if (byte < 0x80 || byte >= 0xA0) return byte;
  const char32_t point = kCp1252High[byte - 0x80];
  return point != 0 ? point : U'\uFFFD';
}

std::string SanitizeDxfLayerName(std::string_view name) {
  std::u32string clean;
  for (const char32_t c : DecodeUtf8(name)) {
    const bool allowed = !IsControl(c) && !IsReservedInNames(c) && ToCp1252(c).has_value() && c != U'\uFFFD';
    clean.push_back(allowed ? c : U'_');
  }
  return ToUtf8(TrimBlanks(TrimBlanks(clean).substr(0, kMaxDxfLayerNameLength)));
}

std::string DxfNameKey(std::string_view name) {
  std::string key(name);
  for (char& c : key) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  }
  return key;
}

std::string BaseDxfLayerName(const Sheet& sheet, int index) {
  std::string name = SanitizeDxfLayerName(EffectiveLayerName(sheet, index));
  return name.empty() ? DefaultLayerName(index) : name;
}

std::array<std::string, kSheetLayerCount> DxfLayerNames(const Sheet& sheet) {
  const std::array<bool, kSheetLayerCount> used = UsedLayers(sheet);
  std::array<std::string, kSheetLayerCount> names;
  std::set<std::string> taken;
  for (int i = 0; i < kSheetLayerCount; ++i) {
    if (!used[static_cast<std::size_t>(i)]) continue;
    const std::string base = BaseDxfLayerName(sheet, i);
    std::string name = base;
    for (int n = 2; taken.contains(DxfNameKey(name)); ++n) {
      const std::string suffix = "_" + std::to_string(n);
      // Cutting the base keeps the suffixed name within the limit; the cut is by character.
      name = ToUtf8(std::u32string_view(DecodeUtf8(base)).substr(0, kMaxDxfLayerNameLength - suffix.size())) + suffix;
    }
    taken.insert(DxfNameKey(name));
    names[static_cast<std::size_t>(i)] = name;
  }
  return names;
}

std::string EncodeDxfText(std::string_view text) {
  const std::u32string points = DecodeUtf8(text);
  std::string out;
  for (std::size_t i = 0; i < points.size(); ++i) {
    const char32_t c = points[i];
    if (c == U'%') {
      std::size_t run = 1;
      while (i + run < points.size() && points[i + run] == U'%') ++run;
      out.append(run == 1 ? 1 : 3 * run, '%');
      i += run - 1;
    } else if (c == U'\\' && i + 1 < points.size() && (points[i + 1] == U'U' || points[i + 1] == U'u')) {
      out += "\\U+005C";
    } else if (IsControl(c)) {
      out.push_back(' ');
    } else if (const std::optional<unsigned char> byte = ToCp1252(c)) {
      out.push_back(static_cast<char>(*byte));
    } else if (c <= 0xFFFF) {
      char escape[8];
      std::snprintf(escape, sizeof escape, "\\U+%04X", static_cast<unsigned>(c));
      out += escape;
    } else {
      // The escape has four digits; nothing beyond the first plane can be written.
      out.push_back('?');
    }
  }
  if (out.size() > kMaxDxfLineLength) throw std::invalid_argument("a label's text is too long for a DXF file");
  return out;
}

void DxfWriter::Write(const Sheet& sheet, std::ostream& out) const {
  CheckSheetValues(sheet);
  const std::array<std::string, kSheetLayerCount> names = DxfLayerNames(sheet);
  // Texts are encoded before anything is written, so that a refused text leaves no half file.
  std::vector<std::string> texts;
  texts.reserve(sheet.labels.size());
  for (const Label& label : sheet.labels) texts.push_back(EncodeDxfText(label.text));
  GroupWriter dxf(out);
  WriteHeader(dxf, sheet);
  WriteTables(dxf, names);
  WriteEntities(dxf, sheet, names, texts);
  dxf.Put(0, "EOF");
}

}  // namespace wb::draft
