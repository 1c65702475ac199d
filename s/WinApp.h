#pragma once

#include "afxwin.h"
#include "s/CommandLineInfo.h"
#include "s/Export.h"

#include <memory>

class CDocTemplate;
class CFileDialog;
struct Gui_WinAppData;

/// The application object of a host of the family. A host derives a class and defines one global object of it:
///
/// @code
/// class BoardApp : public Gui_WinApp {
/// public:
///     BoardApp() : Gui_WinApp("board") {}
///     BOOL InitInstance() override;
///     HICON GetAppIcon() override { return LoadIcon(IDR_MAINFRAME); }
///     CString GetAppVersion() override { return "1.0"; }
/// };
/// BoardApp theApp;
///
/// BOOL BoardApp::InitInstance() {
///     SetRegistryKey("Tarvex");
///     BoardCommandLine info;
///     ParseCommandLine(info);
///     if (!ProcessCommandLine(info))
///         return FALSE; // the user has been told why
///     ...
/// @endcode
///
/// It lives as long as the process. Everything runs on the thread that made it, the user-interface thread.
class GUI_API Gui_WinApp : public CWinApp {
    DECLARE_DYNAMIC(Gui_WinApp)

public:
    /// @param appName the application's name in files and settings, copied; it stays the module's recorded name
    ///     (`AfxGetAppName`) when SetRegistryKey gives the application another name for display
    explicit Gui_WinApp(const char* appName);
    ~Gui_WinApp() override;

    /// Names the application and its place in the settings. Call it first in InitInstance.
    ///
    /// The application's title string (57344) becomes the name of its settings, and "Tarvex" with the title the display
    /// name, which message boxes have as caption. A host without that string keeps its name from the constructor as
    /// title.
    /// @param key the family's part of the settings
    void SetRegistryKey(const char* key);

    /// Checks the command line against the host's option specification and shows in one message box what there is to
    /// say: usage, errors and what is wrong with command files. Errors are shown when they are found as well.
    ///
    /// Call it after ParseCommandLine with the same object. With no word on the command line there is nothing to check.
    /// @return 1: go on; 0: end, because something was shown or `-smoketest` was given. The host answers FALSE from
    ///     InitInstance then. After an error, one in a command file too, the process ends with the exit code 2 unless
    ///     ExitInstance answers another one than 0; after help and a smoke test with 0
    int ProcessCommandLine(const Gui_CommandLineInfo& info);

    /// Runs the message loop until the application ends.
    ///
    /// An exception that no handler has caught ends it: a `Port::Exception` reports itself, a `std::exception` is
    /// issued as an error message with its `what()`, both followed by a fatal message; anything else gives the fatal
    /// message alone, except the framework's own exceptions, which end the loop without a message. The messages go to
    /// the message manager that is registered (see Gui_MessageManager), else to standard error.
    /// @return the exit code: that of the loop, 1 after an exception
    int Run() override;

    /// The framework's translation of key presses into commands.
    BOOL PreTranslateMessage(MSG* message) override;
    /// Called once before InitInstance. It makes a Gui_DocManager the application's document manager; the destructor
    /// puts the one back that was there before.
    BOOL InitApplication() override;

    /// Shows the wait cursor (1), ends it (-1) or shows it again (0). At 0 and less the pointer is set to where it
    /// already is, so that the new shape shows before the user moves it.
    void DoWaitCursor(int code) override;

    /// Every help request of the application ends here. One whose help file is a help map (Gui_Help::SetHelpFileName)
    /// answers it with documents (Gui_BrowserHelp), another one with the platform's viewer, of which there is none
    /// here.
    /// @param data    what help is asked for: a context number or a keyword, as @p command says
    /// @param command one of the HELP_ commands
    void WinHelpA(DWORD_PTR data, UINT command = HELP_CONTEXT) override;
    /// Hands the framework's own help requests to WinHelpA, so that an override of that gets all of them.
    void WinHelpInternal(DWORD_PTR data, UINT command = HELP_CONTEXT) override;

    /// The address of the family's page on the web that sends on to the one in the user's language; more parameters may
    /// be appended: GetRedirectUrl() + "&topic=support". The server is that of the build or the installation
    /// (docs/installation.md). The page's language is Japanese, Korean or Chinese (traditional or simplified) when the
    /// user's is, else English.
    static CString GetRedirectUrl();

    /// The name with "..." in place of its first folders, as Gui_FileName::GetAbbreviatedName makes it. The list of
    /// recent files shows such names.
    CString GetAbbreviatedFileName(const char* path, int maxLength, BOOL keepName) override;

    /// The icon for the About box; it stays the application's.
    virtual HICON GetAppIcon() = 0;
    /// The application's version as the user is to read it.
    virtual CString GetAppVersion() = 0;

    /// @name The file dialogs
    /// What shapes the dialogs in which documents are opened and saved: Gui_DocManager asks for all of it, in another
    /// order, each time that it shows one. An override usually changes what the base version answers.
    /// @{

    /// The window that owns the dialog: the main window, null when there is none.
    virtual HWND GetOwnerForFileDialog();
    /// The folder in which the dialog begins: that of @p fileName when it is an absolute name, else the current one.
    virtual CString GetInitialDirForFileDialog(const CString& fileName);
    /// What stands in the name field: an absolute @p fileName without its folder, else @p fileName as it is.
    virtual CString GetBaseNameForFileDialog(const CString& fileName);
    /// The filter texts, made with AddFileFilter.
    /// @param docTemplate  whose files are shown; null means those of all templates
    /// @param addAllFiles  non-zero: all files can be chosen as well
    virtual CString GetFilterForFileDialog(CDocTemplate* docTemplate, int addAllFiles);
    /// The extension, without dot, of names typed without one.
    /// @param docTemplate whose extension; null means the first template
    virtual CString GetDefaultExtForFileDialog(CDocTemplate* docTemplate);
    /// The dialog's title: the string @p titleId, empty when there is none.
    virtual CString GetTitleForFileDialog(unsigned int titleId);
    /// The dialog's OFN_ flags, made from @p flags: no Help button.
    virtual unsigned int GetFlagsForFileDialog(unsigned int flags);
    /// The full name of the file that was chosen in @p dialog.
    virtual CString GetPathNameFromFileDialog(CFileDialog& dialog);

    /// Appends an entry to a filter text, which holds pairs of description and pattern, each ended by a zero, and a
    /// zero at the end.
    static void AddFileFilter(CString& filter, const CString& description, const CString& pattern);
    /// The same with the string @p descriptionId as description.
    static void AddFileFilter(CString& filter, unsigned int descriptionId, const CString& pattern);
    /// Appends the entry of a template, if it has a filter name and an extension.
    static void AddFileFilter(CString& filter, CDocTemplate* docTemplate);
    /// @}

    /// @name One running instance
    /// A host that allows one running instance for each application name asks at its start and says goodbye at its end:
    ///
    /// @code
    /// BOOL BoardApp::InitInstance() {
    ///     if (!IsFirstInstance()) {
    ///         ShowFirstInstanceWindow();
    ///         return FALSE;
    ///     }
    ///     RegisterInstance();
    ///     ... // the main window
    ///     RegisterInstanceWindow(Gui_Desktop::GetMainWindowID());
    ///
    /// int BoardApp::ExitInstance() {
    ///     UnregisterInstance();
    ///     return Gui_WinApp::ExitInstance();
    /// }
    /// @endcode
    ///
    /// The first instance's process and window stand in the settings under the application's name as given to the
    /// constructor. A process that ended without UnregisterInstance is found to have ended, also when another process
    /// has got its number since. Nothing locks the record: of two that start in the same moment both may run.
    ///
    /// With `TVX_GUI_INSTANCECHECKING` set to a text that begins with "0" the record is left alone, and every instance
    /// is the first. No operation shows a message. docs/single-instance.md tells more.
    /// @{

    /// Whether no other instance is recorded, or the recorded one has ended: 1 or 0.
    int IsFirstInstance();
    /// Records this process as the first instance, as yet without a window.
    /// @return 1
    int RegisterInstance();
    /// Records the main window of this process, once it exists. Nothing happens without RegisterInstance.
    /// @param windowId  see Gui_Desktop::GetMainWindowID; 0 for none
    void RegisterInstanceWindow(unsigned long windowId);
    /// Brings the window of the recorded first instance to the front.
    /// @return 1; 0 when there is no live first instance, or it has no window yet or no longer
    int ShowFirstInstanceWindow();
    /// Clears the record if it names this process.
    void UnregisterInstance();
    /// @}

protected:
    /// Commands of every application's Help menu; the application has them as soon as its menu names them.
    /// @{

    /// GUI_ID_HELP_MANUALS: opens the installed manuals in the PDF viewer.
    afx_msg void OnCommonHelpOnlineDocuments();
    /// GUI_ID_HELP_SUPPORT: opens the support page in the web browser.
    afx_msg void OnCommonHelpSupportServices();
    /// GUI_ID_HELP_ABOUT: shows the About box.
    afx_msg void OnHelpAbout();
    /// @}
    DECLARE_MESSAGE_MAP()

private:
    std::unique_ptr<Gui_WinAppData> m_data;
};
