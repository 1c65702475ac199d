#include "afxcmn.h"
#include "tests/desktop/afx/core/RealKeys.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <QLineEdit>
#include <QTest>

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace {

constexpr BYTE key = FVIRTKEY;
constexpr BYTE control = FVIRTKEY | FCONTROL;
constexpr WORD lastCommand = 99; // F12

const ACCEL entries[] = {
    {control, 'C', 1},
    {control | FSHIFT, 'C', 2},
    {control, VK_OEM_PLUS, 3},
    {control | FSHIFT, VK_OEM_PLUS, 4},
    {control, '1', 5},
    {control | FSHIFT, '1', 6},
    {control | FALT, 'Q', 7},
    {control, VK_OEM_PERIOD, 8},
    {control, VK_NUMPAD7, 9},
    {control, VK_HOME, 10},
    {control, VK_ADD, 11},
    {key | FSHIFT | FALT, 'X', 12},
    {control, 'C', 13}, // the first entry has the key
    {key | FSHIFT, VK_TAB, 14},
    {key, VK_BROWSER_BACK, 15},
    {control | FALT, VK_F5, 16},
    {control, VK_CANCEL, 17},
    {key, 'Q', 18},
    {key, VK_MEDIA_PLAY_PAUSE, 19},
    {control, VK_RETURN, 20},
    {key, VK_F14, 21},
    {key, VK_LAUNCH_MAIL, 22},
    {key, VK_SEPARATOR, 23},
    {key, VK_F12, lastCommand},
};

/// A frame that notes the commands of its accelerators.
class KeyFrame : public CFrameWnd {
public:
    KeyFrame() {
        EXPECT_TRUE(Create(nullptr, "keys"));
        m_hAccelTable = CreateAcceleratorTable(entries, std::size(entries));
        ShowWindow(SW_SHOW);
        EXPECT_TRUE(waitForActive(*this));
        SetFocus();
    }
    /// What a chord has fired, once the display has delivered it.
    std::vector<int> fired(RealKeys& keys, std::initializer_list<unsigned> chord) {
        commands.clear();
        keys.chord(chord);
        keys.chord({96});
        EXPECT_TRUE(QTest::qWaitFor([this] { return !commands.empty() && commands.back() == lastCommand; }));
        if (!commands.empty()) {
            commands.pop_back();
        }
        return commands;
    }
    std::vector<int> commands;

protected:
    BOOL OnCommand(WPARAM wParam, LPARAM) override {
        EXPECT_EQ(HIWORD(wParam), 1);
        commands.push_back(LOWORD(wParam));
        return TRUE;
    }
    void PostNcDestroy() override {}
};

TEST(RealAccelerators, FireOnceOnEveryLayout) {
    constexpr unsigned ctrl = RealKeys::control;
    constexpr unsigned shift = RealKeys::shift;
    constexpr unsigned alt = RealKeys::alt;
    constexpr unsigned numLock = 77;
    struct Chord {
        std::initializer_list<unsigned> keys;
        int command; ///< 0: none
    };
    struct Layout {
        const char* names;
        unsigned group;
        std::vector<Chord> chords;
    };
    const Layout table[] = {
        {"us",
         0,
         {{{ctrl, 54}, 1},
          {{ctrl, shift, 54}, 2},
          {{ctrl, 21}, 3},
          {{ctrl, shift, 21}, 4},
          {{ctrl, 10}, 5},
          {{ctrl, shift, 10}, 6},
          {{ctrl, alt, 24}, 7},
          {{ctrl, 60}, 8},
          {{ctrl, 79}, 10},
          {{ctrl, 86}, 11},
          {{shift, alt, 53}, 12},
          {{alt, shift, 53}, 12},
          {{shift, 23}, 14},
          {{166}, 15},
          {{ctrl, 127}, 17},
          {{24}, 18},
          {{172}, 19},
          {{192}, 21},
          {{163}, 22},
          {{129}, 23},
          {{ctrl, 36}, 20},
          {{ctrl, 104}, 20},
          {{54}, 0},
          {{numLock}, 0},
          {{ctrl, 79}, 9},
          {{ctrl, 86}, 11},
          {{numLock}, 0}}},
        {"de",
         0,
         {{{ctrl, 35}, 3},
          {{ctrl, shift, 35}, 4},
          {{ctrl, shift, 10}, 6},
          {{ctrl, 60}, 8},
          {{ctrl, alt, 24}, 7},
          {{RealKeys::altGr, 24}, 0},
          {{RealKeys::altGr, 71}, 16},
          {{24}, 18}}},
        {"fr", 0, {{{ctrl, 10}, 5}, {{ctrl, shift, 10}, 6}, {{ctrl, 21}, 3}, {{ctrl, 59}, 8}, {{38}, 18}, {{24}, 0}}},
        {"ru", 0, {{{ctrl, 54}, 1}, {{ctrl, shift, 54}, 2}, {{ctrl, 60}, 8}, {{ctrl, 10}, 5}, {{24}, 18}}},
        {"gr", 0, {{{ctrl, 54}, 1}, {{ctrl, alt, 24}, 7}, {{24}, 18}}},
        {"jp", 0, {{{ctrl, 47}, 3}, {{ctrl, 54}, 1}}},
        {"us,ru", 1, {{{ctrl, 54}, 1}, {{ctrl, 60}, 8}, {{ctrl, shift, 10}, 6}}},
        {"us,de,ru", 2, {{{ctrl, 54}, 1}, {{ctrl, 60}, 8}, {{ctrl, shift, 10}, 6}}}, // the display tells of two
    };
    RealKeys keys;
    KeyFrame frame;
    for (const Layout& layout : table) {
        ASSERT_TRUE(keys.layout(layout.names));
        keys.group(layout.group);
        for (std::size_t i = 0; i < layout.chords.size(); ++i) {
            const Chord& chord = layout.chords[i];
            const std::vector<int> expected = chord.command != 0 ? std::vector{chord.command} : std::vector<int>();
            EXPECT_EQ(frame.fired(keys, chord.keys), expected) << layout.names << ", chord " << i;
        }
        keys.group(0);
    }
    frame.DestroyWindow();
}

std::string nameOf(UINT virtualKey) {
    char name[50] = "";
    GetKeyNameText(static_cast<LONG>(MapVirtualKey(virtualKey, 0) << 16), name, sizeof(name));
    return name;
}

TEST(RealAccelerators, AreNamedByTheSignsOfTheLayout) {
    RealKeys keys;
    KeyFrame frame;
    const std::pair<const char*, const char*> table[] = {
        {"us", "[ . Z 1 Num ."}, {"de", "Ü . Z 1 Num ,"}, {"fr", "^ ; Z 1 Num ."}, {"ru", "Х Ю Z 1 Num ,"}};
    for (const auto& [layout, names] : table) {
        ASSERT_TRUE(keys.layout(layout));
        EXPECT_EQ(frame.fired(keys, {}), std::vector<int>());
        std::string found;
        for (const UINT virtualKey : {VK_OEM_4, VK_OEM_PERIOD, +'Z', +'1', VK_DECIMAL}) {
            found += (found.empty() ? "" : " ") + nameOf(virtualKey);
        }
        EXPECT_EQ(found, names) << layout;
    }
    frame.DestroyWindow();
}

TEST(RealKeysInFields, CopyAndPasteOnEveryLayout) {
    RealKeys keys;
    ScriptedDialog dialog(IDD_SHAPE);
    dialog.prepare = [&] { dialog.GetDlgItem(IDC_NAME)->SetFocus(); };
    dialog.script = [&] {
        for (const char* layout : {"ru", "gr", "fr", "de"}) {
            ASSERT_TRUE(keys.layout(layout));
            dialog.SetDlgItemText(IDC_NAME, layout);
            const unsigned a = std::string(layout) == "fr" ? 24 : 38;
            keys.chord({RealKeys::control, a});
            keys.chord({RealKeys::control, 54}); // C
            keys.chord({115});                   // End
            keys.chord({RealKeys::control, 55}); // V
            const std::string doubled = std::string(layout) + layout;
            EXPECT_TRUE(QTest::qWaitFor([&] { return textOf(dialog.GetDlgItem(IDC_NAME)) == doubled; }))
                << textOf(dialog.GetDlgItem(IDC_NAME)) << " on " << layout;
        }
    };
    dialog.DoModal();
}

TEST(RealHotKey, HasTheKeysThatTheWindowManagerKeeps) {
    RealKeys keys;
    ScriptedDialog dialog(IDD_HOT_KEY);
    dialog.prepare = [&] { dialog.GetDlgItem(IDC_HOT_KEY)->SetFocus(); };
    dialog.script = [&] {
        const auto* field = qobject_cast<QLineEdit*>(tvx::afx::peerOf(dialog.GetDlgItem(IDC_HOT_KEY)->m_hWnd));
        const auto shows = [&](const char* text) { return QTest::qWaitFor([&] { return field->text() == text; }); };
        keys.chord({RealKeys::alt, 70});
        EXPECT_TRUE(shows("Alt+F4")) << field->text().toStdString();
        keys.chord({RealKeys::control, RealKeys::alt, 114});
        EXPECT_TRUE(shows("Ctrl+Alt+Right")) << field->text().toStdString();
        keys.press(RealKeys::shift, true);
        keys.press(RealKeys::alt, true);
        EXPECT_TRUE(shows("Alt+Shift+")) << field->text().toStdString();
        keys.press(RealKeys::alt, false);
        keys.press(RealKeys::shift, false);
        EXPECT_TRUE(shows("Ctrl+Alt+Right")) << field->text().toStdString();
        keys.chord({135}); // the key of context menus
        EXPECT_TRUE(shows("Menu")) << field->text().toStdString();
        // Without the field the window manager has them again, once the display has heard of it.
        dialog.GetDlgItem(IDC_HOT_KEY)->ShowWindow(SW_HIDE);
        EXPECT_TRUE(QTest::qWaitFor([&] {
            keys.chord({RealKeys::alt, 70});
            return QTest::qWaitFor([&] { return dialog.codes(IDCANCEL, 0) == 1; }, 500);
        }));
    };
    dialog.DoModal();
}

} // namespace
