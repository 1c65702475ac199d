#pragma once

#include "platform/port/StringBase.h"
#include "s/Export.h"

/// What the user prefers for help, from the settings that all applications of the family share (docs/help-maps.md).
///
/// An object keeps nothing: each question reads the settings, and the environment, which goes before them.
class GUI_API Gui_HelpPreference {
public:
    Gui_HelpPreference() = default;
    virtual ~Gui_HelpPreference();

    /// Whether documents are always taken from the web, also those that are installed: the setting "AlwayOnWeb" is the
    /// number 1, or the environment variable `TVX_GUI_HELP_ALWAYS_TO_WEB` is set, to whatever value.
    bool IsAlwaysGoToWeb();
    /// The web location of documents, to which their names are appended as they are: the environment variable
    /// `TVX_GUI_HELP_WEB_LOCATION` where it is set, else the setting "HelpUrlPrefix".
    /// @return empty when the user has none
    Port::StringBase<char> GetUrlPrefix();
};
