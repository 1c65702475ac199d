#include <gtest/gtest.h>

#include "tests/ui/afx/dialogs/DialogTesting.h"

namespace {

class ExchangeDialog : public ScriptedDialog {
public:
    ExchangeDialog() : ScriptedDialog(IDD_SHAPE) {}
    std::function<void(CDataExchange*)> exchange;

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
