// Every view and layer call honours fault injection: an armed fault fails it, it answers the
// forced result where it has one, and nothing in the host changes or is journaled.
#include <array>
#include <optional>
#include <string>
#include <tuple>

#include "tests/workbench_view/view_host_fixture.h"

namespace {

constexpr std::int32_t kForced = 7;

struct ViewCall {
  const char* name;
  std::optional<double> (*run)();  // the answer, when the call has one
};

template <auto Function, auto... Arguments>
std::optional<double> Quiet() {
  Function(Arguments...);
  return std::nullopt;
}

template <auto Function, auto... Arguments>
std::optional<double> Answered() {
  return static_cast<double>(Function(Arguments...));
}

// Calls that answer a pointer, or fill the caller's buffer, answer kForced when they fail.
std::optional<double> InquireWindow() {
  std::array<double, 4> rect{};
  wn3_inq_view_rect(rect.data());
  return rect[2] == 0.0 ? kForced : 0.0;
}

std::optional<double> SetWindow() {
  const double rect[4] = {1, 2, 3, 4};
  wn3_set_view_rect(rect);
  return std::nullopt;
}

std::optional<double> LayerTable() { return GetLayersInCurrentHDL() == nullptr ? kForced : 0.0; }

std::optional<double> LayerName() {
  return HDL_Get_LayerName(wb::kLayerTableHandleBase + 1, 3) == nullptr ? kForced : 0.0;
}

constexpr ViewCall kCalls[] = {
    {"add_wait_cur", &Quiet<add_wait_cur>},
    {"remove_wait_cur", &Quiet<remove_wait_cur>},
    {"wn3_inq_view_rect", &InquireWindow},
    {"wn3_set_view_rect", &SetWindow},
    {"wn3_auto_window", &Quiet<wn3_auto_window, 4>},
    {"wn3_dl_redraw", &Quiet<wn3_dl_redraw, 2>},
    {"init_hdl_redraw_draw_params", &Quiet<init_hdl_redraw_draw_params>},
    {"execute_2d", &Quiet<execute_2d>},
    {"execute_3d", &Quiet<execute_3d>},
    {"wnp_fixed_scaling", &Answered<wnp_fixed_scaling>},
    {"wnp_auto_scaling", &Answered<wnp_auto_scaling>},
    {"dBox_calc_scale", &Answered<dBox_calc_scale>},
    {"dBox_window_set_keep_scale", &Quiet<dBox_window_set_keep_scale, 2.5F>},
    {"dBox_window_keep_scale", &Answered<dBox_window_keep_scale>},
    {"GetLayersInCurrentHDL", &LayerTable},
    {"HDL_Main", &Answered<HDL_Main>},
    {"HDL_Set_Layer_On", &Answered<HDL_Set_Layer_On, wb::kLayerTableHandleBase + 1, 2>},
    {"HDL_Set_Layer_Off", &Answered<HDL_Set_Layer_Off, wb::kLayerTableHandleBase + 1, 3>},
    {"HDL_Get_LayerName", &LayerName},
};

// What any view call could change.
auto Snapshot() {
  const wb::ViewState& view = wb::Workbench::Get().View();
  std::array<bool, wb::kLayerCount> layers{};
  for (std::size_t i = 0; i < layers.size(); ++i) layers[i] = wb::Workbench::Get().CurrentDrawing().layers[i].on;
  return std::make_tuple(view.waitCursor, view.waitCursorUnderflows, view.window, view.threeD, globr[132],
                         view.keptScale, view.keepingScale, view.autoWindowFits, view.redraws.displayList,
                         view.redraws.drawParameterResets, layers);
}

class EveryViewCall : public ViewHostTest, public ::testing::WithParamInterface<ViewCall> {};

TEST_P(EveryViewCall, AnArmedFaultFailsItAndChangesNothing) {
  // A state in which every call, left alone, would change something.
  wb::Entity& line = Session().CurrentDrawing().Add(host::kTypeLine);
  wb::WriteRecord(line, host::LineRecord{0, 0, 0, 0, {50, 60, 0}, {70, 80, 0}});
  Session().CurrentDrawing().layers[2].on = false;
  globc[22] = 'f';
  execute_internal_command("set_scale_mode");
  dBox_window_set_keep_scale(1.5F);
  add_wait_cur();
  const auto before = Snapshot();
  const std::size_t journaled = Session().GetJournal().Entries().size();

  Session().GetFaults().FailNext(GetParam().name, kForced);
  const std::optional<double> answer = GetParam().run();

  EXPECT_FALSE(Session().GetFaults().Armed()) << "the call asked for its fault";
  if (answer) {
    EXPECT_EQ(*answer, kForced);
  }
  EXPECT_EQ(Snapshot(), before);
  EXPECT_EQ(Session().GetJournal().Entries().size(), journaled);
}

INSTANTIATE_TEST_SUITE_P(ViewCalls, EveryViewCall, ::testing::ValuesIn(kCalls),
                         [](const ::testing::TestParamInfo<ViewCall>& call) {
                           std::string name = call.param.name;
                           std::erase(name, '_');  // test names are CamelCase
                           return name;
                         });

using CommandLinesTest = ViewHostTest;

TEST_F(CommandLinesTest, AreKeptInOrderUntilReset) {
  CommandMessage("/3secadd");
  CommandMessage(nullptr);
  CommandMessage("/3planead");
  EXPECT_EQ(Session().CommandLines(), (std::vector<std::string>{"/3secadd", "/3planead"}));
  Session().Reset();
  EXPECT_TRUE(Session().CommandLines().empty());
}

}  // namespace
