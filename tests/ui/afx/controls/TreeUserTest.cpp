#include "platform/afx/controls/Edit.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/controls/TreeTesting.h"

#include <QScrollBar>
#include <QToolTip>

// What users do with trees.

namespace {

using Lines = TreeDialog::Lines;

TEST(TreeKeys, GoThroughTheTree) {
    TreeDialog dialog;
    const auto press = [&](Qt::Key pressed, const char* lines) {
        key(pressed);
        EXPECT_EQ(dialog.lines(), lines) << pressed;
    };
    dialog.with(
        [&] {
            dialog.fill();
            press(Qt::Key_Down, "[A] B C");
            EXPECT_EQ(dialog.told(), (Lines{"selchanging >A 2", "selchanged >A 2"}));
            press(Qt::Key_Right, "[A] a1 a2 B C"); // opens
            EXPECT_EQ(dialog.told(), (Lines{"expanding A 2", "expanded A 2"}));
            press(Qt::Key_Right, "A [a1] a2 B C"); // goes in
            press(Qt::Key_Right, "A [a1] a11 a2 B C");
            press(Qt::Key_Right, "A a1 [a11] a2 B C");
            press(Qt::Key_Right, "A a1 [a11] a2 B C"); // nothing below
            press(Qt::Key_Left, "A [a1] a11 a2 B C");  // goes out
            press(Qt::Key_Left, "A [a1] a2 B C");      // closes
            press(Qt::Key_End, "A a1 a2 B [C]");
            press(Qt::Key_Up, "A a1 a2 [B] C");
            press(Qt::Key_Home, "[A] a1 a2 B C");
            press(Qt::Key_PageDown, "A a1 a2 B [C]");
            press(Qt::Key_PageUp, "[A] a1 a2 B C");
            press(Qt::Key_Up, "[A] a1 a2 B C");
            press(Qt::Key_Right, "A [a1] a2 B C");
            press(Qt::Key_Backspace, "[A] a1 a2 B C");
            type("-");
            EXPECT_EQ(dialog.lines(), "[A] B C");
            type("+");
            EXPECT_EQ(dialog.lines(), "[A] a1 a2 B C");
            type("-");
            type("*");
            EXPECT_EQ(dialog.lines(), "[A] a1 a11 a2 B C");
            // Enter is the dialog's default button's.
            key(Qt::Key_Return);
        },
        IDOK);
}

TEST(TreeKeys, FindLabels) {
    TreeDialog dialog;
    dialog.with([&] {
        dialog.fill();
        dialog.tree.InsertItem("Ännchen");
        dialog.tree.Expand(dialog.a, TVE_EXPAND);
        const auto found = [&](const char* letters) {
            dialog.tree.SelectItem(dialog.tree.GetSelectedItem()); // a new search
            type(letters);
            return dialog.name(dialog.tree.GetSelectedItem());
        };
        EXPECT_EQ(found("b"), "B");
        EXPECT_EQ(found("a"), "A"); // on at the top
        EXPECT_EQ(found("a"), "a1");
        EXPECT_EQ(found("aa"), "A"); // a2, and on
        EXPECT_EQ(found("a2"), "a2");
        EXPECT_EQ(found("ä"), "Ännchen");
        EXPECT_EQ(found("x"), "Ännchen");
    });
}

TEST(TreeMouse, SelectsAndOpens) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        click(&tree, dialog.middle(dialog.b));
        EXPECT_EQ(dialog.told(), (Lines{"selchanging >B 1", "selchanged >B 1", "click"}));
        click(&tree, dialog.button(dialog.a));
        EXPECT_EQ(dialog.lines(), "A a1 a2 [B] C");
        EXPECT_EQ(dialog.told(), (Lines{"expanding A 2", "expanded A 2", "click"}));
        click(&tree, dialog.button(dialog.a));
        EXPECT_EQ(dialog.lines(), "A [B] C");
        QTest::mouseDClick(dialog.area(), Qt::LeftButton, {}, dialog.middle(dialog.a));
        EXPECT_EQ(dialog.lines(), "[A] a1 a2 B C");
        // Whoever takes the double click keeps the item as it is.
        dialog.answer = [](NMHDR& header) { return LRESULT{header.code == NM_DBLCLK || header.code == NM_RCLICK}; };
        dialog.told();
        QTest::mouseDClick(dialog.area(), Qt::LeftButton, {}, dialog.middle(dialog.a));
        EXPECT_EQ(dialog.told().back(), "dblclk");
        EXPECT_EQ(dialog.lines(), "[A] a1 a2 B C");
        click(&tree, dialog.middle(dialog.c), Qt::NoModifier, Qt::RightButton);
        EXPECT_EQ(dialog.told(), (Lines{"selchanging A>C 1", "selchanged A>C 1", "rclick"}));
        // No buttons: the place of one is none.
        tree.ModifyStyle(TVS_HASBUTTONS, 0);
        click(&tree, dialog.button(dialog.b));
        EXPECT_EQ(dialog.lines(), "A a1 a2 B [C]");
        click(&tree, QPoint(20, dialog.area()->height() - 2)); // below all lines
        EXPECT_EQ(dialog.lines(), "A a1 a2 B [C]");
    });
}

TEST(TreeMouse, TellsWholeLabels) {
    TreeDialog dialog;
    dialog.with([&] {
        dialog.fill();
        const HTREEITEM wide = dialog.tree.InsertItem("a <b>label</b> that is much wider than the tree is");
        const auto tip = [&](HTREEITEM item) {
            const QPoint point = dialog.middle(item);
            QHelpEvent help(QEvent::ToolTip, QPoint(30, point.y()), dialog.area()->mapToGlobal(QPoint(30, point.y())));
            QApplication::sendEvent(dialog.area(), &help);
            return QToolTip::isVisible() ? QToolTip::text().toStdString() : std::string();
        };
        EXPECT_NE(tip(wide).find("&lt;b&gt;"), std::string::npos);
        QToolTip::hideText();
        EXPECT_TRUE(QTest::qWaitFor([] { return !QToolTip::isVisible(); }));
        EXPECT_EQ(tip(dialog.a), "");
        // The bar below goes as far as the label.
        const auto* area = qobject_cast<QAbstractScrollArea*>(dialog.area()->parentWidget());
        EXPECT_GT(area->horizontalScrollBar()->maximum(), 0);
        dialog.tree.DeleteItem(wide);
        dialog.tree.DeleteAllItems();
        EXPECT_EQ(dialog.tree.GetFirstVisibleItem(), nullptr);
        EXPECT_EQ(area->horizontalScrollBar()->maximum(), 0);
    });
}

TEST(TreeSelection, TakesSeveral) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        tree.SetMultiSelect(TRUE);
        EXPECT_TRUE(tree.IsMultiSelect());
        tree.Expand(dialog.a, TVE_EXPAND);
        dialog.told();
        click(&tree, dialog.middle(dialog.a1));
        EXPECT_EQ(dialog.lines(), "A [a1] a2 B C");
        dialog.told();
        click(&tree, dialog.middle(dialog.c), Qt::ShiftModifier);
        EXPECT_EQ(dialog.lines(), "A [a1] [a2] [B] [C]");
        EXPECT_EQ(dialog.told(), (Lines{"selchanging a1>C 1", "selchanged a1>C 1", "click"}));
        click(&tree, dialog.middle(dialog.b), Qt::ControlModifier);
        EXPECT_EQ(dialog.lines(), "A [a1] [a2] B [C]");
        EXPECT_EQ(tree.GetSelectedItem(), dialog.b);
        EXPECT_EQ(tree.GetSelectedCount(), 3U);
        std::string selected;
        for (HTREEITEM item = tree.GetFirstSelectedItem(); item; item = tree.GetNextSelectedItem(item)) {
            selected += dialog.name(item) + " ";
        }
        EXPECT_EQ(selected, "a1 a2 C ");
        key(Qt::Key_Home);
        EXPECT_EQ(dialog.lines(), "[A] a1 a2 B C");
        key(Qt::Key_Down, Qt::ShiftModifier);
        EXPECT_EQ(dialog.lines(), "[A] [a1] a2 B C");
        key(Qt::Key_End, Qt::ControlModifier); // alone
        EXPECT_EQ(dialog.lines(), "[A] [a1] a2 B C");
        key(Qt::Key_Space, Qt::ControlModifier);
        EXPECT_EQ(dialog.lines(), "[A] [a1] a2 B [C]");
        key(Qt::Key_A, Qt::ControlModifier);
        EXPECT_EQ(tree.GetSelectedCount(), 5U);
        // What is not seen is not selected.
        tree.Expand(dialog.a, TVE_COLLAPSE);
        EXPECT_EQ(tree.GetSelectedCount(), 3U);
        dialog.told();
        EXPECT_TRUE(tree.SelectItem(dialog.b, FALSE));
        EXPECT_EQ(dialog.lines(), "[A] B [C]");
        EXPECT_EQ(dialog.told(), Lines{});
        EXPECT_TRUE(tree.CTreeCtrl::SelectItem(dialog.b)); // the only one
        EXPECT_EQ(dialog.lines(), "A [B] C");
        EXPECT_TRUE(tree.SelectItem(dialog.a, TRUE));
        tree.SetMultiSelect(FALSE);
        EXPECT_EQ(dialog.lines(), "A [B] C");
    });
}

TEST(TreeLabels, AreChangedInPlace) {
    TreeDialog dialog(TreeDialog::plain | TVS_EDITLABELS);
    SECTreeCtrl& tree = dialog.tree;
    bool refuses = false;
    std::vector<std::string> ended;
    dialog.answer = [&](NMHDR& header) {
        if (header.code == TVN_ENDLABELEDIT) {
            const char* text = reinterpret_cast<const NMTVDISPINFO&>(header).item.pszText;
            ended.emplace_back(text ? text : "(given up)");
        }
        return LRESULT{header.code == TVN_ENDLABELEDIT ? !refuses : header.code == TVN_BEGINLABELEDIT && refuses};
    };
    dialog.with([&] {
        dialog.fill();
        tree.SelectItem(dialog.b);
        key(Qt::Key_F2);
        ASSERT_NE(tree.GetEditControl(), nullptr);
        EXPECT_EQ(textOf(tree.GetEditControl()), "B");
        type("new name");
        key(Qt::Key_Return);
        EXPECT_EQ(dialog.lines(), "A [new name] C");
        EXPECT_EQ(dialog.focus(), TreeDialog::treeId);
        key(Qt::Key_F2);
        type("other");
        key(Qt::Key_Escape); // not the dialog
        EXPECT_EQ(dialog.lines(), "A [new name] C");
        EXPECT_TRUE(dialog.IsWindowVisible());
        ASSERT_NE(tree.EditLabel(dialog.b), nullptr);
        type("by tab");
        key(Qt::Key_Tab);
        EXPECT_TRUE(QTest::qWaitFor([&] { return dialog.focus() != TreeDialog::treeId; }));
        EXPECT_EQ(dialog.lines(), "A [by tab] C");
        EXPECT_EQ(ended, (std::vector<std::string>{"new name", "(given up)", "by tab"}));
        // A second click, which is none of two.
        tree.SetFocus();
        click(&tree, dialog.middle(dialog.b));
        EXPECT_TRUE(QTest::qWaitFor([&] { return tree.GetEditControl() != nullptr; }));
        type("by click");
        click(&tree, dialog.middle(dialog.c));
        EXPECT_EQ(dialog.lines(), "A by click [C]");
        refuses = true;
        EXPECT_EQ(tree.EditLabel(dialog.b), nullptr);
        EXPECT_FALSE(tree.EndEditLabelNow(TRUE));
        refuses = false;
        ASSERT_NE(tree.EditLabel(dialog.b), nullptr);
        tree.DeleteItem(dialog.b); // under the user's hands
        EXPECT_TRUE(QTest::qWaitFor([&] { return tree.GetEditControl() == nullptr; }));
    });
}

TEST(TreeLook, FollowsStateAndColours) {
    TreeDialog dialog(TVS_HASBUTTONS | TVS_LINESATROOT);
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        tree.SelectItem(dialog.b);
        CRect line;
        tree.GetItemRect(dialog.b, &line, FALSE);
        // Right of the label, where the line is filled.
        const auto shown = [&] {
            return dialog.area()->grab().toImage().pixelColor(line.right - 5, line.CenterPoint().y);
        };
        const QPalette palette = dialog.area()->palette();
        const QColor full = shown();
        const QColor base = palette.color(QPalette::Active, QPalette::Base);
        EXPECT_LT(std::abs(full.hue() - palette.color(QPalette::Active, QPalette::Highlight).hue()), 5);
        dialog.other.SetFocus();
        EXPECT_EQ(shown(), base);
        tree.ModifyStyle(0, TVS_SHOWSELALWAYS);
        const QColor faint = shown();
        EXPECT_GT(faint.saturation(), base.saturation());
        EXPECT_LT(faint.saturation(), full.saturation());
        // Nothing is painted while it must not be.
        tree.SetFocus();
        const QImage before = dialog.area()->grab().toImage();
        tree.SetRedraw(FALSE);
        tree.DeleteItem(dialog.b);
        tree.SetRedraw(TRUE);
        EXPECT_NE(dialog.area()->grab().toImage(), before);
        const auto withButtons = dialog.area()->grab().toImage();
        tree.ModifyStyle(TVS_HASBUTTONS, 0);
        tree.ModifyStyle(0, TVS_HASLINES); // the column stays
        EXPECT_NE(dialog.area()->grab().toImage(), withButtons);
    });
}

TEST(TreeAccess, ShowsLinesWithTheirState) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        tree.Expand(dialog.a, TVE_EXPAND);
        tree.SelectItem(dialog.a1);
        QAccessibleInterface* told = QAccessible::queryAccessibleInterface(dialog.area()->parentWidget());
        EXPECT_EQ(accessibleTree(*told), "Tree \"\"\n TreeItem \"A\"\n TreeItem \"a1\"\n TreeItem \"a2\"\n"
                                         " TreeItem \"B\"\n TreeItem \"C\"\n");
        QAccessibleInterface* item = told->child(1);
        EXPECT_TRUE(item->state().selected && item->state().focused && item->state().collapsed);
        EXPECT_FALSE(told->child(2)->state().expandable);
        EXPECT_EQ(told->focusChild(), item);
        EXPECT_EQ(told->indexOfChild(item), 1);
        EXPECT_EQ(item->parent(), told);
        const QPoint point = item->rect().center();
        EXPECT_EQ(told->childAt(point.x(), point.y()), item);
        item->actionInterface()->doAction(QAccessibleActionInterface::toggleAction());
        EXPECT_EQ(dialog.lines(), "A [a1] a11 a2 B C");
        told->child(5)->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
        EXPECT_EQ(dialog.lines(), "A a1 a11 a2 B [C]");
        tree.DeleteItem(dialog.a);
        EXPECT_FALSE(item->isValid());
        EXPECT_EQ(told->childCount(), 2);
    });
}

} // namespace
