#include "s/PDFProfile.h"

#include "platform/port/Env.h"
#include "platform/port/Version.h"
#include "s/FileName.h"
#include "s/Programs.h"
#include "s/SettingsKey.h"
#include "s/String.h"

#include <memory>

namespace {

constexpr const char* viewerEntry = "PDFViewer";
constexpr const char* installedViewer = "pdfViewer";

} // namespace

int Gui_PDFProfile::ReadPDFViewerName(CString& name) {
    const CString viewer = SettingsKey(familyKey).text(viewerEntry).value_or(CString());
    if (viewer.IsEmpty()) {
        GetDefaultPDFViewerName(name);
    } else {
        name = viewer;
    }
    return 1;
}

void Gui_PDFProfile::WritePDFViewerName(const char* name) {
    SettingsKey(familyKey).writeText(viewerEntry, name);
}

void Gui_PDFProfile::GetDefaultPDFViewerName(CString& name) {
    name = CString(Port::Version::getValue(installedViewer).c_str()).Trim();
    if (name.IsEmpty()) {
        name = Programs::AssociatedCommand(".pdf");
    }
    if (name.IsEmpty()) {
        CString full = "Acrobat.exe";
        CString path;
        name = FindFileInPath(full, path) ? full : CString("AcroRd32.exe");
    }
}

int Gui_PDFProfile::FindFileInPath(CString& name, CString& fullPath) {
    const CString path = Port_Env::GetEnv("PATH");
    // Folders with drives are separated by ";", those of this system by ":".
    const char* separator = path.Find(';') >= 0 ? ";" : ":";
    const std::unique_ptr<CStringArray> folders(Gui_String(path).GetStringArray(separator, 1, 0));
    fullPath.Empty();
    Gui_FileName file;
    file.SetBaseAndExtension(name);
    for (INT_PTR i = 0; i < folders->GetSize(); ++i) {
        file.SetMountAndPath((*folders)[i]);
        if (file.IsExecutable()) {
            fullPath = file.GetFullName();
            return 1;
        }
    }
    return 0;
}
