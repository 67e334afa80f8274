// How replacement temporaries and backups are named and how the leftovers of killed writes are
// found: the same on every system, over the few file system calls each system makes its own way.
#pragma once

#include <cstddef>
#include <filesystem>
#include <string>
#include <string_view>

namespace wb::replacement {

// The longest file name the folder's file system takes (each system answers its own way).
std::size_t NameLimit(const std::filesystem::path& folder);
// Removes the temporary unless a running write holds it (each system tells its own way).
void RemoveIfStale(const std::filesystem::path& path);

// The names a new temporary of a target may take. Making it removes the stale temporaries of the
// same target first.
class TemporaryNames {
 public:
  TemporaryNames(const std::filesystem::path& target, std::string_view suffix);
  // ".<name>.<16 random hex digits><suffix>" in the target's folder, the name cut to fit.
  std::filesystem::path Next() const;

 private:
  std::filesystem::path folder_;
  std::string prefix_;
  std::string suffix_;
};

}  // namespace wb::replacement
