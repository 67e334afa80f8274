// The string table. Texts are the product's own and are shown exactly as written here.
#include "resources/string_table.h"

#include <array>
#include <utility>

namespace resources {
namespace {

constexpr std::array<std::pair<int, std::string_view>, 23> kStrings = {{
    {kIdsModeRefused, "This operation can be performed only in Geometric , Render and Solid mode"},
    {16, "Geometric"},
    {17, "Wireframe"},
    {18, "Hiddenline"},
    {19, "Surfaces"},
    {20, "Shaded"},
    {21, "Monocromatic"},
    {22, "Shadow Terrain"},
    {23, "Shadow Model"},
    {24, "Mono. Shadow Terrain"},
    {25, "Mono. Shadow Model"},
    {26, "Render"},
    {kIdsCutByColor, "By Color"},
    {kIdsCutOff, "Off"},
    {kIdsCutWhole, "Whole"},
    {kIdsFile, "File"},
    {kIdsOf, "of"},
    {kIdsStart, "Start"},
    {kIdsDone, "Done"},
    {kIdsError, "Error"},
    {kIdsInfo, "Info"},
    {kIdsDefaultCamera, "Default"},
    {kIdsCannotCreate2DFolder, "Cannot create 2D folder."},
}};

}  // namespace

std::string_view LoadString(int id) {
  for (const auto& [key, text] : kStrings) {
    if (key == id) return text;
  }
  return {};
}

}  // namespace resources
