#pragma once

#include "s/FileName.h"

/// The value of a file name.
struct Gui_FileName::Record {
    CString mount;     ///< empty, "C:" or "\\server\share"
    CString path;      ///< empty, or folders that end with a backslash
    CString base;      ///< the name without its extension
    CString extension; ///< empty, or begins with "."
    CString fullText;  ///< what the conversion to const char* gave last; not part of the value
};
