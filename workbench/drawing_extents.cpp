// Plan extents over the shown lines and points of a drawing.
#include "workbench/drawing_extents.h"

#include <algorithm>

#include "workbench/finite_values.h"

namespace wb {

namespace {

constexpr double kLeastExtent = 1.0;

class Bounds {
 public:
  void Add(const host::Point3f& point) {
    if (!IsFinite(point)) return;
    if (!any_) {
      box_ = {point.x, point.y, point.x, point.y};
      any_ = true;
      return;
    }
    box_[0] = std::min(box_[0], static_cast<double>(point.x));
    box_[1] = std::min(box_[1], static_cast<double>(point.y));
    box_[2] = std::max(box_[2], static_cast<double>(point.x));
    box_[3] = std::max(box_[3], static_cast<double>(point.y));
  }

  std::optional<std::array<double, 4>> Result() const {
    if (!any_) return std::nullopt;
    std::array<double, 4> box = box_;
    for (std::size_t axis = 0; axis < 2; ++axis) {
      if (box[axis + 2] - box[axis] < kLeastExtent) {
        const double middle = (box[axis] + box[axis + 2]) / 2.0;
        box[axis] = middle - kLeastExtent / 2.0;
        box[axis + 2] = middle + kLeastExtent / 2.0;
      }
    }
    return box;
  }

 private:
  std::array<double, 4> box_{};
  bool any_ = false;
};

bool Shown(const Drawing& drawing, const Entity& entity) {
  const std::uint8_t layer = entity.header.bytes[host::kHeaderLayer];
  return entity.Alive() && !entity.Hidden() && drawing.layers[layer].on;
}

}  // namespace

std::optional<std::array<double, 4>> PlanExtents(const Drawing& drawing) {
  Bounds bounds;
  for (const Entity& entity : drawing.slots) {
    if (!Shown(drawing, entity)) continue;
    if (entity.Type() == host::kTypeLine) {
      const auto line = ReadRecord<host::LineRecord>(entity);
      bounds.Add(line.start);
      bounds.Add(line.end);
    } else if (entity.Type() == host::kTypePoint) {
      bounds.Add(ReadRecord<host::PointRecord>(entity).position);
    }
  }
  return bounds.Result();
}

}  // namespace wb
