#pragma once

/// @file
/// Stands for the framework's automation. There is none here; hosts include it and make its two start calls.

#define __AFXDISP_H__ // hosts ask whether this header came first
#include "afxwin.h"

/// Calls that hosts make in InitInstance: nothing has to be started here, so both succeed.
/// @{
inline void AfxEnableControlContainer() {}
inline BOOL AfxOleInit() {
    return TRUE;
}
/// @}
