// A host whose handlers fail: its command line says which one, and how.
#include "afxwin.h"
#include "platform/port/Exception.h"
#include "platform/port/MsgDispatcher.h"
#include "s/MessageManager.h"
#include "s/WinApp.h"

#include <stdexcept>

namespace {

constexpr UINT idFault = 0x8000;

class FaultyApp : public Gui_WinApp {
public:
    FaultyApp() : Gui_WinApp("faulty") {}
    BOOL InitInstance() override;
    HICON GetAppIcon() override {
        return nullptr;
    }
    CString GetAppVersion() override {
        return "1.0";
    }

    CString m_where; ///< the handler that fails: command, timer, paint, key, close, box
    CString m_how;   ///< what it throws: standard, port, framework, number

private:
    Gui_MessageManager m_boxes;
};

FaultyApp theFaultyApp;

[[noreturn]] void fail() {
    if (theFaultyApp.m_how == "port") {
        throw Port::Exception("The layer table is damaged.");
    }
    if (theFaultyApp.m_how == "framework") {
        AfxThrowMemoryException();
    }
    if (theFaultyApp.m_how == "number") {
        throw 42;
    }
    throw std::runtime_error("The table of shapes has no entry 7.");
}

void failIn(const char* place) {
    if (theFaultyApp.m_where == place) {
        fail();
    }
}

class FaultyFrame : public CFrameWnd {
protected:
    afx_msg void OnFault() {
        failIn("command");
        if (theFaultyApp.m_where == "box") {
            SetTimer(1, 10, nullptr);
        }
        MessageBox("A question meanwhile?", "Question", MB_YESNO);
    }
    // Both fail again and again, also while the user reads why.
    afx_msg void OnTimer(UINT_PTR) {
        if (theFaultyApp.m_where == "paint") {
            Invalidate();
        } else {
            fail();
        }
    }
    afx_msg void OnPaint() {
        CPaintDC dc(this);
        if (theFaultyApp.m_where != "paint") {
            return;
        }
        SetTimer(1, 10, nullptr);
        fail();
    }
    afx_msg void OnKeyDown(UINT, UINT, UINT) {
        failIn("key");
    }
    afx_msg void OnClose() {
        failIn("close");
        CFrameWnd::OnClose();
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(FaultyFrame, CFrameWnd)
    ON_COMMAND(idFault, &FaultyFrame::OnFault)
    ON_WM_TIMER()
    ON_WM_PAINT()
    ON_WM_KEYDOWN()
    ON_WM_CLOSE()
END_MESSAGE_MAP()
// clang-format on

BOOL FaultyApp::InitInstance() {
    SetRegistryKey("Tarvex");
    Port_MsgDispatcher::addMsgMan(&m_boxes);
    CString line(m_lpCmdLine);
    m_where = line.SpanExcluding(" ");
    m_how = line.Mid(m_where.GetLength()).TrimLeft();
    auto* frame = new FaultyFrame;
    m_pMainWnd = frame;
    if (!frame->Create(nullptr, "Faulty", WS_OVERLAPPEDWINDOW, CRect(200, 150, 800, 550))) {
        return FALSE;
    }
    frame->ShowWindow(m_nCmdShow);
    if (m_where == "command" || m_where == "box") {
        frame->PostMessage(WM_COMMAND, idFault);
    }
    if (m_where == "timer") {
        frame->SetTimer(1, 10, nullptr);
    }
    return TRUE;
}

} // namespace
