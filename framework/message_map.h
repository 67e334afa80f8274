// Message maps: each window class lists which message, control id and notification code runs
// which of its handlers; a class's map falls back to its base class's map.
#pragma once

#include <functional>
#include <vector>

#include "framework/win_messages.h"
#include "framework/win_structs.h"
#include "framework/win_types.h"

class CCmdTarget;

namespace framework {

struct MessageMapEntry {
  UINT message = 0;                  // WM_COMMAND, WM_NOTIFY, a reflected message, or any message
  UINT code = 0;                     // notification code of WM_COMMAND and WM_NOTIFY entries
  UINT idFirst = 0;                  // control ids the entry answers
  UINT idLast = 0;
  const UINT* registered = nullptr;  // a registered message: its number is read when dispatching
  // Runs the handler; answers whether the message counts as handled, and sets the result.
  std::function<bool(CCmdTarget&, WPARAM, LPARAM, LRESULT&)> invoke;

  bool MatchesMessage(UINT m) const { return registered != nullptr ? (*registered != 0 && *registered == m) : m == message; }
};

struct MessageMap {
  const MessageMap* base = nullptr;
  std::vector<MessageMapEntry> entries;
};

// Entry makers used by the ON_ macros below; T is the class whose map is being written.
template <class T>
MessageMapEntry CommandEntry(UINT message, UINT code, UINT id, void (T::*fn)()) {
  return {message, code, id, id, nullptr, [fn](CCmdTarget& t, WPARAM, LPARAM, LRESULT&) {
            (static_cast<T&>(t).*fn)();
            return true;
          }};
}

template <class T>
MessageMapEntry NotifyEntry(UINT message, UINT code, UINT id, void (T::*fn)(NMHDR*, LRESULT*)) {
  return {message, code, id, id, nullptr, [fn](CCmdTarget& t, WPARAM, LPARAM lParam, LRESULT& result) {
            (static_cast<T&>(t).*fn)(reinterpret_cast<NMHDR*>(lParam), &result);
            return true;
          }};
}

template <class T>
MessageMapEntry NotifyEntryEx(UINT message, UINT code, UINT id, BOOL (T::*fn)(NMHDR*, LRESULT*)) {
  return {message, code, id, id, nullptr, [fn](CCmdTarget& t, WPARAM, LPARAM lParam, LRESULT& result) {
            return (static_cast<T&>(t).*fn)(reinterpret_cast<NMHDR*>(lParam), &result) != FALSE;
          }};
}

template <class T>
MessageMapEntry MessageEntry(UINT message, const UINT* registered, LRESULT (T::*fn)(WPARAM, LPARAM)) {
  return {message, 0, 0, 0, registered, [fn](CCmdTarget& t, WPARAM wParam, LPARAM lParam, LRESULT& result) {
            result = (static_cast<T&>(t).*fn)(wParam, lParam);
            return true;
          }};
}

}  // namespace framework

// Declares a class's map inside the class.
#define DECLARE_MESSAGE_MAP()                                 \
 protected:                                                   \
  static const ::framework::MessageMap* GetThisMessageMap();  \
  const ::framework::MessageMap* GetMessageMap() const override;

// Writes a class's map in its source file: BEGIN_MESSAGE_MAP, one ON_ line a handler, END_MESSAGE_MAP.
#define BEGIN_MESSAGE_MAP(theClass, baseClass)                                                   \
  const ::framework::MessageMap* theClass::GetMessageMap() const { return GetThisMessageMap(); } \
  const ::framework::MessageMap* theClass::GetThisMessageMap() {                                 \
    using ThisClass [[maybe_unused]] = theClass;                                                 \
    static const ::framework::MessageMap map{baseClass::GetThisMessageMap(), {
#define END_MESSAGE_MAP() \
  }                       \
  }                       \
  ;                       \
  return &map;            \
  }

// Commands from menus and buttons (code 0), and control notifications by code and id.
#define ON_COMMAND(id, fn) ::framework::CommandEntry<ThisClass>(WM_COMMAND, BN_CLICKED, id, &ThisClass::fn),
#define ON_CONTROL(code, id, fn) ::framework::CommandEntry<ThisClass>(WM_COMMAND, code, id, &ThisClass::fn),
#define ON_BN_CLICKED(id, fn) ON_CONTROL(BN_CLICKED, id, fn)
#define ON_EN_CHANGE(id, fn) ON_CONTROL(EN_CHANGE, id, fn)
// WM_NOTIFY from control `id` with notification `code`: void fn(NMHDR*, LRESULT*).
#define ON_NOTIFY(code, id, fn) ::framework::NotifyEntry<ThisClass>(WM_NOTIFY, code, id, &ThisClass::fn),
// Notifications a control handles itself when its parent reflects them back to it.
#define ON_NOTIFY_REFLECT(code, fn) \
  ::framework::NotifyEntry<ThisClass>(WM_REFLECT_BASE + WM_NOTIFY, code, 0, &ThisClass::fn),
// As ON_NOTIFY_REFLECT; the handler answers FALSE to let the parent see the notification too.
#define ON_NOTIFY_REFLECT_EX(code, fn) \
  ::framework::NotifyEntryEx<ThisClass>(WM_REFLECT_BASE + WM_NOTIFY, code, 0, &ThisClass::fn),
#define ON_CONTROL_REFLECT(code, fn) \
  ::framework::CommandEntry<ThisClass>(WM_REFLECT_BASE + WM_COMMAND, code, 0, &ThisClass::fn),
// Any message by number: LRESULT fn(WPARAM, LPARAM).
#define ON_MESSAGE(message, fn) ::framework::MessageEntry<ThisClass>(message, nullptr, &ThisClass::fn),
// A registered message whose number lives in `variable` (a UINT set when the library loads).
#define ON_REGISTERED_MESSAGE(variable, fn) ::framework::MessageEntry<ThisClass>(0, &(variable), &ThisClass::fn),
