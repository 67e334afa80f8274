// The base wrapper: header reads and updates, visibility, classification and the attribute
// family, run through HRUnknown, which keeps every base operation.
#include "model/hr_primitive.h"

#include <functional>

#include "model/hr_unknown.h"
#include "shell/host/qeldll.h"
#include "tests/model/model_fixture.h"

namespace {

class PrimitiveTest : public ModelTest {
 protected:
  // A stored wrapper over a fresh entity of the given type.
  static HRUnknown WrapperOver(host::EntityHandle entity) {
    HRUnknown wrapper;
    wrapper.SetEntity(entity);
    return wrapper;
  }
};

TEST_F(PrimitiveTest, UnknownStartsUnstoredWithZeroHeaderAndNoClassName) {
  const HRUnknown unknown;
  EXPECT_EQ(unknown.GetEntity(), 0);
  EXPECT_FALSE(unknown.IsStored());
  EXPECT_EQ(unknown.GetHeaderByte8(), 0);
  EXPECT_EQ(unknown.GetHeaderByte9(), 0);
  EXPECT_EQ(unknown.GetEntityType(), 0);
  EXPECT_EQ(unknown.GetClassName(), "");
}

TEST_F(PrimitiveTest, StoredOnlyForPositiveHandles) {
  HRUnknown wrapper;
  for (const host::EntityHandle handle : {0, -1, -2147483647}) {
    wrapper.SetEntity(handle);
    EXPECT_FALSE(wrapper.IsStored()) << handle;
  }
  wrapper.SetEntity(1);
  EXPECT_TRUE(wrapper.IsStored());
}

TEST_F(PrimitiveTest, ReadTakesTheHeaderAndHandle) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  Find(entity)->header.bytes[8] = 7;
  Find(entity)->header.bytes[9] = 9;
  Find(entity)->header.bytes[10] = 0x21;
  HRUnknown wrapper;
  EXPECT_EQ(wrapper.Read(entity), 0);
  EXPECT_EQ(wrapper.GetEntity(), entity);
  EXPECT_EQ(wrapper.GetHeaderByte8(), 7);
  EXPECT_EQ(wrapper.GetHeaderByte9(), 9);
  EXPECT_EQ(wrapper.GetFlags(), 0x21);
  EXPECT_EQ(wrapper.GetEntityType(), host::kTypeArc);
}

TEST_F(PrimitiveTest, UnreadableHeaderGivesMinus2AndTakesNoHandle) {
  HRUnknown wrapper;
  EXPECT_EQ(wrapper.Read(42), -2);
  EXPECT_EQ(wrapper.GetEntity(), 0);

  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  FailNext("qel_read_entity_header");
  EXPECT_EQ(wrapper.Read(entity), -2);
  EXPECT_EQ(wrapper.GetEntity(), 0);
}

TEST_F(PrimitiveTest, ArgumentlessOperationsUseTheCurrentDatabase) {
  const host::EntityHandle inFirst = AddEntity(host::kTypeArc);
  wb::Drawing second;
  second.Add(host::kTypeCircle);
  second.Add(host::kTypeSolid);
  const host::DatabaseHandle secondDatabase = Bench().Open(std::move(second));

  HRUnknown wrapper;
  SetCurrentDatabase(secondDatabase);
  EXPECT_EQ(wrapper.Read(2), 0);
  EXPECT_EQ(wrapper.GetEntityType(), host::kTypeSolid);
  EXPECT_EQ(wrapper.Read(Database(), inFirst), 0);
  EXPECT_EQ(wrapper.GetEntityType(), host::kTypeArc);
}

TEST_F(PrimitiveTest, UpdateWritesTheHeaderAndFailsOnlyOnZero) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  HRUnknown wrapper;
  ASSERT_EQ(wrapper.Read(entity), 0);
  wrapper.Hide();
  Find(entity)->header.bytes[10] = 0;
  EXPECT_EQ(wrapper.Update(), 0);
  EXPECT_EQ(Find(entity)->header.bytes[10], host::kFlagHidden);

  FailNext("qel_update_entity_header", 0);
  EXPECT_EQ(wrapper.Update(), -3);
  FailNext("qel_update_entity_header", 5);
  EXPECT_EQ(wrapper.Update(), 0);
  FailNext("qel_update_entity_header", -1);
  EXPECT_EQ(wrapper.Update(), 0);
}

TEST_F(PrimitiveTest, BaseCreateMakesNothingAndBaseDeleteOnlyForgetsTheHandle) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  HRUnknown wrapper = WrapperOver(entity);
  const std::size_t live = Drawing().LiveCount();
  EXPECT_EQ(wrapper.Create(), 0);
  EXPECT_EQ(Drawing().LiveCount(), live);
  EXPECT_EQ(wrapper.Delete(), 0);
  EXPECT_EQ(wrapper.GetEntity(), 0);
  EXPECT_NE(Find(entity), nullptr);
  EXPECT_TRUE(HostCalls().empty());
}

TEST_F(PrimitiveTest, HideAndShowTouchOnlyBitSevenAndRecordTheChange) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  Find(entity)->header.bytes[10] = 0x5A;
  HRUnknown wrapper;
  ASSERT_EQ(wrapper.Read(entity), 0);

  EXPECT_EQ(wrapper.Hide(), 0);
  EXPECT_EQ(wrapper.GetFlags(), 0xDA);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0xDA);
  EXPECT_EQ(wrapper.Show(), 0);
  EXPECT_EQ(wrapper.GetFlags(), 0x5A);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0x5A);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 5}, {-1, -1}, {entity, 5}, {-1, -1}}));

  Find(entity)->header.bytes[10] = 0x7F;
  ASSERT_EQ(wrapper.Read(entity), 0);
  wrapper.Hide();
  wrapper.Show();
  EXPECT_EQ(Find(entity)->header.bytes[10], 0x7F);
}

TEST_F(PrimitiveTest, HideSucceedsAndRecordsTheChangeEvenWhenTheHostRefusesTheHeader) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  HRUnknown wrapper;
  ASSERT_EQ(wrapper.Read(entity), 0);
  FailNext("qel_update_entity_header");
  EXPECT_EQ(wrapper.Hide(), 0);
  EXPECT_EQ(wrapper.GetFlags(), host::kFlagHidden);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 5}, {-1, -1}}));
}

TEST_F(PrimitiveTest, KindFollowsTheEntityType) {
  const std::vector<std::pair<std::uint8_t, std::int16_t>> expected = {
      {1, 2}, {2, 4}, {3, 5}, {4, 7}, {5, 3}, {6, 12}, {7, 12}, {8, 1}, {9, 6}, {10, 9}, {11, 10}, {12, 8},
      {0, 12}, {13, 12}, {255, 12}};
  for (const auto& [type, kind] : expected) {
    HRUnknown wrapper;
    ASSERT_EQ(wrapper.Read(AddEntity(type)), 0);
    EXPECT_EQ(wrapper.GetKind(), kind) << "type " << int{type};
  }
}

TEST_F(PrimitiveTest, LineWithTextBlockIsKindEleven) {
  const host::EntityHandle text = AddEntity(host::kTypeLine);
  AddStringAttribute(text, "tb=", "");
  const host::EntityHandle other = AddEntity(host::kTypeLine);
  AddStringAttribute(other, "tb", "");
  HRUnknown wrapper;
  ASSERT_EQ(wrapper.Read(text), 0);
  EXPECT_EQ(wrapper.GetKind(), 11);
  ASSERT_EQ(wrapper.Read(other), 0);
  EXPECT_EQ(wrapper.GetKind(), 2);
}

// --- The attribute family ------------------------------------------------------------------

TEST_F(PrimitiveTest, StringAttributeNamesReachTheHostWithExactlyOneEqualsSign) {
  const HRUnknown wrapper = WrapperOver(AddEntity(host::kTypeGroup));
  EXPECT_EQ(wrapper.SetStringAttribute("@Class", "first"), 0);
  EXPECT_EQ(wrapper.SetStringAttribute("@Class=", "second"), 0);
  EXPECT_EQ(wrapper.SetStringAttribute("@Class==", "third"), 0);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@Class=", "@Class=", "@Class="}));
  ASSERT_EQ(Find(wrapper.GetEntity())->attributes.size(), 1U);
  EXPECT_EQ(StringAttribute(wrapper.GetEntity(), "@Class="), "third");

  for (const char* name : {"@Class", "@Class=", "@Class=="}) {
    std::string text;
    EXPECT_EQ(wrapper.GetStringAttribute(name, text), 0);
    EXPECT_EQ(text, "third") << name;
  }
}

TEST_F(PrimitiveTest, ShortReadsCanonicalNamesButShortWritesPassTheNameUnchanged) {
  const HRUnknown wrapper = WrapperOver(AddEntity(host::kTypeGroup));
  EXPECT_EQ(wrapper.SetShortAttribute("@S2D", 7), 0);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@S2D"}));
  std::int16_t value = 0;
  EXPECT_EQ(wrapper.GetShortAttribute("@S2D", value), -11);  // asks for "@S2D=", which is absent

  EXPECT_EQ(wrapper.SetShortAttribute("@S2D=", 9), 0);
  EXPECT_EQ(wrapper.GetShortAttribute("@S2D", value), 0);
  EXPECT_EQ(value, 9);
}

TEST_F(PrimitiveTest, VectorOperationsPassNameAndArgumentsUnchanged) {
  const host::EntityHandle entity = AddEntity(host::kTypeGroup);
  const HRUnknown wrapper = WrapperOver(entity);
  const std::int32_t longs[3] = {4, -5, 6};
  float floats[2] = {1.5F, -2.25F};
  EXPECT_EQ(wrapper.SetLongVectorAttribute("@list", 3, longs), 0);
  EXPECT_EQ(wrapper.SetFloatVectorAttribute("@dir=", floats, 2), 0);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@list", "@dir="}));
  EXPECT_EQ(AttributeOf(entity, "@list")->longs, (std::vector<std::int32_t>{4, -5, 6}));
  EXPECT_EQ(AttributeOf(entity, "@dir=")->floats, (std::vector<float>{1.5F, -2.25F}));
  EXPECT_EQ(AttributeOf(entity, "@dir=")->format, 6);
  EXPECT_EQ(floats[0], 1.5F);

  std::int32_t count = 0;
  std::int32_t* hostLongs = nullptr;
  EXPECT_EQ(wrapper.ReadLongVectorAttribute("@list", &count, &hostLongs), 0);
  ASSERT_EQ(count, 3);
  EXPECT_EQ(hostLongs[1], -5);
  log_free(hostLongs);
  EXPECT_EQ(wrapper.ReadLongVectorAttribute("@list=", &count, &hostLongs), -11);

  float* hostFloats = nullptr;
  EXPECT_EQ(wrapper.ReadFloatVectorAttribute("@dir=", &count, &hostFloats), 0);
  ASSERT_EQ(count, 2);
  EXPECT_EQ(hostFloats[1], -2.25F);
  log_free(hostFloats);
  EXPECT_EQ(wrapper.ReadFloatVectorAttribute("@dir", &count, &hostFloats), -11);
}

TEST_F(PrimitiveTest, RemoveAttributePassesTheNameUnchanged) {
  const host::EntityHandle entity = AddEntity(host::kTypeGroup);
  AddStringAttribute(entity, "@CamLst", "x");
  AddStringAttribute(entity, "@CamLst=", "y");
  const HRUnknown wrapper = WrapperOver(entity);
  EXPECT_EQ(wrapper.RemoveAttribute("@CamLst"), 0);
  EXPECT_EQ(AttributeOf(entity, "@CamLst"), nullptr);
  EXPECT_NE(AttributeOf(entity, "@CamLst="), nullptr);
  EXPECT_EQ(wrapper.RemoveAttribute("@CamLst"), -11);
}

// Each member of the family, run against one stored entity.
struct FamilyCall {
  const char* hostCall;
  std::int16_t failure;
  std::function<std::int16_t(const HRPrimitive&)> run;
};

std::vector<FamilyCall> FamilyCalls() {
  static const std::int32_t longs[1] = {1};
  static const float floats[1] = {1.0F};
  return {
      {"qel_set_string_attribute", -10, [](const HRPrimitive& p) { return p.SetStringAttribute("@a", "t"); }},
      {"qel_read_string_attribute", -11,
       [](const HRPrimitive& p) {
         std::string text;
         return p.GetStringAttribute("@s", text);
       }},
      {"qel_read_short_attribute", -11,
       [](const HRPrimitive& p) {
         std::int16_t value = 0;
         return p.GetShortAttribute("@n", value);
       }},
      {"qel_set_short_attribute", -11, [](const HRPrimitive& p) { return p.SetShortAttribute("@n=", 1); }},
      {"qel_set_long_vector_attribute", -11,
       [](const HRPrimitive& p) { return p.SetLongVectorAttribute("@l=", 1, longs); }},
      {"qel_set_float_vector_attribute", -11,
       [](const HRPrimitive& p) { return p.SetFloatVectorAttribute("@f=", floats, 1); }},
      {"qel_read_unknown_long_vector", -11,
       [](const HRPrimitive& p) {
         std::int32_t count = 0;
         std::int32_t* list = nullptr;
         const std::int16_t result = p.ReadLongVectorAttribute("@l=", &count, &list);
         log_free(list);
         return result;
       }},
      {"qel_read_unknown_float_vector", -11,
       [](const HRPrimitive& p) {
         std::int32_t count = 0;
         float* list = nullptr;
         const std::int16_t result = p.ReadFloatVectorAttribute("@f=", &count, &list);
         log_free(list);
         return result;
       }},
      {"qel_remove_attribute_from_record", -11, [](const HRPrimitive& p) { return p.RemoveAttribute("@r="); }},
  };
}

class FamilyTest : public PrimitiveTest {
 protected:
  void SetUp() override {
    PrimitiveTest::SetUp();
    entity_ = AddEntity(host::kTypeGroup);
    AddStringAttribute(entity_, "@s=", "text");
    AddStringAttribute(entity_, "@r=", "gone");
    const HRUnknown writer = WrapperOver(entity_);
    const std::int32_t longs[1] = {3};
    const float floats[1] = {2.0F};
    writer.SetShortAttribute("@n=", 4);
    writer.SetLongVectorAttribute("@l=", 1, longs);
    writer.SetFloatVectorAttribute("@f=", floats, 1);
    ClearJournal();
  }
  host::EntityHandle entity_ = 0;
};

TEST_F(FamilyTest, EveryOperationSucceedsOnAStoredEntity) {
  const HRUnknown wrapper = WrapperOver(entity_);
  for (const FamilyCall& call : FamilyCalls()) EXPECT_EQ(call.run(wrapper), 0) << call.hostCall;
}

TEST_F(FamilyTest, EveryOperationGivesMinus9WhenTheRecordDoesNotOpen) {
  const HRUnknown wrapper = WrapperOver(entity_);
  for (const FamilyCall& call : FamilyCalls()) {
    FailNext("qel_open_attribute_record");
    EXPECT_EQ(call.run(wrapper), -9) << call.hostCall;
  }
  const HRUnknown unstored;
  for (const FamilyCall& call : FamilyCalls()) EXPECT_EQ(call.run(unstored), -9) << call.hostCall;
  EXPECT_TRUE(AttributeWrites().empty());
  EXPECT_EQ(Find(entity_)->FindAttribute("@r=")->text, "gone");
}

TEST_F(FamilyTest, EveryFailedHostCallGivesItsCodeAndTheRecordIsClosed) {
  const HRUnknown wrapper = WrapperOver(entity_);
  for (const FamilyCall& call : FamilyCalls()) {
    FailNext(call.hostCall);
    EXPECT_EQ(call.run(wrapper), call.failure) << call.hostCall;
    EXPECT_EQ(Bench().Records().OpenCount(), 0U) << call.hostCall;
  }
}

TEST_F(FamilyTest, StringReadCopiesAndReleasesTheHostText) {
  const HRUnknown wrapper = WrapperOver(entity_);
  std::string text = "before";
  EXPECT_EQ(wrapper.GetStringAttribute("@s", text), 0);
  EXPECT_EQ(text, "text");
  EXPECT_EQ(Bench().Memory().TotalHandedOut(), 1);

  // A host that answers success without a text leaves an empty one, not a crash.
  FailNext("qel_read_string_attribute", 1);
  EXPECT_EQ(wrapper.GetStringAttribute("@s", text), 0);
  EXPECT_EQ(text, "");
}

}  // namespace
