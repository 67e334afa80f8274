// Message boxes: a modal window with an icon, a text and the buttons its type asks for; every
// box shown is recorded with the answer it got.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "framework/win_constants.h"
#include "framework/win_types.h"

// Shows the box modally over `owner` and answers the id of the button that closed it.
int MessageBox(HWND owner, std::string_view text, std::string_view caption, UINT type);
// The application's box: the caption is the application's name, the owner its main window.
int AfxMessageBox(std::string_view text, UINT type = MB_OK, UINT helpId = 0);
int AfxMessageBox(UINT stringId, UINT type = MB_OK, UINT helpId = static_cast<UINT>(-1));

namespace framework {

struct MessageBoxRecord {
  std::string text;
  std::string caption;
  UINT type = 0;
  int answer = 0;
};

const std::vector<MessageBoxRecord>& MessageBoxLog();
void ClearMessageBoxLog();

}  // namespace framework
