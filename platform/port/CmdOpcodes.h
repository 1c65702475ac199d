#pragma once

#include "platform/base/Export.h"

#include <memory>

namespace Port::detail {
struct OptionSpec;
}

/// An application's option specification, read from its text. The notation is described in docs/command-line.md:
///
///     scale real required     : Scale of the drawing.
///     layer text repeatable   : Layer to show.
///     nosplash none           : Do not show the splash screen.
///     <drawing> 0..*          : Drawings to open.
///
/// Lines that are wrong are left out here; `UT_CMDARGS` reports them.
class TVX_PLATFORM_API UT_CMDOPCODES {
public:
    /// @param specification the text; null counts as empty.
    explicit UT_CMDOPCODES(const char* specification);
    ~UT_CMDOPCODES();
    UT_CMDOPCODES(const UT_CMDOPCODES&) = delete;
    UT_CMDOPCODES& operator=(const UT_CMDOPCODES&) = delete;

    /// The summary of the command line: a line that shows its form, then each argument and option with its help text
    /// under it, indented with blanks so that it reads well in any font and wrapped to 80 columns. It ends with a line
    /// feed; one more sets it apart from a text that follows.
    /// @return the text in UTF-8, allocated with `malloc`: the caller frees it with `free`. Null when memory runs out.
    char* usage() const;

    /// The full name of the option that a word of the command line means, so that hosts which look at switches
    /// themselves accept the abbreviations that the check accepts.
    /// @param word the option without "-", in any letter case, in full or abbreviated.
    /// @return the name as it is spelled in the specification, "help" for every help switch; null when no option or
    ///     more than one is meant. It belongs to this object.
    const char* optionname(const char* word) const;

private:
    std::unique_ptr<Port::detail::OptionSpec> m_spec;
};
