#pragma once

#include "afx.h"

/// @file
/// Not for hosts: help requests as they are shown to those who write help.

/// The keyword of a request HELP_KEY.
/// @param data   its address, 0 for none
/// @param without  what stands for no keyword
CString KeywordOf(unsigned long data, const char* without);

/// Shows a request in a message box, with the map file that it will be looked up in.
void ShowHelpTrace(unsigned long data, unsigned int command, const char* mapFile);
