#include "s/CommandLineState.h"

#include "platform/base/Text.h"
#include "platform/port/CmdFile.h"
#include "s/WinAppData.h"

#include <iterator>
#include <string>

void ExpandCommandFile(CCommandLineInfo& parser, const char* name, CStringArray& problems) {
    const char* const vector[] = {"exe", "-f", name};
    const UT_CMDFILE file(static_cast<int>(std::size(vector)), vector, UT_CMDFILE::Reporting::Silent);
    for (const std::string& problem : file.geterrors()) {
        problems.Add(CString(problem.c_str()));
    }
    const int count = file.getargc();
    for (int i = 1; i < count; ++i) {
        const auto [text, isSwitch] = tvx::afx::takeApart(file.getargv()[i]);
        parser.ParseParam(text, isSwitch, i == count - 1);
    }
}

void NoteMissingCommandFile(bool isPending, bool hasFile, CStringArray& problems) {
    if (isPending && !hasFile) {
        problems.Add("Option \"-f\" needs a command file after it.");
    }
}

void IssueCommandFileProblems(const CStringArray& problems) {
    for (INT_PTR i = 0; i < problems.GetSize(); ++i) {
        WinAppOrigin(__LINE__).issueError("%s", problems[i].GetString());
    }
}

Gui_CmdLineArgsArray::Gui_CmdLineArgsArray() {
    AfxGetApp()->ParseCommandLine(*this);
    NoteMissingCommandFile(m_commandFilePending != 0, m_hasCommandFile, m_problems);
}

Gui_CmdLineArgsArray::~Gui_CmdLineArgsArray() {
    for (INT_PTR i = 0; m_vector && i < m_arguments.GetSize(); ++i) {
        m_arguments[i].ReleaseBuffer();
    }
}

void Gui_CmdLineArgsArray::ParseParam(const char* param, BOOL isSwitch, BOOL) {
    if (isSwitch) {
        NoteMissingCommandFile(m_commandFilePending != 0, m_hasCommandFile, m_problems);
        m_commandFilePending = tvx::text::equalNoCase(param, "f");
        m_hasCommandFile = false;
        if (!m_commandFilePending) {
            m_arguments.Add(CString('-') + param);
        }
    } else if (m_commandFilePending) {
        m_hasCommandFile = true;
        tvx::allocating([&] { ExpandCommandFile(*this, param, m_problems); });
    } else {
        m_arguments.Add(CString(param));
    }
}

int Gui_CmdLineArgsArray::GetCount() const {
    return static_cast<int>(m_arguments.GetSize());
}

char** Gui_CmdLineArgsArray::GetVector() {
    if (!m_vector && GetCount() > 0) {
        m_vector = tvx::allocating([this] { return std::make_unique<char*[]>(static_cast<std::size_t>(GetCount())); });
        for (int i = 0; i < GetCount(); ++i) {
            m_vector[i] = m_arguments[i].GetBuffer();
        }
    }
    return m_vector.get();
}

const CStringArray& Gui_CmdLineArgsArray::GetProblems() const {
    return m_problems;
}
