#pragma once

/// @file
/// The lines of a list or combo box: a flat table without any idea of windows.

#include "platform/afx/controls/detail/GapBuffer.h"
#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::afx {

/// Lines with their data. Indices count from 0; a function that takes one expects it to be valid (isValid).
///
/// Made for tens of thousands of lines: inserting and removing moves numbers, not lines, and a whole text is found by
/// its number rather than by comparing texts.
class TVX_PLATFORM_API ListItems {
public:
    struct Item {
        std::string text;
        LONG_PTR data = 0;
        bool selected = false;
    };

    /// How texts are compared when one is looked for.
    enum class Match { Prefix, Whole };

    int count() const {
        return static_cast<int>(m_order.size());
    }
    bool isValid(LONG_PTR index) const {
        return index >= 0 && index < count();
    }
    /// The text must not be changed.
    Item& at(int index) {
        return m_items[m_order[static_cast<std::size_t>(index)]];
    }
    const Item& at(int index) const {
        return m_items[m_order[static_cast<std::size_t>(index)]];
    }
    void reserve(std::size_t lines) {
        m_order.reserve(lines);
    }
    /// Puts a line before `index`, or behind all others when it is -1; answers its place.
    int insert(LONG_PTR index, Item item);
    /// Puts a line where the order of texts without case wants it, behind its equals.
    int insertSorted(Item item);
    void remove(int index);
    void clear();

    /// The next line behind `after` (-1: from the first on) whose text matches without case, the search going on at the
    /// top; -1 for none.
    int find(std::string_view text, LONG_PTR after, Match match) const;
    /// The same for the data of a line.
    int findData(LONG_PTR data, LONG_PTR after) const;
    int selectedCount() const;

private:
    int findWhole(std::string_view text, std::size_t first) const;

    std::deque<Item> m_items; ///< in the order they came
    std::vector<std::uint32_t> m_free;
    GapBuffer<std::uint32_t> m_order; ///< places in m_items
    /// Numbers of the texts without case, line by line, made by the first search for a whole text.
    mutable GapBuffer<std::uint32_t> m_keys;
    mutable bool m_keyed = false;
};

} // namespace tvx::afx
