#pragma once

#include "s/Export.h"

/// What the installation records about itself in its file "fileset.txt": the version, the commands of help browser and
/// PDF viewer, and more (docs/installation.md). Code outside the library asks `Port::Version::getValue`, which asks
/// here.
///
/// The file lies in the directory that `MYTARVEX` names, else in that of `TARVEX`. It is read when the first value is
/// asked for, and again when it has become newer. All operations are static; the values live as long as the process.
class GUI_API Gui_InstallInfo {
public:
    Gui_InstallInfo() = delete;

    /// The value of @p key, whose letter case counts.
    ///
    /// That the installation or its file cannot be found is issued as an error message, with every call.
    /// @return null when the file cannot be opened or does not have the key. The text is the library's; it holds until
    ///     a later call finds that the file has changed.
    static const char* GetValue(const char* key);
};
