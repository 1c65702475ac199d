#pragma once

#include "afx.h"
#include "s/Export.h"

/// The command line of the PDF viewer: what the user has named once for the whole family, else what the installation or
/// the system names. "%1" stands for the document; without it the document is written behind. There are no objects of
/// this class.
class GUI_API Gui_PDFProfile {
public:
    Gui_PDFProfile() = delete;

    /// Reads the user's viewer, else the default one.
    /// @return 1
    static int ReadPDFViewerName(CString& name);
    /// Keeps the user's viewer; the empty text means the default one. Nothing is reported when that fails.
    static void WritePDFViewerName(const char* name);
    /// The viewer where the user has named none, the first of these that there is:
    ///
    /// 1. "pdfViewer" of the installation (docs/installation.md)
    /// 2. what opens ".pdf" files
    /// 3. "Acrobat.exe" when a folder of `PATH` holds it, else "AcroRd32.exe"
    ///
    /// An installation that cannot be read issues its messages.
    static void GetDefaultPDFViewerName(CString& name);

private:
    /// Looks for a program in the folders of `PATH`.
    /// @param fullPath  receives its whole name, else becomes empty
    /// @return 1 when it was found, else 0
    static int FindFileInPath(CString& name, CString& fullPath);
};
