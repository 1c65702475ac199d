#pragma once

/// @file
/// Message boxes.

#include "platform/afx/App.h"

/// Takes the wait cursor away as long as it lives, for the time that the user is asked something.
class CWaitCursorPause {
public:
    explicit CWaitCursorPause(CWinApp& app);
    ~CWaitCursorPause();
    CWaitCursorPause(const CWaitCursorPause&) = delete;
    CWaitCursorPause& operator=(const CWaitCursorPause&) = delete;
};
