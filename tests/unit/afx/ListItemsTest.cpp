#include "platform/afx/detail/ListItems.h"

#include <gtest/gtest.h>

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

} // namespace
