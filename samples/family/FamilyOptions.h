#pragma once

#include "afxwin.h"

/// What the applications of the family have in common to be chosen. Where documents are, is each application's own;
/// what concerns help is one choice for all of them.
struct FamilyOptions {
    /// The folder in which Open and Save begin for documents without one of their own; empty: where the application was
    /// started.
    CString documentFolder;
    /// Whether help is always taken from the web.
    BOOL alwaysOnWeb = FALSE;
    /// Where it is on the web; empty: where the installation says.
    CString webLocation;

    /// What holds: the environment goes before what is stored, and that before what applications come with.
    static FamilyOptions Read();
    /// Stores what differs from `before`. The rest stays as it is stored: another application may have changed it
    /// meanwhile, or the environment holds instead.
    void Write(const FamilyOptions& before) const;
};
