// The accelerator dialog as a user meets it: by keys and clicks.
#include "s/AccelDlg.h"

#include "res/resource.h"
#include "s/AccelMap.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

using Texts = std::vector<std::string>;

constexpr WORD openFile = 100;
constexpr WORD exitProgram = 101;
constexpr WORD about = GUI_ID_HELP_ABOUT; // a command with a string
constexpr WORD unlisted = 103;

Gui_Accel ctrl(char key, WORD command = 0) {
    return {FVIRTKEY | FCONTROL, static_cast<WORD>(key), command};
}

Gui_Accel f9(WORD command = 0) {
    return {FVIRTKEY, VK_F9, command};
}

/// "&File" with "&Open...", a line and "E&xit", "&Help" with "&Deep" and "&About" in it.
class Menu : public CMenu {
public:
    Menu() {
        CreateMenu();
        const HMENU file = ::CreatePopupMenu();
        ::AppendMenu(file, MF_STRING, openFile, "&Open...\tCtrl+O");
        ::AppendMenu(file, MF_SEPARATOR, 0, nullptr);
        ::AppendMenu(file, MF_STRING, exitProgram, "E&xit");
        const HMENU deep = ::CreatePopupMenu();
        ::AppendMenu(deep, MF_STRING, about, "&About");
        const HMENU help = ::CreatePopupMenu();
        ::AppendMenu(help, MF_POPUP, reinterpret_cast<UINT_PTR>(deep), "&Deep");
        AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(file), "&File");
        AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(help), "&Help");
    }
};

HACCEL tableOf(std::vector<tagACCEL> accels) {
    return CreateAcceleratorTableA(accels.data(), static_cast<int>(accels.size()));
}

/// The dialog, in which a test works once it is shown.
class Dialog : public Gui_AccelDlg {
public:
    explicit Dialog(CMenu& menu, std::vector<tagACCEL> accels = {ctrl('O', openFile), f9(unlisted)},
                    CWnd* parent = nullptr)
        : Dialog(menu, tableOf(std::move(accels)), parent) {}

    int run(std::function<void()> script) {
        m_script = std::move(script);
        return static_cast<int>(DoModal());
    }
    CListBox& list(int id) const {
        return *static_cast<CListBox*>(GetDlgItem(id));
    }
    Texts lines(int id) const {
        Texts texts;
        for (int i = 0; i < list(id).GetCount(); ++i) {
            CString text;
            list(id).GetText(i, text);
            texts.emplace_back(text.GetString());
        }
        return texts;
    }
    Texts keys() const {
        return lines(GUI_IDC_ACCEL_KEYS);
    }
    std::string text(int id) const {
        return textOf(GetDlgItem(id));
    }
    std::string keyText() const {
        return text(GUI_IDC_ACCEL_KEY_TEXT);
    }
    std::string note() const {
        return text(GUI_IDC_ACCEL_NOTE);
    }
    bool isEnabled(int id) const {
        return GetDlgItem(id)->IsWindowEnabled() != 0;
    }
    bool isShown(int id) const {
        return GetDlgItem(id)->IsWindowVisible() != 0;
    }
    int focus() const {
        const CWnd* control = GetFocus();
        return control ? control->GetDlgCtrlID() : 0;
    }
    void push(int id) const {
        click(GetDlgItem(id));
    }
    /// Selects a line by the keyboard.
    void choose(int listId, const char* line) const {
        GetDlgItem(listId)->SetFocus();
        key(Qt::Key_Home);
        for (int i = 1; i < list(listId).GetCount() && selected(listId) != line; ++i) {
            key(Qt::Key_Down);
        }
        EXPECT_EQ(selected(listId), line);
    }
    std::string selected(int listId) const {
        const int line = list(listId).GetCurSel();
        return line < 0 ? "" : lines(listId)[static_cast<std::size_t>(line)];
    }
    /// Specify, a key, Done.
    void specify(Qt::Key typed, Qt::KeyboardModifiers modifiers = Qt::NoModifier) const {
        push(GUI_IDC_ACCEL_SPECIFY);
        key(typed, modifiers);
        push(GUI_IDC_ACCEL_SPECIFY);
    }
    std::unique_ptr<Gui_AccelMap> map() const {
        return std::unique_ptr<Gui_AccelMap>(GetAccelMap());
    }

protected:
    BOOL OnInitDialog() override {
        const BOOL result = Gui_AccelDlg::OnInitDialog();
        PostMessage(WM_APP);
        return result;
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return Gui_AccelDlg::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        m_script();
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(99);
        }
        return 0;
    }

private:
    Dialog(CMenu& menu, HACCEL table, CWnd* parent) : Gui_AccelDlg(&menu, table, parent) {
        DestroyAcceleratorTable(table); // the dialog has a copy
    }
    std::function<void()> m_script;
};

constexpr const char* fileOpen = " File Open...";
constexpr const char* fileExit = " File Exit";
constexpr const char* helpAbout = " Help Deep About";

int commandOf(const Gui_AccelMap& map, const Gui_Accel& accel) {
    unsigned short command = 0;
    map.GetCmdAt(accel, command);
    return command;
}

} // namespace

TEST(AccelDlg, ListsCommandsTheirKeysAndWhatTheyDo) {
    Menu menu;
    Dialog dialog(menu, {ctrl('O', openFile), f9(openFile), ctrl('A', about)});
    dialog.run([&] {
        EXPECT_EQ(dialog.lines(GUI_IDC_ACCEL_COMMANDS), (Texts{fileExit, fileOpen, helpAbout}));
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_COMMANDS);
        EXPECT_EQ(dialog.keyText(), "Press the Specify button to begin the definition of the accelerator key.");
        for (const int id : {GUI_IDC_ACCEL_REMOVE, GUI_IDC_ACCEL_ASSIGN, GUI_IDC_ACCEL_UNDO, GUI_IDC_ACCEL_RESET}) {
            EXPECT_FALSE(dialog.isEnabled(id)) << id;
        }
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileOpen);
        EXPECT_EQ(dialog.keys(), (Texts{"Ctrl+O", "F9"}));
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_COMMAND_TEXT), "");
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        dialog.choose(GUI_IDC_ACCEL_KEYS, "F9");
        EXPECT_TRUE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, helpAbout);
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_COMMAND_TEXT), "Display program information and copyright");
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+A"});
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileExit);
        EXPECT_EQ(dialog.keys(), Texts{});
    });
}

TEST(AccelDlg, TellsWhoHasTheTypedKey) {
    Menu menu;
    Dialog dialog(menu);
    dialog.run([&] {
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_SPECIFY), "&Done");
        EXPECT_EQ(dialog.keyText(), "Type the accelerator key and press the Done button.");
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_HOTKEY);
        key(Qt::Key_O, Qt::ControlModifier);
        EXPECT_EQ(dialog.keyText(), "Type the accelerator key and press the Done button.");
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_SPECIFY), "&Specify");
        EXPECT_FALSE(dialog.isShown(GUI_IDC_ACCEL_HOTKEY));
        EXPECT_EQ(dialog.keyText(), "Ctrl+O is assigned to  File Open...");
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_ASSIGN)) << "no command is selected";
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileExit);
        EXPECT_TRUE(dialog.isEnabled(GUI_IDC_ACCEL_ASSIGN)) << "the key is kept";

        dialog.specify(Qt::Key_F, Qt::AltModifier);
        EXPECT_EQ(dialog.keyText(), "Alt+F is assigned to the File menu");
        EXPECT_TRUE(dialog.isEnabled(GUI_IDC_ACCEL_ASSIGN)) << "it is only said";
        dialog.specify(Qt::Key_F, Qt::AltModifier | Qt::ShiftModifier);
        EXPECT_EQ(dialog.keyText(), "Alt+Shift+F is unassigned");
        dialog.specify(Qt::Key_F9);
        EXPECT_EQ(dialog.keyText(), "F9 is unassigned") << "its command is in no menu";
        dialog.push(GUI_IDC_ACCEL_SPECIFY); // cleared
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        EXPECT_EQ(dialog.keyText(), "Press the Specify button to begin the definition of the accelerator key.");
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_ASSIGN));
    });
}

TEST(AccelDlg, TakesAnAssignedKeyFromItsOwnerAndGivesItBack) {
    Menu menu;
    Dialog dialog(menu, {ctrl('O', openFile), ctrl('P', openFile)});
    dialog.run([&] {
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileExit);
        dialog.specify(Qt::Key_O, Qt::ControlModifier);
        dialog.push(GUI_IDC_ACCEL_ASSIGN);
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+O"});
        EXPECT_EQ(dialog.keyText(), "Ctrl+O is assigned to  File Exit");
        EXPECT_EQ(dialog.note(), "Ctrl+O was taken from File Open...");
        dialog.push(GUI_IDC_ACCEL_ASSIGN); // it is the command's own now
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+O"});
        EXPECT_EQ(dialog.note(), "");
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileOpen);
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+P"}) << "it loses that key only";

        dialog.push(GUI_IDC_ACCEL_UNDO);
        EXPECT_EQ(dialog.keys(), (Texts{"Ctrl+O", "Ctrl+P"}));
        EXPECT_EQ(dialog.keyText(), "Ctrl+O is assigned to  File Open...");
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_UNDO));
        EXPECT_NE(dialog.focus(), GUI_IDC_ACCEL_UNDO);

        dialog.choose(GUI_IDC_ACCEL_KEYS, "Ctrl+P");
        dialog.push(GUI_IDC_ACCEL_REMOVE);
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+O"});
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        dialog.choose(GUI_IDC_ACCEL_KEYS, "Ctrl+O");
        dialog.push(GUI_IDC_ACCEL_REMOVE);
        EXPECT_EQ(dialog.keys(), Texts{});
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        dialog.push(GUI_IDC_ACCEL_RESET);
        EXPECT_EQ(dialog.keys(), (Texts{"Ctrl+O", "Ctrl+P"}));
        EXPECT_FALSE(dialog.isEnabled(GUI_IDC_ACCEL_RESET));
        dialog.push(GUI_IDC_ACCEL_UNDO);
        EXPECT_EQ(dialog.keys(), Texts{});
    });
}

TEST(AccelDlg, BeginsAnewWhenItIsShownOnceMore) {
    Menu menu;
    Dialog dialog(menu);
    dialog.run([&] {
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        dialog.push(GUI_IDC_ACCEL_SPECIFY); // neither is ended
    });
    dialog.run([&] {
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        EXPECT_TRUE(dialog.isShown(GUI_IDC_ACCEL_FIND_FIELD));
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_SPECIFY), "&Done");
        menu.DestroyMenu(); // a host's mistake
        key(Qt::Key_F, Qt::AltModifier);
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        EXPECT_EQ(dialog.keyText(), "Alt+F is unassigned");
    });
}

TEST(AccelDlg, ResetGoesToTheKeysThatItWasTold) {
    Menu menu;
    Dialog dialog(menu);
    Gui_AccelMap own;
    own.Add(ctrl('X', exitProgram));
    dialog.SetResetAccels(own);
    dialog.run([&] {
        dialog.push(GUI_IDC_ACCEL_RESET);
        EXPECT_TRUE(dialog.map()->IsSame(own));
    });
}

TEST(AccelDlg, FiltersByWordsOfNamesAndKeys) {
    Menu menu;
    Dialog dialog(menu);
    dialog.run([&] {
        dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileOpen);
        const auto filtered = [&](const char* typed) {
            CWnd* filter = dialog.GetDlgItem(GUI_IDC_ACCEL_FILTER);
            filter->SetFocus();
            key(Qt::Key_A, Qt::ControlModifier);
            type(typed);
            return dialog.lines(GUI_IDC_ACCEL_COMMANDS);
        };
        EXPECT_EQ(filtered("FILE"), (Texts{fileExit, fileOpen}));
        EXPECT_EQ(dialog.selected(GUI_IDC_ACCEL_COMMANDS), fileOpen) << "stays selected";
        EXPECT_EQ(filtered("open file"), Texts{fileOpen});
        EXPECT_EQ(filtered("ctrl+o"), Texts{fileOpen});
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+O"});
        EXPECT_EQ(filtered("help"), Texts{helpAbout});
        EXPECT_EQ(dialog.selected(GUI_IDC_ACCEL_COMMANDS), "") << "it does not pass";
        EXPECT_EQ(dialog.keys(), Texts{});
        EXPECT_EQ(filtered("nothing"), Texts{});
        key(Qt::Key_Return);
        EXPECT_TRUE(dialog.IsWindowVisible());
        EXPECT_EQ(filtered("help"), Texts{helpAbout});
        key(Qt::Key_Return);
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_COMMANDS);
        EXPECT_EQ(dialog.selected(GUI_IDC_ACCEL_COMMANDS), helpAbout);
        // Keys that are given now are found as well.
        dialog.specify(Qt::Key_G, Qt::ControlModifier);
        dialog.push(GUI_IDC_ACCEL_ASSIGN);
        EXPECT_EQ(filtered("ctrl+g"), Texts{helpAbout});
    });
}

TEST(AccelDlg, FindsTheOwnerOfTheNextKey) {
    Menu menu;
    Dialog dialog(menu,
                  {ctrl('O', openFile), f9(unlisted), {FVIRTKEY, VK_ESCAPE, about}, {FCONTROL, 'g', exitProgram}});
    dialog.run([&] {
        const auto find = [&](Qt::Key typed, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
            dialog.push(GUI_IDC_ACCEL_FIND_KEY);
            EXPECT_EQ(dialog.note(), "Press the key to look for.");
            EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_FIND_FIELD);
            key(typed, modifiers);
            EXPECT_FALSE(dialog.isShown(GUI_IDC_ACCEL_FIND_FIELD));
            EXPECT_TRUE(dialog.isShown(GUI_IDC_ACCEL_FILTER));
            return dialog.selected(GUI_IDC_ACCEL_COMMANDS);
        };
        EXPECT_EQ(find(Qt::Key_O, Qt::ControlModifier), fileOpen);
        EXPECT_EQ(dialog.note(), "Ctrl+O is assigned to File Open...");
        EXPECT_EQ(dialog.selected(GUI_IDC_ACCEL_KEYS), "Ctrl+O");
        EXPECT_TRUE(dialog.isEnabled(GUI_IDC_ACCEL_REMOVE));
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_COMMANDS);
        EXPECT_EQ(find(Qt::Key_Tab), fileOpen) << "nobody has it";
        EXPECT_EQ(dialog.note(), "Tab is unassigned");
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_FIND_KEY);
        EXPECT_EQ(find(Qt::Key_F9), fileOpen);
        EXPECT_EQ(dialog.note(), "F9 is assigned to a command without a menu item");
        EXPECT_EQ(find(Qt::Key_F, Qt::AltModifier), fileOpen);
        EXPECT_EQ(dialog.note(), "Alt+F is assigned to the File menu");
        EXPECT_EQ(find(Qt::Key_G, Qt::ControlModifier), fileExit) << "a character";
        dialog.GetDlgItem(GUI_IDC_ACCEL_FILTER)->SetFocus();
        type("open");
        EXPECT_EQ(find(Qt::Key_Escape), helpAbout) << "the filter gives way";
        EXPECT_EQ(dialog.text(GUI_IDC_ACCEL_FILTER), "");
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        EXPECT_FALSE(dialog.isShown(GUI_IDC_ACCEL_FIND_FIELD));
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        click(dialog.GetDlgItem(GUI_IDC_ACCEL_KEYS));
        EXPECT_FALSE(dialog.isShown(GUI_IDC_ACCEL_FIND_FIELD)) << "the user does something else";
    });
}

TEST(AccelDlg, WorksWithoutTheMouse) {
    Menu menu;
    Dialog dialog(menu);
    const int result = dialog.run([&] {
        key(Qt::Key_Down);
        key(Qt::Key_S, Qt::AltModifier); // Specify
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_HOTKEY);
        key(Qt::Key_Tab);
        key(Qt::Key_K, Qt::ControlModifier);
        EXPECT_EQ(dialog.note(), "Press the key a second time to be done.");
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_HOTKEY);
        key(Qt::Key_K, Qt::ControlModifier);
        EXPECT_EQ(dialog.focus(), GUI_IDC_ACCEL_ASSIGN);
        EXPECT_EQ(dialog.note(), "");
        key(Qt::Key_Space);
        EXPECT_EQ(dialog.keys(), Texts{"Ctrl+K"});
        key(Qt::Key_C, Qt::AltModifier);
        key(Qt::Key_Return); // OK is the default button
    });
    EXPECT_EQ(result, IDOK);
    EXPECT_EQ(commandOf(*dialog.map(), ctrl('K')), exitProgram);
}

TEST(AccelDlg, NamesItsControlsForAssistiveTools) {
    Menu menu;
    Dialog dialog(menu);
    dialog.run([&] {
        dialog.push(GUI_IDC_ACCEL_SPECIFY);
        dialog.push(GUI_IDC_ACCEL_FIND_KEY);
        EXPECT_EQ(accessibleTree(*QAccessible::queryAccessibleInterface(tvx::afx::peerOf(dialog.m_hWnd)->window())),
                  "Dialog \"Keyboard Accelerators\"\n"
                  " StaticText \"Commands\"\n"
                  " List \"Commands\" < Commands\n"
                  "  ListItem \" File Exit\"\n"
                  "  ListItem \" File Open...\"\n"
                  "  ListItem \" Help Deep About\"\n"
                  " StaticText \"Filter\"\n"
                  " EditableText \"Find Key\" < Find Key\n"
                  " Button \"Find Key\"\n"
                  " StaticText \"Current Keys\"\n"
                  " List \"Current Keys\" < Current Keys\n"
                  " Button \"Remove\"\n"
                  " Grouping \"Accelerator Key\"\n"
                  " StaticText \"Type the accelerator key and press the Done button.\"\n"
                  " EditableText \"Type the accelerator key and press the Done button.\" < Type the accelerator key "
                  "and press the Done button.\n"
                  " Button \"Done\"\n"
                  " Button \"Assign\"\n"
                  " StaticText \"Press the key to look for.\"\n"
                  " Button \"Undo\" < Press the key to look for.\n"
                  " Grouping \"Description\"\n"
                  " StaticText \"\"\n"
                  " Button \"OK\" < \n"
                  " Button \"Cancel\"\n"
                  " Button \"Help\"\n"
                  " Button \"Reset\"\n");
    });
}

TEST(AccelDlg, GivesTheResultToAFrameOrACopy) {
    auto* frame = new CFrameWnd;
    ASSERT_TRUE(frame->Create(nullptr, "Frame"));
    Menu menu;
    frame->SetMenu(&menu);
    menu.Detach();
    CMenu& shown = *frame->GetMenu();
    frame->m_hAccelTable = tableOf({ctrl('O', openFile), f9(unlisted)});
    const HACCEL former = frame->m_hAccelTable;
    std::unique_ptr<Gui_AccelMap> copy;
    {
        Gui_AccelDlg untouched(&shown, former, frame);
        untouched.ApplyChangesToFrameWindow(frame);
        EXPECT_EQ(CopyAcceleratorTableA(former, nullptr, 0), 0) << "destroyed";
        EXPECT_EQ(CopyAcceleratorTableA(frame->m_hAccelTable, nullptr, 0), 2);
        Dialog dialog(shown, {ctrl('O', openFile)}, frame);
        dialog.run([&] {
            dialog.choose(GUI_IDC_ACCEL_COMMANDS, fileOpen);
            dialog.choose(GUI_IDC_ACCEL_KEYS, "Ctrl+O");
            dialog.push(GUI_IDC_ACCEL_REMOVE);
            key(Qt::Key_Escape);
        });
        EXPECT_EQ(CopyAcceleratorTableA(frame->m_hAccelTable, nullptr, 0), 2) << "nobody applied anything";
        dialog.ApplyChangesToFrameWindow(frame);
        EXPECT_EQ(frame->m_hAccelTable, nullptr) << "no accelerators, no table";
        copy = dialog.map();
    }
    copy->Add(f9(about)); // it lives on
    CString text;
    shown.GetMenuString(openFile, text, MF_BYCOMMAND);
    EXPECT_STREQ(text, "&Open...");
    frame->DestroyWindow();
}
