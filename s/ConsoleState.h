#pragma once

#include "afxwin.h"
#include "s/ConsoleHistory.h"
#include "s/ConsoleRecall.h"

#include <memory>
#include <vector>

/// @file
/// What all consoles of a process share. Not for hosts.

class CDocTemplate;
class Gui_Console;
class Gui_ConsoleView;

struct Gui_ConsoleState {
    const Gui_Console* m_owner = nullptr; ///< The console that the host made; null: none.
    int (*m_callback)(const char*) = nullptr;
    std::unique_ptr<Gui_ConsoleHistory> m_history; ///< Null without a console.
    std::unique_ptr<Gui_ConsoleRecall> m_recall;   ///< As the history.
    int m_showStatus = 0;                          ///< What the check box said last.
    int m_keepsRecall = 0;
    bool m_isRunning = false; ///< A command of the user's is being run.
    Gui_ConsoleView* m_view = nullptr;
    CDocTemplate* m_template = nullptr;
    int m_widestLine = 0; ///< In pixels.
};

/// The one of this process.
Gui_ConsoleState& ConsoleState();

/// Runs an input: looks up what it recalls and hands the command to the host. A recall that fails is told in a message
/// box.
/// @return the host's result; 1 when there was nothing to run, -1 while a command is being run already
int ResolveAndRunCommand(const char* input);

/// The texts that were kept for recalling, the oldest first.
std::vector<CString> ReadRecallTexts();
/// Adds one to them.
void KeepRecallText(const CString& text);
/// Forgets them.
void ForgetRecallTexts();
