// The input entry points: where a person's mouse and keys enter the window system, from the
// scripted user, the command line or a browser showing the windows' pictures. Each call turns
// the input into the messages the window system would queue for it (after a hit test for the
// mouse, to the focus for keys) and delivers them, with everything they post, before it returns.
#pragma once

#include "framework/win_types.h"

namespace framework::input {

enum class MouseButton { kLeft, kRight, kMiddle };

// Points are in a top-level window's own pixels: (0, 0) is its top-left corner, as a front end
// that shows that window's picture measures a click on it. The window under the point gets the
// input (a window lying over `topLevel` included); a window disabled by a modal dialog gets none.
void MouseMove(HWND topLevel, POINT point);
// A double click is the second press of two; windows whose class does not ask for double
// clicks get it as a plain press.
void MouseDown(HWND topLevel, POINT point, MouseButton button = MouseButton::kLeft, bool doubleClick = false);
void MouseUp(HWND topLevel, POINT point, MouseButton button = MouseButton::kLeft);

// Keys go to the window with the focus (the active window when none has it).
void KeyDown(UINT virtualKey);
void KeyUp(UINT virtualKey);
// A typed character of the 8-bit code page.
void Character(char character);

// Time passes: timers that fall due run (a tip appears, a label edit starts).
void Wait(DWORD milliseconds);

}  // namespace framework::input
