// Query dialogs as a user meets them: asked, answered, cancelled, with help.
#include "s/QueryDlg.h"

#include "afxwin.h"
#include "res/resource.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>

namespace {

/// A query that a test works in once it is shown.
class Query : public Gui_QueryDlg {
public:
    std::function<void()> script;

    CRect rectOf(int id) const {
        CRect rect;
        GetDlgItem(id)->GetWindowRect(&rect);
        ScreenToClient(&rect);
        return rect;
    }
    bool isShown(int id) const {
        return GetDlgItem(id)->IsWindowVisible() != 0;
    }
    std::string answer() const {
        return GetAnswer().GetString();
    }
    CSize size() const {
        CRect rect;
        GetWindowRect(&rect);
        return rect.Size();
    }

protected:
    BOOL OnInitDialog() override {
        const BOOL result = Gui_QueryDlg::OnInitDialog();
        PostMessage(WM_APP);
        return result;
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return Gui_QueryDlg::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        script();
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(99);
        }
        return 0;
    }
};

/// The size that a query with this prompt gets; its contents are checked on the way.
CSize sizeWithPrompt(const char* prompt, int fieldWidth) {
    Query query;
    CSize size;
    query.SetPrompt(prompt);
    query.SetAnswerFieldWidth(fieldWidth);
    query.script = [&] {
        size = query.size();
        const CRect field = query.rectOf(GUI_IDC_QUERY_ANSWER);
        EXPECT_GT(field.left, query.rectOf(GUI_IDC_QUERY_PROMPT).right);
        EXPECT_GT(field.Width(), 50);
        EXPECT_LT(field.right, size.cx);
        EXPECT_GT(query.rectOf(IDOK).top, field.bottom);
        EXPECT_LT(query.rectOf(IDCANCEL).right, size.cx);
        EXPECT_LT(query.rectOf(IDCANCEL).bottom, size.cy);
        EXPECT_LE(size.cx, GetSystemMetrics(SM_CXSCREEN));
    };
    query.DoModal();
    return size;
}

} // namespace

TEST(QueryDlg, TakesTheAnswerWithOkAndLeavesItWithCancel) {
    Query query;
    query.SetTitle("Run Command");
    query.SetPrompt("Befehl für alle && jeden:");
    query.SetAnswer("grün");
    query.script = [&] {
        EXPECT_EQ(textOf(&query), "Run Command");
        EXPECT_EQ(textOf(query.GetDlgItem(GUI_IDC_QUERY_PROMPT)), "Befehl für alle && jeden:");
        EXPECT_EQ(textOf(query.GetDlgItem(GUI_IDC_QUERY_ANSWER)), "grün");
        type("größer"); // over the selected text
        key(Qt::Key_Enter);
    };
    EXPECT_EQ(query.DoModal(), IDOK);
    EXPECT_EQ(query.answer(), "größer");
    query.script = [&] {
        type("nothing");
        key(Qt::Key_Escape);
    };
    EXPECT_EQ(query.DoModal(), IDCANCEL);
    EXPECT_EQ(query.answer(), "größer");
}

TEST(QueryDlg, HasTheApplicationsNameAsTitleFromTheStart) {
    Query query;
    query.SetPrompt(nullptr);
    query.script = [&] { EXPECT_EQ(textOf(&query), AfxGetAppName() ? AfxGetAppName() : ""); };
    query.DoModal();
}

TEST(QueryDlg, GrowsWithPromptAndFieldUpToTheScreen) {
    const CSize empty = sizeWithPrompt("", 20);
    const CSize usual = sizeWithPrompt("Name of the part:", 20);
    const CSize unchanged = sizeWithPrompt("Name of the part:", -1);
    EXPECT_GT(usual.cx, empty.cx);
    EXPECT_EQ(usual.cy, empty.cy);
    EXPECT_EQ(usual, unchanged);
    EXPECT_GT(sizeWithPrompt("Name of the part:", 60).cx, usual.cx);
    const std::string sentence(60, 'm');
    EXPECT_GT(sizeWithPrompt((sentence + ' ' + sentence + ' ' + sentence).c_str(), 20).cy, usual.cy);
    EXPECT_GT(sizeWithPrompt("Two\nlines\nor three:", 20).cy, usual.cy);
    sizeWithPrompt("Wide", 1000000000);
}

TEST(QueryDlg, ShowsTheHelpButtonForAHelpNumberOnly) {
    Query query;
    query.SetPrompt("Name:");
    query.script = [&] {
        EXPECT_FALSE(query.isShown(GUI_IDC_HELP_BUTTON));
        const int left = query.rectOf(IDOK).left;
        const int width = query.rectOf(IDCANCEL).right;
        EXPECT_NEAR(left, query.size().cx - width, 16); // in the middle
    };
    query.DoModal();
}

TEST(QueryDlg, AsksTheApplicationForHelp) {
    Query query;
    query.SetHelpId(20073);
    query.script = [&] {
        EXPECT_TRUE(query.isShown(GUI_IDC_HELP_BUTTON));
        EXPECT_LT(query.rectOf(GUI_IDC_HELP_BUTTON).right, query.size().cx);
        testApplication.help.clear();
        click(query.GetDlgItem(GUI_IDC_HELP_BUTTON));
    };
    EXPECT_EQ(query.DoModal(), 99); // help ends nothing
    ASSERT_EQ(testApplication.help.size(), 1u);
    EXPECT_EQ(testApplication.help[0], (std::pair<DWORD_PTR, UINT>(20073, HELP_CONTEXT)));
}
