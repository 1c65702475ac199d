#pragma once

#include "afxwin.h"

/// A string of the resources; empty when there is none of that number.
[[nodiscard]] inline CString StringOf(UINT id) {
    CString text;
    (void)text.LoadString(id);
    return text;
}
