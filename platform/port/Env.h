#pragma once

#include "platform/base/Export.h"

/// The process's environment and the files of the family's installation.
///
/// Names of files may be null, which names none. Texts that an operation answers hold until its next call, except where
/// it says otherwise.
class TVX_PLATFORM_API Port_Env {
public:
    /// The value of the environment variable @p name, or null when it is not set (or @p name is null). The text belongs
    /// to the environment and holds until the variable is changed.
    static const char* GetEnv(const char* name);

    /// The name of the folder below "doc" that holds the documents in the user's language: "usenglish" for English of
    /// any country, "german", "japanese" and so on (docs/languages.md). A language that the system does not know is
    /// American English. The text holds as long as the process.
    static const char* GetLang();

    /// The full name of an installed data file: the first `<root>/share/<relativeName>` that exists, by the order of
    /// `Port::TarvexPath`.
    /// @param flag 1; kept for the callers' sake, nothing depends on it
    /// @return null when there is none
    static const char* GetDataFileName(const char* relativeName, int flag);
    /// The full name of an installed document: the first `<root>/doc/<language>/<name>` that exists, in the user's
    /// language, else in American English. Where a name has no extension, that of PDF files is understood: "manuals" is
    /// "manuals.pdf".
    /// @param flag 0; kept for the callers' sake, nothing depends on it
    /// @return null when there is none
    static const char* GetDocFileName(const char* name, int flag);
    /// The full name of an installed help file that is no help map: the data file "help/<name>".
    /// @param flag 1; kept for the callers' sake, nothing depends on it
    /// @return null when there is none
    static const char* GetHelpFileName(const char* name, int flag);
};
