#include "s/HelpDocument.h"

#include "platform/port/File.h"
#include "s/PDFProfile.h"

#include <cstring>

namespace {

/// @param special  printable characters that do not stand for themselves
CString encoded(const CString& part, const char* special) {
    CString text;
    for (int i = 0; i < part.GetLength(); ++i) {
        const auto byte = static_cast<unsigned char>(part[i]);
        if (byte > ' ' && byte < 0x7F && !std::strchr(special, part[i])) {
            text += part[i];
        } else {
            text.AppendFormat("%%%02X", byte);
        }
    }
    return text;
}

/// Where the anchor of a document begins; its length when it has none. A "#" may also be part of a file's name.
int anchorOf(const CString& document) {
    const int sign = document.ReverseFind('#');
    return sign < 0 || Port::File::exist(document) ? document.GetLength() : sign;
}

} // namespace

CString FileAddressOf(const CString& document) {
    const int anchor = anchorOf(document);
    const CString path = encoded(document.Left(anchor), "\"%#?<>\\^`{|}");
    // Anchors are written in maps as in addresses: a percent sign is one.
    return (path.Left(1) == "/" ? "file://" : "file:///") + path + encoded(document.Mid(anchor), "\"<>");
}

CString ViewerArgumentOf(const CString& document) {
    CString viewer;
    Gui_PDFProfile::ReadPDFViewerName(viewer);
    CString argument = document;
    argument.Replace("\"", "\\\"");
    const bool isQuoted = viewer.Find("\"%1\"") >= 0;
    return argument.FindOneOf(" \t") >= 0 && !isQuoted ? "\"" + argument + "\"" : argument;
}
