#pragma once

#include "platform/port/CmdOpcodes.h"
#include "s/CommandLineInfo.h"
#include "s/Export.h"

#include "afxcoll.h"

#include <memory>

/// @file
/// What the library keeps of a command line. Not for hosts: the tests are the only ones outside that include this.

/// Hands the words of a command file to a parser, as if they stood on the command line.
/// @param parser   gets each word through its ParseParam; files that are named inside are thus expanded by it
/// @param name     the file
/// @param problems receives a text for the file that is refused, and for each quote that is not closed
GUI_API void ExpandCommandFile(CCommandLineInfo& parser, const char* name, CStringArray& problems);

/// Adds a problem when a switch for command files has come and no file behind it.
void NoteMissingCommandFile(bool isPending, bool hasFile, CStringArray& problems);

/// Issues each text as an error message.
GUI_API void IssueCommandFileProblems(const CStringArray& problems);

/// What the family's switches have set, and what the next plain word is.
class GUI_API Gui_CommandLineInfo_Impl {
public:
    using IntStyleEnum = Gui_CommandLineInfo::IntStyleEnum;

    /// Whether the switch was given: 1 or 0. What each means is told at the public class of the command line.
    /// @{
    virtual int IsSmokeTestSwitch() const;
    virtual int IsHelpSwitch() const;
    virtual int IsNoSplashSwitch() const;
    /// @}
    /// The style asked for by the latest style switch.
    virtual IntStyleEnum GetStyleSwitch() const;

    Gui_CommandLineInfo_Impl() = default;
    Gui_CommandLineInfo_Impl(const Gui_CommandLineInfo_Impl&) = delete;
    Gui_CommandLineInfo_Impl& operator=(const Gui_CommandLineInfo_Impl&) = delete;
    /// Issues the problems that nobody has reported.
    virtual ~Gui_CommandLineInfo_Impl();

    /// Takes a word if it is one of the family's.
    /// @param owner gets the words of command files
    /// @return whether it was
    bool ParseParam(Gui_CommandLineInfo& owner, const char* param, BOOL isSwitch);

    /// Forgets the problems of command files: they have been reported.
    void ForgetProblems();

private:
    /// What a plain word is.
    enum class Expectation { Style = 0, CommandFile = 1, Nothing = 2 };

    bool ParseSwitch(const char* param);
    bool ParseAbbreviation(const Gui_CommandLineInfo& owner, const char* param);
    void ParseStyle(const char* param);
    void EndExpectation();

    int m_smokeTest = 0;
    int m_help = 0;
    int m_noSplash = 0;
    IntStyleEnum m_style = Gui_CommandLineInfo::IntStyleNone;
    Expectation m_expectation = Expectation::Nothing;
    bool m_hasCommandFile = false; ///< one came since they are expected
    CStringArray m_problems;
    std::unique_ptr<UT_CMDOPCODES> m_options; ///< the host's, once a switch was looked for among them
};

/// All words of the running application's command line, command files replaced by their words, in the form that the
/// check of the options takes: switches begin with "-", the program's name is left out.
class GUI_API Gui_CmdLineArgsArray : public CCommandLineInfo {
public:
    /// Goes through the command line of the application object.
    Gui_CmdLineArgsArray();
    ~Gui_CmdLineArgsArray() override;
    Gui_CmdLineArgsArray(const Gui_CmdLineArgsArray&) = delete;
    Gui_CmdLineArgsArray& operator=(const Gui_CmdLineArgsArray&) = delete;

    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override;

    /// How many words there are, those of command files included.
    int GetCount() const;
    /// The words as a vector, null when there is none. It points into this object.
    char** GetVector();
    /// What is wrong with the command files, also that a switch for them names none.
    const CStringArray& GetProblems() const;

private:
    std::unique_ptr<char*[]> m_vector;
    CStringArray m_arguments;
    int m_commandFilePending = 0;
    bool m_hasCommandFile = false; ///< one came since it is pending
    CStringArray m_problems;
};
