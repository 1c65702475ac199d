#pragma once

#include "platform/base/Export.h"

#include <string>
#include <string_view>

namespace Port {

/// A stream of text onto one of the process's standard descriptors.
///
/// Streams are not made by hosts: `Port::File` hands out the ones there are, which live until the process ends.
/// Text goes out at once and in the order of the C library's own output. A write that fails (a full disk, a reader that
/// has gone away) loses the text but never ends the process.
///
///     Port::File::getCout() << "3 drawings read" << Port::Stream::endl;
class TVX_PLATFORM_API Stream {
public:
    /// A stream onto the open descriptor @p descriptor, which stays the caller's to close.
    explicit Stream(int descriptor);
    Stream(const Stream&) = delete;
    Stream& operator=(const Stream&) = delete;

    /// Writes the zero-terminated @p text as it is; null writes nothing.
    Stream& operator<<(const char* text);
    /// Writes the bytes of @p text, zeros included.
    Stream& operator<<(std::string_view text);
    /// Writes the bytes of @p text, zeros included.
    Stream& operator<<(const std::string& text);
    /// Writes one byte.
    Stream& operator<<(char character);
    /// Applies a manipulator such as `endl`.
    Stream& operator<<(Stream& (*manipulator)(Stream&));

    /// Manipulator: ends the line with a line feed.
    static Stream& endl(Stream& stream);

private:
    int m_descriptor;
};

} // namespace Port
