// A user that tests and the command line script: finds controls the way a person does (by id
// or by the text on them), and acts only through the input entry points, so whatever it does a
// person's clicks and keys would do the same. It also answers modal dialogs and message boxes,
// one queued answer each time a modal window waits for input.
#pragma once

#include <cstddef>
#include <deque>
#include <functional>
#include <stdexcept>
#include <string>
#include <string_view>

#include "framework/message_queue.h"
#include "framework/win_types.h"

namespace framework {

// Raised when the user cannot do what the script says (no such control, item or tab).
class ScriptError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class ScriptedUser final : public InputSource {
 public:
  // The user becomes the input source of modal loops until it is destroyed.
  ScriptedUser();
  ScriptedUser(const ScriptedUser&) = delete;
  ScriptedUser& operator=(const ScriptedUser&) = delete;
  ~ScriptedUser();

  // An answer gets the user and the modal window that waits for input.
  using Answer = std::function<void(ScriptedUser&, HWND modal)>;
  // Queues an answer for the next time a modal dialog or message box waits for input.
  void AnswerNext(Answer answer);
  // Queues a click on the button with that id of the next message box or dialog.
  void AnswerNextWithButton(int buttonId);
  std::size_t PendingAnswers() const { return answers_.size(); }
  // Modal windows that waited with no answer queued (each was closed as cancelled).
  int UnansweredModals() const { return unanswered_; }

  // The window the user works in: the active top-level window (an open modal dialog).
  HWND ActiveWindow() const;
  // A control by id or by the text on it (mnemonic ampersands ignored), at any depth below
  // `within` (the active window when none is given); throws ScriptError when there is none.
  HWND Find(int id, HWND within = HWND()) const;
  HWND FindByText(std::string_view text, HWND within = HWND()) const;

  // The mouse, on a point of a window's client area (its centre when none is given).
  void MoveTo(HWND window, POINT clientPoint);
  void Click(HWND window);
  void Click(HWND window, POINT clientPoint);
  void Click(int id);
  void Click(std::string_view text);
  void DoubleClick(HWND window, POINT clientPoint);
  void RightClick(HWND window, POINT clientPoint);

  // Keys: a press and release; a key with Shift or Control held; typed text.
  void Press(UINT virtualKey);
  void PressWith(UINT modifier, UINT virtualKey);
  void Type(std::string_view text);
  void Wait(DWORD milliseconds);

  // Trees, by item path: the texts from the root down, separated by "/" ("Section 0/Default").
  // Collapsed ancestors are expanded with their buttons first, as a person would.
  HTREEITEM FindItem(HWND tree, std::string_view path) const;
  void SelectItem(HWND tree, std::string_view path);
  void ToggleCheck(HWND tree, std::string_view path);
  void DoubleClickItem(HWND tree, std::string_view path);
  void ToggleExpand(HWND tree, std::string_view path);
  // Clicks the selected item's label again, waits for the editor, types the new text and
  // presses Enter (or Escape when `confirm` is false).
  void RenameItem(HWND tree, std::string_view path, std::string_view text, bool confirm = true);

  // Clicks a tab of a tab control.
  void SelectTab(HWND tabs, int index);

 private:
  bool AwaitInput(HWND modalWindow) override;
  POINT ItemPart(HWND tree, HTREEITEM item, UINT part);
  void ShowItem(HWND tree, HTREEITEM item);

  std::deque<Answer> answers_;
  int unanswered_ = 0;
  InputSource* previous_;
};

}  // namespace framework
