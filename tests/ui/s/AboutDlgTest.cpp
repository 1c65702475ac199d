// The About box, and the texts that it shares with the splash window.
#include "s/AboutDlg.h"

#include "res/resource.h"
#include "s/ProductTexts.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/ui/s/WindowTestApp.h"
#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <QClipboard>

#include <functional>
#include <string>

namespace {

class About : public Gui_AboutDlg {
public:
    explicit About(std::function<void(About&)> script) : Gui_AboutDlg(nullptr), m_script(std::move(script)) {}
    std::string text(int id) const {
        return textOf(GetDlgItem(id));
    }

protected:
    BOOL OnInitDialog() override {
        PostMessage(WM_APP);
        return Gui_AboutDlg::OnInitDialog();
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return Gui_AboutDlg::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        m_script(*this);
        return 0;
    }

private:
    std::function<void(About&)> m_script;
};

} // namespace

TEST(AboutDlg, TellsTheProductAndCopiesItAsText) {
    const SavedEnvironment environment;
    unsetenv("TARVEX");
    unsetenv("MYTARVEX");
    windowTestApp.version = "1.2";
    About about([](About& box) {
        EXPECT_EQ(textOf(&box), "About windowtests");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_APP_NAME), "windowtests");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_RELEASE), "Release Version: UNKNOWN");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_APP_VERSION), "Application Version: 1.2");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_COPYRIGHT1), "Copyright (c) 2026 Tarvex.");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_COPYRIGHT2), "All rights reserved.");
        EXPECT_EQ(box.text(GUI_IDC_ABOUT_EMPTY), "");
        EXPECT_NE(static_cast<CStatic*>(box.GetDlgItem(GUI_IDC_ABOUT_ICON))->GetIcon(), nullptr);
        key(Qt::Key_C, Qt::ControlModifier);
        key(Qt::Key_Enter);
    });
    EXPECT_EQ(about.DoModal(), IDOK);
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(),
              "windowtests\nRelease Version: UNKNOWN\nApplication Version: 1.2\nCopyright (c) 2026 Tarvex.\n"
              "All rights reserved.\n");
}

TEST(AboutDlg, SplitsTheNoticeBeforeItsFirstAll) {
    const struct {
        const char* notice;
        const char* first;
        const char* second;
    } rows[] = {{"(c) Maker. All rights reserved. All.", "(c) Maker.", "All rights reserved. All."},
                {" (c) Maker \nAll rights ", "(c) Maker", "All rights"},
                {"(c) Maker, all rights reserved", "(c) Maker, all rights reserved", ""},
                {"All rights reserved", "All rights reserved", ""},
                {"xAll rights", "xAll rights", ""},
                {"c All rights", "c", "All rights"},
                {"", "", ""}};
    for (const auto& row : rows) {
        CString first;
        CString second;
        SplitCopyright(row.notice, first, second);
        EXPECT_STREQ(first, row.first) << row.notice;
        EXPECT_STREQ(second, row.second) << row.notice;
    }
}
