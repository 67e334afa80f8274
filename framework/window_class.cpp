// The class registry and the default window procedure.
#include "framework/window_class.h"

#include <algorithm>
#include <cstring>
#include <map>
#include <string>

#include "framework/message_queue.h"
#include "framework/win_messages.h"
#include "framework/window_table.h"

namespace framework {
namespace {

struct RegisteredClass {
  UINT style = 0;
  BehaviourFactory factory;
};

// Class names compare without regard to case, as the system's do.
struct CaseInsensitiveLess {
  bool operator()(const std::string& a, const std::string& b) const {
    return std::lexicographical_compare(a.begin(), a.end(), b.begin(), b.end(), [](char x, char y) {
      return std::tolower(static_cast<unsigned char>(x)) < std::tolower(static_cast<unsigned char>(y));
    });
  }
};

std::map<std::string, RegisteredClass, CaseInsensitiveLess>& Classes() {
  static std::map<std::string, RegisteredClass, CaseInsensitiveLess> classes;
  return classes;
}

}  // namespace

LRESULT WindowBehaviour::Handle(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  return ::DefWindowProc(hwnd, message, wParam, lParam);
}

std::string WindowBehaviour::StateWords(HWND) const { return {}; }

bool RegisterWindowClass(std::string_view name, UINT classStyle, BehaviourFactory factory) {
  if (name.empty()) return false;
  Classes()[std::string(name)] = RegisteredClass{classStyle, std::move(factory)};
  return true;
}

bool IsWindowClassRegistered(std::string_view name) { return Classes().contains(std::string(name)); }

UINT GetClassStyle(std::string_view name) {
  const auto it = Classes().find(std::string(name));
  return it != Classes().end() ? it->second.style : 0;
}

WindowBehaviour* GetWindowBehaviour(HWND hwnd) {
  detail::Window* w = detail::Find(hwnd);
  return w != nullptr ? w->behaviour.get() : nullptr;
}

namespace detail {

std::unique_ptr<WindowBehaviour> MakeBehaviour(std::string_view className) {
  const auto it = Classes().find(std::string(className));
  if (it == Classes().end() || !it->second.factory) return nullptr;
  return it->second.factory();
}

}  // namespace detail
}  // namespace framework

LRESULT DefWindowProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  framework::detail::Window* w = framework::detail::Find(hwnd);
  if (w == nullptr) return 0;
  switch (message) {
    case WM_NCCREATE:
      return TRUE;
    case WM_SETTEXT:
      w->text = lParam != 0 ? reinterpret_cast<const char*>(lParam) : "";
      ++w->paint.invalidations;
      return TRUE;
    case WM_GETTEXTLENGTH:
      return static_cast<LRESULT>(w->text.size());
    case WM_GETTEXT: {
      if (wParam == 0 || lParam == 0) return 0;
      const std::size_t n = std::min<std::size_t>(wParam - 1, w->text.size());
      auto* buffer = reinterpret_cast<char*>(lParam);
      std::memcpy(buffer, w->text.data(), n);
      buffer[n] = '\0';
      return static_cast<LRESULT>(n);
    }
    case WM_CLOSE:
      DestroyWindow(hwnd);
      return 0;
    case WM_NCHITTEST:
      return HTCLIENT;
    case WM_SYSCOMMAND:
      if ((wParam & 0xFFF0) == 0xF060) SendMessage(hwnd, WM_CLOSE, 0, 0);  // SC_CLOSE
      return 0;
    default:
      return 0;
  }
}
