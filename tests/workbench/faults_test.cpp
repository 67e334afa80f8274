// Fault injection: every host call honours an armed rule, and the rules' skip, times, entity
// and name filters pick exactly the calls they describe.
#include <optional>
#include <string>

#include "shell/host/qelinfo.h"
#include "tests/workbench/host_fixture.h"

namespace {

constexpr std::int32_t kForced = 7;

struct Prepared {
  EntityHandle line;
  EntityHandle group;
  EntityHandle block;
  EntityHandle placed;
  EntityHandle element;
  RecordHandle record;
};

// One host call made with usable arguments; answers what the call answered, when it answers a
// status at all.
struct CallCase {
  const char* name;
  std::optional<std::int32_t> (*run)(const Prepared&);
};

// Records the calls read into or write from.
struct Scratch {
  host::LineRecord line;
  host::BlockRecord block;
  host::GroupRecord group;
  host::PlacedBlockRecord placed;
  host::ElementRecord element;
  host::EntityHeader header;
} scratch{};

template <typename Value>
std::optional<std::int32_t> Answer(Value value) {
  return static_cast<std::int32_t>(value);
}

const CallCase kCalls[] = {
    {"qel_read_entity_header",
     [](const Prepared& p) { return Answer(qel_read_entity_header(db.handle, p.line, &scratch.header)); }},
    {"qel_update_entity_header",
     [](const Prepared& p) { return Answer(qel_update_entity_header(db.handle, p.line, &scratch.header)); }},
    {"qel_delete_entity", [](const Prepared& p) { return Answer(qel_delete_entity(db.handle, p.line)); }},
    {"qel_read_line", [](const Prepared& p) { return Answer(qel_read_line(db.handle, p.line, &scratch.line)); }},
    {"qel_update_line", [](const Prepared& p) { return Answer(qel_update_line(db.handle, p.line, &scratch.line)); }},
    {"qel_add_line",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_add_line(db.handle, &e, &scratch.line));
     }},
    {"qel_add_text",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_add_text(db.handle, &e, &scratch.line, "", "t", 1));
     }},
    {"qel_read_block",
     [](const Prepared& p) { return Answer(qel_read_block(db.handle, p.block, &scratch.block, nullptr)); }},
    {"qel_update_block",
     [](const Prepared& p) { return Answer(qel_update_block(db.handle, p.block, &scratch.block)); }},
    {"qel_create_block",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_create_block(db.handle, &e, 0, nullptr, "b", &scratch.block));
     }},
    {"qel_delete_block", [](const Prepared& p) { return Answer(qel_delete_block(db.handle, p.block)); }},
    {"get_whole_vector_of_block_members",
     [](const Prepared& p) {
       EntityHandle* list = nullptr;
       std::int32_t count = 0;
       return Answer(get_whole_vector_of_block_members(db.handle, p.block, &list, &count));
     }},
    {"qel_add_members_to_block",
     [](const Prepared& p) { return Answer(qel_add_members_to_block(db.handle, p.block, 1, &p.group)); }},
    {"qel_unlink_members_from_block",
     [](const Prepared& p) { return Answer(qel_unlink_members_from_block(db.handle, p.block, 1, &p.line)); }},
    {"qel_read_group",
     [](const Prepared& p) { return Answer(qel_read_group(db.handle, p.group, &scratch.group, nullptr)); }},
    {"qel_update_group",
     [](const Prepared& p) { return Answer(qel_update_group(db.handle, p.group, &scratch.group)); }},
    {"qel_create_group",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_create_group(db.handle, &e, 0, nullptr, "g", &scratch.group));
     }},
    {"qel_delete_group", [](const Prepared& p) { return Answer(qel_delete_group(db.handle, p.group)); }},
    {"qel_read_placed_block",
     [](const Prepared& p) { return Answer(qel_read_placed_block(db.handle, p.placed, &scratch.placed, nullptr)); }},
    {"qel_update_placed_block",
     [](const Prepared& p) { return Answer(qel_update_placed_block(db.handle, p.placed, &scratch.placed, 0)); }},
    {"qel_add_placed_block",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_add_placed_block(db.handle, &e, "blk", &scratch.placed));
     }},
    {"qel_read_element",
     [](const Prepared& p) { return Answer(qel_read_element(db.handle, p.element, &scratch.element)); }},
    {"qel_update_element",
     [](const Prepared& p) { return Answer(qel_update_element(db.handle, p.element, &scratch.element)); }},
    {"qel_add_element",
     [](const Prepared&) {
       EntityHandle e = 0;
       return Answer(qel_add_element(db.handle, &e, &scratch.element, 0));
     }},
    {"qel_get_config_path",
     [](const Prepared& p) { return Answer(qel_get_config_path(db.handle, p.element) == nullptr ? kForced : 0); }},
    {"qel_get_element_name",
     [](const Prepared& p) {
       return Answer(qel_get_element_name(db.handle, p.element, "s") == nullptr ? kForced : 0);
     }},
    {"qel_get_short_name",
     [](const Prepared&) {
       char buffer[9];
       return Answer(qel_get_short_name("file.sym", buffer) == nullptr ? kForced : 0);
     }},
    {"qel_open_attribute_record",
     [](const Prepared& p) {
       std::int16_t status = 0;
       const RecordHandle record = qel_open_attribute_record(db.handle, p.line, &status);
       return Answer(record == 0 ? status : 0);
     }},
    {"qel_close_attribute_record",
     [](const Prepared& p) { return Answer(qel_close_attribute_record(db.handle, p.record)); }},
    {"qel_set_string_attribute",
     [](const Prepared& p) { return Answer(qel_set_string_attribute(p.record, "s=", "x")); }},
    {"qel_read_string_attribute",
     [](const Prepared& p) {
       char* t = nullptr;
       return Answer(qel_read_string_attribute(p.record, "s=", &t));
     }},
    {"qel_set_short_attribute", [](const Prepared& p) { return Answer(qel_set_short_attribute(p.record, "h=", 1)); }},
    {"qel_read_short_attribute",
     [](const Prepared& p) {
       std::int16_t v = 0;
       return Answer(qel_read_short_attribute(p.record, "h=", &v));
     }},
    {"qel_set_float_attribute",
     [](const Prepared& p) { return Answer(qel_set_float_attribute(p.record, "f=", 1.0F, 0)); }},
    {"qel_read_float_attribute",
     [](const Prepared& p) {
       float v = 0;
       return Answer(qel_read_float_attribute(p.record, "f=", &v));
     }},
    {"qel_set_float_vector_attribute",
     [](const Prepared& p) {
       const float v[1] = {1};
       return Answer(qel_set_float_vector_attribute(p.record, "fv=", v, 1, 6));
     }},
    {"qel_read_fixed_float_vector",
     [](const Prepared& p) {
       float v[1];
       return Answer(qel_read_fixed_float_vector(p.record, "fv=", v, 1));
     }},
    {"qel_read_fixed_short_vector",
     [](const Prepared& p) {
       std::int16_t v[1];
       return Answer(qel_read_fixed_short_vector(p.record, "hv=", v, 1));
     }},
    {"qel_set_short_vector_attribute",
     [](const Prepared& p) {
       const std::int16_t v[1] = {1};
       return Answer(qel_set_short_vector_attribute(p.record, "hv=", v, 1));
     }},
    {"qel_read_unknown_short_vector",
     [](const Prepared& p) {
       std::int32_t n = 0;
       std::int16_t* v = nullptr;
       return Answer(qel_read_unknown_short_vector(p.record, "hv=", &n, &v));
     }},
    {"qel_set_long_vector_attribute",
     [](const Prepared& p) {
       const std::int32_t v[1] = {1};
       return Answer(qel_set_long_vector_attribute(p.record, "lv=", 1, v));
     }},
    {"qel_read_unknown_long_vector",
     [](const Prepared& p) {
       std::int32_t n = 0;
       std::int32_t* v = nullptr;
       return Answer(qel_read_unknown_long_vector(p.record, "lv=", &n, &v));
     }},
    {"qel_read_unknown_float_vector",
     [](const Prepared& p) {
       std::int32_t n = 0;
       float* v = nullptr;
       return Answer(qel_read_unknown_float_vector(p.record, "fv=", &n, &v));
     }},
    {"qel_remove_attribute_from_record",
     [](const Prepared& p) { return Answer(qel_remove_attribute_from_record(p.record, "s=")); }},
    {"is_attribute_exist", [](const Prepared& p) { return Answer(is_attribute_exist(db.handle, p.line, "s=")); }},
    {"loop_on_database",
     [](const Prepared&) {
       EntityHandle e = 0;
       std::int32_t c = 0;
       return Answer(loop_on_database(db.handle, &e, &c));
     }},
    {"loop_on_database_blank",
     [](const Prepared&) {
       EntityHandle e = 0;
       std::int32_t c = 0;
       return Answer(loop_on_database_blank(db.handle, &e, &c));
     }},
    {"loop_on_database_blank_h",
     [](const Prepared&) {
       EntityHandle e = 0;
       std::int32_t c = 0;
       return Answer(loop_on_database_blank_h(db.handle, &e, &c, &scratch.header));
     }},
    {"write_to_record",
     [](const Prepared& p) {
       write_to_record(p.line, 5);
       return std::optional<std::int32_t>{};
     }},
    {"execute_internal_command", [](const Prepared&) { return Answer(execute_internal_command("redraw_all")); }},
    {"execute_quorvel_overlay", [](const Prepared&) { return Answer(execute_quorvel_overlay("Pandex")); }},
    {"CommandMessage",
     [](const Prepared&) {
       CommandMessage("/3secadd");
       return std::optional<std::int32_t>{};
     }},
    {"log_free",
     [](const Prepared&) {
       log_free(nullptr);
       return std::optional<std::int32_t>{};
     }},
    {"log_str_dup_new",
     [](const Prepared&) { return Answer(log_str_dup_new("x", "Test", 1) == nullptr ? kForced : 0); }},
    {"g32d",
     [](const Prepared&) {
       const float points[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
       float matrix[16];
       std::int32_t status = 0;
       g32d(points, matrix, &status);
       return Answer(status);
     }},
    {"distance_3d",
     [](const Prepared&) {
       const host::Point3f a{0, 0, 0}, b{1, 0, 0};
       return Answer(distance_3d(&a, &b));
     }},
    {"iskanji_string", [](const Prepared&) { return Answer(iskanji_string("abc")); }},
    {"SetCameraManagerOn",
     [](const Prepared&) {
       SetCameraManagerOn();
       return std::optional<std::int32_t>{};
     }},
    {"SetCameraManagerOff",
     [](const Prepared&) {
       SetCameraManagerOff();
       return std::optional<std::int32_t>{};
     }},
};

}  // namespace

class EveryHostCall : public HostTest, public ::testing::WithParamInterface<CallCase> {};

TEST_P(EveryHostCall, AnArmedFaultFailsItAndChangesNothing) {
  Prepared p{};
  p.line = AddLine();
  p.group = AddGroup();
  EntityHandle members[] = {p.line};
  ASSERT_EQ(qel_create_block(db.handle, &p.block, 1, members, "blk", &scratch.block), 1);
  ASSERT_EQ(qel_add_placed_block(db.handle, &p.placed, "blk", &scratch.placed), 1);
  ASSERT_EQ(qel_add_element(db.handle, &p.element, &scratch.element, 0), 1);
  p.record = OpenRecord(p.line);
  const wb::Drawing before = Current();
  const std::size_t journaled = Log().Entries().size();
  const bool managerOn = Session().CameraManagerOn();

  Session().GetFaults().FailNext(GetParam().name, kForced);
  const std::optional<std::int32_t> answer = GetParam().run(p);

  EXPECT_FALSE(Session().GetFaults().Armed()) << "the call asked for its fault";
  if (answer) {
    EXPECT_EQ(*answer, kForced);
  }
  EXPECT_EQ(Current(), before);
  EXPECT_EQ(Log().Entries().size(), journaled);
  EXPECT_EQ(Session().CameraManagerOn(), managerOn);
  EXPECT_EQ(Session().Memory().Outstanding(), 0);
  EXPECT_EQ(Session().Records().OpenCount(), 1U);
}

INSTANTIATE_TEST_SUITE_P(Qeldll, EveryHostCall, ::testing::ValuesIn(kCalls),
                         [](const ::testing::TestParamInfo<CallCase>& call) {
                           std::string name;
                           for (const char* c = call.param.name; *c != '\0'; ++c) {
                             if (*c != '_') name += *c;
                           }
                           return name;
                         });

using FaultRules = HostTest;

TEST_F(FaultRules, SkipLetsCallsPassThenTimesFailsThatMany) {
  const EntityHandle entity = AddLine();
  wb::FaultRule rule;
  rule.call = "qel_read_entity_header";
  rule.skip = 1;
  rule.times = 2;
  rule.result = -4;
  Session().GetFaults().Add(rule);
  host::EntityHeader header{};
  std::vector<Status> answers;
  for (int i = 0; i < 4; ++i) answers.push_back(qel_read_entity_header(db.handle, entity, &header));
  EXPECT_EQ(answers, (std::vector<Status>{1, -4, -4, 1}));
  EXPECT_FALSE(Session().GetFaults().Armed());
}

TEST_F(FaultRules, NegativeTimesFailsEveryCallUntilCleared) {
  wb::FaultRule rule;
  rule.call = "execute_internal_command";
  rule.times = -1;
  Session().GetFaults().Add(rule);
  for (int i = 0; i < 5; ++i) EXPECT_EQ(execute_internal_command("redraw_all"), 0);
  EXPECT_TRUE(Session().GetFaults().Armed());
  Session().GetFaults().Clear();
  EXPECT_EQ(execute_internal_command("redraw_all"), 1);
  EXPECT_EQ(Log().Names(wb::JournalEntry::Kind::Command), (std::vector<std::string>{"redraw_all"}));
}

TEST_F(FaultRules, EntityRulesFailOnlyThatEntity) {
  const EntityHandle first = AddLine();
  const EntityHandle second = AddLine();
  wb::FaultRule rule;
  rule.call = "qel_open_attribute_record";
  rule.entity = second;
  rule.result = -9;
  Session().GetFaults().Add(rule);
  std::int16_t status = 0;
  EXPECT_NE(qel_open_attribute_record(db.handle, first, &status), 0);
  EXPECT_EQ(status, 1);
  EXPECT_EQ(qel_open_attribute_record(db.handle, second, &status), 0);
  EXPECT_EQ(status, -9) << "a failed open reports the forced result as its status";
}

TEST_F(FaultRules, AttributeRulesFailOnlyThatNameAndWriteNothing) {
  const EntityHandle entity = AddGroup();
  wb::FaultRule rule;
  rule.call = "qel_set_string_attribute";
  rule.attribute = "@Class=";
  Session().GetFaults().Add(rule);
  const RecordHandle record = OpenRecord(entity);
  EXPECT_EQ(qel_set_string_attribute(record, "@type=", "b"), 1);
  EXPECT_EQ(qel_set_string_attribute(record, "@Class=", "HRSection"), 0);
  EXPECT_EQ(Current().Find(entity)->FindAttribute("@Class="), nullptr);
  EXPECT_EQ(Log().Names(wb::JournalEntry::Kind::AttributeWrite), (std::vector<std::string>{"@type="}));
}

TEST_F(FaultRules, CommandRulesMatchTheCommandText) {
  wb::FaultRule rule;
  rule.call = "execute_internal_command";
  rule.attribute = "set_vsect_plane";
  Session().GetFaults().Add(rule);
  EXPECT_EQ(execute_internal_command("redraw_all"), 1);
  EXPECT_EQ(execute_internal_command("set_vsect_plane"), 0);
  EXPECT_EQ(Log().Names(wb::JournalEntry::Kind::Command), (std::vector<std::string>{"redraw_all"}));
}

TEST_F(FaultRules, TheFirstRuleAddedDecidesAndEachIsSpentInTurn) {
  Session().GetFaults().FailNext("loop_on_database", -1);
  Session().GetFaults().FailNext("loop_on_database", -2);
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  EXPECT_EQ(loop_on_database(db.handle, &entity, &cursor), -1);
  EXPECT_EQ(loop_on_database(db.handle, &entity, &cursor), -2);
  EXPECT_EQ(loop_on_database(db.handle, &entity, &cursor), 0) << "an empty drawing ends the walk";
}

TEST_F(FaultRules, FailedReleaseLeavesTheMemoryOutstanding) {
  char* copy = log_str_dup_new("text", "Test", 1);
  Session().GetFaults().FailNext("log_free");
  log_free(copy);
  EXPECT_EQ(Session().Memory().Outstanding(), 1);
  log_free(copy);
  EXPECT_EQ(Session().Memory().Outstanding(), 0);
  EXPECT_EQ(Session().Memory().BadReleases(), 0);
}
