// The sample house in numbers: a 10 m x 8 m plan, two storeys of 3 m, a gable roof along x.
#include "samples/sample_house.h"

#include <array>
#include <cmath>
#include <cstdio>
#include <string>
#include <vector>

#include "samples/solid_shapes.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "views/hr_selection.h"
#include "workbench/workbench.h"

namespace samples {
namespace {

constexpr float kLength = 10.0F;      // along x
constexpr float kDepth = 8.0F;        // along y
constexpr float kWall = 0.3F;         // wall thickness
constexpr float kStorey = 3.0F;       // floor to floor
constexpr float kSlab = 0.25F;
constexpr float kRidge = 2.5F;        // roof rise above the top slab

// Category codes the host's database loop reports for the preserve options.
struct Category {
  std::uint8_t kind;
  std::uint8_t code;
};
constexpr Category kWallCategory{1, 3};
constexpr Category kDimensionCategory{1, 6};
constexpr Category kTextCategory{1, 7};
constexpr Category kNoCategory{0, 0};

wb::Drawing& Current() { return wb::Workbench::Get().CurrentDrawing(); }

wb::Entity& AddEntity(std::uint8_t type, std::uint8_t layer, std::uint8_t color, Category category) {
  wb::Entity& entity = Current().Add(type);
  entity.header.bytes[host::kHeaderLayer] = layer;
  entity.header.bytes[host::kHeaderColor] = color;
  entity.header.bytes[host::kHeaderCategoryKind] = category.kind;
  entity.header.bytes[host::kHeaderCategoryCode] = category.code;
  return entity;
}

void AddSolid(const wb::draft::SolidMesh& mesh, std::uint8_t layer, std::uint8_t color, Category category) {
  wb::draft::WriteSolidMesh(AddEntity(host::kTypeSolid, layer, color, category), mesh);
}

void AddWall(float x, float y, float z, float sizeX, float sizeY, float sizeZ) {
  AddSolid(Block(x, y, z, sizeX, sizeY, sizeZ), kWalls, 1, kWallCategory);
}

// A wall along x from x0 to x1 at y with openings (x from, x to, sill height, head height).
struct Opening {
  float from, to, sill, head;
};
void AddWallAlongX(float x0, float x1, float y, float z, const std::vector<Opening>& openings) {
  float x = x0;
  for (const Opening& opening : openings) {
    AddWall(x, y, z, opening.from - x, kWall, kStorey);
    if (opening.sill > 0.0F) AddWall(opening.from, y, z, opening.to - opening.from, kWall, opening.sill);
    AddWall(opening.from, y, z + opening.head, opening.to - opening.from, kWall, kStorey - opening.head);
    x = opening.to;
  }
  AddWall(x, y, z, x1 - x, kWall, kStorey);
}

void AddWallAlongY(float x, float y0, float y1, float z, const std::vector<Opening>& openings) {
  float y = y0;
  for (const Opening& opening : openings) {
    AddWall(x, y, z, kWall, opening.from - y, kStorey);
    if (opening.sill > 0.0F) AddWall(x, opening.from, z, kWall, opening.to - opening.from, opening.sill);
    AddWall(x, opening.from, z + opening.head, kWall, opening.to - opening.from, kStorey - opening.head);
    y = opening.to;
  }
  AddWall(x, y, z, kWall, y1 - y, kStorey);
}

void AddStorey(float z, bool ground) {
  const Opening door{4.4F, 5.4F, 0.0F, 2.1F};
  const Opening windowLeft{1.5F, 3.0F, 0.9F, 2.1F};
  const Opening windowRight{6.8F, 8.3F, 0.9F, 2.1F};
  AddWallAlongX(0.0F, kLength, 0.0F, z, ground ? std::vector<Opening>{windowLeft, door, windowRight}
                                               : std::vector<Opening>{windowLeft, windowRight});
  AddWallAlongX(0.0F, kLength, kDepth - kWall, z, {{3.5F, 6.5F, 0.9F, 2.1F}});
  AddWallAlongY(0.0F, kWall, kDepth - kWall, z, {{3.0F, 4.5F, 0.9F, 2.1F}});
  AddWallAlongY(kLength - kWall, kWall, kDepth - kWall, z, {});
  // The inner wall between living room and kitchen, with a passage.
  AddWallAlongY(6.0F, kWall, kDepth - kWall, z, {{3.5F, 4.5F, 0.0F, 2.1F}});
}

void AddSlabsAndRoof() {
  AddSolid(Block(-0.2F, -0.2F, -kSlab, kLength + 0.4F, kDepth + 0.4F, kSlab), kSlabs, 8, kNoCategory);
  // The upper slab leaves the stair opening free.
  AddSolid(Block(0.0F, 0.0F, kStorey - kSlab, 6.0F, kDepth, kSlab), kSlabs, 8, kNoCategory);
  AddSolid(Block(6.0F, 0.0F, kStorey - kSlab, kLength - 6.0F, kDepth - 3.0F, kSlab), kSlabs, 8, kNoCategory);
  const float eaves = 2.0F * kStorey;
  // Gable roof: a triangular prism along x with 0.3 m overhangs.
  AddSolid(SweptPrism({{-0.3F, -0.3F, eaves}, {-0.3F, kDepth + 0.3F, eaves}, {-0.3F, kDepth / 2.0F, eaves + kRidge}},
                      {kLength + 0.6F, 0.0F, 0.0F}),
           kRoof, 5, kNoCategory);
}

void AddStairs() {
  constexpr int kSteps = 15;
  const float rise = kStorey / kSteps;
  const float going = 3.3F / kSteps;
  for (int i = 0; i < kSteps; ++i) {
    const auto step = static_cast<float>(i);
    AddSolid(Block(6.3F + step * going, kDepth - 2.8F, 0.0F, going, 1.0F, rise * (step + 1.0F)), kStairs, 3,
             kNoCategory);
  }
}

void AddText(const std::string& text, float x, float y, float z) {
  wb::Entity& entity = AddEntity(host::kTypeLine, kTexts, 2, kTextCategory);
  host::LineRecord line{};
  line.lineType = 254;  // texts keep -2 in the line type byte
  line.start = {x, y, z};
  line.end = {x, y, z};
  wb::WriteRecord(entity, line);
  wb::Attribute textValue;
  textValue.name = "t=";
  textValue.text = text;
  entity.attributes.push_back(textValue);
  wb::Attribute block;
  block.name = "tb=";
  block.type = wb::AttributeType::FloatVector;
  block.format = 4;
  block.floats = {0.35F, 0.0F, 0.0F, 0.0F, 0.0F, 12.0F, 0.0F, 1.0F, 1.0F, 2.0F, 0.0F};
  entity.attributes.push_back(block);
}

void AddDimension(host::Point3f from, host::Point3f to) {
  wb::Entity& entity = AddEntity(host::kTypeDimension, kDimensions, 4, kDimensionCategory);
  host::LineRecord line{};
  line.lineType = 1;
  line.color = 4;
  line.width = 1;
  line.start = from;
  line.end = to;
  wb::WriteRecord(entity, line);
  char text[32];
  const float length = std::hypot(to.x - from.x, to.y - from.y, to.z - from.z);
  std::snprintf(text, sizeof text, "%.2f", static_cast<double>(length));
  wb::Attribute value;
  value.name = "t=";
  value.text = text;
  entity.attributes.push_back(value);
}

CameraSettings View(host::Point3f eye, host::Point3f target, std::int16_t viewMode, std::int16_t displayMode,
                    std::array<double, 4> window) {
  CameraSettings settings;
  settings.eye[0] = eye.x;
  settings.eye[1] = eye.y;
  settings.eye[2] = eye.z;
  settings.target[0] = target.x;
  settings.target[1] = target.y;
  settings.target[2] = target.z;
  settings.cone = 45.0F;
  for (std::size_t i = 0; i < 4; ++i) settings.viewWindow[i] = window[i];
  settings.displayMode = displayMode;
  settings.viewMode = viewMode;
  settings.layers.fill(1);
  settings.showSections = 1;
  settings.autoClip = 1;
  settings.overwrite2D = 1;
  settings.removeCoincident = 1;
  settings.lineMerge = 1;
  settings.scaleMode = 'a';
  return settings;
}

void AddGeneralCamera(const std::string& name, const CameraSettings& settings) {
  HRCamera camera;
  camera.SetSettings(settings);
  camera.SetName(name);
  camera.SetFor2D(1);
  AddGeneralCamera(camera);
}

// Gives an owner's first camera a view and ticks it for 2D.
template <typename Owner>
void SetFirstCamera(Owner& owner, const CameraSettings& settings) {
  HRCamera camera;
  if (owner.LoadCamera(0, camera) != 0) return;
  const std::string name = camera.GetName();
  camera.SetSettings(settings);
  camera.SetName(name);
  camera.SetFor2D(1);
  owner.SaveCamera(0, camera);
}

host::EntityHandle AddSection(const std::string& name, host::Point3f start, host::Point3f end,
                              const CameraSettings& view) {
  HRSection section;
  section.SetName(name);
  SectionSettings settings;
  settings.start[0] = start.x;
  settings.start[1] = start.y;
  settings.start[2] = start.z;
  settings.end[0] = end.x;
  settings.end[1] = end.y;
  settings.end[2] = end.z;
  settings.symbolFile = "...sec_sym\\sec01";
  section.SetSettings(settings);
  section.Create();
  section.ShowView(-1);
  section.AddCamera("Default");
  SetFirstCamera(section, view);
  return section.GetHandle();
}

host::EntityHandle AddPlan(const std::string& name, host::Point3f base, host::Point3f dir, const CameraSettings& view) {
  HRPlane plan;
  const float basePoint[3] = {base.x, base.y, base.z};
  const float dirPoint[3] = {dir.x, dir.y, dir.z};
  plan.DefineFromPoints(name, basePoint, dirPoint);
  plan.Create();
  plan.ShowView(-1);
  plan.AddCamera("Default");
  SetFirstCamera(plan, view);
  return plan.GetHandle();
}

}  // namespace

void BuildSampleHouse() {
  wb::Drawing& drawing = Current();
  constexpr std::array<const char*, 6> kLayerNames = {"Walls", "Slabs", "Roof", "Stairs", "Dimensions", "Texts"};
  for (std::size_t i = 0; i < kLayerNames.size(); ++i) drawing.layers[i].name = kLayerNames[i];

  AddStorey(0.0F, true);
  AddStorey(kStorey, false);
  AddSlabsAndRoof();
  AddStairs();
  AddText("Living", 2.5F, 4.0F, 0.0F);
  AddText("Kitchen", 7.5F, 2.0F, 0.0F);
  AddText("Bedroom", 2.5F, 4.0F, kStorey);
  AddDimension({0.0F, -1.0F, 0.0F}, {kLength, -1.0F, 0.0F});
  AddDimension({-1.0F, 0.0F, 0.0F}, {-1.0F, kDepth, 0.0F});

  const host::Point3f middle{kLength / 2.0F, kDepth / 2.0F, kStorey};
  AddGeneralCamera("Street perspective",
                   View({-8.0F, -18.0F, 7.0F}, middle, HRCamera::k3DPerspective, 2, {-12.0, -9.0, 12.0, 9.0}));
  AddGeneralCamera("Axonometric",
                   View({25.0F, -21.0F, 23.0F}, middle, HRCamera::k3DParallel, 4, {-12.0, -9.0, 12.0, 9.0}));
  AddGeneralCamera("Site plan", View({kLength / 2.0F, kDepth / 2.0F, 50.0F}, {kLength / 2.0F, kDepth / 2.0F, 0.0F},
                                     HRCamera::k2DParallel, 0, {-8.0, -6.0, 8.0, 6.0}));

  const host::Point3f acrossMiddle{kLength / 2.0F, kDepth / 2.0F, 4.0F};
  const host::EntityHandle sectionA =
      AddSection("A", {-2.0F, 4.0F, 0.0F}, {kLength + 2.0F, 4.0F, 0.0F},
                 View({kLength / 2.0F, -30.0F, 4.0F}, acrossMiddle, HRCamera::k3DParallel, 2, {-8.0, -6.0, 8.0, 6.0}));
  const host::EntityHandle sectionB =
      AddSection("B", {5.0F, kDepth + 2.0F, 0.0F}, {5.0F, -2.0F, 0.0F},
                 View({-30.0F, kDepth / 2.0F, 4.0F}, acrossMiddle, HRCamera::k3DParallel, 2, {-8.0, -6.0, 8.0, 6.0}));
  const host::EntityHandle plan =
      AddPlan("Ground floor", {kLength / 2.0F, kDepth / 2.0F, 1.2F}, {kLength / 2.0F, kDepth / 2.0F, 10.0F},
              View({kLength / 2.0F, kDepth / 2.0F, 40.0F}, {kLength / 2.0F, kDepth / 2.0F, 0.0F},
                   HRCamera::k3DParallel, 2, {-8.0, -6.0, 8.0, 6.0}));

  HRSelection selection;
  selection.SetName("All views");
  for (std::int32_t i = 0; i < 3; ++i) selection.AddCamera(i);
  selection.AddSection(sectionA, {0});
  selection.AddSection(sectionB, {0});
  selection.AddPlan(plan, {0});
  selection.Create();
}

}  // namespace samples
