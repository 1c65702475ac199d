// The main frames of the family, of one document and of many: title, where they come up, what a close keeps, help.
#include "s/FrameWnd.h"

#include "afxext.h"
#include "s/Desktop.h"
#include "s/MDIFrameWnd.h"
#include "s/Profile.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/afx/frames/SettingsFolder.h"
#include "tests/ui/s/WindowTestApp.h"

#include <QApplication>
#include <QTest>

#include <gtest/gtest.h>

#include <string>

namespace {

constexpr UINT resources = 128;

/// A document that its user does not want to lose.
class UnsavedDocument : public CDocument {
public:
    BOOL CanCloseFrame(CFrameWnd*) override {
        return FALSE;
    }
};

/// A host's frame with a bar. It ends with the object, so that a test sees it go.
template <class Base>
class Host : public Base {
public:
    Host() {
        load(resources);
        this->EnableDocking(CBRS_ALIGN_ANY);
        bar.CreateEx(this, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP);
        bar.EnableDocking(CBRS_ALIGN_ANY);
        this->DockControlBar(&bar);
        windowTestApp.m_pMainWnd = this;
    }
    ~Host() override {
        windowTestApp.m_pMainWnd = nullptr; // or its end would be the application's
        this->DestroyWindow();
    }
    BOOL load(UINT id) {
        return this->LoadFrame(id);
    }
    CDocument* GetActiveDocument() override {
        return document;
    }
    bool close() {
        const CWnd* main = std::exchange(windowTestApp.m_pMainWnd, nullptr);
        this->SendMessage(WM_CLOSE);
        windowTestApp.m_pMainWnd = const_cast<CWnd*>(main);
        return !this->m_hWnd;
    }
    CRect place() {
        CRect rect;
        this->GetWindowRect(rect);
        return rect;
    }
    /// Its corner; of borders this display learns only after a while.
    CPoint corner() {
        return place().TopLeft();
    }
    void placeAt(const CRect& rect) {
        this->MoveWindow(rect);
        QTest::qWait(0);
    }
    CToolBar bar;
    CDocument* document = nullptr;

protected:
    void PostNcDestroy() override {}
};

template <class Base>
class MainFrame : public testing::Test {
protected:
    void SetUp() override {
        windowTestApp.SetRegistryKey("Tarvex");
        windowTestApp.help.clear();
    }
    void TearDown() override {
        windowTestApp.UnregisterInstance();
    }
    static std::string stored(const char* section, const char* entry) {
        return windowTestApp.GetProfileString(section, entry).GetString();
    }
    static void store(const std::string& placement) {
        windowTestApp.WriteProfileString("Settings", "WindowPlacement", placement.c_str());
    }

    SettingsFolder settings;
};

using Frames = testing::Types<Gui_FrameWnd, Gui_MDIFrameWnd>;
TYPED_TEST_SUITE(MainFrame, Frames);

} // namespace

TYPED_TEST(MainFrame, HasTheFamilysTitle) {
    Host<TypeParam> frame;
    CString text;
    frame.GetWindowText(text);
    EXPECT_EQ(text, "Tarvex Frames");
    EXPECT_EQ(frame.GetTitle(), "Tarvex Frames");
    EXPECT_STREQ(frame.GetRuntimeClass()->m_lpszClassName,
                 RUNTIME_CLASS(TypeParam)->m_lpszClassName); // the host's class has none of its own
    class Bare : public TypeParam {};
    EXPECT_FALSE((new Bare)->LoadFrame(resources + 1)) << "no such menu: the object is gone";
}

TYPED_TEST(MainFrame, ComesUpWhereItWasClosed) {
    {
        Host<TypeParam> frame;
        frame.ActivateFrame();
        frame.placeAt(CRect(90, 80, 490, 380));
        frame.CFrameWnd::DockControlBar(&frame.bar, AFX_IDW_DOCKBAR_LEFT);
        ASSERT_TRUE(frame.close());
    }
    {
        windowTestApp.RegisterInstance();
        Host<TypeParam> frame;
        frame.ActivateFrame();
        EXPECT_EQ(frame.corner(), CPoint(90, 80));
        EXPECT_EQ(frame.bar.GetDockSide(), UINT{AFX_IDW_DOCKBAR_LEFT});
        unsigned long window = 0;
        Gui_Profile::ReadFirstInstanceInfo("windowtests", "WindowID", window);
        EXPECT_EQ(window, Gui_Desktop::GetMainWindowID());
        frame.placeAt(CRect(10, 10, 300, 300));
        frame.ActivateFrame();
        EXPECT_EQ(frame.corner(), CPoint(10, 10)) << "only the first time";
        frame.ShowWindow(SW_SHOWMAXIMIZED);
        ASSERT_TRUE(frame.close());
    }
    Host<TypeParam> frame;
    frame.ActivateFrame(SW_SHOWNORMAL);
    EXPECT_TRUE(frame.IsZoomed()) << "whatever the caller asks for";
    frame.ShowWindow(SW_RESTORE);
    EXPECT_EQ(frame.corner(), CPoint(10, 10));
}

TYPED_TEST(MainFrame, IsSeenWhateverIsKept) {
    const std::string screen =
        std::to_string(GetSystemMetrics(SM_CXSCREEN)) + "," + std::to_string(GetSystemMetrics(SM_CYSCREEN));
    for (const std::string& kept :
         {std::string("damaged"), "0,0,-1,-1,-1,-1,10,20,300,400," + screen, "0,-7,-1,-1,-1,-1,10,20,300,400," + screen,
          "0,1,-1,-1,-1,-1,5000,4000,5600,4500," + screen, "0,1,-1,-1,-1,-1,400,300,100,100," + screen,
          std::string("0,1,-1,-1,-1,-1,10,20,300,400,99,99")}) {
        this->store(kept);
        Host<TypeParam> frame;
        frame.ActivateFrame();
        EXPECT_TRUE(frame.IsWindowVisible()) << kept;
        const CRect screenRect(0, 0, GetSystemMetrics(SM_CXSCREEN), GetSystemMetrics(SM_CYSCREEN));
        EXPECT_TRUE(CRect().IntersectRect(screenRect, frame.place())) << kept;
    }
}

TYPED_TEST(MainFrame, KeepsItsPlaceAlsoWhenTheUserKeepsItOpen) {
    UnsavedDocument document;
    Host<TypeParam> frame;
    frame.ActivateFrame();
    frame.placeAt(CRect(33, 44, 333, 344));
    frame.document = &document;
    EXPECT_FALSE(frame.close());
    EXPECT_NE(this->stored("Settings", "WindowPlacement").find(",33,44,333,344,"), std::string::npos);
    EXPECT_EQ(this->stored("ControlBar-Summary", "Bars"), "1");
    frame.document = nullptr;
    setenv("TVX_REGISTRY", "/dev/null/registry.db", 1);
    tvx::registry::closeStores();
    inDialog([] { QTest::keyClick(QApplication::activeModalWidget(), Qt::Key_Return); }); // which tells so
    EXPECT_TRUE(frame.close()) << "also when nothing can be kept";
}

TYPED_TEST(MainFrame, AnswersTheHelpKeyInMenusOnly) {
    Host<TypeParam> frame;
    frame.ActivateFrame();
    HELPINFO info{};
    info.cbSize = sizeof info;
    info.iContextType = HELPINFO_WINDOW;
    info.hItemHandle = frame.bar.m_hWnd;
    EXPECT_TRUE(frame.bar.SendMessage(WM_HELP, 0, reinterpret_cast<LPARAM>(&info)));
    EXPECT_TRUE(windowTestApp.help.empty());
    frame.SendMessage(WM_COMMAND, ID_HELP);
    ASSERT_EQ(windowTestApp.help.size(), 1U) << "a key that is a command asks";
    EXPECT_EQ(windowTestApp.help[0].first, DWORD_PTR{HID_BASE_RESOURCE + resources});
    info.iContextType = HELPINFO_MENUITEM;
    info.iCtrlId = ID_APP_EXIT;
    EXPECT_TRUE(frame.SendMessage(WM_HELP, 0, reinterpret_cast<LPARAM>(&info)));
    ASSERT_EQ(windowTestApp.help.size(), 2U);
    EXPECT_EQ(windowTestApp.help[1].first, DWORD_PTR{HID_BASE_COMMAND + ID_APP_EXIT});
}

namespace {

/// A host whose map routes what the library's does not.
class RoutingFrame : public Host<Gui_MDIFrameWnd> {
protected:
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(RoutingFrame, Gui_MDIFrameWnd)
    ON_WM_SYSCOMMAND()
    ON_WM_ERASEBKGND()
END_MESSAGE_MAP()
// clang-format on

} // namespace

TEST(MdiMainFrame, DocksABarByASystemCommand) {
    const SettingsFolder settings;
    RoutingFrame frame;
    frame.ActivateFrame();
    CToolBar other;
    other.CreateEx(&frame, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP, CRect(), AFX_IDW_TOOLBAR + 1);
    other.EnableDocking(CBRS_ALIGN_ANY);
    frame.CMDIFrameWnd::DockControlBar(&other); // the base's: nobody has noted it
    const auto ask = [&frame](const CToolBar& bar) {
        frame.SendMessage(WM_SYSCOMMAND, SC_KEYMENU, reinterpret_cast<LPARAM>(bar.m_hWnd));
    };
    ask(other);
    ask(frame.bar);
    EXPECT_TRUE(frame.bar.IsFloating());
    EXPECT_FALSE(other.IsFloating());
    ask(frame.bar);
    EXPECT_FALSE(frame.bar.IsFloating());
    frame.SendMessage(WM_SYSCOMMAND, SC_MAXIMIZE);
    EXPECT_TRUE(frame.IsZoomed()) << "everything else is the base's";
}
