// The application object with a real window: what becomes of exceptions, the wait cursor, the caption of message boxes.
#include "s/WinApp.h"

#include "platform/port/Exception.h"
#include "platform/port/MsgDispatcher.h"

#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

namespace {

constexpr UINT runBody = WM_APP + 1;

/// A main window that does what a test asks it to in a message handler.
class MainWindow : public CWnd {
public:
    explicit MainWindow(std::function<void()> body) : m_body(std::move(body)) {
        CreateEx(0, AfxRegisterWndClass(0), "test", WS_OVERLAPPEDWINDOW, 10, 10, 200, 100, nullptr, nullptr);
    }

protected:
    LRESULT OnRunBody(WPARAM, LPARAM) {
        m_body();
        AfxPostQuitMessage(0);
        return 0;
    }
    DECLARE_MESSAGE_MAP()

private:
    std::function<void()> m_body;
};

BEGIN_MESSAGE_MAP(MainWindow, CWnd)
ON_MESSAGE(runBody, &MainWindow::OnRunBody)
END_MESSAGE_MAP()

class App : public Gui_WinApp {
public:
    App() : Gui_WinApp("testapp") {}

    /// Runs the application until @p body, called in a handler of the main window, has ended.
    int start(std::function<void()> body) {
        m_body = std::move(body);
        char name[] = "testapp";
        char* arguments[] = {name};
        return AfxWinMain(1, arguments);
    }
    BOOL InitInstance() override {
        SetRegistryKey("Tarvex");
        m_window = std::make_unique<MainWindow>(m_body);
        m_pMainWnd = m_window.get();
        m_pMainWnd->ShowWindow(SW_SHOW);
        m_pMainWnd->PostMessage(runBody);
        return TRUE;
    }
    HICON GetAppIcon() override {
        return nullptr;
    }
    CString GetAppVersion() override {
        return "1.0";
    }
    int DoMessageBox(LPCSTR, UINT, UINT) override {
        boxCaption = m_pszAppName;
        return IDOK;
    }
    CString boxCaption;

private:
    std::function<void()> m_body;
    std::unique_ptr<MainWindow> m_window;
};

App theTestApp;

class Recorder : public Port_MsgMan {
public:
    struct Message {
        MsgType type;
        std::wstring text;
        bool operator==(const Message&) const = default;
    };
    Recorder() : Port_MsgMan("recorder") {
        Port_MsgDispatcher::addMsgMan(this);
    }
    std::vector<Message> messages;

protected:
    void msgWrite(MsgType type, const wchar_t* text) override {
        messages.push_back({type, text});
    }
};

const Recorder::Message fatal{
    Port_MsgMan::MsgTypeFatal,
    L"This application has discovered an exceptional condition from which it cannot recover."};

} // namespace

TEST(WinApp, EndsWithTheLoopsCodeWhenNothingIsThrown) {
    Recorder recorder;
    EXPECT_EQ(theTestApp.start([] {}), 0);
    EXPECT_TRUE(recorder.messages.empty());
}

TEST(WinApp, ReportsAStandardExceptionAndEndsWith1) {
    Recorder recorder;
    EXPECT_EQ(theTestApp.start([] { throw std::runtime_error("100%s lost"); }), 1);
    EXPECT_EQ(recorder.messages, (std::vector<Recorder::Message>{{Port_MsgMan::MsgTypeError, L"100%s lost"}, fatal}));
    EXPECT_EQ(recorder.getAbort(), 1);
}

TEST(WinApp, LetsThePortabilityLibrarysExceptionReportItself) {
    class Damaged : public Port::Exception {
    public:
        Damaged() : Port::Exception("short") {}
        void report() const override {
            Port::Exception("the long story").report();
        }
    };
    Recorder recorder;
    EXPECT_EQ(theTestApp.start([] { throw Damaged(); }), 1);
    EXPECT_EQ(recorder.messages,
              (std::vector<Recorder::Message>{{Port_MsgMan::MsgTypeError, L"the long story"}, fatal}));
}

TEST(WinApp, EndsSilentlyAfterAFrameworkException) {
    Recorder recorder;
    EXPECT_EQ(theTestApp.start([] { AfxThrowUserException(); }), 1);
    EXPECT_TRUE(recorder.messages.empty());
}

TEST(WinApp, ReportsAnythingElseAsFatal) {
    Recorder recorder;
    EXPECT_EQ(theTestApp.start([] { throw 42; }), 1);
    EXPECT_EQ(recorder.messages, std::vector<Recorder::Message>{fatal});
}

TEST(WinApp, TakesItsNamesFromTheTitle) {
    theTestApp.start([] { AfxMessageBox("text"); });
    EXPECT_STREQ(theTestApp.boxCaption, "Tarvex Test Title");
    EXPECT_STREQ(theTestApp.m_pszProfileName, "Test Title");
    EXPECT_STREQ(theTestApp.m_pszRegistryKey, "Tarvex");
    EXPECT_STREQ(AfxGetAppName(), "testapp");
    EXPECT_TRUE(AfxGetApp()->IsKindOf(RUNTIME_CLASS(Gui_WinApp)));
}

TEST(WinApp, RefreshesThePointerWhereItStands) {
    theTestApp.start([] {
        ASSERT_TRUE(SetCursorPos(123, 45));
        for (const int code : {1, 0, -1}) {
            theTestApp.DoWaitCursor(code);
            POINT position;
            ASSERT_TRUE(GetCursorPos(&position));
            EXPECT_EQ(position.x, 123) << code;
            EXPECT_EQ(position.y, 45) << code;
        }
    });
}
