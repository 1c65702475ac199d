#include "s/BrowserHelp.h"

#include "afxwin.h"
#include "platform/port/Env.h"
#include "platform/port/File.h"
#include "platform/port/TarvexPath.h"
#include "res/resource.h"
#include "s/BrowserChain.h"
#include "s/HelpDocument.h"
#include "s/HelpMap.h"
#include "s/HelpTrace.h"
#include "s/Msg.h"
#include "s/Record.h"
#include "s/TopicIndexDlg.h"

#include <cstddef>
#include <optional>

namespace {

// --- before a program comes up ---

void endModes(CFrameWnd& frame) {
    frame.ExitHelpMode();
    frame.SendMessage(WM_CANCELMODE);
    frame.SendMessageToDescendants(WM_CANCELMODE, 0, 0, TRUE, FALSE);
}

/// Closes menus, ends help mode and capture, so that nothing holds mouse or keyboard while a browser comes up.
void prepare() {
    if (CWinApp* const app = AfxGetApp()) {
        app->m_bHelpMode = FALSE;
    }
    CWnd* const main = AfxGetMainWnd();
    if (main && main->m_hWnd && main->IsFrameWnd()) {
        endModes(static_cast<CFrameWnd&>(*main));
        CFrameWnd* const top = main->GetTopLevelFrame();
        if (top && top != main) {
            endModes(*top);
        }
    }
    if (const HWND capture = ::GetCapture()) {
        ::SendMessage(capture, WM_CANCELMODE, 0, 0);
    }
}

// --- what is found ---

/// The documents of a request.
struct Found {
    Gui_HelpMap::Strings files;
    Gui_HelpMap::Strings titles;
    Gui_HelpMap::String type;
};

Found find(const Gui_HelpMap& map, unsigned long data, unsigned int command) {
    Found found;
    Gui_HelpMap::String document;
    switch (command) {
    case HELP_CONTENTS:
    case HELP_FINDER:
        document = map.GetContents(found.type);
        break;
    case HELP_CONTEXT:
        document = data == mainFrameHelpContext ? map.GetContents(found.type)
                                                : map.LookupContext(static_cast<unsigned int>(data), found.type);
        break;
    case HELP_KEY:
        map.LookupIndex(KeywordOf(data, "").GetString(), found.files, found.titles, found.type);
        break;
    default:
        break;
    }
    if (!document.IsEmpty()) {
        found.files = {document};
    }
    return found;
}

void tellNotFound(const char* first, const char* second) {
    Gui_Msg message(GUI_IDS_HELP_NOT_FOUND);
    message << first << second;
    AfxMessageBox(message);
}

void tellNotFound(unsigned long data, unsigned int command) {
    CString number;
    switch (command) {
    case HELP_CONTEXT:
        number.Format("0x%x", static_cast<unsigned int>(data));
        tellNotFound("Help Context ID: ", number);
        break;
    case HELP_CONTENTS:
    case HELP_FINDER:
        tellNotFound("Contents", " ");
        break;
    case HELP_KEY:
        tellNotFound("index ", KeywordOf(data, "none"));
        break;
    default:
        number.Format("%d", static_cast<int>(command));
        tellNotFound("unknown", number);
        break;
    }
}

/// Where an installed document is on the web, empty when it is not below a root of the installation.
CString webPlaceOf(const Gui_HelpMap& map, const CString& document) {
    for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance()) {
        const CString documents = CString(root.c_str()) + "/doc/";
        if (document.Find(documents) != 0) {
            continue;
        }
        const CString below = document.Mid(documents.GetLength()); // <language>/<name>
        const int name = below.Find('/') + 1;
        return map.GetWebUrl(below.Mid(name).GetString()).c_str();
    }
    return {};
}

} // namespace

struct Gui_BrowserHelp::Record {
    CString mapFile;
    CString packageName; ///< the package whose map was not found
    Gui_HelpMap map;
    int debug = 0;

    bool LoadMap();
    int Open(const char* document, const char* type) const;
    template <typename TellNone>
    int Show(const Found& found, const TellNone& tellNone) const;
};

Gui_BrowserHelp::Gui_BrowserHelp() : m_record(MakeRecord<Record>()) {
    m_record->debug = Port_Env::GetEnv("TVX_GUI_HELP_DEBUG") ? 1 : 0;
}

Gui_BrowserHelp::~Gui_BrowserHelp() = default;

namespace {

void tellMissing(const CString& name) {
    Gui_Msg message(GUI_IDS_HELP_PACKAGE_MISSING);
    message << name;
    AfxMessageBox(message);
}

} // namespace

int Gui_BrowserHelp::SetHelpMapFileName(const char* name) {
    CString package = name;
    if (!m_record->mapFile.IsEmpty() && m_record->mapFile.Right(package.GetLength()) == package) {
        return 1;
    }
    package.Replace(".map", "");
    const Gui_HelpMap::String file = GetMapFileForPackage(package.GetString());
    if (!file.IsEmpty()) {
        m_record->mapFile = file.c_str();
        return 1;
    }
    tellMissing(name);
    m_record->packageName = name;
    return 0;
}

bool Gui_BrowserHelp::Record::LoadMap() {
    if (mapFile.IsEmpty()) {
        if (packageName.IsEmpty()) {
            AfxMessageBox(Gui_Msg(GUI_IDS_HELP_PACKAGE_NOT_SET).GetValue());
        }
        return false;
    }
    if (map.IsLoaded(mapFile.GetString()) || map.Read(mapFile.GetString()) || Port::File::canread(mapFile)) {
        return true;
    }
    tellMissing(mapFile);
    return false;
}

int Gui_BrowserHelp::Record::Open(const char* document, const char* type) const {
    const CString kind = type;
    if (kind.CompareNoCase("acrobat") == 0) {
        ShowInPDFViewer(document);
        return 1;
    }
    const bool isAddress = kind.CompareNoCase("url") == 0;
    BrowserRequest request;
    request.url = isAddress ? CString(document) : FileAddressOf(document);
    request.wait = 1;
    request.timeout = documentTimeout;
    request.webUrl = isAddress ? CString() : webPlaceOf(map, document);
    return RunBrowserChain(request);
}

namespace {

/// Chooses one of several documents; nothing when the user does not want any.
std::optional<std::size_t> choose(const Found& found) {
    Gui_TopicIndexDlg topics(found.files, found.titles, nullptr);
    if (topics.DoModal() != IDOK) {
        return std::nullopt;
    }
    return static_cast<std::size_t>(topics.GetSelectedIndex());
}

} // namespace

template <typename TellNone>
int Gui_BrowserHelp::Record::Show(const Found& found, const TellNone& tellNone) const {
    if (found.files.empty()) {
        tellNone();
        return 1;
    }
    const std::optional<std::size_t> chosen = found.files.size() == 1 ? 0 : choose(found);
    return chosen ? Open(found.files[*chosen].c_str(), found.type.c_str()) : 1;
}

int Gui_BrowserHelp::BrowserHelp(unsigned long dwData, unsigned int nCmd) {
    if (m_record->debug) {
        ShowHelpTrace(dwData, nCmd, m_record->mapFile);
    }
    prepare();
    if (!m_record->LoadMap()) {
        return 0;
    }
    return m_record->Show(find(m_record->map, dwData, nCmd), [&] { tellNotFound(dwData, nCmd); });
}

int Gui_BrowserHelp::HelpForMapRecordKey(const char* key) {
    if (m_record->debug) {
        Gui_Msg trace("Lookup .map file for key: %1");
        trace << key;
        AfxMessageBox(trace);
    }
    prepare();
    if (!m_record->LoadMap()) {
        return 0;
    }
    Found found;
    m_record->map.LookupKey(key, found.files, found.titles, found.type);
    return m_record->Show(found, [&] { tellNotFound(key, " "); });
}

int Gui_BrowserHelp::OnCommand(unsigned int id) {
    return BrowserHelp(HID_BASE_COMMAND + id, HELP_CONTEXT);
}

int Gui_BrowserHelp::OnDialog(unsigned int id) {
    return BrowserHelp(HID_BASE_RESOURCE + id, HELP_CONTEXT);
}

int Gui_BrowserHelp::OnPrompt(unsigned int id) {
    return BrowserHelp(HID_BASE_PROMPT + id, HELP_CONTEXT);
}

int Gui_BrowserHelp::OnFrameControl(unsigned int id) {
    return BrowserHelp(HID_BASE_CONTROL + id, HELP_CONTEXT);
}

int Gui_BrowserHelp::OnContents() {
    return BrowserHelp(0, HELP_FINDER);
}

void Gui_BrowserHelp::DisplayFailureOnHelp() {}
