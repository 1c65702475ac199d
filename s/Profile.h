#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The settings of an application and of the family. There are no objects of this class.
///
/// Values are texts below "Software" of the current user's settings:
///
/// | where | what |
/// |---|---|
/// | `<registry key>\<title>\<section>` | the application's own, by ReadString and WriteString |
/// | `Tarvex\Common` | what all applications of the family share |
/// | `Tarvex\<application name>\FirstInstance` | the first instance (docs/single-instance.md) |
///
/// The registry key and the title are those of Gui_WinApp::SetRegistryKey. Each operation reads or writes the store
/// itself; what another process writes is there at once. docs/settings.md has the whole layout.
///
/// @code
/// CString unit = "mm";
/// Gui_Profile::ReadString(unit, "Unit", nullptr); // stays "mm" where nothing is stored
/// Gui_Profile::WriteString("inch", "Unit", nullptr);
/// @endcode
class GUI_API Gui_Profile {
public:
    Gui_Profile& operator=(const Gui_Profile&) = default;

    /// Reads a text of the running application.
    /// @param value    receives the text; unchanged when there is none
    /// @param section  null: "Settings"
    /// @return 1, or 0 when there is no text or an empty one
    static int ReadString(CString& value, const char* entry, const char* section);
    /// Writes a text of the running application. Nothing is reported when that fails.
    /// @param value    null removes the entry
    /// @param entry    null removes the whole section
    /// @param section  null: "Settings"
    static void WriteString(const char* value, const char* entry, const char* section);

    /// Where an application that keeps settings for each version of a suite is to keep them: a path like
    /// "NEV\10.1\board" below a key that the caller chooses. No key is touched.
    ///
    /// | suite | application | version | path |
    /// |---|---|---|---|
    /// | no | no | no | `Common` |
    /// | no | no | yes | `Common\<version>` |
    /// | no | yes | no | `Common\<application>` |
    /// | no | yes | yes | `Common\<version>\<application>` |
    /// | yes | no | yes | `NEV\<version>\Common` |
    /// | yes | yes | yes | `NEV\<version>\<application>` |
    /// | yes | any | no | empty |
    ///
    /// The version is the first four characters of the installation's ("10.1" without one).
    static CString GetKeyLocation(CString appName, bool underSuite, bool perApplication, bool versioned);

    /// Writes a number of the record of an application's first instance. Nothing is reported when that fails.
    /// @param appName    the application's name as given to the constructor of Gui_WinApp
    /// @param valueName  "ProcessID" or "WindowID"
    /// @param value      0 for none; 32 bits are kept
    static void WriteFirstInstanceInfo(const char* appName, const char* valueName, unsigned long value);
    /// Reads a number of that record. Makes the record's key when it is missing.
    /// @param value  receives the number (0 means none); unchanged when there is none that can be read
    /// @return 1, or 0 when nothing, no number or too long a text is stored
    static int ReadFirstInstanceInfo(const char* appName, const char* valueName, unsigned long& value);

    /// Where windows stood. A record holds flags, show state, the two corners, the restored rectangle and the size of
    /// the primary screen; it counts only on a screen of that size. A rectangle off the screen is returned as stored:
    /// CWnd::SetWindowPlacement keeps the caption within reach.
    /// @{

    /// Reads where the main window stood.
    /// @param placement  unchanged when nothing is read
    /// @param entry      null: "WindowPlacement"
    /// @param section    null: "Settings"
    /// @return 1, or 0 when nothing, a damaged record or one of another screen size is stored
    static int ReadWindowPlacement(WINDOWPLACEMENT& placement, const char* entry, const char* section);
    /// Writes where the main window stands, as CWnd::GetWindowPlacement tells it. Nothing is reported when that fails.
    static void WriteWindowPlacement(WINDOWPLACEMENT& placement, const char* entry, const char* section);
    /// Reads where a dialog stood. Dialogs of the same name in all applications of the family share one record.
    /// @param placement  unchanged when nothing is read
    /// @return as ReadWindowPlacement
    static int ReadDialogWindowPlacement(const char* name, WINDOWPLACEMENT& placement);
    /// Writes where a dialog stands. Nothing is reported when that fails.
    static void WriteDialogWindowPlacement(const char* name, WINDOWPLACEMENT& placement);
    /// @}

    /// Where the bars of a frame stood: side, row, place in the row, floating, shown.
    /// @{

    /// Whether the kept state fits the frame: each bar that was docked is still there. True when nothing is kept.
    /// @param profileName  null: "ControlBar"
    /// @return 1 or 0
    static int CheckBarState(CFrameWnd* frame, const char* profileName);
    /// Puts the bars where they stood, if the state fits. Otherwise they stay, and the state is kept.
    /// @param profileName  null: "ControlBar"
    /// @return 1
    static int ReadBarState(CFrameWnd* frame, const char* profileName);
    /// Keeps where the bars stand. Nothing is reported when that fails.
    /// @param profileName  null: "ControlBar"
    static void WriteBarState(CFrameWnd* frame, const char* profileName);
    /// @}

    /// Fonts.
    /// @{

    /// Reads a font.
    /// @param font     unchanged when nothing is read
    /// @param entry    null: "Font"
    /// @param section  null: "Settings"
    /// @return 1, or 0 when nothing, a damaged record or one with an empty or too long face name is stored
    static int ReadLogFont(LOGFONTA& font, const char* entry, const char* section);
    /// Writes a font. Nothing is reported when that fails.
    /// @param font  a "~" in its face name becomes a space, here and in what is read back. A font with an empty face
    ///              name does not come back
    static void WriteLogFont(LOGFONTA& font, const char* entry, const char* section);
    /// @}

    /// Which programs open texts and pages: command lines that the user has named once for the whole family, else those
    /// of the system. Nothing is reported when nothing is found, or when writing fails. docs/programs.md tells how they
    /// are started.
    /// @{

    /// Reads the text editor: the user's, which may be empty, else the default one.
    /// @return 1
    static int ReadTextEditorName(CString& name);
    /// Keeps the user's text editor.
    static void WriteTextEditorName(const char* name);
    /// The text editor where the user has named none: the one registered as the system's, else "wordpad.exe".
    static void GetDefaultTextEditorName(CString& name);

    /// Reads the web browser: the user's, else the default one.
    /// @param name  receives the command line, in which "%1" stands for the address; unchanged when there is none
    /// @return 1, or 0 when there is none
    static int ReadWebBrowserName(CString& name);
    /// Keeps the user's web browser; the empty text means the default one.
    static void WriteWebBrowserName(const char* name);
    /// The web browser where the user has named none: the one that opens ".htm" files, else Internet Explorer.
    /// @param name  unchanged when there is none
    static void GetDefaultWebBrowserName(CString& name);
    /// @}

private:
    Gui_Profile() = default;
};
