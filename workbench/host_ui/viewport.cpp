// Drawing the viewport: the drawing as the host's view shows it (the same 2D drawing the host's
// 2D commands make of it), under lines that say how it is looked at, the cut that is active and
// the points picked so far.
#include "workbench/host_ui/viewport.h"

#include <cstdio>
#include <sstream>
#include <stdexcept>
#include <string>

#include "framework/canvas.h"
#include "framework/text_metrics.h"
#include "framework/window_class.h"
#include "workbench/draft/generate_sheet.h"
#include "workbench/draft/svg_writer.h"
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

// The view's 2D drawing as an SVG picture: hidden lines removed while the display is solid, the
// cuts applied. Empty when the drawing holds nothing the view shows.
std::string ModelPicture() {
  Workbench& bench = Workbench::Get();
  const Drawing* drawing = bench.Find(bench.Current());
  if (drawing == nullptr) return {};
  const ViewState& view = bench.View();
  draft::GenerateOptions options;
  options.view = {view.eye, view.target, view.perspective};
  options.hideHiddenLines = bench.Display().SolidState();
  if (view.section.active) options.section = draft::SectionCut{view.section.points, view.section.cutType};
  if (view.plan.active) options.plan = draft::PlanCut{view.plan.base, view.plan.cutType};
  const draft::Sheet sheet = draft::GenerateSheet(*drawing, options);
  if (sheet.strokes.empty() && sheet.labels.empty()) return {};
  std::ostringstream picture;
  try {
    draft::SvgWriter().Write(sheet, picture);
  } catch (const std::invalid_argument&) {
    return {};  // a value no picture can carry: the view stays empty
  }
  return picture.str();
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
  const std::string model = ModelPicture();
  CRect place(client.left + 10, top + 6, client.right - 10, client.bottom - 10);
  if (!model.empty() && place.Width() > 0 && place.Height() > 0) canvas.Picture(place, model, false, {{"data-part", "model"}});
}

}  // namespace wb::ui
