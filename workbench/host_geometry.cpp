// Host geometry and text helpers: the view frame of three points, distances, double-byte texts.
//
// g32d answers the frame of three points as a row-vector matrix that maps frame coordinates
// into the drawing: p_drawing = (x, y, z, 1) · G. Rows 0 to 2 are the frame's unit axes, row 3
// its origin. This is what a placement needs: a symbol laid out along the frame's x axis from
// (0, 0, 0) to (length, 0, 0) lands on the line from the first point to the second. Splitting G
// into its rotation R (row 3 cleared) and the translation T by row 3 gives G = R · T.
#include <cfloat>
#include <cmath>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

struct Vec {
  double x, y, z;
};

Vec Minus(Vec a, Vec b) { return {a.x - b.x, a.y - b.y, a.z - b.z}; }
Vec Times(Vec a, double s) { return {a.x * s, a.y * s, a.z * s}; }
double Dot(Vec a, Vec b) { return a.x * b.x + a.y * b.y + a.z * b.z; }
Vec Cross(Vec a, Vec b) { return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x}; }
double Length(Vec a) { return std::sqrt(Dot(a, a)); }

Vec PointAt(const float* coordinates) { return {coordinates[0], coordinates[1], coordinates[2]}; }

// The unit vector along `v`, or nothing when `v` is too short to give a direction.
bool Direction(Vec v, double tolerance, Vec& unit) {
  const double length = Length(v);
  if (!(length > tolerance)) return false;
  unit = Times(v, 1.0 / length);
  return true;
}

void WriteRow(float* matrix, int row, Vec v, float w) {
  matrix[4 * row + 0] = static_cast<float>(v.x);
  matrix[4 * row + 1] = static_cast<float>(v.y);
  matrix[4 * row + 2] = static_cast<float>(v.z);
  matrix[4 * row + 3] = w;
}

void WriteFrame(float* matrix, Vec xAxis, Vec yAxis, Vec origin) {
  WriteRow(matrix, 0, xAxis, 0.0F);
  WriteRow(matrix, 1, yAxis, 0.0F);
  WriteRow(matrix, 2, Cross(xAxis, yAxis), 0.0F);
  WriteRow(matrix, 3, origin, 1.0F);
}

constexpr Vec kWorldX{1, 0, 0};
constexpr Vec kWorldY{0, 1, 0};
constexpr Vec kWorldZ{0, 0, 1};

// A y axis for an x axis alone: the plan normal to its left, as a section's side point lies;
// for a vertical x axis, world y.
Vec FallbackY(Vec xAxis) {
  Vec yAxis{};
  if (Direction(Cross(kWorldZ, xAxis), 1e-6, yAxis)) return yAxis;
  Direction(Minus(kWorldY, Times(xAxis, Dot(kWorldY, xAxis))), 0.0, yAxis);
  return yAxis;
}

// Answers 1 when the three points span the frame; 0 when a fallback axis had to stand in
// (equal or collinear points) or the input was unusable (non-finite: the identity).
std::int32_t ComputeFrame(const float points[9], float matrix[16]) {
  for (int i = 0; i < 9; ++i) {
    if (!std::isfinite(points[i])) {
      WriteFrame(matrix, kWorldX, kWorldY, Vec{0, 0, 0});
      return 0;
    }
  }
  const Vec origin = PointAt(points);
  // Below a few float steps at the points' magnitude a difference is rounding, not direction.
  double magnitude = 1.0;
  for (int i = 0; i < 9; ++i) magnitude = std::fmax(magnitude, std::fabs(points[i]));
  const double tolerance = 8.0 * FLT_EPSILON * magnitude;

  std::int32_t status = 1;
  Vec xAxis = kWorldX;
  if (!Direction(Minus(PointAt(points + 3), origin), tolerance, xAxis)) status = 0;
  const Vec towardsY = Minus(PointAt(points + 6), origin);
  Vec yAxis{};
  if (!Direction(Minus(towardsY, Times(xAxis, Dot(towardsY, xAxis))), tolerance, yAxis)) {
    yAxis = FallbackY(xAxis);
    status = 0;
  }
  WriteFrame(matrix, xAxis, yAxis, origin);
  return status;
}

bool InRange(unsigned char byte, unsigned char low, unsigned char high) { return byte >= low && byte <= high; }

// Whether the bytes at `text` start a character of two or more bytes, in UTF-8 or in the
// double-byte code page older drawings carry.
bool StartsMultiByte(const unsigned char* text) {
  const unsigned char lead = text[0];
  int continuation = 0;
  if (InRange(lead, 0xC2, 0xDF)) continuation = 1;
  if (InRange(lead, 0xE0, 0xEF)) continuation = 2;
  if (InRange(lead, 0xF0, 0xF4)) continuation = 3;
  bool utf8 = continuation > 0;
  for (int i = 1; utf8 && i <= continuation; ++i) utf8 = InRange(text[i], 0x80, 0xBF);
  if (utf8) return true;
  const bool doubleByteLead = InRange(lead, 0x81, 0x9F) || InRange(lead, 0xE0, 0xFC);
  const unsigned char trail = text[1];
  return doubleByteLead && (InRange(trail, 0x40, 0x7E) || InRange(trail, 0x80, 0xFC));
}

}  // namespace

void g32d(const float points[9], float matrix[16], std::int32_t* status) {
  if (auto fault = call::Fault(__func__)) {
    if (matrix != nullptr) WriteFrame(matrix, kWorldX, kWorldY, Vec{0, 0, 0});
    if (status != nullptr) *status = *fault;
    return;
  }
  if (matrix == nullptr) {
    if (status != nullptr) *status = 0;
    return;
  }
  std::int32_t result = 0;
  if (points == nullptr) {
    WriteFrame(matrix, kWorldX, kWorldY, Vec{0, 0, 0});
  } else {
    result = ComputeFrame(points, matrix);
  }
  if (status != nullptr) *status = result;
}

float distance_3d(const host::Point3f* a, const host::Point3f* b) {
  if (auto fault = call::Fault(__func__)) return static_cast<float>(*fault);
  if (a == nullptr || b == nullptr) return 0.0F;
  const Vec difference = Minus(Vec{a->x, a->y, a->z}, Vec{b->x, b->y, b->z});
  return static_cast<float>(Length(difference));
}

std::int16_t iskanji_string(const char* text) {
  if (auto fault = call::Fault(__func__)) return call::AsStatus(*fault);
  if (text == nullptr) return 0;
  const auto* bytes = reinterpret_cast<const unsigned char*>(text);
  for (; *bytes != 0; ++bytes) {
    if (*bytes >= 0x80 && StartsMultiByte(bytes)) return 1;
  }
  return 0;
}
