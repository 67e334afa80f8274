// The view commands: what is set through one command reads back through its query, values
// that cannot be drawn are refused, redraws are held while redrawing is off, and the section
// and plan cuts replace each other.
#include <algorithm>
#include <limits>
#include <tuple>

#include "tests/workbench/host_fixture.h"

namespace {

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

// Compares points exactly: the host hands back what it was given, float for float.
void ExpectPoint(const host::Point3f& actual, const host::Point3f& expected) {
  EXPECT_EQ(std::tie(actual.x, actual.y, actual.z), std::tie(expected.x, expected.y, expected.z));
}

using ViewCommandsTest = HostTest;

TEST_F(ViewCommandsTest, ValuesReadBackThroughTheirQueriesAndThoseThatCannotBeDrawnAreRefused) {
  globp[48] = {1.5F, -2.25F, 30.0F};
  globp[47] = {4.0F, 5.0F, -6.0F};
  globr[64] = 12.5F;
  for (const char* command : {"eye", "target", "set_viewing_conus"}) EXPECT_EQ(Run(command), 1);
  globp[48] = globp[47] = {kNaN, 0.0F, 0.0F};
  for (const float cone : {0.0F, 180.0F, kNaN}) {
    globr[64] = cone;
    EXPECT_EQ(Run("set_viewing_conus"), 0) << cone;
  }
  EXPECT_EQ(Run("eye"), 0);
  EXPECT_EQ(Run("target"), 0);
  for (const char* query : {"get_eye", "get_target", "inq_viewing_conus"}) EXPECT_EQ(Run(query), 1);
  ExpectPoint(globp[48], {1.5F, -2.25F, 30.0F});
  ExpectPoint(globp[47], {4.0F, 5.0F, -6.0F});
  EXPECT_EQ(globr[64], 12.5F);

  globp[0] = {3, 3, 0};
  globp[1] = {3, 3, 8};  // straight above: no vertical plane through it
  EXPECT_EQ(Run("set_vsect_plane"), 0);
  globp[0] = {kNaN, 0, 0};
  EXPECT_EQ(Run("planv"), 0);
  EXPECT_FALSE(View().section.active || View().plan.active);
  EXPECT_EQ(Run("wireframe_al"), 0) << "an unknown command is not reported as done";
}

TEST_F(ViewCommandsTest, RedrawsAskedForWhileRedrawingIsOffAreDoneOnceWhenItIsOnAgain) {
  const wb::RedrawCounts& redraws = View().redraws;
  for (const char* command : {"redraw_all", "regen", "start_redraw_off", "redraw_all", "regen", "redraw_all"}) {
    Run(command);
  }
  wn3_dl_redraw(5);
  EXPECT_EQ(std::tie(redraws.full, redraws.regenerations, redraws.displayList), std::tuple(1, 1, 0));
  EXPECT_EQ(redraws.lastDisplayListMode, 5);
  for (const char* command : {"start_redraw_on", "start_redraw_off", "start_redraw_on"}) Run(command);
  EXPECT_EQ(redraws.full, 2) << "what was held is drawn once";
}

TEST_F(ViewCommandsTest, SectionCutAndPlanViewTakeTheirPointsAndEndEachOther) {
  const host::Point3f plan[4] = {{1, 2, 0}, {101, 2, 0}, {1, 102, 0}, {1, 2, 5}};
  const host::Point3f section[4] = {{2, 2, 5}, {2, 6, 5}, {2, 2, 6}, {-2, 2, 5}};
  std::copy(plan, plan + 4, globp);
  globc[109] = 'w';
  ASSERT_EQ(Run("planv"), 1);
  std::copy(section, section + 4, globp);
  globc[109] = 'o';
  ASSERT_EQ(Run("set_vsect_plane"), 1);
  EXPECT_FALSE(View().plan.active);
  EXPECT_EQ(View().section.cutType, 'o');
  for (int i = 0; i < 4; ++i) ExpectPoint(View().section.points[i], section[i]);

  std::copy(plan, plan + 4, globp);
  globc[109] = 'w';
  ASSERT_EQ(Run("planv"), 1);
  EXPECT_FALSE(View().section.active);
  const wb::PlanView& taken = View().plan;
  EXPECT_EQ(taken.cutType, 'w');
  const host::Point3f points[4] = {taken.base, taken.xPoint, taken.yPoint, taken.dir};
  for (int i = 0; i < 4; ++i) ExpectPoint(points[i], plan[i]);
}

}  // namespace
