// The console as a user meets it: typed into, recalled, listed, copied from, run again, closed.
#include "s/Console.h"

#include "afxext.h"
#include "platform/afx/core/Clipboard.h"
#include "platform/afx/core/Menu.h"
#include "res/resource.h"
#include "s/ConsoleView.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/s/WindowTestApp.h"

#include <QApplication>
#include <QClipboard>
#include <QMenu>
#include <QMessageBox>
#include <QTest>

#include <gtest/gtest.h>

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace {

using Texts = std::vector<std::string>;

/// What the host does with a command.
std::function<int(const std::string&)> execute;
Texts executed;

int onCommand(const char* text) {
    executed.emplace_back(text);
    return execute(text);
}

class Console : public testing::Test {
protected:
    void SetUp() override {
        executed.clear();
        execute = [this](const std::string& text) {
            console->AddCommand(text.c_str());
            return 1;
        };
        makeConsole();
        auto* frame = new CMDIFrameWnd;
        m_frame = frame;
        windowTestApp.m_pMainWnd = frame;
        ASSERT_TRUE(frame->Create(nullptr, "Host", WS_OVERLAPPEDWINDOW, CRect(0, 0, 700, 500)));
        menu.CreateMenu();
        CMenu popup;
        popup.CreatePopupMenu();
        for (const UINT id : {ID_WINDOW_NEW, ID_FILE_SAVE, ID_FILE_SAVE_AS, ID_EDIT_CUT, ID_EDIT_COPY, ID_EDIT_PASTE,
                              ID_FILE_CLOSE, GUI_ID_CONSOLE_COPY, GUI_ID_CONSOLE_RUN}) {
            popup.AppendMenu(MF_STRING, id, "item");
        }
        menu.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup.Detach()), "Menu");
        frame->SetMenu(&menu);
        frame->ShowWindow(SW_SHOW);
        m_before = number();
    }
    void TearDown() override {
        execute = nullptr;
        if (console && console->IsOpen()) {
            console->Close();
        }
        windowTestApp.m_pMainWnd = nullptr; // or its end would be the application's
        m_frame->DestroyWindow();
        console.reset();
        menu.Detach();
        delete windowTestApp.m_pDocManager;
        windowTestApp.m_pDocManager = nullptr;
    }

    void makeConsole() {
        console.reset();
        console.emplace(onCommand, 0);
        console->Init();
    }
    /// Opens the console and waits until it has the keyboard.
    void open() {
        ASSERT_EQ(1, console->Open());
        ASSERT_TRUE(QTest::qWaitFor([] { return focus() == GUI_IDC_CONSOLE_INPUT; }));
    }

    static Gui_ConsoleView& view() {
        auto* frame = static_cast<CMDIFrameWnd*>(windowTestApp.m_pMainWnd);
        return *dynamic_cast<Gui_ConsoleView*>(frame->MDIGetActive()->GetActiveView());
    }
    static CListBox& list() {
        return *static_cast<CListBox*>(view().GetDlgItem(GUI_IDC_CONSOLE_LINES));
    }
    /// Whether the last line is whole in sight.
    static bool showsEnd() {
        CRect last;
        CRect client;
        list().GetItemRect(list().GetCount() - 1, &last);
        list().GetClientRect(&client);
        return last.top >= 0 && last.bottom <= client.bottom;
    }
    static CEdit& field() {
        return *static_cast<CEdit*>(view().GetDlgItem(GUI_IDC_CONSOLE_INPUT));
    }
    static int focus() {
        const HWND window = ::GetFocus();
        return window ? ::GetDlgCtrlID(window) : 0;
    }
    static std::string text(int id) {
        CString value;
        view().GetDlgItemText(id, value);
        return value.GetString();
    }
    static std::string typed() {
        return text(GUI_IDC_CONSOLE_INPUT);
    }
    /// The number that the next command gets, as the prompt shows it.
    unsigned long number() {
        const bool closed = !console->IsOpen();
        if (closed) {
            open();
        }
        const std::string prompt = text(GUI_IDC_CONSOLE_PROMPT);
        if (closed) {
            console->Close();
        }
        return std::stoul(prompt.substr(prompt.find(' ')));
    }
    /// The lines as assistive tools read them, numbers counted from the test's first command.
    Texts lines() const {
        Texts all;
        for (int i = 0; i < list().GetCount(); ++i) {
            std::string line = list().GetAccessibleText(i).GetString();
            const std::size_t sign = line.find('>');
            if (sign != std::string::npos && line.starts_with("Status") == false) {
                line = std::to_string(std::stoul(line) - m_before + 1) + line.substr(sign);
            }
            all.push_back(line);
        }
        return all;
    }

    static void key(int code, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QTest::keyClick(QApplication::focusWidget(), static_cast<Qt::Key>(code), modifiers);
        QApplication::processEvents();
    }
    static void type(const char* text) {
        QTest::keyClicks(QApplication::focusWidget(), text);
    }
    static void enter(const std::string& text) {
        field().SetWindowText(text.c_str());
        field().SetSel(static_cast<int>(text.size()), static_cast<int>(text.size()));
        key(Qt::Key_Return);
    }
    /// "@" stands for the number before the test's first command.
    void enterNumbered(const std::string& before, unsigned long number, const std::string& behind = {}) {
        enter(before + std::to_string(m_before - 1 + number) + behind);
    }
    static std::string clipboard() {
        return QApplication::clipboard()->text().toStdString();
    }
    /// Whether the menu lets the user choose a command.
    static bool isEnabled(UINT id) {
        CWnd* frame = windowTestApp.m_pMainWnd;
        CMenu* popup = frame->GetMenu()->GetSubMenu(0);
        frame->SendMessage(WM_INITMENUPOPUP, reinterpret_cast<WPARAM>(popup->m_hMenu), 0);
        return (popup->GetMenuState(id, MF_BYCOMMAND) & (MF_GRAYED | MF_DISABLED)) == 0;
    }
    static void select(std::initializer_list<int> lines) {
        list().SetSel(-1, FALSE);
        for (const int line : lines) {
            list().SetSel(line, TRUE);
        }
    }

    std::optional<Gui_Console> console;
    unsigned long m_before = 1;

private:
    CFrameWnd* m_frame = nullptr;
    CMenu menu;
};

} // namespace

// --- typing ---

TEST_F(Console, RunsWhatIsTypedAndKeepsWhatFailed) {
    open();
    type("  run b ");
    key(Qt::Key_Return);
    EXPECT_EQ(Texts{"run b"}, executed);
    EXPECT_EQ("", typed());
    EXPECT_EQ(m_before + 1, number());
    enter(" \t ");
    EXPECT_EQ(" \t ", typed()) << "nothing happens to white space";
    execute = [](const std::string&) { return 0; };
    enter("wrong");
    EXPECT_EQ("wrong", typed());
    execute = [](const std::string&) { return 2; };
    key(Qt::Key_Return);
    EXPECT_EQ("wrong", typed()) << "only 1 is done";
    EXPECT_EQ((Texts{"run b", "wrong", "wrong"}), executed);
    EXPECT_EQ(Texts{"1> run b"}, lines()) << "only the host adds";
}

TEST_F(Console, RecallsAndTellsWhatIsWrongWithARecall) {
    console->AddCommand("open a");
    console->AddCommand("run b");
    open();
    enter("!!");
    enter("!RU");
    enterNumbered("!", 1);
    EXPECT_EQ((Texts{"run b", "run b", "open a"}), executed);
    const struct {
        std::string input;
        UINT help;
        const char* text;
    } cases[] = {
        {"!" + std::to_string(m_before) + "x", GUI_IDS_RECALL_ONE_NUMBER, "only a single command number"},
        {"!0", GUI_IDS_RECALL_NUMBER_RANGE, "between 1 and the last command number."},
        {"! run", GUI_IDS_RECALL_PATTERN_PLACE, "directly after the recall command character"},
        {"!nothing", GUI_IDS_RECALL_NO_MATCH, "no previous command with the pattern you gave."},
    };
    for (const auto& test : cases) {
        windowTestApp.help.clear();
        bool asked = false;
        inDialog([&] {
            auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(nullptr, box);
            EXPECT_TRUE(box->text().contains(test.text)) << box->text().toStdString();
            EXPECT_EQ(QMessageBox::Warning, box->icon());
            key(Qt::Key_F1);
            asked = true;
            key(Qt::Key_Escape);
        });
        enter(test.input);
        EXPECT_TRUE(asked) << test.input;
        ASSERT_EQ(1U, windowTestApp.help.size());
        EXPECT_EQ(HID_BASE_PROMPT + test.help, windowTestApp.help[0].first);
        EXPECT_EQ("", typed()) << "a recall that failed is done with";
    }
    EXPECT_EQ(3U, executed.size());
}

TEST_F(Console, WalksAndSearchesTheCommands) {
    for (const char* command : {"draw line", "list", "list", "draw ellipse"}) {
        console->AddCommand(command);
    }
    open();
    type("half");
    const auto walked = [](int code) {
        key(code);
        return typed();
    };
    EXPECT_EQ("draw ellipse", walked(Qt::Key_Up));
    EXPECT_EQ("list", walked(Qt::Key_Up));
    EXPECT_EQ("draw line", walked(Qt::Key_Up));
    EXPECT_EQ("list", walked(Qt::Key_Down));
    EXPECT_EQ("draw ellipse", walked(Qt::Key_Down));
    EXPECT_EQ("half", walked(Qt::Key_Down));

    const std::string prompt = text(GUI_IDC_CONSOLE_PROMPT);
    key(Qt::Key_R, Qt::ControlModifier);
    type("dra");
    EXPECT_EQ("draw ellipse", typed());
    EXPECT_EQ("Find: dra", text(GUI_IDC_CONSOLE_PROMPT));
    key(Qt::Key_R, Qt::ControlModifier);
    EXPECT_EQ("draw line", typed());
    key(Qt::Key_R, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ("draw ellipse", typed());
    key(Qt::Key_Escape);
    EXPECT_EQ("half", typed());
    EXPECT_EQ(prompt, text(GUI_IDC_CONSOLE_PROMPT));
    key(Qt::Key_R, Qt::ControlModifier);
    type("dra");
    view().GetDlgItem(GUI_IDC_CONSOLE_SHOW_STATUS)->SendMessage(BM_CLICK);
    view().GetDlgItem(GUI_IDC_CONSOLE_SHOW_STATUS)->SendMessage(BM_CLICK);
    key(Qt::Key_Escape);
    EXPECT_EQ(prompt, text(GUI_IDC_CONSOLE_PROMPT)) << "what is searched for is no prompt";

    key(Qt::Key_R, Qt::ControlModifier);
    key(Qt::Key_R, Qt::ControlModifier);
    EXPECT_EQ("Find: ", text(GUI_IDC_CONSOLE_PROMPT)) << "nothing has been looked for yet";
    type("lisx");
    EXPECT_EQ("Not found: lisx", text(GUI_IDC_CONSOLE_PROMPT));
    key(Qt::Key_Return);
    EXPECT_TRUE(executed.empty()) << "what stands there is not what was looked for";
    key(Qt::Key_R, Qt::ControlModifier);
    type("lisx");
    key(Qt::Key_Backspace);
    key(Qt::Key_Return);
    EXPECT_EQ(Texts{"list"}, executed);
}

TEST_F(Console, PastesOneLine) {
    open();
    field().SetWindowText("<>");
    field().SetSel(1, 1);
    QApplication::clipboard()->setText("a\r\nb\nc");
    key(Qt::Key_V, Qt::ControlModifier);
    EXPECT_EQ("<a b c>", typed());
    EXPECT_FALSE(field().CanUndo());
    EXPECT_TRUE(isEnabled(ID_EDIT_PASTE));
    QApplication::clipboard()->clear();
    view().SendMessage(WM_COMMAND, ID_EDIT_PASTE);
    EXPECT_EQ("<a b c>", typed());
    EXPECT_FALSE(isEnabled(ID_EDIT_PASTE));
}

// --- lines ---

TEST_F(Console, ShowsWhatWasAddedWhileItWasClosed) {
    console->AddStatusLine("ready");
    console->AddCommand("open a");
    console->AddStatusLine("opened");
    EXPECT_FALSE(console->IsOpen());
    open();
    EXPECT_EQ(Texts{"1> open a"}, lines());
    EXPECT_EQ("Command " + std::to_string(m_before + 1) + ">", text(GUI_IDC_CONSOLE_PROMPT));
    CString title;
    view().GetParentFrame()->GetWindowText(title);
    EXPECT_STREQ("Console", title);
    console->AddStatusLine("hidden");
    console->SetShowCommandStatusFlag(1);
    EXPECT_EQ(Texts{"1> open a"}, lines()) << "lines that are shown stay as they are";
    EXPECT_EQ(1, view().IsDlgButtonChecked(GUI_IDC_CONSOLE_SHOW_STATUS));
    console->AddStatusLine("shown");
    EXPECT_EQ((Texts{"1> open a", "Status: shown"}), lines());

    view().GetDlgItem(GUI_IDC_CONSOLE_SHOW_STATUS)->SendMessage(BM_CLICK);
    EXPECT_EQ(0, console->GetShowCommandStatusFlag());
    EXPECT_EQ(Texts{"1> open a"}, lines());
    view().GetDlgItem(GUI_IDC_CONSOLE_SHOW_STATUS)->SendMessage(BM_CLICK);
    const Texts all{"Status: ready", "1> open a", "Status: opened", "Status: hidden", "Status: shown"};
    EXPECT_EQ(all, lines());

    console->Close();
    EXPECT_FALSE(console->IsOpen());
    EXPECT_EQ(1, console->GetShowCommandStatusFlag());
    open();
    EXPECT_EQ(all, lines());
    console->SetShowCommandStatusFlag(0);
}

TEST_F(Console, LaysItsControlsOut) {
    open();
    view().GetParentFrame()->MoveWindow(0, 0, 120, 100);
    QApplication::processEvents();
    view().SendMessage(WM_VSCROLL, SB_BOTTOM); // what was scrolled away in a small window comes back in a large one
    view().SendMessage(WM_HSCROLL, SB_RIGHT);
    view().GetParentFrame()->MoveWindow(0, 0, 120, 110);
    view().GetParentFrame()->MoveWindow(0, 0, 500, 400);
    QApplication::processEvents();
    const int h = LOWORD(::GetDialogBaseUnits()) / 4;
    const int v = HIWORD(::GetDialogBaseUnits()) / 8;
    CRect client;
    view().GetClientRect(&client);
    const auto place = [](int id) {
        CRect rect;
        view().GetDlgItem(id)->GetWindowRect(&rect);
        view().ScreenToClient(&rect);
        return rect;
    };
    const CRect input = place(GUI_IDC_CONSOLE_INPUT);
    const CRect box = place(GUI_IDC_CONSOLE_SHOW_STATUS);
    const CRect lines = place(GUI_IDC_CONSOLE_LINES);
    EXPECT_EQ(client.bottom - 7 * v, input.bottom);
    EXPECT_EQ(client.right - 7 * h, input.right);
    EXPECT_EQ(input.top + v, place(GUI_IDC_CONSOLE_PROMPT).top);
    EXPECT_EQ(input.top - 5 * v, box.bottom);
    EXPECT_EQ(CPoint(7 * h, 7 * v), lines.TopLeft());
    EXPECT_EQ(client.right - 7 * h, lines.right);
    EXPECT_EQ(box.top - 5 * v, lines.bottom);
}

TEST_F(Console, KeepsTheEndInSight) {
    for (int i = 0; i < 300; ++i) {
        console->AddCommand("command");
    }
    open();
    EXPECT_TRUE(showsEnd());
    list().SetTopIndex(0);
    console->AddCommand("one more");
    EXPECT_TRUE(showsEnd());
    const int width = list().GetHorizontalExtent();
    console->AddCommand(std::string(200, 'w').c_str());
    EXPECT_GT(list().GetHorizontalExtent(), 2 * width);
    console->AddCommand("short");
    EXPECT_GT(list().GetHorizontalExtent(), 2 * width) << "it only grows";
}

// The bar comes up with the long line.
TEST_F(Console, KeepsTheEndAboveTheBarForLongLines) {
    for (int i = 0; i < 60; ++i) {
        console->AddCommand("command");
    }
    console->AddStatusLine(std::string(200, 'w').c_str());
    open();
    CWnd& box = *view().GetDlgItem(GUI_IDC_CONSOLE_SHOW_STATUS);
    for (const int shown : {1, 0, 1}) {
        box.SendMessage(BM_CLICK);
        QTest::qWait(0);
        EXPECT_TRUE(showsEnd()) << shown;
    }
}

// --- what is selected ---

TEST_F(Console, CopiesAndRunsTheSelectedCommands) {
    console->AddCommand("open a");
    console->AddStatusLine("opened");
    console->AddCommand("!run");
    console->AddCommand("run b");
    console->SetShowCommandStatusFlag(1);
    open();
    list().SetFocus();
    EXPECT_FALSE(isEnabled(GUI_ID_CONSOLE_COPY));
    EXPECT_FALSE(isEnabled(ID_EDIT_COPY));
    select({1});
    EXPECT_FALSE(isEnabled(GUI_ID_CONSOLE_COPY)) << "a status line is no command";
    EXPECT_FALSE(isEnabled(GUI_ID_CONSOLE_RUN));
    key(Qt::Key_Home);
    key(Qt::Key_Down, Qt::ShiftModifier);
    key(Qt::Key_End, Qt::ShiftModifier);
    EXPECT_EQ(4, list().GetSelCount());
    EXPECT_TRUE(isEnabled(ID_EDIT_COPY));
    EXPECT_FALSE(isEnabled(ID_EDIT_CUT));
    key(Qt::Key_C, Qt::ControlModifier);
    EXPECT_TRUE(clipboard() == "open a\n!run\nrun b\n" || clipboard() == "open a\r\n!run\r\nrun b\r\n") << clipboard();
    key(Qt::Key_Return);
    EXPECT_EQ((Texts{"open a", "run b", "run b"}), executed) << "a recall that was added as a command recalls";
    EXPECT_EQ(7, list().GetCount());
    for (const UINT never : {ID_WINDOW_NEW, ID_FILE_SAVE, ID_FILE_SAVE_AS}) {
        EXPECT_FALSE(isEnabled(never)) << never;
    }
    console->SetShowCommandStatusFlag(0);
}

TEST_F(Console, ServesTheClipboardOfItsField) {
    console->AddCommand("open a");
    open();
    EXPECT_FALSE(isEnabled(ID_EDIT_COPY));
    EXPECT_FALSE(isEnabled(ID_EDIT_CUT));
    field().SetWindowText("some text");
    field().SetSel(0, 4);
    select({0});
    EXPECT_TRUE(isEnabled(ID_EDIT_COPY));
    view().SendMessage(WM_COMMAND, ID_EDIT_COPY);
    EXPECT_EQ("some", clipboard());
    EXPECT_TRUE(isEnabled(ID_EDIT_CUT));
    view().SendMessage(WM_COMMAND, ID_EDIT_CUT);
    EXPECT_EQ(" text", typed());
}

TEST_F(Console, OffersTheCommandsInAMenu) {
    console->AddCommand("open a");
    console->AddCommand("run b");
    open();
    list().SetFocus();
    select({1});
    list().SetCaretIndex(1);
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&] {
        if (auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget())) {
            timer.stop();
            CRect row;
            list().GetItemRect(1, &row);
            list().ClientToScreen(&row);
            EXPECT_NEAR(menu->y(), row.bottom, 3) << "at the current line";
            QTest::keyClick(menu, Qt::Key_Up);
            QTest::keyClick(menu, Qt::Key_Return);
        }
    });
    timer.start(0);
    list().SendMessage(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(list().m_hWnd), MAKELPARAM(-1, -1));
    QApplication::processEvents();
    EXPECT_FALSE(timer.isActive());
    EXPECT_EQ(Texts{"run b"}, executed);
}

TEST_F(Console, DrawsSelectedLinesInSwappedColors) {
    console->AddCommand("open a");
    const auto corner = [] {
        QApplication::processEvents();
        CRect row;
        list().GetItemRect(0, &row);
        CClientDC dc(&list());
        return dc.GetPixel(row.left, row.top);
    };
    const QPalette light = QApplication::palette();
    QPalette dark = light;
    dark.setColor(QPalette::Base, QColor(16, 16, 16));
    dark.setColor(QPalette::Text, QColor(240, 240, 240));
    for (const QPalette& palette : {light, dark}) {
        QApplication::setPalette(palette);
        open();
        const QColor base = palette.color(QPalette::Base);
        const QColor text = palette.color(QPalette::Text);
        EXPECT_EQ(RGB(base.red(), base.green(), base.blue()), corner());
        select({0});
        EXPECT_EQ(RGB(text.red(), text.green(), text.blue()), corner());
        select({});
        EXPECT_EQ(RGB(base.red(), base.green(), base.blue()), corner());
        console->Close();
    }
    QApplication::setPalette(light);
}

// --- life ---

TEST_F(Console, SurvivesWhatACommandDoes) {
    open();
    execute = [this](const std::string& text) {
        if (text == "close") {
            console->Close();
        } else if (text == "reopen") {
            console->Close();
            console->Open();
        } else if (text == "nested") {
            // Keys that come while a command runs are typed, and run nothing.
            type("more");
            key(Qt::Key_Return);
        } else if (text == "edit") {
            field().SetWindowText("another text");
        } else if (text == "fail") {
            throw std::runtime_error("host");
        }
        return 1;
    };
    enter("close");
    EXPECT_FALSE(console->IsOpen());
    open();
    enter("reopen");
    EXPECT_TRUE(console->IsOpen());
    EXPECT_EQ("", typed());
    enter("nested");
    EXPECT_EQ("more", typed());
    enter("edit");
    EXPECT_EQ("another text", typed()) << "not what was run";
    EXPECT_EQ((Texts{"close", "reopen", "nested", "edit"}), executed);
    const CWnd* const frame = view().GetParentFrame();
    EXPECT_EQ(1, console->Open());
    EXPECT_EQ(frame, view().GetParentFrame()) << "an open console is activated";
    view().SendMessage(WM_COMMAND, ID_FILE_CLOSE);
    EXPECT_FALSE(console->IsOpen());
    EXPECT_EQ(0, console->Close());

    console->AddCommand("fail");
    open();
    select({0});
    for (int i = 0; i < 2; ++i) {
        EXPECT_THROW(view().SendMessage(WM_COMMAND, GUI_ID_CONSOLE_RUN), std::runtime_error) << "time " << i;
    }
}

TEST_F(Console, RunsSelectedCommandsUntilOneClosesIt) {
    console->AddCommand("close");
    console->AddCommand("never");
    open();
    execute = [this](const std::string&) {
        console->Close();
        return 1;
    };
    select({0, 1});
    view().SendMessage(WM_COMMAND, GUI_ID_CONSOLE_RUN);
    EXPECT_EQ(Texts{"close"}, executed);
    execute = [this](const std::string&) {
        console.reset();
        return 1;
    };
    open();
    select({0, 1});
    view().SendMessage(WM_COMMAND, GUI_ID_CONSOLE_RUN);
    EXPECT_EQ((Texts{"close", "close"}), executed) << "who ends the console runs nothing more";
    EXPECT_EQ(0, list().GetCount());
}

TEST_F(Console, MayEndBeforeItsWindow) {
    console->AddCommand("open a");
    open();
    key(Qt::Key_R, Qt::ControlModifier);
    console.reset();
    EXPECT_EQ(0, list().GetCount());
    type("o");
    key(Qt::Key_Backspace);
    key(Qt::Key_Escape);
    enter("nobody");
    key(Qt::Key_Up);
    key(Qt::Key_R, Qt::ControlModifier);
    EXPECT_TRUE(executed.empty());
    makeConsole();
    EXPECT_TRUE(console->IsOpen());
    enter("run b");
    EXPECT_EQ(Texts{"run b"}, executed);

    console.reset();
    console.emplace(nullptr, 0);
    enter("nobody");
    EXPECT_EQ("", typed()) << "nothing to run is done";
    console->SetShowCommandStatusFlag(1);
    EXPECT_EQ(1, console->AddCommand(nullptr));
    EXPECT_EQ(1, console->AddStatusLine(nullptr));
    EXPECT_EQ(2, list().GetCount());
    console->SetShowCommandStatusFlag(0);
}

TEST_F(Console, KeepsRecallTextsOverRestartsWhenTheHostSaysSo) {
    open();
    enter("before");
    console->SetKeepRecallFlag(1);
    EXPECT_EQ(1, console->GetKeepRecallFlag());
    const std::string odd = "path C:\\new\\x 100%";
    enter(odd);
    enter("list");
    enter("list");
    console->SetKeepRecallFlag(1); // which it is
    for (const std::string& older : {std::string("list"), odd, std::string("before"), std::string("before")}) {
        key(Qt::Key_Up);
        EXPECT_EQ(older, typed()) << "each command once";
    }
    field().SetWindowText("");
    execute = [](const std::string&) { return 0; };
    enter("wrong");
    console->Close();
    makeConsole();
    open();
    EXPECT_EQ(0, list().GetCount()) << "texts, not lines";
    key(Qt::Key_Up);
    EXPECT_EQ("list", typed());
    key(Qt::Key_Up);
    EXPECT_EQ(odd, typed());
    key(Qt::Key_Up);
    EXPECT_EQ(odd, typed()) << "nothing was kept before";
    console->SetKeepRecallFlag(0);
    console->SetKeepRecallFlag(1);
    key(Qt::Key_Up);
    EXPECT_EQ(odd, typed()) << "turned off means forgotten";
    console->SetKeepRecallFlag(0);
}
