// Drawing the viewport: a line that says how the host looks at the drawing, the cut that is
// active and the points picked so far.
#include "workbench/host_ui/viewport.h"

#include <cstdio>
#include <string>

#include "framework/canvas.h"
#include "framework/text_metrics.h"
#include "framework/window_class.h"
#include "workbench/workbench.h"

namespace wb::ui {
namespace {

std::string PointText(const host::Point3f& p) {
  char text[96];
  std::snprintf(text, sizeof text, "(%.2f, %.2f, %.2f)", static_cast<double>(p.x), static_cast<double>(p.y),
                static_cast<double>(p.z));
  return text;
}

std::string ViewText(const ViewState& view) {
  std::string text = view.threeD ? "3D " : "2D ";
  text += view.perspective ? "perspective" : "parallel";
  return text + " view from " + PointText(view.eye) + " to " + PointText(view.target);
}

}  // namespace

bool Viewport::Create(CWnd* parent, int id) {
  framework::RegisterWindowClass(kClassName, 0, [] { return std::make_unique<framework::WindowBehaviour>(); });
  return CreateEx(WS_EX_CLIENTEDGE, kClassName, "", WS_CHILD | WS_VISIBLE, CRect(0, 0, 100, 100), parent,
                  static_cast<UINT>(id)) != FALSE;
}

void Viewport::SetPickedPoints(std::vector<host::Point3f> points) {
  picked_ = std::move(points);
  Invalidate(FALSE);
}

LRESULT Viewport::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  if (message == WM_PAINT) {
    Paint(*reinterpret_cast<Canvas*>(wParam));
    return 0;
  }
  return CWnd::WindowProc(message, wParam, lParam);
}

void Viewport::Paint(Canvas& canvas) const {
  CRect client;
  GetClientRect(&client);
  canvas.FillRect(client, RGB(255, 255, 255));
  const ViewState& view = Workbench::Get().View();
  std::vector<std::string> lines = {ViewText(view)};
  if (view.section.active) lines.push_back("Section cut from " + PointText(view.section.points[0]) + " to " +
                                           PointText(view.section.points[1]));
  if (view.plan.active) lines.push_back("Plan cut at " + PointText(view.plan.base));
  for (std::size_t i = 0; i < picked_.size(); ++i) {
    lines.push_back("Point " + std::to_string(i + 1) + ": " + PointText(picked_[i]));
  }
  int top = 8;
  for (const std::string& line : lines) {
    canvas.Text(10, top + framework::kFontAscent, line, {RGB(60, 60, 60), false, Canvas::Anchor::kStart});
    top += framework::kLineHeight + 4;
  }
}

}  // namespace wb::ui
