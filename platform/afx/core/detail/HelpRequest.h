#pragma once

/// @file
/// The road of help requests. The help key makes WM_HELP for what it asks about; that climbs from window to parent (for
/// top-level ones the owner) until somebody takes it. Frames, and top-level windows over which nothing stands, turn it
/// into WM_COMMANDHELP, with which all other requests begin: it climbs the same way until a dialog or frame answers
/// with its own context.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"

namespace tvx::afx {

class Window;

/// The help key in a window.
TVX_PLATFORM_API LRESULT requestHelp(HWND window);
/// The help key on an item of an open menu.
/// @param owner  the menu's window; null: the main window
/// @param item   the command; 0 for an item that opens a popup
void requestMenuHelp(HWND owner, HMENU menu, UINT item);
/// Explains what a request of the help key that nobody took on its way up is about.
/// @param last  the window that it has reached
TVX_PLATFORM_API void answerHelpRequest(const HELPINFO& info, HWND last);
/// Explains a window: WM_COMMANDHELP, then the command ID_DEFAULT_HELP when nobody has answered.
/// @param window   null: the main window
/// @param context  what is asked about when it is not the window itself: a message, a button of a bar; 0 for none
TVX_PLATFORM_API void explain(HWND window, DWORD_PTR context = 0);
/// Explains the window that has the keyboard, or `fallback` when no window of ours has it.
TVX_PLATFORM_API void explainAtKeyboard(HWND fallback);
/// As long as one lives, help is being answered: message boxes that this shows have no help of their own.
class HelpAnswer {
public:
    HelpAnswer();
    ~HelpAnswer();
    HelpAnswer(const HelpAnswer&) = delete;
    HelpAnswer& operator=(const HelpAnswer&) = delete;
    [[nodiscard]] TVX_PLATFORM_API static bool isUnderWay();
};

/// The help context of the message boxes that are shown while this lives.
class BoxHelp {
public:
    /// @param context  0: they have none
    explicit BoxHelp(DWORD_PTR context);
    ~BoxHelp();
    BoxHelp(const BoxHelp&) = delete;
    BoxHelp& operator=(const BoxHelp&) = delete;
    /// Takes the context for the box that is about to be shown; boxes over that one have their own.
    TVX_PLATFORM_API static DWORD_PTR take();

private:
    DWORD_PTR m_outer;
};

/// The number under which a command's prompt and help stand. System commands lie 16 apart and their prompts 1; all
/// frames of the Window menu share one.
[[nodiscard]] TVX_PLATFORM_API UINT promptOf(UINT command);

} // namespace tvx::afx
