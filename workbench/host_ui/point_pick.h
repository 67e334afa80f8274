// The host asking its user for points, one prompt a point: a point is typed on the main
// frame's command line as "x,y" or "x,y,z" and confirmed with Enter; Escape cancels the pick.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "shell/host/host_types.h"

namespace wb::ui {

// Two or three numbers separated by commas, blanks around them allowed; z is 0 when left out.
// Nothing for anything else, numbers that are not finite included.
std::optional<host::Point3f> ParseTypedPoint(std::string_view text);

class PointPick {
 public:
  // One prompt for each point to pick, in order.
  explicit PointPick(std::vector<std::string> prompts) : prompts_(std::move(prompts)) {}

  bool Finished() const { return cancelled_ || points_.size() == prompts_.size(); }
  bool Cancelled() const { return cancelled_; }
  const std::vector<host::Point3f>& Points() const { return points_; }
  // What the command line asks now, or why the last line typed was no point.
  std::string Prompt() const;

  void Take(const host::Point3f& point);
  // Takes a typed line; false when it is no point (the prompt then says so).
  bool TakeTyped(std::string_view text);
  void Cancel() { cancelled_ = true; }

 private:
  std::vector<std::string> prompts_;
  std::vector<host::Point3f> points_;
  bool cancelled_ = false;
  bool refused_ = false;  // the last line typed was no point
};

}  // namespace wb::ui
