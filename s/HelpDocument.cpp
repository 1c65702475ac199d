#include "s/HelpDocument.h"

#include "platform/port/File.h"
#include "s/PDFProfile.h"

#include <cstring>

namespace {

bool standsForItself(char character) {
    const auto byte = static_cast<unsigned char>(character);
    return byte > ' ' && byte < 0x7F && !std::strchr("\"%#?<>\\^`{|}", character);
}

CString encoded(const CString& path) {
    CString text;
    for (int i = 0; i < path.GetLength(); ++i) {
        if (standsForItself(path[i])) {
            text += path[i];
        } else {
            text.AppendFormat("%%%02X", static_cast<unsigned char>(path[i]));
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
    const CString path = encoded(document.Left(anchor));
    return (path.Left(1) == "/" ? "file://" : "file:///") + path + document.Mid(anchor);
}

CString ViewerArgumentOf(const CString& document) {
    CString viewer;
    Gui_PDFProfile::ReadPDFViewerName(viewer);
    CString argument = document;
    argument.Replace("\"", "\\\"");
    const bool isQuoted = viewer.Find("\"%1\"") >= 0;
    return argument.FindOneOf(" \t") >= 0 && !isQuoted ? "\"" + argument + "\"" : argument;
}
