// Saving and opening drawings: everything comes back, files are reproducible and opening leaves
// them as they were.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <cmath>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeBulkDrawing;
using drawing_file_samples::MakeDrawingWithEverything;
using drawing_file_samples::ReadBytes;
using drawing_file_samples::ScratchFolder;

class DrawingFileRoundTrip : public ::testing::Test {
 protected:
  ScratchFolder folder_;
};

TEST_F(DrawingFileRoundTrip, EveryKindOfContentComesBack) {
  const wb::Drawing original = MakeDrawingWithEverything();
  wb::SaveDrawingFile(original, folder_ / "house.pdx");
  const wb::Drawing opened = wb::OpenDrawingFile(folder_ / "house.pdx");

  EXPECT_EQ(opened, original);
  ASSERT_EQ(opened.slots.size(), original.slots.size());
  EXPECT_EQ(opened.NextHandle(), 19);
  EXPECT_EQ(opened.LiveCount(), 15U);
  EXPECT_FALSE(opened.slots[1].Alive());
  EXPECT_FALSE(opened.slots[16].Alive());
  EXPECT_FALSE(opened.slots[17].Alive());
  EXPECT_EQ(opened.title, original.title);
  EXPECT_EQ(opened.layers[3].name, "");
  EXPECT_FALSE(opened.layers[255].on);
  EXPECT_TRUE(opened.layers[254].on);

  const wb::Entity* element = opened.Find(12);
  ASSERT_NE(element, nullptr);
  EXPECT_EQ(element->configPath, "/srv/library/Cameras");
  EXPECT_EQ(element->elementName, "Camera 1");
  ASSERT_EQ(element->attributes.size(), 10U);
  EXPECT_EQ(element->attributes[2].type, wb::AttributeType::Float);
  EXPECT_EQ(element->attributes[2].format, 3);
  EXPECT_TRUE(std::signbit(element->attributes[3].floatValue));
  EXPECT_TRUE(std::isinf(element->attributes[4].floatValue));
  EXPECT_EQ(element->attributes[8].longs.front(), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(element->attributes[9].text.size(), 15U);
  EXPECT_EQ(wb::ReadRecord<host::ElementRecord>(*element).placement[12], 12.0F);

  const wb::Entity* placed = opened.Find(15);
  ASSERT_NE(placed, nullptr);
  EXPECT_EQ(wb::ReadRecord<host::PlacedBlockRecord>(*placed).block, 14);
  EXPECT_EQ(wb::ReadRecord<host::PlacedBlockRecord>(*placed).placement[12], 250.0);
  EXPECT_EQ(opened.Find(13)->members, (std::vector<host::EntityHandle>{1, 3, 12}));
  EXPECT_TRUE(opened.Find(3)->Hidden());
  EXPECT_TRUE(opened.Find(10)->record.empty());
}

TEST_F(DrawingFileRoundTrip, EmptyAndLargeDrawingsComeBack) {
  const wb::Drawing empty;
  wb::SaveDrawingFile(empty, folder_ / "empty.pdx");
  const wb::Drawing openedEmpty = wb::OpenDrawingFile(folder_ / "empty.pdx");
  EXPECT_EQ(openedEmpty, empty);
  EXPECT_EQ(openedEmpty.NextHandle(), 1);
  EXPECT_EQ(openedEmpty.layers[7].name, "Layer 8");

  const wb::Drawing bulk = MakeBulkDrawing(20000, 11);
  wb::SaveDrawingFile(bulk, folder_ / "bulk.pdx");
  const wb::Drawing openedBulk = wb::OpenDrawingFile(folder_ / "bulk.pdx");
  EXPECT_EQ(openedBulk, bulk);
  EXPECT_EQ(openedBulk.NextHandle(), bulk.NextHandle());
}

TEST_F(DrawingFileRoundTrip, SavingAnOpenedDrawingGivesTheSameBytes) {
  for (const wb::Drawing& original : {MakeDrawingWithEverything(), MakeBulkDrawing(3000, 5)}) {
    wb::SaveDrawingFile(original, folder_ / "first.pdx");
    const std::vector<std::uint8_t> first = ReadBytes(folder_ / "first.pdx");
    const wb::Drawing opened = wb::OpenDrawingFile(folder_ / "first.pdx");
    wb::SaveDrawingFile(opened, folder_ / "second.pdx");
    EXPECT_EQ(ReadBytes(folder_ / "second.pdx"), first);
    // Saving over itself too: nothing in the file depends on when or where it was written.
    wb::SaveDrawingFile(opened, folder_ / "first.pdx");
    EXPECT_EQ(ReadBytes(folder_ / "first.pdx"), first);
  }
}

TEST_F(DrawingFileRoundTrip, OpeningChangesNothing) {
  const std::filesystem::path file = folder_ / "house.pdx";
  wb::SaveDrawingFile(MakeDrawingWithEverything(), file);
  std::filesystem::remove(folder_ / "house.pdx.bak");
  struct stat before {};
  ASSERT_EQ(stat(file.c_str(), &before), 0);
  const std::vector<std::uint8_t> bytes = ReadBytes(file);

  wb::OpenDrawingFile(file);
  wb::OpenDrawingFile(file);

  struct stat after {};
  ASSERT_EQ(stat(file.c_str(), &after), 0);
  EXPECT_EQ(after.st_mtim.tv_sec, before.st_mtim.tv_sec);
  EXPECT_EQ(after.st_mtim.tv_nsec, before.st_mtim.tv_nsec);
  EXPECT_EQ(after.st_ino, before.st_ino);
  EXPECT_EQ(ReadBytes(file), bytes);
  // No journal, lock or any other file appears beside it.
  EXPECT_EQ(folder_.Names(), std::vector<std::string>{"house.pdx"});
}

}  // namespace
