// Saving drawings to files and opening them again: the steps on the file itself and the
// messages a user reads when one fails.
#include "workbench/drawing_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <optional>
#include <system_error>

#include "workbench/drawing_file_check.h"
#include "workbench/drawing_file_database.h"
#include "workbench/drawing_file_format.h"
#include "workbench/drawing_file_replace.h"

namespace wb {
namespace {

using Reason = DrawingFileError::Reason;

std::string Message(Reason reason, const std::string& path, const std::string& detail) {
  const std::string inBrackets = detail.empty() ? "" : " (" + detail + ")";
  switch (reason) {
    case Reason::CannotRead: return "cannot open drawing file " + path + ": " + detail;
    case Reason::NotADrawing: return "not a Pandex drawing file: " + path + inBrackets;
    case Reason::Damaged: return "drawing file is damaged: " + path + inBrackets;
    case Reason::NewerVersion: return "drawing file is from a newer version of Pandex: " + path + inBrackets;
    case Reason::CannotWrite: return "cannot write " + path + ": " + detail;
  }
  return detail;
}

[[noreturn]] void Refuse(Reason reason, const std::filesystem::path& path, const std::string& detail) {
  throw DrawingFileError(reason, Message(reason, path.string(), detail));
}

std::string ErrorText(int error) { return std::generic_category().message(error); }

// The file's bytes in memory SQLite can take over, so the database is read without SQLite ever
// opening the file: no lock, journal or any other side file, and the file cannot change.
struct SqliteFree {
  void operator()(unsigned char* bytes) const { sqlite3_free(bytes); }
};
struct FileBytes {
  std::unique_ptr<unsigned char[], SqliteFree> bytes;
  std::size_t size = 0;
};

class FileDescriptor {
 public:
  explicit FileDescriptor(int fd) : fd_(fd) {}
  ~FileDescriptor() { close(fd_); }
  FileDescriptor(const FileDescriptor&) = delete;
  FileDescriptor& operator=(const FileDescriptor&) = delete;
  int Get() const { return fd_; }

 private:
  int fd_;
};

FileBytes ReadWholeFile(const std::filesystem::path& path) {
  // Non-blocking, so that a named pipe in the file's place is refused rather than waited on.
  const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
  if (fd < 0) Refuse(Reason::CannotRead, path, ErrorText(errno));
  const FileDescriptor file(fd);
  struct stat status {};
  if (fstat(file.Get(), &status) != 0) Refuse(Reason::CannotRead, path, ErrorText(errno));
  if (S_ISDIR(status.st_mode)) Refuse(Reason::CannotRead, path, "it is a folder");
  if (!S_ISREG(status.st_mode)) Refuse(Reason::CannotRead, path, "it is not a regular file");
  const auto size = static_cast<std::size_t>(status.st_size);
  FileBytes content;
  content.bytes.reset(static_cast<unsigned char*>(sqlite3_malloc64(std::max<std::size_t>(size, 1))));
  if (!content.bytes) Refuse(Reason::CannotRead, path, "not enough memory");
  while (content.size < size) {
    const ssize_t got = read(file.Get(), content.bytes.get() + content.size, size - content.size);
    if (got < 0 && errno == EINTR) continue;
    if (got < 0) Refuse(Reason::CannotRead, path, ErrorText(errno));
    if (got == 0) break;  // the file shrank meanwhile; the checks below see what is there
    content.size += static_cast<std::size_t>(got);
  }
  return content;
}

std::uint32_t BigEndian(const unsigned char* bytes, std::size_t offset, std::size_t width) {
  std::uint32_t value = 0;
  for (std::size_t i = 0; i < width; ++i) value = (value << 8) | bytes[offset + i];
  return value;
}

// The SQLite file header, checked before SQLite sees the file, so that foreign files and files
// from newer versions get their own message, and a cut-off file is named as such.
void CheckFileHeader(const FileBytes& file, const std::filesystem::path& path) {
  static constexpr char kMagic[] = "SQLite format 3";  // 16 bytes with the terminating zero
  constexpr std::size_t kHeaderSize = 100;
  const unsigned char* header = file.bytes.get();
  if (file.size == 0) Refuse(Reason::NotADrawing, path, "the file is empty");
  if (file.size < sizeof kMagic || std::memcmp(header, kMagic, sizeof kMagic) != 0) {
    Refuse(Reason::NotADrawing, path, "");
  }
  if (file.size < kHeaderSize) Refuse(Reason::Damaged, path, "it is cut off in its header");
  if (BigEndian(header, 68, 4) != drawing_file::kApplicationId) {
    Refuse(Reason::NotADrawing, path, "a database of another program");
  }
  const std::uint32_t format = BigEndian(header, 60, 4);
  if (format > drawing_file::kFormatVersion) {
    Refuse(Reason::NewerVersion, path,
           "format " + std::to_string(format) + "; this version reads format " +
               std::to_string(drawing_file::kFormatVersion));
  }
  if (format != drawing_file::kFormatVersion) Refuse(Reason::Damaged, path, "unknown format " + std::to_string(format));
  // Drawing files never use a write-ahead log and always store UTF-8; read as it stands, a
  // header saying otherwise would make SQLite look for side files or convert the texts.
  const std::uint32_t pageSizeField = BigEndian(header, 16, 2);
  const std::size_t pageSize = pageSizeField == 1 ? 65536 : pageSizeField;
  if (header[18] != 1 || header[19] != 1 || BigEndian(header, 56, 4) != 1 || pageSize < 512 ||
      (pageSize & (pageSize - 1)) != 0) {
    Refuse(Reason::Damaged, path, "its header is damaged");
  }
  const std::size_t expectedSize = pageSize * BigEndian(header, 28, 4);
  if (file.size < expectedSize) {
    Refuse(Reason::Damaged, path,
           "it is cut off after " + std::to_string(file.size) + " of " + std::to_string(expectedSize) + " bytes");
  }
  if (file.size != expectedSize) Refuse(Reason::Damaged, path, "its size does not match its header");
}

}  // namespace

void SaveDrawingFile(const Drawing& drawing, const std::filesystem::path& path) {
  if (path.filename().empty()) Refuse(Reason::CannotWrite, path, "the path names no file");
  if (std::optional<std::string> problem = drawing_file::FindInconsistency(drawing)) {
    Refuse(Reason::CannotWrite, path, "the drawing does not hold together: " + *problem);
  }
  try {
    drawing_file::FileReplacement replacement(path);
    drawing_file::WriteDrawingDatabase(drawing, replacement.TemporaryPath());
    replacement.Commit();
  } catch (const std::system_error& error) {
    Refuse(Reason::CannotWrite, path, error.what());
  } catch (const drawing_file::SqliteError& error) {
    Refuse(Reason::CannotWrite, path, error.what());
  } catch (const drawing_file::BadContent& error) {
    Refuse(Reason::CannotWrite, path, error.what());
  }
}

Drawing OpenDrawingFile(const std::filesystem::path& path) {
  FileBytes file = ReadWholeFile(path);
  CheckFileHeader(file, path);
  try {
    drawing_file::Connection database;
    database.Deserialize(file.bytes.release(), file.size);
    return drawing_file::ReadDrawingDatabase(database, file.size);
  } catch (const drawing_file::SqliteError& error) {
    Refuse(Reason::Damaged, path, error.what());
  } catch (const drawing_file::BadContent& error) {
    Refuse(Reason::Damaged, path, error.what());
  }
}

}  // namespace wb
