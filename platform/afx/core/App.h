#pragma once

/// @file
/// The application object and the state of the running module.

#include "platform/afx/core/CommandLineInfo.h"
#include "platform/afx/core/Thread.h"
#include "platform/base/List.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Registry.h"

class CDocManager;
class CDocTemplate;
class CDocument;
class CRecentFileList;

/// What the framework knows about the running module.
struct AFX_MODULE_STATE {
    HINSTANCE m_hCurrentInstanceHandle = nullptr; ///< The application's own module.
    HINSTANCE m_hCurrentResourceHandle = nullptr; ///< The module searched first for resources: AfxGetResourceHandle.
    /// The name given to the application object's constructor, or the program's base name.
    LPCSTR m_lpszCurrentAppName = nullptr;
    /// The application object.
    class CWinApp* m_pCurrentWinApp = nullptr;
};

/// The one application object of a process.
///
/// A host derives a class, defines one global object of it and overrides InitInstance. It has no `main`: the entry
/// point that tvx_add_application links calls InitApplication, InitInstance and, when that answered TRUE, Run.
///
/// @code
/// class CMyApp : public CWinApp {
/// public:
///     CMyApp() : CWinApp("MyApp") {}
///     BOOL InitInstance() override;
/// };
/// CMyApp theApp;
/// @endcode
class TVX_PLATFORM_API CWinApp : public CWinThread {
    DECLARE_DYNAMIC(CWinApp)

public:
    /// @param appName the name used for captions and files; null: the title string of the resources, else the
    /// program's name.
    explicit CWinApp(LPCSTR appName = nullptr);
    ~CWinApp() override;
    CWinApp(const CWinApp&) = delete;
    CWinApp& operator=(const CWinApp&) = delete;

    /// The application's own module; known from InitApplication on.
    HINSTANCE m_hInstance = nullptr;
    /// The command line after the program's name, words with blanks quoted.
    LPSTR m_lpCmdLine = nullptr;
    /// The show state the main window is to begin with.
    int m_nCmdShow = SW_SHOWNORMAL;
    /// Display name: the caption of message boxes. Owned; replaced with free() and strdup().
    LPCSTR m_pszAppName = nullptr;
    /// The program's file name without directory and extension.
    LPCSTR m_pszExeName = nullptr;
    /// Full name of the help file.
    LPCSTR m_pszHelpFilePath = nullptr;
    /// Name of the application's part of the settings below m_pszRegistryKey.
    LPCSTR m_pszProfileName = nullptr;
    /// The maker's part of the settings; null until SetRegistryKey.
    LPCSTR m_pszRegistryKey = nullptr;
    /// Owned; null until the first AddDocTemplate.
    CDocManager* m_pDocManager = nullptr;
    /// Owned; null until LoadStdProfileSettings. A host may put an object of a derived class here before that.
    CRecentFileList* m_pRecentFileList = nullptr;
    /// Whether the pointer chooses what to explain: see CFrameWnd::OnContextHelp.
    BOOL m_bHelpMode = FALSE;

    /// The first call of a start, for what has to be there before InitInstance. FALSE ends the program with exit code
    /// 1, without ExitInstance.
    virtual BOOL InitApplication();
    BOOL InitInstance() override;
    int Run() override;
    BOOL OnIdle(LONG count) override;
    int ExitInstance() override;

    /// Hands each word of the command line to `info`, without its leading "-" or "/" when it is a switch.
    ///
    /// A word that begins with "/" and names an existing file or folder is that file, not a switch.
    void ParseCommandLine(CCommandLineInfo& info);
    /// Does what the command line asked for: a new document, opening the named file, ... FALSE when that failed or
    /// when the application is to end.
    BOOL ProcessShellCommand(CCommandLineInfo& info);

    /// Settings. Each is an entry of a section of the application's part of the user's settings, which is the key
    /// "Software\<maker>\<profile name>", or "Software\<profile name>" before SetRegistryKey was called. Code that sets
    /// m_pszProfileName for a while reaches the settings of that name. Nothing is kept in memory: what another process
    /// writes is seen by the next call. docs/settings.md tells where the file is.
    /// @{

    /// Makes `key` the maker's part of the settings; the application's part becomes its display name, m_pszAppName.
    void SetRegistryKey(LPCSTR key);
    void SetRegistryKey(UINT id);

    /// The number of an entry, or `defaultValue` where there is no entry or it is no number.
    virtual UINT GetProfileInt(LPCSTR section, LPCSTR entry, int defaultValue);
    /// The text of an entry, or `defaultValue` (null: the empty text) where there is no entry or it is no text.
    virtual CString GetProfileStringA(LPCSTR section, LPCSTR entry, LPCSTR defaultValue = nullptr);
    CString GetProfileString(LPCSTR section, LPCSTR entry, LPCSTR defaultValue = nullptr) {
        return GetProfileStringA(section, entry, defaultValue);
    }
    /// The bytes of an entry.
    /// @param data  receives a copy, which the caller frees with delete[]; null where the call fails
    /// @return whether there is such an entry of bytes
    virtual BOOL GetProfileBinary(LPCSTR section, LPCSTR entry, LPBYTE* data, UINT* size);
    /// Writes a number. FALSE when that failed, as in the other calls that write.
    virtual BOOL WriteProfileInt(LPCSTR section, LPCSTR entry, int value);
    /// Writes a text.
    /// @param entry  null removes the whole section
    /// @param value  null removes the entry
    virtual BOOL WriteProfileStringA(LPCSTR section, LPCSTR entry, LPCSTR value);
    BOOL WriteProfileString(LPCSTR section, LPCSTR entry, LPCSTR value) {
        return WriteProfileStringA(section, entry, value);
    }
    /// Writes bytes.
    virtual BOOL WriteProfileBinary(LPCSTR section, LPCSTR entry, LPBYTE data, UINT size);
    /// @}

    /// Calls that hosts make in InitInstance and that have nothing to do here: the desktop opens files by its own
    /// entries of applications, and draws controls in its own style.
    /// @{

    void EnableShellOpen() {}
    void RegisterShellFileTypes(BOOL withPrinting = FALSE) {}
    BOOL Enable3dControls() {
        return TRUE;
    }
    BOOL Enable3dControlsStatic() {
        return TRUE;
    }
    /// @}

    /// Documents.
    /// @{

    /// Makes a kind of document known, in InitInstance. The application deletes it, unless its m_bAutoDelete is FALSE.
    void AddDocTemplate(CDocTemplate* docTemplate);
    /// Goes through the kinds in the order they were added; a null position is the end.
    POSITION GetFirstDocTemplatePosition() const;
    CDocTemplate* GetNextDocTemplate(POSITION& position) const;
    /// Opens a document, or activates it when it is open already. Null when that failed (the user has been told).
    virtual CDocument* OpenDocumentFile(LPCSTR fileName);
    /// Asks for each modified document whether it is to be saved. FALSE when the user cancelled.
    virtual BOOL SaveAllModified();
    /// Closes all documents without asking; SaveAllModified comes first. `endSession` is passed on to the templates.
    void CloseAllDocuments(BOOL endSession);
    /// Documents of all kinds that are open.
    int GetOpenDocumentCount();
    /// Asks for a file name with the document manager's dialog. FALSE when the user cancelled.
    /// @param fileName    comes with the name that is proposed, goes with the one chosen
    /// @param titleId     string resource of the dialog's caption
    /// @param flags       OFN_...
    /// @param docTemplate whose kind of file is proposed; null: all kinds are offered
    BOOL DoPromptFileName(CString& fileName, UINT titleId, DWORD flags, BOOL openDialog, CDocTemplate* docTemplate);
    /// Keeps a list of recent files, in InitInstance behind SetRegistryKey. The settings are read when the list is
    /// first needed.
    /// @param count files that are kept: 16 at most, 0 for no list
    void LoadStdProfileSettings(UINT count = 4);
    /// Puts a file first in the list of recent files, if there is one. Documents do so when they are opened or saved.
    virtual void AddToRecentFileList(LPCSTR path);
    /// A file's name for a place with little room, such as the menu. The base version answers the whole name.
    /// @param maxLength characters that there is room for
    /// @param keepName  whether the name itself is to be answered even where it has no room
    virtual CString GetAbbreviatedFileName(LPCSTR path, int maxLength, BOOL keepName);
    /// @}

    /// Resources.
    /// @{

    /// Icons and cursors are looked for in the whole chain of modules, those named Standard are the system's (IDI_...,
    /// IDC_...). They are shared and stay the framework's; null when there is none of that name or number.
    HICON LoadIcon(LPCSTR name) const;
    HICON LoadIcon(UINT id) const;
    HICON LoadStandardIcon(LPCSTR name) const;
    HCURSOR LoadCursor(LPCSTR name) const;
    HCURSOR LoadCursor(UINT id) const;
    HCURSOR LoadStandardCursor(LPCSTR name) const;
    /// @}

    /// What a derived class may change.
    /// @{

    /// Shows a message box; AfxMessageBox calls this.
    /// @param helpId context of the box's help, 0 for none.
    virtual int DoMessageBox(LPCSTR text, UINT type, UINT helpId);
    /// Shows (1), ends (-1) or shows again (0) the wait cursor.
    virtual void DoWaitCursor(int code);
    /// Every help request of the framework ends here. This system has no viewer of help files, so the base version
    /// tells the user that help could not be started; HELP_QUIT does nothing.
    /// @param data    what help is asked for: a context (HID_BASE_... and an identifier) or the address of a keyword
    /// @param command one of the HELP_ commands
    virtual void WinHelpA(DWORD_PTR data, UINT command = HELP_CONTEXT);
    void WinHelp(DWORD_PTR data, UINT command = HELP_CONTEXT) {
        WinHelpA(data, command);
    }
    /// Help requests of the framework's own windows; calls WinHelpA.
    virtual void WinHelpInternal(DWORD_PTR data, UINT command = HELP_CONTEXT);

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    /// @}

    /// Commands. All but OnAppExit are in no map until the host puts them into its own, for the commands that its menu
    /// has: ON_COMMAND(ID_HELP_FINDER, &CWinApp::OnHelpFinder).
    /// @{

    afx_msg void OnFileNew();
    afx_msg void OnFileOpen();
    /// Closes the main window as its close button does, so that documents are asked about.
    afx_msg void OnAppExit();
    /// Help on where the keyboard is, as the help key asks for it.
    afx_msg void OnHelp();
    /// The list of topics: HELP_INDEX.
    afx_msg void OnHelpIndex();
    /// The search: HELP_FINDER.
    afx_msg void OnHelpFinder();
    /// How help is used: HELP_HELPONHELP.
    afx_msg void OnHelpUsing();
    /// Lets the pointer choose what to explain, if the main window is a frame (WM_COMMAND with ID_CONTEXT_HELP).
    afx_msg void OnContextHelp();

    /// Puts the recent files into the menu; opens one of them. Both are in this class's own map, for ID_FILE_MRU_FILE1
    /// to 16. A file that is gone is taken out of the list when it cannot be opened.
    afx_msg void OnUpdateRecentFileMenu(CCmdUI* item);
    afx_msg BOOL OnOpenRecentFile(UINT id);

    /// Stores the list of recent files where the host has changed it; ExitInstance does.
    void SaveStdProfileSettings();
    /// Hides the main window: the first step of the end.
    void HideApplication();

    DECLARE_MESSAGE_MAP()
    /// @}
private:
    friend int AfxWinMain(int argc, char** argv);
    void rememberCommandLine(int argc, char** argv);
    void DeleteDocManager();
    void DeleteRecentFileList();
    CString profilePath() const;
    LSTATUS writeEntry(LPCSTR section, LPCSTR entry, DWORD type, std::string_view bytes);
    int m_waitDepth = 0;
};

/// The application object, null before its constructor ran.
TVX_PLATFORM_API CWinApp* AfxGetApp();
/// The application's main window, null when there is none.
TVX_PLATFORM_API CWnd* AfxGetMainWnd();
/// The one state of the process, which all modules share; each call brings its handles up to date.
TVX_PLATFORM_API AFX_MODULE_STATE* AfxGetModuleState();
/// The name given to the application object, else the program's without directory and extension. Null while neither is
/// known: before an application object without a name is run.
TVX_PLATFORM_API LPCSTR AfxGetAppName();

/// Shows a message box with the application's display name as caption and answers the button (IDOK, ...).
///
/// Without a display caption and text go to standard error and the default button is answered.
/// @param type MB_...: buttons, icon and default button.
/// @param helpId context of the box's help, 0 for none.
TVX_PLATFORM_API int AfxMessageBox(LPCSTR text, UINT type = MB_OK, UINT helpId = 0);
/// The same with a string resource.
TVX_PLATFORM_API int AfxMessageBox(UINT textId, UINT type = MB_OK, UINT helpId = static_cast<UINT>(-1));
/// A message box with a caption of its own over `owner` (may be null).
TVX_PLATFORM_API int MessageBoxA(HWND owner, LPCSTR text, LPCSTR caption, UINT type);
inline int MessageBox(HWND owner, LPCSTR text, LPCSTR caption, UINT type) {
    return MessageBoxA(owner, text, caption, type);
}
/// The desktop's one sound for mistakes, whatever the type; none without a display. Always TRUE.
TVX_PLATFORM_API BOOL MessageBeep(UINT type);
/// Puts texts into the places "%1" and "%2" of a string resource, which every module may have.
TVX_PLATFORM_API void AfxFormatString1(CString& result, UINT formatId, LPCSTR first);
/// The same for a format with two places.
TVX_PLATFORM_API void AfxFormatString2(CString& result, UINT formatId, LPCSTR first, LPCSTR second);
/// What the entry point runs: the application object's life from InitApplication to its exit code.
TVX_PLATFORM_API int AfxWinMain(int argc, char** argv);
