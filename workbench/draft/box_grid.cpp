// Building the box grid: sized within its entry budget, then counted and filled into one flat
// list.
#include "workbench/draft/box_grid.h"

#include <algorithm>
#include <cmath>
#include <stdexcept>

namespace wb::draft {

namespace {

constexpr int kMaxCellsPerSide = 2048;

int CellCount(double extent, double cellSize) {
  if (!(cellSize > 0.0)) return 1;
  return static_cast<int>(std::clamp(std::ceil(extent / cellSize), 1.0, static_cast<double>(kMaxCellsPerSide)));
}

// Positions off the grid go to its border cells; the test is written so that NaN does too.
int CellIndex(double position, int count) {
  if (!(position > 0.0)) return 0;
  if (position >= count - 1) return count - 1;
  return static_cast<int>(position);
}

}  // namespace

std::uint64_t BoxGrid::EntryBudget(std::size_t boxes) {
  return std::max<std::uint64_t>(kMinEntryBudget, std::uint64_t{kEntriesPerBox} * boxes);
}

BoxGrid::BoxGrid(const std::vector<Box2>& boxes) {
  if (boxes.empty()) return;
  // Entries name their box in 32 bits, and the budget keeps every count within them.
  static_assert(kMinEntryBudget < UINT32_MAX);
  if (boxes.size() > UINT32_MAX / kEntriesPerBox) throw std::length_error("too many boxes for one grid");
  bounds_ = boxes.front();
  for (const Box2& box : boxes) {
    bounds_.min = {std::min(bounds_.min.x, box.min.x), std::min(bounds_.min.y, box.min.y)};
    bounds_.max = {std::max(bounds_.max.x, box.max.x), std::max(bounds_.max.y, box.max.y)};
  }
  const double width = bounds_.max.x - bounds_.min.x;
  const double height = bounds_.max.y - bounds_.min.y;
  const double cells = static_cast<double>(boxes.size());
  const double area = width * height;
  const double cellSize = area > 0.0 ? std::sqrt(area / cells) : std::max(width, height) / cells;
  SetCells(CellCount(width, cellSize), CellCount(height, cellSize));
  // Many large boxes cover many cells each: tens of thousands of long strokes across the whole
  // view would list billions of entries. A coarser grid lists fewer; its walks visit more.
  const std::uint64_t budget = EntryBudget(boxes.size());
  while (CountEntries(boxes) > budget && (columns_ > 1 || rows_ > 1)) {
    SetCells(std::max(1, columns_ / 2), std::max(1, rows_ / 2));
  }

  const std::size_t cellTotal = static_cast<std::size_t>(columns_) * static_cast<std::size_t>(rows_);
  cellStart_.assign(cellTotal + 1, 0);
  const auto forEachCell = [&](const Box2& box, auto action) {
    for (int row = Row(box.min.y); row <= Row(box.max.y); ++row) {
      for (int column = Column(box.min.x); column <= Column(box.max.x); ++column) {
        action(static_cast<std::size_t>(row) * static_cast<std::size_t>(columns_) + column);
      }
    }
  };
  for (const Box2& box : boxes) forEachCell(box, [&](std::size_t cell) { ++cellStart_[cell + 1]; });
  for (std::size_t cell = 0; cell < cellTotal; ++cell) cellStart_[cell + 1] += cellStart_[cell];
  entries_.resize(cellStart_[cellTotal]);
  std::vector<std::uint32_t> fill(cellStart_.begin(), cellStart_.end() - 1);
  for (std::uint32_t index = 0; index < boxes.size(); ++index) {
    forEachCell(boxes[index], [&](std::size_t cell) { entries_[fill[cell]++] = index; });
  }
}

void BoxGrid::SetCells(int columns, int rows) {
  columns_ = columns;
  rows_ = rows;
  const double width = bounds_.max.x - bounds_.min.x;
  const double height = bounds_.max.y - bounds_.min.y;
  cellWidth_ = width > 0.0 ? width / columns_ : 1.0;
  cellHeight_ = height > 0.0 ? height / rows_ : 1.0;
}

std::uint64_t BoxGrid::CountEntries(const std::vector<Box2>& boxes) const {
  std::uint64_t total = 0;
  for (const Box2& box : boxes) {
    const auto columns = static_cast<std::uint64_t>(Column(box.max.x) - Column(box.min.x) + 1);
    const auto rows = static_cast<std::uint64_t>(Row(box.max.y) - Row(box.min.y) + 1);
    total += columns * rows;
  }
  return total;
}

int BoxGrid::Column(double x) const { return CellIndex((x - bounds_.min.x) / cellWidth_, columns_); }

int BoxGrid::Row(double y) const { return CellIndex((y - bounds_.min.y) / cellHeight_, rows_); }

}  // namespace wb::draft
