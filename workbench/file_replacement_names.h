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

// ".<name>." cut so that the random digits and the suffix still fit in a file name.
std::string TemporaryPrefix(const std::filesystem::path& target, std::string_view suffix);
std::string RandomDigits();
// Removes the stale temporaries of the target whose temporaries start with the prefix.
void RemoveStaleTemporariesOf(const std::filesystem::path& folder, std::string_view suffix, std::string_view prefix);

}  // namespace wb::replacement
