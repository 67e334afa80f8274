// A fresh host with the library loaded and its camera manager on the current drawing, plus the
// readers the views tests compare against: the journal, the stored records and saved files.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "model/current_database.h"
#include "shell/host/argument_blocks.h"
#include "shell/plugin_exports.h"
#include "views/camera_settings.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_section.h"
#include "workbench/drawing_file.h"
#include "workbench/workbench.h"

class ViewsTest : public ::testing::Test {
 protected:
  using ChangeRecord = std::pair<host::EntityHandle, std::int32_t>;
  using Kind = wb::JournalEntry::Kind;

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
    if (!savedFile_.empty()) std::filesystem::remove_all(savedFile_.parent_path(), ignored);
  }

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  static wb::Entity* Find(host::EntityHandle entity) { return Drawing().Find(entity); }
  static const wb::Attribute* AttributeOf(host::EntityHandle entity, const std::string& name) {
    const wb::Entity* found = Find(entity);
    return found == nullptr ? nullptr : found->FindAttribute(name.c_str());
  }
  // Takes a key out of a stored record, as an older or damaged record would lack it.
  static void DropAttribute(host::EntityHandle entity, const std::string& name) {
    std::erase_if(Find(entity)->attributes, [&](const wb::Attribute& a) { return a.name == name; });
  }
  static void PutLongs(host::EntityHandle entity, const std::string& name, std::vector<std::int32_t> values) {
    DropAttribute(entity, name);
    wb::Attribute& attribute = Find(entity)->attributes.emplace_back();
    attribute.name = name;
    attribute.type = wb::AttributeType::LongVector;
    attribute.longs = std::move(values);
  }
  static void PutString(host::EntityHandle entity, const std::string& name, const std::string& text) {
    DropAttribute(entity, name);
    wb::Attribute& attribute = Find(entity)->attributes.emplace_back();
    attribute.name = name;
    attribute.type = wb::AttributeType::String;
    attribute.text = text;
  }
  static void PutShort(host::EntityHandle entity, const std::string& name, std::int16_t value) {
    DropAttribute(entity, name);
    wb::Attribute& attribute = Find(entity)->attributes.emplace_back();
    attribute.name = name;
    attribute.type = wb::AttributeType::Short;
    attribute.shortValue = value;
  }

  static const wb::Journal& Log() { return Bench().GetJournal(); }
  static void ClearJournal() { Bench().GetJournal().Clear(); }
  static std::vector<ChangeRecord> ChangeRecords() { return Log().ChangeRecords(); }
  // Commands and overlays in the order the host ran them; overlays carry an "overlay " prefix.
  static std::vector<std::string> Steps() {
    std::vector<std::string> steps;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == Kind::Command) steps.push_back(entry.name);
      if (entry.kind == Kind::Overlay) steps.push_back("overlay " + entry.name);
    }
    return steps;
  }
  // The attribute writes one entity received, in order.
  static std::vector<std::string> WritesTo(host::EntityHandle entity) {
    std::vector<std::string> names;
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == Kind::AttributeWrite && entry.entity == entity) names.push_back(entry.name);
    }
    return names;
  }
  static bool Journaled(Kind kind, const std::string& name) {
    for (const wb::JournalEntry& entry : Log().Entries()) {
      if (entry.kind == kind && entry.name == name) return true;
    }
    return false;
  }

  static void FailNext(const std::string& call, std::int32_t result = 0) { Bench().GetFaults().FailNext(call, result); }
  // Fails every call of `call` on `attribute` (or command text), after letting `skip` pass.
  static void FailOn(const std::string& call, const std::string& attribute, int times = -1, int skip = 0) {
    wb::FaultRule rule;
    rule.call = call;
    rule.attribute = attribute;
    rule.times = times;
    rule.skip = skip;
    Bench().GetFaults().Add(rule);
  }
  static void FailForEntity(const std::string& call, host::EntityHandle entity) {
    wb::FaultRule rule;
    rule.call = call;
    rule.entity = entity;
    rule.times = -1;
    Bench().GetFaults().Add(rule);
  }

  // Saves the current drawing to a file, opens that file as a new drawing and makes it the
  // library's current database; answers the new database handle.
  host::DatabaseHandle ReopenThroughFile() {
    if (savedFile_.empty()) {
      const std::filesystem::path folder =
          std::filesystem::temp_directory_path() /
          ("pandex_views_" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + "_" +
           ::testing::UnitTest::GetInstance()->current_test_info()->name());
      std::filesystem::create_directories(folder);
      savedFile_ = folder / "drawing.pdx";
    }
    wb::SaveDrawingFile(Drawing(), savedFile_);
    const host::DatabaseHandle reopened = Bench().Open(wb::OpenDrawingFile(savedFile_));
    Bench().SetCurrent(reopened);
    SetDatabase(reopened);
    return reopened;
  }

  // A camera whose every value differs from the reset defaults, so that a value lost on the
  // way through a record shows.
  static CameraSettings DistinctSettings(float seed = 1.0F) {
    CameraSettings settings;
    settings.eye[0] = 10.5F * seed;
    settings.eye[1] = -20.25F;
    settings.eye[2] = 1.75F;
    settings.target[0] = 3.0F;
    settings.target[1] = 4.0F * seed;
    settings.target[2] = -5.5F;
    settings.cone = 37.5F;
    settings.viewWindow[0] = -12.125;
    settings.viewWindow[1] = -7.5;
    settings.viewWindow[2] = 30.0 * seed;
    settings.viewWindow[3] = 19.875;
    settings.displayMode = 4;
    settings.viewMode = HRCamera::k3DPerspective;
    for (std::size_t i = 0; i < settings.layers.size(); ++i) settings.layers[i] = (i % 3 == 0) ? 1 : 0;
    settings.file2D = "plans\\ground floor.dxf";
    settings.comment = "north elevation";
    settings.patterns = 1;
    settings.showSections = 0;
    settings.autoClip = 0;
    settings.overwrite2D = 0;
    settings.removeCoincident = 0;
    settings.lineMerge = 0;
    settings.scaleMode = 'f';
    settings.preserveDimensions = 1;
    settings.preserveText = 1;
    settings.preserveWalls = 1;
    settings.preserveLayer = 1;
    settings.preserveLayerIndex = 17;
    return settings;
  }

  static void ExpectSameSettings(const CameraSettings& actual, const CameraSettings& expected) {
    for (int i = 0; i < 3; ++i) {
      EXPECT_EQ(actual.eye[i], expected.eye[i]) << "eye " << i;
      EXPECT_EQ(actual.target[i], expected.target[i]) << "target " << i;
    }
    EXPECT_EQ(actual.cone, expected.cone);
    for (int i = 0; i < 4; ++i) EXPECT_DOUBLE_EQ(actual.viewWindow[i], expected.viewWindow[i]) << "window " << i;
    EXPECT_EQ(actual.displayMode, expected.displayMode);
    EXPECT_EQ(actual.viewMode, expected.viewMode);
    EXPECT_EQ(actual.layers, expected.layers);
    EXPECT_EQ(actual.file2D, expected.file2D);
    EXPECT_EQ(actual.comment, expected.comment);
    EXPECT_EQ(actual.patterns, expected.patterns);
    EXPECT_EQ(actual.showSections, expected.showSections);
    EXPECT_EQ(actual.autoClip, expected.autoClip);
    EXPECT_EQ(actual.overwrite2D, expected.overwrite2D);
    EXPECT_EQ(actual.removeCoincident, expected.removeCoincident);
    EXPECT_EQ(actual.lineMerge, expected.lineMerge);
    EXPECT_EQ(actual.scaleMode, expected.scaleMode);
    EXPECT_EQ(actual.preserveDimensions, expected.preserveDimensions);
    EXPECT_EQ(actual.preserveText, expected.preserveText);
    EXPECT_EQ(actual.preserveWalls, expected.preserveWalls);
    EXPECT_EQ(actual.preserveLayer, expected.preserveLayer);
    EXPECT_EQ(actual.preserveLayerIndex, expected.preserveLayerIndex);
  }

  static CameraSettings SettingsOf(const HRCamera& camera) {
    CameraSettings settings;
    camera.GetSettings(settings);
    return settings;
  }

  // A stored camera of the given kind with distinct values; answers its handle.
  static host::EntityHandle StoreCamera(const std::string& name, const std::string& className = "HRCamera",
                                        float seed = 1.0F) {
    HRCamera camera;
    camera.SetSettings(DistinctSettings(seed));
    camera.SetName(name);
    camera.SetClassName(className);
    EXPECT_EQ(camera.Create(), 0);
    return camera.GetHandle();
  }

  // A stored section five units long along x, made as the pane makes one; answers its handle.
  static host::EntityHandle StoreSection(const std::string& name = "A", HRSection* keep = nullptr) {
    HRSection local;
    HRSection& section = keep != nullptr ? *keep : local;
    SectionSettings settings;
    settings.end[0] = 5.0F;
    settings.symbolFile = "...sec_sym\\sec01";
    section.SetName(name);
    section.SetSettings(settings);
    EXPECT_EQ(section.Create(), 0);
    return section.GetHandle();
  }

 private:
  std::filesystem::path savedFile_;
};
