#pragma once

/// @file
/// The road of commands that reach the main frame while another frame is the thread's routing frame.

#include "platform/afx/core/CmdTarget.h"

class CFrameWnd;

namespace tvx::afx {

/// Whether what reaches `frame` goes to the routing frame instead of to a child frame or view of its own: it is the
/// application's main frame, and there is a routing frame besides it.
[[nodiscard]] bool isRouted(const CFrameWnd& frame);
/// Offers the routing frame a command or question that has reached the main frame. FALSE also while that frame is being
/// asked for the same: it may hand on to the main frame what it does not know.
BOOL offerToRoutingFrame(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info);
/// Whether a frame is being asked so. The application's turn is after the main frame's then.
[[nodiscard]] bool isAskedForMainFrame(const CFrameWnd& frame, UINT id, int code);

} // namespace tvx::afx
