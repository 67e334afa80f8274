// The message queue, its pump, the modal loop, timers on the virtual clock and the pre-translation
// chain.
#include "framework/message_queue.h"

#include <algorithm>
#include <cctype>
#include <deque>
#include <map>
#include <string>
#include <vector>

#include "framework/win_constants.h"
#include "framework/win_messages.h"
#include "framework/window_system.h"
#include "framework/window_table.h"

namespace {

struct Timer {
  HWND hwnd;
  UINT_PTR id = 0;
  UINT elapse = 0;
  DWORD due = 0;
};

struct Queue {
  std::deque<MSG> messages;
  std::vector<Timer> timers;
  std::map<int, framework::MessageFilter> filters;
  int nextKey = 1;
  DWORD now = 0;
  POINT cursor;
  std::vector<UINT> keysDown;
  MSG current;
  framework::InputSource* input = nullptr;
};

Queue& TheQueue() {
  static Queue queue;
  return queue;
}

// A window that posts to itself from its own handler would keep the idle pump busy for ever.
constexpr std::size_t kIdlePumpBound = 10000;

bool TakeDueTimer(MSG& msg) {
  Queue& q = TheQueue();
  Timer* due = nullptr;
  for (Timer& timer : q.timers) {
    if (timer.due <= q.now && (due == nullptr || timer.due < due->due)) due = &timer;
  }
  if (due == nullptr) return false;
  due->due = q.now + std::max<UINT>(1, due->elapse);
  msg = MSG{due->hwnd, WM_TIMER, due->id, 0, q.now, q.cursor};
  return true;
}

}  // namespace

BOOL PostMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  if (!IsWindow(hwnd)) return FALSE;
  Queue& q = TheQueue();
  q.messages.push_back(MSG{hwnd, message, wParam, lParam, q.now, q.cursor});
  return TRUE;
}

LRESULT SendDlgItemMessage(HWND dialog, int id, UINT message, WPARAM wParam, LPARAM lParam) {
  return SendMessage(GetDlgItem(dialog, id), message, wParam, lParam);
}

UINT RegisterWindowMessage(std::string_view name) {
  static std::map<std::string, UINT> registered;
  static UINT next = kFirstRegisteredMessage;
  if (name.empty()) return 0;
  std::string key(name);
  std::transform(key.begin(), key.end(), key.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
  if (const auto it = registered.find(key); it != registered.end()) return it->second;
  if (next > kLastRegisteredMessage) return 0;
  registered.emplace(key, next);
  return next++;
}

UINT_PTR SetTimer(HWND hwnd, UINT_PTR id, UINT elapseMs) {
  if (!IsWindow(hwnd)) return 0;
  Queue& q = TheQueue();
  const DWORD due = q.now + std::max<UINT>(1, elapseMs);
  for (Timer& timer : q.timers) {
    if (timer.hwnd == hwnd && timer.id == id) {
      timer.elapse = elapseMs;
      timer.due = due;
      return id;
    }
  }
  q.timers.push_back(Timer{hwnd, id, elapseMs, due});
  return id;
}

BOOL KillTimer(HWND hwnd, UINT_PTR id) {
  auto& timers = TheQueue().timers;
  const auto removed = std::erase_if(timers, [&](const Timer& t) { return t.hwnd == hwnd && t.id == id; });
  // A WM_TIMER already queued for it is dropped as well.
  std::erase_if(TheQueue().messages,
                [&](const MSG& m) { return m.hwnd == hwnd && m.message == WM_TIMER && m.wParam == id; });
  return removed > 0 ? TRUE : FALSE;
}

DWORD GetTickCount() { return TheQueue().now; }
DWORD GetMessageTime() { return TheQueue().current.time; }

DWORD GetMessagePos() {
  const POINT p = TheQueue().current.pt;
  return MAKELONG(static_cast<unsigned>(p.x), static_cast<unsigned>(p.y));
}

BOOL GetCursorPos(POINT* point) {
  if (point == nullptr) return FALSE;
  *point = TheQueue().cursor;
  return TRUE;
}

short GetKeyState(int virtualKey) {
  const auto& keys = TheQueue().keysDown;
  return std::find(keys.begin(), keys.end(), static_cast<UINT>(virtualKey)) != keys.end() ? static_cast<short>(0x8000)
                                                                                          : 0;
}

BOOL CallPreTranslate(MSG& msg) {
  for (const auto& [key, filter] : std::map<int, framework::MessageFilter>(TheQueue().filters)) {
    if (filter(msg)) return TRUE;
  }
  // The framework objects from the target up to its top-level window, innermost first.
  for (HWND h = msg.hwnd; h; h = (GetWindowStyle(h) & WS_CHILD) != 0 ? GetParent(h) : HWND()) {
    if (framework::AttachedObject* object = framework::GetAttachedObject(h)) {
      if (object->PreTranslate(msg)) return TRUE;
    }
  }
  return FALSE;
}

BOOL TranslateMessage(const MSG& msg) {
  if (msg.message != WM_KEYDOWN) return FALSE;
  char character = 0;
  switch (msg.wParam) {
    case VK_RETURN:
      character = '\r';
      break;
    case VK_ESCAPE:
      character = 0x1B;
      break;
    case VK_TAB:
      character = '\t';
      break;
    case VK_BACK:
      character = 0x08;
      break;
    default:
      return FALSE;
  }
  Queue& q = TheQueue();
  q.messages.push_front(MSG{msg.hwnd, WM_CHAR, static_cast<WPARAM>(character), msg.lParam, msg.time, msg.pt});
  return TRUE;
}

LRESULT DispatchMessage(const MSG& msg) {
  Queue& q = TheQueue();
  q.current = msg;
  return SendMessage(msg.hwnd, msg.message, msg.wParam, msg.lParam);
}

namespace framework {

void SetInputSource(InputSource* source) { TheQueue().input = source; }
InputSource* GetInputSource() { return TheQueue().input; }

int AddMessageFilter(MessageFilter filter) {
  Queue& q = TheQueue();
  q.filters.emplace(q.nextKey, std::move(filter));
  return q.nextKey++;
}

void RemoveMessageFilter(int key) { TheQueue().filters.erase(key); }

void PostInputMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  ::PostMessage(hwnd, message, wParam, lParam);
}

void SetCursorPosition(POINT screen) { TheQueue().cursor = screen; }

void SetKeyDown(UINT virtualKey, bool down) {
  auto& keys = TheQueue().keysDown;
  std::erase(keys, virtualKey);
  if (down) keys.push_back(virtualKey);
}

void AdvanceClock(DWORD milliseconds) { TheQueue().now += milliseconds; }

bool PeekNextMessage(MSG& msg) {
  Queue& q = TheQueue();
  while (!q.messages.empty()) {
    msg = q.messages.front();
    q.messages.pop_front();
    if (IsWindow(msg.hwnd)) return true;  // messages for windows destroyed meanwhile are dropped
  }
  return TakeDueTimer(msg);
}

bool PumpOneMessage() {
  MSG msg;
  if (!PeekNextMessage(msg)) return false;
  TheQueue().current = msg;
  if (!CallPreTranslate(msg)) {
    TranslateMessage(msg);
    DispatchMessage(msg);
  }
  return true;
}

std::size_t PumpPendingMessages() {
  std::size_t delivered = 0;
  while (delivered < kIdlePumpBound && PumpOneMessage()) ++delivered;
  return delivered;
}

std::size_t PendingMessageCount() { return TheQueue().messages.size(); }
std::size_t LiveTimerCount() { return TheQueue().timers.size(); }

bool RunModalLoop(HWND modalWindow, const std::function<bool()>& ended) {
  while (!ended()) {
    if (PumpOneMessage()) continue;
    InputSource* source = GetInputSource();
    if (source == nullptr || !source->AwaitInput(modalWindow)) return false;
  }
  return true;
}

void ResetMessageQueue() {
  Queue& q = TheQueue();
  q.messages.clear();
  q.timers.clear();
  q.filters.clear();
  q.keysDown.clear();
  q.current = MSG{};
}

namespace detail {

void ForgetWindowTimers(HWND hwnd) {
  std::erase_if(TheQueue().timers, [&](const Timer& t) { return t.hwnd == hwnd; });
}

}  // namespace detail
}  // namespace framework
