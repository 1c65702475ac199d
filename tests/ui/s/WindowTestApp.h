#pragma once

#include "s/WinApp.h"

#include <functional>
#include <string>
#include <utility>
#include <vector>

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

    /// The hooks of the file dialogs note that they are asked.
    /// @{
    HWND GetOwnerForFileDialog() override {
        asked.emplace_back("owner");
        return Gui_WinApp::GetOwnerForFileDialog();
    }
    CString GetInitialDirForFileDialog(const CString& fileName) override {
        asked.emplace_back("folder");
        return Gui_WinApp::GetInitialDirForFileDialog(fileName);
    }
    CString GetBaseNameForFileDialog(const CString& fileName) override {
        asked.emplace_back("name");
        return Gui_WinApp::GetBaseNameForFileDialog(fileName);
    }
    CString GetFilterForFileDialog(CDocTemplate* docTemplate, int addAllFiles) override {
        asked.emplace_back("filter");
        return Gui_WinApp::GetFilterForFileDialog(docTemplate, addAllFiles);
    }
    CString GetDefaultExtForFileDialog(CDocTemplate* docTemplate) override {
        asked.emplace_back("extension");
        return Gui_WinApp::GetDefaultExtForFileDialog(docTemplate);
    }
    CString GetTitleForFileDialog(unsigned int titleId) override {
        asked.emplace_back("title");
        return Gui_WinApp::GetTitleForFileDialog(titleId);
    }
    unsigned int GetFlagsForFileDialog(unsigned int flags) override {
        asked.emplace_back("flags");
        return Gui_WinApp::GetFlagsForFileDialog(flags);
    }
    CString GetPathNameFromFileDialog(CFileDialog& dialog) override {
        asked.emplace_back("path");
        return Gui_WinApp::GetPathNameFromFileDialog(dialog);
    }
    /// @}

    std::vector<std::string> asked; ///< what the file dialogs asked for, in order
    void WinHelpA(DWORD_PTR data, UINT command) override {
        help.emplace_back(data, command);
    }
    CString version = "1.2";
    std::vector<std::pair<DWORD_PTR, UINT>> help; ///< number and command of each request
    std::function<void()> idle;                   ///< called in the idle time
};

extern WindowTestApp windowTestApp;
