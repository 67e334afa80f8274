// The tree's item model and what it tells its parent: insertion order, navigation, item
// values, refused selections, expansion by the user and by code, scrolling into view; and the
// text escaping every picture relies on.
#include <string>
#include <vector>

#include "framework/canvas.h"
#include "framework/controls/tree_control.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"

namespace {

// A parent that writes down the tree's notifications and can refuse selection changes.
class TreeHost : public CWnd {
 public:
  std::vector<std::string> notes;
  bool refuseSelection = false;

 protected:
  BOOL OnNotify(WPARAM, LPARAM lParam, LRESULT* result) override {
    const auto* header = reinterpret_cast<const NMHDR*>(lParam);
    *result = 0;
    if (header->code == TVN_SELCHANGING) {
      notes.push_back("selchanging");
      *result = refuseSelection ? 1 : 0;
    } else if (header->code == TVN_SELCHANGED) {
      const auto* tv = reinterpret_cast<const NMTREEVIEW*>(lParam);
      notes.push_back("selchanged by " + std::to_string(tv->action));
    } else if (header->code == TVN_ITEMEXPANDING || header->code == TVN_ITEMEXPANDED) {
      const auto* tv = reinterpret_cast<const NMTREEVIEW*>(lParam);
      notes.push_back(std::string(header->code == TVN_ITEMEXPANDING ? "expanding " : "expanded ") +
                      (tv->action == TVE_EXPAND ? "open" : "shut"));
    } else if (header->code == NM_DBLCLK) {
      notes.push_back("double click");
    }
    return TRUE;
  }
};

class TreeModelTest : public FrameworkTest {
 protected:
  TreeModelTest() {
    host.CreateEx(0, framework::kDialogClass, "Trees", WS_POPUP | WS_VISIBLE, CRect(0, 0, 300, 140), nullptr, 0);
    tree.Create(WS_CHILD | WS_VISIBLE | TVS_HASBUTTONS | TVS_HASLINES | TVS_LINESATROOT, CRect(0, 0, 300, 140), &host,
                5016);
  }

  std::vector<std::string> Roots() const {
    std::vector<std::string> names;
    for (HTREEITEM h = tree.GetRootItem(); h; h = tree.GetNextSiblingItem(h)) names.push_back(tree.GetItemText(h));
    return names;
  }

  TreeHost host;
  CTreeCtrl tree;
};

TEST_F(TreeModelTest, ItemsGoWhereTheyAreInsertedAndKeepTheirValues) {
  const HTREEITEM b = tree.InsertItem("beta");
  tree.InsertItem("Gamma");
  tree.InsertItem("alpha", TVI_ROOT, TVI_FIRST);
  tree.InsertItem("Delta", TVI_ROOT, TVI_SORT);  // sorted without regard to case
  tree.InsertItem("after beta", TVI_ROOT, b);
  EXPECT_EQ(Roots(), (std::vector<std::string>{"alpha", "beta", "after beta", "Delta", "Gamma"}));

  const HTREEITEM child = tree.InsertItem("Default", 0, 0, b);
  EXPECT_TRUE(tree.SetItemData(child, 0xDEADBEEF));
  EXPECT_TRUE(tree.SetItemImage(child, 2, 1));
  EXPECT_EQ(tree.GetItemData(child), 0xDEADBEEFU);
  int image = 0;
  int selected = 0;
  EXPECT_TRUE(tree.GetItemImage(child, image, selected));
  EXPECT_EQ(image, 2);
  EXPECT_EQ(selected, 1);
  EXPECT_EQ(tree.GetParentItem(child), b);
  EXPECT_EQ(tree.GetChildItem(b), child);
  EXPECT_TRUE(tree.ItemHasChildren(b));
  EXPECT_EQ(tree.GetCount(), 6U);

  RECT r;
  EXPECT_FALSE(tree.GetItemRect(child, &r, TRUE));  // under a collapsed item: not in view
  EXPECT_FALSE(tree.SetItemData(HTREEITEM(99999), 1));
  EXPECT_EQ(tree.GetItemText(HTREEITEM(99999)), "");
}

TEST_F(TreeModelTest, AParentCanRefuseASelectionAndIsToldHowItChanged) {
  tree.InsertItem("one");
  tree.InsertItem("two");
  user.Click(tree.m_hWnd, {40, 9});  // the first row's label (focus then click select it)
  EXPECT_EQ(tree.GetItemText(tree.GetSelectedItem()), "one");
  host.notes.clear();
  host.refuseSelection = true;
  user.Press(VK_DOWN);
  EXPECT_EQ(tree.GetItemText(tree.GetSelectedItem()), "one");
  host.refuseSelection = false;
  user.Press(VK_DOWN);
  EXPECT_EQ(tree.GetItemText(tree.GetSelectedItem()), "two");
  EXPECT_EQ(host.notes, (std::vector<std::string>{"selchanging", "selchanging", "selchanged by 2"}));
}

TEST_F(TreeModelTest, TheUserExpandsWithNoticeWhileCodeExpandsSilently) {
  const HTREEITEM section = tree.InsertItem("Section 0");
  tree.InsertItem("Default", section);
  tree.Expand(section, TVE_EXPAND);
  tree.Expand(section, TVE_COLLAPSE);
  EXPECT_TRUE(host.notes.empty());
  user.DoubleClickItem(tree.m_hWnd, "Section 0");
  EXPECT_TRUE(tree.GetItemState(section, TVIS_EXPANDED) & TVIS_EXPANDED);
  user.ToggleExpand(tree.m_hWnd, "Section 0");
  EXPECT_FALSE(tree.GetItemState(section, TVIS_EXPANDED) & TVIS_EXPANDED);
  const std::vector<std::string> expected = {"selchanging", "selchanged by 1", "double click", "expanding open",
                                             "expanded open", "expanding shut", "expanded shut"};
  EXPECT_EQ(host.notes, expected);
}

TEST_F(TreeModelTest, EnsureVisibleScrollsALongTreeAndExpandsTheWayDown) {
  HTREEITEM last;
  for (int i = 0; i < 20; ++i) {
    const HTREEITEM section = tree.InsertItem("Section " + std::to_string(i));
    last = tree.InsertItem("Default", section);
  }
  EXPECT_TRUE(tree.EnsureVisible(last));
  EXPECT_TRUE(tree.GetItemState(tree.GetParentItem(last), TVIS_EXPANDED) & TVIS_EXPANDED);
  EXPECT_NE(tree.GetFirstVisibleItem(), tree.GetRootItem());
  RECT r;
  ASSERT_TRUE(tree.GetItemRect(last, &r, FALSE));
  EXPECT_GE(r.top, 0);
  EXPECT_LE(r.bottom, 140);
  EXPECT_EQ(tree.GetVisibleCount(), 7U);  // 140 pixels of 18-pixel rows
  user.Click(tree.m_hWnd, {60, r.top + 9});
  EXPECT_EQ(tree.GetSelectedItem(), last);
}

TEST(CanvasText, TextsAreEscapedAndConvertedFromTheCodePage) {
  EXPECT_EQ(framework::EscapeXmlText("<a href=\"x\">&'</a>"), "&lt;a href=&quot;x&quot;&gt;&amp;&apos;&lt;/a&gt;");
  EXPECT_EQ(framework::EscapeXmlText("Preserve\xA0XY \x80\x85 caf\xE9"), "Preserve\u00A0XY \u20AC\u2026 caf\u00E9");
  EXPECT_EQ(framework::EscapeXmlText("bell\x07 tab\t\x81"), "bell tab\t");  // nothing XML cannot hold
}

}  // namespace
