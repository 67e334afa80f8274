// The 2D tests' host: a scratch folder for the drawing and every file the generation writes.
#include "tests/output2d/output2d_fixture.h"

#include <algorithm>

#include "display/save2d.h"
#include "model/current_database.h"
#include "shell/host/qeldll_2d.h"
#include "shell/plugin_exports.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "workbench/draft/dxf_reader.h"

namespace output2d_test {

void Output2DTest::SetUp() {
  Bench().Reset();
  // The host's own work files go with the test's, not into a folder that outlives it.
  HostState().specialFolder = scratch_ / "host";
  Bench().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  SetDatabase(Bench().Current());
  Bench().SetDrawingPath(Bench().Current(), DrawingPath().string());
}

void Output2DTest::TearDown() {
  EXPECT_EQ(Bench().Records().OpenCount(), 0U) << "an attribute record was left open";
  Bench().GetFaults().Clear();
  Bench().UnloadPlugin();
  EXPECT_EQ(Bench().Memory().Outstanding(), 0) << "host memory was not released";
  EXPECT_EQ(Bench().Memory().BadReleases(), 0);
  Bench().Reset();
}

std::vector<std::string> Output2DTest::Steps() {
  using Kind = wb::JournalEntry::Kind;
  std::vector<std::string> steps;
  for (const wb::JournalEntry& entry : Bench().GetJournal().Entries()) {
    switch (entry.kind) {
      case Kind::Command: steps.push_back(entry.name); break;
      case Kind::Overlay: steps.push_back("overlay " + entry.name); break;
      case Kind::ChangeRecord:
        steps.push_back("write_to_record " + std::to_string(entry.entity) + " " + std::to_string(entry.code));
        break;
      case Kind::HostCall:
        if (entry.name == "qel_put_long_name" || entry.name == "select_app_entity") {
          steps.push_back(entry.name + " " + std::to_string(entry.entity));
        } else if (entry.name == "SetSymbolString") {
          steps.push_back(entry.name);
        }
        break;
      default: break;
    }
  }
  return steps;
}

long Output2DTest::Count(const std::vector<std::string>& steps, const std::string& step) {
  return std::count(steps.begin(), steps.end(), step);
}

bool Output2DTest::Save(const std::filesystem::path& target, const SaveOptions& options) {
  std::int32_t word = -1;
  qel_put_long_name(target.c_str(), 10, &word);
  return HRUtility::Save2D(target.string(), options.autoClip, options.overwrite, options.removeCoincident,
                           options.lineMerge, options.dimensions, options.texts, options.walls, options.layer,
                           options.layerIndex);
}

wb::draft::Sheet Output2DTest::ReadOutput(const std::filesystem::path& target) {
  return wb::draft::ReadDxfSheet(target.string() + ".dxf");
}

CameraSettings Output2DTest::SettingsFor(const View& view) {
  CameraSettings settings;
  settings.eye[0] = view.eye.x;
  settings.eye[1] = view.eye.y;
  settings.eye[2] = view.eye.z;
  settings.target[0] = view.target.x;
  settings.target[1] = view.target.y;
  settings.target[2] = view.target.z;
  settings.cone = 45.0F;
  std::copy(view.window.begin(), view.window.end(), settings.viewWindow);
  settings.displayMode = view.displayMode;
  settings.viewMode = view.perspective ? HRCamera::k3DPerspective : HRCamera::k3DParallel;
  settings.layers.fill(1);
  settings.scaleMode = 'a';
  return settings;
}

void Output2DTest::Show(const View& view) {
  HRCamera camera;
  camera.SetSettings(SettingsFor(view));
  ASSERT_EQ(camera.Execute(nullptr), 0);
}

std::int32_t Output2DTest::AddCamera(const std::string& name, const View& view, bool ticked,
                                     const std::string& file2D) {
  CameraSettings settings = SettingsFor(view);
  settings.file2D = file2D;
  HRCamera camera;
  camera.SetSettings(settings);
  camera.SetName(name);
  camera.SetFor2D(ticked ? 1 : 0);
  const std::int32_t index = AddGeneralCamera(camera);
  EXPECT_GE(index, 0) << name;
  return index;
}

wb::Entity& Output2DTest::AddCube(host::Point3f corner, float size, std::uint8_t layer) {
  return draft_test::AddBox(Drawing(), corner, {size, size, size}, layer);
}

void Output2DTest::SetCategory(wb::Entity& entity, Category category) {
  entity.header.bytes[host::kHeaderCategoryKind] = category.kind;
  entity.header.bytes[host::kHeaderCategoryCode] = category.code;
}

wb::Entity& Output2DTest::AddText(const std::string& text, host::Point3f at, std::uint8_t layer) {
  wb::Entity& entity = draft_test::AddLine(Drawing(), at, at, layer, 2);
  SetCategory(entity, kTextCategory);
  wb::Attribute value;
  value.name = "t=";
  value.text = text;
  entity.attributes.push_back(value);
  wb::Attribute block;
  block.name = "tb=";
  block.type = wb::AttributeType::FloatVector;
  block.floats = {0.5F};
  entity.attributes.push_back(block);
  return entity;
}

wb::Entity& Output2DTest::AddDimension(host::Point3f from, host::Point3f to, const std::string& value,
                                       std::uint8_t layer) {
  wb::Entity& entity = Drawing().Add(host::kTypeDimension);
  entity.header.bytes[host::kHeaderLayer] = layer;
  entity.header.bytes[host::kHeaderColor] = 4;
  SetCategory(entity, kDimensionCategory);
  host::LineRecord line{};
  line.start = from;
  line.end = to;
  wb::WriteRecord(entity, line);
  wb::Attribute text;
  text.name = "t=";
  text.text = value;
  entity.attributes.push_back(text);
  return entity;
}

}  // namespace output2d_test
