// A section's cut view and its own cameras ("hrSecCam" entities listed under "@CamLst=").
#include "display/display_mode.h"
#include "model/host_point.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "views/cut_display.h"
#include "views/hr_section.h"
#include "views/section_symbols.h"

namespace {

void Run(const char* command) { execute_internal_command(command); }

}  // namespace

std::int16_t HRSection::ShowView(std::int32_t cameraIndex) {
  HRCamera camera;
  const bool withCamera = cameraIndex != -1;
  if (withCamera) {
    // Applying a camera that did not load would switch every layer off and put the eye on the
    // target; the view is left as it is instead.
    if (const std::int16_t loaded = cameras_.Load(cameraIndex, camera); loaded != 0) return loaded;
    camera.ApplyView(0);
  } else {
    HRUtility::SetDisplayMode(HRUtility::kGeometric);
  }
  HideSectionSymbols();

  HRMath::Vector start;
  HRMath::Vector end;
  CutLine(start, end);
  const host::Point3f s = ToHostPoint(start);
  const host::Point3f e = ToHostPoint(end);
  globp[0] = s;
  globp[1] = e;
  globp[2] = {s.x, s.y, s.z + 1.0F};
  globp[3] = {s.x - (e.y - s.y), s.y + (e.x - s.x), s.z};

  if (cut_display::RenderingActive()) {
    // The camera's first phase turned the wait cursor on; do not leave it on when refusing.
    if (withCamera) remove_wait_cur();
    return cut_display::kRenderStillOn;
  }
  cut_display::Begin(cutType_);
  cut_display::Finish('w');
  if (withCamera) {
    camera.ApplyView(1);
  } else {
    Run("set_vsect_plane");
    HRUtility::SetDisplayMode(HRUtility::kHiddenline);
  }
  return 0;
}

std::int32_t HRSection::AddCamera(const std::string& name) { return cameras_.Add(instance_, name); }
std::int16_t HRSection::RemoveCamera(std::int32_t index) { return cameras_.Remove(instance_, index); }
std::int16_t HRSection::GetCameraCount() const { return cameras_.Count(); }
void HRSection::SetCameraFor2D(std::int32_t index, std::int16_t for2D) { cameras_.SetFor2D(index, for2D); }
std::uint16_t HRSection::IsCameraFor2D(std::int32_t index) { return cameras_.IsFor2D(index); }
void HRSection::CopyCameraName(std::int32_t index, std::string& name) { name = cameras_.NameAt(index); }
std::string HRSection::GetCameraName(std::int32_t index) { return cameras_.NameAt(index); }
void HRSection::RenameCamera(const std::string& name, std::int32_t index) { cameras_.Rename(index, name); }
std::int16_t HRSection::LoadCamera(std::int32_t index, HRCamera& camera) { return cameras_.Load(index, camera); }
std::int16_t HRSection::SaveCamera(std::int32_t index, HRCamera& camera) { return cameras_.Save(index, camera); }
