// The choice of a web browser: the page, its dialog, and what becomes of a command line.
#include "s/BrowserPreference.h"

#include "platform/base/SystemPath.h"
#include "res/resource.h"
#include "s/CommandText.h"
#include "s/Process.h"
#include "s/Profile.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/ui/afx/frames/SettingsFolder.h"
#include "tests/ui/s/WindowTestApp.h"
#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <QFileDialog>
#include <QLineEdit>

#include <filesystem>
#include <fstream>
#include <functional>
#include <string>

namespace {

/// The text that is stored as the user's browser.
std::string stored() {
    HKEY key = nullptr;
    char text[200] = {};
    DWORD size = sizeof text;
    const bool found = RegOpenKeyExA(HKEY_CURRENT_USER, "Software\\Tarvex\\Common", 0, KEY_READ, &key) == 0 &&
                       RegQueryValueExA(key, "Browser", nullptr, nullptr, reinterpret_cast<BYTE*>(text), &size) == 0;
    RegCloseKey(key);
    return found ? text : "<nothing>";
}

/// Works in the dialog once it is shown.
int work(CPropertySheet& sheet, const std::function<void()>& script) {
    QTimer::singleShot(0, [&] {
        EXPECT_TRUE(waitForActive(sheet));
        script();
    });
    return sheet.DoModal();
}

class BrowserPreference : public testing::Test {
protected:
    SavedEnvironment m_environment;
    SettingsFolder m_settings;
};

} // namespace

TEST_F(BrowserPreference, StoresWhatWasChanged) {
    Gui_Profile::WriteWebBrowserName("browser -new %1");
    Gui_BrowserPreference preference;
    CPropertySheet& sheet = preference.GetModalPreferenceDialog();
    CPropertyPage& page = preference.GetPropertyPage();
    EXPECT_EQ(&preference.GetModalPreferenceDialog(), &sheet);
    EXPECT_EQ(&preference.GetPropertyPage(), &page);
    EXPECT_EQ(sheet.GetPageCount(), 1);
    EXPECT_EQ(sheet.GetPage(0), &page);
    EXPECT_EQ(work(sheet,
                   [&] {
                       EXPECT_EQ(textOf(&sheet), "Web Browser");
                       EXPECT_EQ(sheet.GetDlgItem(ID_APPLY_NOW), nullptr);
                       EXPECT_EQ(sheet.GetDlgItem(IDHELP), nullptr);
                       EXPECT_EQ(textOf(page.GetDlgItem(GUI_IDC_BROWSER_COMMAND)), "browser -new %1");
                       type("other %1");
                       key(Qt::Key_Escape);
                   }),
              IDCANCEL);
    EXPECT_EQ(stored(), "browser -new %1");
    EXPECT_EQ(work(sheet,
                   [&] {
                       page.SetDlgItemText(GUI_IDC_BROWSER_COMMAND, "Browser -new %1");
                       key(Qt::Key_Enter);
                   }),
              IDOK);
    EXPECT_EQ(stored(), "Browser -new %1") << "the letters' case counts";
}

TEST_F(BrowserPreference, StoresNoDefaultThatWasOnlyShown) {
    Gui_BrowserPreference preference;
    CPropertySheet& sheet = preference.GetModalPreferenceDialog();
    CPropertyPage& page = preference.GetPropertyPage();
    CString browser;
    Gui_Profile::GetDefaultWebBrowserName(browser);
    const auto showDefault = [&] {
        page.SetDlgItemText(GUI_IDC_BROWSER_COMMAND, "something else");
        click(page.GetDlgItem(GUI_IDC_BROWSER_SHOW_DEFAULT));
        EXPECT_EQ(textOf(page.GetDlgItem(GUI_IDC_BROWSER_COMMAND)), browser.GetString());
        key(Qt::Key_Enter); // the button that was clicked has the keyboard
        click(sheet.GetDlgItem(IDOK));
    };
    EXPECT_EQ(work(sheet, showDefault), IDOK);
    EXPECT_EQ(stored(), "<nothing>");
}

TEST_F(BrowserPreference, PutsAPickedProgramBeforeTheArguments) {
    const auto folder = std::filesystem::temp_directory_path() / "my browsers";
    std::filesystem::create_directories(folder);
    std::ofstream(folder / "other") << "x";
    Gui_Profile::WriteWebBrowserName("browser -new %1");
    Gui_BrowserPreference preference;
    CPropertySheet& sheet = preference.GetModalPreferenceDialog();
    CPropertyPage& page = preference.GetPropertyPage();
    const auto pick = [&](const std::string& name) {
        QTimer::singleShot(0, [name] {
            auto* dialog = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
            ASSERT_NE(dialog, nullptr);
            auto* edit = dialog->findChild<QLineEdit*>("fileNameEdit");
            edit->setText(QString::fromStdString(name));
            QTest::keyClick(edit, name.empty() ? Qt::Key_Escape : Qt::Key_Return);
        });
        click(page.GetDlgItem(GUI_IDC_BROWSER_BROWSE));
        return textOf(page.GetDlgItem(GUI_IDC_BROWSER_COMMAND));
    };
    work(sheet, [&] {
        const std::string other = (folder / "other").string();
        EXPECT_EQ(pick(""), "browser -new %1");
        EXPECT_EQ(pick(other), "\"" + tvx::driveName(other) + "\" -new %1");
        click(sheet.GetDlgItem(IDOK));
    });
    EXPECT_NE(stored().find("other\" -new %1"), std::string::npos);
    std::filesystem::remove_all(folder);
}

TEST_F(BrowserPreference, IsAskedForFirstWhereTheEnvironmentWantsThat) {
    const auto folder = std::filesystem::temp_directory_path() / "browsers";
    std::filesystem::create_directories(folder);
    const auto record = folder / "record";
    std::ofstream(folder / "browser") << "#!/bin/sh\necho \"$1\" >'" << record.string() << "'\n";
    std::filesystem::permissions(folder / "browser", std::filesystem::perms::owner_all);
    const std::string browser = (folder / "browser").string() + " opened:%1";
    const auto browse = [&](Qt::Key answer) {
        std::string shown;
        QTimer::singleShot(0, [&] {
            QWidget* const sheet = QApplication::activeModalWidget();
            ASSERT_NE(sheet, nullptr);
            auto* const field = sheet->findChild<QLineEdit*>();
            shown = field->text().toStdString();
            field->setText(QString::fromStdString(browser));
            QTest::keyClick(field, answer);
        });
        EXPECT_EQ(Gui_Process().RunWebBrowser("http://a", nullptr, 1, 5000), answer == Qt::Key_Enter);
        return shown;
    };
    Gui_Profile::WriteWebBrowserName("none %1");
    setenv("XDG_DATA_DIRS", folder.c_str(), 1); // no desktop that knows one,
    setenv("PATH", folder.c_str(), 1);          // and no generic browser
    setenv("TVX_GUI_HTML_BROWSER_PATH", "", 1);
    BoxAnswer box;
    EXPECT_EQ(browse(Qt::Key_Escape), "none %1");
    EXPECT_NE(box.text.find("none http://a: failed."), std::string::npos) << box.text;
    EXPECT_EQ(browse(Qt::Key_Enter), "none %1") << "what was cancelled is not kept";
    EXPECT_TRUE(QTest::qWaitFor([&] { return std::filesystem::exists(record) && file_size(record) > 0; }));
    std::string line;
    std::getline(std::ifstream(record) >> std::ws, line);
    EXPECT_EQ(line, "opened:http://a");
    std::filesystem::remove_all(folder);
}

TEST(CommandText, KeepsTheArgumentsBehindAnotherProgram) {
    const char* const other = "C:/Other/other.exe";
    const struct {
        const char* command;
        const char* program;
        const char* expected;
    } rows[] = {{"browser.exe -new %1", other, "C:/Other/other.exe -new %1"},
                {" \t browser.exe\t-new", other, "C:/Other/other.exe\t-new"},
                {"browser.exe", other, "C:/Other/other.exe"},
                {"", other, "C:/Other/other.exe"},
                {"\"C:/my browsers/b.exe\" -new %1", other, "C:/Other/other.exe -new %1"},
                {"\"C:/my browsers/b.exe\"", other, "C:/Other/other.exe"},
                {"\"C:/my browsers/b -new %1", other, "C:/Other/other.exe browsers/b -new %1"},
                {"browser.exe \"%1\"", "C:/my other.exe", "\"C:/my other.exe\" \"%1\""}};
    for (const auto& row : rows) {
        EXPECT_STREQ(WithProgram(row.command, row.program), row.expected) << row.command;
    }
}
