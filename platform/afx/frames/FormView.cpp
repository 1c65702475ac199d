#include "platform/afx/frames/FormView.h"

#include "platform/afx/dialogs/detail/DialogWindow.h"
#include "platform/afx/gdi/GdiTypes.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/ResourceConstants.h"

#include <algorithm>
#include <cstdio>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CFormView, CScrollView)

CFormView::CFormView(LPCSTR templateName) : m_lpszTemplateName(templateName) {}

CFormView::CFormView(UINT templateId) : CFormView(MAKEINTRESOURCE(templateId)) {}

// --- making ---

BOOL CFormView::Create(LPCSTR, LPCSTR, DWORD style, const RECT& rect, CWnd* parent, UINT id, CCreateContext* context) {
    const auto description = loadDialogTemplate(m_lpszTemplateName);
    if (!description) {
        PostNcDestroy();
        return FALSE;
    }
    // Of the template's own style the dialog's bits count; what else it says is said for dialogs of their own. It is
    // shown when its controls stand.
    constexpr DWORD dialogBits = 0xFFFF;
    const DWORD wanted = (description->style & dialogBits) | WS_CHILD | (style & ~DWORD{WS_VISIBLE});
    if (!CreateEx(description->extendedStyle, dialogClass, description->title.c_str(), wanted, rect, parent, id,
                  context)) {
        return FALSE;
    }
    auto& dialog = static_cast<DialogWindow&>(*GetState());
    dialog.useFont(*description);
    if (!makeControls(dialog, *description)) {
        std::fprintf(stderr, "A control of the form %s could not be made.\n",
                     resourceNameOf(m_lpszTemplateName).c_str());
    }
    fillControls(dialog, m_lpszTemplateName);
    const QSize size = dialog.map(description->rect).size();
    SetScrollSizes(MM_TEXT, CSize(size.width(), size.height()));
    if ((style & WS_VISIBLE) != 0) {
        ShowWindow(SW_SHOW);
    }
    return TRUE;
}

void CFormView::OnInitialUpdate() {
    UpdateData(FALSE);
    CScrollView::OnInitialUpdate();
}

// --- the keyboard ---

void CFormView::OnActivateView(BOOL activate, CView* activated, CView* deactivated) {
    // A control that was clicked, or had the keyboard all the time, keeps it.
    const HWND focus = ::GetFocus();
    if (!activate || !focus || !::IsChild(m_hWnd, focus)) {
        CScrollView::OnActivateView(activate, activated, deactivated);
    }
}

BOOL CFormView::PreTranslateMessage(MSG* message) {
    if (CScrollView::PreTranslateMessage(message)) {
        return TRUE;
    }
    // The answer below is TRUE for each key, so that the frames must be asked before.
    for (CFrameWnd* frame = GetParentFrame(); frame; frame = frame->GetParentFrame()) {
        if (frame->PreTranslateMessage(message)) {
            return TRUE;
        }
    }
    const HWND self = m_hWnd;
    const HWND before = ::GetFocus();
    const BOOL mine = PreTranslateInput(message);
    if (::IsWindow(self) && ::GetFocus() != before) {
        scrollToFocus();
    }
    return mine;
}

void CFormView::scrollToFocus() {
    const HWND focus = ::GetFocus();
    if (!::IsChild(m_hWnd, focus)) {
        return;
    }
    CRect place;
    ::GetWindowRect(focus, &place);
    ScreenToClient(&place);
    CRect client;
    GetClientRect(&client);
    // Its end first: of a control that is larger than the view the beginning is seen.
    const auto distance = [](LONG from, LONG to, LONG extent) {
        const LONG shift = std::max<LONG>(0, to - extent);
        return from - shift < 0 ? from : shift;
    };
    const CSize by(distance(place.left, place.right, client.Width()),
                   distance(place.top, place.bottom, client.Height()));
    OnScrollBy(by);
}
