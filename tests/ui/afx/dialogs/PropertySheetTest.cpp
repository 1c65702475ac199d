// Property sheets as a user meets them: tabs, keys, buttons, and what the pages are told.
#include "platform/afx/dialogs/PropertySheet.h"

#include "platform/afx/frames/Frame.h"
#include "platform/win/FrameworkIds.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <QTabBar>

#include <functional>
#include <string>
#include <utility>

namespace {

/// What the pages of a test were told, as in "grid:apply".
std::string told;

std::string takeTold() {
    return std::exchange(told, std::string());
}

class Page : public CPropertyPage {
public:
    Page(const char* name, UINT id, UINT captionId = 0) : CPropertyPage(id, captionId), m_name(name) {}
    bool letsGo = true;
    bool accepts = true;
    bool mayBeShown = true;
    bool mayBeCancelled = true;
    int width = 10;

    BOOL OnSetActive() override {
        note("show");
        return CPropertyPage::OnSetActive() && mayBeShown;
    }
    BOOL OnKillActive() override {
        note("leave");
        return CPropertyPage::OnKillActive() && letsGo;
    }
    BOOL OnApply() override {
        note("apply");
        return CPropertyPage::OnApply() && accepts;
    }
    void OnReset() override {
        note("reset");
        CPropertyPage::OnReset();
    }
    BOOL OnQueryCancel() override {
        note("cancel?");
        return CPropertyPage::OnQueryCancel() && mayBeCancelled;
    }
    void OnOK() override {
        note("ok");
        CPropertyPage::OnOK();
    }
    void OnCancel() override {
        note("cancel");
        CPropertyPage::OnCancel();
    }

protected:
    BOOL OnInitDialog() override {
        note("made");
        return CPropertyPage::OnInitDialog();
    }
    void DoDataExchange(CDataExchange* dx) override {
        CPropertyPage::DoDataExchange(dx);
        if (GetDlgItem(IDC_WIDTH)) {
            DDX_Text(dx, IDC_WIDTH, width);
        }
    }
    afx_msg void OnChange() {
        SetModified();
    }
    afx_msg LRESULT OnSibling(WPARAM wParam, LPARAM lParam) {
        note("asked");
        return wParam == 7 && m_name == "colours" ? lParam : 0;
    }
    afx_msg void OnDestroy() {
        note("gone");
        CPropertyPage::OnDestroy();
    }
    DECLARE_MESSAGE_MAP()

private:
    void note(const char* what) {
        told += (told.empty() ? "" : " ") + m_name + ":" + what;
    }
    std::string m_name;
};

BEGIN_MESSAGE_MAP(Page, CPropertyPage)
ON_EN_CHANGE(IDC_WIDTH, &Page::OnChange)
ON_BN_CLICKED(IDC_DARK, &Page::OnChange)
ON_MESSAGE(PSM_QUERYSIBLINGS, &Page::OnSibling)
ON_WM_DESTROY()
END_MESSAGE_MAP()

/// A sheet with two pages, in which a test works once it is shown.
class Sheet : public CPropertySheet {
public:
    explicit Sheet(UINT firstPage = 0) : CPropertySheet("Settings", nullptr, firstPage) {
        AddPage(&grid);
        AddPage(&colors);
        told.clear();
    }
    Page grid{"grid", IDD_GRID_PAGE};
    Page colors{"colours", IDD_COLOR_PAGE};
    std::function<void()> script;
    static constexpr int scriptDone = 99;

    bool isEnabled(int id) const {
        return GetDlgItem(id)->IsWindowEnabled() != 0;
    }
    /// Clicks a tab.
    void choose(int index) {
        QTabBar* bar = tvx::afx::peerOf(m_hWnd)->findChild<QTabBar*>();
        QTest::mouseClick(bar, Qt::LeftButton, Qt::NoModifier, bar->tabRect(index).center());
    }
    int focus() const {
        const CWnd* control = GetFocus();
        return control ? control->GetDlgCtrlID() : 0;
    }

protected:
    BOOL OnInitDialog() override {
        PostMessage(WM_APP);
        return CPropertySheet::OnInitDialog();
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return CPropertySheet::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        script();
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(scriptDone);
        }
        return 0;
    }
};

} // namespace

TEST(PropertySheet, TellsItsPagesInOrderAndAgainTheSecondTime) {
    Sheet sheet;
    for (int round = 0; round < 2; ++round) {
        sheet.script = [&] {
            EXPECT_EQ(takeTold(), "grid:made grid:show");
            EXPECT_EQ(sheet.colors.m_hWnd, nullptr) << "made when it is first seen";
            sheet.choose(1);
            EXPECT_EQ(takeTold(), "grid:leave colours:made colours:show");
            EXPECT_TRUE(sheet.colors.IsWindowVisible());
            EXPECT_FALSE(sheet.grid.IsWindowVisible());
            EXPECT_EQ(sheet.GetActivePage(), &sheet.colors);
            sheet.choose(0);
            EXPECT_EQ(takeTold(), "colours:leave grid:show");
            click(sheet.GetDlgItem(IDOK));
            EXPECT_EQ(takeTold(), "grid:leave grid:apply grid:ok colours:apply colours:ok");
        };
        EXPECT_EQ(sheet.DoModal(), IDOK);
        EXPECT_EQ(takeTold(), "colours:gone grid:gone");
        EXPECT_EQ(sheet.grid.m_hWnd, nullptr);
    }
}

TEST(PropertySheet, CancelAsksThePageAndResetsThoseThatWereMade) {
    Sheet sheet(1);
    sheet.script = [&] {
        EXPECT_EQ(sheet.GetActiveIndex(), 1);
        sheet.colors.mayBeCancelled = false;
        takeTold();
        key(Qt::Key_Escape);
        EXPECT_EQ(takeTold(), "colours:cancel?");
        EXPECT_TRUE(sheet.IsWindowVisible());
        sheet.colors.mayBeCancelled = true;
        sheet.SendMessage(WM_CLOSE);
        EXPECT_EQ(takeTold(), "colours:cancel? colours:reset colours:cancel");
    };
    EXPECT_EQ(sheet.DoModal(), IDCANCEL);
}

TEST(PropertySheet, StaysWhereAPageRefuses) {
    Sheet sheet;
    sheet.script = [&] {
        sheet.grid.letsGo = false;
        takeTold();
        sheet.choose(1);
        EXPECT_EQ(takeTold(), "grid:leave");
        EXPECT_EQ(sheet.GetActiveIndex(), 0);
        EXPECT_EQ(tvx::afx::peerOf(sheet.m_hWnd)->findChild<QTabBar*>()->currentIndex(), 0);
        EXPECT_FALSE(sheet.SetActivePage(&sheet.colors));
        EXPECT_TRUE(sheet.PressButton(PSBTN_OK));
        EXPECT_TRUE(sheet.IsWindowVisible());
        sheet.grid.letsGo = true;
        sheet.grid.accepts = false;
        EXPECT_TRUE(sheet.SetActivePage(1));
        takeTold();
        click(sheet.GetDlgItem(IDOK));
        EXPECT_EQ(takeTold(), "colours:leave grid:apply grid:ok") << "those behind are not asked";
        EXPECT_TRUE(sheet.IsWindowVisible());
        EXPECT_EQ(sheet.GetActiveIndex(), 1);
        sheet.grid.mayBeShown = false;
        EXPECT_FALSE(sheet.SetActivePage(0));
        EXPECT_EQ(sheet.GetActiveIndex(), 1);
        EXPECT_TRUE(sheet.colors.IsWindowVisible());
    };
    EXPECT_EQ(sheet.DoModal(), Sheet::scriptDone);
}

TEST(PropertySheet, AppliesWhatWasChanged) {
    Sheet sheet;
    sheet.script = [&] {
        EXPECT_FALSE(sheet.isEnabled(ID_APPLY_NOW));
        EXPECT_FALSE(sheet.PressButton(PSBTN_APPLYNOW));
        EXPECT_EQ(sheet.focus(), IDC_WIDTH) << "the keyboard is in the page";
        type("25");
        EXPECT_TRUE(sheet.isEnabled(ID_APPLY_NOW));
        takeTold();
        key(Qt::Key_A, Qt::AltModifier);
        EXPECT_EQ(takeTold(), "grid:leave grid:apply grid:ok grid:show");
        EXPECT_EQ(sheet.grid.width, 25);
        EXPECT_FALSE(sheet.isEnabled(ID_APPLY_NOW));
        sheet.choose(1);
        click(sheet.colors.GetDlgItem(IDC_DARK));
        EXPECT_TRUE(sheet.isEnabled(ID_APPLY_NOW));
        sheet.grid.SetModified();
        sheet.colors.SetModified(FALSE);
        EXPECT_TRUE(sheet.isEnabled(ID_APPLY_NOW)) << "the other page is";
        sheet.grid.CancelToClose();
        EXPECT_EQ(textOf(sheet.GetDlgItem(IDOK)), "Close");
        EXPECT_FALSE(sheet.isEnabled(IDCANCEL));
        key(Qt::Key_Escape);
    };
    EXPECT_EQ(sheet.DoModal(), IDCANCEL);
}

TEST(PropertySheet, KeepsAWrongValueFromBeingLeft) {
    Sheet sheet;
    sheet.script = [&] {
        type("wide");
        BoxAnswer answer;
        key(Qt::Key_PageDown, Qt::ControlModifier);
        EXPECT_EQ(answer.text, "Please enter an integer.");
        EXPECT_EQ(sheet.GetActiveIndex(), 0);
        EXPECT_TRUE(waitForActive(sheet));
        EXPECT_EQ(sheet.focus(), IDC_WIDTH);
    };
    sheet.DoModal();
}

TEST(PropertySheet, IsWorkedByTheKeyboard) {
    Sheet sheet;
    sheet.script = [&] {
        const auto active = [&] { return sheet.GetActiveIndex(); };
        key(Qt::Key_Tab, Qt::ControlModifier);
        EXPECT_EQ(active(), 1);
        EXPECT_EQ(sheet.focus(), IDC_DARK) << "the keyboard goes with the page";
        key(Qt::Key_Tab, Qt::ControlModifier);
        EXPECT_EQ(active(), 0) << "round and round";
        key(Qt::Key_Backtab, Qt::ControlModifier | Qt::ShiftModifier);
        EXPECT_EQ(active(), 1);
        key(Qt::Key_PageUp, Qt::ControlModifier);
        EXPECT_EQ(active(), 0);
        key(Qt::Key_C, Qt::AltModifier);
        EXPECT_EQ(active(), 1) << "the mnemonic of a tab";
        std::string stops;
        for (int i = 0; i < 4; ++i) {
            key(Qt::Key_Tab);
            stops += std::to_string(sheet.focus()) + " ";
        }
        EXPECT_EQ(stops, "1 2 12320 1071 ") << "OK, Cancel, tabs, page";
        key(Qt::Key_Backtab, Qt::ShiftModifier);
        key(Qt::Key_Left);
        EXPECT_EQ(active(), 0);
        EXPECT_EQ(sheet.focus(), AFX_IDC_TAB_CONTROL);
        key(Qt::Key_Enter);
    };
    EXPECT_EQ(sheet.DoModal(), IDOK);
}

TEST(PropertySheet, HasTheButtonsThatItsFlagsName) {
    Sheet sheet;
    EXPECT_EQ(sheet.m_psh.dwFlags & PSH_HASHELP, 0u) << "this application has no help command";
    sheet.m_psh.dwFlags |= PSH_NOAPPLYNOW;
    sheet.script = [&] {
        EXPECT_EQ(sheet.GetDlgItem(ID_APPLY_NOW), nullptr);
        EXPECT_EQ(sheet.GetDlgItem(IDHELP), nullptr);
        sheet.grid.SetModified();
    };
    sheet.DoModal();
    sheet.m_psh.dwFlags = PSH_HASHELP;
    sheet.grid.m_psp.dwFlags |= PSP_HASHELP;
    sheet.script = [&] {
        testApplication.help.clear();
        click(sheet.GetDlgItem(IDHELP));
        key(Qt::Key_F1);
        sheet.GetDlgItem(IDOK)->SetFocus();
        key(Qt::Key_F1);
        const std::pair<DWORD_PTR, UINT> page(HID_BASE_RESOURCE + IDD_GRID_PAGE, HELP_CONTEXT);
        EXPECT_EQ(testApplication.help, std::vector(3, page)) << "wherever the keyboard is";
        sheet.choose(1);
        EXPECT_FALSE(sheet.isEnabled(IDHELP));
        EXPECT_FALSE(sheet.PressButton(PSBTN_HELP));
    };
    sheet.DoModal();
}

TEST(PropertySheet, IsAsLargeAsItsLargestPage) {
    Sheet sheet;
    sheet.script = [&] {
        const auto inside = [&](const CWnd* window) {
            CRect rect;
            window->GetWindowRect(&rect);
            sheet.ScreenToClient(&rect);
            return rect;
        };
        const CRect page = inside(&sheet.grid);
        CRect least(0, 0, 160, 90); // the width of one, the height of the other
        sheet.grid.MapDialogRect(&least);
        EXPECT_GE(page.Width(), least.Width());
        EXPECT_GE(page.Height(), least.Height());
        CRect client;
        sheet.GetClientRect(&client);
        for (const int id : {AFX_IDC_TAB_CONTROL, IDOK, IDCANCEL, ID_APPLY_NOW}) {
            const CRect rect = inside(sheet.GetDlgItem(id));
            EXPECT_TRUE(client.PtInRect(rect.TopLeft()) && client.PtInRect(rect.BottomRight())) << id;
        }
        EXPECT_GT(inside(sheet.GetDlgItem(IDOK)).top, page.bottom);
    };
    sheet.DoModal();
}

TEST(PropertySheet, ChangesItsPagesWhileItIsOpen) {
    Sheet sheet;
    Page other("other", IDD_GRID_PAGE, IDS_OTHER_TITLE);
    sheet.script = [&] {
        const QTabBar* bar = tvx::afx::peerOf(sheet.m_hWnd)->findChild<QTabBar*>();
        sheet.AddPage(&other);
        EXPECT_EQ(bar->tabText(2), "Other");
        EXPECT_TRUE(sheet.SetActivePage(&other));
        EXPECT_EQ(other.QuerySiblings(7, 42), 0) << "the page that would answer has no window yet";
        sheet.SetActivePage(1);
        takeTold();
        EXPECT_EQ(other.QuerySiblings(7, 42), 42);
        EXPECT_EQ(takeTold(), "grid:asked colours:asked");
        sheet.RemovePage(&sheet.colors);
        EXPECT_EQ(sheet.colors.m_hWnd, nullptr);
        EXPECT_EQ(sheet.GetPageCount(), 2);
        EXPECT_EQ(sheet.GetActivePage(), &other) << "what stood behind it";
        sheet.RemovePage(1);
        EXPECT_EQ(sheet.GetActivePage(), &sheet.grid);
        EXPECT_EQ(sheet.GetPageIndex(&other), -1);
        EXPECT_EQ(sheet.GetPage(1), nullptr);
        sheet.SetTitle("Other settings");
        EXPECT_EQ(textOf(&sheet), "Other settings");
    };
    sheet.DoModal();
}

TEST(PropertySheet, LivesBesideItsOwnerWithoutAWait) {
    Sheet sheet;
    sheet.script = [] {};
    CFrameWnd* owner = nullptr;
    ASSERT_TRUE(sheet.Create(owner));
    EXPECT_EQ(sheet.GetDlgItem(IDOK), nullptr);
    EXPECT_TRUE(sheet.IsWindowVisible());
    takeTold();
    sheet.SendMessage(WM_CLOSE);
    EXPECT_EQ(takeTold(), "grid:cancel? grid:reset grid:cancel grid:gone");
    EXPECT_EQ(sheet.m_hWnd, nullptr);
}

TEST(PropertySheet, TellsRolesAndNamesToAssistiveTools) {
    Sheet sheet;
    sheet.script = [&] {
        const QAccessibleInterface* window = QAccessible::queryAccessibleInterface(tvx::afx::peerOf(sheet.m_hWnd));
        EXPECT_EQ(accessibleTree(*window), R"(Dialog "Settings"
 Client ""
  PageTabList "Grid"
   PageTab "Grid"
   PageTab "Colours"
 PropertyPage "Grid"
  StaticText "Width:"
  EditableText "Width:" < Width:
 Button "OK"
 Button "Cancel"
 Button "Apply"
)");
    };
    sheet.DoModal();
}
