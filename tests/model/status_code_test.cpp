// Every status code of the entity model, each reached by making one host call fail, and what a
// refused operation leaves behind.
#include <functional>
#include <ostream>

#include "model/hr_block.h"
#include "model/hr_group.h"
#include "model/hr_line.h"
#include "model/hr_placed_block.h"
#include "model/hr_placed_object.h"
#include "model/hr_text.h"
#include "model/hr_unknown.h"
#include "tests/model/model_fixture.h"

namespace {

// A stored wrapper of each class (`member` in `block`, `base` over the group), and out values.
struct Stored {
  HRLine line, member, spare;
  HRText text;
  HRBlock block;
  HRGroup group;
  HRPlacedBlock placed;
  HRPlacedObject object;
  HRUnknown base;
  std::string string;
  std::int16_t value = 0;
  std::int32_t count = 0;
  std::int32_t* longs = nullptr;
};

struct StatusCase {
  const char* call;  // the host call that fails; empty when the input alone is wrong
  std::int32_t answer;
  std::int16_t expected;
  std::function<std::int16_t(Stored&)> run;
  const char* attribute = "";  // narrows the failing call to writes of this attribute
};

void PrintTo(const StatusCase& c, std::ostream* out) { *out << c.call << c.attribute << " -> " << c.expected; }

class StatusCodeTest : public ModelTest, public ::testing::WithParamInterface<StatusCase> {
 public:
  static std::vector<StatusCase> Cases();

 protected:
  void SetUp() override {
    ModelTest::SetUp();
    Stored& s = stored_;
    s.object.SetFile("C:\\sym\\sec01.sym");
    ASSERT_EQ(
        s.line.Create() | s.text.Create() | s.block.Create() | s.group.Create() | s.placed.Create() | s.object.Create(),
        0);
    ASSERT_EQ(s.block.AddMember(s.member), 0);
    ASSERT_EQ(s.base.Read(s.group.GetEntity()), 0);
  }

  // A refused create leaves the wrapper unstored and `leftBehind` new entities in the drawing.
  template <typename Wrapper>
  static std::int16_t RefusedCreate(std::size_t leftBehind = 0) {
    const std::size_t live = Drawing().LiveCount();
    Wrapper wrapper;
    const std::int16_t result = wrapper.Create();
    EXPECT_FALSE(wrapper.IsStored());
    EXPECT_EQ(Drawing().LiveCount(), live + leftBehind);
    return result;
  }

  // A read the host answers with success but without a name leaves the name empty.
  template <typename Wrapper>
  static std::int16_t NamelessRead(host::EntityHandle entity) {
    Wrapper wrapper;
    const std::int16_t result = wrapper.Read(entity);
    EXPECT_EQ(wrapper.GetName(), "");
    return result;
  }

  // A refused delete keeps both the entity and the wrapper's handle.
  static std::int16_t RefusedDelete(HRPrimitive& wrapper) {
    const host::EntityHandle entity = wrapper.GetEntity();
    const std::int16_t result = wrapper.Delete();
    EXPECT_EQ(wrapper.GetEntity(), entity);
    EXPECT_NE(Find(entity), nullptr);
    return result;
  }

  Stored stored_;
};

std::vector<StatusCase> StatusCodeTest::Cases() {
  return {
      // The base wrapper and the attribute family; the base header update fails only on 0.
      {"qel_read_entity_header", 0, -2, [](Stored& s) { return HRUnknown().Read(s.line.GetEntity()); }},
      {"qel_update_entity_header", 0, -3, [](Stored& s) { return s.base.Update(); }},
      {"qel_update_entity_header", 5, 0, [](Stored& s) { return s.base.Update(); }},
      {"qel_open_attribute_record", 0, -9, [](Stored& s) { return s.base.SetStringAttribute("@a", "t"); }},
      {"qel_set_string_attribute", 0, -10, [](Stored& s) { return s.base.SetStringAttribute("@a", "t"); }},
      {"qel_read_string_attribute", 0, -11, [](Stored& s) { return s.base.GetStringAttribute("@r", s.string); }},
      {"qel_read_short_attribute", 0, -11, [](Stored& s) { return s.base.GetShortAttribute("@n", s.value); }},
      {"qel_set_short_attribute", 0, -11, [](Stored& s) { return s.base.SetShortAttribute("@n=", 1); }},
      {"qel_set_long_vector_attribute", 0, -11,
       [](Stored& s) { return s.base.SetLongVectorAttribute("@l=", 1, &s.count); }},
      {"qel_read_unknown_long_vector", 0, -11,
       [](Stored& s) { return s.base.ReadLongVectorAttribute("@l=", &s.count, &s.longs); }},
      {"qel_remove_attribute_from_record", 0, -11, [](Stored& s) { return s.base.RemoveAttribute("@r="); }},
      // Lines and texts; a text's refused header update is not reported.
      {"qel_add_line", 0, -18, [](Stored&) { return RefusedCreate<HRLine>(); }},
      {"qel_read_line", 0, -17, [](Stored& s) { return HRLine().Read(s.line.GetEntity()); }},
      {"qel_update_line", 0, -19, [](Stored& s) { return s.line.Update(); }},
      {"qel_delete_entity", 0, -20, [](Stored& s) { return RefusedDelete(s.line); }},
      {"qel_add_text", 0, -27, [](Stored&) { return RefusedCreate<HRText>(); }},
      {"qel_update_line", 0, -27, [](Stored& s) { return s.text.Update(); }},
      {"qel_open_attribute_record", 0, -9, [](Stored& s) { return s.text.Update(); }},
      {"qel_update_entity_header", 0, 0, [](Stored& s) { return s.text.Update(); }},
      {"", 0, -4, [](Stored& s) { return HRText().Read(s.group.GetEntity()); }},
      {"qel_read_line", 0, -17, [](Stored& s) { return HRText().Read(s.text.GetEntity()); }},
      {"qel_open_attribute_record", 0, -17, [](Stored& s) { return HRText().Read(s.text.GetEntity()); }},
      {"qel_delete_entity", 0, -20, [](Stored& s) { return RefusedDelete(s.text); }},
      // Blocks and their members.
      {"qel_create_block", 0, -5, [](Stored&) { return RefusedCreate<HRBlock>(); }},
      {"qel_read_entity_header", 0, -2, [](Stored&) { return RefusedCreate<HRBlock>(1); }},
      {"qel_read_block", 0, -4, [](Stored& s) { return HRBlock().Read(s.block.GetEntity()); }},
      {"get_whole_vector_of_block_members", 0, -5, [](Stored& s) { return HRBlock().Read(s.block.GetEntity()); }},
      {"qel_update_entity_header", 2, -3, [](Stored& s) { return s.block.Update(); }},
      {"qel_read_block", 1, 0, [](Stored& s) { return NamelessRead<HRBlock>(s.block.GetEntity()); }},
      {"qel_update_block", 0, -6, [](Stored& s) { return s.block.Update(); }},
      {"qel_delete_block", 0, -7, [](Stored& s) { return RefusedDelete(s.block); }},
      {"qel_add_members_to_block", 0, -8, [](Stored& s) { return s.block.AddMember(s.spare); }},
      {"qel_unlink_members_from_block", 0, -21, [](Stored& s) { return s.block.RemoveAndDeleteMember(s.member); }},
      {"qel_unlink_members_from_block", 0, -21, [](Stored& s) { return s.block.DeleteAllMembers(); }},
      {"get_whole_vector_of_block_members", 0, -29, [](Stored& s) { return s.block.UnlinkAllMembers(); }},
      {"qel_delete_entity", 0, -20, [](Stored& s) { return s.block.RemoveAndDeleteMember(s.member); }},
      // Groups.
      {"qel_create_group", 0, -13, [](Stored&) { return RefusedCreate<HRGroup>(); }},
      {"qel_read_entity_header", 0, -2, [](Stored&) { return RefusedCreate<HRGroup>(1); }},
      {"qel_read_group", 0, -4, [](Stored& s) { return HRGroup().Read(s.group.GetEntity()); }},
      {"qel_read_group", 1, 0, [](Stored& s) { return NamelessRead<HRGroup>(s.group.GetEntity()); }},
      {"qel_update_group", 0, -6, [](Stored& s) { return s.group.Update(); }},
      {"qel_delete_group", 0, -7, [](Stored& s) { return RefusedDelete(s.group); }},
      // Placed blocks.
      {"qel_add_placed_block", 0, -25, [](Stored&) { return RefusedCreate<HRPlacedBlock>(); }},
      {"qel_read_placed_block", 0, -24, [](Stored& s) { return HRPlacedBlock().Read(s.placed.GetEntity()); }},
      {"qel_read_placed_block", 1, 0, [](Stored& s) { return NamelessRead<HRPlacedBlock>(s.placed.GetEntity()); }},
      {"qel_update_placed_block", 0, -26, [](Stored& s) { return s.placed.Update(); }},
      // Library elements; the file name write fails only on 0, the folder writes on anything but 1.
      {"qel_add_element", 0, -14, [](Stored&) { return RefusedCreate<HRPlacedObject>(); }},
      {"qel_set_string_attribute", 0, -10, [](Stored&) { return RefusedCreate<HRPlacedObject>(1); }, "URL="},
      {"qel_update_element", 0, -14, [](Stored& s) { return s.object.Update(); }},
      {"qel_open_attribute_record", 0, -14, [](Stored& s) { return s.object.Update(); }},
      {"qel_set_string_attribute", 2, 0, [](Stored& s) { return s.object.Update(); }, "@lfname="},
      {"qel_set_string_attribute", 0, -10, [](Stored& s) { return s.object.Update(); }, "@lfname="},
      {"qel_set_string_attribute", -205, -10, [](Stored& s) { return s.object.Update(); }, "@lib="},
      {"qel_read_element", 0, -4, [](Stored& s) { return HRPlacedObject().Read(s.object.GetEntity()); }},
      {"qel_delete_entity", 0, -16, [](Stored& s) { return RefusedDelete(s.object); }},
  };
}

TEST_P(StatusCodeTest, RefusedHostCallGivesItsCode) {
  const StatusCase& c = GetParam();
  if (*c.call != '\0') FailNext(c.call, c.answer, c.attribute);
  EXPECT_EQ(c.run(stored_), c.expected);
  EXPECT_EQ(Find(stored_.block.GetEntity())->members.size(), stored_.block.GetMemberCount()) << "lists differ";
  EXPECT_FALSE(Bench().GetFaults().Armed()) << "the failing call was never made";
}

INSTANTIATE_TEST_SUITE_P(EveryCode, StatusCodeTest, ::testing::ValuesIn(StatusCodeTest::Cases()));

}  // namespace
