#pragma once

#include "afx.h"

/// @file
/// Not for hosts: how documents are named to the programs that show them.

/// The address of an installed document, which may end in an anchor: "file:///opt/docs/a.htm#start". Characters that
/// have a meaning in addresses or command lines, and those outside ASCII, are written as percent signs and numbers.
CString FileAddressOf(const CString& document);

/// A document as an argument of the PDF viewer that is in use: in quotes where its name has blanks and the viewer's
/// command line has none for it.
CString ViewerArgumentOf(const CString& document);
