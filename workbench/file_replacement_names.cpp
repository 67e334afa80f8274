// Temporaries are named ".<name>.<16 hex digits><suffix>" and backups "<name>.bak". Where a long
// name leaves no room for the rest, the name is cut: temporaries and backups must fit in a file
// name wherever their target does.
#include "workbench/file_replacement_names.h"

#include <cstdint>
#include <cstdio>
#include <random>
#include <system_error>

#include "workbench/file_replacement.h"

namespace wb {
namespace replacement {
namespace {

constexpr std::size_t kRandomDigits = 16;
constexpr std::string_view kBackupSuffix = ".bak";

// At most `bytes` bytes of the name, cut between characters, never inside one.
std::string CutTo(std::string name, std::size_t bytes) {
  if (name.size() <= bytes) return name;
  while (bytes > 0 && (static_cast<unsigned char>(name[bytes]) & 0xC0) == 0x80) --bytes;
  name.resize(bytes);
  return name;
}

// ".<name>.<16 hex digits><suffix>"
bool IsTemporary(std::string_view name, std::string_view suffix) {
  if (name.size() < 2 + kRandomDigits + suffix.size() || !name.starts_with('.') || !name.ends_with(suffix)) {
    return false;
  }
  name.remove_suffix(suffix.size());
  const std::string_view digits = name.substr(name.size() - kRandomDigits);
  return digits.find_first_not_of("0123456789abcdef") == std::string_view::npos &&
         name[name.size() - kRandomDigits - 1] == '.';
}

// A temporary of the target whose temporaries start with the prefix.
bool IsTemporaryOf(std::string_view name, std::string_view suffix, std::string_view prefix) {
  return name.size() == prefix.size() + kRandomDigits + suffix.size() && name.starts_with(prefix) &&
         IsTemporary(name, suffix);
}

// The temporaries the test picks out, when no running write holds them.
template <typename Pick>
void RemoveStale(const std::filesystem::path& folder, Pick pick) {
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
    if (pick(entry->path().filename().string())) RemoveIfStale(entry->path());
  }
}

}  // namespace

TemporaryNames::TemporaryNames(const std::filesystem::path& target, std::string_view suffix)
    : folder_(target.parent_path()), suffix_(suffix) {
  const std::size_t room = NameLimit(folder_) - 2 - kRandomDigits - suffix.size();
  prefix_ = '.' + CutTo(target.filename().string(), room) + '.';
  RemoveStale(folder_, [this](std::string_view name) { return IsTemporaryOf(name, suffix_, prefix_); });
}

std::filesystem::path TemporaryNames::Next() const {
  std::random_device random;
  const std::uint64_t value = (std::uint64_t{random()} << 32) ^ random();
  char digits[kRandomDigits + 1];
  std::snprintf(digits, sizeof digits, "%016llx", static_cast<unsigned long long>(value));
  return folder_ / (prefix_ + digits + suffix_);
}

}  // namespace replacement

std::filesystem::path BackupPath(const std::filesystem::path& target) {
  const std::size_t room = replacement::NameLimit(target.parent_path()) - replacement::kBackupSuffix.size();
  return target.parent_path() /
         (replacement::CutTo(target.filename().string(), room) + std::string(replacement::kBackupSuffix));
}

void RemoveStaleTemporaries(const std::filesystem::path& folder, std::string_view suffix) {
  replacement::RemoveStale(folder, [suffix](std::string_view name) { return replacement::IsTemporary(name, suffix); });
}

}  // namespace wb
