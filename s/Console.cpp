#include "s/Console.h"

#include "res/resource.h"
#include "s/ConsoleState.h"
#include "s/ConsoleView.h"
#include "s/Document.h"
#include "s/MessageOrigin.h"
#include "s/Record.h"

namespace {

constexpr const char* revision = "$Revision: 1 $";

/// Whether the application still has the template: another application object of the process may have ended with it.
bool HasTemplate(const CDocTemplate* wanted) {
    const CWinApp* app = AfxGetApp();
    for (POSITION at = app && wanted ? app->GetFirstDocTemplatePosition() : nullptr; at;) {
        if (app->GetNextDocTemplate(at) == wanted) {
            return true;
        }
    }
    return false;
}

} // namespace

Gui_Console::Gui_Console(int (*callback)(const char*), int) {
    Gui_ConsoleState& state = ConsoleState();
    if (state.m_owner) {
        LibraryOrigin("../s/Console", __LINE__, revision).issueInternal("There is a console already.\n");
        return;
    }
    state.m_history = MakeRecord<Gui_ConsoleHistory>();
    state.m_recall = MakeRecord<Gui_ConsoleRecall>(*state.m_history);
    if (state.m_keepsRecall) {
        state.m_recall->SetEarlier(ReadRecallTexts());
    }
    state.m_callback = callback;
    state.m_owner = this;
}

Gui_Console::~Gui_Console() {
    Gui_ConsoleState& state = ConsoleState();
    if (state.m_owner != this) {
        return;
    }
    if (state.m_view) {
        state.m_view->ForgetLines();
    }
    state.m_recall.reset();
    state.m_history.reset();
    state.m_callback = nullptr;
    state.m_owner = nullptr;
}

int Gui_Console::Init() {
    auto* added = new CMultiDocTemplate(GUI_IDR_CONSOLE, RUNTIME_CLASS(Gui_Document), RUNTIME_CLASS(CMDIChildWnd),
                                        RUNTIME_CLASS(Gui_ConsoleView));
    AfxGetApp()->AddDocTemplate(added);
    Gui_ConsoleState& state = ConsoleState();
    if (!HasTemplate(state.m_template)) {
        state.m_template = added;
    }
    return 1;
}

int Gui_Console::Open() {
    const Gui_ConsoleState& state = ConsoleState();
    if (state.m_view) {
        CFrameWnd* const frame = state.m_view->GetParentFrame();
        frame->ActivateFrame();
        return 1;
    }
    if (!HasTemplate(state.m_template)) {
        LibraryOrigin("../s/Console", __LINE__, revision).issueInternal("The console was not initialized.\n");
        return 0;
    }
    return state.m_template->OpenDocumentFile(nullptr, TRUE) ? 1 : 0;
}

int Gui_Console::Close() {
    const Gui_ConsoleState& state = ConsoleState();
    if (!state.m_view) {
        return 0;
    }
    state.m_view->GetParentFrame()->DestroyWindow();
    return 1;
}

int Gui_Console::IsOpen() const {
    return ConsoleState().m_view ? 1 : 0;
}

void Gui_Console::SetShowCommandStatusFlag(int show) {
    Gui_ConsoleState& state = ConsoleState();
    state.m_showStatus = show ? 1 : 0;
    if (state.m_view) {
        state.m_view->SetShowStatus(state.m_showStatus);
    }
}

int Gui_Console::GetShowCommandStatusFlag() const {
    const Gui_ConsoleState& state = ConsoleState();
    return state.m_view ? state.m_view->GetShowStatus() : state.m_showStatus;
}

int Gui_Console::AddCommand(const char* text) {
    const Gui_ConsoleState& state = ConsoleState();
    if (!state.m_history) {
        return 1;
    }
    Gui_ConsoleHistoryLine* const line = state.m_history->AddCommand(text);
    if (state.m_view) {
        state.m_view->ShowLine(line);
        state.m_view->ShowPrompt();
    }
    return 1;
}

int Gui_Console::AddStatusLine(const char* text) {
    const Gui_ConsoleState& state = ConsoleState();
    if (!state.m_history) {
        return 1;
    }
    Gui_ConsoleHistoryLine* const line = state.m_history->AddStatusLine(text);
    if (state.m_view && state.m_view->GetShowStatus()) {
        state.m_view->ShowLine(line);
    }
    return 1;
}

void Gui_Console::SetKeepRecallFlag(int keep) {
    Gui_ConsoleState& state = ConsoleState();
    if (state.m_keepsRecall == (keep ? 1 : 0)) {
        return; // what is kept holds this process's commands, too, which are in the walk already
    }
    state.m_keepsRecall = keep ? 1 : 0;
    if (!keep) {
        ForgetRecallTexts();
    }
    if (state.m_recall) {
        state.m_recall->SetEarlier(keep ? ReadRecallTexts() : std::vector<CString>());
    }
}

int Gui_Console::GetKeepRecallFlag() const {
    return ConsoleState().m_keepsRecall;
}
