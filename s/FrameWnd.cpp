#include "s/FrameWnd.h"

#include "s/MainFrameRecord.h"
#include "s/Record.h"

IMPLEMENT_DYNAMIC(Gui_FrameWnd, CFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_FrameWnd, CFrameWnd)
    ON_WM_CLOSE()
    ON_WM_HELPINFO()
END_MESSAGE_MAP()
// clang-format on

Gui_FrameWnd::Gui_FrameWnd() : m_record(MakeRecord<Gui_MainFrameRecord>()) {}

Gui_FrameWnd::~Gui_FrameWnd() = default;

BOOL Gui_FrameWnd::LoadFrame(UINT id, DWORD style, CWnd* parent, CCreateContext* context) {
    if (!CFrameWnd::LoadFrame(id, style, parent, context)) {
        return FALSE;
    }
    Gui_MainFrameRecord::SetFamilyTitle(*this);
    return TRUE;
}

void Gui_FrameWnd::ActivateFrame(int command) {
    CFrameWnd::ActivateFrame(m_record->Restore(*this, command));
}

void Gui_FrameWnd::OnClose() {
    Gui_MainFrameRecord::Save(*this);
    CFrameWnd::OnClose();
}

BOOL Gui_FrameWnd::OnHelpInfo(HELPINFO* info) {
    return info->iContextType == HELPINFO_MENUITEM ? CFrameWnd::OnHelpInfo(info) : TRUE;
}
