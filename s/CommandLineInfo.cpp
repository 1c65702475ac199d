#include "s/CommandLineInfo.h"

#include "platform/base/Text.h"
#include "s/CommandLineState.h"
#include "s/Record.h"

#include <iterator>

Gui_CommandLineInfo::Gui_CommandLineInfo() : m_impl(MakeRecord<Gui_CommandLineInfo_Impl>()) {}

Gui_CommandLineInfo::~Gui_CommandLineInfo() = default;

void Gui_CommandLineInfo::ParseParam(const char* param, BOOL isSwitch, BOOL isLast) {
    if (!tvx::allocating([&] { return m_impl->ParseParam(*this, param, isSwitch); })) {
        CCommandLineInfo::ParseParam(param, isSwitch, isLast);
    }
    if (m_impl->IsNoSplashSwitch()) {
        m_bShowSplash = FALSE;
    }
}

int Gui_CommandLineInfo::IsSmokeTestSwitch() const {
    return m_impl->IsSmokeTestSwitch();
}

int Gui_CommandLineInfo::IsHelpSwitch() const {
    return m_impl->IsHelpSwitch();
}

Gui_CommandLineInfo::IntStyleEnum Gui_CommandLineInfo::GetStyleSwitch() const {
    return m_impl->GetStyleSwitch();
}

Gui_CommandLineInfo_Impl::~Gui_CommandLineInfo_Impl() {
    // A destructor has nobody to tell that the heap is exhausted.
    try {
        tvx::allocating([this] {
            EndExpectation();
            IssueCommandFileProblems(m_problems);
        });
    } catch (CMemoryException* exception) {
        exception->Delete();
    }
}

int Gui_CommandLineInfo_Impl::IsSmokeTestSwitch() const {
    return m_smokeTest;
}

int Gui_CommandLineInfo_Impl::IsHelpSwitch() const {
    return m_help;
}

int Gui_CommandLineInfo_Impl::IsNoSplashSwitch() const {
    return m_noSplash;
}

Gui_CommandLineInfo_Impl::IntStyleEnum Gui_CommandLineInfo_Impl::GetStyleSwitch() const {
    return m_style;
}

bool Gui_CommandLineInfo_Impl::ParseParam(Gui_CommandLineInfo& owner, const char* param, BOOL isSwitch) {
    if (isSwitch) {
        EndExpectation();
        return ParseSwitch(param) || ParseAbbreviation(owner, param);
    }
    switch (m_expectation) {
    case Expectation::Style:
        ParseStyle(param);
        return true;
    case Expectation::CommandFile:
        m_hasCommandFile = true;
        ExpandCommandFile(owner, param, m_problems);
        return true;
    case Expectation::Nothing:
        break;
    }
    return false;
}

bool Gui_CommandLineInfo_Impl::ParseSwitch(const char* param) {
    const auto is = [param](const char* name) { return tvx::text::equalNoCase(param, name); };
    if (is("smoketest")) {
        m_smokeTest = 1;
    } else if (is("help") || is("h")) {
        m_help = 1;
    } else if (is("nosplash")) {
        m_noSplash = 1;
    } else if (is("intstyle")) {
        m_expectation = Expectation::Style;
    } else if (is("f")) {
        m_expectation = Expectation::CommandFile;
    } else {
        return false;
    }
    return true;
}

/// Takes the abbreviations that the check of the options takes.
bool Gui_CommandLineInfo_Impl::ParseAbbreviation(const Gui_CommandLineInfo& owner, const char* param) {
    if (!m_options) {
        m_options = std::make_unique<UT_CMDOPCODES>(owner.GetCmdOpcodes());
    }
    const char* const name = m_options->optionname(param);
    return name && ParseSwitch(name);
}

void Gui_CommandLineInfo_Impl::ParseStyle(const char* param) {
    static constexpr const char* names[] = {"nev", "kelma", "silent"};
    m_expectation = Expectation::Nothing;
    for (std::size_t style = 0; style < std::size(names); ++style) {
        if (tvx::text::equalNoCase(param, names[style])) {
            m_style = static_cast<IntStyleEnum>(style);
        }
    }
}

void Gui_CommandLineInfo_Impl::EndExpectation() {
    NoteMissingCommandFile(m_expectation == Expectation::CommandFile, m_hasCommandFile, m_problems);
    m_expectation = Expectation::Nothing;
    m_hasCommandFile = false;
}

void Gui_CommandLineInfo_Impl::ForgetProblems() {
    EndExpectation();
    m_problems.RemoveAll();
}
