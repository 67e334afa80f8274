// The library's application object and the appearance it gives to newly added sections.
#pragma once

#include <cstdint>
#include <string>

#include "framework/cwinapp.h"

class CPandexApp : public CWinApp {
 public:
  CPandexApp() = default;
  ~CPandexApp() override = default;

  // Written by the section settings dialog, read when a section is added.
  std::int16_t lineColor = 1;  // host colour index of the section line
  std::int16_t lineType = 1;   // 0..7, one of the eight offered line types
  std::int16_t lineWidth = 1;  // 1 or 2
  std::string symbolFile = "...sec_sym\\sec01";  // library path of the end symbols
};

// The application object of the loaded library; null while the library is not loaded.
CPandexApp* TheApp();
