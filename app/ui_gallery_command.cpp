// The ui-gallery command: builds each control in a small window of its own (in the states that
// matter: chosen, dropped, checked, disabled, coloured), opens each dialog template empty, and
// writes each picture as SVG beside an index page; popups (menus, drop-down lists) are drawn
// over the window they belong to.
#include "app/ui_gallery_command.h"

#include <CLI/CLI.hpp>

#include <filesystem>
#include <fstream>
#include <functional>
#include <ostream>
#include <string>
#include <vector>

#include "framework/canvas.h"
#include "framework/cdc.h"
#include "framework/cdialog.h"
#include "framework/controls/button.h"
#include "framework/controls/combo_box_ex.h"
#include "framework/controls/edit.h"
#include "framework/controls/progress_ctrl.h"
#include "framework/controls/static_control.h"
#include "framework/controls/tab_control.h"
#include "framework/controls/tree_control.h"
#include "framework/cwinapp.h"
#include "framework/image_list.h"
#include "framework/menu.h"
#include "framework/render.h"
#include "framework/resource_module.h"
#include "framework/scripted_user.h"
#include "framework/text_metrics.h"
#include "framework/toolkit/button_st.h"
#include "framework/toolkit/image_menu.h"
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"
#include "resources/resource_module.h"
#include "ui/controls/report_ctrl.h"

namespace app {
namespace {

namespace fs = std::filesystem;

// A window to put controls in, with the caption saying what it shows.
class Sheet : public CWnd {
 public:
  Sheet(std::string_view caption, int width, int height) {
    CreateEx(0, framework::kDialogClass, caption, WS_POPUP | WS_CAPTION | WS_VISIBLE, CRect(40, 40, 40 + width, 40 + height),
             nullptr, 0);
  }
};

// The colour list of the section settings in small: owner-drawn items with a swatch each.
class SwatchCombo : public CComboBox {
 public:
  void MeasureItem(LPMEASUREITEMSTRUCT measure) override {
    if (static_cast<int>(measure->itemID) >= 0) measure->itemHeight = measure->itemHeight * 12 / 10;
  }
  void DrawItem(LPDRAWITEMSTRUCT draw) override {
    CDC* dc = CDC::FromHandle(draw->hDC);
    const CRect r(draw->rcItem);
    const bool selected = (draw->itemState & ODS_SELECTED) != 0;
    dc->FillSolidRect(r, ::GetSysColor(selected ? COLOR_HIGHLIGHT : COLOR_WINDOW));
    if (static_cast<int>(draw->itemID) < 0) return;
    const CRect swatch(4, r.top + 2, 18, r.bottom - 2);
    dc->FillSolidRect(swatch, static_cast<COLORREF>(draw->itemData));
    draw->hDC->FrameRect(swatch, RGB(0, 0, 0));
    dc->SetBkMode(TRANSPARENT);
    dc->SetTextColor(selected ? ::GetSysColor(COLOR_HIGHLIGHTTEXT) : ::GetSysColor(COLOR_WINDOWTEXT));
    CRect text(21, r.top + 2, r.right, r.bottom);
    dc->DrawText(GetLBText(static_cast<int>(draw->itemID)), &text, DT_LEFT | DT_SINGLELINE);
  }
};

// Draws windows (a window and the popups over it) into one picture at their screen places.
std::string RenderTogether(const std::vector<HWND>& windows) {
  CRect bounds;
  for (HWND w : windows) {
    RECT r;
    ::GetWindowRect(w, &r);
    bounds = bounds.IsRectEmpty() ? CRect(r)
                                  : CRect(std::min(bounds.left, r.left), std::min(bounds.top, r.top),
                                          std::max(bounds.right, r.right), std::max(bounds.bottom, r.bottom));
  }
  Canvas canvas(bounds.Width(), bounds.Height());
  for (HWND w : windows) {
    RECT r;
    ::GetWindowRect(w, &r);
    CRect place(r);
    place.OffsetRect(-bounds.left, -bounds.top);
    framework::PaintWindow(w, canvas, place);
  }
  return canvas.Svg();
}

class Gallery {
 public:
  explicit Gallery(fs::path folder) : folder_(std::move(folder)) {}

  void Write(const std::string& name, const std::string& svg) {
    std::ofstream(folder_ / (name + ".svg"), std::ios::binary) << svg;
    names_.push_back(name);
  }

  void WriteIndex() const {
    std::ofstream index(folder_ / "index.html", std::ios::binary);
    index << "<!DOCTYPE html>\n<html><head><meta charset=\"utf-8\"><title>Pandex UI gallery</title></head>\n"
             "<body style=\"background:#ddd;font-family:sans-serif\">\n";
    for (const std::string& name : names_) {
      index << "<h3>" << name << "</h3>\n<img src=\"" << name << ".svg\" style=\"zoom:2\">\n";
    }
    index << "</body></html>\n";
  }

  const std::vector<std::string>& Names() const { return names_; }

 private:
  fs::path folder_;
  std::vector<std::string> names_;
};

void Buttons(Gallery& gallery) {
  Sheet sheet("Buttons", 330, 150);
  CButton push, def, disabled, check, checkedBox, greyed, radio, group;
  CButtonST icon, iconText;
  push.Create("Push", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(10, 10, 85, 33), &sheet, 1);
  def.Create("Default", WS_CHILD | WS_VISIBLE | BS_DEFPUSHBUTTON, CRect(95, 10, 170, 33), &sheet, 2);
  disabled.Create("Disabled", WS_CHILD | WS_VISIBLE | WS_DISABLED | BS_PUSHBUTTON, CRect(180, 10, 255, 33), &sheet, 3);
  icon.Create("", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(265, 10, 289, 33), &sheet, 4);
  icon.SetIcon(5064U);
  iconText.Create("Layers Configuration", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(10, 40, 170, 69), &sheet, 5);
  iconText.SetIcon(framework::LoadPictureSlice(5027, 11, 16));
  group.Create(" Group ", WS_CHILD | WS_VISIBLE | BS_GROUPBOX, CRect(180, 38, 320, 120), &sheet, 6);
  check.Create("Unchecked", WS_CHILD | WS_VISIBLE | BS_AUTOCHECKBOX, CRect(10, 78, 170, 94), &sheet, 7);
  checkedBox.Create("Checked", WS_CHILD | WS_VISIBLE | BS_AUTOCHECKBOX, CRect(10, 98, 170, 114), &sheet, 8);
  checkedBox.SetCheck(BST_CHECKED);
  greyed.Create("Checked, disabled", WS_CHILD | WS_VISIBLE | WS_DISABLED | BS_AUTOCHECKBOX, CRect(190, 58, 315, 74), &sheet, 9);
  greyed.SetCheck(BST_CHECKED);
  radio.Create("Radio", WS_CHILD | WS_VISIBLE | BS_AUTORADIOBUTTON, CRect(190, 80, 315, 96), &sheet, 10);
  radio.SetCheck(BST_CHECKED);
  gallery.Write("buttons", framework::RenderWindow(sheet.m_hWnd));
}

void Edits(Gallery& gallery) {
  Sheet sheet("Edits and labels", 330, 100);
  CStatic label;
  CEdit edit, readOnly;
  label.Create("A label:", WS_CHILD | WS_VISIBLE | SS_LEFT, CRect(10, 12, 80, 26), &sheet);
  edit.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | ES_AUTOHSCROLL, CRect(85, 8, 320, 30), &sheet, 1);
  edit.SetWindowText("Section 0 (typed, part selected)");
  readOnly.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | ES_READONLY | ES_AUTOHSCROLL, CRect(85, 40, 320, 62), &sheet, 2);
  readOnly.SetWindowText("...sec_sym\\arrow.sym (read-only)");
  edit.SetFocus();
  edit.SetSel(0, 9);
  gallery.Write("edits", framework::RenderWindow(sheet.m_hWnd));
}

void Combos(Gallery& gallery, framework::ScriptedUser& user) {
  Sheet sheet("Combo boxes", 420, 90);
  CComboBox plain;
  SwatchCombo colours;
  CComboBoxEx lineTypes;
  CImageList lineImages;
  plain.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(10, 10, 130, 110), &sheet, 1);
  for (const char* text : {"Auto scale", "Fixed scale", "Scale off"}) plain.AddString(text);
  plain.SetCurSel(1);
  colours.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST | CBS_OWNERDRAWFIXED | CBS_HASSTRINGS, CRect(140, 10, 270, 180),
                 &sheet, 2);
  const COLORREF swatches[] = {RGB(0, 0, 0), RGB(255, 0, 0), RGB(0, 160, 0), RGB(0, 0, 255), RGB(255, 200, 0)};
  for (int i = 0; i < 5; ++i) colours.SetItemData(colours.AddString(std::to_string(i + 1)), swatches[i]);
  colours.SetItemData(colours.AddString("Select color"), RGB(255, 255, 255));
  colours.SetCurSel(1);
  lineImages.Create(5039U, 49, 1, RGB(255, 0, 255));
  lineTypes.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(280, 10, 410, 150), &sheet, 3);
  lineTypes.SetImageList(&lineImages);
  for (int i = 0; i < 8; ++i) lineTypes.InsertItem(i, std::to_string(i), i, i);
  lineTypes.SetCurSel(1);
  gallery.Write("combo_boxes", framework::RenderWindow(sheet.m_hWnd));

  for (const auto& [name, combo] : {std::pair<const char*, CComboBox*>{"combo_dropped", &plain},
                                    {"combo_owner_drawn_dropped", &colours},
                                    {"combo_ex_dropped", &lineTypes}}) {
    user.Click(combo->m_hWnd);
    COMBOBOXINFO info;
    combo->SendMessage(CB_GETCOMBOBOXINFO, 0, reinterpret_cast<LPARAM>(&info));
    user.MoveTo(info.hwndList, CPoint(20, 20));  // the item under the mouse is highlighted
    gallery.Write(name, RenderTogether({sheet.m_hWnd, info.hwndList}));
    user.Press(VK_ESCAPE);
  }
}

void Lists(Gallery& gallery, framework::ScriptedUser& user) {
  Sheet sheet("Report list", 340, 210);
  CReportCtrl list;
  CImageList images;
  list.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | LVS_REPORT | LVS_SHOWSELALWAYS, CRect(8, 8, 330, 176), &sheet, 1);
  images.Create(5052U, 15, 1, RGB(255, 0, 255));
  list.SetImageList(&images);
  list.SetExtendedStyle(list.GetExtendedStyle() | LVS_EX_CHECKBOXES | LVS_EX_GRIDLINES);
  list.InsertColumn(0, "ID", LVCFMT_LEFT, 60);
  list.InsertColumn(1, "Name", LVCFMT_LEFT, 130);
  list.InsertColumn(2, "On/Off", LVCFMT_LEFT, 60);
  const char* names[] = {"Walls", "Slabs", "Roof", "Dimensions", "Texts", "Stairs", "Furniture", "Hatches", "Grid", "Site"};
  for (int i = 0; i < 10; ++i) {
    const int row = list.InsertItem(i, std::to_string(i * 10), 0);
    list.SetItemText(row, 1, names[i]);
    list.SetItemImage(row, 2, i % 3 == 0 ? 1 : 2);
    list.SetCheck(row, i % 2 == 0);
  }
  list.SetItemTextColor(1, 1, RGB(200, 0, 0));
  list.SetItemBkColor(3, -1, RGB(255, 244, 200));
  list.SetItemStates(2, RC_ITEM_SELECTED | RC_ITEM_FOCUSED);
  user.ClickListHeader(list.m_hWnd, 1);  // sorted by name
  gallery.Write("report_list", framework::RenderWindow(sheet.m_hWnd));

  list.SetEditable();
  user.ClickListCell(list.m_hWnd, 4, 1);  // the selected row: its cell opens for editing
  user.Type("Renamed layer");
  gallery.Write("report_list_editing", framework::RenderWindow(sheet.m_hWnd));
  user.Press(VK_ESCAPE);
}

void TreeAndTabs(Gallery& gallery) {
  Sheet sheet("Tree and tabs", 260, 200);
  CTabCtrl tabs;
  CTreeCtrl tree;
  CImageList icons;
  icons.Create(16, 16, ILC_COLOR | ILC_MASK, 3, 1);
  for (UINT id : {5006U, 5007U, 5008U}) icons.Add(AfxLoadIcon(id));
  tabs.Create(WS_CHILD | WS_VISIBLE, CRect(4, 4, 252, 164), &sheet, 1);
  tabs.SetImageList(icons.GetSafeHandle());
  tabs.InsertItem(0, "Cameras", 0);
  tabs.InsertItem(1, "Sections", 1);
  tabs.InsertItem(2, "Plans", 2);
  tabs.SetCurSel(1);
  tree.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | TVS_HASBUTTONS | TVS_HASLINES | TVS_LINESATROOT | TVS_CHECKBOXES |
                  TVS_SHOWSELALWAYS,
              CRect(10, 34, 246, 158), &sheet, 2);
  tree.SetImageList(&icons, TVSIL_NORMAL);
  const HTREEITEM section = tree.InsertItem("Section A", 1, 1);
  tree.SetCheck(tree.InsertItem("Default", 0, 0, section));
  tree.InsertItem("Camera 1", 0, 0, section);
  tree.Expand(section, TVE_EXPAND);
  tree.SelectItem(tree.InsertItem("Section B", 1, 1));
  gallery.Write("tree_and_tabs", framework::RenderWindow(sheet.m_hWnd));
}

void Progress(Gallery& gallery) {
  Sheet sheet("Progress bars", 300, 80);
  CProgressCtrl smooth, blocks;
  smooth.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | PBS_SMOOTH, CRect(10, 10, 290, 30), &sheet, 1);
  smooth.SetRange(0, 3);
  smooth.SetPos(2);
  blocks.Create(WS_CHILD | WS_VISIBLE | WS_BORDER, CRect(10, 38, 290, 56), &sheet, 2);
  blocks.SetPos(60);
  gallery.Write("progress_bars", framework::RenderWindow(sheet.m_hWnd));
}

void Menus(Gallery& gallery, framework::ScriptedUser& user) {
  Sheet sheet("Menus", 260, 60);
  CMenu build;
  build.CreatePopupMenu();
  const UINT texts[] = {13, 14, 30, 46, 9};
  CBitmap bitmaps[5];
  for (UINT i = 0; i < 5; ++i) {
    build.AppendMenu(MF_STRING, i + 1, AfxLoadString(texts[i]));
    bitmaps[i].LoadBitmap(5057 + i);
    build.SetMenuItemBitmaps(i, MF_BYPOSITION, &bitmaps[i], &bitmaps[i]);
  }
  build.AppendMenu(MF_STRING, 6, AfxLoadString(12));
  const auto capture = [&](const char* name) {
    user.AnswerNext([&gallery, &sheet, name](framework::ScriptedUser& u, HWND) {
      u.MoveTo(u.OpenMenu(), CPoint(60, 55));
      gallery.Write(name, RenderTogether({sheet.m_hWnd, u.OpenMenu()}));
      u.DismissMenu();
    });
  };
  capture("menu_with_bitmaps");
  build.TrackPopupMenu(TPM_LEFTALIGN | TPM_RETURNCMD, 60, 60, &sheet);

  CImageList modes;
  modes.Create(5027U, 16, 1, RGB(255, 0, 255));
  CImageMenu displayModes;
  displayModes.Create(modes);
  for (UINT code = 0; code <= 10; ++code) displayModes.AddItem(code + 1, AfxLoadString(16 + code), static_cast<int>(code));
  displayModes.CheckMenuItem(3, MF_BYCOMMAND | MF_CHECKED);
  capture("image_menu");
  displayModes.Track(&sheet, CPoint(160, 180));
}

void Icons(Gallery& gallery) {
  // Every picture of the resources with its number, twice its size.
  std::vector<UINT> ids;
  for (UINT id = 5000; id < 5100; ++id) {
    if (!framework::IconPicture(AfxLoadIcon(id)).empty()) ids.push_back(id);
  }
  int height = 10;
  for (UINT id : ids) height += std::max(32, static_cast<int>(framework::PictureSize(framework::IconPicture(AfxLoadIcon(id))).cy) * 2) + 14;
  Canvas canvas(860, height);
  canvas.FillRect(CRect(0, 0, 860, height), RGB(255, 255, 255));
  int top = 10;
  for (UINT id : ids) {
    const std::string_view picture = framework::IconPicture(AfxLoadIcon(id));
    const SIZE size = framework::PictureSize(picture);
    canvas.Text(10, top + 20, std::to_string(id), {RGB(0, 0, 0), true, Canvas::Anchor::kStart});
    canvas.Picture(CRect(60, top, 60 + size.cx * 2, top + size.cy * 2), picture, false, {{"data-icon", std::to_string(id)}});
    top += std::max(32, static_cast<int>(size.cy) * 2) + 14;
  }
  gallery.Write("icons_and_bitmaps", canvas.Svg());
}

void Templates(Gallery& gallery) {
  Sheet host("Host", 600, 560);
  for (const DialogTemplate* dialogTemplate : resources::AllDialogTemplates()) {
    CDialog dialog;
    if (!dialog.CreateIndirect(*dialogTemplate, &host)) throw std::runtime_error("cannot open dialog " + std::to_string(dialogTemplate->id));
    dialog.ShowWindow(SW_SHOW);
    gallery.Write("dialog_" + std::to_string(dialogTemplate->id), framework::RenderWindow(dialog.m_hWnd));
    dialog.DestroyWindow();
  }
}

}  // namespace

int RunUiGallery(const CLI::App& command, std::ostream& out) {
  const std::string folder = command.get_option("DIR")->as<std::string>();
  fs::create_directories(folder);
  framework::SetResourceModule(&resources::Module());
  Gallery gallery(folder);
  {
    framework::ScriptedUser user;
    Buttons(gallery);
    Edits(gallery);
    Combos(gallery, user);
    Lists(gallery, user);
    TreeAndTabs(gallery);
    Progress(gallery);
    Menus(gallery, user);
    Icons(gallery);
    Templates(gallery);
  }
  gallery.WriteIndex();
  framework::SetResourceModule(nullptr);
  for (const std::string& name : gallery.Names()) out << (fs::path(folder) / (name + ".svg")).string() << '\n';
  out << "Open " << (fs::path(folder) / "index.html").string() << " in a browser, or make a PNG of one picture with\n"
      << "  rsvg-convert -z 2 " << (fs::path(folder) / "dialog_5012.svg").string() << " -o dialog_5012.png\n";
  return 0;
}

CLI::App* AddUiGalleryCommand(CLI::App& app) {
  CLI::App* command = app.add_subcommand("ui-gallery", "Draw every control and every dialog (empty) as SVG pictures into a folder");
  command->add_option("DIR", "Folder for the pictures and their index page")->required();
  return command;
}

}  // namespace app
