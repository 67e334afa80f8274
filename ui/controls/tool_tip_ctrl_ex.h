// The dialogs' tool tips: one tool a control, its text a string of the string table.
#pragma once

#include "framework/controls/tool_tip.h"

class CToolTipCtrlEx : public CToolTipCtrl {
 public:
  // A tool over the control's client area that follows the mouse by itself, with the text of
  // a string id (used as a 16-bit resource id).
  BOOL AddTool(CWnd* control, UINT stringId);
};
