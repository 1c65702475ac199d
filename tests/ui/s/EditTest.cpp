// Edit controls of the library: finding, appending within a limit, the menu of a right click.
#include "s/Edit.h"

#include "afxwin.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <memory>
#include <string>
#include <utility>

namespace {

constexpr DWORD logStyle = WS_CHILD | WS_VISIBLE | WS_VSCROLL | ES_MULTILINE | ES_AUTOHSCROLL;

/// A window with one edit control, which notes requests for a context menu.
class EditWindow : public CWnd {
public:
    explicit EditWindow(DWORD style = logStyle) {
        CreateEx(0, nullptr, "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 20, 20, 400, 240, nullptr, nullptr);
        edit.Create(style, CRect(0, 0, 300, 160), this, 1);
        EXPECT_TRUE(waitForActive(*this));
    }
    std::pair<int, int> selection() const {
        int start = 0;
        int end = 0;
        edit.GetSel(start, end);
        return {start, end};
    }
    std::string text() const {
        return textOf(&edit);
    }
    int find(const char* wanted, int from, int to, unsigned long flags) {
        range = {{from, to}, wanted, {-7, -7}};
        return edit.FindTextA(flags, &range);
    }

    Gui_Edit edit;
    _findtextexa range{};
    int menus = 0;
    CPoint menuPlace;

protected:
    afx_msg void OnContextMenu(CWnd*, CPoint point) {
        ++menus;
        menuPlace = point;
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(EditWindow, CWnd)
    ON_WM_CONTEXTMENU()
END_MESSAGE_MAP()
// clang-format on

using Selection = std::pair<int, int>;

} // namespace

TEST(Edit, ReadsTheSelection) {
    EditWindow window;
    window.edit.SetWindowText("один two\r\nthree");
    EXPECT_EQ(window.edit.GetTextLength(), 19);
    EXPECT_EQ(window.edit.GetSelText(), "");
    window.edit.SetSel(9, 14);
    EXPECT_EQ(window.edit.GetSelText(), "two\r\n");
    window.edit.SetSel(0, -1);
    EXPECT_EQ(window.edit.GetSelText(), "один two\r\nthree");
}

TEST(Edit, FindsByCaseAndWholeWords) {
    EditWindow window;
    window.edit.SetWindowText("concat cat");
    EXPECT_EQ(window.find("cat", 0, 10, 2), 7);
    EXPECT_EQ(window.find("cat", 0, 10, 0), 3);
    EXPECT_EQ(window.find("cat", 0, 5, 0), -1); // it ends at 6
    EXPECT_EQ(window.range.chrgText.cpMin, 3);
    EXPECT_EQ(window.range.chrgText.cpMax, 6);
    EXPECT_EQ(window.find("CAT", 0, 10, 4), -1);
    EXPECT_EQ(window.find("CAT", 0, 10, 6), -1);
    EXPECT_EQ(window.find("CAT", 0, 10, 2), 7);
    EXPECT_EQ(window.find("CAT", 0, 10, 1 | 4), 3); // a further bit: neither case nor words count
    EXPECT_EQ(window.find("cat", 3, 10, 2), 7);     // "n" stands before it
    EXPECT_EQ(window.find("cat", 4, -1, 0), -1);    // the range's end must be a real position
}

TEST(Edit, RefusesSearchesOutsideTheText) {
    EditWindow window;
    EXPECT_EQ(window.find("a", 0, 10, 0), -1);
    window.edit.SetWindowText("abc");
    EXPECT_EQ(window.find("a", -1, 10, 0), -1);
    EXPECT_EQ(window.find("c", 3, 10, 0), -1);
    EXPECT_EQ(window.find("abcd", 0, 10, 0), -1);
    EXPECT_EQ(window.range.chrgText.cpMin, -7);
}

TEST(Edit, FindsWordsInTextOfAnyLanguage) {
    EditWindow window;
    window.edit.SetWindowText("Maßstab\u3000GRÖSSE größe\r\nẞ ende");
    EXPECT_EQ(window.find("größe", 0, 100, 2), 19);
    EXPECT_EQ(window.find("grösse", 0, 100, 2), 11);
    EXPECT_EQ(window.find("SSE", 0, 100, 2), -1);
    EXPECT_EQ(window.find("ß", 0, 100, 2), 28); // the capital form takes a byte more
    EXPECT_EQ(window.range.chrgText.cpMax, 31);
    EXPECT_EQ(window.find("ENDE", 0, 100, 2), 32);
}

TEST(Edit, FindsAmongTextsThatNearlyMatch) {
    EditWindow window;
    window.edit.SetWindowText("abababac aab aaab");
    EXPECT_EQ(window.find("ababac", 0, 100, 0), 2);
    EXPECT_EQ(window.find("aab", 0, 100, 6), 9);
    EXPECT_EQ(window.find("AAAB", 0, 100, 2), 13);
    EXPECT_EQ(window.find("", 3, 100, 0), 3);
    // Comparing at every place would take 600 million steps.
    window.edit.SetWindowText((std::string(50000, 'A') + "b").c_str());
    EXPECT_EQ(window.find((std::string(25000, 'a') + "b").c_str(), 0, 60000, 0), 25000);
}

TEST(Edit, DropsTheOldestTextBeyondTheLimit) {
    EditWindow window;
    window.edit.SetLimitText(1000);
    window.edit.SetWindowText(("start" + std::string(945, '.')).c_str());
    window.edit.SetSel(2, 4);
    window.edit.AppendText(CString('x', 100));
    EXPECT_EQ(window.text(), std::string(900, '.') + std::string(100, 'x'));
    EXPECT_EQ(window.selection(), Selection(0, 0)); // what was selected has gone
    window.edit.SetSel(890, 910);
    window.edit.AppendText("0123456789");
    EXPECT_EQ(window.selection(), Selection(880, 900));
    EXPECT_EQ(window.edit.GetSelText(), std::string(10, '.').append(10, 'x').c_str());
    EXPECT_FALSE(window.edit.CanUndo());
}

TEST(Edit, PutsTheCaretBehindTheNewTextWhenNothingIsSelected) {
    EditWindow window;
    window.edit.AppendText("line\r\n");
    window.edit.SetSel(2, 2);
    Gui_Edit::AppendText(window.edit, "line\r\n");
    EXPECT_EQ(window.text(), "line\r\nline\r\n");
    EXPECT_EQ(window.selection(), Selection(12, 12));
}

TEST(Edit, CutsBetweenCharactersOnly) {
    EditWindow window;
    window.edit.SetLimitText(10);
    window.edit.AppendText("äöü\r\n");
    window.edit.AppendText("1234"); // two bytes too many: one letter
    EXPECT_EQ(window.text(), "öü\r\n1234");
    window.edit.AppendText("567"); // a letter and half of one: both
    EXPECT_EQ(window.text(), "\r\n1234567");
    window.edit.AppendText("89"); // half of a line's end: all of it
    EXPECT_EQ(window.text(), "123456789");
    window.edit.AppendText("€€€€"); // more than the limit: the last of it, and nothing old
    EXPECT_EQ(window.text(), "€€€");
}

TEST(Edit, KeepsTheLimitInWhatTheControlCounts) {
    const struct {
        DWORD style;
        const char* before;
        const char* added;
        const char* after;
    } cases[] = {
        {logStyle, "", "a\nb\nc\nd\n", "b\r\nc\r\nd\r\n"}, // each counts two
        {logStyle, "12345678", "a\r", "2345678a\r\n"},
        {logStyle, "old", "1\r\n3456789", "1\r\n3456789"}, // just the limit
        {logStyle, "old", "a\n123456789", "123456789"},    // half of the line's end has no room
        {logStyle, "old", "äa\n12345678", "\r\n12345678"},
        {WS_CHILD, "12345678", "ab\r\n", "12345678ab"}, // the line's end is not taken
        {WS_CHILD, "12345678", "abc\nlost", "2345678abc"},
    };
    for (const auto& [style, before, added, after] : cases) {
        EditWindow window(style);
        window.edit.SetLimitText(10);
        window.edit.SetWindowText(before);
        window.edit.AppendText(added);
        EXPECT_EQ(window.text(), after) << added;
    }
}

TEST(Edit, GetsALimitWhereItHasNone) {
    for (const auto& [style, limit] : {std::pair<DWORD, UINT>{logStyle, 60000}, {WS_CHILD, 30000}}) {
        EditWindow window(style);
        window.edit.SetLimitText(0);
        window.edit.SetWindowText(std::string(limit, 'x').c_str());
        EXPECT_EQ(window.edit.GetLimitText(), 0u);
        window.edit.AppendText("end");
        EXPECT_EQ(window.edit.GetLimitText(), limit);
        EXPECT_EQ(window.text(), std::string(limit - 3, 'x') + "end");
    }
}

TEST(Edit, LeavesTheMenuOfARightClickToTheParent) {
    EditWindow window;
    // By the window, as the display sends it: the toolkit must know that the button is up again.
    const QWidget* widget = tvx::afx::peerOf(window.edit.m_hWnd);
    QTest::mouseClick(widget->window()->windowHandle(), Qt::RightButton, Qt::NoModifier,
                      widget->mapTo(widget->window(), QPoint(30, 20)));
    ASSERT_TRUE(QTest::qWaitFor([&] { return window.menus != 0; }));
    CPoint place(30, 20);
    window.edit.ClientToScreen(&place);
    EXPECT_EQ(window.menuPlace, place);
    EXPECT_EQ(window.menus, 1);
    EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
}

namespace {

/// A log of numbered lines, fifty of which have room.
class LogWindow : public EditWindow {
public:
    explicit LogWindow(DWORD style = 0) : EditWindow(logStyle | style) {
        edit.SetLimitText(50 * 10);
        append(50);
    }
    void append(int lines) {
        for (int i = 0; i < lines; ++i) {
            CString line;
            line.Format("line %03d\r\n", m_next++);
            edit.AppendText(line);
        }
    }
    std::string firstSeen() const {
        char buffer[40] = {};
        edit.GetLine(edit.GetFirstVisibleLine(), buffer, sizeof(buffer) - 1);
        return buffer;
    }
    bool seesEnd() {
        SCROLLINFO bar{};
        return edit.GetScrollInfo(SB_VERT, &bar) && bar.nPos + std::max<int>(bar.nPage, 1) > bar.nMax;
    }

private:
    int m_next = 0;
};

} // namespace

TEST(Edit, FollowsNewTextWhileItsEndIsInSight) {
    LogWindow log;
    EXPECT_TRUE(log.seesEnd());
    log.append(20);
    EXPECT_TRUE(log.seesEnd());
    EXPECT_EQ(log.text().substr(0, 8), "line 020");
}

TEST(Edit, LeavesTheViewOfAUserWhoHasScrolled) {
    LogWindow log;
    log.edit.LineScroll(-20);
    const std::string seen = log.firstSeen();
    ASSERT_FALSE(log.seesEnd());
    log.append(5);
    EXPECT_EQ(log.firstSeen(), seen);
    log.edit.LineScroll(1000);
    log.append(1);
    EXPECT_TRUE(log.seesEnd()); // back at the end, it follows again
}

TEST(Edit, KeepsWhatAUserHasSelectedAndScrolledTo) {
    LogWindow log;
    log.edit.SetSel(log.edit.LineIndex(30), log.edit.LineIndex(32));
    log.edit.LineScroll(28 - log.edit.GetFirstVisibleLine());
    const CString selected = log.edit.GetSelText();
    ASSERT_EQ(selected, "line 030\r\nline 031\r\n");
    log.append(20);
    EXPECT_EQ(log.edit.GetSelText(), selected);
    EXPECT_EQ(log.firstSeen(), "line 028");
    log.append(11); // the first of the selected lines goes
    EXPECT_EQ(log.edit.GetSelText(), "line 031\r\n");
    EXPECT_EQ(log.firstSeen(), "line 031");
}

TEST(Edit, CountsBytesThroughEveryChange) {
    EditWindow window;
    const char* pieces[] = {"", "a", "größe", "\r\n", "日本\r\n語", "😀", "\xFF", "x\r\n\r\n"};
    unsigned random = 1;
    for (int i = 0; i < 3000; ++i) {
        random = random * 1103515245 + 12345;
        const int length = window.edit.GetTextLength();
        const int start = static_cast<int>((random >> 8) % static_cast<unsigned>(length + 1));
        window.edit.SetSel(start, std::min(start + static_cast<int>(random >> 4) % 9, length));
        if (random % 7 == 0) {
            window.edit.Undo();
        } else {
            window.edit.ReplaceSel(pieces[(random >> 16) % std::size(pieces)], TRUE);
        }
        const std::string text = window.text();
        ASSERT_EQ(window.edit.GetTextLength(), static_cast<int>(text.size())) << i;
        const int line = window.edit.LineFromChar(-1);
        const int index = window.edit.LineIndex(line);
        ASSERT_TRUE(index == 0 || text.substr(static_cast<std::size_t>(index) - 2, 2) == "\r\n") << i;
    }
    EXPECT_NE(window.text().find('\xFF'), std::string::npos); // bytes that are no text are kept
}
