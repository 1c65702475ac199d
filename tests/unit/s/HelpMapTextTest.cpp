// Maps so large that they are best made in memory. HelpMapTest reads others from disk.
#include "s/HelpMapText.h"

#include <gtest/gtest.h>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace {

/// Maps by their names.
class Memory : public HelpMapSource {
public:
    std::string findInclude(const std::string& name) override {
        return maps.contains(name) ? name : std::string();
    }
    std::string normalized(const std::string& name) override {
        return name;
    }
    std::optional<std::string> read(const std::string& name) override {
        return maps.at(name);
    }
    void remark(HelpMapRemark remark, const HelpMapFile& file, std::string_view, std::string_view about) override {
        remarks.emplace_back(remark, file.name + " " + std::string(about));
    }

    std::unordered_map<std::string, std::string> maps;
    std::vector<std::pair<HelpMapRemark, std::string>> remarks;
};

std::vector<std::string_view> filesOf(const HelpMapText& map, const std::string& key) {
    const auto found = map.find(key);
    return found ? ReadHelpMapRecord(map.sections()[*found]).files : std::vector<std::string_view>{"none"};
}

using Files = std::vector<std::string_view>;

/// A deep chain must not need a deep stack, nor time that grows with its square.
TEST(HelpMapText, ReadsLongChainsOfIncludes) {
    constexpr int length = 100000;
    Memory memory;
    for (int i = 0; i < length; ++i) {
        const std::string name = std::to_string(i);
        memory.maps[name + ".map"] = "[" + name + "]\nfile=first\n# " + name + "\n# " +
                                     std::to_string((i + 1) % length) + "\nfile=last\n[end of " + name +
                                     "]\nfile=" + name;
    }
    HelpMapText map;
    ASSERT_TRUE(map.add("0.map", memory));
    EXPECT_EQ(map.files().size(), std::size_t{length});
    EXPECT_EQ(filesOf(map, "0"), (Files{"first", "last"}));
    EXPECT_EQ(filesOf(map, "99999"), (Files{"first", "last"}));
    EXPECT_EQ(filesOf(map, "end of 50000"), Files{"50000"});
    // Each includes itself, and the last the first.
    ASSERT_EQ(memory.remarks.size(), std::size_t{length + 1});
    EXPECT_EQ(memory.remarks[0], std::pair(HelpMapRemark::IncludedWhileRead, std::string("0.map 0.map")));
}

TEST(HelpMapText, HoldsManySectionsAndLongLines) {
    constexpr int count = 1000000;
    const std::string longLine(10000000, 'x');
    Memory memory;
    std::string& text = memory.maps["m"];
    for (int i = 0; i < count; ++i) {
        text += "[topic " + std::to_string(i) + "]\nfile=" + std::to_string(i) + "\n";
    }
    text += "[long]\nfile=" + longLine + "\n[" + longLine + "]\nfile=a\n";
    HelpMapText map;
    ASSERT_TRUE(map.add("m", memory));
    EXPECT_EQ(map.sections().size(), std::size_t{count + 2});
    EXPECT_EQ(filesOf(map, "topic 0"), Files{"0"});
    EXPECT_EQ(filesOf(map, "topic 999999"), Files{"999999"});
    EXPECT_EQ(filesOf(map, "topic 1000000"), Files{"none"});
    EXPECT_EQ(filesOf(map, "long"), Files{longLine});
    EXPECT_EQ(filesOf(map, longLine), Files{"a"});
}

} // namespace
