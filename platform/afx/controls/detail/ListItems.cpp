#include "platform/afx/controls/detail/ListItems.h"

#include "platform/base/Text.h"

#include <algorithm>

namespace tvx::afx {

namespace {

// Start and prime of the FNV-1a hash: a few instructions a byte, and texts are compared only where it agrees.
constexpr std::uint32_t hashStart = 2166136261U;

std::uint32_t hashStep(std::uint32_t hash, char byte) {
    constexpr std::uint32_t prime = 16777619U;
    return (hash ^ static_cast<unsigned char>(byte)) * prime;
}

/// Equal for texts that are equal without case.
std::uint32_t keyOf(std::string_view text) {
    std::uint32_t key = hashStart;
    for (const char byte : text) {
        if (static_cast<unsigned char>(byte) >= 0x80) {
            // Folding beyond ASCII may change the length, so it is done for the whole text.
            key = hashStart;
            for (const char folded : text::foldCase(text)) {
                key = hashStep(key, folded);
            }
            return key;
        }
        key = hashStep(key, byte >= 'A' && byte <= 'Z' ? static_cast<char>(byte + ('a' - 'A')) : byte);
    }
    return key;
}

/// Calls `matches` with each index once, beginning behind `after`; answers the first that does, -1 for none.
template <class Matches>
int search(int count, std::size_t first, const Matches& matches) {
    for (int step = 0; step < count; ++step) {
        const int index = static_cast<int>((first + static_cast<std::size_t>(step)) % static_cast<std::size_t>(count));
        if (matches(index)) {
            return index;
        }
    }
    return -1;
}

std::size_t firstBehind(LONG_PTR after, int count) {
    return after >= 0 && after + 1 < count ? static_cast<std::size_t>(after) + 1 : 0;
}

} // namespace

int ListItems::insert(LONG_PTR index, Item item) {
    const std::size_t place = index < 0 ? m_order.size() : static_cast<std::size_t>(index);
    if (m_keyed) {
        m_keys.insert(place, keyOf(item.text));
    }
    if (m_free.empty()) {
        m_order.insert(place, static_cast<std::uint32_t>(m_items.size()));
        m_items.push_back(std::move(item));
    } else {
        m_order.insert(place, m_free.back());
        m_items[m_free.back()] = std::move(item);
        m_free.pop_back();
    }
    return static_cast<int>(place);
}

int ListItems::insertSorted(Item item) {
    // Lists are mostly filled in order already, so the end is tried first.
    if (count() == 0 || text::compareNoCase(at(count() - 1).text, item.text) <= 0) {
        return insert(-1, std::move(item));
    }
    int first = 0;
    int last = count();
    while (first < last) {
        const int middle = first + (last - first) / 2;
        if (text::compareNoCase(item.text, at(middle).text) < 0) {
            last = middle;
        } else {
            first = middle + 1;
        }
    }
    return insert(first, std::move(item));
}

void ListItems::remove(int index) {
    const auto place = static_cast<std::size_t>(index);
    m_free.push_back(m_order[place]);
    m_items[m_order[place]] = {};
    m_order.erase(place);
    if (m_keyed) {
        m_keys.erase(place);
    }
}

void ListItems::clear() {
    *this = {};
}

int ListItems::findWhole(std::string_view text, std::size_t first) const {
    const std::size_t count = m_order.size();
    if (!m_keyed) {
        m_keys.reserve(count);
        for (std::size_t index = 0; index < count; ++index) {
            m_keys.insert(index, keyOf(m_items[m_order[index]].text));
        }
        m_keyed = true;
    }
    const std::uint32_t key = keyOf(text);
    const auto within = [&](std::size_t from, std::size_t end) {
        std::size_t index = m_keys.find(key, from, end);
        while (index < end && !text::equalNoCase(m_items[m_order[index]].text, text)) {
            index = m_keys.find(key, index + 1, end);
        }
        return index < end ? static_cast<int>(index) : -1;
    };
    const int found = within(first, count);
    return found >= 0 ? found : within(0, first);
}

int ListItems::find(std::string_view text, LONG_PTR after, Match match) const {
    const std::size_t first = firstBehind(after, count());
    if (match == Match::Whole) {
        return findWhole(text, first);
    }
    return search(count(), first, [&](int index) { return text::startsWithNoCase(at(index).text, text); });
}

int ListItems::findData(LONG_PTR data, LONG_PTR after) const {
    return search(count(), firstBehind(after, count()), [&](int index) { return at(index).data == data; });
}

int ListItems::selectedCount() const {
    int selected = 0;
    for (int index = 0; index < count(); ++index) {
        selected += at(index).selected ? 1 : 0;
    }
    return selected;
}

} // namespace tvx::afx
