#pragma once

#include "platform/base/Export.h"

/// Checks a command line against an option specification. The check is done by the constructor:
///
///     UT_CMDARGS check(argc, argv, specification, &showMore, UT_CMDARGS::NoProgramName);
///     if (check.gaveusage() || check.iserror())
///         return 1;
///
/// An argument that begins with "-" is an option, in any letter case, in full or abbreviated as long as it is unique.
/// An option with a value takes the argument that follows. All other arguments are plain ones.
///
/// Everything that is wrong is reported, one error message for each: unknown and ambiguous options, missing and
/// malformed values, options given twice or not given, too few or too many plain arguments. A help switch ("-help",
/// "-h", "-?") gives the usage summary instead. A mistake in the specification itself is an internal error that names
/// its line; the arguments are not checked then.
class TVX_PLATFORM_API UT_CMDARGS {
public:
    /// Value for the flags: element 0 of the vector is the first argument and not the program's name.
    static constexpr unsigned short NoProgramName = 1;

    /// @param argc the number of elements of @p argv.
    /// @param argv the arguments. May be null when @p argc is 0.
    /// @param specification what is allowed; null counts as empty, which allows nothing but help.
    /// @param usagefunction called after the summary has been issued as a status message, so that the caller can issue
    ///     more; may be null.
    /// @param flags 0 or NoProgramName.
    UT_CMDARGS(int argc, const char* const* argv, const char* specification, void (*usagefunction)(),
               unsigned short flags);

    /// Whether a help switch was given and the usage summary has been issued. Nothing else is reported then.
    bool gaveusage() const;
    /// Whether an error message has been issued.
    bool iserror() const;

private:
    bool m_gaveUsage = false;
    bool m_isError = false;
};
