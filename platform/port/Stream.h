#pragma once

#include "platform/base/Export.h"

#include <string>
#include <string_view>

namespace Port {

/// A stream of text: one of the process's standard outputs, or a file that is being read.
///
/// Streams are not made by hosts: `Port::File` hands them out. The standard ones live until the process ends, one from
/// `Port::File::open` until it is closed. Text goes out at once and in the order of the C library's own output. A write
/// that fails (a full disk, a reader that has gone away) loses the text but never ends the process.
///
///     Port::File::getCout() << "3 drawings read" << Port::Stream::endl;
///
/// A text that is read may have line ends of any kind (LF, CR LF, CR), also mixed.
class TVX_PLATFORM_API Stream {
public:
    /// A stream onto the open descriptor @p descriptor, which stays the caller's to close.
    explicit Stream(int descriptor);
    virtual ~Stream();
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

    /// Reads the next line, without its line end.
    ///
    /// Of a longer line the first @p limit bytes are read, fewer where a character would be cut; what is left of it is
    /// what the next call reads, so nothing is lost.
    /// @param buffer has room for @p limit bytes and a zero, which is put behind the line
    /// @param limit  1 or more
    /// @return the number of bytes read, the zero not counted; 0 also at the end of the file
    int readline(char* buffer, int limit);
    /// Whether the last readline ran into the end of the file: it found no line end behind what it read. So it does
    /// for what stands behind the last line end, be that text or nothing. A file that cannot be read on has ended.
    bool geteof() const;
    /// Reads all that is left, line ends as they are. A file that cannot be read on has ended.
    std::string readall();

private:
    void buffer(std::size_t count);

    int m_descriptor;
    std::string m_input; ///< read from the descriptor and not yet asked for, from m_consumed on
    std::size_t m_consumed = 0;
    bool m_exhausted = false; ///< the descriptor gives no more
    bool m_eof = false;
};

} // namespace Port
