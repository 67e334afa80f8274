// Output file names of the 2D batch: the 2D folder and prefix a drawing gives, the default file
// of each view, and the names of one run kept apart.
#pragma once

#include <map>
#include <optional>
#include <string>

namespace HRUtility {

// The 2D folder and file prefix of a drawing: beside the drawing, "2D_"; the drawing's name and
// "_".
struct OutputNames {
  std::string folder;
  std::string prefix;
};
OutputNames OutputNamesFor(const std::string& drawingPath);

// A default output file inside the folder; the name parts cannot leave the folder whatever they
// hold. Characters no file system takes become '_'. The name is written whole where the
// folder's file system takes it, and cut between characters only where it is too long.
std::string DefaultOutputFile(const OutputNames& names, const std::string& viewName);

// Where a camera's own 2D file name leads: a relative name is taken from the drawing's folder.
// Unless allowed, a name that leads out of the drawing's folder (symbolic links followed) or
// holds control characters is refused: nothing is answered, and `refusal` says why.
std::optional<std::string> OwnOutputFile(const std::string& own, const std::string& drawingFolder, bool allowAnywhere,
                                         std::string& refusal);

// Views whose files would share one name (the same name, or names equal without regard to case,
// as some file systems compare them) get told apart by this and a number, "~2", "~3", ...
inline constexpr char kCollisionSuffix = '~';

// The files one run writes, so that no view replaces the file an earlier view of the run wrote.
class OutputFileClaims {
 public:
  struct Claim {
    std::string file;     // the name to write to
    std::string warning;  // why it is not the name asked for; empty when it is
  };
  // A view that adds to its file (its overwrite option off) shares it on purpose and keeps the
  // name; any other view whose file is taken gets the first free name with a suffix.
  Claim Take(const std::string& view, const std::string& file, bool adds);

 private:
  std::map<std::string, std::string> taken_;  // by name without regard to case: the view that took it
};

}  // namespace HRUtility
