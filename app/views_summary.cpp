// Listing cameras, sections, plans and selection sets through the plug-in's own view classes.
#include "app/views_summary.h"

#include "model/current_database.h"
#include "resources/string_table.h"
#include "shell/host/argument_blocks.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "views/hr_selection.h"
#include "views/view_collection.h"

namespace app {
namespace {

CameraLine Describe(const HRCamera& camera) {
  return {camera.GetHandle(), camera.GetName(), camera.IsFor2D() == 1, camera.GetDisplayMode(), camera.GetViewMode()};
}

template <typename Owner>
OwnerLine DescribeOwner(Owner& owner, host::EntityHandle handle) {
  OwnerLine line{handle, owner.GetName(), owner.IsFor2D() == 1, {}};
  for (std::int32_t i = 0; i < owner.GetCameraCount(); ++i) {
    HRCamera camera;
    if (owner.LoadCamera(i, camera) == 0) line.cameras.push_back(Describe(camera));
  }
  return line;
}

const char* ViewModeName(std::int16_t mode) {
  switch (mode) {
    case HRCamera::k2DParallel: return "2D parallel";
    case HRCamera::k2DPerspective: return "2D perspective";
    case HRCamera::k3DParallel: return "3D parallel";
    case HRCamera::k3DPerspective: return "3D perspective";
    default: return "unknown view";
  }
}

std::string DisplayModeName(std::int16_t mode) {
  const std::string_view name = resources::LoadString(resources::kIdsFirstDisplayMode + mode);
  return mode >= 0 && !name.empty() ? std::string(name) : "mode " + std::to_string(mode);
}

void PrintCamera(const CameraLine& camera, const char* indent, std::ostream& out) {
  out << indent << (camera.for2D ? "[x] " : "[ ] ") << camera.name << " (" << ViewModeName(camera.viewMode) << ", "
      << DisplayModeName(camera.displayMode) << ", entity " << camera.handle << ")\n";
}

void PrintOwners(const char* title, const std::vector<OwnerLine>& owners, std::ostream& out) {
  out << title << ": " << owners.size() << '\n';
  for (const OwnerLine& owner : owners) {
    out << "  " << (owner.for2D ? "[x] " : "[ ] ") << owner.name << " (entity " << owner.handle << "), "
        << owner.cameras.size() << " cameras\n";
    for (const CameraLine& camera : owner.cameras) PrintCamera(camera, "    ", out);
  }
}

}  // namespace

ViewsSummary CollectViews() {
  ViewsSummary views;
  SetDatabase(db.handle);
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    if (LoadGeneralCamera(camera, i) == 0) views.cameras.push_back(Describe(camera));
  }
  const host::DatabaseHandle database = GetCurrentDatabase();
  for (const host::EntityHandle handle : CollectSectionHandles(database)) {
    HRSection section;
    if (section.Load(handle) == 0) views.sections.push_back(DescribeOwner(section, handle));
  }
  for (const host::EntityHandle handle : CollectPlanHandles(database)) {
    HRPlane plan;
    if (plan.Load(handle) == 0) views.plans.push_back(DescribeOwner(plan, handle));
  }
  for (const host::EntityHandle handle : CollectSelectionHandles()) {
    HRSelection selection;
    if (selection.Load(handle) == 0) {
      views.selections.push_back({handle, selection.GetName(), selection.GetCameraCount(),
                                  selection.GetSectionCount(), selection.GetPlanCount()});
    }
  }
  return views;
}

void PrintViews(const ViewsSummary& views, std::ostream& out) {
  out << "Cameras: " << views.cameras.size() << '\n';
  for (const CameraLine& camera : views.cameras) PrintCamera(camera, "  ", out);
  PrintOwners("Sections", views.sections, out);
  PrintOwners("Plans", views.plans, out);
  out << "Selection sets: " << views.selections.size() << '\n';
  for (const SelectionLine& selection : views.selections) {
    out << "  " << selection.name << " (entity " << selection.handle << "): " << selection.cameras << " cameras, "
        << selection.sections << " sections, " << selection.plans << " plans\n";
  }
}

}  // namespace app
