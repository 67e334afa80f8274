// Plain types and records shared with the host. Widths and layouts are fixed so that the
// plug-in and the host agree on every build, 32-bit included.
#pragma once

#include <cstddef>
#include <cstdint>

namespace host {

using DatabaseHandle = std::int32_t;  // handle of an open drawing, not an address
using EntityHandle = std::int32_t;    // 0 = not stored
using RecordHandle = std::int32_t;    // an open attribute record
using Status = std::int16_t;          // host calls answer 1 for success

constexpr Status kOk = 1;
constexpr Status kAttributeAbsent = -205;  // read of an attribute the record does not hold

// Host entity types (header byte 11).
enum EntityType : std::uint8_t {
  kTypeLine = 1,  // texts are lines carrying "tb="
  kTypeArc = 2,
  kTypeCircle = 3,
  kTypeElement = 4,  // placed library object
  kTypePolyline = 5,
  kTypeHatch = 6,
  kTypeDimension = 7,
  kTypePoint = 8,
  kTypeSolid = 9,
  kTypeGroup = 10,
  kTypeBlock = 11,
  kTypePlacedBlock = 12,
};

// The host's 18-byte entity header. The plug-in uses bytes 8 to 11; the host keeps the
// layer index in byte 12, the colour in byte 13, and the two category codes and the flag byte
// its database loop reports in bytes 14, 15 and 16.
struct EntityHeader {
  std::uint8_t bytes[18];
};
constexpr std::size_t kHeaderByte8 = 8;
constexpr std::size_t kHeaderByte9 = 9;
constexpr std::size_t kHeaderFlags = 10;
constexpr std::size_t kHeaderType = 11;
constexpr std::size_t kHeaderLayer = 12;
constexpr std::size_t kHeaderColor = 13;
constexpr std::size_t kHeaderCategoryCode = 14;  // reported as byte 1 by the database loop
constexpr std::size_t kHeaderCategoryKind = 15;  // reported as byte 3
constexpr std::size_t kHeaderLoopFlags = 16;     // reported as byte 2
constexpr std::uint8_t kFlagHidden = 0x80;

struct Point3f {
  float x, y, z;
};

struct LineRecord {
  std::uint8_t lineType;
  std::uint8_t color;
  std::uint8_t width;
  std::uint8_t unused;
  Point3f start;
  Point3f end;
};

// Block definition record: opaque to the plug-in, kept and passed whole.
struct BlockRecord {
  Point3f base;
  std::int32_t flags;
  std::uint8_t reserved[16];
};

// Group record: opaque to the plug-in, kept and passed whole.
struct GroupRecord {
  std::int32_t kind;
  std::uint8_t reserved[28];
};

// Point record: the plug-in uses the position only.
struct PointRecord {
  std::uint8_t unused[4];
  Point3f position;
};

// Insertion of a block. The placement is a 4x4 row-vector matrix stored row by row; the
// explicit padding keeps its offset at 8 on 32-bit builds too.
struct PlacedBlockRecord {
  std::uint8_t values[3];
  std::uint8_t unused;
  std::uint8_t padding[4];
  double placement[16];
  EntityHandle block;
  std::uint8_t tail[4];
};

// A placed library element.
struct ElementRecord {
  std::uint8_t values[3];
  std::uint8_t unused;
  char shortName[8];  // not necessarily terminated
  float placement[16];
};

static_assert(sizeof(EntityHeader) == 18);
static_assert(sizeof(Point3f) == 12);
static_assert(sizeof(LineRecord) == 28 && offsetof(LineRecord, start) == 4 && offsetof(LineRecord, end) == 16);
static_assert(sizeof(BlockRecord) == 32);
static_assert(sizeof(GroupRecord) == 32);
static_assert(sizeof(PointRecord) == 16);
static_assert(sizeof(PlacedBlockRecord) == 144 && offsetof(PlacedBlockRecord, placement) == 8 &&
              offsetof(PlacedBlockRecord, block) == 136);
static_assert(sizeof(ElementRecord) == 76 && offsetof(ElementRecord, shortName) == 4 &&
              offsetof(ElementRecord, placement) == 12);

}  // namespace host
