// Commands over the host's view: eye, target, cone, projection, redraws, scale mode and the
// section and plan cuts.
#include <array>

#include "shell/host/argument_blocks.h"
#include "workbench/command_table.h"
#include "workbench/display_state.h"
#include "workbench/finite_values.h"
#include "workbench/workbench.h"

namespace wb {

namespace {

constexpr int kEyeSlot = 48;     // globp
constexpr int kTargetSlot = 47;  // globp
constexpr int kConeSlot = 64;    // globr
constexpr float kWidestCone = 180.0F;
constexpr float kPlanEyeHeight = 100.0F;  // above the plan's base point

ViewState& View() { return Workbench::Get().View(); }

host::Status GetEye() {
  globp[kEyeSlot] = View().eye;
  return host::kOk;
}

host::Status GetTarget() {
  globp[kTargetSlot] = View().target;
  return host::kOk;
}

host::Status InquireCone() {
  globr[kConeSlot] = View().cone;
  return host::kOk;
}

host::Status InquirePerspective() {
  globr[0] = View().perspective ? 1.0F : 0.0F;
  return host::kOk;
}

// A camera sets the eye before the target, so an eye that meets the old target for a moment
// is taken; only values that cannot be drawn are refused.
host::Status SetEye() {
  if (!IsFinite(globp[kEyeSlot])) return 0;
  View().eye = globp[kEyeSlot];
  return host::kOk;
}

host::Status SetTarget() {
  if (!IsFinite(globp[kTargetSlot])) return 0;
  View().target = globp[kTargetSlot];
  return host::kOk;
}

host::Status SetCone() {
  const float cone = globr[kConeSlot];
  if (!(cone > 0.0F && cone < kWidestCone)) return 0;  // also refuses NaN
  View().cone = cone;
  return host::kOk;
}

host::Status SetParallel() {
  View().perspective = false;
  return host::kOk;
}

host::Status SetPerspective() {
  View().perspective = true;
  return host::kOk;
}

host::Status RedrawOff() {
  View().redrawOn = false;
  return host::kOk;
}

// The redraws held back while redrawing was off are done now, once.
host::Status RedrawOn() {
  ViewState& view = View();
  view.redrawOn = true;
  if (view.redraws.held) {
    view.redraws.held = false;
    ++view.redraws.full;
  }
  return host::kOk;
}

host::Status Regenerate() {
  View().Redraw(&RedrawCounts::regenerations);
  return host::kOk;
}

host::Status RedrawAll() {
  View().Redraw(&RedrawCounts::full);
  return host::kOk;
}

bool IsScaleMode(char mode) { return mode == 'a' || mode == 'f' || mode == 'o' || mode == ' '; }

// An unknown mode is refused and globc[22] shows the mode still in force, so a capture that
// follows stores a mode the host can take back.
host::Status SetScaleMode() {
  ViewState& view = View();
  const char mode = globc[kScaleModeSlot];
  if (!IsScaleMode(mode)) {
    globc[kScaleModeSlot] = view.scaleMode;
    return 0;
  }
  view.scaleMode = mode;
  if (!view.FixedScaling()) view.keepingScale = false;
  return host::kOk;
}

// A vertical cut needs a direction in plan: a cut line whose ends meet in plan has none.
// The host turns the view to face a cut it is asked to show: square on to a section from the
// side it keeps, straight down onto a plan, both in parallel projection.
void FaceSection(const SectionCut& cut) {
  const host::Point3f& start = cut.points[0];
  const host::Point3f& end = cut.points[1];
  const host::Point3f& side = cut.points[3];
  const host::Point3f middle{(start.x + end.x) / 2.0F, (start.y + end.y) / 2.0F, start.z};
  // The side point lies square to the line, as far from its start as the line is long.
  const float awayX = middle.x - 2.0F * (side.x - start.x);
  const float awayY = middle.y - 2.0F * (side.y - start.y);
  ViewState& view = View();
  view.target = middle;
  view.eye = {awayX, awayY, middle.z};
  view.perspective = false;
}

void FacePlan(const PlanView& plan) {
  ViewState& view = View();
  view.target = plan.base;
  view.eye = {plan.base.x, plan.base.y, plan.base.z + kPlanEyeHeight};
  view.perspective = false;
}

bool SectionPointsUsable(const std::array<host::Point3f, 4>& points) {
  for (const host::Point3f& point : points) {
    if (!IsFinite(point)) return false;
  }
  return !(points[0].x == points[1].x && points[0].y == points[1].y);
}

host::Status SetSectionPlane() {
  std::array<host::Point3f, 4> points{globp[0], globp[1], globp[2], globp[3]};
  if (!SectionPointsUsable(points)) return 0;
  ViewState& view = View();
  view.section = SectionCut{points, globc[letter::kCutType], true};
  view.plan.active = false;
  FaceSection(view.section);
  return host::kOk;
}

host::Status ShowPlanView() {
  for (int slot = 0; slot < 4; ++slot) {
    if (!IsFinite(globp[slot])) return 0;
  }
  ViewState& view = View();
  view.plan = PlanView{globp[0], globp[1], globp[2], globp[3], globc[letter::kCutType], true};
  view.section.active = false;
  FacePlan(view.plan);
  return host::kOk;
}

constexpr NamedCommand kViewCommands[] = {
    {"get_eye", &GetEye},
    {"get_target", &GetTarget},
    {"inq_viewing_conus", &InquireCone},
    {"inq_persp_mode", &InquirePerspective},
    {"eye", &SetEye},
    {"target", &SetTarget},
    {"set_viewing_conus", &SetCone},
    {"set_parallel", &SetParallel},
    {"set_perspective", &SetPerspective},
    {"start_redraw_off", &RedrawOff},
    {"start_redraw_on", &RedrawOn},
    {"regen", &Regenerate},
    {"redraw_all", &RedrawAll},
    {"set_scale_mode", &SetScaleMode},
    {"set_vsect_plane", &SetSectionPlane},
    {"planv", &ShowPlanView},
};

}  // namespace

std::span<const NamedCommand> ViewCommands() { return kViewCommands; }

void TakeCutFromSolidBuild() {
  if (globc[letter::kCutStyle] != 's') return;
  const std::array<host::Point3f, 4> points{globp[0], globp[1], globp[2], globp[3]};
  ViewState& view = View();
  // The third point lies straight above the first for a section, beside it for a plan.
  const bool vertical = points[2].x == points[0].x && points[2].y == points[0].y;
  if (vertical) {
    if (!SectionPointsUsable(points)) return;
    view.section = SectionCut{points, globc[letter::kCutType], true};
    view.plan.active = false;
  } else {
    for (const host::Point3f& point : points) {
      if (!IsFinite(point)) return;
    }
    view.plan = PlanView{points[0], points[1], points[2], points[3], globc[letter::kCutType], true};
    view.section.active = false;
  }
}

void DropCuts() {
  globc[letter::kCutStyle] = ' ';  // the next solid build carries no cut
  View().section.active = false;
  View().plan.active = false;
}

}  // namespace wb
