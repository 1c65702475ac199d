// The check of the command line.
#include "s/WinApp.h"

#include "platform/afx/core/AskedFor.h"
#include "platform/afx/core/StartCode.h"
#include "platform/port/CmdArgs.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/MsgDispatcher.h"
#include "s/CommandLineState.h"
#include "s/MessageManager.h"
#include "s/WinAppData.h"

#include <cstdlib>
#include <memory>

namespace {

/// What the process ends with, by the custom of commands.
constexpr int refusedCommandLine = 2;

/// Whose messages the functions below collect: message managers take plain functions.
Gui_WinAppData* s_target = nullptr;

// Both have the type of the manager's callbacks, which take their texts by value.
// NOLINTBEGIN(performance-unnecessary-value-param)
void showError(CString text) {
    s_target->pending += text;
    AfxMessageBox(s_target->pending, MB_ICONERROR);
}

void collectStatus(CString line) {
    s_target->pending += line;
    s_target->pending += '\n';
}
// NOLINTEND(performance-unnecessary-value-param)

void issueUsageText() {
    WinAppOrigin(__LINE__).issueStatus("%s", s_target->usageText.GetString());
}

void issueUsageSummary(const CString& opcodes) {
    const std::unique_ptr<char, decltype(&std::free)> usage(UT_CMDOPCODES(opcodes).usage(), &std::free);
    if (usage) {
        WinAppOrigin(__LINE__).issueStatus("%s\n", usage.get());
    }
}

/// Checks the words and leaves what there is to say in the target's pending text. False when something is wrong.
bool check(Gui_CmdLineArgsArray& arguments, const CString& opcodes) {
    bool isRight = arguments.GetProblems().GetSize() == 0;
    Gui_MessageManager manager(&showError, &collectStatus);
    Port_MsgDispatcher::addMsgMan(&manager);
    IssueCommandFileProblems(arguments.GetProblems());
    if (arguments.GetCount() > 0) {
        const UT_CMDARGS parser(arguments.GetCount(), arguments.GetVector(), opcodes, &issueUsageText,
                                UT_CMDARGS::NoProgramName);
        isRight = isRight && !parser.iserror();
        if (!parser.gaveusage() && parser.iserror()) {
            issueUsageSummary(opcodes);
            issueUsageText();
        }
    }
    Port_MsgDispatcher::removeMsgMan(&manager);
    return isRight;
}

} // namespace

int Gui_WinApp::ProcessCommandLine(const Gui_CommandLineInfo& info) {
    s_target = m_data.get();
    Gui_CmdLineArgsArray arguments;
    // They are those that the collector has met too, and are reported from there.
    info.m_impl->ForgetProblems();
    bool isRight = true;
    if (arguments.GetCount() > 0 || arguments.GetProblems().GetSize() > 0) {
        m_data->usageText = info.GetUsageText();
        isRight = tvx::allocating([&] { return check(arguments, info.GetCmdOpcodes()); });
    }
    if (!isRight) {
        tvx::afx::setStartCode(refusedCommandLine);
    }
    if (!m_data->pending.IsEmpty()) {
        const auto summary = isRight ? std::make_unique<tvx::afx::AskedFor>() : nullptr;
        AfxMessageBox(m_data->pending);
        m_data->pending.Empty();
        return 0;
    }
    return info.IsSmokeTestSwitch() ? 0 : 1;
}
