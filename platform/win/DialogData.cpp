#include "platform/base/Text.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/detail/ByteReader.h"

#include <array>

namespace tvx {

namespace {

using detail::ByteReader;
using Kind = DialogDataEntry::Kind;

// Code points of the bytes 0x80 to 0x9F in the western code page (1252).
constexpr std::array<char16_t, 32> western80 = {0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                                0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x008D, 0x017D, 0x008F,
                                                0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                                0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

// Resource editors write these texts as numbers, byte by byte in the code page of their time.
std::string toUtf8(std::string bytes) {
    if (text::isWellFormed(bytes))
        return bytes;
    std::string result;
    for (const char c : bytes) {
        const auto byte = static_cast<std::uint8_t>(c);
        text::append(result, byte >= 0x80 && byte < 0xA0 ? western80[byte - 0x80] : byte);
    }
    return result;
}

Kind kindOf(WORD message) {
    switch (message) {
    case 0x0180: // LB_ADDSTRING and its number in 16-bit scripts
    case 0x0401:
        return Kind::AddToListBox;
    case 0x0143: // CB_ADDSTRING likewise
    case 0x0403:
        return Kind::AddToComboBox;
    default:
        return Kind::Other;
    }
}

} // namespace

ResourceResult<std::vector<DialogDataEntry>> parseDialogData(ResourceBytes data) {
    ByteReader reader(data);
    std::vector<DialogDataEntry> entries;
    while (const WORD controlId = reader.u16()) {
        DialogDataEntry entry;
        entry.controlId = controlId;
        entry.message = reader.u16();
        entry.kind = kindOf(entry.message);
        const ResourceBytes bytes = reader.bytes(reader.u32());
        std::string text(bytes.begin(), bytes.end());
        if (text.ends_with('\0'))
            text.pop_back();
        entry.text = toUtf8(std::move(text));
        if (!reader.ok())
            break;
        entries.push_back(std::move(entry));
    }
    if (!reader.ok())
        return ResourceError{"dialog data ends after " + std::to_string(entries.size()) +
                             " entries without an end mark"};
    return entries;
}

} // namespace tvx
