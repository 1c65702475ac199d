#include "platform/win/MenuTemplate.h"

#include "platform/base/Text.h"
#include "platform/win/ResourceConstants.h"
#include "platform/win/detail/ByteReader.h"

namespace tvx {

namespace {

using detail::ByteReader;
using Kind = MenuItemTemplate::Kind;
using Break = MenuItemTemplate::Break;

// Bits of a plain item's flags; of an extended item's type and state they are the MFT_ and MFS_ constants.
constexpr unsigned grayedFlag = 0x0001;
constexpr unsigned inactiveFlag = 0x0002;
constexpr unsigned checkedFlag = 0x0008;
constexpr unsigned popupFlag = 0x0010;
constexpr unsigned barBreakFlag = 0x0020;
constexpr unsigned breakFlag = 0x0040;
constexpr unsigned endFlag = 0x0080;
constexpr unsigned separatorFlag = 0x0800;
constexpr unsigned helpFlag = 0x4000;

constexpr unsigned extendedPopupFlag = 0x01;
constexpr unsigned extendedEndFlag = 0x80;

// Nobody nests menus like that, and a damaged one must not exhaust the stack.
constexpr int deepestMenu = 32;

Break breakOf(unsigned flags) {
    if ((flags & barBreakFlag) != 0) {
        return Break::Bar;
    }
    return (flags & breakFlag) != 0 ? Break::Column : Break::None;
}

class MenuReader {
public:
    explicit MenuReader(ResourceBytes data) : m_reader(data) {}

    ResourceResult<std::vector<MenuItemTemplate>> read() {
        const unsigned version = m_reader.u16();
        const unsigned offset = m_reader.u16();
        m_reader.skip(offset);
        if (!m_reader.ok()) {
            return ResourceError{"menu ends within its head"};
        }
        if (version > 1) {
            return ResourceError{"menu of the unknown version " + std::to_string(version)};
        }
        m_isExtended = version == 1;
        std::vector<MenuItemTemplate> items = readItems(0);
        if (!m_reader.ok()) {
            return ResourceError{"menu ends without an end mark"};
        }
        if (m_isTooDeep) {
            return ResourceError{"menu nested deeper than " + std::to_string(deepestMenu) + " levels"};
        }
        return items;
    }

private:
    std::vector<MenuItemTemplate> readItems(int depth) {
        std::vector<MenuItemTemplate> items;
        bool isLast = depth > deepestMenu;
        m_isTooDeep = m_isTooDeep || isLast;
        while (!isLast && m_reader.ok() && !m_isTooDeep) {
            MenuItemTemplate item = m_isExtended ? readExtended(isLast) : readPlain(isLast);
            if (item.kind == Kind::Popup) {
                item.items = readItems(depth + 1);
            }
            items.push_back(std::move(item));
        }
        return items;
    }

    MenuItemTemplate readPlain(bool& isLast) {
        MenuItemTemplate item;
        const unsigned flags = m_reader.u16();
        isLast = (flags & endFlag) != 0;
        item.grayed = (flags & grayedFlag) != 0;
        item.inactive = (flags & inactiveFlag) != 0;
        item.checked = (flags & checkedFlag) != 0;
        item.help = (flags & helpFlag) != 0;
        item.breakBefore = breakOf(flags);
        const bool isPopup = (flags & popupFlag) != 0;
        item.id = isPopup ? 0 : m_reader.u16();
        item.text = text::narrow(m_reader.zeroEndedText());
        const bool isSeparator = (flags & separatorFlag) != 0 || (item.id == 0 && item.text.empty());
        item.kind = isPopup ? Kind::Popup : isSeparator ? Kind::Separator : Kind::Command;
        return item;
    }

    MenuItemTemplate readExtended(bool& isLast) {
        MenuItemTemplate item;
        m_reader.align(4);
        const std::uint32_t type = m_reader.u32();
        const std::uint32_t state = m_reader.u32();
        item.id = m_reader.u32();
        const unsigned info = m_reader.u16();
        item.text = text::narrow(m_reader.zeroEndedText());
        isLast = (info & extendedEndFlag) != 0;
        item.grayed = (state & MFS_GRAYED) != 0;
        item.checked = (state & MFS_CHECKED) != 0;
        item.help = (type & MFT_RIGHTJUSTIFY) != 0;
        item.breakBefore = breakOf(type);
        if ((info & extendedPopupFlag) != 0) {
            item.kind = Kind::Popup;
            m_reader.align(4);
            item.helpId = m_reader.u32();
        } else if ((type & MFT_SEPARATOR) != 0) {
            item.kind = Kind::Separator;
        }
        return item;
    }

    ByteReader m_reader;
    bool m_isExtended = false;
    bool m_isTooDeep = false;
};

} // namespace

ResourceResult<std::vector<MenuItemTemplate>> parseMenuTemplate(ResourceBytes data) {
    return MenuReader(data).read();
}

} // namespace tvx
