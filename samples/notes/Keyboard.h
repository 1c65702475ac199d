#pragma once

#include "afxwin.h"
#include "s/AccelMap.h"

/// The keys of Notes, which its user may change. An application with one document at a time has one table, that of the
/// main window.
class CKeyboard {
public:
    /// Puts the user's keys in force, if he has any.
    /// @param main  must live as long as the object is used
    explicit CKeyboard(CFrameWnd& main);
    /// Lets the user change the keys.
    void Edit();
    /// How many keys the user has given or taken away.
    int CountOwn() const;
    /// Puts the keys that Notes comes with in force, and forgets the user's.
    void Reset();

private:
    void apply(const Gui_AccelMap& map);

    CFrameWnd& m_main;
};
