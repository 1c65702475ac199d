#pragma once

#include "s/WinApp.h"

#include <functional>
#include <string>
#include <vector>

/// The application object of the tests: it keeps the message boxes instead of showing them, and starts as often as
/// asked.
class TestApp : public Gui_WinApp {
public:
    struct Box {
        std::string text;
        UINT type;
    };

    TestApp() : Gui_WinApp("testapp") {}

    /// Starts with a command line of these words and runs @p body in place of InitInstance. The result is what the
    /// process would end with.
    int start(std::vector<std::string> words, std::function<void()> body) {
        words.insert(words.begin(), "testapp");
        std::vector<char*> arguments;
        for (std::string& word : words) {
            arguments.push_back(word.data());
        }
        boxes.clear();
        m_body = std::move(body);
        return AfxWinMain(static_cast<int>(arguments.size()), arguments.data());
    }

    BOOL InitInstance() override {
        m_body();
        return FALSE;
    }
    int DoMessageBox(LPCSTR text, UINT type, UINT) override {
        boxes.push_back({text, type});
        return IDOK;
    }
    HICON GetAppIcon() override {
        return nullptr;
    }
    CString GetAppVersion() override {
        return "1.0";
    }

    std::vector<Box> boxes;

private:
    std::function<void()> m_body;
};

extern TestApp theApp;
