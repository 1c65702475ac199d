#include "afxwin.h"
#include "tests/ui/afx/TestApplication.h"

#include <QApplication>

#include <gtest/gtest.h>

#include <optional>
#include <utility>

namespace {

TEST(App, HelpCommandsEndAtTheApplicationsHelp) {
    const std::pair<void (CWinApp::*)(), UINT> commands[] = {{&CWinApp::OnHelpIndex, HELP_INDEX},
                                                             {&CWinApp::OnHelpFinder, HELP_FINDER},
                                                             {&CWinApp::OnHelpUsing, HELP_HELPONHELP}};
    for (const auto& [command, expected] : commands) {
        testApplication.help.clear();
        (testApplication.*command)();
        EXPECT_EQ(testApplication.help, (std::vector<std::pair<DWORD_PTR, UINT>>{{0, expected}}));
    }
}

std::optional<Qt::CursorShape> shownCursor() {
    const QCursor* cursor = QApplication::overrideCursor();
    return cursor ? std::optional(cursor->shape()) : std::nullopt;
}

TEST(App, WaitCursorsAreShownUntilTheLastOneEnds) {
    testApplication.RestoreWaitCursor();
    EXPECT_EQ(shownCursor(), std::nullopt) << "nobody waits";
    testApplication.BeginWaitCursor();
    {
        CWaitCursor inner;
        QApplication::changeOverrideCursor(Qt::ArrowCursor);
        inner.Restore();
        EXPECT_EQ(shownCursor(), Qt::WaitCursor);
    }
    EXPECT_EQ(shownCursor(), Qt::WaitCursor);
    QApplication::changeOverrideCursor(Qt::ArrowCursor);
    testApplication.RestoreWaitCursor();
    EXPECT_EQ(shownCursor(), Qt::WaitCursor);
    testApplication.EndWaitCursor();
    EXPECT_EQ(shownCursor(), std::nullopt);
    testApplication.EndWaitCursor();
    testApplication.BeginWaitCursor();
    EXPECT_EQ(shownCursor(), Qt::WaitCursor) << "one end too many does not count";
    testApplication.EndWaitCursor();
}

TEST(App, TellsOfItsModule) {
    const AFX_MODULE_STATE* state = AfxGetModuleState();
    EXPECT_EQ(state->m_pCurrentWinApp, &testApplication);
    EXPECT_STREQ(state->m_lpszCurrentAppName, "Afx tests");
    EXPECT_EQ(state->m_hCurrentInstanceHandle, AfxGetInstanceHandle());
    const auto other = reinterpret_cast<HINSTANCE>(&state);
    AfxSetResourceHandle(other);
    EXPECT_EQ(AfxGetModuleState()->m_hCurrentResourceHandle, other);
    AfxSetResourceHandle(nullptr);
    EXPECT_EQ(AfxGetModuleState()->m_hCurrentResourceHandle, AfxGetInstanceHandle());
    const HICON question = testApplication.LoadStandardIcon(IDI_QUESTION);
    EXPECT_NE(question, nullptr);
    EXPECT_EQ(testApplication.LoadStandardIcon(IDI_QUESTION), question);
    EXPECT_NE(testApplication.LoadStandardIcon(IDI_EXCLAMATION), question);
    EXPECT_TRUE(MessageBeep(MB_ICONQUESTION));
}

} // namespace
