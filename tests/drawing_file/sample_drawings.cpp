// Sample drawings built in code, so they always match the current drawing model.
#include "tests/drawing_file/sample_drawings.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <random>
#include <string>
#include <type_traits>
#include <vector>

namespace drawing_file_samples {
namespace {

using wb::Attribute;
using Type = wb::AttributeType;
using wb::Drawing;
using wb::Entity;

void SetHeader(Entity& entity, std::uint8_t layer, std::uint8_t color, bool hidden) {
  entity.header.bytes[host::kHeaderLayer] = layer;
  entity.header.bytes[host::kHeaderColor] = color;
  if (hidden) entity.header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  entity.header.bytes[host::kHeaderByte8] = static_cast<std::uint8_t>(layer ^ color);
}

// An attribute of the given type with `value` in the member that type keeps it in.
template <typename Value>
Attribute Make(const char* name, Type type, Value Attribute::*member, std::type_identity_t<Value> value,
               std::int16_t format = 0) {
  Attribute attribute;
  attribute.name = name;
  attribute.type = type;
  attribute.format = format;
  attribute.*member = std::move(value);
  return attribute;
}

Attribute Text(const char* name, std::string value) { return Make(name, Type::String, &Attribute::text, value); }

host::LineRecord Line(float x, float y, float length) {
  return {.lineType = 1, .color = 7, .width = 2, .unused = 0, .start = {x, y, 0.0F}, .end = {x + length, y, 3.0F}};
}

host::PlacedBlockRecord Placement(host::EntityHandle block, double offset) {
  host::PlacedBlockRecord placed{};
  placed.values[0] = 1;
  for (int i = 0; i < 16; ++i) placed.placement[i] = (i % 5 == 0) ? 1.0 : 0.0;
  placed.placement[12] = offset;
  placed.block = block;
  return placed;
}

host::ElementRecord Element(const char* shortName, float x) {
  host::ElementRecord element{};
  element.values[2] = 4;
  // Not terminated when the name takes all eight characters.
  std::memcpy(element.shortName, shortName, std::min(std::strlen(shortName), sizeof element.shortName));
  for (int i = 0; i < 16; ++i) element.placement[i] = (i % 5 == 0) ? 1.0F : 0.0F;
  element.placement[12] = x;
  return element;
}

// Bytes for the types whose records the plug-in never reads.
std::vector<std::uint8_t> Pattern(std::size_t size, std::uint8_t seed) {
  std::vector<std::uint8_t> bytes(size);
  for (std::size_t i = 0; i < size; ++i) bytes[i] = static_cast<std::uint8_t>(seed + 31 * i);
  return bytes;
}

}  // namespace

Drawing MakeDrawingWithEverything() {
  Drawing drawing;
  drawing.title = "Haus Süd \xE2\x80\x93 Schnitt A";
  drawing.layers[0].name = "Walls";
  drawing.layers[3] = {"", false};
  drawing.layers[255] = {"Last layer, switched off", false};
  // Adding may move the entities, so only handles are kept across additions.
  Entity* entity = &drawing.Add(host::kTypeLine);
  wb::WriteRecord(*entity, Line(0.0F, 0.0F, 5.5F));
  SetHeader(*entity, 0, 1, false);
  const host::EntityHandle line = entity->handle;
  drawing.Remove(drawing.Add(host::kTypePoint).handle);  // deleted between live entities

  entity = &drawing.Add(host::kTypeLine);
  wb::WriteRecord(*entity, Line(1.0F, 2.0F, 0.0F));
  entity->attributes = {Text("tb=", "Section A-A\n(second line)"), Text("t=", "")};
  SetHeader(*entity, 5, 2, true);
  const host::EntityHandle text = entity->handle;

  for (std::uint8_t type : {host::kTypeArc, host::kTypeCircle, host::kTypePolyline, host::kTypeHatch,
                            host::kTypeDimension, host::kTypeSolid}) {
    entity = &drawing.Add(type);
    entity->record = Pattern(8U * type, type);
    SetHeader(*entity, type, type, type % 2 == 0);
  }
  drawing.Add(host::kTypeSolid);  // an entity whose record was never written

  entity = &drawing.Add(host::kTypePoint);
  wb::WriteRecord(*entity, host::PointRecord{{}, {1.5F, -2.5F, 1e30F}});
  const host::EntityHandle point = entity->handle;

  entity = &drawing.Add(host::kTypeElement);
  wb::WriteRecord(*entity, Element("CAMERA01", 12.0F));
  entity->configPath = "/srv/library/Cameras";
  entity->elementName = "Camera 1";
  entity->attributes = {
      Text("@Class=", "Camera"),
      Make("mode=", Type::Short, &Attribute::shortValue, -32768),
      Make("fov=", Type::Float, &Attribute::floatValue, 47.5F, 3),
      Make("zero=", Type::Float, &Attribute::floatValue, -0.0F, -1),
      Make("far=", Type::Float, &Attribute::floatValue, std::numeric_limits<float>::infinity()),
      Make("eye=", Type::FloatVector, &Attribute::floats, {1.0F, -2.0F, 1.7F}, 2),
      Make("empty=", Type::FloatVector, &Attribute::floats, {}),
      Make("flags=", Type::ShortVector, &Attribute::shorts, {0, 1, -1, 32767}),
      Make("ids=", Type::LongVector, &Attribute::longs,
           {std::numeric_limits<std::int32_t>::min(), 0, 42, std::numeric_limits<std::int32_t>::max()}),
      Text("note=", std::string("with a \0 inside", 15)),
  };
  SetHeader(*entity, 1, 250, false);
  const host::EntityHandle element = entity->handle;

  entity = &drawing.Add(host::kTypeGroup);
  wb::WriteRecord(*entity, host::GroupRecord{.kind = 3, .reserved = {}});
  entity->name = "Section 0";
  entity->members = {line, text, element};

  entity = &drawing.Add(host::kTypeBlock);
  wb::WriteRecord(*entity, host::BlockRecord{.base = {0.0F, 0.0F, 0.0F}, .flags = 1, .reserved = {}});
  entity->name = "Sofa";
  entity->members = {point};
  const host::EntityHandle block = entity->handle;

  entity = &drawing.Add(host::kTypePlacedBlock);
  wb::WriteRecord(*entity, Placement(block, 250.0));
  entity->name = "Sofa";

  wb::WriteRecord(drawing.Add(host::kTypeGroup), host::GroupRecord{});  // without members or name

  drawing.Remove(drawing.Add(host::kTypeLine).handle);  // deleted last: the next handle must survive
  drawing.Remove(drawing.Add(host::kTypeLine).handle);
  return drawing;
}

Drawing MakeBulkDrawing(std::size_t count, unsigned seed) {
  Drawing drawing;
  drawing.title = "bulk " + std::to_string(seed);
  std::mt19937 random(seed);
  std::uniform_int_distribution<int> percent(0, 99);
  std::uniform_int_distribution<int> byte(0, 255);
  std::uniform_real_distribution<float> coordinate(-1000.0F, 1000.0F);
  std::vector<host::EntityHandle> blocks;
  const auto earlier = [&](const Entity& entity) {
    return static_cast<host::EntityHandle>(std::uniform_int_distribution<int>(1, entity.handle - 1)(random));
  };
  for (std::size_t i = 0; i < count; ++i) {
    const int kind = percent(random);
    Entity* entity = nullptr;
    if (kind < 70 || i < 8) {
      entity = &drawing.Add(host::kTypeLine);
      wb::WriteRecord(*entity, Line(coordinate(random), coordinate(random), coordinate(random)));
      if (kind < 10) entity->attributes = {Text("tb=", "Room " + std::to_string(i))};
    } else if (kind < 80) {
      entity = &drawing.Add(host::kTypeElement);
      wb::WriteRecord(*entity, Element("CAM", coordinate(random)));
      entity->configPath = "/srv/library/Cameras";
      entity->elementName = "Camera " + std::to_string(i);
      entity->attributes = {
          Text("@Class=", "Camera"),
          Make("eye=", Type::FloatVector, &Attribute::floats, {coordinate(random), coordinate(random), 1.7F}, 2),
          Make("target=", Type::FloatVector, &Attribute::floats, {coordinate(random), coordinate(random), 1.7F}, 2),
          Make("fov=", Type::Float, &Attribute::floatValue, 50.0F, 3),
          Make("mode=", Type::Short, &Attribute::shortValue, static_cast<std::int16_t>(kind)),
          Make("flags=", Type::ShortVector, &Attribute::shorts, {1, 0, static_cast<std::int16_t>(kind)}),
          Make("sections=", Type::LongVector, &Attribute::longs, {static_cast<std::int32_t>(i), 7})};
    } else if (kind < 86) {
      entity = &drawing.Add(host::kTypeGroup);
      wb::WriteRecord(*entity, host::GroupRecord{.kind = kind, .reserved = {}});
      entity->name = "Group " + std::to_string(i);
      for (int m = kind % 5 + 1; m > 0; --m) entity->members.push_back(earlier(*entity));
    } else if (kind < 90) {
      entity = &drawing.Add(host::kTypeBlock);
      wb::WriteRecord(*entity, host::BlockRecord{.base = {}, .flags = 0, .reserved = {}});
      entity->name = "Block " + std::to_string(i);
      entity->members = {earlier(*entity), earlier(*entity)};
      blocks.push_back(entity->handle);
    } else if (kind < 94) {
      entity = &drawing.Add(host::kTypePlacedBlock);
      const host::EntityHandle block = blocks.empty() ? 0 : blocks[static_cast<std::size_t>(kind) % blocks.size()];
      wb::WriteRecord(*entity, Placement(block, coordinate(random)));
    } else if (kind < 98) {
      entity = &drawing.Add(host::kTypeSolid);
      entity->record = Pattern(64, static_cast<std::uint8_t>(kind));
    } else {
      drawing.Remove(drawing.Add(host::kTypeLine).handle);
      continue;
    }
    SetHeader(*entity, static_cast<std::uint8_t>(byte(random)), static_cast<std::uint8_t>(byte(random)), kind % 7 == 0);
  }
  return drawing;
}

}  // namespace drawing_file_samples
