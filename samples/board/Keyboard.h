#pragma once

#include "afxwin.h"
#include "s/AccelMap.h"

#include <optional>

/// The keys of the board, which its user may change. A key means the same everywhere; main window and drawings have
/// tables of their own, with the keys of the commands in their menus: that of the main window goes with the window,
/// that of the drawings with their template.
class CKeyboard {
public:
    /// Puts the user's keys in force, if he has any.
    /// @param main, drawings  must live as long as the object is used
    CKeyboard(CMDIFrameWnd& main, CMultiDocTemplate& drawings);
    /// Lets the user change the keys.
    void Edit();
    /// How many keys the user has given or taken away.
    int CountOwn() const;
    /// Puts the keys that the board comes with in force, and forgets the user's.
    void Reset();
    /// Puts the user's keys in force in the window of a floating drawing, if he has any. Its table goes with it.
    void Apply(CFrameWnd& window) const;

private:
    void apply(const Gui_AccelMap& map);

    std::optional<Gui_AccelMap> m_keys; ///< the user's
    CMDIFrameWnd& m_main;
    CMultiDocTemplate& m_drawings;
};
