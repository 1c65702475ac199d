// Combo boxes of the library.
#include "s/ComboBox.h"

#include "afxwin.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QComboBox>

#include <string>

namespace {

class ComboWindow : public CWnd {
public:
    explicit ComboWindow(DWORD style = CBS_DROPDOWNLIST) {
        CreateEx(0, nullptr, "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 20, 20, 300, 240, nullptr, nullptr);
        combo.Create(WS_CHILD | WS_VISIBLE | WS_VSCROLL | style, CRect(10, 10, 160, 60), this, 1);
    }
    std::string contents() {
        CStringList items;
        EXPECT_EQ(combo.GetContents(items), combo.GetCount());
        std::string all;
        for (POSITION at = items.GetHeadPosition(); at;) {
            all += std::string(items.GetNext(at)) + ' ';
        }
        return all;
    }
    void merge(std::initializer_list<const char*> texts, int (*compare)(const CString*, const CString*)) {
        CStringList items;
        for (const char* text : texts) {
            items.AddTail(text);
        }
        combo.AddStringList(items, compare);
    }
    /// The items that the open list shows at once.
    int visibleItems() {
        combo.ShowDropDown();
        const auto* box = dynamic_cast<QComboBox*>(tvx::afx::peerOf(combo.m_hWnd));
        EXPECT_TRUE(QTest::qWaitFor([&] { return box->view()->isVisible(); }));
        const int rows = box->view()->viewport()->height() / combo.GetItemHeight(0);
        combo.ShowDropDown(FALSE);
        return rows;
    }

    Gui_ComboBox combo;
};

} // namespace

TEST(ComboBox, MergesAndForgetsTheSelection) {
    ComboWindow window;
    window.combo.AddString("c");
    window.combo.SetCurSel(0);
    window.merge({"b", "a"}, Gui_ComboBox::StringCompare);
    EXPECT_EQ(window.contents(), "a b c ");
    EXPECT_EQ(window.combo.GetCurSel(), -1);
    window.merge({"z", "y"}, nullptr);
    EXPECT_EQ(window.contents(), "a b c z y ");

    ComboWindow sorted(CBS_DROPDOWNLIST | CBS_SORT);
    sorted.combo.AddString("m");
    sorted.merge({"z", "A"}, Gui_ComboBox::StringCompare);
    EXPECT_EQ(sorted.contents(), "A m z ");
}

TEST(ComboBox, DeletesFiltersAndSelectsByText) {
    ComboWindow window;
    window.merge({"one.brd", "two.brd", "three.txt", "TWO.brd"}, nullptr);
    EXPECT_EQ(window.combo.SelectStringExact(1, "two.BRD"), 3);
    EXPECT_EQ(window.combo.SelectStringExact(-1, "two.brd"), 1);
    EXPECT_EQ(window.combo.SelectStringExact(-1, "two"), -1);
    EXPECT_EQ(window.combo.GetCurSel(), -1);
    EXPECT_EQ(window.combo.DeleteUnmatched("*.brd"), 1);
    CStringList gone;
    gone.AddTail("ONE.BRD");
    gone.AddTail("four.brd");
    EXPECT_EQ(window.combo.DeleteStringList(gone), 1);
    EXPECT_EQ(window.contents(), "two.brd TWO.brd ");
}

TEST(ComboBox, MakesRoomForItems) {
    ComboWindow window;
    window.merge({"1", "2", "3", "4", "5"}, nullptr);
    CRect before;
    window.combo.GetWindowRect(&before);
    for (const auto& [asked, shown] : {std::pair(-1, 5), std::pair(3, 3), std::pair(9, 5)}) {
        window.combo.SetSizeExact(asked);
        CRect open;
        window.combo.GetDroppedControlRect(&open);
        EXPECT_EQ(open.Height(), (shown + 1) * window.combo.GetItemHeight(0) + window.combo.GetItemHeight(-1) + 4);
        EXPECT_EQ(open.Width(), before.Width());
        EXPECT_EQ(open.TopLeft(), before.TopLeft());
        EXPECT_EQ(window.visibleItems(), shown);
    }
}
