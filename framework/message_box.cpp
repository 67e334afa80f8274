// Message boxes as dialogs laid out for their text: an icon, the wrapped text, a row of buttons
// on the right; Enter presses the first button, Escape the Cancel button (or OK when it is the
// only one).
#include "framework/message_box.h"

#include <algorithm>
#include <vector>

#include "framework/canvas.h"
#include "framework/cdc.h"
#include "framework/cdialog.h"
#include "framework/controls/static_control.h"
#include "framework/cwinapp.h"
#include "framework/resource_module.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace {

std::vector<framework::MessageBoxRecord>& Log() {
  static std::vector<framework::MessageBoxRecord> log;
  return log;
}

struct BoxButton {
  int id;
  std::string_view text;
};

std::vector<BoxButton> ButtonsOf(UINT type) {
  switch (type & MB_TYPEMASK) {
    case MB_OKCANCEL:
      return {{IDOK, "OK"}, {IDCANCEL, "Cancel"}};
    case MB_ABORTRETRYIGNORE:
      return {{IDABORT, "&Abort"}, {IDRETRY, "&Retry"}, {IDIGNORE, "&Ignore"}};
    case MB_YESNOCANCEL:
      return {{IDYES, "&Yes"}, {IDNO, "&No"}, {IDCANCEL, "Cancel"}};
    case MB_YESNO:
      return {{IDYES, "&Yes"}, {IDNO, "&No"}};
    case MB_RETRYCANCEL:
      return {{IDRETRY, "&Retry"}, {IDCANCEL, "Cancel"}};
    default:
      return {{IDOK, "OK"}};
  }
}

int IconOf(UINT type) {
  switch (type & MB_ICONMASK) {
    case MB_ICONHAND:
      return IDI_HAND;
    case MB_ICONQUESTION:
      return IDI_QUESTION;
    case MB_ICONEXCLAMATION:
      return IDI_EXCLAMATION;
    case MB_ICONASTERISK:
      return IDI_ASTERISK;
    default:
      return 0;
  }
}

constexpr int kIconControlId = 20;
constexpr int kTextControlId = 0xFFFF;

// Pixels to dialog units, the other way round from the dialog font metric.
short UnitsX(int pixels) { return static_cast<short>(framework::MulDiv(pixels, 4, framework::kDialogBaseUnitX)); }
short UnitsY(int pixels) { return static_cast<short>(framework::MulDiv(pixels, 8, framework::kDialogBaseUnitY)); }

DialogTemplate LayOut(std::string_view text, std::string_view caption, UINT type) {
  constexpr int kMargin = 11;
  constexpr int kButtonWidth = 75;
  constexpr int kButtonHeight = 23;
  constexpr int kGap = 6;
  constexpr int kMaxTextWidth = 380;
  const int icon = IconOf(type);
  const int iconSize = icon != 0 ? ::GetSystemMetrics(SM_CXICON) : 0;
  const int textLeft = kMargin + (icon != 0 ? iconSize + kMargin : 0);

  Canvas measure(1, 1);
  CRect textRect(0, 0, kMaxTextWidth, 0);
  measure.Dc().DrawText(text, &textRect, DT_WORDBREAK | DT_CALCRECT | DT_NOPREFIX);
  const int textWidth = std::max<int>(textRect.Width(), 1);
  const int textHeight = std::max<int>(textRect.Height(), framework::kLineHeight);

  const std::vector<BoxButton> buttons = ButtonsOf(type);
  const int rowWidth = static_cast<int>(buttons.size()) * (kButtonWidth + kGap) - kGap;
  const int clientWidth = std::max(textLeft + textWidth + kMargin, rowWidth + 2 * kMargin);
  const int contentBottom = kMargin + std::max(textHeight, iconSize);
  const int rowTop = contentBottom + 14;
  const int clientHeight = rowTop + kButtonHeight + kMargin;

  DialogTemplate t;
  t.style = WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_CENTER;
  t.cx = UnitsX(clientWidth);
  t.cy = UnitsY(clientHeight);
  t.caption = caption;
  if (icon != 0) {
    t.items.push_back({kIconControlId, framework::kStaticClass, "", WS_VISIBLE | SS_ICON, 0, UnitsX(kMargin),
                       UnitsY(kMargin), UnitsX(iconSize), UnitsY(iconSize)});
  }
  const int textTop = kMargin + std::max(0, (iconSize - textHeight) / 2);
  t.items.push_back({kTextControlId, framework::kStaticClass, text, WS_VISIBLE | SS_LEFT | SS_NOPREFIX, 0, UnitsX(textLeft),
                     UnitsY(textTop), UnitsX(textWidth + 2), UnitsY(textHeight)});
  int left = clientWidth - kMargin - rowWidth;
  bool first = true;
  for (const BoxButton& button : buttons) {
    t.items.push_back({button.id, framework::kButtonClass, button.text,
                       WS_VISIBLE | WS_TABSTOP | (first ? BS_DEFPUSHBUTTON : BS_PUSHBUTTON), 0, UnitsX(left),
                       UnitsY(rowTop), UnitsX(kButtonWidth), UnitsY(kButtonHeight)});
    left += kButtonWidth + kGap;
    first = false;
  }
  return t;
}

class MessageBoxDialog : public CDialog {
 public:
  MessageBoxDialog(const DialogTemplate& t, CWnd* owner, UINT type) : CDialog(t, owner), type_(type) {}

 protected:
  BOOL OnInitDialog() override {
    CDialog::OnInitDialog();
    if (const int icon = IconOf(type_); icon != 0) {
      ::SendDlgItemMessage(m_hWnd, kIconControlId, STM_SETICON, AfxLoadIcon(static_cast<UINT>(icon)).ToWParam(), 0);
    }
    return TRUE;
  }

  BOOL OnCommand(WPARAM wParam, LPARAM) override {
    const int id = LOWORD(wParam);
    const std::vector<BoxButton> buttons = ButtonsOf(type_);
    const bool ownButton = std::any_of(buttons.begin(), buttons.end(), [id](const BoxButton& b) { return b.id == id; });
    if (ownButton) {
      EndDialog(id);
    } else if (id == IDCANCEL && buttons.size() == 1) {
      EndDialog(buttons.front().id);  // a box with only OK closes with OK on Escape
    }
    return TRUE;
  }

 private:
  UINT type_;
};

}  // namespace

int MessageBox(HWND owner, std::string_view text, std::string_view caption, UINT type) {
  const std::string textCopy(text);
  const std::string captionCopy(caption);
  const DialogTemplate layout = LayOut(textCopy, captionCopy, type);
  MessageBoxDialog dialog(layout, CWnd::FromHandle(owner), type);
  const auto result = static_cast<int>(dialog.DoModal());
  Log().push_back({textCopy, captionCopy, type, result});
  return result;
}

int AfxMessageBox(std::string_view text, UINT type, UINT) {
  HWND owner = ::GetActiveWindow();
  if (!owner) {
    if (CWnd* main = AfxGetMainWnd()) owner = main->m_hWnd;
  }
  return MessageBox(owner, text, framework::ApplicationName(), type);
}

int AfxMessageBox(UINT stringId, UINT type, UINT helpId) {
  return AfxMessageBox(AfxLoadString(stringId), type, helpId == static_cast<UINT>(-1) ? stringId : helpId);
}

namespace framework {

const std::vector<MessageBoxRecord>& MessageBoxLog() { return Log(); }
void ClearMessageBoxLog() { Log().clear(); }

}  // namespace framework
