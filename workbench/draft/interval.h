// A range of a segment's parameter, 0 at its start and 1 (or its length) at its end.
#pragma once

namespace wb::draft {

struct Interval {
  double from = 0.0;
  double to = 0.0;
};

}  // namespace wb::draft
