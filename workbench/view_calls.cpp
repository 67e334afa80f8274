// The host's view calls: wait cursor, view window, redraws, 2D and 3D, scale keeping.
#include <algorithm>
#include <cmath>

#include "shell/host/qeldll_view.h"
#include "workbench/drawing_extents.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

constexpr std::int32_t kFitEverything = 4;

ViewState& View() { return Workbench::Get().View(); }

}  // namespace

void add_wait_cur() {
  if (call::Fault(__func__)) return;
  ++View().waitCursor;
  call::JournalHostCall(__func__);
}

// A remove with no add outstanding is a caller's fault: it is counted, never taken.
void remove_wait_cur() {
  if (call::Fault(__func__)) return;
  ViewState& view = View();
  if (view.waitCursor == 0) {
    ++view.waitCursorUnderflows;
    return;
  }
  --view.waitCursor;
  call::JournalHostCall(__func__);
}

void wn3_inq_view_rect(double rect[4]) {
  if (call::Fault(__func__) || rect == nullptr) return;
  std::copy(View().window.begin(), View().window.end(), rect);
}

// Corners given the wrong way round are put in order; a window that cannot be drawn is refused.
void wn3_set_view_rect(const double rect[4]) {
  if (call::Fault(__func__) || rect == nullptr) return;
  if (!std::all_of(rect, rect + 4, [](double value) { return std::isfinite(value); })) return;
  View().window = {std::min(rect[0], rect[2]), std::min(rect[1], rect[3]), std::max(rect[0], rect[2]),
                   std::max(rect[1], rect[3])};
  call::JournalHostCall(__func__);
}

void wn3_auto_window(std::int32_t mode) {
  if (call::Fault(__func__) || mode != kFitEverything) return;
  ViewState& view = View();
  ++view.autoWindowFits;
  if (const Drawing* drawing = Workbench::Get().Find(Workbench::Get().Current())) {
    if (auto extents = PlanExtents(*drawing)) view.window = *extents;
  }
  call::JournalHostCall(__func__);
}

void wn3_dl_redraw(std::int32_t mode) {
  if (call::Fault(__func__)) return;
  ViewState& view = View();
  view.redraws.lastDisplayListMode = mode;
  view.Redraw(&RedrawCounts::displayList);
  call::JournalHostCall(__func__);
}

void init_hdl_redraw_draw_params() {
  if (call::Fault(__func__)) return;
  ++View().redraws.drawParameterResets;
  call::JournalHostCall(__func__);
}

void execute_2d() {
  if (call::Fault(__func__)) return;
  View().SetThreeD(false);
  call::JournalHostCall(__func__);
}

void execute_3d() {
  if (call::Fault(__func__)) return;
  View().SetThreeD(true);
  call::JournalHostCall(__func__);
}

std::int32_t wnp_fixed_scaling() {
  if (auto fault = call::Fault(__func__)) return *fault;
  return View().FixedScaling() ? 1 : 0;
}

std::int32_t wnp_auto_scaling() {
  if (auto fault = call::Fault(__func__)) return *fault;
  return View().AutoScaling() ? 1 : 0;
}

// The scale the present window shows at: its width over the width of the drawing box.
double dBox_calc_scale() {
  if (auto fault = call::Fault(__func__)) return *fault;
  const ViewState& view = View();
  if (!(view.boxWidth > 0.0)) return 0.0;
  return (view.window[2] - view.window[0]) / view.boxWidth;
}

// Only a scale that can be drawn at is kept.
void dBox_window_set_keep_scale(float scale) {
  if (call::Fault(__func__)) return;
  if (!(scale > 0.0F) || !std::isfinite(scale)) return;
  View().keptScale = scale;
  call::JournalHostCall(__func__);
}

std::int32_t dBox_window_keep_scale() {
  if (auto fault = call::Fault(__func__)) return *fault;
  ViewState& view = View();
  if (view.keptScale <= 0.0F) return 0;
  view.keepingScale = true;
  call::JournalHostCall(__func__);
  return 1;
}
