#include "s/MainFrameRecord.h"

#include "afxext.h"
#include "platform/win/Registry.h"
#include "res/resource.h"
#include "s/Desktop.h"
#include "s/Msg.h"
#include "s/Profile.h"
#include "s/WinApp.h"

#include <algorithm>
#include <utility>

void Gui_MainFrameRecord::SetFamilyTitle(CFrameWnd& frame) {
    CString application;
    application.LoadString(AFX_IDS_APP_TITLE);
    Gui_Msg title(GUI_IDS_FAMILY_TITLE);
    title << application;
    frame.SetTitle(title);
    frame.SetWindowText(title);
}

int Gui_MainFrameRecord::Restore(CFrameWnd& frame, int command) {
    if (std::exchange(placementRestored, 1)) {
        return command;
    }
    WINDOWPLACEMENT placement;
    if (Gui_Profile::ReadWindowPlacement(placement, nullptr, nullptr)) {
        frame.SetWindowPlacement(&placement);
        // A damaged record must not leave an application that nobody sees.
        command = placement.showCmd != SW_HIDE ? static_cast<int>(placement.showCmd) : command;
    }
    Gui_Profile::ReadBarState(&frame, nullptr);
    if (auto* app = DYNAMIC_DOWNCAST(Gui_WinApp, AfxGetApp())) {
        app->RegisterInstanceWindow(Gui_Desktop::GetMainWindowID());
    }
    return command;
}

void Gui_MainFrameRecord::Save(CFrameWnd& frame) {
    // Together: where another program holds the settings, this is waited for once. What cannot be kept is not: the
    // former records stay, and the frame closes all the same.
    tvx::RegistryTransaction together;
    if (together.begin() != ERROR_SUCCESS) {
        return;
    }
    WINDOWPLACEMENT placement;
    if (frame.GetWindowPlacement(&placement)) {
        Gui_Profile::WriteWindowPlacement(placement, nullptr, nullptr);
    }
    Gui_Profile::WriteBarState(&frame, nullptr);
    (void)together.commit();
}

void Gui_MainFrameRecord::NoteBar(const CControlBar& bar) {
    if (!BarOf(bar.m_hWnd)) {
        dockedBars.push_back(bar.m_hWnd);
    }
}

CControlBar* Gui_MainFrameRecord::BarOf(HWND window) const {
    const bool noted = std::ranges::find(dockedBars, window) != dockedBars.end();
    return noted ? DYNAMIC_DOWNCAST(CControlBar, CWnd::FromHandlePermanent(window)) : nullptr;
}
