#include <gtest/gtest.h>

#include "tests/ui/afx/dialogs/DialogTesting.h"

namespace {

class ExchangeDialog : public ScriptedDialog {
public:
    ExchangeDialog() : ScriptedDialog(IDD_SHAPE) {}
    std::function<void(CDataExchange*)> exchange;
    int changes = 0; ///< Changes of the name that its handler would have been told.

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override {
        changes += id == IDC_NAME && code == EN_CHANGE ? 1 : 0;
        return ScriptedDialog::OnCmdMsg(id, code, extra, info);
    }

protected:
    void DoDataExchange(CDataExchange* dx) override {
        if (exchange) {
            exchange(dx);
        }
    }
};

TEST(DataExchange, MovesValuesBothWays) {
    ExchangeDialog dialog;
    CString name = "Welle";
    double scale = 0.1;
    int kind = 2;
    int visible = 1;
    int color = 1;
    CString font = "Sans";
    dialog.exchange = [&](CDataExchange* dx) {
        DDX_Text(dx, IDC_NAME, name);
        DDX_Text(dx, IDC_SCALE, scale);
        DDX_Radio(dx, IDC_LINE, kind);
        DDX_Check(dx, IDC_VISIBLE, visible);
        DDX_CBIndex(dx, IDC_COLOR, color);
        DDX_CBString(dx, IDC_FONT, font);
    };
    // The first contents come from the resources before OnInitDialog.
    dialog.script = [&] {
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_SCALE)), "0.1");
        EXPECT_EQ(dialog.GetCheckedRadioButton(IDC_LINE, IDC_ARC), IDC_ARC);
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_COLOR)), "Two");
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_FONT)), "Sans");
        dialog.SetDlgItemText(IDC_SCALE, " -2.5e1 ");
        click(dialog.GetDlgItem(IDC_CIRCLE));
        click(dialog.GetDlgItem(IDC_VISIBLE));
        dialog.GetDlgItem(IDC_NAME)->SetFocus();
        key(Qt::Key_End);
        type(" 2");
        key(Qt::Key_Return);
    };
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_STREQ(name, "Welle 2");
    EXPECT_EQ(scale, -25.0);
    EXPECT_EQ(kind, 1);
    EXPECT_EQ(visible, 0);
}

TEST(DataExchange, FillsControlsWithoutANotification) {
    ExchangeDialog dialog;
    CString name = "Gear";
    dialog.exchange = [&](CDataExchange* dx) { DDX_Text(dx, IDC_NAME, name); };
    dialog.script = [&] {
        name = "Shaft";
        EXPECT_TRUE(dialog.UpdateData(FALSE));
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_NAME)), "Shaft");
        EXPECT_EQ(dialog.changes, 0);
        dialog.SetDlgItemText(IDC_NAME, "Wheel");
        EXPECT_EQ(dialog.changes, 1);
    };
    dialog.DoModal();
}

TEST(DataExchange, RefusesWhatIsNoNumber) {
    ExchangeDialog dialog;
    int scale = 5;
    dialog.exchange = [&](CDataExchange* dx) { DDX_Text(dx, IDC_SCALE, scale); };
    dialog.script = [&] {
        for (const char* text : {"", "twelve", "12x", "2147483648", "1.5"}) {
            dialog.SetDlgItemText(IDC_SCALE, text);
            dialog.GetDlgItem(IDC_NAME)->SetFocus();
            BoxAnswer box;
            EXPECT_FALSE(dialog.UpdateData(TRUE)) << text;
            EXPECT_NE(box.text, "") << text;
            EXPECT_TRUE(waitForActive(dialog));
            EXPECT_EQ(dialog.focus(), IDC_SCALE);
        }
        EXPECT_EQ(scale, 5);
        dialog.SetDlgItemText(IDC_SCALE, "-2147483648");
        EXPECT_TRUE(dialog.UpdateData(TRUE));
        EXPECT_EQ(scale, INT_MIN);
    };
    dialog.DoModal();
}

TEST(DataExchange, KeepsTheDialogOpenUntilValuesAreInRange) {
    ExchangeDialog dialog;
    int scale = 100;
    dialog.exchange = [&](CDataExchange* dx) {
        DDX_Text(dx, IDC_SCALE, scale);
        DDV_MinMaxInt(dx, scale, 1, 400);
    };
    dialog.script = [&] {
        dialog.SetDlgItemText(IDC_SCALE, "401");
        BoxAnswer box;
        click(dialog.GetDlgItem(IDOK));
        EXPECT_TRUE(dialog.IsWindowVisible());
        EXPECT_NE(box.text.find("400"), std::string::npos) << box.text;
        dialog.SetDlgItemText(IDC_SCALE, "400");
        click(dialog.GetDlgItem(IDOK));
    };
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(scale, 400);
}

TEST(DataExchange, ChecksEveryKindOfNumberAgainstItsRange) {
    // Each takes the last value of its range, or the next one behind.
    const struct {
        void (*check)(CDataExchange* dx, bool inside);
        const char* limit;
    } cases[] = {
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxByte(dx, inside ? 250 : 251, 10, 250); }, "250"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxShort(dx, inside ? -7 : -8, -7, 7); }, "-7"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxLong(dx, inside ? -70000 : -70001, -70000, 0); }, "-70000"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxUInt(dx, 4000000000U - inside, 0, 3999999999U); },
         "3999999999"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxDWord(dx, 4000000001U - inside, 1, 4000000000U); },
         "4000000000"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxFloat(dx, inside ? 0.5F : 0.4999F, 0.5F, 1.0F); }, "0.5"},
        {[](CDataExchange* dx, bool inside) { DDV_MinMaxDouble(dx, inside ? 2.25 : 2.2500001, -1, 2.25); }, "2.25"},
    };
    ExchangeDialog dialog;
    dialog.script = [&] {
        for (const auto& each : cases) {
            bool inside = true;
            dialog.exchange = [&](CDataExchange* dx) {
                dx->PrepareEditCtrl(IDC_SCALE);
                each.check(dx, inside);
            };
            EXPECT_TRUE(dialog.UpdateData(TRUE)) << each.limit;
            inside = false;
            EXPECT_TRUE(dialog.UpdateData(FALSE)) << "shown as it is";
            BoxAnswer box;
            EXPECT_FALSE(dialog.UpdateData(TRUE)) << each.limit;
            EXPECT_NE(box.text.find(each.limit), std::string::npos) << box.text;
            EXPECT_TRUE(waitForActive(dialog));
        }
    };
    dialog.DoModal();
}

TEST(DataExchange, FindsLinesByWholeTextAndByPlace) {
    ExchangeDialog dialog;
    CScrollBar bar;
    dialog.prepare = [&] {
        ASSERT_TRUE(bar.Create(WS_CHILD | SBS_HORZ, CRect(0, 0, 50, 10), &dialog, 5000));
        bar.SetScrollRange(0, 50);
        for (const char* line : {"Dimensions", "Dim", "Border"}) {
            dialog.SendDlgItemMessage(IDC_LAYERS, LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(line)); // sorted
            dialog.SendDlgItemMessage(IDC_FONT, CB_ADDSTRING, 0, reinterpret_cast<LPARAM>(line));
        }
    };
    dialog.script = [&] {
        CString line = "Dim";
        int index = 2;
        CString font = "Dim";
        int position = 20;
        dialog.exchange = [&](CDataExchange* dx) {
            DDX_LBStringExact(dx, IDC_LAYERS, line);
            DDX_CBStringExact(dx, IDC_FONT, font);
            DDX_Scroll(dx, 5000, position);
        };
        const auto chosen = [&](int id, UINT message) { return dialog.SendDlgItemMessage(id, message); };
        EXPECT_TRUE(dialog.UpdateData(FALSE));
        EXPECT_EQ(chosen(IDC_LAYERS, LB_GETCURSEL), 1);
        EXPECT_EQ(chosen(IDC_FONT, CB_GETCURSEL), 1);
        EXPECT_EQ(bar.GetScrollPos(), 20);
        line = font = "Di"; // no line is only that, but the field takes any text
        EXPECT_TRUE(dialog.UpdateData(FALSE));
        EXPECT_EQ(chosen(IDC_LAYERS, LB_GETCURSEL), -1);
        EXPECT_EQ(chosen(IDC_FONT, CB_GETCURSEL), -1);
        bar.SetScrollPos(30);
        EXPECT_TRUE(dialog.UpdateData(TRUE));
        EXPECT_STREQ(line, "");
        EXPECT_STREQ(font, "Di");
        EXPECT_EQ(position, 30);
        dialog.exchange = [&](CDataExchange* dx) { DDX_LBIndex(dx, IDC_LAYERS, index); };
        EXPECT_TRUE(dialog.UpdateData(FALSE));
        EXPECT_EQ(chosen(IDC_LAYERS, LB_GETCURSEL), 2);
        dialog.SendDlgItemMessage(IDC_LAYERS, LB_SETCURSEL, 0);
        EXPECT_TRUE(dialog.UpdateData(TRUE));
        EXPECT_EQ(index, 0);
    };
    dialog.DoModal();
}

TEST(DataExchange, LimitsWhatCanBeTyped) {
    ExchangeDialog dialog;
    CString name;
    dialog.exchange = [&](CDataExchange* dx) {
        DDX_Text(dx, IDC_NAME, name);
        DDV_MaxChars(dx, name, 4);
    };
    dialog.script = [&] {
        type("abcdef");
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_NAME)), "abcd");
        EXPECT_EQ(dialog.codes(IDC_NAME, EN_MAXTEXT), 2);
    };
    dialog.DoModal();
}

TEST(DataExchange, BindsMembersToControls) {
    ExchangeDialog dialog;
    CListBox layers;
    dialog.exchange = [&](CDataExchange* dx) { DDX_Control(dx, IDC_LAYERS, layers); };
    dialog.prepare = [&] { layers.AddString("Dimensions"); };
    dialog.script = [&] {
        EXPECT_EQ(dialog.GetDlgItem(IDC_LAYERS), &layers);
        EXPECT_EQ(layers.GetCount(), 1);
    };
    dialog.DoModal();
    EXPECT_EQ(layers.m_hWnd, nullptr); // ended with the dialog
}

TEST(DialogItems, HoldNumbersOf32Bits) {
    ScriptedDialog dialog(IDD_SHAPE);
    dialog.script = [&] {
        dialog.SetDlgItemInt(IDC_SCALE, static_cast<UINT>(-7));
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_SCALE)), "-7");
        BOOL translated = FALSE;
        EXPECT_EQ(static_cast<int>(dialog.GetDlgItemInt(IDC_SCALE, &translated)), -7);
        EXPECT_TRUE(translated);
        dialog.GetDlgItemInt(IDC_SCALE, &translated, FALSE);
        EXPECT_FALSE(translated);
        dialog.SetDlgItemText(IDC_SCALE, "4294967295");
        EXPECT_EQ(dialog.GetDlgItemInt(IDC_SCALE, &translated, FALSE), 4294967295U);
        dialog.GetDlgItemInt(IDC_SCALE, &translated);
        EXPECT_FALSE(translated);
    };
    dialog.DoModal();
}

} // namespace
