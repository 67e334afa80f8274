// The tree as a user works it in the pane: check boxes by mouse and space bar, selection,
// expansion, and renaming in place, accepted, refused and cancelled.
#include <string>
#include <vector>

#include "tests/framework/framework_fixture.h"
#include "tests/framework/test_pane.h"

namespace {

class TreeTest : public FrameworkTest {
 protected:
  TreeTest() {
    pane.Create(5000, &HostFrame());
    pane.ShowWindow(SW_SHOW);
    pane.FillSections();
    tree = pane.tree.m_hWnd;
  }

  HTREEITEM Item(std::string_view path) const { return user.FindItem(tree, path); }

  TestPane pane;
  HWND tree;
};

TEST_F(TreeTest, ACheckBoxClickIsSeenByTheParentBeforeTheTreeChangesTheStateImage) {
  user.ToggleCheck(tree, "Section 0/Camera 1");
  // The click notification still sees the old state; the message it posts runs after the
  // tree has changed the state image.
  EXPECT_EQ(pane.events, (std::vector<std::string>{"click Camera 1 unchecked", "apply Camera 1 checked"}));
  EXPECT_EQ(pane.tree.GetItemState(Item("Section 0/Camera 1"), TVIS_STATEIMAGEMASK), INDEXTOSTATEIMAGEMASK(2));
  EXPECT_FALSE(pane.tree.GetCheck(Item("Section 0/Default")));
  // A check box click does not select its item; the focus it gives the tree selects the first.
  EXPECT_EQ(pane.tree.GetSelectedItem(), Item("Section 0"));

  user.ToggleCheck(tree, "Section 0/Camera 1");
  EXPECT_EQ(pane.events.back(), "apply Camera 1 unchecked");
  EXPECT_EQ(pane.tree.GetItemState(Item("Section 0/Camera 1"), TVIS_STATEIMAGEMASK), INDEXTOSTATEIMAGEMASK(1));
}

TEST_F(TreeTest, ClicksBesideTheCheckBoxChangeNoCheck) {
  user.SelectItem(tree, "Section 1");
  EXPECT_EQ(pane.tree.GetSelectedItem(), Item("Section 1"));
  user.ToggleExpand(tree, "Section 0");
  EXPECT_FALSE(pane.tree.GetItemState(Item("Section 0"), TVIS_EXPANDED) & TVIS_EXPANDED);
  EXPECT_TRUE(pane.events.empty());
  for (const char* path : {"Section 0", "Section 1"}) EXPECT_FALSE(pane.tree.GetCheck(Item(path))) << path;
}

TEST_F(TreeTest, TheSpaceBarTicksTheSelectedItemAndTheArrowsMoveTheSelection) {
  user.SelectItem(tree, "Section 0");
  user.Press(VK_DOWN);
  EXPECT_EQ(pane.tree.GetItemText(pane.tree.GetSelectedItem()), "Default");
  user.Press(VK_SPACE);
  EXPECT_EQ(pane.events, std::vector<std::string>{"apply Default checked"});
  user.Press(VK_LEFT);  // from a child to its parent
  EXPECT_EQ(pane.tree.GetSelectedItem(), Item("Section 0"));
  user.Press(VK_LEFT);  // collapses the parent
  EXPECT_FALSE(pane.tree.GetItemState(Item("Section 0"), TVIS_EXPANDED) & TVIS_EXPANDED);
  EXPECT_TRUE(pane.tree.GetCheck(Item("Section 0/Default")));
}

TEST_F(TreeTest, RenamingInPlaceIsAcceptedRefusedOrCancelled) {
  const std::size_t windows = framework::LiveWindowCount();
  user.RenameItem(tree, "Section 0", "Front");
  EXPECT_EQ(pane.tree.GetItemText(pane.tree.GetRootItem()), "Front");
  user.RenameItem(tree, "Front", "Section 1");  // a duplicate the pane refuses
  user.RenameItem(tree, "Front", "Back", false);
  EXPECT_EQ(pane.events, (std::vector<std::string>{"rename to Front", "rename to Section 1 refused", "edit cancelled"}));
  EXPECT_EQ(pane.tree.GetItemText(pane.tree.GetRootItem()), "Front");
  EXPECT_EQ(pane.tree.GetEditControl(), nullptr);
  EXPECT_EQ(framework::LiveWindowCount(), windows);  // each editor went away with its edit
  EXPECT_EQ(GetFocus(), tree);
}

TEST_F(TreeTest, ADoubleClickDoesNotStartAnEditAndEnterInTheEditorDoesNotReachTheDialog) {
  user.SelectItem(tree, "Section 1");
  user.DoubleClickItem(tree, "Section 1");
  user.Wait(1000);
  EXPECT_EQ(pane.tree.GetEditControl(), nullptr);
  user.RenameItem(tree, "Section 1", "Plan A");
  EXPECT_EQ(pane.events, std::vector<std::string>{"rename to Plan A"});  // no "ok" from Enter
}

TEST_F(TreeTest, DeletingTheSelectedItemMovesTheSelectionToItsPreviousSibling) {
  user.SelectItem(tree, "Section 1");
  pane.tree.DeleteItem(Item("Section 1"));
  EXPECT_EQ(pane.tree.GetSelectedItem(), Item("Section 0"));
  pane.tree.DeleteAllItems();
  EXPECT_FALSE(pane.tree.GetSelectedItem());
  EXPECT_EQ(pane.tree.GetCount(), 0U);
}

}  // namespace
