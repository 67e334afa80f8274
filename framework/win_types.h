// The basic types of the window layer: integers with the widths the host's window system gives
// them, 32-bit handles, points, rectangles, colours and the queued message record.
#pragma once

#include <compare>
#include <cstddef>
#include <cstdint>

using BYTE = std::uint8_t;
using WORD = std::uint16_t;
using DWORD = std::uint32_t;
using UINT = std::uint32_t;
using LONG = std::int32_t;
using BOOL = int;
using INT_PTR = std::intptr_t;
using UINT_PTR = std::uintptr_t;
using DWORD_PTR = std::uintptr_t;
using WPARAM = std::uintptr_t;
using LPARAM = std::intptr_t;
using LRESULT = std::intptr_t;
using COLORREF = std::uint32_t;

constexpr BOOL TRUE = 1;
constexpr BOOL FALSE = 0;

// An opaque 32-bit handle. Zero is no object; values are never reused within a process, so a
// handle kept past its object's end finds nothing instead of a newer object.
template <class Tag>
class Handle {
 public:
  constexpr Handle() = default;
  constexpr Handle(std::nullptr_t) {}  // NOLINT: handles compare and assign with nullptr
  constexpr explicit Handle(std::uint32_t value) : value_(value) {}

  constexpr std::uint32_t Value() const { return value_; }
  constexpr explicit operator bool() const { return value_ != 0; }
  friend constexpr bool operator==(Handle, Handle) = default;
  friend constexpr auto operator<=>(Handle, Handle) = default;

  // Handles travel in message parameters as their 32-bit value.
  constexpr LPARAM ToLParam() const { return static_cast<LPARAM>(value_); }
  constexpr WPARAM ToWParam() const { return static_cast<WPARAM>(value_); }
  static constexpr Handle FromParam(std::uintptr_t param) { return Handle(static_cast<std::uint32_t>(param)); }
  static constexpr Handle FromParam(std::intptr_t param) { return FromParam(static_cast<std::uintptr_t>(param)); }

 private:
  std::uint32_t value_ = 0;
};

using HWND = Handle<struct WindowTag>;
using HTREEITEM = Handle<struct TreeItemTag>;
using HICON = Handle<struct IconTag>;
using HIMAGELIST = Handle<struct ImageListTag>;

class Canvas;
using HDC = Canvas*;  // a device context is the canvas a window paints into

struct POINT {
  LONG x = 0;
  LONG y = 0;
  friend constexpr bool operator==(const POINT&, const POINT&) = default;
};

struct SIZE {
  LONG cx = 0;
  LONG cy = 0;
  friend constexpr bool operator==(const SIZE&, const SIZE&) = default;
};

struct RECT {
  LONG left = 0;
  LONG top = 0;
  LONG right = 0;
  LONG bottom = 0;
  friend constexpr bool operator==(const RECT&, const RECT&) = default;
};

// One message as the queue keeps it: the target, the message, its parameters, the virtual time
// it was posted at and the mouse position (screen pixels) at that time.
struct MSG {
  HWND hwnd;
  UINT message = 0;
  WPARAM wParam = 0;
  LPARAM lParam = 0;
  DWORD time = 0;
  POINT pt;
};

constexpr COLORREF RGB(int r, int g, int b) {
  return static_cast<COLORREF>((r & 0xFF) | ((g & 0xFF) << 8) | ((b & 0xFF) << 16));
}
constexpr int GetRValue(COLORREF c) { return static_cast<int>(c & 0xFF); }
constexpr int GetGValue(COLORREF c) { return static_cast<int>((c >> 8) & 0xFF); }
constexpr int GetBValue(COLORREF c) { return static_cast<int>((c >> 16) & 0xFF); }

constexpr WORD LOWORD(std::uintptr_t v) { return static_cast<WORD>(v & 0xFFFF); }
constexpr WORD HIWORD(std::uintptr_t v) { return static_cast<WORD>((v >> 16) & 0xFFFF); }
constexpr DWORD MAKELONG(unsigned low, unsigned high) { return (low & 0xFFFFU) | ((high & 0xFFFFU) << 16); }
constexpr WPARAM MAKEWPARAM(unsigned low, unsigned high) { return MAKELONG(low, high); }
constexpr LPARAM MAKELPARAM(int low, int high) {
  return static_cast<LPARAM>(static_cast<std::int32_t>(MAKELONG(static_cast<unsigned>(low), static_cast<unsigned>(high))));
}
// Mouse coordinates are signed 16-bit halves: a point left of or above a window is negative.
constexpr int GET_X_LPARAM(LPARAM lp) { return static_cast<std::int16_t>(LOWORD(static_cast<std::uintptr_t>(lp))); }
constexpr int GET_Y_LPARAM(LPARAM lp) { return static_cast<std::int16_t>(HIWORD(static_cast<std::uintptr_t>(lp))); }
