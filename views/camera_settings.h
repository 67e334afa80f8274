// A camera's editable values, as the camera settings dialog exchanges them.
#pragma once

#include <array>
#include <cstdint>
#include <string>

struct CameraSettings {
  float eye[3] = {0.0F, 0.0F, 0.0F};
  float target[3] = {0.0F, 0.0F, 0.0F};
  float cone = 0.0F;
  double viewWindow[4] = {0.0, 0.0, 0.0, 0.0};
  std::int16_t displayMode = 0;
  std::int16_t viewMode = 0;
  std::array<std::uint16_t, 256> layers{};
  std::string file2D;
  std::string comment;
  std::uint8_t patterns = 0;
  std::uint8_t showSections = 0;
  std::uint8_t autoClip = 0;
  std::uint8_t overwrite2D = 0;
  std::uint8_t removeCoincident = 0;
  std::uint8_t lineMerge = 0;
  char scaleMode = 'a';
  std::uint8_t preserveDimensions = 0;
  std::uint8_t preserveText = 0;
  std::uint8_t preserveWalls = 0;
  std::uint8_t preserveLayer = 0;
  std::int16_t preserveLayerIndex = 0;
};
