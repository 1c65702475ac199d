// A second process with one frame window, for tests of what one process does with another's windows. It writes the
// window's handle as a number and a line end, and ends when its standard input does.
#include "afxwin.h"

#include <QSocketNotifier>

#include <cstdio>
#include <memory>

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
        std::printf("%zu\n", reinterpret_cast<std::size_t>(frame->m_hWnd));
        std::fflush(stdout);
        return TRUE;
    }
    int ExitInstance() override {
        m_input.reset();
        return CWinApp::ExitInstance();
    }

private:
    std::unique_ptr<QSocketNotifier> m_input;
};

PeerApp theApp;

} // namespace
