// A fresh host with the library loaded and its camera manager on the current drawing, plus the
// readers the views tests compare against: the journal, the stored records and saved files.
#pragma once

#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <initializer_list>
#include <sstream>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "model/current_database.h"
#include "shell/host/argument_blocks.h"
#include "shell/plugin_exports.h"
#include "views/camera_settings.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "workbench/drawing_file.h"
#include "workbench/workbench.h"

class ViewsTest : public ::testing::Test {
 protected:
  using ChangeRecord = std::pair<host::EntityHandle, std::int32_t>;
  using StepList = std::vector<std::string>;

  void SetUp() override {
    Bench().Reset();
    Bench().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
    SetDatabase(Bench().Current());
  }

  void TearDown() override {
    EXPECT_EQ(Bench().Records().OpenCount(), 0U) << "an attribute record was left open";
    Bench().GetFaults().Clear();
    Bench().UnloadPlugin();
    EXPECT_EQ(Bench().Memory().Outstanding(), 0) << "host memory was not released";
    EXPECT_EQ(Bench().Memory().BadReleases(), 0);
    std::error_code ignored;
    if (!folder_.empty()) std::filesystem::remove_all(folder_, ignored);
  }

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  static wb::Entity* Find(host::EntityHandle entity) { return Drawing().Find(entity); }
  static std::uint8_t& Flags(host::EntityHandle entity) { return Find(entity)->header.bytes[host::kHeaderFlags]; }
  static const wb::Attribute* AttributeOf(host::EntityHandle entity, const std::string& name) {
    const wb::Entity* found = Find(entity);
    return found == nullptr ? nullptr : found->FindAttribute(name.c_str());
  }
  // Takes a key out of a stored record, as an older or damaged record would lack it.
  static void DropAttribute(host::EntityHandle entity, const std::string& name) {
    std::erase_if(Find(entity)->attributes, [&](const wb::Attribute& a) { return a.name == name; });
  }
  // Replaces a key with a fresh one of the given type, for the caller to fill in.
  static wb::Attribute& Put(host::EntityHandle entity, const std::string& name, wb::AttributeType type) {
    DropAttribute(entity, name);
    wb::Attribute& attribute = Find(entity)->attributes.emplace_back();
    attribute.name = name;
    attribute.type = type;
    return attribute;
  }
  static void PutString(host::EntityHandle entity, const std::string& name, const std::string& text) {
    Put(entity, name, wb::AttributeType::String).text = text;
  }

  static const wb::Journal& Log() { return Bench().GetJournal(); }
  static void ClearJournal() { Bench().GetJournal().Clear(); }
  static std::vector<ChangeRecord> ChangeRecords() { return Log().ChangeRecords(); }
  // Commands and overlays in the order the host ran them; overlays carry an "overlay " prefix.
  static StepList Steps() {
    StepList steps;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == wb::JournalEntry::Kind::Command) steps.push_back(entry.name);
      if (entry.kind == wb::JournalEntry::Kind::Overlay) steps.push_back("overlay " + entry.name);
    }
    return steps;
  }
  // The attribute writes one entity received, in order.
  static StepList WritesTo(host::EntityHandle entity) {
    StepList names;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == wb::JournalEntry::Kind::AttributeWrite && entry.entity == entity) names.push_back(entry.name);
    }
    return names;
  }
  static void FailNext(const std::string& call) { Bench().GetFaults().FailNext(call, 0); }
  // Fails every call of `call` on `attribute` (or command text), or on one entity.
  static void FailOn(const std::string& call, const std::string& attribute,
                     host::EntityHandle entity = wb::FaultRule::kAnyEntity) {
    Bench().GetFaults().Add({.call = call, .entity = entity, .attribute = attribute, .times = -1});
  }

  // Saves the current drawing to a file, opens that file as a new drawing and makes it the
  // library's current database.
  void ReopenThroughFile() {
    folder_ =
        std::filesystem::path(::testing::TempDir()) / ("pandex_views_" + std::to_string(::getpid()) + "_" +
                                                       ::testing::UnitTest::GetInstance()->current_test_info()->name());
    std::filesystem::create_directories(folder_);
    wb::SaveDrawingFile(Drawing(), folder_ / "drawing.pdx");
    const host::DatabaseHandle reopened = Bench().Open(wb::OpenDrawingFile(folder_ / "drawing.pdx"));
    Bench().SetCurrent(reopened);
    SetDatabase(reopened);
  }

  // A camera whose every value differs from the reset defaults, so that a value lost on the
  // way through a record shows.
  static CameraSettings DistinctSettings(float seed = 1.0F) {
    CameraSettings settings{.eye = {10.5F * seed, -20.25F, 1.75F},
                            .target = {3.0F, 4.0F * seed, -5.5F},
                            .cone = 37.5F,
                            .file2D = "plans\\ground floor.dxf",
                            .comment = "north elevation"};
    std::copy_n(std::array{-12.125, -7.5, 30.0 * seed, 19.875}.begin(), 4, settings.viewWindow);
    settings.displayMode = 4;
    settings.viewMode = HRCamera::k3DPerspective;
    for (std::size_t i = 0; i < settings.layers.size(); i += 3) settings.layers[i] = 1;
    settings.patterns = settings.preserveDimensions = settings.preserveText = settings.preserveWalls = 1;
    settings.preserveLayer = 1;
    settings.scaleMode = 'f';
    settings.preserveLayerIndex = 17;
    return settings;
  }

  // Every value of a camera, to compare whole.
  static auto Values(const CameraSettings& s) {
    return std::tuple(
        std::to_array(s.eye), std::to_array(s.target), s.cone, std::to_array(s.viewWindow), s.displayMode, s.viewMode,
        s.scaleMode, s.file2D, s.comment, s.preserveLayerIndex,
        std::array{+s.patterns, +s.showSections, +s.autoClip, +s.overwrite2D, +s.removeCoincident, +s.lineMerge,
                   +s.preserveDimensions, +s.preserveText, +s.preserveWalls, +s.preserveLayer},
        s.layers);
  }

  // Points rounded to a thousandth, so that a comparison does not depend on float arithmetic.
  static std::string Rounded(std::initializer_list<host::Point3f> points) {
    std::ostringstream out;
    for (const host::Point3f& p : points) {
      out << '(' << std::round(p.x * 1000) / 1000 + 0.0 << ' ' << std::round(p.y * 1000) / 1000 + 0.0 << ' '
          << std::round(p.z * 1000) / 1000 + 0.0 << ')';
    }
    return out.str();
  }

  static CameraSettings SettingsOf(const HRCamera& camera) {
    CameraSettings settings;
    camera.GetSettings(settings);
    return settings;
  }

  static HRCamera CameraWith(const CameraSettings& settings) {
    HRCamera camera;
    camera.SetSettings(settings);
    return camera;
  }

  // A stored camera of the given kind with distinct values; answers its handle.
  static host::EntityHandle StoreCamera(const std::string& name, const std::string& className = "HRCamera") {
    HRCamera camera = CameraWith(DistinctSettings());
    camera.SetName(name);
    camera.SetClassName(className);
    EXPECT_EQ(camera.Create(), 0);
    return camera.GetHandle();
  }

  // A stored section made as the pane makes one; answers its instance.
  static host::EntityHandle StoreSection(HRSection& section, const std::string& name = "A",
                                         std::array<float, 3> start = {0, 0, 0}, std::array<float, 3> end = {5, 0, 0}) {
    SectionSettings settings;
    std::copy(start.begin(), start.end(), settings.start);
    std::copy(end.begin(), end.end(), settings.end);
    settings.symbolFile = "...sec_sym\\sec01";
    section.SetName(name);
    section.SetSettings(settings);
    EXPECT_EQ(section.Create(), 0);
    return section.GetHandle();
  }
  static host::EntityHandle StoreSection(const std::string& name = "A") {
    HRSection section;
    return StoreSection(section, name);
  }

  // A stored plan cut at (1, 2, 0) looking from (1, 2, 5); answers its entity.
  static host::EntityHandle StorePlan(HRPlane& plan, const std::string& name = "P") {
    const float base[3] = {1, 2, 0};
    const float dir[3] = {1, 2, 5};
    plan.DefineFromPoints(name, base, dir);
    EXPECT_EQ(plan.Create(), 0);
    return plan.GetHandle();
  }

  static host::EntityHandle StoreView(HRSection& section) { return StoreSection(section); }
  static host::EntityHandle StoreView(HRPlane& plan) { return StorePlan(plan); }

 private:
  std::filesystem::path folder_;
};
