#pragma once

/// @file
/// Message boxes.

#include "platform/afx/core/App.h"

/// The time in which the user is told why the application ends: what message handlers throw meanwhile is dropped. A
/// timer or a paint handler that has failed once may fail again at any moment, and would take the message box away.
class TVX_PLATFORM_API CLastReport {
public:
    CLastReport();
    ~CLastReport();
    CLastReport(const CLastReport&) = delete;
    CLastReport& operator=(const CLastReport&) = delete;
};

/// Takes the wait cursor away as long as it lives, for the time that the user is asked something.
class CWaitCursorPause {
public:
    explicit CWaitCursorPause(CWinApp& app);
    ~CWaitCursorPause();
    CWaitCursorPause(const CWaitCursorPause&) = delete;
    CWaitCursorPause& operator=(const CWaitCursorPause&) = delete;
};
