#pragma once

#include "platform/afx/core/App.h"

#include <utility>
#include <vector>

/// The application object of these tests. It notes what its help is asked for.
class TestApplication : public CWinApp {
public:
    TestApplication() : CWinApp("Afx tests") {}
    void WinHelpA(DWORD_PTR data, UINT command) override {
        help.emplace_back(data, command);
    }
    std::vector<std::pair<DWORD_PTR, UINT>> help; ///< number and command of each request
};

extern TestApplication testApplication;
