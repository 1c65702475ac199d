// List boxes of the library: whole lists of strings added, merged, selected, deleted, filtered; the extent that fits.
#include "s/ListBox.h"

#include "afxwin.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <initializer_list>
#include <string>

namespace {

/// A window with one list box.
class ListWindow : public CWnd {
public:
    explicit ListWindow(DWORD style = 0) {
        CreateEx(0, nullptr, "", WS_OVERLAPPEDWINDOW, 20, 20, 300, 240, nullptr, nullptr);
        list.Create(WS_CHILD | WS_VISIBLE | WS_VSCROLL | WS_HSCROLL | style, CRect(0, 0, 200, 160), this, 1);
    }
    void fill(std::initializer_list<const char*> items) {
        for (const char* item : items) {
            list.AddString(item);
        }
    }
    std::string contents() {
        CStringList items;
        EXPECT_EQ(list.GetContents(items), list.GetCount());
        return joined(items);
    }
    std::string selections() {
        CStringList items;
        list.GetSelections(items);
        return joined(items);
    }
    static std::string joined(const CStringList& items) {
        std::string all;
        for (POSITION at = items.GetHeadPosition(); at;) {
            all += std::string(items.GetNext(at)) + ' ';
        }
        return all;
    }
    static void add(CStringList& items, std::initializer_list<const char*> texts) {
        for (const char* text : texts) {
            items.AddTail(text);
        }
    }
    int merge(std::initializer_list<const char*> texts, int (*compare)(const CString*, const CString*)) {
        CStringList items;
        add(items, texts);
        list.AddStringList(items, compare);
        return list.GetCount();
    }

    Gui_ListBox list;
};

int byNumber(const CString* first, const CString* second) {
    return std::atoi(*first) - std::atoi(*second);
}

} // namespace

TEST(ListBox, ComparesByBytesWithCase) {
    const CString upper = "Z";
    const CString lower = "a";
    const CString accented = "é";
    EXPECT_LT(Gui_ListBox::StringCompare(&upper, &lower), 0);
    EXPECT_LT(Gui_ListBox::StringCompare(&lower, &accented), 0);
    EXPECT_EQ(Gui_ListBox::StringCompare(&lower, &lower), 0);
    EXPECT_GT(Gui_ListBox::StringCompare(&accented, &upper), 0);
}

TEST(ListBox, MergesInTheCallersOrderAndKeepsTheSelection) {
    ListWindow single;
    single.fill({"c"});
    single.list.SetCurSel(0);
    EXPECT_EQ(single.merge({"b", "a"}, Gui_ListBox::StringCompare), 3);
    EXPECT_EQ(single.contents(), "a b c ");
    EXPECT_EQ(single.list.GetCurSel(), 2);

    ListWindow multiple(LBS_EXTENDEDSEL);
    multiple.fill({"30", "10", "20"});
    multiple.list.SetSel(0, TRUE);
    multiple.list.SetSel(1, TRUE);
    multiple.merge({"25", "5", "100"}, byNumber);
    EXPECT_EQ(multiple.contents(), "5 10 20 25 30 100 ");
    EXPECT_EQ(multiple.selections(), "10 30 ");
}

TEST(ListBox, SelectsOneOfEqualItemsAgain) {
    ListWindow window(LBS_MULTIPLESEL);
    window.fill({"x", "X", "y"});
    window.list.SetSel(0, TRUE);
    window.list.SetSel(1, TRUE);
    window.merge({"z"}, Gui_ListBox::StringCompare);
    EXPECT_EQ(window.contents(), "X x y z ");
    EXPECT_EQ(window.list.GetSelCount(), 1); // both texts find the second item first
    EXPECT_GT(window.list.GetSel(1), 0);
}

TEST(ListBox, LeavesTheOrderToControlsThatSort) {
    ListWindow sorted(LBS_SORT);
    sorted.fill({"delta", "Alpha"});
    sorted.merge({"Charlie", "bravo"}, byNumber);
    EXPECT_EQ(sorted.contents(), "Alpha bravo Charlie delta ");
    ListWindow plain;
    plain.fill({"z"});
    plain.merge({"c", "a"}, nullptr);
    EXPECT_EQ(plain.contents(), "z c a ");
}

TEST(ListBox, DeletesByText) {
    ListWindow window;
    window.fill({"x", "b", "B", "c", "É"});
    CStringList gone;
    ListWindow::add(gone, {"X", "b", "missing", "é"});
    EXPECT_EQ(window.list.DeleteStringList(gone), 3);
    EXPECT_EQ(window.contents(), "b c "); // one item for each text, the first one last
    CStringList rest;
    ListWindow::add(rest, {"b", "b", "C", ""});
    EXPECT_EQ(window.list.DeleteStringList(rest), 2);
    CStringList nothing;
    EXPECT_LE(window.list.GetContents(nothing), 0);
    EXPECT_TRUE(nothing.IsEmpty());
}

TEST(ListBox, FiltersByWildcards) {
    ListWindow window;
    window.fill({"a.txt", "b.doc", "c.txt"});
    CString pattern = "*.txt";
    EXPECT_EQ(window.list.DeleteUnmatched(pattern), 1);
    EXPECT_EQ(window.contents(), "a.txt c.txt ");
    EXPECT_EQ(window.list.DeleteUnmatched("?.TXT"), 2);
    EXPECT_EQ(window.list.GetCount(), 0);
}

TEST(ListBox, SelectsByText) {
    ListWindow single;
    single.fill({"one", "two", "three", "TWO"});
    EXPECT_EQ(single.list.SelectStringExact(-1, "Two"), 1);
    EXPECT_EQ(single.list.SelectStringExact(1, "two"), 3);
    EXPECT_EQ(single.list.GetCurSel(), 3);
    EXPECT_EQ(single.list.SelectStringExact(-1, "tw"), -1);
    EXPECT_EQ(single.list.GetCurSel(), 3);
    EXPECT_LT(single.list.UnselectAll(), 0);
    CStringList none;
    EXPECT_LT(single.list.GetSelections(none), 0);
    EXPECT_EQ(single.list.GetCurSel(), 3);

    ListWindow multiple(LBS_MULTIPLESEL);
    multiple.fill({"one", "two", "three"});
    EXPECT_NE(multiple.list.SelectStringExact(0, "one"), -1);
    CStringList wanted;
    ListWindow::add(wanted, {"THREE", "four"});
    EXPECT_EQ(multiple.list.SelectStringListExact(wanted), 1);
    EXPECT_EQ(multiple.selections(), "one three ");
    EXPECT_EQ(multiple.list.UnselectAll(), 2);
    EXPECT_EQ(multiple.list.GetSelCount(), 0);
    EXPECT_EQ(multiple.list.UnselectAll(), 0);
}

TEST(ListBox, ScrollsAsFarAsTheWidestItemReaches) {
    ListWindow window;
    window.list.SetHorizontalExtent(77);
    window.list.UpdateHorizontalExtent();
    EXPECT_EQ(window.list.GetHorizontalExtent(), 0);
    const char* widest = "the widest of all items, Ärger mit größeren Wörtern";
    window.fill({"short", widest, "a bit longer"});
    window.list.UpdateHorizontalExtent();
    CDC* dc = window.list.GetDC();
    EXPECT_EQ(window.list.SendMessage(LB_GETHORIZONTALEXTENT), dc->GetTextExtent(widest).cx);
    window.list.ReleaseDC(dc);
}

TEST(ListBox, HoldsAsManyItemsAsHostsGive) {
    ListWindow window(LBS_EXTENDEDSEL);
    CStringList items;
    for (int i = 0; i < 65535; ++i) {
        items.AddTail(std::to_string(i * 7919 % 65535).c_str());
    }
    window.list.AddStringList(items, byNumber);
    EXPECT_EQ(window.list.GetCount(), 65535);
    window.list.SelItemRange(TRUE, 1000, 60999);
    CStringList more;
    more.AddTail("1500");
    window.list.AddStringList(more, byNumber);
    CStringList selected;
    EXPECT_EQ(window.list.GetSelections(selected), 60000);
    CString text;
    window.list.GetText(65535, text);
    EXPECT_EQ(text, "65534");
    EXPECT_EQ(window.list.DeleteStringList(selected), 60000);
    EXPECT_EQ(window.list.DeleteUnmatched("1*"), 5536 - 112);
}
