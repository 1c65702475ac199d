#pragma once

/// @file
/// CFormView: a view that is filled with controls.

#include "platform/afx/frames/ScrollView.h"

/// A view whose controls come from a dialog template. Derive a class from it, name the template in the constructor,
/// exchange the controls' values with members in DoDataExchange and handle the controls' commands in the message map.
/// It is made by its document template as any view is.
///
/// @code
/// class CPartView : public CFormView {
///     DECLARE_DYNCREATE(CPartView)
/// public:
///     CPartView() : CFormView(IDD_PART) {}
///     void DoDataExchange(CDataExchange* dx) override { DDX_Text(dx, IDC_PART_NAME, m_name); }
/// };
/// @endcode
///
/// The template says WS_CHILD and has no caption; border and place are the frame's affair. Its size is the size of the
/// drawing that the view scrolls (SetScrollSizes tells another).
///
/// Tab, arrows, Enter, Esc and mnemonics work as in a dialog, behind the accelerators of the frames around the view; a
/// control that they lead to is scrolled into sight. A view that becomes active again gives the keyboard to the control
/// that had it.
class TVX_PLATFORM_API CFormView : public CScrollView {
    DECLARE_DYNAMIC(CFormView)

public:
    /// Tells nothing: a form has no drawing.
    void OnDraw(CDC* dc) override {}
    /// Fills the controls by UpdateData(FALSE), then calls OnUpdate.
    void OnInitialUpdate() override;
    void OnActivateView(BOOL activate, CView* activated, CView* deactivated) override;
    BOOL PreTranslateMessage(MSG* message) override;

protected:
    /// @param templateName name of the dialog template, which must live as long as the view
    explicit CFormView(LPCSTR templateName);
    /// @param templateId number of the dialog template
    explicit CFormView(UINT templateId);

    /// Creates window and controls from the template. FALSE, which standard error tells, when it is missing or damaged.
    /// @param className,title not used: the template has them
    /// @param style of the window (WS_VISIBLE, WS_BORDER)
    BOOL Create(LPCSTR className, LPCSTR title, DWORD style, const RECT& rect, CWnd* parent, UINT id,
                CCreateContext* context = nullptr) override;

    LPCSTR m_lpszTemplateName = nullptr;

private:
    void scrollToFocus();
};
