// Builds the sample drawing in code, so that it never goes stale against the file format.
#include "samples/sample_drawing.h"

#include <array>
#include <string_view>

namespace samples {

wb::Drawing MakeSampleDrawing() {
  wb::Drawing drawing;
  drawing.title = "sample";
  constexpr std::array<std::string_view, 6> kLayerNames = {"Walls", "Slabs", "Roof", "Stairs", "Dimensions", "Texts"};
  for (std::size_t i = 0; i < kLayerNames.size(); ++i) drawing.layers[i].name = kLayerNames[i];
  return drawing;
}

}  // namespace samples
