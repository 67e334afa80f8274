// Reading typed points and following a pick from prompt to prompt.
#include "workbench/host_ui/point_pick.h"

#include <charconv>
#include <cmath>

namespace wb::ui {
namespace {

std::string_view Trimmed(std::string_view text) {
  const auto first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

std::optional<float> Number(std::string_view text) {
  text = Trimmed(text);
  if (!text.empty() && text.front() == '+') text.remove_prefix(1);
  float value = 0.0F;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
  if (text.empty() || error != std::errc() || end != text.data() + text.size() || !std::isfinite(value)) {
    return std::nullopt;
  }
  return value;
}

}  // namespace

std::optional<host::Point3f> ParseTypedPoint(std::string_view text) {
  float values[3] = {0.0F, 0.0F, 0.0F};
  std::size_t count = 0;
  for (std::size_t start = 0;; ++count) {
    const std::size_t comma = text.find(',', start);
    if (count == 3) return std::nullopt;
    const std::optional<float> value = Number(text.substr(start, comma == std::string_view::npos ? comma : comma - start));
    if (!value) return std::nullopt;
    values[count] = *value;
    if (comma == std::string_view::npos) break;
    start = comma + 1;
  }
  if (count < 1) return std::nullopt;  // one number is no point
  return host::Point3f{values[0], values[1], values[2]};
}

std::string PointPick::Prompt() const {
  if (Finished()) return {};
  const std::string& ask = prompts_[points_.size()];
  return refused_ ? "Not a point. " + ask : ask;
}

void PointPick::Take(const host::Point3f& point) {
  if (Finished()) return;
  points_.push_back(point);
  refused_ = false;
}

bool PointPick::TakeTyped(std::string_view text) {
  const std::optional<host::Point3f> point = ParseTypedPoint(text);
  refused_ = !point;
  if (point) Take(*point);
  return point.has_value();
}

}  // namespace wb::ui
