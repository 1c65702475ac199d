#include "platform/win/DialogTemplate.h"

#include "platform/base/Text.h"
#include "platform/win/ResourceConstants.h"
#include "platform/win/detail/ByteReader.h"

#include <array>
#include <string_view>

namespace tvx {

namespace {

using detail::ByteReader;

constexpr std::uint16_t ordinalMark = 0xFFFF;
constexpr DWORD anonymousId = 0xFFFF;
constexpr std::uint16_t firstNumberedClass = 0x80;
constexpr std::array<const char*, 6> numberedClasses = {"Button", "Edit", "Static", "ListBox", "ScrollBar", "ComboBox"};

ResourceName readName(ByteReader& reader) {
    if (reader.peekU16() != ordinalMark) {
        return text::narrow(reader.zeroEndedText());
    }
    reader.skip(2);
    return reader.u16();
}

// A name for which the empty text means that there is none.
ResourceName readOptionalName(ByteReader& reader) {
    ResourceName name = readName(reader);
    if (name == ResourceName(std::string())) {
        return WORD{0};
    }
    return name;
}

DialogRect readRect(ByteReader& reader) {
    DialogRect rect;
    rect.x = reader.s16();
    rect.y = reader.s16();
    rect.width = reader.s16();
    rect.height = reader.s16();
    return rect;
}

DialogFont readFont(ByteReader& reader, bool isExtended) {
    DialogFont font;
    font.pointSize = reader.u16();
    if (isExtended) {
        font.weight = reader.u16();
        font.italic = reader.u8() != 0;
        font.charSet = reader.u8();
    }
    font.faceName = text::narrow(reader.zeroEndedText());
    return font;
}

// The dialog itself; answers the number of items that follow.
unsigned readHead(ByteReader& reader, DialogTemplate& dialog) {
    if (dialog.extended) {
        reader.skip(4); // version and signature
        dialog.helpId = reader.u32();
        dialog.extendedStyle = reader.u32();
        dialog.style = reader.u32();
    } else {
        dialog.style = reader.u32();
        dialog.extendedStyle = reader.u32();
    }
    const unsigned itemCount = reader.u16();
    dialog.rect = readRect(reader);
    dialog.menu = readOptionalName(reader);
    dialog.className = readOptionalName(reader);
    dialog.title = text::narrow(reader.zeroEndedText());
    if ((dialog.style & DS_SETFONT) != 0) {
        dialog.font = readFont(reader, dialog.extended);
    }
    return itemCount;
}

// The class's name, empty for a number that means none.
std::string readClassName(ByteReader& reader) {
    const ResourceName name = readName(reader);
    const auto* number = std::get_if<WORD>(&name);
    if (!number) {
        return textOf(name);
    }
    const int index = *number - firstNumberedClass;
    return index >= 0 && index < static_cast<int>(numberedClasses.size())
               ? numberedClasses[static_cast<std::size_t>(index)]
               : "";
}

DialogItemTemplate readItem(ByteReader& reader, bool isExtended) {
    DialogItemTemplate item;
    if (isExtended) {
        item.helpId = reader.u32();
        item.extendedStyle = reader.u32();
        item.style = reader.u32();
    } else {
        item.style = reader.u32();
        item.extendedStyle = reader.u32();
    }
    item.rect = readRect(reader);
    // Numbers of plain templates have 16 bits; -1 of an extended one means the same control without a number.
    const DWORD id = isExtended ? reader.u32() : reader.u16();
    item.id = id == 0xFFFFFFFF ? anonymousId : id;
    item.className = readClassName(reader);
    item.title = readName(reader);
    reader.skip(reader.u16()); // creation data
    return item;
}

bool isExtendedTemplate(ResourceBytes data) {
    ByteReader reader(data);
    return reader.u16() == 1 && reader.u16() == ordinalMark;
}

} // namespace

std::string textOf(const ResourceName& name) {
    const auto* string = std::get_if<std::string>(&name);
    return string ? *string : std::string();
}

ResourceResult<DialogTemplate> parseDialogTemplate(ResourceBytes data) {
    ByteReader reader(data);
    DialogTemplate dialog;
    dialog.extended = isExtendedTemplate(data);
    const unsigned itemCount = readHead(reader, dialog);
    if (!reader.ok()) {
        return ResourceError{"dialog template ends within its head"};
    }
    for (unsigned i = 1; i <= itemCount; ++i) {
        reader.align(4);
        DialogItemTemplate item = readItem(reader, dialog.extended);
        const std::string place = "control " + std::to_string(i) + " of " + std::to_string(itemCount);
        if (!reader.ok()) {
            return ResourceError{"dialog template ends within " + place};
        }
        if (item.className.empty()) {
            return ResourceError{"dialog template has no known class for " + place};
        }
        dialog.items.push_back(std::move(item));
    }
    return dialog;
}

} // namespace tvx
