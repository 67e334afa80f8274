// Saving drawings to files and opening them again: the steps on the file itself and the
// messages a user reads when one fails.
#include "workbench/drawing_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <exception>
#include <future>
#include <limits>
#include <memory>
#include <new>
#include <optional>
#include <span>
#include <system_error>

#include "workbench/drawing_file_check.h"
#include "workbench/drawing_file_database.h"
#include "workbench/drawing_file_format.h"
#include "workbench/file_replacement.h"

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
    case Reason::InUse: return "drawing file " + path + " is in use by another program" + inBrackets;
  }
  return detail;
}

[[noreturn]] void Refuse(Reason reason, const std::filesystem::path& path, const std::string& detail) {
  throw DrawingFileError(reason, Message(reason, path.string(), detail));
}

std::string ErrorText(int error) { return std::generic_category().message(error); }

// A regular file open for reading; anything else in its place is refused.
class OpenedFile {
 public:
  explicit OpenedFile(const std::filesystem::path& path)
      // Non-blocking, so that a named pipe in the file's place is refused rather than waited on.
      : path_(path), fd_(open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC)) {
    if (fd_ < 0) Refuse(Reason::CannotRead, path, ErrorText(errno));
    struct stat status {};
    const bool known = fstat(fd_, &status) == 0;
    const int error = errno;
    if (!known || !S_ISREG(status.st_mode)) {
      close(fd_);
      if (!known) Refuse(Reason::CannotRead, path, ErrorText(error));
      Refuse(Reason::CannotRead, path, S_ISDIR(status.st_mode) ? "it is a folder" : "it is not a regular file");
    }
    size_ = static_cast<std::uint64_t>(status.st_size);
  }
  ~OpenedFile() { close(fd_); }
  OpenedFile(const OpenedFile&) = delete;
  OpenedFile& operator=(const OpenedFile&) = delete;

  // In 64 bits on every build: a 32-bit size_t would wrap a file of 4 GiB or more.
  std::uint64_t Size() const { return size_; }

  // Reads `count` bytes from the start; refuses a file that has become shorter meanwhile.
  void ReadStart(unsigned char* bytes, std::size_t count) const {
    std::size_t done = 0;
    while (done < count) {
      const ssize_t got = pread(fd_, bytes + done, count - done, static_cast<off_t>(done));
      if (got < 0 && errno == EINTR) continue;
      if (got < 0) Refuse(Reason::CannotRead, path_, ErrorText(errno));
      if (got == 0) Refuse(Reason::CannotRead, path_, "it changed while it was read");
      done += static_cast<std::size_t>(got);
    }
  }

  // The whole file in memory, so the database is read without SQLite ever opening the file: no
  // lock, journal or other side file, and nothing is written to it.
  std::unique_ptr<unsigned char[]> ReadAll() const {
    std::unique_ptr<unsigned char[]> bytes;
    if (size_ > std::numeric_limits<std::size_t>::max()) Refuse(Reason::CannotRead, path_, "not enough memory");
    try {
      bytes = std::make_unique_for_overwrite<unsigned char[]>(static_cast<std::size_t>(size_));
    } catch (const std::bad_alloc&) {
      Refuse(Reason::CannotRead, path_, "not enough memory");
    }
    ReadStart(bytes.get(), static_cast<std::size_t>(size_));
    return bytes;
  }

 private:
  const std::filesystem::path& path_;
  int fd_;
  std::uint64_t size_ = 0;
};

std::uint32_t BigEndian(const unsigned char* bytes, std::size_t offset, std::size_t width) {
  std::uint32_t value = 0;
  for (std::size_t i = 0; i < width; ++i) value = (value << 8) | bytes[offset + i];
  return value;
}

// The SQLite file header, checked before the rest is read and before SQLite sees the file, so
// that a foreign file is never read whole, foreign files and files from newer versions get their
// own message, and a cut-off file is named as such.
void CheckFileHeader(const OpenedFile& file, const std::filesystem::path& path) {
  static constexpr char kMagic[] = "SQLite format 3";  // 16 bytes with the terminating zero
  std::array<unsigned char, 100> header{};
  const std::uint64_t size = file.Size();
  if (size == 0) Refuse(Reason::NotADrawing, path, "the file is empty");
  file.ReadStart(header.data(), static_cast<std::size_t>(std::min<std::uint64_t>(size, header.size())));
  if (size < sizeof kMagic || std::memcmp(header.data(), kMagic, sizeof kMagic) != 0) {
    Refuse(Reason::NotADrawing, path, "");
  }
  if (size < header.size()) Refuse(Reason::Damaged, path, "it is cut off in its header");
  if (BigEndian(header.data(), 68, 4) != drawing_file::kApplicationId) {
    Refuse(Reason::NotADrawing, path, "a database of another program");
  }
  const std::uint32_t format = BigEndian(header.data(), 60, 4);
  if (format > drawing_file::kFormatVersion) {
    Refuse(Reason::NewerVersion, path,
           "format " + std::to_string(format) + "; this version reads format " +
               std::to_string(drawing_file::kFormatVersion));
  }
  if (format != drawing_file::kFormatVersion) Refuse(Reason::Damaged, path, "unknown format " + std::to_string(format));
  // Drawing files never use a write-ahead log and always store UTF-8; read as it stands, a
  // header saying otherwise would make SQLite look for side files or convert the texts.
  const std::uint32_t pageSizeField = BigEndian(header.data(), 16, 2);
  const std::uint64_t pageSize = pageSizeField == 1 ? 65536 : pageSizeField;
  if (header[18] != 1 || header[19] != 1 || BigEndian(header.data(), 56, 4) != 1 || pageSize < 512 ||
      (pageSize & (pageSize - 1)) != 0) {
    Refuse(Reason::Damaged, path, "its header is damaged");
  }
  const std::uint64_t expectedSize = pageSize * BigEndian(header.data(), 28, 4);
  if (size < expectedSize) {
    Refuse(Reason::Damaged, path,
           "it is cut off after " + std::to_string(size) + " of " + std::to_string(expectedSize) + " bytes");
  }
  if (size != expectedSize) Refuse(Reason::Damaged, path, "its size does not match its header");
}

// The file at the end of a chain of symbolic links: a save replaces that file and keeps the
// links, so that editing through a link changes the drawing it leads to.
std::filesystem::path FileBehindLinks(const std::filesystem::path& path) {
  constexpr int kMostLinks = 40;  // as the system itself follows
  std::filesystem::path current = path;
  for (int links = 0; std::filesystem::is_symlink(std::filesystem::symlink_status(current)); ++links) {
    if (links == kMostLinks) throw std::system_error(ELOOP, std::generic_category(), "following its links");
    const std::filesystem::path next = std::filesystem::read_symlink(current);
    current = next.is_absolute() ? next : current.parent_path() / next;
  }
  return current;
}

}  // namespace

void SaveDrawingFile(const Drawing& drawing, const std::filesystem::path& path) {
  if (path.filename().empty()) Refuse(Reason::CannotWrite, path, "the path names no file");
  if (std::optional<std::string> problem = drawing_file::FindInconsistency(drawing)) {
    Refuse(Reason::CannotWrite, path, "the drawing does not hold together: " + *problem);
  }
  try {
    FileReplacement replacement(FileBehindLinks(path), {".saving", true});
    drawing_file::WriteDrawingDatabase(drawing, replacement.TemporaryPath());
    replacement.Commit();
  } catch (const std::runtime_error& error) {  // system, SQLite and content errors alike
    Refuse(Reason::CannotWrite, path, error.what());
  }
}

Drawing OpenDrawingFile(const std::filesystem::path& path) {
  const OpenedFile file(path);
  CheckFileHeader(file, path);
  const std::unique_ptr<unsigned char[]> bytes = file.ReadAll();
  const auto length = static_cast<std::size_t>(file.Size());  // it is in memory, so it fits
  const std::span<const unsigned char> content(bytes.get(), length);
  try {
    // SQLite checks the pages on one connection while the rows are read on another, on a second
    // core: the check costs a fifth of opening a large drawing.
    drawing_file::Connection pages;
    drawing_file::Connection rows;
    pages.Deserialize(content);
    rows.Deserialize(content);
    std::future<void> pageCheck = std::async([&pages] { drawing_file::CheckPages(pages); });
    std::optional<Drawing> drawing;
    std::exception_ptr rowError;
    try {
      drawing = drawing_file::ReadDrawingDatabase(rows, length);
    } catch (const std::runtime_error&) {
      rowError = std::current_exception();
    }
    pageCheck.get();  // damaged pages come first: they explain whatever the rows showed
    if (rowError) std::rethrow_exception(rowError);
    return std::move(*drawing);
  } catch (const std::runtime_error& error) {  // SQLite and content errors alike
    Refuse(Reason::Damaged, path, error.what());
  }
}

}  // namespace wb
