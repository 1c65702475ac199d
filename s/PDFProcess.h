#pragma once

#include "s/Process.h"

/// A PDF viewer that runs as a child process.
///
/// @code
/// Gui_PDFProcess viewer;
/// if (!viewer.RunPDFReader("/opt/tarvex/doc/usenglish/manuals.pdf", nullptr, 1, 5000))
///     AfxMessageBox(GUI_IDS_NO_PDF_VIEWER);
/// @endcode
///
/// Gui_PDFProfile says which viewer that is. The viewer runs on when the object goes.
class GUI_API Gui_PDFProcess : public Gui_Process {
public:
    Gui_PDFProcess();
    ~Gui_PDFProcess() override;

    /// Opens a document in the PDF viewer. Sets the release policy to `LeaveRunning` with exit code 0.
    /// @param fileName   put into the viewer's command line as it is, with an anchor such as "#page=12"; where it has
    ///                   blanks it needs quotes, there or here
    /// @param directory  where the viewer starts; null is the current directory
    /// @param wait       non-zero: as RunWaitForWindow, 0: as Run
    /// @param timeout    that of RunWaitForWindow
    /// @return as Run; no message is shown
    int RunPDFReader(const char* fileName, const char* directory, int wait, unsigned long timeout);
};
