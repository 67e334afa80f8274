// A section's editable values, as the section settings dialog and the add command exchange them.
#pragma once

#include <cstdint>
#include <string>

struct SectionSettings {
  float start[3] = {0.0F, 0.0F, 0.0F};
  float end[3] = {0.0F, 0.0F, 0.0F};
  std::string symbolFile;
  std::string comment;  // shown by the dialog; a section keeps none
  std::uint16_t lineType = 1;
  std::uint16_t lineWidth = 1;
  std::uint16_t lineColor = 1;
  char cutType = 'b';
};
