// Taking a camera from the host view and applying it back, whole or in two phases.
#include <algorithm>

#include "display/display_mode.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "views/hr_camera.h"
#include "views/section_symbols.h"

namespace {

constexpr int kEyeSlot = 48;
constexpr int kTargetSlot = 47;
constexpr int kConeSlot = 64;
constexpr int kDimensionSlot = 132;  // 2.0 while the view is 2D
constexpr int kScaleModeSlot = 22;
constexpr int kPatternSlot = 66;
constexpr std::int32_t kAutoWindowFit = 4;
constexpr std::int32_t kRedrawAll = 2;

void Run(const char* command) { execute_internal_command(command); }

void FromPoint(const host::Point3f& point, float (&out)[3]) {
  out[0] = point.x;
  out[1] = point.y;
  out[2] = point.z;
}

host::Point3f ToPoint(const float (&values)[3]) { return {values[0], values[1], values[2]}; }

// What the layer switch must do for layer i; layer values other than 0 and 1 switch nothing.
enum class LayerSwitch { None, On, Off };

LayerSwitch SwitchFor(std::uint16_t wanted, const host::LayerEntry& present) {
  const bool presentlyOff = present.state == host::kLayerOffState;
  if (wanted == 1 && presentlyOff) return LayerSwitch::On;
  if (wanted == 0 && !presentlyOff) return LayerSwitch::Off;
  return LayerSwitch::None;
}

}  // namespace

std::int16_t HRCamera::CaptureView() {
  if (globc[kPatternSlot] == 'h') patterns_ = 1;
  wn3_inq_view_rect(viewWindow_);
  if (const host::LayerEntry* table = GetLayersInCurrentHDL()) {
    for (int i = 0; i < kLayerCount; ++i) layers_[static_cast<std::size_t>(i)] = table[i].state != host::kLayerOffState ? 1 : 0;
  }
  Run("get_eye");
  FromPoint(globp[kEyeSlot], eye_);
  Run("get_target");
  FromPoint(globp[kTargetSlot], target_);
  Run("inq_viewing_conus");
  cone_ = globr[kConeSlot];
  Run("inq_persp_mode");
  const bool perspective = globr[0] != 0.0F;
  const bool flat = globr[kDimensionSlot] == 2.0F;
  viewMode_ = flat ? (perspective ? k2DPerspective : k2DParallel) : (perspective ? k3DPerspective : k3DParallel);
  displayMode_ = HRUtility::GetDisplayMode();
  scaleMode_ = globc[kScaleModeSlot];
  return 0;
}

void HRCamera::UpdateView() {
  wn3_inq_view_rect(viewWindow_);
  Run("get_eye");
  FromPoint(globp[kEyeSlot], eye_);
  Run("get_target");
  FromPoint(globp[kTargetSlot], target_);
}

bool HRCamera::ApplyLayers(bool stopAtRefusal) const {
  const host::LayerEntry* table = GetLayersInCurrentHDL();
  if (table == nullptr) return true;  // no layer table: there is nothing to switch
  // The host may refresh its table on every switch; take a copy of the state we compare with.
  std::array<host::LayerEntry, kLayerCount> present{};
  std::copy(table, table + kLayerCount, present.begin());
  for (int i = 0; i < kLayerCount; ++i) {
    host::Status result = host::kOk;
    switch (SwitchFor(layers_[static_cast<std::size_t>(i)], present[static_cast<std::size_t>(i)])) {
      case LayerSwitch::On: result = HDL_Set_Layer_On(HDL_Main(), i); break;
      case LayerSwitch::Off: result = HDL_Set_Layer_Off(HDL_Main(), i); break;
      case LayerSwitch::None: break;
    }
    if (result != host::kOk && stopAtRefusal) return false;
  }
  return true;
}

void HRCamera::ApplyProjection() const {
  switch (viewMode_) {
    case k2DParallel: Run("set_parallel"); execute_2d(); break;
    case k2DPerspective: Run("set_perspective"); execute_2d(); break;
    case k3DParallel: Run("set_parallel"); execute_3d(); break;
    case k3DPerspective: Run("set_perspective"); execute_3d(); break;
    default: break;
  }
}

void HRCamera::ApplyEyeTargetCone() const {
  globp[kEyeSlot] = ToPoint(eye_);
  Run("eye");
  globp[kTargetSlot] = ToPoint(target_);
  Run("target");
  globr[kConeSlot] = cone_;
  Run("set_viewing_conus");
}

void HRCamera::ApplyScaleAndWindow() const {
  globc[kScaleModeSlot] = scaleMode_;
  Run("set_scale_mode");
  if (wnp_fixed_scaling() != 0) {
    dBox_window_set_keep_scale(static_cast<float>(dBox_calc_scale()));
    dBox_window_keep_scale();
  } else if (wnp_auto_scaling() != 0) {
    wn3_auto_window(kAutoWindowFit);
  }
  wn3_set_view_rect(viewWindow_);
  wn3_dl_redraw(kRedrawAll);
  init_hdl_redraw_draw_params();
  Run("start_redraw_on");
}

void HRCamera::ApplyPatterns() const {
  if (displayMode_ != HRUtility::kGeometric) return;
  globc[0] = globc[kPatternSlot];
  globc[kPatternSlot] = patterns_ == 1 ? 'h' : ' ';
  execute_quorvel_overlay("refh");
  Run(globc[kPatternSlot] == 'h' ? "regen" : "redraw_all");
}

std::int16_t HRCamera::Execute(const void* /*context*/) {
  add_wait_cur();
  HRUtility::SetDisplayMode(HRUtility::kGeometric);
  if (showSections_ == 0) {
    HideSectionSymbols();
    SectionsShown = 0;
  } else {
    ShowSectionSymbols();
    SectionsShown = 1;
  }
  if (!ApplyLayers(true)) {
    remove_wait_cur();
    return -12;
  }
  ApplyProjection();
  Run("start_redraw_off");
  ApplyEyeTargetCone();
  ApplyScaleAndWindow();
  ApplyPatterns();
  HRUtility::SetDisplayMode(displayMode_);
  Run("redraw_all");
  remove_wait_cur();
  return 0;
}

void HRCamera::ApplyView(std::int16_t phase) {
  if (phase == 0) {
    add_wait_cur();
    HRUtility::SetDisplayMode(HRUtility::kGeometric);
    if (showSections_ != 0) {
      SectionsShown = 1;
    } else {
      HideSectionSymbols();
    }
    ApplyLayers(false);
    ApplyEyeTargetCone();
    ApplyProjection();
    Run("start_redraw_off");
    ApplyScaleAndWindow();
    ApplyPatterns();
  } else if (phase == 1) {
    HRUtility::SetDisplayMode(displayMode_ == HRUtility::kGeometric ? std::int16_t{HRUtility::kHiddenline} : displayMode_);
    remove_wait_cur();
  }
}
