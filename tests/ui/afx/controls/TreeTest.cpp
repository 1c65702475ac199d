#include "platform/afx/controls/Edit.h"
#include "platform/afx/controls/ImageList.h"
#include "tests/ui/afx/controls/TreeTesting.h"

#include <set>

// What programs do with trees.

namespace {

using Lines = TreeDialog::Lines;

TEST(Tree, KeepsItemsInTheirOrder) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        EXPECT_EQ(dialog.lines(), "A B C");
        EXPECT_EQ(tree.GetCount(), 7U);
        EXPECT_EQ(dialog.name(tree.InsertItem("first", TVI_ROOT, TVI_FIRST)), "first");
        tree.InsertItem("behind A", TVI_ROOT, dialog.a);
        EXPECT_EQ(dialog.lines(), "first A behind A B C");
        EXPECT_EQ(tree.InsertItem("lost", TVI_ROOT, dialog.a1), nullptr); // no child of the root

        const HTREEITEM sorted = tree.InsertItem("sorted", dialog.c);
        for (const char* text : {"b", "É", "a", "B", "é", "_"}) {
            tree.InsertItem(text, sorted, TVI_SORT);
        }
        std::string order;
        for (HTREEITEM item = tree.GetChildItem(sorted); item; item = tree.GetNextSiblingItem(item)) {
            order += dialog.name(item);
        }
        EXPECT_EQ(order, "_abBÉé");
        const HTREEITEM last = tree.GetNextItem(tree.GetChildItem(sorted), TVGN_NEXT);
        EXPECT_EQ(tree.GetPrevSiblingItem(last), tree.GetChildItem(sorted));
        EXPECT_EQ(tree.GetParentItem(last), sorted);
        EXPECT_EQ(tree.GetParentItem(dialog.a), nullptr);

        // All of them one after another, closed ones too.
        std::string all;
        for (HTREEITEM item = tree.GetRootItem(); item; item = tree.GetNextItem(item)) {
            all += dialog.name(item) + " ";
        }
        EXPECT_EQ(all, "first A a1 a11 a2 behind A B b1 C sorted _ a b B É é ");
        EXPECT_EQ(dialog.name(tree.GetIndexItem(3)), "a11");
        EXPECT_EQ(tree.GetIndexItem(16), nullptr);
        EXPECT_EQ(tree.GetIndexItem(-1), nullptr);
    });
}

TEST(Tree, SortsChildren) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.answer = [](NMHDR& header) {
        if (header.code == TVN_GETDISPINFO) {
            reinterpret_cast<NMTVDISPINFO&>(header).item.pszText = const_cast<LPSTR>("kept"); // not copied
        }
        return LRESULT{0};
    };
    dialog.with([&] {
        int number = 0;
        for (const char* text : {"x", "B", "a", "b"}) {
            tree.SetItemData(tree.InsertItem(text), static_cast<DWORD_PTR>(++number));
        }
        tree.InsertItem(LPSTR_TEXTCALLBACK);
        tree.SelectItem(tree.GetRootItem());
        EXPECT_TRUE(tree.SortChildren(TVI_ROOT));
        EXPECT_EQ(dialog.lines(), "a B b kept [x]");
        TVSORTCB backwards{
            TVI_ROOT,
            [](LPARAM left, LPARAM right, LPARAM factor) { return static_cast<int>((left - right) * factor); }, -1};
        EXPECT_TRUE(tree.SortChildrenCB(&backwards));
        EXPECT_EQ(dialog.lines(), "b a B [x] kept");
    });
}

TEST(Tree, KeepsWhatItemsAreGiven) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        const HTREEITEM item = tree.InsertItem("text", 1, 2);
        int image = 0;
        int selected = 0;
        EXPECT_TRUE(tree.GetItemImage(item, image, selected));
        EXPECT_EQ(std::pair(image, selected), std::pair(1, 2));
        EXPECT_TRUE(tree.SetItemImage(item, 3, 4));
        EXPECT_TRUE(tree.GetItemImage(item, image, selected));
        EXPECT_EQ(std::pair(image, selected), std::pair(3, 4));
        EXPECT_EQ(tree.GetItemData(item), 0U);
        EXPECT_TRUE(tree.SetItemData(item, 77));
        EXPECT_EQ(tree.GetItemData(item), 77U);
        const std::string text(5000, 'x');
        EXPECT_TRUE(tree.SetItemText(item, (text + "é").c_str()));
        EXPECT_EQ(dialog.name(item), text + "é");
        EXPECT_FALSE(tree.ItemHasChildren(item));
        TVITEM claims{TVIF_CHILDREN, item, 0, 0, nullptr, 0, 0, 0, 1, 0};
        EXPECT_TRUE(tree.SetItem(&claims));
        EXPECT_TRUE(tree.ItemHasChildren(item));
        EXPECT_TRUE(tree.SetItemState(item, TVIS_BOLD, TVIS_BOLD));
        EXPECT_EQ(tree.GetItemState(item, TVIS_BOLD | TVIS_EXPANDED), UINT{TVIS_BOLD});

        CImageList images;
        images.Create(16, 30, ILC_COLOR24, 1, 1);
        CRect before;
        CRect after;
        tree.GetItemRect(item, &before, FALSE);
        EXPECT_EQ(tree.SetImageList(&images, TVSIL_NORMAL), nullptr);
        EXPECT_EQ(tree.GetImageList(TVSIL_NORMAL), &images);
        tree.GetItemRect(item, &after, FALSE);
        EXPECT_GT(after.Height(), 30); // as high as the pictures
        EXPECT_LT(before.Height(), 30);
        EXPECT_EQ(tree.SetImageList(nullptr, TVSIL_NORMAL), &images);
    });
}

TEST(Tree, RefusesItemsThatHaveGone) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        tree.SelectItem(dialog.a1);
        const HTREEITEM gone = dialog.a1;
        EXPECT_TRUE(tree.DeleteItem(gone));
        // The place in the table is taken again, but not by this handle.
        EXPECT_NE(tree.InsertItem("new", dialog.a), gone);
        for (const HTREEITEM item :
             {gone, TVI_SORT, reinterpret_cast<HTREEITEM>(1), reinterpret_cast<HTREEITEM>(~0ULL)}) {
            CRect rect;
            int image = 0;
            EXPECT_EQ(tree.InsertItem("x", item), nullptr);
            EXPECT_FALSE(tree.DeleteItem(item));
            EXPECT_FALSE(tree.SelectItem(item));
            EXPECT_FALSE(tree.Expand(item, TVE_EXPAND));
            EXPECT_FALSE(tree.EnsureVisible(item));
            EXPECT_FALSE(tree.GetItemRect(item, &rect, TRUE));
            EXPECT_FALSE(tree.SetItemText(item, "x"));
            EXPECT_FALSE(tree.GetItemImage(item, image, image));
            EXPECT_FALSE(tree.SortChildren(item));
            EXPECT_FALSE(tree.Select(item, TVGN_FIRSTVISIBLE));
            EXPECT_EQ(dialog.name(item), "");
            EXPECT_EQ(tree.GetItemData(item), 0U);
            EXPECT_EQ(tree.EditLabel(item), nullptr);
            for (const UINT code : {TVGN_NEXT, TVGN_PREVIOUS, TVGN_PARENT, TVGN_CHILD, TVGN_NEXTVISIBLE,
                                    TVGN_PREVIOUSVISIBLE, TVGN_NEXTSELECTED}) {
                EXPECT_EQ(tree.CTreeCtrl::GetNextItem(item, code), nullptr) << code;
            }
        }
        EXPECT_EQ(tree.GetCount(), 6U);
    });
}

TEST(Tree, TellsOfSelection) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        EXPECT_EQ(tree.GetSelectedItem(), nullptr);
        EXPECT_TRUE(tree.SelectItem(dialog.a1)); // opened around
        EXPECT_EQ(dialog.told(), (Lines{"selchanging >a1 0", "expanding A 2", "expanded A 2", "selchanged >a1 0"}));
        EXPECT_EQ(dialog.lines(), "A [a1] a2 B C");
        EXPECT_TRUE(tree.SelectItem(dialog.a1));
        EXPECT_EQ(dialog.told(), Lines{});
        dialog.answer = [](NMHDR& header) { return LRESULT{header.code == TVN_SELCHANGING}; };
        EXPECT_FALSE(tree.SelectItem(dialog.c));
        EXPECT_EQ(tree.GetSelectedItem(), dialog.a1);
        key(Qt::Key_Down);
        click(&tree, dialog.middle(dialog.c));
        EXPECT_EQ(dialog.lines(), "A [a1] a2 B C");
        dialog.answer = nullptr;
        dialog.told();

        // Who goes hands the selection on.
        tree.DeleteItem(dialog.a1);
        EXPECT_EQ(dialog.told(), (Lines{"delete 0", "delete 0", "selchanging >a2 0", "selchanged >a2 0"}));
        tree.DeleteItem(tree.GetSelectedItem());
        EXPECT_EQ(dialog.lines(), "[A] B C");
        EXPECT_TRUE(tree.SelectItem(nullptr));
        EXPECT_EQ(dialog.lines(), "A B C");
        EXPECT_EQ(tree.GetSelectedItem(), nullptr);
        dialog.told();
        EXPECT_TRUE(tree.SelectItem(dialog.b, TRUE)); // marked only
        EXPECT_EQ(dialog.lines(), "A [B] C");
        EXPECT_EQ(dialog.told(), Lines{});
        EXPECT_TRUE(tree.DeleteAllItems());
        EXPECT_EQ(dialog.told(), (Lines{"delete 0", "delete 0", "delete 0", "delete 0"}));
        EXPECT_EQ(tree.GetSelectedItem(), nullptr);
    });
}

TEST(Tree, OpensItemsOnDemand) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.answer = [&](NMHDR& header) {
        const auto& what = reinterpret_cast<const NMTREEVIEW&>(header);
        if (header.code == TVN_ITEMEXPANDING && what.action == TVE_EXPAND && what.itemNew.lParam == 1) {
            tree.InsertItem("made", what.itemNew.hItem);
        }
        return LRESULT{header.code == TVN_ITEMEXPANDING && what.itemNew.lParam == 2};
    };
    dialog.with([&] {
        TVINSERTSTRUCT demand{
            TVI_ROOT,
            TVI_LAST,
            {TVIF_TEXT | TVIF_CHILDREN | TVIF_PARAM, nullptr, 0, 0, const_cast<LPSTR>("demand"), 0, 0, 0, 1, 1}};
        const HTREEITEM item = tree.InsertItem(&demand);
        const HTREEITEM locked = tree.InsertItem("locked");
        tree.SetItemData(locked, 2);
        tree.InsertItem("inside", locked);
        EXPECT_FALSE(tree.Expand(locked, TVE_EXPAND));
        EXPECT_TRUE(tree.Expand(item, TVE_EXPAND));
        EXPECT_EQ(dialog.lines(), "demand made locked");
        EXPECT_FALSE(tree.Expand(item, TVE_EXPAND)); // it is
        dialog.told();
        // Programs are told the first time only.
        EXPECT_TRUE(tree.Expand(item, TVE_TOGGLE));
        EXPECT_TRUE(tree.Expand(item, TVE_TOGGLE));
        EXPECT_EQ(dialog.told(), Lines{});
        // The keyboard does not stay where nothing is seen.
        tree.SelectItem(tree.GetChildItem(item));
        dialog.told();
        EXPECT_TRUE(tree.Expand(item, TVE_COLLAPSE | TVE_COLLAPSERESET));
        EXPECT_EQ(dialog.told(), (Lines{"selchanging made>demand 0", "selchanged made>demand 0", "delete 0"}));
        EXPECT_EQ(dialog.lines(), "[demand] locked");
        EXPECT_TRUE(tree.Expand(item, TVE_EXPAND)); // asked again
        EXPECT_EQ(dialog.lines(), "[demand] made locked");
        EXPECT_FALSE(tree.Expand(tree.GetChildItem(item), TVE_EXPAND)); // nothing below
    });
}

TEST(Tree, AsksForWhatIsSeenOnly) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    std::set<HTREEITEM> asked;
    dialog.answer = [&](NMHDR& header) {
        if (header.code == TVN_GETDISPINFO) {
            auto& item = reinterpret_cast<NMTVDISPINFO&>(header).item;
            asked.insert(item.hItem);
            if ((item.mask & TVIF_TEXT) != 0) {
                strncpy(item.pszText, ("item " + std::to_string(item.lParam)).c_str(), 100);
            }
            item.cChildren = static_cast<int>(item.lParam % 2);
            item.iImage = 0;
        }
        return LRESULT{0};
    };
    dialog.with([&] {
        constexpr LPARAM count = 100000;
        HTREEITEM last = nullptr;
        for (LPARAM number = 0; number < count; ++number) {
            TVINSERTSTRUCT insert{nullptr,
                                  TVI_LAST,
                                  {TVIF_TEXT | TVIF_CHILDREN | TVIF_PARAM | TVIF_IMAGE, nullptr, 0, 0,
                                   LPSTR_TEXTCALLBACK, 0, I_IMAGECALLBACK, 0, I_CHILDRENCALLBACK, number}};
            last = tree.InsertItem(&insert);
        }
        dialog.area()->grab();
        EXPECT_GT(asked.size(), 4U);
        EXPECT_LT(asked.size(), 40U);
        EXPECT_EQ(dialog.name(last), "item 99999");
        EXPECT_TRUE(tree.ItemHasChildren(last));
        asked.clear();
        EXPECT_TRUE(tree.EnsureVisible(last));
        dialog.area()->grab();
        EXPECT_LT(asked.size(), 40U);
        // The last line is whole.
        CRect rect;
        EXPECT_TRUE(tree.GetItemRect(last, &rect, FALSE));
        EXPECT_LE(rect.bottom, dialog.area()->height());
        EXPECT_FALSE(tree.EnsureVisible(last));
        // What goes above the first line does not move it.
        const HTREEITEM first = tree.GetFirstVisibleItem();
        tree.DeleteItem(tree.GetRootItem());
        tree.InsertItem("new", TVI_ROOT, TVI_FIRST);
        tree.InsertItem("newer", TVI_ROOT, TVI_FIRST);
        EXPECT_EQ(tree.GetFirstVisibleItem(), first);
        EXPECT_TRUE(tree.Select(tree.GetIndexItem(50), TVGN_FIRSTVISIBLE));
        EXPECT_EQ(tree.GetFirstVisibleItem(), tree.GetIndexItem(50));
    });
}

TEST(Tree, KnowsItsPlaces) {
    TreeDialog dialog;
    SECTreeCtrl& tree = dialog.tree;
    dialog.with([&] {
        dialog.fill();
        tree.Expand(dialog.a, TVE_EXPAND);
        CRect label;
        CRect line;
        EXPECT_TRUE(tree.GetItemRect(dialog.a1, &label, TRUE));
        EXPECT_TRUE(tree.GetItemRect(dialog.a1, &line, FALSE));
        EXPECT_EQ(line.left, 0);
        const auto at = [&](LONG x) {
            UINT flags = 0;
            const HTREEITEM item = tree.HitTest(CPoint(static_cast<int>(x), label.CenterPoint().y), &flags);
            return std::pair(item, flags);
        };
        EXPECT_EQ(at(label.CenterPoint().x), std::pair(dialog.a1, UINT{TVHT_ONITEMLABEL}));
        EXPECT_EQ(at(label.left - 5), std::pair(dialog.a1, UINT{TVHT_ONITEMBUTTON}));
        EXPECT_EQ(at(2), std::pair(dialog.a1, UINT{TVHT_ONITEMINDENT}));
        EXPECT_EQ(at(label.right + 5), std::pair(dialog.a1, UINT{TVHT_ONITEMRIGHT}));
        EXPECT_EQ(at(-5), std::pair(HTREEITEM{}, UINT{TVHT_TOLEFT}));
        EXPECT_EQ(tree.HitTest(CPoint(20, line.Height() * 6)), nullptr);
        tree.Expand(dialog.a, TVE_COLLAPSE);
        EXPECT_FALSE(tree.GetItemRect(dialog.a1, &label, TRUE)); // in no line
        // Without the column for buttons the topmost items begin at the edge.
        tree.ModifyStyle(TVS_LINESATROOT, 0);
        EXPECT_TRUE(tree.GetItemRect(dialog.a, &label, TRUE));
        EXPECT_EQ(label.left, 0);
    });
}

/// What handlers do that are not kind.
TEST(Tree, LivesThroughItsHandlers) {
    enum class Deed { RemoveItem, RemoveAll, EndTree };
    const UINT codes[] = {TVN_SELCHANGING, TVN_SELCHANGED, TVN_ITEMEXPANDING,  TVN_ITEMEXPANDED, TVN_GETDISPINFO,
                          TVN_DELETEITEM,  TVN_KEYDOWN,    TVN_BEGINLABELEDIT, TVN_ENDLABELEDIT, NM_CLICK,
                          NM_DBLCLK,       NM_RCLICK,      NM_RETURN};
    for (const Deed deed : {Deed::RemoveItem, Deed::RemoveAll, Deed::EndTree}) {
        for (const UINT code : codes) {
            TreeDialog dialog(TreeDialog::plain | TVS_EDITLABELS);
            SECTreeCtrl& tree = dialog.tree;
            int done = 0;
            bool armed = false;
            dialog.answer = [&](NMHDR& header) {
                if (armed && header.code == code && done++ < 100 && tree.m_hWnd) {
                    if (deed == Deed::RemoveItem) {
                        tree.DeleteItem(tree.GetSelectedItem());
                        tree.DeleteItem(tree.GetRootItem());
                    } else if (deed == Deed::RemoveAll) {
                        tree.DeleteAllItems();
                    } else {
                        tree.DestroyWindow();
                    }
                }
                return LRESULT{header.code == TVN_ENDLABELEDIT};
            };
            dialog.with([&] {
                dialog.fill();
                tree.InsertItem(LPSTR_TEXTCALLBACK, dialog.a);
                tree.SelectItem(dialog.a);
                armed = true;
                const auto lives = [&] { return tree.m_hWnd && tree.GetCount() > 0; };
                const auto act = [&](const std::function<void()>& deedOfUser) {
                    if (lives() && QApplication::focusWidget()) {
                        deedOfUser();
                    }
                };
                act([&] { tree.SendMessage(WM_KEYDOWN, VK_RETURN); }); // the dialog would take it
                act([] { type("*"); });
                act([&] { dialog.area()->grab(); });
                act([] { key(Qt::Key_Down); });
                act([&] { click(&tree, QPoint(60, 10), Qt::NoModifier, Qt::RightButton); });
                act([&] { QTest::mouseDClick(dialog.area(), Qt::LeftButton, {}, QPoint(60, 30)); });
                act([&] { tree.SelectItem(tree.GetRootItem()); });
                act([] { key(Qt::Key_F2); });
                act([&] { tree.EndEditLabelNow(FALSE); });
                act([&] { click(&tree, QPoint(60, 10)); });
                act([] { type("b"); });
                act([&] { tree.Expand(tree.GetRootItem(), TVE_TOGGLE); });
                act([&] { tree.DeleteItem(tree.GetSelectedItem()); });
                EXPECT_GT(done, 0) << static_cast<int>(code) << " " << static_cast<int>(deed);
            });
        }
    }
}

} // namespace
