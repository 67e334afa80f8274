// The plug-in's own display-mode code against this host: every mode switched to reads back as
// itself, from plain geometry and from every other mode, and the way back to plain geometry
// re-enters the plug-in to show the section symbols again.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "shell/pane_instance.h"
#include "tests/shell/plugin_fixture.h"
#include "ui/pandex_dlg.h"
#include "workbench/workbench.h"

namespace {

constexpr std::int16_t kFirstMode = HRUtility::kGeometric;
constexpr std::int16_t kLastMode = HRUtility::kRender;

class DisplayRoundTripTest : public LoadedPluginTest {
 protected:
  // A fresh host with the plug-in loaded again, for each pair of modes.
  void FreshHost() {
    TearDown();
    SetUp();
  }

  static std::int16_t SwitchAndAsk(std::int16_t mode) {
    HRUtility::SetDisplayMode(mode);
    return HRUtility::GetDisplayMode();
  }
};

TEST_F(DisplayRoundTripTest, EveryModeReadsBackFromPlainGeometry) {
  for (std::int16_t k = kFirstMode; k <= kLastMode; ++k) {
    FreshHost();
    ASSERT_EQ(HRUtility::GetDisplayMode(), HRUtility::kGeometric);
    EXPECT_EQ(SwitchAndAsk(k), k);
  }
}

TEST_F(DisplayRoundTripTest, EveryModeReadsBackFromEveryOtherMode) {
  for (std::int16_t j = kFirstMode; j <= kLastMode; ++j) {
    for (std::int16_t k = kFirstMode; k <= kLastMode; ++k) {
      FreshHost();
      ASSERT_EQ(SwitchAndAsk(j), j);
      EXPECT_EQ(SwitchAndAsk(k), k) << "from " << j;
    }
  }
}

// The same pairs in one long session, so what one switch leaves behind (the remembered
// projection, the hidden-line switch, the render window) meets every later switch.
TEST_F(DisplayRoundTripTest, EveryPairReadsBackInOneSession) {
  for (std::int16_t j = kFirstMode; j <= kLastMode; ++j) {
    for (std::int16_t k = kFirstMode; k <= kLastMode; ++k) {
      ASSERT_EQ(SwitchAndAsk(j), j) << "before " << k;
      EXPECT_EQ(SwitchAndAsk(k), k) << "from " << j;
    }
  }
}

TEST_F(DisplayRoundTripTest, RenderAndBackRestoresTheProjectionAndLeavesNoImage) {
  execute_internal_command("set_perspective");
  ASSERT_EQ(SwitchAndAsk(HRUtility::kShaded), HRUtility::kShaded);
  ASSERT_EQ(SwitchAndAsk(HRUtility::kRender), HRUtility::kRender);
  EXPECT_EQ(globc[403], 'a');
  EXPECT_EQ(wb::Workbench::Get().Display().toolbar, "RENDER  ");

  execute_internal_command("set_parallel");
  ASSERT_EQ(SwitchAndAsk(HRUtility::kGeometric), HRUtility::kGeometric);
  const wb::Workbench& host = wb::Workbench::Get();
  EXPECT_TRUE(host.View().perspective);
  EXPECT_FALSE(host.Display().renderOn);
  EXPECT_FALSE(host.Display().renderImage);
  EXPECT_FALSE(host.Display().renderWindowShown);
  EXPECT_EQ(host.Display().toolbar, "GEOM    ");
}

TEST_F(DisplayRoundTripTest, RenderFromTwoDSwitchesTheViewToThreeD) {
  execute_2d();
  ASSERT_EQ(SwitchAndAsk(HRUtility::kRender), HRUtility::kRender);
  EXPECT_TRUE(wb::Workbench::Get().View().threeD);
  EXPECT_EQ(globr[132], 3.0F);
}

TEST_F(DisplayRoundTripTest, SolidSetUpRunsOnceBetweenSolidModes) {
  SwitchAndAsk(HRUtility::kHiddenline);
  SwitchAndAsk(HRUtility::kShadowModel);
  SwitchAndAsk(HRUtility::kMonoShadowTerrain);
  const wb::DisplayState& display = wb::Workbench::Get().Display();
  EXPECT_EQ(display.solidBuilds, 1);
  EXPECT_EQ(display.freshSolidBuilds, 1);
  EXPECT_TRUE(display.hiddenLine2d);
  EXPECT_EQ(display.toolbar, "SOLID   ");
}

TEST_F(DisplayRoundTripTest, ModesOnlyReportedAreRecognisedFromTheLetters) {
  globc[65] = 'p';
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kDesign);
  globc[65] = ' ';
  globc[32] = 'a';
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kGeometricA);
  globc[32] = ' ';
  SwitchAndAsk(HRUtility::kWireframe);
  globc[0] = 'b';
  execute_internal_command("set_dspmode_info");
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kSolidBlank);
}

// Stands in for the docked pane: sub-command 3 needs a pane to exist, nothing more.
class QuietPane : public CPandexDlg {
 public:
  bool Create(int, CWnd*) override { return true; }
  void ShowPane(bool) override {}
};

class GeometricReEntryTest : public DisplayRoundTripTest {
 protected:
  void SetUp() override {
    DisplayRoundTripTest::SetUp();
    pandex::SetPaneFactory([] { return std::make_unique<QuietPane>(); });
  }

  // A section's instance, hidden, as the section symbols are after a cut view.
  static host::EntityHandle AddHiddenSection() {
    wb::Entity& entity = wb::Workbench::Get().CurrentDrawing().Add(host::kTypePlacedBlock);
    wb::WriteRecord(entity, host::PlacedBlockRecord{});
    wb::Attribute marker;
    marker.name = "@Class=";
    marker.text = "HRSection";
    entity.attributes.push_back(marker);
    entity.header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
    return entity.handle;
  }

  static bool Hidden(host::EntityHandle handle) { return wb::Workbench::Get().CurrentDrawing().Find(handle)->Hidden(); }
};

TEST_F(GeometricReEntryTest, LeavingASolidModeReEntersThePlugInWithSubCommandThree) {
  ASSERT_NE(pandex::EnsurePane(), nullptr);
  SwitchAndAsk(HRUtility::kSurfaces);
  const host::EntityHandle section = AddHiddenSection();
  wb::Workbench::Get().GetJournal().Clear();

  ASSERT_EQ(SwitchAndAsk(HRUtility::kGeometric), HRUtility::kGeometric);

  EXPECT_EQ(globi[0], 3);
  EXPECT_FALSE(Hidden(section));
  const std::vector<std::string> overlays = wb::Workbench::Get().GetJournal().Names(wb::JournalEntry::Kind::Overlay);
  EXPECT_EQ(overlays, (std::vector<std::string>{"hidlin2d", "toolbar", "Pandex"}));
}

TEST_F(GeometricReEntryTest, AlreadyPlainGeometryDoesNotReEnter) {
  ASSERT_NE(pandex::EnsurePane(), nullptr);
  const host::EntityHandle section = AddHiddenSection();
  wb::Workbench::Get().GetJournal().Clear();

  ASSERT_EQ(SwitchAndAsk(HRUtility::kGeometric), HRUtility::kGeometric);

  EXPECT_TRUE(Hidden(section));
  EXPECT_TRUE(wb::Workbench::Get().GetJournal().Names(wb::JournalEntry::Kind::Overlay).empty());
}

}  // namespace
