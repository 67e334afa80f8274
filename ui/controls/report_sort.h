// How the report list orders the texts of a column: as hexadecimal numbers, else as decimal
// numbers (a "%" may follow), else as dates, else byte by byte.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string_view>
#include <vector>

namespace report_sort {

// Whether `a` comes before `b`, by the first rule that reads both texts: (1) both read wholly
// as unsigned hexadecimal numbers (no sign); (2) both read wholly as decimal numbers, each
// optionally followed by one "%" (not-a-number is no number); (3) both read as dates; (4)
// otherwise the bytes compare, upper case before lower case.
bool Less(std::string_view a, std::string_view b);

// The date reading of rule (3), in seconds from the start of 1 January of year 1. It reads
//   YYYY-MM-DD, optionally followed by a blank or "T" and HH:MM or HH:MM:SS (24 hours), and
//   M/D/YYYY, optionally followed by a blank and H:MM or H:MM:SS, optionally " AM" or " PM";
// with blanks around allowed, real calendar days only (leap years counted), nothing else.
std::optional<std::int64_t> ReadDate(std::string_view text);

// Sorts `order` by `less`, keeping rows that compare equal in their order. The rules above may
// order three texts in a circle (a hex pair, a number pair and a text pair), so this sort
// stays within its range whatever `less` answers.
void StableSort(std::vector<int>& order, const std::function<bool(int, int)>& less);

}  // namespace report_sort
