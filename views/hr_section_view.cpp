// A section's cut view and its own cameras ("hrSecCam" entities listed under "@CamLst=").
#include "display/display_mode.h"
#include "model/current_database.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "views/hr_section.h"
#include "views/section_symbols.h"

namespace {

constexpr const char* kSectionCameraClass = "hrSecCam";
constexpr std::int16_t kRenderStillOn = -28;
constexpr int kCutTypeSlot = 109;
constexpr int kCutStyleSlot = 243;
constexpr int kCutFlagsPoint = 25;

void Run(const char* command) { execute_internal_command(command); }

host::Point3f ToPoint(const HRMath::Vector& vector) {
  float values[3];
  vector.CopyTo(values);
  return {values[0], values[1], values[2]};
}

// Puts the host into the cut display: solid background, cut by the section's type.
void PrepareCutDisplay(char cutType) {
  globc[kCutTypeSlot] = cutType;
  globc[kCutStyleSlot] = 's';
  globp[kCutFlagsPoint].y = 7.0F;
  if (globc[26] != 's') {
    globc[26] = 's';
    Run("set_background_color");
    globr[0] = 0.0F;
    Run("wire_frame_all");
  }
  globc[0] = 'b';
  Run("set_dspmode_info");
  globc[27] = 'f';
  Run("new_solid");
  Run("redraw_all");
  if (globc[0] != 'w') {
    globc[0] = 'w';
    Run("set_dspmode_info");
  }
}

}  // namespace

host::EntityHandle HRSection::CameraHandle(std::int32_t index) const {
  if (index < 0 || static_cast<std::size_t>(index) >= cameras_.size()) return 0;
  return cameras_[static_cast<std::size_t>(index)];
}

std::int16_t HRSection::ShowView(std::int32_t cameraIndex) {
  HRCamera camera;
  const bool withCamera = cameraIndex != -1;
  if (withCamera) {
    // Applying a camera that did not load would switch every layer off and put the eye on the
    // target; the view is left as it is instead.
    if (const std::int16_t loaded = camera.Load(CameraHandle(cameraIndex)); loaded != 0) return loaded;
    camera.ApplyView(0);
  } else {
    HRUtility::SetDisplayMode(HRUtility::kGeometric);
  }
  HideSectionSymbols();

  HRMath::Vector start;
  HRMath::Vector end;
  CutLine(start, end);
  const host::Point3f s = ToPoint(start);
  const host::Point3f e = ToPoint(end);
  globp[0] = s;
  globp[1] = e;
  globp[2] = {s.x, s.y, s.z + 1.0F};
  globp[3] = {s.x - (e.y - s.y), s.y + (e.x - s.x), s.z};

  Run("inq_render_mode");
  if (globr[0] == 1.0F) {
    // The camera's first phase turned the wait cursor on; do not leave it on when refusing.
    if (withCamera) remove_wait_cur();
    return kRenderStillOn;
  }
  PrepareCutDisplay(cutType_);
  if (withCamera) {
    camera.ApplyView(1);
  } else {
    Run("set_vsect_plane");
    HRUtility::SetDisplayMode(HRUtility::kHiddenline);
  }
  return 0;
}

std::int32_t HRSection::AddCamera(const std::string& name) {
  HRCamera camera;
  const std::int16_t captured = camera.CaptureView();
  camera.SetName(name);
  camera.SetClassName(kSectionCameraClass);
  if (captured != 0 || camera.Create() != 0) return 0;
  const auto index = static_cast<std::int32_t>(cameras_.size());
  cameras_.push_back(camera.GetHandle());
  WriteCameraList();
  return index;
}

std::int16_t HRSection::RemoveCamera(std::int32_t index) {
  if (index < 0 || static_cast<std::size_t>(index) >= cameras_.size()) return -2;
  HRCamera camera;
  const std::int16_t loaded = camera.Load(cameras_[static_cast<std::size_t>(index)]);
  cameras_.erase(cameras_.begin() + index);
  WriteCameraList();
  return loaded == 0 ? camera.Delete() : loaded;
}

std::int16_t HRSection::GetCameraCount() const { return static_cast<std::int16_t>(cameras_.size()); }

void HRSection::SetCameraFor2D(std::int32_t index, std::int16_t for2D) {
  HRCamera camera;
  if (camera.Load(CameraHandle(index)) != 0) return;
  camera.SetFor2D(for2D);
  camera.Save();
}

std::uint16_t HRSection::IsCameraFor2D(std::int32_t index) {
  HRCamera camera;
  return camera.Load(CameraHandle(index)) == 0 ? camera.IsFor2D() : 0;
}

void HRSection::CopyCameraName(std::int32_t index, std::string& name) { name = GetCameraName(index); }

std::string HRSection::GetCameraName(std::int32_t index) {
  HRCamera camera;
  return camera.Load(CameraHandle(index)) == 0 ? camera.GetName() : std::string();
}

void HRSection::RenameCamera(const std::string& name, std::int32_t index) {
  HRCamera camera;
  if (camera.Load(CameraHandle(index)) != 0) return;
  camera.SetName(name);
  camera.Save();
}

std::int16_t HRSection::LoadCamera(std::int32_t index, HRCamera& camera) { return camera.Load(CameraHandle(index)); }

std::int16_t HRSection::SaveCamera(std::int32_t index, HRCamera& camera) {
  camera.SetHandle(CameraHandle(index));
  return camera.SaveTo(GetCurrentDatabase());
}
