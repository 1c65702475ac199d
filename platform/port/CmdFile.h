#pragma once

#include "platform/base/Export.h"

#include <memory>
#include <string>
#include <vector>

/// An argument vector in which a command file has been replaced by the arguments it holds.
///
/// The first pair "-f name" of the vector given ("/f" as well, in either letter case) gives way to the words of that
/// file; everything else stays as it is and where it is. The words are not looked at: a "-f" among them is left to the
/// caller, who makes another object for it while this one lives.
///
///     const char* vector[] = {"exe", "-f", name};
///     const UT_CMDFILE file(3, vector);
///     for (int i = 1; i < file.getargc(); ++i)
///         handle(file.getargv()[i]);
///
/// As long as the object lives its file counts as being expanded. A file that is being expanded already, under
/// whatever name, is refused, and so is nesting beyond 64 files; a file that cannot be read or holds no text is refused
/// too, and so are pipes and devices, without waiting for them. A refusal is an error message that names the file, the
/// reason and the chain of files that led there, and the file contributes no argument. The notation of command files is
/// described in docs/command-line.md.
class TVX_PLATFORM_API UT_CMDFILE {
public:
    /// Whether what is wrong with a file is issued as error messages. Code that goes through one command line several
    /// times, or before anybody takes messages, keeps what `geterrors` answers and issues it when it is time.
    enum class Reporting { Silent, Issue };

    /// @param argc the number of arguments.
    /// @param argv the arguments; the first is a placeholder and is passed on unread. All are copied.
    UT_CMDFILE(int argc, const char* const* argv, Reporting reporting = Reporting::Issue);
    ~UT_CMDFILE();
    UT_CMDFILE(const UT_CMDFILE&) = delete;
    UT_CMDFILE& operator=(const UT_CMDFILE&) = delete;

    /// The number of arguments, the placeholder included.
    int getargc() const;
    /// The arguments, followed by a null pointer. They belong to this object; the caller may change the characters.
    char** getargv() const;
    /// Whether the file was refused or a quote in it is not closed.
    bool iserror() const;
    /// What is wrong, a text for each message, issued or not.
    const std::vector<std::string>& geterrors() const;

private:
    struct Impl;
    std::unique_ptr<Impl> m_impl;
};
