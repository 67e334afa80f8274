// A uniform grid over the view plane that finds the boxes a segment may cross: occluders in
// hidden-line removal, strokes in the line clean-ups.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

#include "workbench/draft/sheet.h"

namespace wb::draft {

class BoxGrid {
 public:
  BoxGrid() = default;
  // About one cell per box keeps both the cell lists and the walk short; where boxes are so
  // large that this would list more than EntryBudget entries, the grid is made coarser.
  explicit BoxGrid(const std::vector<Box2>& boxes);

  // The most (box, cell) entries a grid over this many boxes lists.
  static std::uint64_t EntryBudget(std::size_t boxes);
  std::size_t EntryCount() const { return entries_.size(); }

  // Calls visit(index) for the boxes listed in every cell the segment from a to b, widened by
  // margin, passes; a box in several cells comes once per cell. Stops when visit
  // answers false.
  template <typename Visit>
  void ForEachAlong(Point2 a, Point2 b, double margin, Visit visit) const;

 private:
  // 16 M entries (64 MB), or 4 per box where there are more boxes.
  static constexpr std::uint64_t kMinEntryBudget = std::uint64_t{1} << 24;
  static constexpr std::uint64_t kEntriesPerBox = 4;

  void SetCells(int columns, int rows);
  // How many entries the boxes make in the grid as it stands, counted without overflow.
  std::uint64_t CountEntries(const std::vector<Box2>& boxes) const;
  int Column(double x) const;
  int Row(double y) const;

  Box2 bounds_{};
  double cellWidth_ = 1.0;
  double cellHeight_ = 1.0;
  int columns_ = 0;
  int rows_ = 0;
  std::vector<std::uint32_t> cellStart_;  // per cell, its first entry in entries_; one more at the end
  std::vector<std::uint32_t> entries_;
};

template <typename Visit>
void BoxGrid::ForEachAlong(Point2 a, Point2 b, double margin, Visit visit) const {
  if (columns_ == 0) return;
  if (std::max(a.x, b.x) + margin < bounds_.min.x || std::min(a.x, b.x) - margin > bounds_.max.x ||
      std::max(a.y, b.y) + margin < bounds_.min.y || std::min(a.y, b.y) - margin > bounds_.max.y) {
    return;
  }
  if (a.y > b.y) std::swap(a, b);
  const double dy = b.y - a.y;
  const double dxPerY = dy > 0.0 ? (b.x - a.x) / dy : 0.0;
  const int firstRow = Row(a.y - margin);
  const int lastRow = Row(b.y + margin);
  for (int row = firstRow; row <= lastRow; ++row) {
    // The part of the segment inside this row's band gives the columns to look at.
    double xLow = std::min(a.x, b.x);
    double xHigh = std::max(a.x, b.x);
    if (dy > 0.0) {
      const double bandLow = std::max(a.y, bounds_.min.y + row * cellHeight_ - margin);
      const double bandHigh = std::min(b.y, bounds_.min.y + (row + 1) * cellHeight_ + margin);
      const double x1 = a.x + (bandLow - a.y) * dxPerY;
      const double x2 = a.x + (bandHigh - a.y) * dxPerY;
      xLow = std::max(xLow, std::min(x1, x2));
      xHigh = std::min(xHigh, std::max(x1, x2));
    }
    const int lastColumn = Column(xHigh + margin);
    for (int column = Column(xLow - margin); column <= lastColumn; ++column) {
      const std::size_t cell = static_cast<std::size_t>(row) * static_cast<std::size_t>(columns_) + column;
      for (std::uint32_t k = cellStart_[cell]; k < cellStart_[cell + 1]; ++k) {
        if (!visit(entries_[k])) return;
      }
    }
  }
}

}  // namespace wb::draft
