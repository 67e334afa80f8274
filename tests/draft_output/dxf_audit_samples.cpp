// Writes the 2D files the independent audit opens: an empty sheet, every layer, odd names and
// texts, a large random sheet and a merge, each through WriteSheetFiles as a generation would.
// Beside them, "expected.txt" lists per file the LINE and TEXT counts and the layer names the
// audit must find.
#include <exception>
#include <fstream>
#include <iostream>

#include "tests/draft_output/draft_samples.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/draft/sheet_files.h"

namespace {

using wb::draft::Sheet;

void Write(const std::filesystem::path& folder, const std::string& name, const Sheet& sheet, bool overwrite,
           std::ostream& expected, const Sheet& content) {
  wb::draft::WriteSheetFiles(sheet, folder / name, overwrite);
  expected << name << ".dxf\t" << content.strokes.size() << '\t' << content.labels.size();
  const auto names = wb::draft::DxfLayerNames(content);
  for (const std::string& layer : names) {
    if (!layer.empty()) expected << '\t' << layer;
  }
  expected << '\n';
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: dxf_audit_samples FOLDER\n";
    return 2;
  }
  try {
    const std::filesystem::path folder = argv[1];
    std::ofstream expected(folder / "expected.txt");
    const auto write = [&](const std::string& name, const Sheet& sheet) { Write(folder, name, sheet, true, expected, sheet); };

    write("empty", Sheet{});
    write("all_layers", draft_output_samples::MakeAllLayersSheet());
    write("odd_names", draft_output_samples::MakeOddNamesSheet());
    Sheet odd = draft_output_samples::MakeSheet(3, 20, 0, 4);
    for (const std::string& text : draft_output_samples::OddTexts()) odd.labels.push_back({{1, 2}, 2.0, 15.0, text, 1, 2});
    write("odd_texts", odd);
    write("large", draft_output_samples::MakeSheet(4, 5000, 500, 60));

    const Sheet first = draft_output_samples::MakeSheet(5, 200, 20, 10);
    const Sheet second = draft_output_samples::MakeOddNamesSheet();
    wb::draft::WriteSheetFiles(first, folder / "merged", true);
    Write(folder, "merged", second, false, expected, wb::draft::MergeSheets(first, second));
    if (!expected.flush()) throw std::runtime_error("cannot write expected.txt");
  } catch (const std::exception& error) {
    std::cerr << "dxf_audit_samples: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
