#pragma once

#include "afx.h"
#include "s/Export.h"

/// Child processes, and questions about any process.
class GUI_API Gui_Process {
public:
    /// Whether any process with that id is alive. One that has ended but was not collected by its parent is not; one
    /// that the caller may not ask about is. May be called from any thread.
    static int IsActive(unsigned long processId);

    /// 1 for the exit code of a program that the interrupt keys stopped, 0xC000013A.
    static int IsAbortExitCode(unsigned long code);
    /// 1 for the exit code of a program that crashed: one of the two highest bits is set, and it is no abort.
    static int IsCrashExitCode(unsigned long code);
};
