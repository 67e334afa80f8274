// The view commands: what is set through one command reads back through its query, values
// that cannot be drawn are refused, redraws are held while redrawing is off, and the section
// and plan cuts replace each other.
#include <limits>

#include "tests/workbench_view/view_host_fixture.h"

namespace {

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

class ViewCommandsTest : public ViewHostTest {};

TEST_F(ViewCommandsTest, EyeTargetAndConeReadBackThroughTheirQueries) {
  globp[48] = {1.5F, -2.25F, 30.0F};
  ASSERT_EQ(Run("eye"), 1);
  globp[47] = {4.0F, 5.0F, -6.0F};
  ASSERT_EQ(Run("target"), 1);
  globr[64] = 12.5F;
  ASSERT_EQ(Run("set_viewing_conus"), 1);

  globp[48] = globp[47] = {};
  globr[64] = 0.0F;
  Run("get_eye");
  Run("get_target");
  Run("inq_viewing_conus");
  ExpectPoint(globp[48], 1.5F, -2.25F, 30.0F);
  ExpectPoint(globp[47], 4.0F, 5.0F, -6.0F);
  EXPECT_EQ(globr[64], 12.5F);
}

TEST_F(ViewCommandsTest, ValuesThatCannotBeDrawnAreRefusedAndChangeNothing) {
  globp[48] = {kNaN, 0.0F, 0.0F};
  EXPECT_EQ(Run("eye"), 0);
  globp[47] = {0.0F, kInfinity, 0.0F};
  EXPECT_EQ(Run("target"), 0);
  for (float cone : {0.0F, -5.0F, 180.0F, kNaN, kInfinity}) {
    globr[64] = cone;
    EXPECT_EQ(Run("set_viewing_conus"), 0) << cone;
  }
  ExpectPoint(View().eye, 10.0F, -10.0F, 10.0F);
  ExpectPoint(View().target, 0.0F, 0.0F, 0.0F);
  EXPECT_EQ(View().cone, 45.0F);
}

TEST_F(ViewCommandsTest, UnknownScaleModeIsRefusedAndTheModeInForceShown) {
  globc[22] = 'f';
  Run("set_scale_mode");
  globc[22] = 'x';
  EXPECT_EQ(Run("set_scale_mode"), 0);
  EXPECT_EQ(globc[22], 'f');
  EXPECT_EQ(View().scaleMode, 'f');
}

TEST_F(ViewCommandsTest, RedrawsAskedForWhileRedrawingIsOffAreDoneOnceWhenItIsOnAgain) {
  Run("redraw_all");
  Run("regen");
  EXPECT_EQ(View().redraws.full, 1);
  EXPECT_EQ(View().redraws.regenerations, 1);

  Run("start_redraw_off");
  Run("redraw_all");
  Run("regen");
  Run("redraw_all");
  EXPECT_EQ(View().redraws.full, 1);
  EXPECT_EQ(View().redraws.regenerations, 1);
  Run("start_redraw_on");
  EXPECT_EQ(View().redraws.full, 2);

  Run("start_redraw_off");
  Run("start_redraw_on");
  EXPECT_EQ(View().redraws.full, 2) << "nothing was held";
}

TEST_F(ViewCommandsTest, SectionCutTakesTheFourPointsAndCutTypeAndEndsThePlanView) {
  globp[0] = {1, 2, 0};
  globp[1] = {1, 2, 5};
  globp[2] = {1, 102, 0};
  globp[3] = {1, 2, 5};
  globc[109] = 'w';
  ASSERT_EQ(Run("planv"), 1);
  ASSERT_TRUE(View().plan.active);

  globp[0] = {2, 2, 5};
  globp[1] = {2, 6, 5};
  globp[2] = {2, 2, 6};
  globp[3] = {-2, 2, 5};
  globc[109] = 'o';
  ASSERT_EQ(Run("set_vsect_plane"), 1);

  const wb::SectionCut& cut = View().section;
  EXPECT_TRUE(cut.active);
  EXPECT_FALSE(View().plan.active);
  EXPECT_EQ(cut.cutType, 'o');
  ExpectPoint(cut.points[0], 2, 2, 5);
  ExpectPoint(cut.points[1], 2, 6, 5);
  ExpectPoint(cut.points[2], 2, 2, 6);
  ExpectPoint(cut.points[3], -2, 2, 5);
}

TEST_F(ViewCommandsTest, PlanViewTakesBaseSpanAndDirAndEndsTheSectionCut) {
  globp[0] = {0, 0, 0};
  globp[1] = {10, 0, 0};
  globc[109] = 'b';
  ASSERT_EQ(Run("set_vsect_plane"), 1);

  globp[0] = {1, 2, 0};
  globp[1] = {101, 2, 0};
  globp[2] = {1, 102, 0};
  globp[3] = {1, 2, 5};
  globc[109] = 'w';
  ASSERT_EQ(Run("planv"), 1);

  const wb::PlanView& plan = View().plan;
  EXPECT_TRUE(plan.active);
  EXPECT_FALSE(View().section.active);
  EXPECT_EQ(plan.cutType, 'w');
  ExpectPoint(plan.base, 1, 2, 0);
  ExpectPoint(plan.xPoint, 101, 2, 0);
  ExpectPoint(plan.yPoint, 1, 102, 0);
  ExpectPoint(plan.dir, 1, 2, 5);
}

TEST_F(ViewCommandsTest, SectionCutWithoutDirectionInPlanIsRefused) {
  globp[0] = {3, 3, 0};
  globp[1] = {3, 3, 8};  // straight above: no vertical plane through it
  EXPECT_EQ(Run("set_vsect_plane"), 0);
  EXPECT_FALSE(View().section.active);

  globp[1] = {kNaN, 3, 0};
  EXPECT_EQ(Run("set_vsect_plane"), 0);
  EXPECT_FALSE(View().section.active);

  globp[0] = {kInfinity, 0, 0};
  EXPECT_EQ(Run("planv"), 0);
  EXPECT_FALSE(View().plan.active);
}

TEST_F(ViewCommandsTest, CommandsAreJournaledInOrderAndHonourFaults) {
  wb::FaultRule refuseEye;
  refuseEye.call = "execute_internal_command";
  refuseEye.attribute = "eye";
  Session().GetFaults().Add(refuseEye);
  globp[48] = {5, 5, 5};
  EXPECT_EQ(Run("eye"), 0);
  ExpectPoint(View().eye, 10.0F, -10.0F, 10.0F);
  EXPECT_EQ(Run("eye"), 1);
  ExpectPoint(View().eye, 5.0F, 5.0F, 5.0F);
  Run("get_eye");
  EXPECT_EQ(Commands(), (std::vector<std::string>{"eye", "get_eye"}));
}

TEST_F(ViewCommandsTest, UnknownCommandIsJournaledButNotReportedAsDone) {
  EXPECT_EQ(Run("wireframe_al"), 0);
  EXPECT_EQ(Commands(), std::vector<std::string>{"wireframe_al"});
}

TEST_F(ViewCommandsTest, ResetBringsBackTheFreshView) {
  globp[48] = {1, 1, 1};
  Run("eye");
  Run("set_perspective");
  execute_2d();
  Run("start_redraw_off");
  globc[22] = 'f';
  Run("set_scale_mode");
  globp[0] = {0, 0, 0};
  globp[1] = {1, 0, 0};
  Run("set_vsect_plane");
  add_wait_cur();
  remove_wait_cur();
  remove_wait_cur();
  dBox_window_set_keep_scale(3.0F);

  Session().Reset();

  ExpectPoint(View().eye, 10.0F, -10.0F, 10.0F);
  EXPECT_FALSE(View().perspective);
  EXPECT_TRUE(View().threeD);
  EXPECT_EQ(globr[132], 3.0F);
  EXPECT_TRUE(View().redrawOn);
  EXPECT_EQ(View().scaleMode, 'a');
  EXPECT_EQ(globc[22], 'a');
  EXPECT_FALSE(View().section.active);
  EXPECT_EQ(View().waitCursor, 0);
  EXPECT_EQ(View().waitCursorUnderflows, 0);
  EXPECT_EQ(View().keptScale, 0.0F);
}

}  // namespace
