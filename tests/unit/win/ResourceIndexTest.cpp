#include "platform/win/detail/ResourceIndex.h"

#include "platform/win/Error.h"
#include "platform/win/Resource.h"
#include "tests/unit/win/Damage.h"

#include <fstream>
#include <iterator>
#include <set>

using tvx::detail::ResourceIndex;

namespace {

std::vector<std::uint8_t> compiledScript() {
    std::ifstream file(TVX_TEST_SCRIPT, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace

TEST(ResourceIndex, HoldsEveryResourceOnce) {
    const std::vector<std::uint8_t> data = compiledScript();
    const ResourceIndex index(data);
    EXPECT_EQ(index.damage(), "");
    std::set<std::string> dialogs;
    for (const auto& entry : index.entries()) {
        if (entry.type == "#5") {
            dialogs.insert(entry.name);
        }
    }
    EXPECT_EQ(dialogs, (std::set<std::string>{"#130", "#131"}));
    EXPECT_TRUE(index.hasType("#240"));
    EXPECT_FALSE(index.hasType("#3000"));
}

TEST(ResourceIndex, TruncatedFilesAreRefused) {
    const std::vector<std::uint8_t> data = compiledScript();
    const std::size_t complete = ResourceIndex(data).entries().size();
    ASSERT_GT(complete, 10u);
    for (std::size_t length = 0; length < data.size(); ++length) {
        const ExactBytes part(tvx::ResourceBytes(data).first(length));
        const ResourceIndex index(part.view());
        // A file cut between two resources is a shorter file.
        if (index.damage().empty()) {
            EXPECT_LT(index.entries().size(), complete + (data.size() - length < 4 ? 1 : 0)) << length;
        } else {
            EXPECT_TRUE(index.entries().empty()) << length;
        }
    }
}

TEST(ResourceIndex, DamagedSizesDoNotReadOutside) {
    const std::vector<std::uint8_t> data = compiledScript();
    ExactBytes copy(data);
    const std::uint8_t* const last = copy.view().data() + data.size();
    for (std::size_t bit = 0; bit < data.size() * 8; ++bit) {
        copy.flip(bit);
        const ResourceIndex index(copy.view());
        for (const auto& entry : index.entries()) {
            ASSERT_LE(entry.data.data() + entry.data.size(), last);
        }
        copy.flip(bit);
    }
}

TEST(ResourceIndex, DamageIsReportedForTheModule) {
    static const std::uint8_t damaged[] = {0, 1, 2, 3};
    tvx::registerResources(damaged, damaged, sizeof damaged);
    EXPECT_EQ(tvx::resourceDamage(nullptr), "no list of resources");
    EXPECT_EQ(tvx::resourceString(nullptr, 100), "Hello\tworld\n") << "sound parts of a module stay usable";
    tvx::unregisterResources(damaged);
    EXPECT_EQ(tvx::resourceDamage(nullptr), "");
}
