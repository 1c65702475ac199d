#pragma once

#include "afx.h"

/// Where command lines of programs come from, one source at a time. A look-up of a browser answers 1 and sets the name
/// when its source has a command line that is not empty, else it answers 0 and leaves the name alone.
namespace ProgramSources {

/// What the user has named; blanks count.
int UserBrowser(CString& name);
/// None: what the installation's file names is for hosts.
int InstalledBrowser(CString& name);
/// What opens ".htm" files, without white space at its ends.
int AssociatedBrowser(CString& name);
/// The last resort: Internet Explorer, where the machine has it.
int LastBrowser(CString& name);

/// The command line that opens files of an extension such as ".pdf", as it is registered; empty when there is none.
[[nodiscard]] CString AssociatedCommand(const char* extension);

} // namespace ProgramSources
