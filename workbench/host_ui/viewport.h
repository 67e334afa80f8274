// The main frame's view of the drawing: what the host's view state shows, and the points a
// pick has taken so far.
#pragma once

#include <vector>

#include "framework/cwnd.h"
#include "shell/host/host_types.h"

namespace wb::ui {

class Viewport : public CWnd {
 public:
  static constexpr const char* kClassName = "WorkbenchViewport";

  bool Create(CWnd* parent, int id);
  // The points of a pick under way, marked in the view.
  void SetPickedPoints(std::vector<host::Point3f> points);

 protected:
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override;

 private:
  void Paint(Canvas& canvas) const;

  std::vector<host::Point3f> picked_;
};

}  // namespace wb::ui
