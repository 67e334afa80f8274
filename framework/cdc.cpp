// Text layout and drawing calls of the device context.
#include "framework/cdc.h"

#include <utility>
#include <vector>

#include "framework/canvas.h"
#include "framework/resource_module.h"
#include "framework/text_metrics.h"
#include "framework/window_system.h"

namespace {

// Without DT_NOPREFIX an ampersand marks the next character (the key that chooses a control)
// and is not shown; two ampersands show one.
std::string WithoutPrefixes(std::string_view text) {
  std::string out;
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '&' && i + 1 < text.size()) ++i;
    out += text[i];
  }
  return out;
}

// Breaks a text into lines no wider than `width` at blanks (and at line breaks); a word wider
// than the line stands on a line of its own.
std::vector<std::string> WrapLines(const std::string& text, int width, bool bold) {
  std::vector<std::string> lines;
  std::size_t start = 0;
  while (start <= text.size()) {
    const std::size_t newline = text.find('\n', start);
    std::string paragraph = text.substr(start, newline == std::string::npos ? std::string::npos : newline - start);
    if (!paragraph.empty() && paragraph.back() == '\r') paragraph.pop_back();
    std::string line;
    std::size_t pos = 0;
    while (pos < paragraph.size()) {
      const std::size_t blank = paragraph.find(' ', pos);
      const std::string word = paragraph.substr(pos, blank == std::string::npos ? std::string::npos : blank - pos);
      const std::string candidate = line.empty() ? word : line + " " + word;
      if (!line.empty() && framework::TextWidth(candidate, bold) > width) {
        lines.push_back(line);
        line = word;
      } else {
        line = candidate;
      }
      pos = blank == std::string::npos ? paragraph.size() : blank + 1;
    }
    lines.push_back(line);
    if (newline == std::string::npos) break;
    start = newline + 1;
  }
  return lines;
}

}  // namespace

CDC* CDC::FromHandle(HDC hdc) { return hdc != nullptr ? &hdc->Dc() : nullptr; }

COLORREF CDC::SetTextColor(COLORREF color) { return std::exchange(textColor_, color); }
COLORREF CDC::SetBkColor(COLORREF color) { return std::exchange(bkColor_, color); }
int CDC::SetBkMode(int mode) { return std::exchange(bkMode_, mode); }

CFont* CDC::SelectObject(CFont* font) {
  if (font == nullptr || !font->Exists()) return font_;
  return std::exchange(font_, font);
}

void CDC::FillSolidRect(const RECT& rect, COLORREF color) {
  canvas_->FillRect(rect, color);
  bkColor_ = color;
}

void CDC::FillSolidRect(int x, int y, int cx, int cy, COLORREF color) { FillSolidRect(RECT{x, y, x + cx, y + cy}, color); }

void CDC::Draw3dRect(const RECT& r, COLORREF topLeft, COLORREF bottomRight) {
  canvas_->FillRect({r.left, r.top, r.right - 1, r.top + 1}, topLeft);
  canvas_->FillRect({r.left, r.top, r.left + 1, r.bottom - 1}, topLeft);
  canvas_->FillRect({r.left, r.bottom - 1, r.right, r.bottom}, bottomRight);
  canvas_->FillRect({r.right - 1, r.top, r.right, r.bottom}, bottomRight);
}

void CDC::DrawFocusRect(const RECT& rect) { canvas_->FocusRect(rect); }

CSize CDC::GetTextExtent(std::string_view text) const {
  const bool bold = font_ != nullptr && font_->IsBold();
  return {framework::TextWidth(text, bold), framework::kLineHeight};
}

int CDC::DrawText(std::string_view rawText, RECT* rect, UINT format) {
  if (rect == nullptr) return 0;
  const bool bold = font_ != nullptr && font_->IsBold();
  const std::string text = (format & DT_NOPREFIX) != 0 ? std::string(rawText) : WithoutPrefixes(rawText);
  const CRect box(*rect);
  std::vector<std::string> lines;
  if ((format & DT_SINGLELINE) != 0) {
    lines.push_back(text);
  } else if ((format & DT_WORDBREAK) != 0) {
    lines = WrapLines(text, box.Width(), bold);
  } else {
    lines = WrapLines(text, 1 << 20, bold);
  }
  if ((format & DT_END_ELLIPSIS) != 0) {
    for (std::string& line : lines) {
      if (framework::TextWidth(line, bold) <= box.Width()) continue;
      while (!line.empty() && framework::TextWidth(line + "...", bold) > box.Width()) line.pop_back();
      line += "...";
    }
  }
  const int height = static_cast<int>(lines.size()) * framework::kLineHeight;
  if ((format & DT_CALCRECT) != 0) {
    int widest = 0;
    for (const std::string& line : lines) widest = std::max(widest, framework::TextWidth(line, bold));
    rect->right = rect->left + widest;
    rect->bottom = rect->top + height;
    return height;
  }
  int top = box.top;
  if ((format & DT_SINGLELINE) != 0 && (format & DT_VCENTER) != 0) top = box.top + (box.Height() - height) / 2;
  if ((format & DT_SINGLELINE) != 0 && (format & DT_BOTTOM) != 0) top = box.bottom - height;
  Canvas::TextStyle style{textColor_, bold, Canvas::Anchor::kStart};
  for (const std::string& line : lines) {
    const int width = framework::TextWidth(line, bold);
    int x = box.left;
    if ((format & DT_CENTER) != 0) x = box.left + (box.Width() - width) / 2;
    if ((format & DT_RIGHT) != 0) x = box.right - width;
    if (bkMode_ == OPAQUE) canvas_->FillRect({x, top, x + width, top + framework::kLineHeight}, bkColor_);
    canvas_->Text(x, top + framework::kFontAscent, line, style);
    top += framework::kLineHeight;
  }
  return height;
}

BOOL CDC::DrawState(CPoint point, CSize size, HICON icon, UINT flags) {
  const std::string_view picture = framework::IconPicture(icon);
  if (picture.empty()) return FALSE;
  canvas_->Picture(CRect(point, size), picture, (flags & DSS_DISABLED) != 0,
                   {{"data-icon", std::to_string(framework::IconResourceId(icon))}});
  return TRUE;
}

BOOL CDC::DrawIcon(int x, int y, HICON icon) {
  const int size = ::GetSystemMetrics(SM_CXICON);
  return DrawState(CPoint(x, y), CSize(size, size), icon, DST_ICON | DSS_NORMAL);
}
