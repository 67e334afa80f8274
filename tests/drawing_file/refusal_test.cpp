// Files that are not whole drawings are refused with one line that says why and names the file.
#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <string>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeDrawingWithEverything;
using drawing_file_samples::ReadBytes;
using drawing_file_samples::ScratchFolder;
using drawing_file_samples::WriteBytes;
using Reason = wb::DrawingFileError::Reason;

// Runs SQL on a drawing file with a plain SQLite connection, as another program would.
void RunSql(const std::filesystem::path& file, const std::string& sql) {
  sqlite3* database = nullptr;
  ASSERT_EQ(sqlite3_open(file.c_str(), &database), SQLITE_OK);
  char* error = nullptr;
  EXPECT_EQ(sqlite3_exec(database, sql.c_str(), nullptr, nullptr, &error), SQLITE_OK) << (error ? error : "");
  sqlite3_free(error);
  sqlite3_close(database);
}

class DrawingFileRefusal : public ::testing::Test {
 protected:
  void SetUp() override { wb::SaveDrawingFile(MakeDrawingWithEverything(), file_); }

  // Opens the file, expecting a refusal for the reason with `fragment` in its one-line message.
  void ExpectRefused(const std::filesystem::path& path, Reason reason, const std::string& fragment) {
    try {
      wb::OpenDrawingFile(path);
      ADD_FAILURE() << "opened " << path;
    } catch (const wb::DrawingFileError& error) {
      const std::string message = error.what();
      EXPECT_EQ(error.GetReason(), reason) << message;
      EXPECT_NE(message.find(path.string()), std::string::npos) << message;
      EXPECT_NE(message.find(fragment), std::string::npos) << message;
      EXPECT_EQ(message.find('\n'), std::string::npos) << message;
    }
  }

  // The saved drawing's bytes with a change.
  std::filesystem::path Variant(const std::string& name, void (*change)(std::vector<std::uint8_t>&)) {
    std::vector<std::uint8_t> bytes = ReadBytes(file_);
    change(bytes);
    WriteBytes(folder_ / name, bytes);
    return folder_ / name;
  }

  ScratchFolder folder_;
  const std::filesystem::path file_ = folder_ / "house.pdx";
};

TEST_F(DrawingFileRefusal, ThingsThatAreNoFileAtAll) {
  ExpectRefused(folder_ / "missing.pdx", Reason::CannotRead,
                "cannot open drawing file " + (folder_ / "missing.pdx").string() + ": No such file or directory");
  ExpectRefused(folder_.Path(), Reason::CannotRead, "it is a folder");
  ASSERT_EQ(mkfifo((folder_ / "pipe.pdx").c_str(), 0600), 0);
  ExpectRefused(folder_ / "pipe.pdx", Reason::CannotRead, "it is not a regular file");
}

TEST_F(DrawingFileRefusal, FilesOfOtherKinds) {
  WriteBytes(folder_ / "empty.pdx", {});
  ExpectRefused(folder_ / "empty.pdx", Reason::NotADrawing,
                "not a Pandex drawing file: " + (folder_ / "empty.pdx").string() + " (the file is empty)");
  const std::string text = "Cameras:\n  Camera 1\n";
  WriteBytes(folder_ / "notes.pdx", {text.begin(), text.end()});
  ExpectRefused(folder_ / "notes.pdx", Reason::NotADrawing, "not a Pandex drawing file");
  RunSql(folder_ / "other.db", "CREATE TABLE drawing(title TEXT); INSERT INTO drawing VALUES('x')");
  ExpectRefused(folder_ / "other.db", Reason::NotADrawing, "(a database of another program)");
}

TEST_F(DrawingFileRefusal, HugeFilesAreJudgedByTheirHeaderBeforeBeingRead) {
  // Sparse files: they take no disk, but reading one whole would take 64 GB of memory.
  constexpr std::uintmax_t kHuge = std::uintmax_t{64} << 30;
  const std::string text = "just text";
  WriteBytes(folder_ / "huge.txt", {text.begin(), text.end()});
  std::filesystem::resize_file(folder_ / "huge.txt", kHuge);
  ExpectRefused(folder_ / "huge.txt", Reason::NotADrawing, "not a Pandex drawing file");
  std::filesystem::copy_file(file_, folder_ / "huge.pdx");
  std::filesystem::resize_file(folder_ / "huge.pdx", kHuge);
  ExpectRefused(folder_ / "huge.pdx", Reason::Damaged, "(its size does not match its header)");
}

TEST_F(DrawingFileRefusal, FormatsOfOtherVersions) {
  std::filesystem::copy_file(file_, folder_ / "newer.pdx");
  RunSql(folder_ / "newer.pdx", "PRAGMA user_version = 2");
  ExpectRefused(folder_ / "newer.pdx", Reason::NewerVersion,
                "drawing file is from a newer version of Pandex: " + (folder_ / "newer.pdx").string() +
                    " (format 2; this version reads format 1)");
  std::filesystem::copy_file(file_, folder_ / "unknown.pdx");
  RunSql(folder_ / "unknown.pdx", "PRAGMA user_version = 0");
  ExpectRefused(folder_ / "unknown.pdx", Reason::Damaged, "(unknown format 0)");
}

TEST_F(DrawingFileRefusal, CutOffAndGrownFiles) {
  const std::size_t size = ReadBytes(file_).size();
  ExpectRefused(Variant("half.pdx", [](auto& b) { b.resize(b.size() / 2); }), Reason::Damaged,
                "(it is cut off after " + std::to_string(size / 2) + " of " + std::to_string(size) + " bytes)");
  ExpectRefused(Variant("one-short.pdx", [](auto& b) { b.pop_back(); }), Reason::Damaged, "it is cut off");
  ExpectRefused(Variant("header-only.pdx", [](auto& b) { b.resize(60); }), Reason::Damaged,
                "(it is cut off in its header)");
  ExpectRefused(Variant("grown.pdx", [](auto& b) { b.insert(b.end(), 4096, 0); }), Reason::Damaged,
                "(its size does not match its header)");
}

TEST_F(DrawingFileRefusal, DamagedHeadersAndPages) {
  ExpectRefused(Variant("wal.pdx", [](auto& b) { b[18] = b[19] = 2; }), Reason::Damaged, "its header is damaged");
  ExpectRefused(Variant("utf16.pdx", [](auto& b) { b[59] = 2; }), Reason::Damaged, "its header is damaged");
  ExpectRefused(Variant("page-size.pdx", [](auto& b) { b[16] = 0x30; }), Reason::Damaged, "its header is damaged");
  // Garbage over the last page, which holds entity rows.
  ExpectRefused(Variant("garbage.pdx", [](auto& b) { std::fill(b.end() - 4096, b.end(), 0x5A); }), Reason::Damaged,
                "drawing file is damaged");
  // A b-tree page that points at itself as its own child.
  ExpectRefused(Variant("loop.pdx",
                        [](auto& b) {
                          std::fill(b.begin() + 4096, b.begin() + 8192, 0);
                          b[4096] = 0x05;  // interior table page without cells, right child page 2
                          b[4096 + 11] = 2;
                        }),
                Reason::Damaged, "drawing file is damaged");
}

// A drawing file changed with SQL by another program: still a sound SQLite database, but not a
// drawing the host could work on.
struct Tampering {
  const char* name;
  std::string sql;
  const char* expected;
};

void PrintTo(const Tampering& tampering, std::ostream* out) { *out << tampering.sql; }

class DrawingFileTampering : public DrawingFileRefusal, public ::testing::WithParamInterface<Tampering> {};

TEST_P(DrawingFileTampering, IsRefusedAsDamaged) {
  RunSql(file_, GetParam().sql);
  ExpectRefused(file_, Reason::Damaged, GetParam().expected);
}

// SQL that sets an entity's details to empty names and then the given hex bytes: the member
// count and handles, then the attribute count and attributes.
std::string SetDetails(host::EntityHandle entity, const std::string& hex) {
  const std::string emptyNames = "000000000000000000000000";
  return "UPDATE entities SET details = x'" + emptyNames + hex + "' WHERE handle = " + std::to_string(entity);
}

// In the sample: 1 line, 2 deleted, 3 text, 12 element, 13 group of 1, 3 and 12, 14 block of 11,
// 15 placed block of 14.
const Tampering kTamperings[] = {
    {"HeaderOfWrongSize", "UPDATE entities SET header = x'0102' WHERE handle = 1", "entity 1: its header has 2 bytes"},
    {"HeaderOfWrongKind", "UPDATE entities SET header = 'text' WHERE handle = 1",
     "entity 1: the wrong kind of value in its header"},
    {"DetailsOfWrongKind", "UPDATE entities SET details = 12 WHERE handle = 13",
     "entity 13: the wrong kind of value in its details"},
    {"HandleMissing", "DELETE FROM entities WHERE handle = 4", "handles do not count up from 1: 5 where 4 belongs"},
    {"HandleZero", "INSERT INTO entities(handle, header) VALUES(0, zeroblob(18))", "0 where 1 belongs"},
    {"DeletedSlotWithRecord", "UPDATE entities SET record = x'00' WHERE handle = 2", "entity 2: deleted, yet it holds"},
    {"DeletedSlotWithDetails", "UPDATE entities SET details = x'00' WHERE handle = 17", "entity 17: deleted, yet"},
    {"LineRecordOfWrongSize", "UPDATE entities SET record = x'00' WHERE handle = 1",
     "entity 1 has a record of 1 bytes where its type takes 28"},
    {"UnknownAttributeType", SetDetails(3, "00000000" "01000000" "02000000613d090000"),
     "entity 3: attribute 1 has the unknown type 9"},
    {"AttributeCutShort", SetDetails(3, "00000000" "01000000" "0500000061"), "entity 3: its details are cut short"},
    {"ForgedNameLength", "UPDATE entities SET details = x'f0ffffff41' WHERE handle = 3",
     "its details are cut short"},
    {"ForgedTextLength", SetDetails(3, "00000000" "01000000" "02000000613d010000f0ffffff41"),
     "its details are cut short"},
    {"ForgedVectorCount", SetDetails(3, "00000000" "01000000" "02000000613d060000ffffff7f01000000"),
     "its details are cut short"},
    {"MemberOutOfRange", SetDetails(13, "01000000e8030000" "00000000"), "entity 13 lists the member 1000"},
    {"MemberListCutShort", SetDetails(13, "02000000010000"), "entity 13: its details are cut short"},
    {"ForgedAttributeCount", SetDetails(3, "00000000" "ffffff7f"), "entity 3: its details are cut short"},
    {"DetailsRunningOn", SetDetails(3, "00000000" "00000000" "00"), "entity 3: its details run on past their end"},
    {"GroupInItself", SetDetails(13, "02000000010000000d000000" "00000000"), "entity 13 contains itself"},
    {"BlockPlacingItself", SetDetails(14, "010000000f000000" "00000000"), "contains itself"},
    {"PlacedBlockOutOfRange",
     "UPDATE entities SET record = x'" + std::string(272, '0') + "0f270000" + std::string(8, '0') +
         "' WHERE handle = 15",
     "entity 15 places the block 9999"},
    {"LayerMissing", "DELETE FROM layers WHERE layer_index = 7", "the layer table does not hold layers 1 to 256"},
    {"LayerExtra", "INSERT INTO layers VALUES(256, 'extra', 1)", "the layer table does not hold layers 1 to 256"},
    {"LayerNeitherOnNorOff", "UPDATE layers SET is_on = 5 WHERE layer_index = 0", "layer 1 is neither on nor off"},
    {"LayerNameOfWrongKind", "UPDATE layers SET name = x'41' WHERE layer_index = 2", "layer 3 has no name"},
    {"TitleMissing", "DELETE FROM drawing", "the drawing has no title"},
    {"TwoTitles", "INSERT INTO drawing VALUES('second')", "the drawing has more than one title"},
    {"ForeignView", "CREATE VIEW extra AS SELECT 1", "it holds tables that are not a drawing's"},
    {"EndlessViewInPlaceOfTable",
     "DROP TABLE layers; CREATE VIEW layers AS WITH RECURSIVE n(i) AS (SELECT 0 UNION ALL SELECT i + 1 FROM n) "
     "SELECT i AS layer_index, 'x' AS name, 1 AS is_on FROM n",
     "it holds tables that are not a drawing's"},
    {"Trigger", "CREATE TRIGGER t AFTER INSERT ON drawing BEGIN SELECT 1; END", "not a drawing's"},
    {"Index", "CREATE INDEX by_record ON entities(record)", "not a drawing's"},
    {"ColumnAdded", "ALTER TABLE entities ADD COLUMN extra", "not a drawing's"},
    {"TableDropped", "DROP TABLE drawing", "tables of the drawing are missing"},
};

INSTANTIATE_TEST_SUITE_P(Rows, DrawingFileTampering, ::testing::ValuesIn(kTamperings),
                         [](const ::testing::TestParamInfo<Tampering>& tampering) { return tampering.param.name; });

}  // namespace
