#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

class Gui_CommandLineInfo_Impl;

/// The command line of an application of the family. Each host derives a class that says which options it takes:
///
/// @code
/// class BoardCommandLine : public Gui_CommandLineInfo {
/// public:
///     CString GetCmdOpcodes() const override {
///         return "scale real : Scale of the drawings.\n<drawing> 0..* : Drawings to open.\n";
///     }
///     CString GetUsageText() const override { return "Drawings are files with the extension .brd."; }
/// };
///
/// BOOL BoardApp::InitInstance() {
///     BoardCommandLine info;
///     ParseCommandLine(info);
///     if (!ProcessCommandLine(info))
///         return FALSE;
/// @endcode
///
/// The whole family takes these switches, with "-" or "/" in front and in any letter case:
///
/// | switch | meaning |
/// |---|---|
/// | `-help`, `-h` | see IsHelpSwitch; `ProcessCommandLine` shows the usage |
/// | `-smoketest` | the application checks its command line and ends |
/// | `-nosplash` | no splash screen: m_bShowSplash becomes FALSE |
/// | `-intstyle STYLE` | see GetStyleSwitch; STYLE is `nev`, `kelma` or `silent`, any other word is ignored |
/// | `-f FILE...` | the words up to the next switch name command files, whose words take their place |
///
/// A switch that the host's option specification lists may be abbreviated as long as only one option begins that way:
/// `-smoke` is `-smoketest`, for the check as well as here.
///
/// They are known without the host's doing, but `ProcessCommandLine` accepts only what the option specification lists,
/// so a host lists those it wants to take (`-f` apart, which is gone by then). Everything else goes to the base class,
/// which takes the first plain word as the file to open.
///
/// The option specification is asked for once, when the first switch comes that is none of these.
///
/// A word that begins with "/" and names an existing file or folder is that name and not a switch. Command files that
/// cannot be read, or lead back to themselves, and `-f` without a file are errors: `ProcessCommandLine` shows them. If
/// it is never called, they are issued when this object is destroyed. An exhausted heap raises the framework's memory
/// exception.
class GUI_API Gui_CommandLineInfo : public CCommandLineInfo {
public:
    /// How the application is to talk to its user.
    enum IntStyleEnum {
        IntStyleNev = 0,    ///< "nev"
        IntStyleKelma = 1,  ///< "kelma"
        IntStyleSilent = 2, ///< "silent"
        IntStyleNone = 3    ///< none was asked for
    };

    ~Gui_CommandLineInfo() override;
    Gui_CommandLineInfo(const Gui_CommandLineInfo&) = delete;
    Gui_CommandLineInfo& operator=(const Gui_CommandLineInfo&) = delete;

    /// Takes one word. An override handles its own words and passes the others on; it sees the words of command files
    /// just as those of the command line.
    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override;

    /// 1 when `-smoketest` was given, else 0.
    virtual int IsSmokeTestSwitch() const;
    /// 1 when `-help` or `-h` was given, else 0.
    virtual int IsHelpSwitch() const;
    /// The style asked for last with `-intstyle`.
    virtual IntStyleEnum GetStyleSwitch() const;
    /// The host's option specification, in the notation of `UT_CMDARGS` (docs/command-line.md).
    virtual CString GetCmdOpcodes() const = 0;
    /// A text shown behind the usage summary; may be empty.
    virtual CString GetUsageText() const = 0;

protected:
    Gui_CommandLineInfo();

private:
    friend class Gui_WinApp;

    std::unique_ptr<Gui_CommandLineInfo_Impl> m_impl;
};
