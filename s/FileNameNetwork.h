#pragma once

#include "afx.h"

/// Which drive is connected to which share, asked from the system each time.

/// The share ("\\server\share") that a drive is connected to; empty when it is connected to none or the connections
/// cannot be told.
/// @param letter  of the drive, in any case
CString ShareOfDrive(char letter);

/// The drive ("X:") that is connected to a share; empty when there is none.
/// @param share  "\\server\share" in any case
CString DriveOfShare(const CString& share);
