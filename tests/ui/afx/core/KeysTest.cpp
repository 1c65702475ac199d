#include "platform/afx/core/detail/Keys.h"
#include "afxwin.h"
#include "platform/afx/core/detail/KeyLayout.h"
#include "platform/afx/core/detail/Window.h"

#include <QMenu>
#include <QTest>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <map>
#include <string>

namespace {

class Keys : public testing::Test {
protected:
    Keys() {
        EXPECT_TRUE(frame.CreateEx(0, AfxRegisterWndClass(0), "frame", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 200, 100,
                                   nullptr, nullptr));
        widget = tvx::afx::peerOf(frame.m_hWnd);
    }
    ~Keys() override {
        frame.DestroyWindow();
    }
    CWnd frame;
    QWidget* widget = nullptr;
};

// The Alt that opens a menu is released while the menu has the keyboard. An Alt that stayed down would keep every
// accelerator from matching afterwards.
TEST_F(Keys, AreFollowedWhileAMenuHasTheKeyboard) {
    QTest::keyPress(widget, Qt::Key_Alt, Qt::AltModifier);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_MENU));
    EXPECT_LT(GetAsyncKeyState(VK_MENU), 0);

    QMenu menu;
    menu.addAction("item");
    menu.popup(QPoint(0, 0));
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&menu));
    QTest::keyRelease(&menu, Qt::Key_Alt);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_MENU));
    EXPECT_EQ(GetAsyncKeyState(VK_MENU), 0);
    menu.close();
}

// The Ctrl of a command is released before the command's dialog has the keyboard: the toolkit drops that release.
TEST_F(Keys, TellOfModifiers) {
    QTest::keyPress(widget, Qt::Key_Control, Qt::ControlModifier);
    QTest::keyPress(widget, Qt::Key_P, Qt::ControlModifier);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_CONTROL));
    QTest::keyPress(widget, Qt::Key_F8);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_CONTROL));
    // Pressed where another program had the keyboard.
    QKeyEvent held(QEvent::KeyPress, Qt::Key_P, Qt::ControlModifier, QStringLiteral("\x10"));
    QSpontaneKeyEvent::setSpontaneous(&held);
    QApplication::instance()->notify(widget, &held);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_CONTROL));
    QTest::keyPress(widget, Qt::Key_F8);
}

void sendKey(QWidget& receiver, QEvent::Type type, int key, Qt::KeyboardModifiers modifiers, quint64 time) {
    QKeyEvent event(type, key, modifiers);
    event.setTimestamp(time);
    QSpontaneKeyEvent::setSpontaneous(&event);
    QApplication::instance()->notify(&receiver, &event);
}

// The toolkit asks who takes a short-cut before it sends the press. A command's dialog is opened by that question, and
// the press comes when the dialog is gone and the keys have been released long since.
TEST_F(Keys, AreDownNoLongerWhenTheirPressComesLate) {
    sendKey(*widget, QEvent::ShortcutOverride, Qt::Key_P, Qt::ControlModifier, 100);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_CONTROL));
    sendKey(*widget, QEvent::KeyRelease, Qt::Key_Control, Qt::ControlModifier, 200);
    sendKey(*widget, QEvent::KeyRelease, Qt::Key_P, Qt::NoModifier, 210);
    sendKey(*widget, QEvent::KeyPress, Qt::Key_P, Qt::ControlModifier, 100);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_CONTROL));
    EXPECT_FALSE(tvx::afx::isKeyDown('P'));
    // Accelerators are looked for at the question already.
    QTest::keyPress(widget, Qt::Key_P, Qt::ControlModifier);
    sendKey(*widget, QEvent::ShortcutOverride, Qt::Key_F8, Qt::NoModifier, 300);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_CONTROL));
    sendKey(*widget, QEvent::KeyRelease, Qt::Key_F8, Qt::NoModifier, 301);
}

std::string nameOf(LONG parameter) {
    char name[50] = "";
    const int length = GetKeyNameText(parameter, name, sizeof(name));
    EXPECT_EQ(static_cast<std::size_t>(length), std::strlen(name));
    return name;
}

// As a program names a virtual key: by its scan code, with the extended bit for the cursor block only.
std::string nameOfKey(UINT virtualKey) {
    const bool cursor =
        (virtualKey >= VK_PRIOR && virtualKey <= VK_DOWN) || virtualKey == VK_INSERT || virtualKey == VK_DELETE;
    return nameOf(static_cast<LONG>(MapVirtualKey(virtualKey, 0) << 16 | (cursor ? 1U << 24 : 0)));
}

TEST_F(Keys, HaveNamesThatTellThemApart) {
    const std::pair<Qt::Key, const char*> table[] = {{Qt::Key_A, "A"},
                                                     {Qt::Key_7, "7"},
                                                     {Qt::Key_F1, "F1"},
                                                     {Qt::Key_F11, "F11"},
                                                     {Qt::Key_F24, "F24"},
                                                     {Qt::Key_Space, "Space"},
                                                     {Qt::Key_Backtab, "Tab"},
                                                     {Qt::Key_Backspace, "Backspace"},
                                                     {Qt::Key_Enter, "Enter"},
                                                     {Qt::Key_Escape, "Esc"},
                                                     {Qt::Key_Pause, "Pause"},
                                                     {Qt::Key_Print, "Print Screen"},
                                                     {Qt::Key_Menu, "Menu"},
                                                     {Qt::Key_Home, "Home"},
                                                     {Qt::Key_Left, "Left"},
                                                     {Qt::Key_Delete, "Delete"},
                                                     {Qt::Key_CapsLock, "Caps Lock"},
                                                     {Qt::Key_NumLock, "Num Lock"},
                                                     {Qt::Key_Control, "Ctrl"},
                                                     {Qt::Key_Alt, "Alt"},
                                                     {Qt::Key_Shift, "Shift"},
                                                     {Qt::Key_Plus, "="},
                                                     {Qt::Key_Question, "/"},
                                                     {Qt::Key_Back, "Browser Back"},
                                                     {Qt::Key_MediaPlay, "Play/Pause"},
                                                     {Qt::Key_LaunchMail, "Mail"},
                                                     {Qt::Key_VolumeMute, "Mute"},
                                                     {Qt::Key_Select, "Select"},
                                                     {Qt::Key_Printer, "Print"},
                                                     {Qt::Key_Execute, "Execute"},
                                                     {Qt::Key_Cancel, "Break"}};
    for (const auto& [key, name] : table) {
        const QKeyEvent press(QEvent::KeyPress, key, Qt::NoModifier);
        EXPECT_EQ(nameOfKey(static_cast<UINT>(tvx::afx::virtualKey(press))), name);
        EXPECT_EQ(nameOf(static_cast<LONG>(tvx::afx::keyParameter(press, false))), name);
    }
    std::map<std::string, UINT> named;
    for (UINT key = 1; key < 256; ++key) {
        if (const std::string name = nameOfKey(key); !name.empty()) {
            EXPECT_TRUE(named.emplace(name, key).second) << name << " is " << key << " and " << named[name];
        }
    }
    EXPECT_GE(named.size(), 140U);
    EXPECT_EQ(nameOfKey(VK_NUMPAD7), "Num 7");
    EXPECT_EQ(nameOfKey(VK_DIVIDE), "Num /");
    EXPECT_EQ(nameOfKey(0xFF), "");
}

TEST_F(Keys, AreMappedToScanCodesAndCharacters) {
    EXPECT_EQ(MapVirtualKey(VK_HOME, 0), MapVirtualKey(VK_NUMPAD7, 0));
    EXPECT_EQ(MapVirtualKey(0x47, 1), static_cast<UINT>(VK_HOME));
    EXPECT_EQ(MapVirtualKey(0x38, 3), static_cast<UINT>(VK_MENU));
    EXPECT_EQ(MapVirtualKey(0xE038, 3), static_cast<UINT>(VK_MENU));
    EXPECT_EQ(MapVirtualKey('Q', 2), static_cast<UINT>('Q'));
    EXPECT_EQ(MapVirtualKey(VK_NUMPAD4, 2), static_cast<UINT>('4'));
    EXPECT_EQ(MapVirtualKey(VK_TAB, 2), static_cast<UINT>('\t'));
    EXPECT_EQ(MapVirtualKey(VK_F5, 2), 0U);
    char name[4] = "";
    EXPECT_EQ(GetKeyNameText(0x390000, name, sizeof(name)), 3);
    EXPECT_STREQ(name, "Spa");
    EXPECT_EQ(GetKeyNameText(0x390000, name, 0), 0);
}

/// A layout from what its keys type, row by row from the digits to the bottom, then the key beside the left Shift key
/// and the two that Japanese keyboards have. A blank stands for a key that there is not.
tvx::afx::KeyLayout layoutOf(const std::u32string& plain, const std::u32string& shifted) {
    std::vector<unsigned> codes;
    for (const auto& [first, last] :
         {std::pair(10U, 21U), std::pair(24U, 35U), std::pair(38U, 49U), std::pair(51U, 61U), std::pair(94U, 94U),
          std::pair(97U, 97U), std::pair(132U, 132U)}) {
        for (unsigned code = first; code <= last; ++code) {
            codes.push_back(code);
        }
    }
    std::vector<tvx::KeySigns> signs(256);
    for (std::size_t key = 0; key < plain.size(); ++key) {
        signs[codes.at(key)] = {plain[key] != U' ' ? plain[key] : 0, shifted.at(key)};
    }
    return tvx::afx::KeyLayout(signs);
}

TEST(KeyLayouts, GiveEachKeyAVirtualKeyOfItsOwn) {
    struct Layout {
        const char* name;
        std::u32string plain;
        std::u32string shifted;
        std::vector<std::pair<unsigned, int>> keys; ///< key codes, and what they are to be
    };
    const Layout table[] = {
        {"us",
         U"1234567890-=qwertyuiop[]asdfghjkl;'`\\zxcvbnm,./<",
         U"!@#$%^&*()_+QWERTYUIOP{}ASDFGHJKL:\"~|ZXCVBNM<>?>",
         {{10, '1'},
          {20, VK_OEM_MINUS},
          {21, VK_OEM_PLUS},
          {24, 'Q'},
          {34, VK_OEM_4},
          {47, VK_OEM_1},
          {51, VK_OEM_5},
          {59, VK_OEM_COMMA},
          {61, VK_OEM_2},
          {94, VK_OEM_102}}},
        {"de",
         U"1234567890ß´qwertzuiopü+asdfghjklöä^#yxcvbnm,.-<",
         U"!\"§$%&/()=?`QWERTZUIOPÜ*ASDFGHJKLÖÄ°'YXCVBNM;:_>",
         {{16, '7'},
          {29, 'Z'},
          {52, 'Y'},
          {34, VK_OEM_4},
          {35, VK_OEM_PLUS},
          {47, VK_OEM_1},
          {48, VK_OEM_7},
          {51, VK_OEM_5},
          {59, VK_OEM_COMMA},
          {60, VK_OEM_PERIOD},
          {61, VK_OEM_MINUS},
          {94, VK_OEM_102}}},
        {"fr",
         U"&é\"'(-è_çà)=azertyuiop^$qsdfghjklmù²*wxcvbn,;:!<",
         U"1234567890°+AZERTYUIOP¨£QSDFGHJKLM%~µWXCVBN?./§>",
         {{10, '1'},
          {15, '6'},
          {19, '0'},
          {21, VK_OEM_PLUS},
          {24, 'A'},
          {47, 'M'},
          {58, VK_OEM_COMMA},
          {59, VK_OEM_PERIOD},
          {60, VK_OEM_1},
          {61, VK_OEM_2}}},
        {"ru",
         U"1234567890-=йцукенгшщзхъфывапролджэё\\ячсмитьбю./",
         U"!\"№;%:?*()_+ЙЦУКЕНГШЩЗХЪФЫВАПРОЛДЖЭЁ/ЯЧСМИТЬБЮ,|",
         {{12, '3'}, {24, 'Q'}, {54, 'C'}, {34, VK_OEM_4}, {59, VK_OEM_COMMA}, {60, VK_OEM_PERIOD}, {61, VK_OEM_2}}},
        {"gr",
         U"1234567890-=;ςερτυθιοπ[]ασδφγηξκλ΄'`\\ζχψωβνμ,./«",
         U"!@#$%^&*()_+:¦ΕΡΤΥΘΙΟΠ{}ΑΣΔΦΓΗΞΚΛ¨\"~|ΖΧΨΩΒΝΜ<>?»",
         {{24, 'Q'}, {25, 'W'}, {47, VK_OEM_1}, {54, 'C'}}},
        {"jp",
         U"1234567890-^qwertyuiop@[asdfghjkl;: ]zxcvbnm,./ \\\\",
         U"!\"#$%&'() =~QWERTYUIOP`{ASDFGHJKL+* }ZXCVBNM<>? _|",
         {{20, VK_OEM_MINUS}, {35, VK_OEM_4}, {47, VK_OEM_PLUS}, {48, VK_OEM_1}, {51, VK_OEM_6}}},
        {"tr",
         U"1234567890*-qwertyuıopğüasdfghjklşi\",zxcvbnmöç.<",
         U"!'^+%&/()=?_QWERTYUIOPĞÜASDFGHJKLŞİé;ZXCVBNMÖÇ:>",
         {{13, '4'}, {21, VK_OEM_MINUS}, {48, 'I'}, {51, VK_OEM_COMMA}, {61, VK_OEM_PERIOD}}},
    };
    for (const Layout& layout : table) {
        const tvx::afx::KeyLayout made = layoutOf(layout.plain, layout.shifted);
        for (const auto& [code, key] : layout.keys) {
            EXPECT_EQ(made.virtualKey(code), key) << layout.name << ", key " << code;
        }
        std::map<int, unsigned> places;
        for (unsigned code = 0; code < 256; ++code) {
            if (const int key = made.virtualKey(code)) {
                EXPECT_TRUE(places.emplace(key, code).second) << layout.name << ": " << code << " and " << places[key];
                EXPECT_NE(made.sign(key), 0U) << layout.name << ", key " << code;
            }
        }
        EXPECT_EQ(places.size(), layout.plain.size() - std::ranges::count(layout.plain, U' ')) << layout.name;
    }
    EXPECT_EQ(layoutOf(table[1].plain, table[1].shifted).sign(VK_OEM_4), U'ü');
    EXPECT_EQ(tvx::afx::KeyLayout({}).virtualKey(24), 0);
}

} // namespace
