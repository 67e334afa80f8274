// Dialog 5012, "Camera Settings": the camera's coordinates, its look (2D/3D, projection,
// patterns, display mode, layers, scale) and its 2D drawing settings, laid out in three groups
// one above the other, labels left of their controls, OK and Cancel at the bottom right.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& CameraSettingsTemplate() {
  using namespace framework;
  constexpr DWORD kLabel = WS_VISIBLE | SS_LEFT;
  constexpr DWORD kIconButton = WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON;
  constexpr DWORD kCheck = WS_VISIBLE | WS_TABSTOP | BS_AUTOCHECKBOX;
  constexpr DWORD kDropList = WS_VISIBLE | WS_TABSTOP | WS_VSCROLL | CBS_DROPDOWNLIST;
  constexpr DWORD kGroup = WS_VISIBLE | BS_GROUPBOX;
  static const DialogTemplate camera{
      kIddCameraSettings, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_SETFONT | DS_CENTER, 0, 0, 0, 271,
      306, "Camera Settings", "MS Shell Dlg", 8, false,
      {
          {IDC_STATIC, kButtonClass, " Coordinate Camera", kGroup, 0, 7, 4, 257, 48},
          {5057, kStaticClass, "", kLabel | SS_NOPREFIX, 0, 15, 16, 241, 9},
          {5058, kStaticClass, "", kLabel | SS_NOPREFIX, 0, 15, 27, 241, 9},
          {5059, kStaticClass, "", kLabel | SS_NOPREFIX, 0, 15, 38, 241, 9},

          {IDC_STATIC, kButtonClass, " Visualization Settings ", kGroup, 0, 7, 57, 257, 92},
          {IDC_STATIC, kStaticClass, "2D / 3D :", kLabel, 0, 15, 72, 62, 8},
          {5030, kButtonClass, "", kIconButton, 0, 80, 68, 24, 16},
          {IDC_STATIC, kStaticClass, "View Mode :", kLabel, 0, 15, 92, 62, 8},
          {5031, kButtonClass, "", kIconButton, 0, 80, 88, 24, 16},
          {IDC_STATIC, kStaticClass, "Patterns On/Off :", kLabel, 0, 15, 112, 62, 8},
          {5061, kButtonClass, "", kIconButton, 0, 80, 108, 24, 16},
          {IDC_STATIC, kStaticClass, "Scale mode:", kLabel, 0, 15, 132, 62, 8},
          {5079, kComboBoxClass, "", kDropList, 0, 80, 129, 64, 60, {"Auto scale", "Fixed scale", "Scale off"}},
          {IDC_STATIC, kStaticClass, "Display Mode :", kLabel, 0, 150, 70, 106, 8},
          {5032, kButtonClass, "", kIconButton, 0, 150, 80, 106, 18},
          {5033, kButtonClass, "Layers Configuration", kIconButton, 0, 150, 106, 106, 18},

          {IDC_STATIC, kButtonClass, "2D Drawing Settings", kGroup, 0, 7, 154, 257, 118},
          {IDC_STATIC, kStaticClass, "Comments", kLabel, 0, 15, 168, 40, 8},
          {5035, kEditClass, "", WS_VISIBLE | WS_TABSTOP | WS_BORDER | ES_AUTOHSCROLL, 0, 58, 166, 198, 13},
          {5063, kButtonClass, "Display section symbol text and dimension", kCheck, 0, 15, 185, 241, 10},
          {5077, kButtonClass, "Auto clip", kCheck, 0, 15, 199, 118, 10},
          {5078, kButtonClass, "Save 2D overwrite", kCheck, 0, 15, 212, 118, 10},
          {5080, kButtonClass, "Line merge", kCheck, 0, 15, 225, 118, 10},
          {5081, kButtonClass, "Remove coincidental lines", kCheck, 0, 15, 238, 118, 10},
          {5082, kButtonClass, "Preserve Walls", kCheck, 0, 140, 199, 118, 10},
          {5083, kButtonClass, "Preserve\xA0XY dimension", kCheck, 0, 140, 212, 118, 10},
          {5084, kButtonClass, "Preserve XY text", kCheck, 0, 140, 225, 118, 10},
          {5085, kButtonClass, "Preserve entities on Layer", kCheck, 0, 140, 238, 118, 10},
          {5086, kComboBoxClass, "", kDropList, 0, 152, 251, 50, 100},

          // The detail level: created hidden, so the user never reaches its menu.
          {IDC_STATIC, kStaticClass, "Detail :", SS_LEFT, 0, 15, 288, 30, 8},
          {5062, kButtonClass, "", WS_TABSTOP | BS_PUSHBUTTON, 0, 48, 285, 60, 14},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 150, 285, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 207, 285, 50, 14},
      }};
  return camera;
}

}  // namespace resources
