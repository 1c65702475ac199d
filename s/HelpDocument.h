#pragma once

#include "afxwin.h"

/// @file
/// Not for hosts: how documents are named and handed to the programs that show them.

/// The address of an installed document, which may end in an anchor: "file:///opt/docs/a.htm#start". Characters that
/// have a meaning in addresses or command lines, and those outside ASCII, are written as percent signs and numbers.
CString FileAddressOf(const CString& document);

/// Opens a document in the PDF viewer, in quotes where its name has blanks and the viewer's command line has none for
/// it. The user is told when there is no viewer.
void ShowInPDFViewer(const CString& document);

/// The context under which the main frame's page is asked for: that of the contents.
inline constexpr unsigned long mainFrameHelpContext = HID_BASE_RESOURCE + 128;

/// How long the callers of viewers and browsers allow for their windows, in milliseconds.
inline constexpr unsigned long documentTimeout = 5000;
