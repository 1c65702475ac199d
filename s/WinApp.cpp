#include "s/WinApp.h"

#include "platform/afx/core/LastReport.h"
#include "platform/port/Exception.h"
#include "res/resource.h"
#include "s/DocManager.h"
#include "s/Msg.h"
#include "s/Record.h"
#include "s/WinAppData.h"

#include <cstdlib>
#include <cstring>
#include <exception>
#include <utility>

IMPLEMENT_DYNAMIC(Gui_WinApp, CWinApp)

namespace {

void issueFatal(int line) {
    WinAppOrigin(line).issueFatal(
        1, "This application has discovered an exceptional condition from which it cannot recover.");
}

/// The document manager that the application had before InitApplication: none, unless the host was early.
CDocManager* platformDocManager = nullptr;

/// Replaces one of the application object's texts.
void replace(LPCSTR& place, LPCSTR text) {
    LPCSTR old = place;
    place = strdup(text);
    std::free(const_cast<LPSTR>(old));
}

} // namespace

Gui_WinApp::Gui_WinApp(const char* appName) : CWinApp(appName), m_data(MakeRecord<Gui_WinAppData>()) {}

Gui_WinApp::~Gui_WinApp() {
    // The base class ends the one that is put back.
    CDocManager* const installed = m_pDocManager;
    m_pDocManager = std::exchange(platformDocManager, nullptr);
    if (installed != m_pDocManager) {
        delete installed;
    }
}

void Gui_WinApp::SetRegistryKey(const char* key) {
    CWinApp::SetRegistryKey(key);
    CString title;
    if (!title.LoadString(AFX_IDS_APP_TITLE)) {
        title = AfxGetAppName();
    }
    Gui_Msg displayName(GUI_IDS_FAMILY_TITLE);
    displayName << title;
    replace(m_pszAppName, displayName);
    replace(m_pszProfileName, title);
}

int Gui_WinApp::Run() {
    int result = 1;
    try {
        result = CWinApp::Run();
    } catch (const Port::Exception& exception) {
        const CLastReport report;
        exception.report();
        issueFatal(__LINE__);
    } catch (const std::exception& exception) {
        const CLastReport report;
        WinAppOrigin(__LINE__).issueError("%s", exception.what());
        issueFatal(__LINE__);
    } catch (CException* exception) {
        exception->Delete();
    } catch (...) {
        const CLastReport report;
        issueFatal(__LINE__);
    }
    return result;
}

BOOL Gui_WinApp::PreTranslateMessage(MSG* message) {
    return CWinApp::PreTranslateMessage(message);
}

BOOL Gui_WinApp::InitApplication() {
    // An object that is started once more goes on with the one it has.
    if (!m_data->docManager || m_pDocManager != m_data->docManager) {
        platformDocManager = m_pDocManager;
        m_data->docManager = new Gui_DocManager;
        m_pDocManager = m_data->docManager;
    }
    return CWinApp::InitApplication();
}

void Gui_WinApp::DoWaitCursor(int code) {
    CWinApp::DoWaitCursor(code);
    // The pointer is drawn in its new shape when it moves: so it is moved to where it stands.
    POINT position;
    if (code <= 0 && GetCursorPos(&position)) {
        SetCursorPos(position.x, position.y);
    }
}
