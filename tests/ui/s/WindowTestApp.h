#pragma once

#include "s/WinApp.h"

#include <functional>

/// The application object of tests of the library's windows: a host with an icon and a version.
class WindowTestApp : public Gui_WinApp {
public:
    WindowTestApp() : Gui_WinApp("windowtests") {}
    HICON GetAppIcon() override {
        return ::LoadIcon(nullptr, MAKEINTRESOURCE(32515));
    }
    CString GetAppVersion() override {
        return version;
    }
    BOOL OnIdle(LONG count) override {
        if (idle) {
            idle();
        }
        return Gui_WinApp::OnIdle(count);
    }
    CString version = "1.2";
    std::function<void()> idle; ///< called in the idle time
};

extern WindowTestApp windowTestApp;
