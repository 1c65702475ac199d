#pragma once

#include "afx.h"

/// A page that is to be shown in a web browser.
struct BrowserRequest {
    CString url;
    CString directory = {};    ///< where the browser starts; empty: the current directory
    int wait = 0;              ///< kept for the caller's sake: nothing depends on it
    unsigned long timeout = 0; ///< likewise
    CString webUrl = {};       ///< where the page is on the web when `url` is a local file; empty: nowhere
};

/// Starts the first browser that can be started: the user's, the system's, the last resort. A browser that cannot read
/// the page, because it runs in a sandbox, is passed over; when no other one opens the page, it gets the page's place
/// on the web. The user is told why once, and when nothing opens the page, what was tried.
/// @return 1 when a browser was started, else 0
int RunBrowserChain(const BrowserRequest& request);
