// Files that are not whole drawings are refused with one line that says why and names the file.
#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <functional>
#include <string>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::ReadBytes;
using drawing_file_samples::WriteBytes;
using Bytes = std::vector<std::uint8_t>;
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

// SQL that sets an entity's details to empty names and then the given hex bytes: the member
// count and handles, then the attribute count and attributes.
std::string SetDetails(host::EntityHandle entity, const std::string& hex) {
  return "UPDATE entities SET details = x'000000000000000000000000" + hex + "' WHERE handle = " +
         std::to_string(entity);
}

class DrawingFileRefusal : public ::testing::Test {
 protected:
  void SetUp() override { wb::SaveDrawingFile(drawing_file_samples::MakeDrawingWithEverything(), file_); }

  // Opens the file, expecting a refusal for the reason with `fragment` in its one-line message.
  static void ExpectRefused(const std::filesystem::path& path, Reason reason, const std::string& fragment) {
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

  // Expects the saved drawing, changed, to be refused as damaged.
  void ExpectDamaged(const std::function<void(Bytes&)>& change, const std::string& fragment) {
    Bytes bytes = ReadBytes(file_);
    change(bytes);
    WriteBytes(folder_ / "variant.pdx", bytes);
    ExpectRefused(folder_ / "variant.pdx", Reason::Damaged, fragment);
  }

  drawing_file_samples::ScratchFolder folder_;
  const std::filesystem::path file_ = folder_ / "house.pdx";
};

TEST_F(DrawingFileRefusal, ThingsThatAreNoDrawingAtAll) {
  const std::filesystem::path missing = folder_ / "missing.pdx";
  ExpectRefused(missing, Reason::CannotRead, "cannot open drawing file " + missing.string() + ": No such file");
  ExpectRefused(folder_.Path(), Reason::CannotRead, "it is a folder");
  ASSERT_EQ(mkfifo((folder_ / "pipe.pdx").c_str(), 0600), 0);
  ExpectRefused(folder_ / "pipe.pdx", Reason::CannotRead, "it is not a regular file");
  WriteBytes(folder_ / "empty.pdx", {});
  ExpectRefused(folder_ / "empty.pdx", Reason::NotADrawing,
                "not a Pandex drawing file: " + (folder_ / "empty.pdx").string() + " (the file is empty)");
  const std::string text = "Cameras:\n  Camera 1\n";
  WriteBytes(folder_ / "notes.pdx", {text.begin(), text.end()});
  ExpectRefused(folder_ / "notes.pdx", Reason::NotADrawing, "not a Pandex drawing file");
  RunSql(folder_ / "other.db", "CREATE TABLE drawing(title TEXT); INSERT INTO drawing VALUES('x')");
  ExpectRefused(folder_ / "other.db", Reason::NotADrawing, "(a database of another program)");
  // Sparse files take no disk, but reading one whole would take 64 GB of memory.
  std::filesystem::resize_file(folder_ / "notes.pdx", std::uintmax_t{64} << 30);
  ExpectRefused(folder_ / "notes.pdx", Reason::NotADrawing, "not a Pandex drawing file");
  std::filesystem::resize_file(file_, std::uintmax_t{64} << 30);
  ExpectRefused(file_, Reason::Damaged, "(its size does not match its header)");
}

TEST_F(DrawingFileRefusal, OtherVersionsCutOffAndDamagedFiles) {
  std::filesystem::copy_file(file_, folder_ / "newer.pdx");
  RunSql(folder_ / "newer.pdx", "PRAGMA user_version = 2");
  ExpectRefused(folder_ / "newer.pdx", Reason::NewerVersion,
                "drawing file is from a newer version of Pandex: " + (folder_ / "newer.pdx").string() +
                    " (format 2; this version reads format 1)");
  std::filesystem::copy_file(file_, folder_ / "unknown.pdx");
  RunSql(folder_ / "unknown.pdx", "PRAGMA user_version = 0");
  ExpectRefused(folder_ / "unknown.pdx", Reason::Damaged, "(unknown format 0)");

  const std::size_t size = ReadBytes(file_).size();
  ExpectDamaged([](Bytes& b) { b.resize(b.size() / 2); },
                "(it is cut off after " + std::to_string(size / 2) + " of " + std::to_string(size) + " bytes)");
  ExpectDamaged([](Bytes& b) { b.pop_back(); }, "it is cut off");
  ExpectDamaged([](Bytes& b) { b.resize(60); }, "(it is cut off in its header)");
  ExpectDamaged([](Bytes& b) { b.insert(b.end(), 4096, 0); }, "(its size does not match its header)");
  // The expected size is reckoned in 64 bits: a page count 4 GiB too large must not wrap round
  // to the real size on a 32-bit build.
  ExpectDamaged(
      [](Bytes& b) {
        const std::uint32_t pageSize = b[16] << 8 | b[17];
        const std::uint32_t pages = (b[28] << 24 | b[29] << 16 | b[30] << 8 | b[31]) + (1U << 31) / pageSize * 2;
        for (int i = 0; i < 4; ++i) b[28 + i] = static_cast<std::uint8_t>(pages >> (24 - 8 * i));
      },
      "(it is cut off after " + std::to_string(size) + " of " + std::to_string(size + (std::uint64_t{1} << 32)) +
          " bytes)");
  ExpectDamaged([](Bytes& b) { b[18] = b[19] = 2; }, "its header is damaged");
  ExpectDamaged([](Bytes& b) { b[59] = 2; }, "its header is damaged");
  ExpectDamaged([](Bytes& b) { b[16] = 0x30; }, "its header is damaged");
  // Garbage over the last page, which holds entity rows.
  ExpectDamaged([](Bytes& b) { std::fill(b.end() - 4096, b.end(), 0x5A); }, "drawing file is damaged");
  // An interior b-tree page without cells whose right child is itself.
  ExpectDamaged(
      [](Bytes& b) {
        std::fill(b.begin() + 4096, b.begin() + 8192, 0);
        b[4096] = 0x05;
        b[4096 + 11] = 2;
      },
      "drawing file is damaged");
}

// A drawing changed with SQL by another program: still a sound database, but not a drawing the
// host could work on. In the sample: 1 line, 2 deleted, 3 text, 12 element, 13 group of 1, 3 and
// 12, 14 block of 11, 15 placed block of 14, 17 deleted.
TEST_F(DrawingFileRefusal, TamperedContentIsRefusedAsDamaged) {
  const std::pair<std::string, const char*> tamperings[] = {
      {"UPDATE entities SET header = x'0102' WHERE handle = 1", "entity 1: its header has 2 bytes"},
      {"UPDATE entities SET details = 12 WHERE handle = 13", "entity 13: the wrong kind of value in its details"},
      {"DELETE FROM entities WHERE handle = 4", "handles do not count up from 1: 5 where 4 belongs"},
      {"UPDATE entities SET record = x'00' WHERE handle = 2", "entity 2: deleted, yet it holds"},
      {"UPDATE entities SET record = x'00' WHERE handle = 1", "entity 1 has a record of 1 bytes where its type"},
      {SetDetails(3, "00000000" "01000000" "02000000613d090000"), "entity 3: attribute 1 has the unknown type 9"},
      {"UPDATE entities SET details = x'f0ffffff41' WHERE handle = 3", "its details are cut short"},
      {SetDetails(3, "00000000" "01000000" "02000000613d010000f0ffffff41"), "its details are cut short"},
      {SetDetails(3, "00000000" "01000000" "02000000613d060000ffffff7f01000000"), "its details are cut short"},
      {SetDetails(13, "01000000e8030000" "00000000"), "entity 13 lists the member 1000"},
      {SetDetails(3, "00000000" "ffffff7f"), "entity 3: its details are cut short"},
      {SetDetails(3, "00000000" "00000000" "00"), "entity 3: its details run on past their end"},
      {SetDetails(13, "02000000010000000d000000" "00000000"), "entity 13 contains itself"},
      {"UPDATE entities SET record = x'" + std::string(272, '0') + "0f27000000000000' WHERE handle = 15",
       "entity 15 places the block 9999"},
      {"DELETE FROM layers WHERE layer_index = 7", "the layer table does not hold layers 1 to 256"},
      {"UPDATE layers SET is_on = 5 WHERE layer_index = 0", "layer 1 is neither on nor off"},
      {"DELETE FROM drawing", "the drawing has no title"},
      {"CREATE VIEW extra AS SELECT 1", "it holds tables that are not a drawing's"},
      {"DROP TABLE layers; CREATE VIEW layers AS WITH RECURSIVE n(i) AS (SELECT 0 UNION ALL SELECT i + 1 FROM n) "
       "SELECT i AS layer_index, 'x' AS name, 1 AS is_on FROM n",
       "it holds tables that are not a drawing's"},
      {"ALTER TABLE entities ADD COLUMN extra", "not a drawing's"},
      {"DROP TABLE drawing", "tables of the drawing are missing"},
  };
  for (const auto& [sql, expected] : tamperings) {
    SCOPED_TRACE(sql);
    std::filesystem::copy_file(file_, folder_ / "tampered.pdx", std::filesystem::copy_options::overwrite_existing);
    RunSql(folder_ / "tampered.pdx", sql);
    ExpectRefused(folder_ / "tampered.pdx", Reason::Damaged, expected);
  }
}

}  // namespace
