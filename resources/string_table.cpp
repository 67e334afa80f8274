// The string table. Texts are the product's own and are shown exactly as written here.
#include "resources/string_table.h"

#include <utility>

namespace resources {
namespace {

constexpr std::pair<int, std::string_view> kStrings[] = {
    {4, "Camera"},
    {5, "Section"},
    {kIdsModeRefused, "This operation can be performed only in Geometric , Render and Solid mode"},
    {8, "Hsection "},
    {9, "Generate all 2D"},
    {10, "Generate 2D of cameras"},
    {11, "Generate 2D of planes"},
    {12, "Generate 2D of sections"},
    {13, "Select all for 2D"},
    {14, "Deselect all for 2D"},
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
    {30, "Save 2D selections"},
    {31, "Target"},
    {32, "Eye"},
    {33, "Cone"},
    {34, "Level 5"},
    {35, "Level 10"},
    {36, "Level 50"},
    {37, "Level 100"},
    {38, "Level Render"},
    {39, "ID"},
    {40, "Name"},
    {41, "On/Off"},
    {kIdsFile, "File"},
    {kIdsOf, "of"},
    {kIdsStart, "Start"},
    {kIdsDone, "Done"},
    {46, "Open Selection Dialog"},
    {kIdsError, "Error"},
    {48, "System error while deleting the Selection"},
    {kIdsInfo, "Info"},
    {50, "The selection has been deleted"},
    {51, "System error during selection reading"},
    {52, "No name has been typed for the selection"},
    {54, "System error while adding selection"},
    {kIdsDefaultCamera, "Default"},
    {58, "Section"},
    {59, "Camera"},
    {60, "Plane"},
    {61, "General Cameras"},
    {62, "Sections"},
    {63, "Plane"},
    {64, "Toogles 2D / 3D"},
    {67, "Toogle Othogonal/ Perpsective view"},
    {68, "Toogle patterns ON/OFF"},
    {70, "Display Mode"},
    {71, "Layer Configuration"},
    {72, "Toogle absolute/used layer view"},
    {74, "Click to force all layers ON"},
    {75, "Add new"},
    {76, "Remove"},
    {77, "Update camera"},
    {78, "Execute"},
    {79, "Add camera view"},
    {80, "Build 2D"},
    {81, "Remove selection"},
    {82, "Load selection"},
    {83, "Selection report"},
    {85, "This selection name has alredy been used. Please use a different one."},
    {86, "Cameras and sections manager"},
    {87, "Refresh"},
    {88, "Views and Plans"},
    {89, "Vertical Section"},
    {90, "Horizontal Section"},
    {kIdsCannotCreate2DFolder, "Cannot create 2D folder."},
};

}  // namespace

std::string_view LoadString(int id) {
  for (const auto& [key, text] : kStrings) {
    if (key == id) return text;
  }
  return {};
}

}  // namespace resources
