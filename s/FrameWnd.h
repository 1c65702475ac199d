#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

struct Gui_MainFrameRecord;

/// The main window of an application that shows one document at a time. Hosts derive their main frame from it:
///
/// @code
/// class CMainFrame : public Gui_FrameWnd {
///     DECLARE_DYNCREATE(CMainFrame)
/// public:
///     afx_msg int OnCreate(CREATESTRUCT* cs); // makes the bars
///     DECLARE_MESSAGE_MAP()
/// };
///
/// IMPLEMENT_DYNCREATE(CMainFrame, Gui_FrameWnd)
/// BEGIN_MESSAGE_MAP(CMainFrame, Gui_FrameWnd)
///     ON_WM_CREATE()
/// END_MESSAGE_MAP()
///
/// // in InitInstance
/// AddDocTemplate(new CSingleDocTemplate(IDR_MAINFRAME, RUNTIME_CLASS(CNotesDoc), RUNTIME_CLASS(CMainFrame),
///                                       RUNTIME_CLASS(CNotesView)));
/// @endcode
///
/// It comes up where it stood when it was closed last, with its bars as they were (docs/window-records.md), has the
/// family's title, and records its window for the one running instance. A derived class that handles WM_CLOSE calls the
/// base: that is where all of it is kept.
///
/// Frames delete themselves when their window has ended; samples/notes has a whole application around one.
class GUI_API Gui_FrameWnd : public CFrameWnd { // NOLINT(cppcoreguidelines-virtual-class-destructor)
    DECLARE_DYNAMIC(Gui_FrameWnd)

public:
    /// Loads the frame as the base does, then makes "Tarvex" and the application's title (string 57344) its title.
    /// @return that of the base. After FALSE the object has been deleted
    BOOL LoadFrame(UINT id, DWORD style = WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE, CWnd* parent = nullptr,
                   CCreateContext* context = nullptr) override;
    /// Shows the frame. The first call puts it and its bars where they stood; the show command that was kept then takes
    /// the place of `command`, so that a window closed maximised comes up maximised.
    void ActivateFrame(int command = -1) override;

    /// Keeps where the frame and its bars stand, then closes as the base does: also when the user keeps it open because
    /// of a document with changes.
    afx_msg void OnClose();
    /// Help on menu items goes to the base; over everything else the help key does nothing. A host that has a page for
    /// what is worked on handles WM_HELP itself.
    afx_msg BOOL OnHelpInfo(HELPINFO* info);

protected:
    Gui_FrameWnd();
    ~Gui_FrameWnd() override;

    DECLARE_MESSAGE_MAP()

private:
    std::unique_ptr<Gui_MainFrameRecord> m_record;
};
