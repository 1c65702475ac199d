#include "s/BrowserChain.h"

#include "afxwin.h"
#include "platform/base/Exception.h"
#include "platform/port/Env.h"
#include "platform/win/Associations.h"
#include "res/resource.h"
#include "s/BrowserPreference.h"
#include "s/Msg.h"
#include "s/Process.h"
#include "s/Programs.h"
#include "s/String.h"

#include <algorithm>
#include <array>
#include <memory>
#include <optional>
#include <set>
#include <string>

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

/// A browser that was not tried, because it could not open the page.
struct PassedOver {
    const Candidate* candidate;
    CString browser;
    std::string obstacle;
};

/// Why a browser was passed over, in a sentence.
CString reason(const PassedOver& passed, const CString& url) {
    Gui_Msg sentence(passed.obstacle == "files only" ? GUI_IDS_BROWSER_FILES_ONLY : GUI_IDS_BROWSER_SANDBOXED);
    sentence << passed.browser << passed.obstacle.c_str() << url;
    return sentence.GetValue();
}

/// Whether something about a browser has not been said before in this process.
bool isNews(const CString& browser) {
    static std::set<std::string> said;
    return tvx::allocating([&browser] { return said.insert(browser.GetString()).second; });
}

/// Opens one page; keeps what is to be said of the ways that were tried.
class Launch {
public:
    explicit Launch(const BrowserRequest& request) : m_request(request) {}

    bool Try(const Candidate& candidate) {
        CString browser;
        if (!candidate.find(browser)) {
            Say(candidate.missing ? Gui_Msg(candidate.missing).GetValue() : CString());
            return false;
        }
        browser = withoutRemote(browser);
        const std::string obstacle =
            tvx::allocating([&] { return tvx::obstacleTo(browser.GetString(), m_request.url.GetString()); });
        if (obstacle.empty()) {
            return Start(candidate, browser, m_request.url);
        }
        if (!m_passedOver) {
            m_passedOver = PassedOver{&candidate, browser, obstacle};
        }
        return false;
    }
    /// Lets the first browser that was passed over open the page where it is on the web.
    bool TryOnWeb() {
        return m_passedOver && !m_request.webUrl.IsEmpty() &&
               Start(*m_passedOver->candidate, m_passedOver->browser, m_request.webUrl);
    }
    /// Tells why the page is not shown by the browser that it was meant for.
    void ExplainDetour() const {
        if (m_passedOver && isNews(m_passedOver->browser)) {
            AfxMessageBox(reason(*m_passedOver, m_request.url) + "\n" + Gui_Msg(GUI_IDS_BROWSER_OTHER_WAY).GetValue());
        }
    }
    /// Tells what was tried.
    void ExplainFailure() {
        if (m_passedOver) {
            Say(reason(*m_passedOver, m_request.url));
        }
        AfxMessageBox(m_story);
    }

private:
    bool Start(const Candidate& candidate, const CString& browser, const CString& url) {
        const CString commandLine = Programs::CommandLineFor(browser, url);
        if (start(commandLine, m_request.directory)) {
            return true;
        }
        Gui_Msg failed(candidate.failed);
        failed << commandLine;
        Say(failed.GetValue());
        return false;
    }
    /// The texts of the first steps end their lines, those of the last do not.
    void Say(const CString& text) {
        if (!m_story.IsEmpty() && m_story.Right(1) != "\n") {
            m_story += "\n";
        }
        m_story += text;
    }

    const BrowserRequest& m_request;
    std::optional<PassedOver> m_passedOver; ///< the first one
    CString m_story;
};

} // namespace

int RunBrowserChain(const BrowserRequest& request) {
    if (Port_Env::GetEnv(askVariable)) {
        Gui_BrowserPreference preference;
        preference.GetModalPreferenceDialog().DoModal();
    }
    Launch launch(request);
    if (std::ranges::any_of(candidates, [&launch](const Candidate& candidate) { return launch.Try(candidate); }) ||
        launch.TryOnWeb()) {
        launch.ExplainDetour();
        return 1;
    }
    launch.ExplainFailure();
    return 0;
}
