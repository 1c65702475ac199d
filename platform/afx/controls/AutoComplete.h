#pragma once

/// @file
/// Completion of names that are typed into an edit control.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#define SHACF_FILESYS_DIRS 0x00000020 ///< Names of folders.

/// Has an edit control of one line complete the names of folders that the user types: below the field opens a list of
/// those that begin so. Up and down choose a line; Enter, Tab or a click takes it; Tab without a chosen line completes
/// what all lines have in common, and moves on where that is nothing. Esc closes the list, a second Esc is the
/// dialog's.
///
/// Whole names are completed, in the family's form ("C:\pl", "\\server\share\pl") or the system's ("/ho"). The folders
/// are read in the background: the field never waits, also not for a server that does not answer. Folders whose names
/// begin with a dot are offered once the dot is typed.
///
/// @param edit   the control; a second call changes nothing
/// @param flags  SHACF_FILESYS_DIRS
/// @return 0, or a negative number when `edit` is no such control or the flags are others
TVX_PLATFORM_API LONG SHAutoComplete(HWND edit, DWORD flags);
