#pragma once

#include "platform/base/Export.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"
#include "platform/base/Types.h"

/// What the command line asks for. The host makes one object, hands it to `CWinApp::ParseCommandLine`, which gives it
/// every word, and then to `CWinApp::ProcessShellCommand`, which does what it says:
///
/// @code
/// CCommandLineInfo info;
/// ParseCommandLine(info);
/// if (!ProcessShellCommand(info))
///     return FALSE;
/// @endcode
///
/// A host with switches of its own derives a class and overrides ParseParam; what it does not know it passes on to the
/// base, which knows:
///
/// | word | meaning |
/// |---|---|
/// | `NAME` | opens that file; further plain words are of no interest to the base |
/// | `-p NAME` | prints that file and ends |
/// | `-pt NAME PRINTER DRIVER PORT` | prints that file on that printer and ends |
/// | `-dde` | starts without a document and waits for requests |
/// | `-Register`, `-Regserver` | enters the application with the desktop and ends |
/// | `-Unregister`, `-Unregserver` | takes those entries out and ends |
/// | `-Embedding`, `-Automation` | started by another program: no splash screen |
///
/// The first three switches are compared exactly, the others without case.
class TVX_PLATFORM_API CCommandLineInfo : public CObject {
public:
    /// What `CWinApp::ProcessShellCommand` is to do.
    enum ShellCommand {
        FileNothing = -1, ///< nothing, not even a new document; only hosts set it
        FileNew,          ///< make a new document, the default
        FileOpen,         ///< open m_strFileName
        FilePrint,        ///< print m_strFileName and end
        FilePrintTo,      ///< print it on m_strPrinterName and end
        FileDDE,          ///< wait for requests
        AppRegister,      ///< make the desktop's entries and end
        AppUnregister     ///< remove them and end
    };

    CCommandLineInfo() = default;
    ~CCommandLineInfo() override = default;

    /// Takes one word of the command line.
    /// @param param    the word, without the "-" or "/" of a switch
    /// @param isSwitch whether it had one
    /// @param isLast   whether no word follows
    virtual void ParseParam(const char* param, BOOL isSwitch, BOOL isLast);

    /// Whether the application should show its splash screen.
    BOOL m_bShowSplash = TRUE;
    /// Whether another program started it to show or edit an object in its own windows.
    BOOL m_bRunEmbedded = FALSE;
    /// Whether another program started it to control it.
    BOOL m_bRunAutomated = FALSE;
    ShellCommand m_nShellCommand = FileNew;
    /// The file to open or print, as it was given; empty for none.
    CString m_strFileName;
    /// @{
    /// Of FilePrintTo only.
    CString m_strPrinterName;
    CString m_strDriverName;
    CString m_strPortName;
    /// @}

protected:
    /// Takes a switch.
    void ParseParamFlag(const char* param);
    /// Takes a plain word: the file, and after `-pt` printer, driver and port.
    void ParseParamNotFlag(const char* param);
    /// Ends the parsing once the last word was taken.
    void ParseLast(BOOL isLast);
};

namespace tvx::afx {

/// A word of a command line or command file as `CCommandLineInfo::ParseParam` takes it.
struct CommandLineWord {
    const char* text; ///< the word, for a switch what follows the "-" or "/"; points into the word given
    bool isSwitch;
};

/// Tells switches from plain words. A word that begins with "-" or "/" is a switch, unless it begins with "/" and names
/// an existing file or folder: then it is that name.
/// @param word zero-terminated, in UTF-8
[[nodiscard]] TVX_PLATFORM_API CommandLineWord takeApart(const char* word);

} // namespace tvx::afx
