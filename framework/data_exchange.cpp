// Data exchange: texts, numbers and check boxes between controls and values.
#include "framework/data_exchange.h"

#include <cerrno>
#include <cfloat>
#include <cstdint>
#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "framework/cwnd.h"
#include "framework/message_box.h"

namespace {

// The framework's own texts for a refused number.
constexpr std::string_view kEnterInteger = "Please enter an integer.";
constexpr std::string_view kEnterNumber = "Please enter a number.";

std::string Trimmed(const std::string& text) {
  const auto first = text.find_first_not_of(" \t");
  if (first == std::string::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

bool ParseInteger(const std::string& text, int& out) {
  const std::string t = Trimmed(text);
  if (t.empty()) return false;
  errno = 0;
  char* end = nullptr;
  const long value = std::strtol(t.c_str(), &end, 10);
  if (errno != 0 || *end != '\0' || value < INT32_MIN || value > INT32_MAX) return false;
  out = static_cast<int>(value);
  return true;
}

bool ParseNumber(const std::string& text, double& out) {
  const std::string t = Trimmed(text);
  if (t.empty()) return false;
  errno = 0;
  char* end = nullptr;
  const double value = std::strtod(t.c_str(), &end);
  if (errno != 0 || *end != '\0' || !std::isfinite(value)) return false;
  out = value;
  return true;
}

void Refuse(CDataExchange* dx, std::string_view message) {
  AfxMessageBox(message, MB_OK | MB_ICONEXCLAMATION);
  dx->Fail();
}

}  // namespace

HWND CDataExchange::PrepareCtrl(int id) {
  if (failed_) return HWND();
  lastControl_ = ::GetDlgItem(m_pDlgWnd->m_hWnd, id);
  if (!lastControl_) failed_ = true;
  return lastControl_;
}

void CDataExchange::Fail() {
  failed_ = true;
  if (::IsWindow(lastControl_)) {
    ::SetFocus(lastControl_);
    ::SendMessage(lastControl_, EM_SETSEL, 0, -1);
  }
}

void DDX_Control(CDataExchange* dx, int id, CWnd& control) {
  if (control.m_hWnd) return;  // bound once, on the first exchange
  const HWND hwnd = dx->PrepareCtrl(id);
  if (hwnd) control.SubclassWindow(hwnd);
}

void DDX_Text(CDataExchange* dx, int id, std::string& value) {
  const HWND hwnd = dx->PrepareCtrl(id);
  if (!hwnd) return;
  if (dx->m_bSaveAndValidate) {
    value = ::GetWindowText(hwnd);
  } else {
    ::SetWindowText(hwnd, value);
  }
}

void DDX_Text(CDataExchange* dx, int id, int& value) {
  const HWND hwnd = dx->PrepareCtrl(id);
  if (!hwnd) return;
  if (!dx->m_bSaveAndValidate) {
    ::SetWindowText(hwnd, std::to_string(value));
  } else if (int parsed = 0; ParseInteger(::GetWindowText(hwnd), parsed)) {
    value = parsed;
  } else {
    Refuse(dx, kEnterInteger);
  }
}

// Numbers are shown with the digits their type holds, so a value shown and taken back is unchanged.
template <class Number>
void ExchangeNumber(CDataExchange* dx, int id, Number& value, int digits) {
  const HWND hwnd = dx->PrepareCtrl(id);
  if (!hwnd) return;
  if (!dx->m_bSaveAndValidate) {
    char text[40];
    std::snprintf(text, sizeof text, "%.*g", digits, static_cast<double>(value));
    ::SetWindowText(hwnd, text);
  } else if (double parsed = 0; ParseNumber(::GetWindowText(hwnd), parsed)) {
    value = static_cast<Number>(parsed);
  } else {
    Refuse(dx, kEnterNumber);
  }
}

void DDX_Text(CDataExchange* dx, int id, double& value) { ExchangeNumber(dx, id, value, DBL_DIG); }
void DDX_Text(CDataExchange* dx, int id, float& value) { ExchangeNumber(dx, id, value, FLT_DIG); }

void DDX_Check(CDataExchange* dx, int id, int& value) {
  const HWND hwnd = dx->PrepareCtrl(id);
  if (!hwnd) return;
  if (dx->m_bSaveAndValidate) {
    value = static_cast<int>(::SendMessage(hwnd, BM_GETCHECK, 0, 0));
  } else {
    ::SendMessage(hwnd, BM_SETCHECK, static_cast<WPARAM>(value), 0);
  }
}
