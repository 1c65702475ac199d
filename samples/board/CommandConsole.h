#pragma once

#include "BoardDoc.h"
#include "Options.h"
#include "afxwin.h"
#include "s/Console.h"

#include <string>
#include <vector>

/// The board's console: what the menus do can be typed, recalled, and kept in script files. Commands are English in
/// every language, so that scripts work everywhere; what is reported is the user's language.
///
/// A command that fails says what was expected, and stays in the field.
class CCommandConsole {
public:
    CCommandConsole();
    /// Registers the console; call it in InitInstance.
    void Init();
    void Open();
    /// Puts what concerns the console in force.
    void SetOptions(const Options& options);

private:
    /// A command. It gets the words behind its name.
    struct Command {
        const char* name;
        bool (CCommandConsole::*run)(const CString& words);
        bool needsDrawing;
    };
    static const Command commands[];

    static int OnCommand(const char* text);
    bool Execute(const CString& text);
    bool ExecuteFile(const CString& path);
    bool ReadLines(const CString& path, std::vector<CString>& lines);

    bool OnNew(const CString& words);
    bool OnOpen(const CString& words);
    bool OnSave(const CString& words);
    bool OnClose(const CString& words);
    bool OnList(const CString& words);
    bool OnDraw(const CString& words);
    bool OnDelete(const CString& words);
    bool OnFront(const CString& words);
    bool OnBack(const CString& words);
    bool OnUndo(const CString& words);
    bool OnRedo(const CString& words);
    bool OnSet(const CString& words);
    bool OnRun(const CString& words);
    bool OnHelp(const CString& words);

    /// The number of a shape as `list` shows it, less 1; -1 after it was told that there is none.
    int ShapeNumber(const CString& words);
    /// Changes the shape with the number that the words are, and reports it.
    bool ChangeShape(const CString& words, UINT doneId, board::Change (*change)(const board::Drawing&, int));
    bool SetGrid(const CString& value);
    bool SetFlag(const CString& value, void (CCommandConsole::*set)(bool));
    void ShowStatus(bool show);
    void KeepCommands(bool keep);
    void ListSettings();

    /// Shows a line in the console and in the status line.
    void Report(const CString& text);
    void Report(UINT id);
    void Report(UINT id, const CString& detail);
    /// Reports what the running command expects, and answers false.
    bool Expected();

    Gui_Console m_console;
    const Command* m_running = nullptr;
    std::vector<CString> m_scripts; ///< Those that are being run, the outermost first.
};
