// The report list's ordering rules and the merge sort that applies them.
#include "ui/controls/report_sort.h"

#include <cctype>
#include <cerrno>
#include <cmath>
#include <cstdlib>
#include <string>

namespace report_sort {
namespace {

// The standard library's reading of an unsigned hexadecimal number, refusing a sign (which it
// would take and negate, putting "-5" after every positive number) and numbers too large.
std::optional<unsigned long long> ReadHex(std::string_view text) {
  if (text.empty() || text.find_first_of("+-") != std::string_view::npos) return std::nullopt;
  const std::string copy(text);
  char* end = nullptr;
  errno = 0;
  const unsigned long long value = std::strtoull(copy.c_str(), &end, 16);
  if (errno == ERANGE || end == copy.c_str() || *end != '\0') return std::nullopt;
  return value;
}

std::optional<double> ReadNumber(std::string_view text) {
  if (!text.empty() && text.back() == '%') text.remove_suffix(1);
  if (text.empty()) return std::nullopt;
  const std::string copy(text);
  char* end = nullptr;
  const double value = std::strtod(copy.c_str(), &end);
  if (end == copy.c_str() || *end != '\0' || std::isnan(value)) return std::nullopt;
  return value;
}

// Reads 1 to `maxDigits` digits at `at` into `value`.
bool Digits(std::string_view text, std::size_t& at, std::size_t minDigits, std::size_t maxDigits, int& value) {
  std::size_t count = 0;
  value = 0;
  while (at < text.size() && count < maxDigits && std::isdigit(static_cast<unsigned char>(text[at])) != 0) {
    value = value * 10 + (text[at++] - '0');
    ++count;
  }
  return count >= minDigits;
}

bool Expect(std::string_view text, std::size_t& at, char c) {
  if (at >= text.size() || text[at] != c) return false;
  ++at;
  return true;
}

bool IsLeapYear(int year) { return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0; }

int DaysInMonth(int year, int month) {
  static constexpr int kDays[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  return month == 2 && IsLeapYear(year) ? 29 : kDays[month - 1];
}

// Days from 1 January of year 1 in the proleptic Gregorian calendar.
std::int64_t DayNumber(int year, int month, int day) {
  const std::int64_t y = year - 1;
  std::int64_t days = y * 365 + y / 4 - y / 100 + y / 400;
  for (int m = 1; m < month; ++m) days += DaysInMonth(year, m);
  return days + day - 1;
}

// "H:MM" or "H:MM:SS" at `at`; the hour is checked by the caller.
bool ReadTime(std::string_view text, std::size_t& at, int& hour, int& minute, int& second) {
  second = 0;
  if (!Digits(text, at, 1, 2, hour) || !Expect(text, at, ':') || !Digits(text, at, 2, 2, minute) || minute > 59) return false;
  if (at < text.size() && text[at] == ':') {
    ++at;
    if (!Digits(text, at, 2, 2, second) || second > 59) return false;
  }
  return true;
}

bool EqualNoCase(std::string_view a, std::string_view b) {
  if (a.size() != b.size()) return false;
  for (std::size_t i = 0; i < a.size(); ++i) {
    if (std::toupper(static_cast<unsigned char>(a[i])) != std::toupper(static_cast<unsigned char>(b[i]))) return false;
  }
  return true;
}

}  // namespace

std::optional<std::int64_t> ReadDate(std::string_view text) {
  while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
  while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
  std::size_t at = 0;
  int year = 0;
  int month = 0;
  int day = 0;
  const bool iso = text.size() >= 5 && text[4] == '-';
  if (iso) {
    if (!Digits(text, at, 4, 4, year) || !Expect(text, at, '-') || !Digits(text, at, 2, 2, month) || !Expect(text, at, '-') ||
        !Digits(text, at, 2, 2, day)) {
      return std::nullopt;
    }
  } else if (!Digits(text, at, 1, 2, month) || !Expect(text, at, '/') || !Digits(text, at, 1, 2, day) ||
             !Expect(text, at, '/') || !Digits(text, at, 4, 4, year)) {
    return std::nullopt;
  }
  if (year < 1 || month < 1 || month > 12 || day < 1 || day > DaysInMonth(year, month)) return std::nullopt;
  int hour = 0;
  int minute = 0;
  int second = 0;
  if (at < text.size()) {
    if (!(text[at] == ' ' || (iso && text[at] == 'T'))) return std::nullopt;
    ++at;
    if (!ReadTime(text, at, hour, minute, second)) return std::nullopt;
    const std::string_view rest = text.substr(at);
    if (rest.empty()) {
      if (hour > 23) return std::nullopt;
    } else if (!iso && (EqualNoCase(rest, " AM") || EqualNoCase(rest, " PM"))) {
      if (hour < 1 || hour > 12) return std::nullopt;
      hour = hour % 12 + (EqualNoCase(rest, " PM") ? 12 : 0);
    } else {
      return std::nullopt;
    }
  }
  return DayNumber(year, month, day) * 86400 + hour * 3600 + minute * 60 + second;
}

bool Less(std::string_view a, std::string_view b) {
  if (const auto ha = ReadHex(a), hb = ReadHex(b); ha && hb) return *ha < *hb;
  if (const auto na = ReadNumber(a), nb = ReadNumber(b); na && nb) return *na < *nb;
  if (const auto da = ReadDate(a), db = ReadDate(b); da && db) return *da < *db;
  return a < b;  // byte by byte, as unsigned characters
}

void StableSort(std::vector<int>& order, const std::function<bool(int, int)>& less) {
  // Bottom-up merging: every step reads only within its two runs, whatever `less` answers.
  std::vector<int> merged(order.size());
  for (std::size_t width = 1; width < order.size(); width *= 2) {
    for (std::size_t start = 0; start < order.size(); start += 2 * width) {
      const std::size_t middle = std::min(start + width, order.size());
      const std::size_t end = std::min(start + 2 * width, order.size());
      std::size_t left = start;
      std::size_t right = middle;
      std::size_t out = start;
      while (left < middle && right < end) merged[out++] = less(order[right], order[left]) ? order[right++] : order[left++];
      while (left < middle) merged[out++] = order[left++];
      while (right < end) merged[out++] = order[right++];
    }
    order.swap(merged);
  }
}

}  // namespace report_sort
