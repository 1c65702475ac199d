// A second process with one frame window, for tests of what one process does with another's windows. It writes the
// window's handle as a number and a line end, and ends when its standard input does.
#include "afxwin.h"
#include "platform/afx/core/detail/DesktopAnswers.h"
#include "platform/afx/core/detail/Window.h"

#include <QCoreApplication>
#include <QSocketNotifier>
#include <QTimer>
#include <QWindow>

#include <cstdio>
#include <memory>

using namespace tvx::afx;

namespace {

class PeerApp : public CWinApp {
public:
    PeerApp() : CWinApp("peer") {}

    BOOL InitInstance() override {
        auto* frame = new CFrameWnd;
        m_pMainWnd = frame;
        if (!frame->Create(nullptr, "Peer", WS_OVERLAPPEDWINDOW, CRect(40, 40, 340, 240))) {
            return FALSE;
        }
        frame->ShowWindow(SW_SHOW);
        m_input = std::make_unique<QSocketNotifier>(0, QSocketNotifier::Read);
        QObject::connect(m_input.get(), &QSocketNotifier::activated, [] {
            if (std::getchar() == EOF) {
                AfxPostQuitMessage(0);
            }
        });
        tellWhenSettled(*frame);
        return TRUE;
    }
    int ExitInstance() override {
        m_input.reset();
        return CWinApp::ExitInstance();
    }

private:
    /// The toolkit asks for the activation of a new window only when that is mapped, which may be after the window
    /// manager has activated it. Such a late request would undo what others do with the window.
    void tellWhenSettled(const CFrameWnd& frame) {
        const QWindow* native = frame.GetState()->widget()->windowHandle();
        while (!native->isExposed()) {
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        }
        m_settled.setSingleShot(true);
        QObject::connect(&m_settled, &QTimer::timeout, [handle = frame.m_hWnd] {
            std::printf("%zu\n", reinterpret_cast<std::size_t>(handle));
            std::fflush(stdout);
        });
        startWhenDesktopHasAnswered(m_settled);
    }

    std::unique_ptr<QSocketNotifier> m_input;
    QTimer m_settled;
};

PeerApp theApp;

} // namespace
