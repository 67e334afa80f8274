// Output file names: characters replaced, names cut where the file system refuses them, and
// collisions within one run told apart.
#include "display/output_names.h"

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <system_error>

namespace HRUtility {
namespace {

// The longer of the two extensions the host adds, ".dxf" and ".svg".
constexpr const char* kExtension = ".dxf";

// Characters no file system takes inside a name, and the separators of any of them.
bool Refused(unsigned char c) { return c < 0x20 || c == 0x7F || std::strchr("/\\<>:\"|?*", c) != nullptr; }

std::string SafeNamePart(const std::string& text) {
  std::string safe;
  safe.reserve(text.size());
  for (const char c : text) safe.push_back(Refused(static_cast<unsigned char>(c)) ? '_' : c);
  return safe;
}

bool TooLong(const std::filesystem::path& path) {
  std::error_code error;
  static_cast<void>(std::filesystem::status(path, error));
  return error == std::errc::filename_too_long;
}

// Drops the last character, never part of one.
void CutOneCharacter(std::string& name) {
  std::size_t cut = name.size();
  while (cut > 0 && (static_cast<unsigned char>(name[--cut]) & 0xC0) == 0x80) {
  }
  name.resize(cut);
}

// The name with the suffix, cut before the suffix as far as the folder's file system needs.
std::string Fitted(const std::filesystem::path& folder, std::string name, const std::string& suffix) {
  // Hardly any file system takes more than 255 bytes; past that, cutting starts there.
  constexpr std::size_t kUsualLimit = 255;
  const std::size_t ending = suffix.size() + std::strlen(kExtension);
  const auto tooLong = [&] { return TooLong(folder / (name + suffix + kExtension)); };
  if (tooLong() && name.size() + ending > kUsualLimit) {
    name.resize(kUsualLimit > ending ? kUsualLimit - ending + 1 : 1);
    CutOneCharacter(name);
  }
  while (!name.empty() && tooLong()) CutOneCharacter(name);
  return name + suffix;
}

std::string Folded(const std::string& file) {
  std::string folded = std::filesystem::path(file).lexically_normal().string();
  for (char& c : folded) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  }
  return folded;
}

}  // namespace

OutputNames OutputNamesFor(const std::string& drawingPath) {
  const std::filesystem::path path(drawingPath);
  return {(path.parent_path() / "2D_").string(), SafeNamePart(path.stem().string()) + "_"};
}

std::string DefaultOutputFile(const OutputNames& names, const std::string& viewName) {
  std::string file = Fitted(names.folder, SafeNamePart(names.prefix + viewName), "");
  // "." and ".." alone would name a folder; a prefix normally prevents it, an empty one not.
  if (file.empty() || file == "." || file == "..") file = "_" + file;
  return (std::filesystem::path(names.folder) / file).string();
}

std::optional<std::string> OwnOutputFile(const std::string& own, const std::string& drawingFolder, bool allowAnywhere,
                                         std::string& refusal) {
  const std::filesystem::path folder = std::filesystem::absolute(drawingFolder).lexically_normal();
  const std::filesystem::path file = (folder / own).lexically_normal();  // an absolute name stays as it is
  if (allowAnywhere) return file.string();
  if (std::ranges::any_of(own, [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; })) {
    refusal = "its own 2D file name holds control characters";
    return std::nullopt;
  }
  // Links to folders may lead anywhere; what counts is the folder the file ends up in. A link
  // in the file's own place is replaced, not followed.
  std::error_code error;
  const std::filesystem::path realFolder = std::filesystem::weakly_canonical(folder, error);
  const std::filesystem::path realFile = std::filesystem::weakly_canonical(file.parent_path(), error) / file.filename();
  const std::filesystem::path inside = realFile.lexically_relative(realFolder);
  if (error || inside.empty() || *inside.begin() == ".." || inside == ".") {
    refusal = "its own 2D file " + file.string() + " lies outside the drawing's folder " + folder.string();
    return std::nullopt;
  }
  return file.string();
}

OutputFileClaims::Claim OutputFileClaims::Take(const std::string& view, const std::string& file, bool adds) {
  const auto [first, added] = taken_.try_emplace(Folded(file), view);
  if (added || adds) return {file, {}};
  const std::filesystem::path path(file);
  std::string name;
  for (int number = 2;; ++number) {
    name = (path.parent_path() / Fitted(path.parent_path(), path.filename().string(),
                                        std::string(1, kCollisionSuffix) + std::to_string(number)))
               .string();
    if (taken_.try_emplace(Folded(name), view).second) break;
  }
  return {name, "its file " + path.filename().string() + " is also the file of \"" + first->second +
                    "\"; written as " + std::filesystem::path(name).filename().string() + " instead"};
}

}  // namespace HRUtility
