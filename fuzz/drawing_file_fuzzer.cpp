// Any bytes as a drawing file: opening them must either refuse them with a DrawingFileError or
// give a drawing that saves and opens again unchanged. Anything else (a crash, a sanitizer
// report, another exception, a hang) is a finding.
#include <stdlib.h>

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include "workbench/drawing_file.h"

namespace {

std::filesystem::path folder;

void RemoveFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(folder, ignored);
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int* /*argc*/, char*** /*argv*/) {
  std::string pattern = (std::filesystem::temp_directory_path() / "pandex-fuzz-XXXXXX").string();
  if (mkdtemp(pattern.data()) == nullptr) std::abort();
  folder = pattern;
  std::atexit(RemoveFolder);
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::filesystem::path input = folder / "input.pdx";
  {
    std::ofstream out(input, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(data), static_cast<std::streamsize>(size));
    if (!out) std::abort();
  }
  wb::Drawing opened;
  try {
    opened = wb::OpenDrawingFile(input);
  } catch (const wb::DrawingFileError&) {
    return 0;
  }
  // Whatever opens is a drawing the host can work on, so it must save and come back whole.
  const std::filesystem::path resaved = folder / "resaved.pdx";
  wb::SaveDrawingFile(opened, resaved);
  if (wb::OpenDrawingFile(resaved) != opened) std::abort();
  return 0;
}
