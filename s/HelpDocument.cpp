#include "s/HelpDocument.h"

#include "platform/base/Address.h"
#include "platform/port/File.h"
#include "res/resource.h"
#include "s/Msg.h"
#include "s/PDFProcess.h"
#include "s/PDFProfile.h"

#include <string>

namespace {

/// Where the anchor of a document begins; its length when it has none. A "#" may also be part of a file's name.
int anchorOf(const CString& document) {
    const int sign = document.ReverseFind('#');
    return sign < 0 || Port::File::exist(document) ? document.GetLength() : sign;
}

} // namespace

CString FileAddressOf(const CString& document) {
    const int anchor = anchorOf(document);
    const std::string path = tvx::encodeAddress(document.Left(anchor).GetString());
    CString address = (path.starts_with('/') ? "file://" : "file:///") + CString(path.c_str());
    if (anchor < document.GetLength()) {
        // Maps write places as addresses do, where a percent sign begins a code.
        const std::string place = tvx::decodeAddress(document.Mid(anchor + 1).GetString());
        address += "#" + CString(tvx::encodeAddress(place).c_str());
    }
    return address;
}

namespace {

CString viewerArgumentOf(const CString& document) {
    CString viewer;
    Gui_PDFProfile::ReadPDFViewerName(viewer);
    CString argument = document;
    argument.Replace("\"", "\\\"");
    const bool isQuoted = viewer.Find("\"%1\"") >= 0;
    return argument.FindOneOf(" \t") >= 0 && !isQuoted ? "\"" + argument + "\"" : argument;
}

} // namespace

void ShowInPDFViewer(const CString& document) {
    Gui_PDFProcess viewer;
    if (!viewer.RunPDFReader(viewerArgumentOf(document), nullptr, 1, documentTimeout)) {
        AfxMessageBox(Gui_Msg(GUI_IDS_NO_PDF_VIEWER).GetValue());
    }
}
