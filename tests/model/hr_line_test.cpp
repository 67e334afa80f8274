// Line wrappers: the line record in the host's narrow form.
#include "model/hr_line.h"

#include "tests/model/model_fixture.h"

namespace {

using LineTest = ModelTest;

std::vector<int> StyleOf(const host::LineRecord& line) { return {line.lineType, line.color, line.width}; }

TEST_F(LineTest, CreateUpdateAndReadCarryTheRecordInTheHostsNarrowForm) {
  HRLine line;
  ASSERT_EQ(line.Create(), 0);
  const host::EntityHandle entity = line.GetEntity();
  EXPECT_EQ(StyleOf(wb::ReadRecord<host::LineRecord>(*Find(entity))), (std::vector<int>{1, 1, 1}));
  line.SetLineType(0x1FF);
  line.SetColor(300);
  line.SetWidth(258);
  line.SetPoints(0.1, 2, 3, 4, 5, 6.000000001);
  line.Hide();
  Find(entity)->header.bytes[10] = 0;
  EXPECT_EQ(line.Update(), 0);
  EXPECT_EQ(Find(entity)->header.bytes[10], host::kFlagHidden);
  const host::LineRecord stored = wb::ReadRecord<host::LineRecord>(*Find(entity));
  EXPECT_EQ(StyleOf(stored), (std::vector<int>{255, 44, 2}));
  EXPECT_EQ(stored.start.x, 0.1F);
  EXPECT_EQ(stored.end.z, 6.0F);

  HRLine read;
  EXPECT_EQ(read.Read(entity), 0);
  EXPECT_EQ((std::vector<int>{read.GetLineType(), read.GetColor(), read.GetWidth()}), (std::vector<int>{255, 44, 2}));
}

}  // namespace
