// Fault injection: every host call honours an armed rule, and the rules' skip, times, entity
// and name filters pick exactly the calls they describe.
#include <optional>
#include <string>
#include <tuple>

#include "shell/host/qelinfo.h"
#include "tests/workbench/host_fixture.h"

namespace {

constexpr std::int32_t kForced = 7;
using Answer = std::optional<double>;

// Live entities of every kind, an open record, and room for whatever the calls hand back.
struct Prepared {
  EntityHandle line, group, block, placed, element, made, *members;
  RecordHandle record;
  host::LineRecord lineRecord;
  host::BlockRecord blockRecord;
  host::GroupRecord groupRecord;
  host::PlacedBlockRecord placedRecord;
  host::ElementRecord elementRecord;
  host::EntityHeader header;
  char* text;
  char shortName[9];
  std::int16_t shortValue, shorts[1], *shortList;
  std::int32_t count, longs[1], *longList;
  float floatValue, floats[1], *floatList, matrix[16];
  float framePoints[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
  host::Point3f points[2] = {{0, 0, 0}, {1, 0, 0}};
  double rect[4] = {1, 2, 3, 4}, window[4];
};

// Calls that answer a pointer, or fill the caller's buffer, answer kForced when they fail.
Answer ForcedIfNull(const void* answer) { return answer == nullptr ? kForced : 0; }

constexpr auto kTable = wb::kLayerTableHandleBase + 1;  // the current drawing's layers

struct Call {
  const char* name;
  Answer (*run)(Prepared&);
};
void PrintTo(const Call& call, std::ostream* out) { *out << call.name; }

// One row per call, named by the function it makes: a status or value answered, a pointer
// answered (null counts as kForced), or no answer at all.
#define ANSWERED(function, ...) \
  {#function, []([[maybe_unused]] Prepared& p) -> Answer { return function(__VA_ARGS__); }}
#define POINTER(function, ...) \
  {#function, []([[maybe_unused]] Prepared& p) { return ForcedIfNull(function(__VA_ARGS__)); }}
#define QUIET(function, ...) \
  {#function, []([[maybe_unused]] Prepared& p) -> Answer { return function(__VA_ARGS__), std::nullopt; }}

const Call kCalls[] = {
    ANSWERED(qel_read_entity_header, db.handle, p.line, &p.header),
    ANSWERED(qel_update_entity_header, db.handle, p.line, &p.header),
    ANSWERED(qel_delete_entity, db.handle, p.line),
    ANSWERED(qel_read_line, db.handle, p.line, &p.lineRecord),
    ANSWERED(qel_update_line, db.handle, p.line, &p.lineRecord),
    ANSWERED(qel_add_line, db.handle, &p.made, &p.lineRecord),
    ANSWERED(qel_add_text, db.handle, &p.made, &p.lineRecord, "", "t", 1),
    ANSWERED(qel_read_block, db.handle, p.block, &p.blockRecord, nullptr),
    ANSWERED(qel_update_block, db.handle, p.block, &p.blockRecord),
    ANSWERED(qel_create_block, db.handle, &p.made, 0, nullptr, "b", &p.blockRecord),
    ANSWERED(qel_delete_block, db.handle, p.block),
    ANSWERED(get_whole_vector_of_block_members, db.handle, p.block, &p.members, &p.count),
    ANSWERED(qel_add_members_to_block, db.handle, p.block, 1, &p.group),
    ANSWERED(qel_unlink_members_from_block, db.handle, p.block, 1, &p.line),
    ANSWERED(qel_read_group, db.handle, p.group, &p.groupRecord, nullptr),
    ANSWERED(qel_update_group, db.handle, p.group, &p.groupRecord),
    ANSWERED(qel_create_group, db.handle, &p.made, 0, nullptr, "g", &p.groupRecord),
    ANSWERED(qel_delete_group, db.handle, p.group),
    ANSWERED(qel_read_placed_block, db.handle, p.placed, &p.placedRecord, nullptr),
    ANSWERED(qel_update_placed_block, db.handle, p.placed, &p.placedRecord, 0),
    ANSWERED(qel_add_placed_block, db.handle, &p.made, "blk", &p.placedRecord),
    ANSWERED(qel_read_element, db.handle, p.element, &p.elementRecord),
    ANSWERED(qel_update_element, db.handle, p.element, &p.elementRecord),
    ANSWERED(qel_add_element, db.handle, &p.made, &p.elementRecord, 0),
    POINTER(qel_get_config_path, db.handle, p.element),
    POINTER(qel_get_element_name, db.handle, p.element, "s"),
    POINTER(qel_get_short_name, "file.sym", p.shortName),
    {"qel_open_attribute_record",
     [](Prepared& p) -> Answer {
       return qel_open_attribute_record(db.handle, p.line, &p.shortValue) == 0 ? p.shortValue : 0;
     }},
    ANSWERED(qel_close_attribute_record, db.handle, p.record),
    ANSWERED(qel_set_string_attribute, p.record, "s=", "x"),
    ANSWERED(qel_read_string_attribute, p.record, "s=", &p.text),
    ANSWERED(qel_set_short_attribute, p.record, "h=", 1),
    ANSWERED(qel_read_short_attribute, p.record, "h=", &p.shortValue),
    ANSWERED(qel_set_float_attribute, p.record, "f=", 1.0F, 0),
    ANSWERED(qel_read_float_attribute, p.record, "f=", &p.floatValue),
    ANSWERED(qel_set_float_vector_attribute, p.record, "fv=", p.floats, 1, 6),
    ANSWERED(qel_read_fixed_float_vector, p.record, "fv=", p.floats, 1),
    ANSWERED(qel_read_fixed_short_vector, p.record, "hv=", p.shorts, 1),
    ANSWERED(qel_set_short_vector_attribute, p.record, "hv=", p.shorts, 1),
    ANSWERED(qel_read_unknown_short_vector, p.record, "hv=", &p.count, &p.shortList),
    ANSWERED(qel_set_long_vector_attribute, p.record, "lv=", 1, p.longs),
    ANSWERED(qel_read_unknown_long_vector, p.record, "lv=", &p.count, &p.longList),
    ANSWERED(qel_read_unknown_float_vector, p.record, "fv=", &p.count, &p.floatList),
    ANSWERED(qel_remove_attribute_from_record, p.record, "s="),
    ANSWERED(is_attribute_exist, db.handle, p.line, "s="),
    ANSWERED(loop_on_database, db.handle, &p.made, &p.count),
    ANSWERED(loop_on_database_blank, db.handle, &p.made, &p.count),
    ANSWERED(loop_on_database_blank_h, db.handle, &p.made, &p.count, &p.header),
    QUIET(write_to_record, p.line, 5),
    ANSWERED(execute_internal_command, "redraw_all"),
    ANSWERED(execute_quorvel_overlay, "toolbar"),
    QUIET(CommandMessage, "/3secadd"),
    QUIET(log_free, nullptr),
    POINTER(log_str_dup_new, "x", "Test", 1),
    {"g32d", [](Prepared& p) -> Answer { return g32d(p.framePoints, p.matrix, &p.count), p.count; }},
    ANSWERED(distance_3d, &p.points[0], &p.points[1]),
    ANSWERED(iskanji_string, "\xE6\x96\xAD"),
    QUIET(SetCameraManagerOn),
    QUIET(SetCameraManagerOff),
    QUIET(add_wait_cur),
    QUIET(remove_wait_cur),
    {"wn3_inq_view_rect",
     [](Prepared& p) -> Answer { return wn3_inq_view_rect(p.window), p.window[2] == 0.0 ? kForced : 0; }},
    QUIET(wn3_set_view_rect, p.rect),
    QUIET(wn3_auto_window, 4),
    QUIET(wn3_dl_redraw, 2),
    QUIET(init_hdl_redraw_draw_params),
    QUIET(execute_2d),
    QUIET(execute_3d),
    ANSWERED(wnp_fixed_scaling),
    ANSWERED(wnp_auto_scaling),
    ANSWERED(dBox_calc_scale),
    QUIET(dBox_window_set_keep_scale, 2.5F),
    ANSWERED(dBox_window_keep_scale),
    POINTER(GetLayersInCurrentHDL),
    ANSWERED(HDL_Main),
    ANSWERED(HDL_Set_Layer_On, kTable, 2),
    ANSWERED(HDL_Set_Layer_Off, kTable, 3),
    POINTER(HDL_Get_LayerName, kTable, 3),
};

#undef ANSWERED
#undef POINTER
#undef QUIET

// Everything a call could change in the host.
auto Snapshot() {
  wb::Workbench& host = wb::Workbench::Get();
  const wb::ViewState& view = host.View();
  return std::make_tuple(host.CurrentDrawing(), host.GetJournal().Entries(), host.Memory().Outstanding(),
                         host.Records().OpenCount(), host.CameraManagerOn(), host.CommandLines(), view.waitCursor,
                         view.waitCursorUnderflows, view.window, view.threeD, globr[132], view.keptScale,
                         view.keepingScale, view.autoWindowFits, view.redraws.displayList,
                         view.redraws.drawParameterResets);
}

}  // namespace

class EveryHostCall : public HostTest, public ::testing::WithParamInterface<Call> {};

TEST_P(EveryHostCall, AnArmedFaultFailsItAndChangesNothing) {
  // A state in which every call, left alone, would change something.
  Prepared p{};
  p.line = AddLine();
  p.group = AddGroup();
  ASSERT_EQ(qel_create_block(db.handle, &p.block, 1, &p.line, "blk", &p.blockRecord), 1);
  ASSERT_EQ(qel_add_placed_block(db.handle, &p.placed, "blk", &p.placedRecord), 1);
  ASSERT_EQ(qel_add_element(db.handle, &p.element, &p.elementRecord, 0), 1);
  p.record = OpenRecord(p.line);
  Current().layers[2].on = false;
  globc[22] = 'f';
  Run("set_scale_mode");
  dBox_window_set_keep_scale(1.5F);
  add_wait_cur();
  const auto before = Snapshot();

  SCOPED_TRACE(GetParam().name);
  Session().GetFaults().FailNext(GetParam().name, kForced);
  const Answer answer = GetParam().run(p);

  EXPECT_FALSE(Session().GetFaults().Armed()) << "the call asked for its fault";
  EXPECT_EQ(answer.value_or(kForced), kForced);
  EXPECT_TRUE(Snapshot() == before);
}

INSTANTIATE_TEST_SUITE_P(HostCalls, EveryHostCall, ::testing::ValuesIn(kCalls));

using FaultRules = HostTest;

TEST_F(FaultRules, SkipTimesEntityAndNameFiltersPickExactlyTheirCallsInTheOrderAdded) {
  const EntityHandle first = AddLine();
  const EntityHandle second = AddLine();
  wb::Faults& faults = Session().GetFaults();
  faults.Add({.call = "qel_read_entity_header", .attribute = {}, .skip = 1, .times = 2, .result = -4});
  faults.Add({.call = "qel_read_entity_header", .attribute = {}, .times = 2, .result = -5});
  host::EntityHeader header{};
  std::vector<Status> answers;
  for (int i = 0; i < 5; ++i) answers.push_back(qel_read_entity_header(db.handle, first, &header));
  EXPECT_EQ(answers, (std::vector<Status>{-5, -4, -4, -5, 1})) << "the first rule added that fires decides";

  faults.Add({.call = "qel_open_attribute_record", .entity = second, .attribute = {}, .result = -9});
  const RecordHandle record = OpenRecord(first);
  std::int16_t status = 0;
  EXPECT_EQ(qel_open_attribute_record(db.handle, second, &status), 0);
  EXPECT_EQ(status, -9) << "a failed open reports the forced result as its status";

  faults.Add({.call = "qel_set_string_attribute", .attribute = "@Class="});
  faults.Add({.call = "execute_internal_command", .attribute = "regen", .times = -1});
  EXPECT_EQ(qel_set_string_attribute(record, "@type=", "b"), 1);
  EXPECT_EQ(qel_set_string_attribute(record, "@Class=", "HRSection"), 0);
  EXPECT_EQ(Run("redraw_all"), 1);
  for (int i = 0; i < 3; ++i) EXPECT_EQ(Run("regen"), 0);
  EXPECT_TRUE(faults.Armed()) << "a rule of negative times stays until cleared";
  faults.Clear();
  EXPECT_EQ(Run("regen"), 1);
  EXPECT_EQ(Log().Names(Kind::AttributeWrite), std::vector<std::string>{"@type="});
  EXPECT_EQ(Log().Names(Kind::Command), (std::vector<std::string>{"redraw_all", "regen"}));

  char* copy = log_str_dup_new("text", "Test", 1);
  faults.FailNext("log_free");
  log_free(copy);
  EXPECT_EQ(Session().Memory().Outstanding(), 1) << "a failed release keeps the memory";
  log_free(copy);
}
