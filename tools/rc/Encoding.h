#pragma once

#include <string>
#include <string_view>

namespace rc {

/// Whether every byte belongs to a well-formed UTF-8 sequence.
[[nodiscard]] bool isUtf8(std::string_view text);

/// Text of the western code page (1252) in UTF-8.
[[nodiscard]] std::string westernToUtf8(std::string_view text);

/// Well-formed UTF-8 in UTF-16.
[[nodiscard]] std::u16string utf8ToUtf16(std::string_view text);

/// A file's text in UTF-8: UTF-16 with a byte order mark is converted, a UTF-8 mark is dropped, everything else stays
/// as it is.
[[nodiscard]] std::string withoutByteOrderMark(std::string_view bytes);

} // namespace rc
