// A fresh host with the library loaded over an empty drawing that lives in a scratch folder,
// and the readers the 2D tests compare against: the order of host calls, the files written and
// how the host's 2D commands were asked to work.
#pragma once

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

#include "tests/draft/draft_fixture.h"
#include "tests/drawing_file/scratch_folder.h"
#include "views/camera_settings.h"
#include "workbench/draft/sheet.h"
#include "workbench/workbench.h"

namespace output2d_test {

// A camera's nine 2D options, in the order Save2D takes them.
struct SaveOptions {
  std::uint8_t autoClip = 0;
  std::uint8_t overwrite = 1;
  std::uint8_t removeCoincident = 0;
  std::uint8_t lineMerge = 0;
  std::uint8_t dimensions = 0;
  std::uint8_t texts = 0;
  std::uint8_t walls = 0;
  std::uint8_t layer = 0;
  std::int16_t layerIndex = 0;
};

// Category codes the database loop reports (byte 3, byte 1).
struct Category {
  std::uint8_t kind;
  std::uint8_t code;
};
constexpr Category kWallCategory{1, 3};
constexpr Category kDimensionCategory{4, 44};
constexpr Category kTextCategory{1, 7};

// A view as a camera holds it.
struct View {
  host::Point3f eye{};
  host::Point3f target{};
  bool perspective = false;
  std::int16_t displayMode = 0;
  std::array<double, 4> window{-100.0, -100.0, 100.0, 100.0};
};

class Output2DTest : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  static wb::Output2DState& HostState() { return Bench().Output2D(); }

  // The drawing counts as saved here; its 2D folder is Folder() / "2D_".
  std::filesystem::path DrawingPath() const { return scratch_ / "house.pdx"; }
  const std::filesystem::path& Folder() const { return scratch_.Path(); }
  std::filesystem::path OutputFolder() const { return scratch_ / "2D_"; }

  // Commands, overlays ("overlay " prefix), change records ("write_to_record E C") and the
  // 2D host calls that change the host ("qel_put_long_name KIND", "SetSymbolString",
  // "select_app_entity E"), in the order the host saw them.
  static std::vector<std::string> Steps();
  static long Count(const std::vector<std::string>& steps, const std::string& step);

  // Registers the target under kind 10, as the batch does, and runs Save2D on it.
  static bool Save(const std::filesystem::path& target, const SaveOptions& options = {});
  // The DXF a generation wrote for the target.
  static wb::draft::Sheet ReadOutput(const std::filesystem::path& target);

  static CameraSettings SettingsFor(const View& view);
  // Puts the view on the host screen the way the batch does, through a camera's Execute.
  static void Show(const View& view);
  // A stored general camera ticked for 2D (or not); answers its index.
  static std::int32_t AddCamera(const std::string& name, const View& view, bool ticked = true,
                                const std::string& file2D = "");

  // Entities of the drawing with their category bytes.
  static wb::Entity& AddCube(host::Point3f corner, float size = 1.0F, std::uint8_t layer = 0);
  static wb::Entity& AddText(const std::string& text, host::Point3f at, std::uint8_t layer = 5);
  static wb::Entity& AddDimension(host::Point3f from, host::Point3f to, const std::string& value,
                                  std::uint8_t layer = 4);
  static void SetCategory(wb::Entity& entity, Category category);

 private:
  drawing_file_samples::ScratchFolder scratch_;
};

}  // namespace output2d_test
