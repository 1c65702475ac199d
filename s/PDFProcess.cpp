#include "s/PDFProcess.h"

#include "s/PDFProfile.h"
#include "s/Programs.h"

Gui_PDFProcess::Gui_PDFProcess() = default;

Gui_PDFProcess::~Gui_PDFProcess() = default;

int Gui_PDFProcess::RunPDFReader(const char* fileName, const char* directory, int wait, unsigned long timeout) {
    CString viewer;
    Gui_PDFProfile::ReadPDFViewerName(viewer);
    SetReleasePolicy(LeaveRunning, 0);
    const CString commandLine = Programs::CommandLineFor(viewer.Trim(), fileName);
    return wait ? RunWaitForWindow(commandLine, directory, timeout) : Run(commandLine, directory, 0, 0);
}
