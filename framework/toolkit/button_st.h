// A push button that shows one icon instead of a text and reports clicks like any push button.
#pragma once

#include "framework/controls/button.h"

class CButtonST : public CButton {
 public:
  // Shows the icon of a resource id; false when the resources have no such picture.
  BOOL SetIcon(UINT iconId);
  BOOL SetIcon(HICON icon);

 protected:
  void PreSubclassWindow() override;
};
