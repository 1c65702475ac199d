#pragma once

#include "s/AccelMap.h"

/// Keeps the keys that a user has chosen, among the settings of the application. There are no objects of this class.
///
/// @code
/// const Gui_AccelMap own(table);             // the application's own keys, from its resources
/// Gui_AccelMap map(own);
/// Gui_AccelProfile::Read(map, "Keys", nullptr); // at the start: the user's
/// ...
/// Gui_AccelProfile::Write(map, own, "Keys", nullptr); // after the dialog
/// @endcode
///
/// What differs from the application's own keys is kept, not the whole table: a key that the user has taken away from a
/// command stays away, a key that he has given to one stays there, and all others follow the tables of later versions.
/// Commands are kept by their numbers.
///
/// The setting is a text with one line for each key: "+" for a key that was given, "-" for one that was taken away, the
/// packed key (Gui_Accel::EncodeFlagsAndKey) as hexadecimal number, a blank, and the command. Other lines are passed
/// over.
class GUI_API Gui_AccelProfile {
public:
    /// Puts the user's choice over the application's own keys.
    /// @param map      the application's own keys; receives the user's
    /// @param entry    where they are kept
    /// @param section  null: "Settings"
    /// @return 1, or 0 when nothing is kept and nothing has changed
    static int Read(Gui_AccelMap& map, const char* entry, const char* section);
    /// Keeps the user's choice; forgets it when it is the application's own. Nothing is reported when that fails.
    /// @param map  the user's keys
    /// @param own  the application's own keys
    static void Write(const Gui_AccelMap& map, const Gui_AccelMap& own, const char* entry, const char* section);
    /// Forgets the user's choice: the application's own keys are in force with the next Read.
    static void Forget(const char* entry, const char* section);

private:
    Gui_AccelProfile() = default;
};
