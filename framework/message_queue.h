// Messages: sent at once or posted to the queue, the pump that empties the queue (the host's
// idle pump and every modal loop), timers on a virtual clock, and registered message numbers.
#pragma once

#include <cstddef>
#include <functional>
#include <string_view>

#include "framework/win_types.h"

LRESULT SendMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT SendDlgItemMessage(HWND dialog, int id, UINT message, WPARAM wParam, LPARAM lParam);
// Queues a message for the window; answers false for a window that does not exist.
BOOL PostMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);

// Same name, same number, in the range 0xC000 to 0xFFFF, for the life of the process; names
// compare without regard to case. Answers 0 for an empty name or when the range is used up.
UINT RegisterWindowMessage(std::string_view name);

// Timers post WM_TIMER when the virtual clock passes their time.
UINT_PTR SetTimer(HWND hwnd, UINT_PTR id, UINT elapseMs);
BOOL KillTimer(HWND hwnd, UINT_PTR id);

// The virtual clock in milliseconds: it moves only when input or the host says time passed, so
// every run of a script sees the same times.
DWORD GetTickCount();
DWORD GetMessageTime();
// The screen position of the mouse when the message being handled was queued, as
// MAKELONG(x, y) with signed 16-bit halves.
DWORD GetMessagePos();
BOOL GetCursorPos(POINT* point);
// Whether a key is held down (the high bit set, as the system answers it).
short GetKeyState(int virtualKey);

// One message through the pre-translation chain: message filters, then the framework objects
// from the target window up to its top-level window.
BOOL CallPreTranslate(MSG& msg);
// Turns a key press into the character message a user gets with it (Enter, Escape, Tab,
// Backspace); printable characters come in as characters of their own.
BOOL TranslateMessage(const MSG& msg);
LRESULT DispatchMessage(const MSG& msg);

namespace framework {

// Where modal loops wait for a person: a scripted user in tests and on the command line, the
// browser front end later. AwaitInput delivers input through the input entry points and
// answers false when no more input will ever come.
class InputSource {
 public:
  virtual bool AwaitInput(HWND modalWindow) = 0;

 protected:
  ~InputSource() = default;
};
void SetInputSource(InputSource* source);
InputSource* GetInputSource();

// Filters see each queued message before the windows do (the host's own pre-translation);
// a filter that answers true consumes the message. Answers a key for RemoveMessageFilter.
using MessageFilter = std::function<bool(MSG&)>;
int AddMessageFilter(MessageFilter filter);
void RemoveMessageFilter(int key);

// Queues a message with the current mouse position and time (the input entry points use it).
void PostInputMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
void SetCursorPosition(POINT screen);
void SetKeyDown(UINT virtualKey, bool down);
void AdvanceClock(DWORD milliseconds);

// Takes the next queued message, or a due timer; false when there is none.
bool PeekNextMessage(MSG& msg);
// Pre-translates, translates and dispatches one message; false when the queue was empty.
bool PumpOneMessage();
// The idle pump: delivers every queued message and due timer, including those posted while
// it runs, and answers how many it delivered. A window that keeps posting to itself is cut
// off after a bound so that the host never hangs.
std::size_t PumpPendingMessages();
std::size_t PendingMessageCount();
std::size_t LiveTimerCount();

// Runs messages until `ended` answers true; while the queue is empty it waits for input from
// the input source. Answers false when the source had no more input before the run ended.
bool RunModalLoop(HWND modalWindow, const std::function<bool()>& ended);

// Forgets queued messages, timers and filters (a host unloading the library, a test starting).
void ResetMessageQueue();

}  // namespace framework
