// A 2D drawing as the 2D pipeline produces it and the writers serialize it: straight strokes
// and text labels on layers, in drawing units of the view plane.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace wb::draft {

struct Point2 {
  double x = 0.0;
  double y = 0.0;
  bool operator==(const Point2&) const = default;
};

struct Box2 {
  Point2 min;
  Point2 max;
  bool operator==(const Box2&) const = default;
};

// What a stroke shows; writers may style the kinds differently (cut edges heavier).
enum class StrokeKind : std::uint8_t {
  Edge = 0,       // a model edge seen in the view
  Cut = 1,        // where a section or plan cut meets the model
  Preserved = 2,  // an entity carried over unchanged from the drawing
};

struct Stroke {
  Point2 a;
  Point2 b;
  std::uint8_t layer = 0;  // 0-based host layer index
  std::uint8_t color = 7;  // host colour index (1..255), 7 = the drawing's foreground
  StrokeKind kind = StrokeKind::Edge;
  bool operator==(const Stroke&) const = default;
};

struct Label {
  Point2 at;
  double height = 2.5;
  double angle = 0.0;  // degrees, counter-clockwise
  std::string text;
  std::uint8_t layer = 0;
  std::uint8_t color = 7;
  bool operator==(const Label&) const = default;
};

constexpr int kSheetLayerCount = 256;

struct Sheet {
  std::vector<Stroke> strokes;
  std::vector<Label> labels;
  std::array<std::string, kSheetLayerCount> layerNames{};  // empty: "Layer n" (n = index + 1)
  bool operator==(const Sheet&) const = default;
};

}  // namespace wb::draft
