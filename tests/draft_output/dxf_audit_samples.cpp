// Writes the 2D files the independent audit opens, as generations would, and "expected.txt":
// per file the LINE and TEXT counts and the layer names the audit must find.
#include <exception>
#include <fstream>
#include <iostream>

#include "tests/draft_output/draft_samples.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/draft/sheet_files.h"

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: dxf_audit_samples FOLDER\n";
    return 2;
  }
  using namespace draft_output_samples;
  using wb::draft::Sheet;
  try {
    const std::filesystem::path folder = argv[1];
    std::ofstream expected(folder / "expected.txt");
    // Without overwrite, the file holds the merge of the sheet into the one written before.
    const auto write = [&](const std::string& name, const Sheet& sheet, const Sheet* before = nullptr) {
      wb::draft::WriteSheetFiles(sheet, folder / name, before == nullptr);
      const Sheet content = before == nullptr ? sheet : wb::draft::MergeSheets(*before, sheet);
      expected << name << ".dxf\t" << content.strokes.size() << '\t' << content.labels.size();
      for (const std::string& layer : wb::draft::DxfLayerNames(content)) {
        if (!layer.empty()) expected << '\t' << layer;
      }
      expected << '\n';
    };
    write("empty", Sheet{});
    write("all_layers", MakeAllLayersSheet());
    write("odd_names", MakeOddNamesSheet());
    Sheet odd = MakeSheet(3, 20, 0, 4);
    for (const std::string& text : OddTexts()) odd.labels.push_back({{1, 2}, 2.0, 15.0, text, 1, 2});
    write("odd_texts", odd);
    write("large", MakeSheet(4, 5000, 500, 60));
    const Sheet first = MakeSheet(5, 200, 20, 10);
    wb::draft::WriteSheetFiles(first, folder / "merged", true);
    write("merged", MakeOddNamesSheet(), &first);
    if (!expected.flush()) throw std::runtime_error("cannot write expected.txt");
  } catch (const std::exception& error) {
    std::cerr << "dxf_audit_samples: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
