// The command palette as a user meets it.
#include "s/CommandPalette.h"

#include "res/resource.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <string>
#include <vector>

namespace {

using Texts = std::vector<std::string>;

constexpr UINT front = 0x8001;
constexpr UINT back = 0x8002;
constexpr UINT rectangle = 0x8003;
constexpr UINT grid = 0x8004;
constexpr UINT nobody = 0x8005; // without a handler

/// A frame with a menu that notes the commands it gets.
class Frame : public CFrameWnd {
public:
    std::vector<UINT> commands;
    bool boxed = true;

    static Frame* make() {
        auto* frame = new Frame;
        EXPECT_TRUE(frame->Create(nullptr, "Frame", WS_OVERLAPPEDWINDOW, CRect(0, 0, 600, 500)));
        const HMENU edit = ::CreatePopupMenu();
        ::AppendMenu(edit, MF_STRING, front, "Bring to &Front\tCtrl+F");
        ::AppendMenu(edit, MF_STRING, back, "Send to &Back");
        ::AppendMenu(edit, MF_STRING, nobody, "Nobody's");
        const HMENU draw = ::CreatePopupMenu();
        ::AppendMenu(draw, MF_STRING, rectangle, "&Rectangle");
        ::AppendMenu(draw, MF_STRING, grid, "&Grid");
        ::AppendMenu(draw, MF_STRING, GUI_ID_HELP_ABOUT, "&About");
        CMenu bar;
        bar.CreateMenu();
        bar.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(edit), "&Edit");
        bar.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(draw), "&Draw");
        frame->SetMenu(&bar);
        bar.Detach();
        const tagACCEL accels[] = {{FVIRTKEY, VK_F9, static_cast<WORD>(rectangle)}, {FVIRTKEY, VK_DELETE, back}};
        frame->m_hAccelTable = CreateAcceleratorTableA(accels, 2);
        frame->ShowWindow(SW_SHOW);
        frame->SetActiveWindow();
        EXPECT_TRUE(waitForActive(*frame));
        return frame;
    }

protected:
    afx_msg BOOL note(UINT id) {
        commands.push_back(id);
        return TRUE;
    }
    afx_msg void updateGrid(CCmdUI* item) {
        item->SetCheck(1);
    }
    afx_msg void updateBack(CCmdUI* item) {
        item->Enable(boxed);
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(Frame, CFrameWnd)
    ON_COMMAND_EX(front, &Frame::note)
    ON_COMMAND_EX(back, &Frame::note)
    ON_COMMAND_EX(rectangle, &Frame::note)
    ON_COMMAND_EX(grid, &Frame::note)
    ON_COMMAND_EX(GUI_ID_HELP_ABOUT, &Frame::note)
    ON_UPDATE_COMMAND_UI(grid, &Frame::updateGrid)
    ON_UPDATE_COMMAND_UI(back, &Frame::updateBack)
END_MESSAGE_MAP()
// clang-format on

class CommandPalette : public testing::Test {
protected:
    void SetUp() override {
        m_frame = Frame::make();
    }
    void TearDown() override {
        m_frame->DestroyWindow();
        DestroyAcceleratorTable(m_accelerators);
    }
    void open() {
        ASSERT_EQ(Gui_CommandPalette::Open(m_frame), 1);
        m_palette = CWnd::GetActiveWindow();
        if (m_palette == m_frame || !m_palette) {
            ASSERT_TRUE(QTest::qWaitFor([&] {
                m_palette = CWnd::GetActiveWindow();
                return m_palette && m_palette != m_frame;
            }));
        }
        m_handle = m_palette->m_hWnd;
    }
    CListBox& list() const {
        return *static_cast<CListBox*>(m_palette->GetDlgItem(GUI_IDC_PALETTE_COMMANDS));
    }
    Texts lines() const {
        Texts texts;
        for (int i = 0; i < list().GetCount(); ++i) {
            CString text;
            list().GetText(i, text);
            texts.emplace_back(text.GetString());
        }
        return texts;
    }
    std::string prompt() const {
        return textOf(m_palette->GetDlgItem(GUI_IDC_PALETTE_PROMPT));
    }
    [[nodiscard]] bool isClosed() const {
        return QTest::qWaitFor([this] { return !::IsWindow(m_handle); });
    }
    /// The command that arrives next.
    UINT nextCommand() {
        EXPECT_TRUE(isClosed());
        EXPECT_TRUE(QTest::qWaitFor([this] { return !m_frame->commands.empty(); }));
        return m_frame->commands.empty() ? 0 : std::exchange(m_frame->commands, {}).front();
    }

    Frame* m_frame = nullptr;
    CWnd* m_palette = nullptr;
    HWND m_handle = nullptr;
    HACCEL m_accelerators = nullptr;
};

// The first of all: what was run stands above the rest from then on.
TEST_F(CommandPalette, NamesItsControlsForAssistiveTools) {
    open();
    EXPECT_EQ(accessibleTree(*QAccessible::queryAccessibleInterface(tvx::afx::peerOf(m_handle)->window())),
              "Dialog \"Commands\"\n"
              " StaticText \"Words or first letters of a command\"\n"
              " EditableText \"Words or first letters of a command\" < Words or first letters of a command\n"
              " StaticText \"Commands\"\n"
              " List \"Commands\" < Commands\n"
              "  ListItem \"Edit: Bring to Front, Ctrl+F\"\n"
              "  ListItem \"Edit: Send to Back, Delete\"\n"
              "  ListItem \"Edit: Nobody's, unavailable\"\n"
              "  ListItem \"Draw: Rectangle, F9\"\n"
              "  ListItem \"Draw: Grid, checked\"\n"
              "  ListItem \"Draw: About\"\n"
              " StaticText \"\"\n");
}

TEST_F(CommandPalette, FindsWhatIsTypedAndRunsIt) {
    open();
    EXPECT_EQ(lines(),
              (Texts{"Edit: Bring to Front, Ctrl+F", "Edit: Send to Back, Delete", "Edit: Nobody's, unavailable",
                     "Draw: Rectangle, F9", "Draw: Grid, checked", "Draw: About"}));
    type("bf");
    EXPECT_EQ(lines(), Texts{"Edit: Bring to Front, Ctrl+F"});
    key(Qt::Key_A, Qt::ControlModifier);
    type("dra rec");
    EXPECT_EQ(lines(), Texts{"Draw: Rectangle, F9"});
    EXPECT_TRUE(m_frame->commands.empty());
    key(Qt::Key_Return);
    EXPECT_EQ(nextCommand(), rectangle);
    EXPECT_TRUE(waitForActive(*m_frame));

    open();
    EXPECT_EQ(lines().front(), "Draw: Rectangle, F9") << "what was run last";
    type("about");
    EXPECT_EQ(prompt(), "Display program information and copyright");
    key(Qt::Key_A, Qt::ControlModifier);
    type("xyz");
    EXPECT_EQ(lines(), Texts{});
    EXPECT_EQ(prompt(), "No command matches.");
    key(Qt::Key_Down);
    key(Qt::Key_Return);
    key(Qt::Key_Escape);
    EXPECT_TRUE(isClosed());
    EXPECT_TRUE(m_frame->commands.empty());
}

TEST_F(CommandPalette, KeysMoveTheSelectionWhileTheFieldIsTyped) {
    open();
    const int last = list().GetCount() - 1;
    const std::vector<std::pair<Qt::Key, int>> steps = {
        {Qt::Key_Down, 1},   {Qt::Key_Up, 0},     {Qt::Key_Up, last},       {Qt::Key_Down, 0},
        {Qt::Key_End, last}, {Qt::Key_PageUp, 0}, {Qt::Key_PageDown, last}, {Qt::Key_Home, 0}};
    for (const auto& [pressed, line] : steps) {
        key(pressed);
        EXPECT_EQ(list().GetCurSel(), line) << pressed;
        EXPECT_EQ(CWnd::GetFocus()->GetDlgCtrlID(), GUI_IDC_PALETTE_TEXT);
    }
    key(Qt::Key_Delete); // the field's, not the frame's accelerator
    EXPECT_TRUE(m_frame->commands.empty());
    key(Qt::Key_Down);
    key(Qt::Key_Return);
    EXPECT_NE(nextCommand(), 0u);
}

TEST_F(CommandPalette, RunsNothingThatIsGreyed) {
    m_frame->boxed = false;
    open();
    type("back");
    EXPECT_EQ(lines(), Texts{"Edit: Send to Back, Delete, unavailable"});
    EXPECT_EQ(prompt(), "Unavailable now. ");
    key(Qt::Key_Return);
    EXPECT_TRUE(::IsWindow(m_handle));
    key(Qt::Key_Escape);
    EXPECT_TRUE(isClosed());
    EXPECT_TRUE(m_frame->commands.empty());
    m_frame->boxed = true;
    open();
    type("back");
    key(Qt::Key_Return);
    EXPECT_EQ(nextCommand(), back);
}

TEST_F(CommandPalette, RunsWhatIsClickedAndClosesWhenTheUserTurnsAway) {
    open();
    CRect item;
    type("grid");
    list().GetItemRect(0, &item);
    click(&list(), QPoint(item.CenterPoint().x, item.CenterPoint().y));
    EXPECT_EQ(nextCommand(), grid);
    open();
    m_frame->SetActiveWindow();
    EXPECT_TRUE(isClosed());
    EXPECT_TRUE(m_frame->commands.empty());
}

TEST_F(CommandPalette, EndsWithItsFrameAndNeedsAMenu) {
    EXPECT_EQ(Gui_CommandPalette::Open(nullptr), 0);
    open();
    auto* other = new CFrameWnd;
    ASSERT_TRUE(other->Create(nullptr, "No menu"));
    EXPECT_EQ(Gui_CommandPalette::Open(other), 0);
    other->DestroyWindow();
    m_frame->DestroyWindow();
    EXPECT_FALSE(::IsWindow(m_handle));
    m_frame = Frame::make();
}

} // namespace
