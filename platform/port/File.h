#pragma once

#include "platform/base/Export.h"
#include "platform/port/Stream.h"

#include <cstdint>

namespace Port {

/// The portability library's files: the output streams that every process has, and text files that are read line by
/// line.
///
///     if (Port::Stream* file = Port::File::open(path, Port::File::AccessRead, Port::File::FlagText)) {
///         char line[256];
///         for (file->readline(line, 255); !file->geteof(); file->readline(line, 255))
///             use(line);
///         Port::File::close(file);
///     }
///
/// Names come in the form of hosts (`C:\a\b`) or in the system's (`/a/b`).
class TVX_PLATFORM_API File {
public:
    /// The stream onto standard output. It belongs to the library and is usable at any time, before `main` and while
    /// the process ends.
    static Stream& getCout();
    /// The same for standard error.
    static Stream& getCerr();

    /// What an opened file is for.
    enum Access { AccessRead };
    /// How its contents are taken: as text, with line ends of any kind.
    enum Flag { FlagText };

    /// Opens a file.
    /// @return the stream, to be ended with close; null when there is no such file, it may not be read, or it is none
    ///     (a folder, a pipe, a device)
    [[nodiscard]] static Stream* open(const char* path, Access access, Flag flag);
    /// Closes and frees a stream from open; null is ignored.
    static void close(Stream* stream);

    /// Closes the stream of a `std::unique_ptr<Port::Stream, Port::File::Closer>`.
    struct Closer {
        void operator()(Stream* stream) const {
            close(stream);
        }
    };

    /// Whether there is a file of that name: no folder. Null names none.
    [[nodiscard]] static bool exist(const char* path);
    /// Whether there is such a file and this process may read it.
    [[nodiscard]] static bool canread(const char* path);

    /// When a file was last changed.
    /// @param time receives the seconds since 1970, UTC; left alone on failure
    /// @return whether there is such a file
    [[nodiscard]] static bool getdatetime(const char* path, std::int64_t& time);
};

} // namespace Port
