// Writes the fuzzer's seed corpus into the folder given: small real drawing files covering every
// table, entity kind and attribute type.
#include <cstdio>
#include <filesystem>
#include <exception>

#include "tests/drawing_file/sample_drawings.h"
#include "workbench/drawing_file.h"

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "usage: %s FOLDER\n", argv[0]);
    return 2;
  }
  const std::filesystem::path folder = argv[1];
  try {
    wb::SaveDrawingFile(wb::Drawing(), folder / "empty.pdx");
    wb::SaveDrawingFile(drawing_file_samples::MakeDrawingWithEverything(), folder / "everything.pdx");
    wb::SaveDrawingFile(drawing_file_samples::MakeBulkDrawing(60, 1), folder / "bulk.pdx");
  } catch (const std::exception& error) {
    std::fprintf(stderr, "drawing_file_seeds: %s\n", error.what());
    return 1;
  }
  // Saving keeps backups; the corpus wants the drawings only.
  for (const char* name : {"empty.pdx.bak", "everything.pdx.bak", "bulk.pdx.bak"}) {
    std::filesystem::remove(folder / name);
  }
  return 0;
}
