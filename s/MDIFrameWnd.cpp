#include "s/MDIFrameWnd.h"

#include "afxext.h"
#include "s/MainFrameRecord.h"
#include "s/Record.h"

IMPLEMENT_DYNAMIC(Gui_MDIFrameWnd, CMDIFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_MDIFrameWnd, CMDIFrameWnd)
    ON_WM_CLOSE()
    ON_WM_HELPINFO()
END_MESSAGE_MAP()
// clang-format on

Gui_MDIFrameWnd::Gui_MDIFrameWnd() : m_record(MakeRecord<Gui_MainFrameRecord>()) {}

Gui_MDIFrameWnd::~Gui_MDIFrameWnd() = default;

BOOL Gui_MDIFrameWnd::LoadFrame(UINT id, DWORD style, CWnd* parent, CCreateContext* context) {
    if (!CMDIFrameWnd::LoadFrame(id, style, parent, context)) {
        return FALSE;
    }
    Gui_MainFrameRecord::SetFamilyTitle(*this);
    return TRUE;
}

void Gui_MDIFrameWnd::ActivateFrame(int command) {
    CMDIFrameWnd::ActivateFrame(m_record->Restore(*this, command));
}

void Gui_MDIFrameWnd::OnClose() {
    Gui_MainFrameRecord::Save(*this);
    CMDIFrameWnd::OnClose();
}

BOOL Gui_MDIFrameWnd::OnHelpInfo(HELPINFO* info) {
    return info->iContextType == HELPINFO_MENUITEM ? CMDIFrameWnd::OnHelpInfo(info) : TRUE;
}

// --- bars ---

void Gui_MDIFrameWnd::DockControlBar(CControlBar* bar, unsigned int side, const RECT* rect) {
    m_record->NoteBar(*bar);
    CMDIFrameWnd::DockControlBar(bar, side, rect);
}

void Gui_MDIFrameWnd::toggleDocking(CControlBar& bar) {
    CRect place;
    bar.GetWindowRect(place);
    bar.GetTopLevelParent()->SetActiveWindow();
    if (bar.IsFloating()) {
        DockControlBar(&bar);
    } else {
        FloatControlBar(&bar, place.TopLeft());
    }
}

// --- for the maps of hosts ---

int Gui_MDIFrameWnd::OnCreate(CREATESTRUCT* cs) {
    return CFrameWnd::OnCreate(cs) == -1 ? -1 : 0;
}

BOOL Gui_MDIFrameWnd::OnEraseBkgnd(CDC* dc) {
    return CFrameWnd::OnEraseBkgnd(dc);
}

void Gui_MDIFrameWnd::OnSysCommand(unsigned int command, LPARAM parameter) {
    // The low bits of a system command are the platform's own.
    CControlBar* bar = (command & 0xFFF0U) == SC_KEYMENU ? m_record->BarOf(reinterpret_cast<HWND>(parameter)) : nullptr;
    if (bar) {
        toggleDocking(*bar);
    } else {
        CMDIFrameWnd::OnSysCommand(command, parameter);
    }
}
