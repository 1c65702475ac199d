#include "platform/afx/controls/detail/ListItems.h"
#include "platform/base/Text.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using tvx::afx::ListItems;
using Match = ListItems::Match;

ListItems sorted(std::initializer_list<const char*> lines) {
    ListItems items;
    for (const char* line : lines) {
        items.insertSorted({line});
    }
    return items;
}

std::string joined(const ListItems& items) {
    std::string all;
    for (int index = 0; index < items.count(); ++index) {
        all += items.at(index).text + ' ';
    }
    return all;
}

TEST(ListItems, KeepOrderWithoutCaseAndEqualsInTheirOwn) {
    EXPECT_EQ(joined(sorted({"fig", "Apple", "éclair", "pear", "apple", "Éclair", "Fig"})),
              "Apple apple fig Fig pear éclair Éclair ");
}

TEST(ListItems, SearchGoesOnAtTheTop) {
    const ListItems items = sorted({"alpha", "Alps", "beta"});
    EXPECT_EQ(items.find("al", -1, Match::Prefix), 0);
    EXPECT_EQ(items.find("AL", 0, Match::Prefix), 1);
    EXPECT_EQ(items.find("al", 1, Match::Prefix), 0);
    EXPECT_EQ(items.find("al", 2, Match::Prefix), 0);   // behind the last line
    EXPECT_EQ(items.find("al", 500, Match::Prefix), 0); // and behind any
    EXPECT_EQ(items.find("ALPS", -1, Match::Whole), 1);
    EXPECT_EQ(items.find("alp", -1, Match::Whole), -1);
    EXPECT_EQ(ListItems().find("", -1, Match::Prefix), -1);
}

TEST(ListItems, FindDataAndCountTheSelected) {
    ListItems items;
    for (const LONG_PTR data : {7, 9, 7}) {
        items.insert(-1, {"", data, data == 7});
    }
    EXPECT_EQ(items.findData(7, 0), 2);
    EXPECT_EQ(items.findData(8, -1), -1);
    EXPECT_EQ(items.selectedCount(), 2);
    items.remove(0);
    EXPECT_EQ(items.selectedCount(), 1);
    EXPECT_FALSE(items.isValid(2));
    EXPECT_FALSE(items.isValid(-1));
}

int findIn(const std::vector<std::string>& table, const std::string& wanted, int after) {
    const auto count = static_cast<int>(table.size());
    for (int step = 0; step < count; ++step) {
        const int index = (after + 1 + step) % count;
        if (tvx::text::equalNoCase(table[static_cast<std::size_t>(index)], wanted)) {
            return index;
        }
    }
    return -1;
}

TEST(ListItems, AgreeWithAPlainTableThroughEveryChange) {
    ListItems items;
    std::vector<std::string> table;
    unsigned random = 1;
    const auto next = [&](std::size_t below) {
        random = random * 1103515245 + 12345;
        return (random >> 8) % (below + 1);
    };
    for (int i = 0; i < 20000; ++i) {
        const auto place = static_cast<std::ptrdiff_t>(next(table.size()));
        if (next(9) < 6 || table.empty()) {
            const std::string text = (next(1) != 0 ? "É" : "k") + std::to_string(next(300));
            EXPECT_EQ(items.insert(place, {text}), place);
            table.insert(table.begin() + place, text);
        } else if (place < std::ssize(table)) {
            items.remove(static_cast<int>(place));
            table.erase(table.begin() + place);
        }
        if (i % 64 == 0) {
            const std::string wanted = (next(1) != 0 ? "é" : "K") + std::to_string(next(300));
            const auto after = static_cast<int>(next(table.size())) - 1;
            EXPECT_EQ(items.find(wanted, after, Match::Whole), findIn(table, wanted, after));
        }
    }
    ASSERT_EQ(items.count(), std::ssize(table));
    for (int index = 0; index < items.count(); ++index) {
        ASSERT_EQ(items.at(index).text, table[static_cast<std::size_t>(index)]) << index;
    }
}

} // namespace
