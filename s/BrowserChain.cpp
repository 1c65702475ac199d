#include "s/BrowserChain.h"

#include "afxwin.h"
#include "platform/port/Env.h"
#include "res/resource.h"
#include "s/Msg.h"
#include "s/Process.h"
#include "s/Programs.h"
#include "s/String.h"

#include <algorithm>
#include <array>
#include <memory>

namespace {

constexpr const char* askVariable = "TVX_GUI_HTML_BROWSER_PATH";

/// A source of a browser, and what is said where it does not serve.
struct Candidate {
    int (*find)(CString& commandLine);
    UINT failed;
    UINT missing; ///< 0: nothing
};

constexpr std::array candidates = {
    Candidate{&Programs::UserBrowser, GUI_IDS_BROWSER_FAILED, 0},
    Candidate{&Programs::AssociatedBrowser, GUI_IDS_DEFAULT_BROWSER_FAILED, GUI_IDS_NO_DEFAULT_BROWSER},
    Candidate{&Programs::LastBrowser, GUI_IDS_LAST_BROWSER_FAILED, GUI_IDS_NO_LAST_BROWSER},
};

/// A command line that hands the address to a running browser becomes the browser alone, which is started afresh.
CString withoutRemote(const CString& commandLine) {
    constexpr std::array<const char*, 3> requests = {"openURL(%1,new-window)", "openURL(%1,new-tab)", "openURL(%1)"};
    const std::unique_ptr<CStringArray> words(Gui_String(commandLine).GetStringArray(" ", 1, 0));
    const CStringArray& word = *words;
    const bool isRemote = word.GetSize() == 3 && word[1] == "-remote" &&
                          std::ranges::any_of(requests, [&word](const char* request) { return word[2] == request; });
    return isRemote ? word[0] : commandLine;
}

bool start(const CString& commandLine, const CString& directory) {
    Gui_Process browser;
    browser.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
    return browser.Run(commandLine, directory.IsEmpty() ? nullptr : directory.GetString(), 0, 0) == 1;
}

/// Opens one page; keeps what is to be said when that fails.
class Launch {
public:
    explicit Launch(const BrowserRequest& request) : m_request(request) {}

    bool Try(const Candidate& candidate) {
        CString browser;
        if (!candidate.find(browser)) {
            m_story += candidate.missing ? Gui_Msg(candidate.missing).GetValue() : CString();
            return false;
        }
        const CString commandLine = Programs::CommandLineFor(withoutRemote(browser), m_request.url);
        if (start(commandLine, m_request.directory)) {
            return true;
        }
        Gui_Msg failed(candidate.failed);
        failed << commandLine;
        m_story += failed;
        return false;
    }
    [[nodiscard]] const CString& Story() const {
        return m_story;
    }

private:
    const BrowserRequest& m_request;
    CString m_story;
};

} // namespace

int RunBrowserChain(const BrowserRequest& request) {
    Launch launch(request);
    if (std::ranges::any_of(candidates, [&launch](const Candidate& candidate) { return launch.Try(candidate); })) {
        return 1;
    }
    AfxMessageBox(launch.Story());
    return 0;
}
