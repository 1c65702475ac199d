// What a user sees in a session in German, Japanese or English: this program runs once in each.
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "res/resource.h"
#include "s/WinApp.h"

#include <QAbstractButton>
#include <QApplication>
#include <QElapsedTimer>
#include <QFontMetrics>
#include <QMessageBox>
#include <QTest>
#include <QTimer>

#include <gtest/gtest.h>

#include <map>
#include <string>

namespace {

std::string language() {
    char text[4] = "";
    GetLocaleInfo(LOCALE_USER_DEFAULT, LOCALE_SABBREVLANGNAME, text, sizeof text);
    return text;
}

/// The text of this session's language.
std::string of(std::map<std::string, std::string> texts) {
    EXPECT_TRUE(texts.contains(language())) << language();
    return texts[language()];
}

std::string stringOf(UINT id) {
    CString text;
    text.LoadString(id);
    return text.GetString();
}

std::string textOf(const CWnd& window) {
    CString text;
    window.GetWindowText(text);
    return text.GetString();
}

std::string itemText(const CMenu& menu, UINT item, UINT flags) {
    CString text;
    menu.GetMenuString(item, text, flags);
    return text.GetString();
}

/// A host, whatever it does: the library's texts are found in its process.
class App : public Gui_WinApp {
public:
    App() : Gui_WinApp("translation") {}
    HICON GetAppIcon() override {
        return nullptr;
    }
    CString GetAppVersion() override {
        return "1.0";
    }
};
App theApp;

/// A frame for as long as a test lasts.
class Frame {
public:
    Frame() : m_frame(new CFrameWnd) {
        EXPECT_TRUE(m_frame->Create(nullptr, "frame", WS_OVERLAPPEDWINDOW));
    }
    ~Frame() {
        m_frame->DestroyWindow(); // it deletes its object
    }
    Frame(const Frame&) = delete;
    Frame& operator=(const Frame&) = delete;
    CFrameWnd* operator->() const {
        return m_frame;
    }
    CFrameWnd* get() const {
        return m_frame;
    }

private:
    CFrameWnd* m_frame;
};

/// How much wider and higher than its control a text is, in pixels; at most 0 when it fits.
QSize excess(CWnd& control, const std::string& className, const std::string& text) {
    CRect area;
    control.GetClientRect(&area);
    const QWidget* widget = tvx::afx::peerOf(control.m_hWnd);
    const QFontMetrics metrics(widget->font());
    const QString shown = tvx::afx::toQt(text.c_str()).remove(QLatin1Char('&'));
    const bool isLabel = className == "Static";
    const QRect place(0, 0, area.Width(), 10000);
    const QRect needed = metrics.boundingRect(place, isLabel ? Qt::TextWordWrap : Qt::TextSingleLine, shown);
    return needed.size() - QSize(area.Width(), isLabel ? area.Height() : std::max(area.Height(), metrics.height()));
}

} // namespace

TEST(Translation, OfTheLibrarysStrings) {
    EXPECT_EQ(stringOf(GUI_IDS_CLOSE), of({{"ENU", "Close"}, {"DEU", "Schließen"}, {"JPN", "閉じる"}}));
    EXPECT_EQ(stringOf(GUI_IDS_KEY_ASSIGNED), of({{"ENU", "%1 is assigned to %2"},
                                                  {"DEU", "%1 ist %2 zugewiesen"},
                                                  {"JPN", "%1 は %2 に割り当てられています"}}));
    // Pictures are not translated and come from the library itself.
    EXPECT_NE(FindResource(AfxFindResourceHandle("CDSPLASHBMP", RT_BITMAP), "CDSPLASHBMP", RT_BITMAP), nullptr);
}

TEST(Translation, OfTheLibrarysMenu) {
    CMenu menu;
    ASSERT_TRUE(menu.LoadMenu(GUI_IDM_CONSOLE));
    EXPECT_EQ(itemText(*menu.GetSubMenu(0), GUI_ID_CONSOLE_RUN, MF_BYCOMMAND),
              of({{"ENU", "&Run Commands"}, {"DEU", "Befehle &ausführen"}, {"JPN", "コマンドの実行(&R)"}}));
}

TEST(Translation, OfEveryDialogFitsIntoItsControls) {
    for (const UINT id : {GUI_IDD_ABOUT, GUI_IDD_ACCELERATORS, GUI_IDD_QUERY, GUI_IDD_DIRECTORY, GUI_IDD_CONSOLE,
                          GUI_IDD_TOPICS, GUI_IDD_BROWSER, GUI_IDD_PROPERTIES, GUI_IDD_COMMANDS, AFX_IDD_NEWTYPEDLG}) {
        const Frame owner;
        CDialog dialog;
        if (!dialog.Create(id, owner.get())) {
            continue; // a control of a class that is not there
        }
        dialog.ShowWindow(SW_SHOW);
        for (CWnd* control = dialog.GetWindow(GW_CHILD); control; control = control->GetWindow(GW_HWNDNEXT)) {
            char className[32] = "";
            GetClassNameA(control->m_hWnd, className, sizeof className);
            const std::string text = textOf(*control);
            if (std::string(className) != "Static" && std::string(className) != "Button") {
                continue;
            }
            const QSize over = excess(*control, className, text);
            EXPECT_LE(over.width(), 0) << "dialog " << id << ", \"" << text << "\"";
            EXPECT_LE(over.height(), 0) << "dialog " << id << ", \"" << text << "\"";
        }
        dialog.DestroyWindow();
    }
}

TEST(Translation, OfMessageBoxesWithItsMnemonics) {
    const std::map<std::string, Qt::Key> yes = {{"ENU", Qt::Key_Y}, {"DEU", Qt::Key_J}, {"JPN", Qt::Key_Y}};
    QStringList buttons;
    QTimer timer;
    QElapsedTimer waiting;
    QObject::connect(&timer, &QTimer::timeout, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (!box || !box->isActiveWindow()) {
            return;
        }
        if (!buttons.empty()) {
            if (waiting.hasExpired(5000)) { // the mnemonic has done nothing
                box->buttons().back()->click();
            }
            return;
        }
        for (const QAbstractButton* button : box->buttons()) {
            buttons.append(button->text());
        }
        waiting.start();
        QTest::keyClick(QApplication::focusWidget(), yes.at(language()), Qt::AltModifier);
    });
    timer.start(0);
    EXPECT_EQ(MessageBoxA(nullptr, "?", "caption", MB_YESNOCANCEL | MB_DEFBUTTON2), IDYES);
    EXPECT_EQ(
        buttons.join(QLatin1Char(' ')).toStdString(),
        of({{"ENU", "&Yes &No Cancel"}, {"DEU", "&Ja &Nein Abbrechen"}, {"JPN", "はい(&Y) いいえ(&N) キャンセル"}}));
}

TEST(Translation, OfKeys) {
    std::string names;
    for (const UINT key : {VK_CONTROL, VK_SHIFT, VK_LEFT, VK_RETURN, VK_NUMPAD4}) {
        char name[50] = "";
        GetKeyNameText(static_cast<LONG>(MapVirtualKey(key, 0) << 16 | (key == VK_LEFT ? 1U << 24 : 0)), name,
                       sizeof name);
        names += name + std::string(", ");
    }
    EXPECT_EQ(names, of({{"ENU", "Ctrl, Shift, Left, Enter, Num 4, "},
                         {"DEU", "Strg, Umschalt, Links, Eingabe, Num 4, "},
                         {"JPN", "Ctrl, Shift, 左, Enter, テンキー 4, "}}));
}

TEST(Translation, OfSystemMenus) {
    const Frame frame;
    EXPECT_EQ(itemText(*frame->GetSystemMenu(FALSE), SC_CLOSE, MF_BYCOMMAND),
              of({{"ENU", "&Close\tAlt+F4"}, {"DEU", "&Schließen\tAlt+F4"}, {"JPN", "閉じる(&C)\tAlt+F4"}}));
}

/// The metrics that dialogs are laid out with.
int main(int argc, char** argv) {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    testing::InitGoogleTest(&argc, argv);
    if (!tvx::afx::ensureGui()) {
        return 1;
    }
    QApplication::setStyle(QStringLiteral("Fusion"));
    return RUN_ALL_TESTS();
}
