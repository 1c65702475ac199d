#pragma once

#include "afx.h"

/// Command lines of programs: where they come from, and how a document gets into them.
namespace Programs {

/// @{
/// The sources of a browser, one at a time. A look-up answers 1 and sets the name when its source has a command line
/// that is not empty, else it answers 0 and leaves the name alone.

/// What the user has named; blanks count.
int UserBrowser(CString& name);
/// None: what the installation's file names is for hosts.
int InstalledBrowser(CString& name);
/// What opens ".htm" files, without white space at its ends.
int AssociatedBrowser(CString& name);
/// The last resort: Internet Explorer, where the machine has it.
int LastBrowser(CString& name);
/// @}

/// The command line that opens files of an extension such as ".pdf", as it is registered; empty when there is none.
[[nodiscard]] CString AssociatedCommand(const char* extension);

/// The command line that opens a document: the document takes the place of each "%1" of the program's command line, or
/// stands behind it, a blank between. It is put in as it is, without quotes. Where there is a "%1", any other marker is
/// one of a message without its parameter (Gui_Msg).
[[nodiscard]] CString CommandLineFor(const CString& program, const char* document);

} // namespace Programs
