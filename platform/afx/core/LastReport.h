#pragma once

/// @file
/// The end of an application that failed.

#include "platform/base/Export.h"

/// The time in which the user is told why the application ends: what message handlers throw meanwhile is dropped. A
/// timer or a paint handler that has failed once may fail again at any moment, and would take the message box away.
class TVX_PLATFORM_API CLastReport {
public:
    /// Begins that time on the calling thread; it ends with the object. May be nested.
    CLastReport();
    ~CLastReport();
    CLastReport(const CLastReport&) = delete;
    CLastReport& operator=(const CLastReport&) = delete;
};
