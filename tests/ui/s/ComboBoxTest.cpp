// Combo boxes of the library.
#include "s/ComboBox.h"

#include "afxwin.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QComboBox>
#include <QScrollBar>

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
    struct OpenList {
        int rows; ///< that it shows at once
        int rest; ///< pixels below them
        bool isScrolled;
    };
    OpenList openList() {
        combo.ShowDropDown();
        const auto* box = dynamic_cast<QComboBox*>(tvx::afx::peerOf(combo.m_hWnd));
        EXPECT_TRUE(QTest::qWaitFor([&] { return box->view()->isVisible(); }));
        const int height = box->view()->viewport()->height();
        const int row = box->view()->visualRect(box->model()->index(0, 0)).height();
        const OpenList list{height / row, height % row, box->view()->verticalScrollBar()->isVisible()};
        combo.ShowDropDown(FALSE);
        return list;
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
    for (const DWORD style : {CBS_DROPDOWNLIST, CBS_DROPDOWN}) {
        ComboWindow window(style);
        window.merge({"1", "2", "3", "4", "5"}, nullptr);
        CRect before;
        window.combo.GetWindowRect(&before);
        for (const int height : {5, 15, 40}) {
            window.combo.SetItemHeight(0, static_cast<UINT>(height));
            for (const auto& [asked, shown] : {std::pair(-1, 5), std::pair(3, 3), std::pair(9, 5)}) {
                window.combo.SetSizeExact(asked);
                CRect open;
                window.combo.GetDroppedControlRect(&open);
                EXPECT_EQ(open.Height(), (shown + 1) * height + window.combo.GetItemHeight(-1) + 4);
                EXPECT_EQ(open.Width(), before.Width());
                EXPECT_EQ(open.TopLeft(), before.TopLeft());
                const auto [rows, rest, isScrolled] = window.openList();
                EXPECT_EQ(rows, shown) << height;
                EXPECT_EQ(rest, 0) << height;
                EXPECT_EQ(isScrolled, shown < 5) << height << " " << style << " " << asked;
            }
        }
    }
}
