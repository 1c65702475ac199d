#include "platform/base/Text.h"
#include "platform/base/WesternCodePage.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/detail/ByteReader.h"

namespace tvx {

namespace {

using detail::ByteReader;
using Kind = DialogDataEntry::Kind;

// Resource editors write these texts as numbers, byte by byte in the code page of their time.
std::string toUtf8(std::string bytes) {
    if (text::isWellFormed(bytes)) {
        return bytes;
    }
    std::string result;
    for (const char c : bytes) {
        text::append(result, text::westernCodePoint(static_cast<std::uint8_t>(c)));
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
        if (text.ends_with('\0')) {
            text.pop_back();
        }
        entry.text = toUtf8(std::move(text));
        if (!reader.ok()) {
            break;
        }
        entries.push_back(std::move(entry));
    }
    if (!reader.ok()) {
        return ResourceError{"dialog data ends after " + std::to_string(entries.size()) +
                             " entries without an end mark"};
    }
    return entries;
}

} // namespace tvx
