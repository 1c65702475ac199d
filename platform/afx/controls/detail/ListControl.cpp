#include "platform/afx/controls/detail/ListControl.h"

#include "platform/afx/core/detail/Dispatch.h"

#include <QPalette>

#include <algorithm>
#include <cstring>

namespace tvx::afx {

void ListControl::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    applyFieldColors(palette, text, background);
}

ListItems::Item ListControl::newItem(LPARAM text) const {
    ListItems::Item item;
    if (hasStrings()) {
        item.text = text != 0 ? reinterpret_cast<const char*>(text) : "";
    } else {
        item.data = text;
    }
    return item;
}

int ListControl::askHeight(int standard) {
    MEASUREITEMSTRUCT item{};
    item.CtlType = m_kind.ownerType;
    item.CtlID = static_cast<UINT>(id());
    item.itemHeight = static_cast<UINT>(standard);
    SendMessageA(parent()->handle(), WM_MEASUREITEM, item.CtlID, reinterpret_cast<LPARAM>(&item));
    // Whatever the owner answers, a line has a height: lines are counted by dividing by it.
    return std::clamp(static_cast<int>(item.itemHeight), 1, 1000);
}

void ListControl::tellDeleted(int index) {
    if (!isOwnerDrawn() || !parent()) {
        return;
    }
    DELETEITEMSTRUCT gone{m_kind.ownerType, static_cast<UINT>(id()), static_cast<UINT>(index), handle(),
                          static_cast<ULONG_PTR>(m_items.at(index).data)};
    SendMessageA(parent()->handle(), WM_DELETEITEM, gone.CtlID, reinterpret_cast<LPARAM>(&gone));
}

void ListControl::tellAllDeleted() {
    for (int row = 0; isOwnerDrawn() && row < m_items.count(); ++row) {
        tellDeleted(row);
    }
}

LRESULT ListControl::find(WPARAM after, LPARAM text, ListItems::Match match) const {
    const auto start = static_cast<int>(after);
    if (!hasStrings()) {
        return m_items.findData(text, start);
    }
    return text != 0 ? m_items.find(reinterpret_cast<const char*>(text), start, match) : LB_ERR;
}

LRESULT ListControl::copyText(WPARAM index, LPARAM buffer) const {
    const auto row = static_cast<int>(index);
    if (!m_items.isValid(row)) {
        return LB_ERR;
    }
    const auto& item = m_items.at(row);
    if (!hasStrings()) {
        std::memcpy(reinterpret_cast<void*>(buffer), &item.data, sizeof(item.data));
        return sizeof(item.data);
    }
    std::memcpy(reinterpret_cast<void*>(buffer), item.text.c_str(), item.text.size() + 1);
    return static_cast<LRESULT>(item.text.size());
}

LRESULT ListControl::textLength(WPARAM index) const {
    const auto row = static_cast<int>(index);
    if (!m_items.isValid(row)) {
        return LB_ERR;
    }
    return hasStrings() ? static_cast<LRESULT>(m_items.at(row).text.size()) : LRESULT{sizeof(LONG_PTR)};
}

LRESULT ListControl::itemData(WPARAM index) const {
    const auto row = static_cast<int>(index);
    return m_items.isValid(row) ? m_items.at(row).data : LB_ERR;
}

LRESULT ListControl::setItemData(WPARAM index, LPARAM data) {
    const auto row = static_cast<int>(index);
    if (!m_items.isValid(row)) {
        return LB_ERR;
    }
    m_items.at(row).data = data;
    return LB_OKAY;
}

} // namespace tvx::afx
