#include <gtest/gtest.h>

#include "platform/afx/controls/detail/EditWindow.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/Gdi.h"
#include "tests/ui/afx/controls/ControlTesting.h"

#include <QAbstractItemView>
#include <QClipboard>
#include <QComboBox>
#include <QLineEdit>
#include <QMimeData>
#include <QPlainTextEdit>

namespace {

// --- edit ---

class EditTest : public ControlTest<CEdit> {
protected:
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create(shown | WS_BORDER | style, place, &dialog, controlId));
    }
    std::pair<int, int> selection() const {
        int start = 0;
        int end = 0;
        control.GetSel(start, end);
        return {start, end};
    }
};

TEST_F(EditTest, TellsWhatIsTyped) {
    with(ES_AUTOHSCROLL, [&] {
        type("ab");
        EXPECT_EQ(textOf(&control), "ab");
        EXPECT_EQ(told(EN_UPDATE), 2);
        EXPECT_EQ(told(EN_CHANGE), 2);
        EXPECT_TRUE(control.GetModify());
        control.SetWindowText("program");
        EXPECT_EQ(told(EN_CHANGE), 3);
        EXPECT_FALSE(control.GetModify());
        key(Qt::Key_Backspace);
        EXPECT_EQ(textOf(&control), "program"); // the caret stands at the beginning
        key(Qt::Key_Delete);
        EXPECT_EQ(textOf(&control), "rogram");
    });
}

TEST_F(EditTest, CountsPositionsInBytes) {
    with(ES_AUTOHSCROLL, [&] {
        control.SetWindowText("aä€😀z");
        EXPECT_EQ(control.GetWindowTextLength(), 11);
        control.SetSel(1, 6);
        control.ReplaceSel("-");
        EXPECT_EQ(textOf(&control), "a-😀z");
        control.SetSel(2, 6);
        EXPECT_EQ(selection(), std::pair(2, 6));
        control.SetSel(3, 5); // within a character: moved to its beginning
        EXPECT_EQ(selection(), std::pair(2, 2));
        control.SetSel(0, -1);
        EXPECT_EQ(selection(), std::pair(0, 7));
        control.SetSel(-1, 0);
        EXPECT_EQ(selection(), std::pair(7, 7));
    });
}

TEST_F(EditTest, LimitsTypingAndPastingButNotThePrograms) {
    with(ES_AUTOHSCROLL, [&] {
        EXPECT_EQ(control.GetLimitText(), 30000U);
        control.SetLimitText(5);
        type("abä");
        type("ö"); // two bytes, and one is left
        EXPECT_EQ(textOf(&control), "abä");
        EXPECT_EQ(told(EN_MAXTEXT), 1);
        QApplication::clipboard()->setText("12345");
        control.Paste();
        EXPECT_EQ(textOf(&control), "abä1");
        control.SetWindowText("longer than five");
        EXPECT_EQ(textOf(&control), "longer than five");
    });
}

TEST_F(EditTest, ChangesCaseAndRefusesLetters) {
    with(ES_UPPERCASE | ES_AUTOHSCROLL, [&] {
        type("aé1");
        EXPECT_EQ(textOf(&control), "AÉ1");
    });
    with(ES_NUMBER | ES_AUTOHSCROLL, [&] {
        type("1a2.");
        EXPECT_EQ(textOf(&control), "12");
        QApplication::clipboard()->setText("3x4");
        key(Qt::Key_V, Qt::ControlModifier);
        EXPECT_EQ(textOf(&control), "1234");
    });
}

TEST_F(EditTest, ReadOnlyOnesKeepTheirText) {
    for (const DWORD lines : {DWORD{0}, DWORD{ES_MULTILINE}}) {
        with(lines | ES_READONLY | ES_AUTOHSCROLL, [&] {
            control.SetWindowText("fixed");
            type("x");
            key(Qt::Key_Delete);
            EXPECT_EQ(textOf(&control), "fixed");
            control.SetSel(0, -1);
            key(Qt::Key_C, Qt::ControlModifier);
            EXPECT_EQ(QApplication::clipboard()->text(), "fixed");
            EXPECT_FALSE(QApplication::clipboard()->mimeData()->hasHtml()) << "others get text without fonts";
            control.SetReadOnly(FALSE);
            type("x");
            EXPECT_EQ(textOf(&control), "x");
            control.Undo();
            EXPECT_EQ(textOf(&control), "fixed");
        });
    }
}

TEST_F(EditTest, CutsForgetsAndHides) {
    with(ES_AUTOHSCROLL, [&] {
        control.SetWindowText("secret");
        control.SetModify();
        EXPECT_TRUE(control.GetModify());
        control.SetModify(FALSE);
        EXPECT_FALSE(control.GetModify());
        control.SetSel(0, 3);
        control.Cut();
        EXPECT_EQ(textOf(&control), "ret");
        EXPECT_EQ(QApplication::clipboard()->text(), "sec");
        EXPECT_TRUE(control.CanUndo());
        control.EmptyUndoBuffer();
        EXPECT_FALSE(control.CanUndo());
        const auto& field = dynamic_cast<const QLineEdit&>(*tvx::afx::peerOf(control.m_hWnd));
        EXPECT_EQ(control.GetPasswordChar(), 0);
        control.SetPasswordChar('#');
        EXPECT_EQ(control.GetPasswordChar(), '#');
        EXPECT_NE(field.displayText(), QString("ret"));
        control.SetPasswordChar(0);
        EXPECT_EQ(field.displayText(), QString("ret"));
        control.LimitText(4);
        control.SetSel(3, 3);
        type("xy");
        EXPECT_EQ(textOf(&control), "retx");
    });
}

TEST_F(EditTest, ManyLinesEndInCarriageReturnAndLineFeed) {
    with(ES_MULTILINE | ES_WANTRETURN | ES_AUTOHSCROLL | ES_AUTOVSCROLL | WS_VSCROLL, [&] {
        control.SetWindowText("first\r\nzweite ä\r\n\r\nlast");
        EXPECT_EQ(textOf(&control), "first\r\nzweite ä\r\n\r\nlast");
        EXPECT_EQ(told(EN_CHANGE), 0);
        EXPECT_EQ(control.GetLineCount(), 4);
        EXPECT_EQ(control.LineIndex(1), 7);
        EXPECT_EQ(control.LineIndex(2), 18);
        EXPECT_EQ(control.LineIndex(4), -1);
        EXPECT_EQ(control.LineLength(8), 9);
        EXPECT_EQ(control.LineFromChar(18), 2);
        char line[16] = "";
        EXPECT_EQ(control.GetLine(1, line, sizeof(line)), 9);
        EXPECT_EQ(std::string(line, 9), "zweite ä");
        EXPECT_EQ(control.GetLine(1, line, 8), 7); // no half character
        control.SetSel(5, 5);
        key(Qt::Key_Return);
        EXPECT_EQ(textOf(&control).substr(0, 9), "first\r\n\r\n");
        EXPECT_EQ(told(EN_CHANGE), 1);
        EXPECT_EQ(selection(), std::pair(7, 7));
    });
}

TEST_F(EditTest, UndoneBackToWhatWasSavedManyLinesAreUnmodified) {
    with(ES_MULTILINE, [&] {
        control.SetWindowText("text");
        type("a");
        control.SetModify(FALSE);
        type("b");
        EXPECT_TRUE(control.GetModify());
        control.Undo();
        EXPECT_EQ(textOf(&control), "atext");
        EXPECT_FALSE(control.GetModify());
        control.Undo();
        EXPECT_TRUE(control.GetModify());
    });
}

TEST_F(EditTest, ManyLinesKeepEveryCharacter) {
    with(ES_MULTILINE, [&] {
        const std::string text = "not\xC2\xA0"
                                 "broken, a line\xE2\x80\xA8"
                                 "separator, \xEF\xBF\xBC, caf\xE9, \x01\x0B\x0C\x7F";
        control.SetWindowText(text.c_str());
        EXPECT_EQ(textOf(&control), text);
        control.SetSel(0, -1);
        control.Copy();
        EXPECT_EQ(QApplication::clipboard()->text().left(4), QString::fromUtf8("not\xC2\xA0"));
    });
}

TEST_F(EditTest, WithoutWantReturnEnterIsTheDialogs) {
    dialog.prepare = [&] { make(ES_MULTILINE); };
    dialog.script = [&] {
        control.SetFocus();
        key(Qt::Key_Return);
    };
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.codes(IDOK, BN_CLICKED), 1);
}

namespace {

/// Takes what ends a line, as fields for commands do.
class CommandField : public CEdit {
public:
    std::vector<WPARAM> ends;
    std::vector<WPARAM> keys;

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_KEYDOWN) {
            keys.push_back(wParam);
        }
        if (message == WM_CHAR && (wParam == '\r' || wParam == '\n')) {
            ends.push_back(wParam);
            return 0;
        }
        return CEdit::WindowProc(message, wParam, lParam);
    }
};

/// The first and the last row of a picture's middle that have something dark.
std::pair<int, int> darkRows(const QImage& picture) {
    std::pair rows(-1, -1);
    for (int y = 3; y < picture.height() - 3; ++y) {
        for (int x = 3; x < 40; ++x) {
            if (qGray(picture.pixel(x, y)) < 100) {
                rows = {rows.first < 0 ? y : rows.first, y};
            }
        }
    }
    return rows;
}

} // namespace

TEST(CommandField, IsOneLineThatEnterDoesNotEnd) {
    ScriptedDialog dialog(IDD_EMPTY);
    CommandField command;
    CEdit line;
    dialog.prepare = [&] {
        constexpr DWORD style = shown | WS_BORDER | ES_AUTOHSCROLL;
        ASSERT_TRUE(command.Create(style | ES_MULTILINE | ES_WANTRETURN, CRect(10, 10, 210, 33), &dialog, controlId));
        ASSERT_TRUE(line.Create(style, CRect(10, 40, 210, 63), &dialog, controlId + 1));
    };
    dialog.script = [&] {
        line.SetWindowText("Hxg");
        command.SetFocus();
        type("Hxg");
        key(Qt::Key_Return);
        key(Qt::Key_Return, Qt::ControlModifier);
        key(Qt::Key_Up);
        key(Qt::Key_Down);
        EXPECT_EQ(command.ends, (std::vector<WPARAM>{13, 10}));
        EXPECT_EQ(textOf(&command), "Hxg");
        command.SetSel(3, 3);
        EXPECT_EQ(command.GetFirstVisibleLine(), 0);
        for (const WPARAM arrow : {VK_UP, VK_DOWN}) {
            EXPECT_EQ(std::count(command.keys.begin(), command.keys.end(), arrow), 1);
        }
        // Each without the caret.
        const auto picture = [](const CWnd& field, CWnd& other) {
            other.SetFocus();
            return tvx::afx::Window::from(field.m_hWnd)->widget()->grab().toImage();
        };
        const auto ours = darkRows(picture(command, line));
        const auto usual = darkRows(picture(line, command));
        EXPECT_NEAR(ours.first, usual.first, 1);
        EXPECT_NEAR(ours.second, usual.second, 1);
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}

// --- list box ---

class ListBoxTest : public ListTest<CListBox> {
protected:
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create(shown | WS_BORDER | WS_VSCROLL | LBS_NOTIFY | style, place, &dialog, controlId));
        for (const char* line : lines) {
            control.AddString(line);
        }
    }
    std::vector<const char*> lines{"pear", "Apple", "fig", "apricot", "Zebra"};
};

TEST_F(ListBoxTest, SortsAndFindsWithoutCase) {
    with(LBS_SORT, [&] {
        CString text;
        control.GetText(0, text);
        EXPECT_STREQ(text, "Apple");
        control.GetText(4, text);
        EXPECT_STREQ(text, "Zebra");
        EXPECT_EQ(control.FindString(-1, "AP"), 0);
        EXPECT_EQ(control.FindString(0, "ap"), 1);
        EXPECT_EQ(control.FindString(1, "ap"), 0); // around
        EXPECT_EQ(control.FindStringExact(-1, "ap"), LB_ERR);
        EXPECT_EQ(control.AddString("banana"), 2);
        EXPECT_EQ(control.InsertString(0, "zz"), 0);
        control.SetItemData(3, 77);
        EXPECT_EQ(control.DeleteString(1), 6);
        EXPECT_EQ(control.GetItemData(2), 77U);
        EXPECT_EQ(control.SetItemDataPtr(0, &control), LB_OKAY);
        EXPECT_EQ(control.GetItemDataPtr(0), &control);
        EXPECT_EQ(control.GetTextLen(99), LB_ERR);
        EXPECT_EQ(control.DeleteString(99), LB_ERR);
    });
}

TEST_F(ListBoxTest, TellsWhatTheUserChooses) {
    with(0, [&] {
        control.SetCurSel(1);
        EXPECT_EQ(told(LBN_SELCHANGE), 0);
        click(&control, middle(2));
        EXPECT_EQ(control.GetCurSel(), 2);
        EXPECT_EQ(told(LBN_SELCHANGE), 1);
        key(Qt::Key_Down);
        EXPECT_EQ(control.GetCurSel(), 3);
        type("z");
        EXPECT_EQ(control.GetCurSel(), 4);
        key(Qt::Key_Home);
        EXPECT_EQ(control.GetCurSel(), 0);
        EXPECT_EQ(told(LBN_SELCHANGE), 4);
        QTest::mouseDClick(tvx::afx::peerOf(control.m_hWnd), Qt::LeftButton, {}, middle(1));
        EXPECT_EQ(told(LBN_DBLCLK), 1);
        control.SetCurSel(-1);
        EXPECT_EQ(control.GetCurSel(), LB_ERR);
    });
}

TEST_F(ListBoxTest, ExtendedSelectionsFollowShiftAndControl) {
    with(LBS_EXTENDEDSEL, [&] {
        click(&control, middle(1));
        click(&control, middle(3), Qt::ShiftModifier);
        EXPECT_EQ(selected(), (std::vector<int>{1, 2, 3}));
        click(&control, middle(2), Qt::ControlModifier);
        EXPECT_EQ(selected(), (std::vector<int>{1, 3}));
        click(&control, middle(4));
        EXPECT_EQ(selected(), (std::vector<int>{4}));
        key(Qt::Key_Up, Qt::ShiftModifier);
        EXPECT_EQ(selected(), (std::vector<int>{3, 4}));
        EXPECT_EQ(control.GetAnchorIndex(), 4);
        EXPECT_EQ(control.GetCaretIndex(), 3);
        control.SetAnchorIndex(0);
        control.SetCaretIndex(1);
        EXPECT_EQ(selected(), (std::vector<int>{3, 4})) << "nothing is selected by that";
        key(Qt::Key_Down, Qt::ShiftModifier);
        EXPECT_EQ(selected(), (std::vector<int>{0, 1, 2}));
        control.SetSel(0, FALSE);
        control.SelItemRange(FALSE, 1, 2);
        control.SelItemRange(TRUE, 3, 4);
        control.SelItemRange(TRUE, 0, 1);
        EXPECT_EQ(control.GetSelCount(), 4);
        control.SetSel(-1, FALSE);
        EXPECT_EQ(control.GetSelCount(), 0);
        EXPECT_EQ(control.SetCurSel(1), LB_ERR);
    });
    with(LBS_MULTIPLESEL, [&] {
        click(&control, middle(0));
        click(&control, middle(2));
        EXPECT_EQ(selected(), (std::vector<int>{0, 2}));
        key(Qt::Key_Space);
        EXPECT_EQ(selected(), (std::vector<int>{0}));
    });
}

TEST_F(ListBoxTest, ScrollsThroughManyLines) {
    with(0, [&] {
        control.ResetContent();
        for (int line = 0; line < 1000; ++line) {
            control.AddString(std::to_string(line).c_str());
        }
        control.SetCurSel(500);
        CRect client;
        CRect rect;
        control.GetClientRect(&client);
        control.GetItemRect(500, &rect);
        EXPECT_TRUE(rect.top >= 0 && rect.bottom <= client.bottom);
        control.SetTopIndex(300);
        EXPECT_EQ(control.GetTopIndex(), 300);
        BOOL outside = TRUE;
        EXPECT_EQ(control.ItemFromPoint(CPoint(5, 1), outside), 300U);
        EXPECT_FALSE(outside);
        key(Qt::Key_End);
        EXPECT_EQ(control.GetCurSel(), 999);
    });
}

TEST_F(ListBoxTest, AlignsColumnsAtTabStops) {
    lines = {".\t|"};
    with(LBS_USETABSTOPS, [&] {
        // The second column's place in the first line, in pixels behind the first one's.
        const auto column = [&] {
            const QImage image = tvx::afx::peerOf(control.m_hWnd)->grab().toImage();
            for (int x = 15; x < image.width(); ++x) {
                for (int y = 4; y < 12; ++y) {
                    if (image.pixelColor(x, y).lightness() < 128) {
                        return x - 3;
                    }
                }
            }
            return -1;
        };
        // A dialog unit of this font has 6 / 4 pixels.
        const struct {
            std::vector<int> stops;
            int place;
        } cases[] = {{{}, 48}, {{20}, 30}, {{16, 60}, 24}, {{1, 40}, 60}};
        for (const auto& each : cases) {
            std::vector<int> stops = each.stops;
            EXPECT_TRUE(control.SetTabStops(static_cast<int>(stops.size()), stops.data()));
            EXPECT_NEAR(column(), each.place, 4) << testing::PrintToString(stops);
        }
    });
}

/// Paints its lines itself and keeps count of their ends.
class OwnerList : public CListBox {
public:
    int deleted = 0;

protected:
    void MeasureItem(MEASUREITEMSTRUCT* item) override {
        item->itemHeight = 20;
    }
    void DrawItem(DRAWITEMSTRUCT* item) override {
        const CBrush brush((item->itemState & ODS_SELECTED) != 0 ? RGB(255, 0, 0)
                                                                 : static_cast<COLORREF>(item->itemData));
        ::FillRect(item->hDC, &item->rcItem, brush);
    }
    void DeleteItem(DELETEITEMSTRUCT*) override {
        ++deleted;
    }
};

TEST(OwnerDrawnList, IsPaintedByItsObject) {
    ScriptedDialog dialog(IDD_EMPTY);
    OwnerList list;
    dialog.prepare = [&] {
        const DWORD style = shown | WS_VSCROLL | LBS_OWNERDRAWFIXED | LBS_NOINTEGRALHEIGHT | LBS_NOTIFY;
        ASSERT_TRUE(list.Create(style, CRect(10, 10, 110, 110), &dialog, controlId));
        for (const COLORREF color : {RGB(0, 0, 255), RGB(0, 255, 0)}) {
            list.SendMessage(LB_ADDSTRING, 0, static_cast<LPARAM>(color)); // data instead of a text
        }
    };
    dialog.script = [&] {
        EXPECT_EQ(list.GetItemHeight(0), 20);
        EXPECT_EQ(list.GetItemData(1), static_cast<DWORD_PTR>(RGB(0, 255, 0)));
        const auto colorAt = [&](int y) { return tvx::afx::peerOf(list.m_hWnd)->grab().toImage().pixelColor(50, y); };
        EXPECT_EQ(colorAt(5), QColor(0, 0, 255));
        EXPECT_EQ(colorAt(25), QColor(0, 255, 0));
        click(&list, {50, 5});
        EXPECT_EQ(colorAt(5), QColor(255, 0, 0));
        list.DeleteString(0);
        EXPECT_EQ(list.deleted, 1);
    };
    dialog.DoModal();
    EXPECT_EQ(list.deleted, 2); // the list's end is its lines' end
}

// --- combo box ---

class ComboBoxTest : public ControlTest<CComboBox> {
protected:
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create(shown | WS_VSCROLL | style, place, &dialog, controlId));
        for (const char* line : {"pear", "Apple", "fig"}) {
            control.AddString(line);
        }
    }
};

TEST_F(ComboBoxTest, ChoosesOnlyWhatItIsTold) {
    with(CBS_DROPDOWNLIST | CBS_SORT, [&] {
        EXPECT_EQ(control.GetCurSel(), CB_ERR);
        EXPECT_EQ(control.GetCount(), 3);
        CString text;
        control.GetLBText(0, text);
        EXPECT_STREQ(text, "Apple");
        control.SetCurSel(1);
        EXPECT_EQ(textOf(&control), "fig");
        EXPECT_EQ(told(CBN_SELCHANGE), 0);
        key(Qt::Key_Down);
        EXPECT_EQ(control.GetCurSel(), 2);
        EXPECT_EQ(told(CBN_SELCHANGE), 1);
        EXPECT_EQ(control.AddString("blackberry"), 1);
        EXPECT_EQ(textOf(&control), "pear"); // what is chosen stays chosen
        control.SetItemData(0, 42);
        EXPECT_EQ(control.GetItemData(0), 42U);
        control.SetItemDataPtr(1, &control);
        EXPECT_EQ(control.GetItemDataPtr(1), &control);
        EXPECT_EQ(control.GetLBTextLen(1), 10);
        EXPECT_EQ(control.GetLBTextLen(9), CB_ERR);
        EXPECT_EQ(control.SelectString(-1, "FI"), 2);
        control.DeleteString(2);
        EXPECT_EQ(control.GetCurSel(), CB_ERR);
        control.ResetContent();
        EXPECT_EQ(control.GetCount(), 0);
    });
}

TEST_F(ComboBoxTest, OpensItsList) {
    with(CBS_DROPDOWNLIST, [&] {
        CRect closed;
        control.GetWindowRect(&closed);
        EXPECT_LT(closed.Height(), 30);
        control.ShowDropDown();
        EXPECT_TRUE(control.GetDroppedState());
        EXPECT_EQ(told(CBN_DROPDOWN), 1);
        key(Qt::Key_Escape);
        EXPECT_FALSE(control.GetDroppedState());
        EXPECT_EQ(told(CBN_CLOSEUP), 1);
        EXPECT_TRUE(dialog.IsWindowVisible());
        control.SetItemHeight(0, 40);
        EXPECT_EQ(control.GetItemHeight(2), 40);
        control.GetWindowRect(&closed);
        EXPECT_GE(closed.Height(), 40);
        EXPECT_EQ(control.SetDroppedWidth(333), 333);
        control.ShowDropDown();
        EXPECT_GE(dynamic_cast<QComboBox&>(*tvx::afx::peerOf(control.m_hWnd)).view()->width(), 333);
        control.ShowDropDown(FALSE);
    });
}

TEST_F(ComboBoxTest, LimitsTypingInBytesButNotTheProgram) {
    with(CBS_DROPDOWN, [&] {
        EXPECT_TRUE(control.LimitText(4));
        type("aäöb");
        EXPECT_EQ(textOf(&control), "aäb") << "two bytes, and one was left";
        control.SetCurSel(1);
        EXPECT_EQ(textOf(&control), "Apple");
        EXPECT_TRUE(control.LimitText(0));
        control.SetWindowText("");
        type("longer");
        EXPECT_EQ(textOf(&control), "longer");
    });
    with(CBS_DROPDOWNLIST, [&] { EXPECT_EQ(control.LimitText(3), CB_ERR); });
}

TEST_F(ComboBoxTest, TakesWhatIsTyped) {
    with(CBS_DROPDOWN | CBS_AUTOHSCROLL, [&] {
        EXPECT_EQ(textOf(&control), "");
        type("Bä");
        EXPECT_EQ(textOf(&control), "Bä");
        EXPECT_EQ(told(CBN_EDITCHANGE), 2);
        EXPECT_EQ(control.GetCurSel(), CB_ERR);
        control.SetEditSel(0, 1);
        EXPECT_EQ(control.GetEditSel(), static_cast<DWORD>(MAKELONG(0, 1)));
        control.AddString("new"); // does not disturb the field
        EXPECT_EQ(textOf(&control), "Bä");
        control.SetCurSel(0);
        EXPECT_EQ(textOf(&control), "pear");
    });
}

// --- buttons and statics ---

class ButtonTest : public ControlTest<CButton> {
protected:
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create("&Button", shown | style, CRect(10, 10, 110, 34), &dialog, controlId));
    }
};

TEST_F(ButtonTest, MarksChangeByThemselvesOnlyInAutomaticKinds) {
    with(BS_AUTO3STATE, [&] {
        for (const int expected : {1, 2, 0}) {
            click(&control, {10, 12});
            EXPECT_EQ(control.GetCheck(), expected);
        }
        EXPECT_EQ(told(BN_CLICKED), 3);
    });
    with(BS_CHECKBOX, [&] {
        click(&control, {10, 12});
        EXPECT_EQ(control.GetCheck(), 0);
        EXPECT_EQ(told(BN_CLICKED), 1);
        control.SetCheck(1);
        EXPECT_EQ(told(BN_CLICKED), 1);
    });
}

TEST_F(ButtonTest, AreNotPressedWhileDisabled) {
    with(BS_PUSHBUTTON, [&] {
        control.SetState(TRUE);
        EXPECT_EQ(control.GetState() & BST_PUSHED, UINT{BST_PUSHED});
        control.SetState(FALSE);
        EXPECT_EQ(control.GetState() & BST_PUSHED, 0U);
        EXPECT_EQ(told(BN_CLICKED), 0) << "only looks so";
        click(&control);
        key(Qt::Key_Space);
        EXPECT_EQ(told(BN_CLICKED), 2);
        control.EnableWindow(FALSE);
        click(&control);
        EXPECT_EQ(told(BN_CLICKED), 2);
    });
}

TEST(Icons, StandOnButtonsAndStatics) {
    ScriptedDialog dialog(IDD_EMPTY);
    CButton button;
    CStatic picture;
    const HICON icon = ::LoadIconA(nullptr, IDI_HAND);
    dialog.prepare = [&] {
        ASSERT_TRUE(button.Create("Label", shown | BS_ICON, CRect(10, 10, 60, 60), &dialog, 1));
        ASSERT_TRUE(picture.Create("", WS_CHILD | WS_VISIBLE | SS_ICON, CRect(70, 10, 71, 11), &dialog, 2));
    };
    dialog.script = [&] {
        EXPECT_EQ(button.SetIcon(icon), nullptr);
        EXPECT_EQ(button.SetIcon(icon), icon);
        const auto& widget = dynamic_cast<const QAbstractButton&>(*tvx::afx::peerOf(button.m_hWnd));
        EXPECT_FALSE(widget.icon().isNull());
        EXPECT_EQ(widget.text(), QString());
        EXPECT_EQ(picture.SetIcon(icon), nullptr);
        EXPECT_EQ(picture.GetIcon(), icon);
        CRect rect;
        picture.GetClientRect(&rect);
        EXPECT_EQ(rect, CRect(0, 0, 32, 32)) << "as large as its picture";
    };
    dialog.DoModal();
}

TEST(GroupBox, LetsWhatItSurroundsBeUsed) {
    ScriptedDialog dialog(IDD_EMPTY);
    CButton inside;
    CButton box;
    dialog.prepare = [&] {
        ASSERT_TRUE(inside.Create("Inside", shown | BS_AUTOCHECKBOX, CRect(20, 30, 120, 50), &dialog, 1));
        ASSERT_TRUE(box.Create("Title", WS_CHILD | WS_VISIBLE | BS_GROUPBOX, CRect(10, 10, 160, 80), &dialog, 2));
    };
    dialog.script = [&] {
        QWidget* top = dialog.GetState()->widget();
        QWidget* hit = top->childAt(30, 40);
        ASSERT_EQ(hit, tvx::afx::peerOf(inside.m_hWnd));
        click(&inside, {8, 10});
        EXPECT_EQ(inside.GetCheck(), 1);
        // The title interrupts the frame's upper edge.
        const QImage image = top->grab().toImage();
        const QColor background = image.pixelColor(150, 70);
        EXPECT_NE(image.pixelColor(150, 16), background);
        EXPECT_EQ(image.pixelColor(13, 10), background);
    };
    dialog.DoModal();
}

TEST(Statics, AskForMenusThroughTheirParent) {
    class MenuDialog : public ScriptedDialog {
    public:
        MenuDialog() : ScriptedDialog(IDD_EMPTY) {}
        std::vector<HWND> asked;

    protected:
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
            if (message == WM_CONTEXTMENU) {
                asked.push_back(reinterpret_cast<HWND>(wParam));
                return 0;
            }
            return ScriptedDialog::WindowProc(message, wParam, lParam);
        }
    } dialog;
    CListBox list;
    dialog.prepare = [&] { ASSERT_TRUE(list.Create(shown | WS_BORDER, CRect(10, 10, 110, 110), &dialog, controlId)); };
    dialog.script = [&] {
        click(&list, {20, 20}, {}, Qt::RightButton);
        EXPECT_EQ(dialog.asked, (std::vector<HWND>{list.m_hWnd}));
    };
    dialog.DoModal();
}

TEST(ScrollBarControl, TellsItsParentWhichMovesIt) {
    class ScrollDialog : public ScriptedDialog {
    public:
        ScrollDialog() : ScriptedDialog(IDD_EMPTY) {}
        std::vector<UINT> codes;
        CScrollBar bar;

    protected:
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
            if (message == WM_HSCROLL && reinterpret_cast<HWND>(lParam) == bar.m_hWnd) {
                codes.push_back(LOWORD(wParam));
            }
            return ScriptedDialog::WindowProc(message, wParam, lParam);
        }
    } dialog;
    dialog.prepare = [&] {
        ASSERT_TRUE(dialog.bar.Create(shown | SBS_HORZ, CRect(10, 10, 150, 26), &dialog, controlId));
        dialog.bar.SetScrollRange(0, 10);
        dialog.bar.SetScrollPos(3);
    };
    dialog.script = [&] {
        dialog.bar.SetFocus();
        key(Qt::Key_Right);
        EXPECT_EQ(dialog.codes, (std::vector<UINT>{SB_LINERIGHT}));
        EXPECT_EQ(dialog.bar.GetScrollPos(), 3); // moved by the parent alone
        EXPECT_EQ(dialog.bar.SetScrollPos(20), 3);
        EXPECT_EQ(dialog.bar.GetScrollPos(), 10);
    };
    dialog.DoModal();
}

} // namespace
