#include "platform/afx/detail/ListItems.h"

#include "platform/base/Text.h"

#include <algorithm>

namespace tvx::afx {

int ListItems::insert(LONG_PTR index, Item item) {
    const int place = index < 0 ? count() : static_cast<int>(index);
    m_items.insert(m_items.begin() + place, std::move(item));
    return place;
}

int ListItems::insertSorted(Item item) {
    // Lists are mostly filled in order already, so the end is tried first.
    if (m_items.empty() || text::compareNoCase(m_items.back().text, item.text) <= 0) {
        return insert(-1, std::move(item));
    }
    const auto before = [](const Item& left, const Item& right) {
        return text::compareNoCase(left.text, right.text) < 0;
    };
    const auto place = std::upper_bound(m_items.begin(), m_items.end(), item, before);
    return insert(place - m_items.begin(), std::move(item));
}

void ListItems::remove(int index) {
    m_items.erase(m_items.begin() + index);
}

void ListItems::clear() {
    m_items.clear();
    m_items.shrink_to_fit();
}

namespace {

/// Calls `matches` with each index once, beginning behind `after`; answers the first that does, -1 for none.
template <class Matches>
int search(int count, LONG_PTR after, const Matches& matches) {
    const int first = after >= 0 && after + 1 < count ? static_cast<int>(after) + 1 : 0;
    for (int step = 0; step < count; ++step) {
        const int index = (first + step) % count;
        if (matches(index)) {
            return index;
        }
    }
    return -1;
}

} // namespace

int ListItems::find(std::string_view text, LONG_PTR after, Match match) const {
    return search(count(), after, [&](int index) {
        const std::string& line = at(index).text;
        return match == Match::Whole ? text::equalNoCase(line, text) : text::startsWithNoCase(line, text);
    });
}

int ListItems::findData(LONG_PTR data, LONG_PTR after) const {
    return search(count(), after, [&](int index) { return at(index).data == data; });
}

int ListItems::selectedCount() const {
    return static_cast<int>(
        std::count_if(m_items.begin(), m_items.end(), [](const Item& item) { return item.selected; }));
}

} // namespace tvx::afx
