#include "tools/includes/Forwarder.h"

#include <gtest/gtest.h>

#include <unistd.h>

#include <fstream>
#include <iterator>

namespace {

namespace fs = std::filesystem;

/// A host's folder, and the names that are helped on in it.
class ForwarderTest : public testing::Test {
protected:
    ForwarderTest() : m_folder(fs::path(testing::TempDir()) / ("includes-" + std::to_string(::getpid()))) {
        m_options = {{m_folder / "Host.cpp"}, {m_folder},         {m_folder / "system"},
                     m_folder / "made",       m_folder / "stamp", m_folder / "made.d"};
    }
    ~ForwarderTest() override {
        fs::remove_all(m_folder);
    }
    void write(const fs::path& name, const std::string& text) {
        fs::create_directories((m_folder / name).parent_path());
        std::ofstream(m_folder / name) << text;
    }
    std::string read(const fs::path& file) {
        std::ifstream stream(file);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    /// What a name forwards to below the host's folder; empty when nothing was made for it.
    std::string forwarded(const std::string& name) {
        const std::string text = read(includes::searchFolder(m_options.output) / name);
        const std::string before = "#include \"" + fs::canonical(m_folder).string() + "/";
        return text.starts_with(before) ? text.substr(before.size(), text.size() - before.size() - 2) : text;
    }

    fs::path m_folder;
    includes::Options m_options;
};

TEST_F(ForwarderTest, HelpsOnWhatNoFileIsCalled) {
    write("Host.cpp",
          "#include \"stdafx.h\"\n  # include \"Parts\\dialog.h\"\n#include <Math.H>\n#include \"Missing.h\"\n"
          "#include \"Exact.h\"\n// #include \"EXACT.H\" is what it was called\n");
    write("StdAfx.h", "#pragma once\n");
    write("Exact.h", "");
    write("parts/Dialog.h", "#include \"..\\resource.h\"\n#include \"../PARTS/DIALOG.H\"\n");
    write("Resource.h", "");
    write("system/math.h", "#include \"STDAFX.H\"\n");
    EXPECT_TRUE(includes::forward(m_options).empty());
    EXPECT_EQ(forwarded("stdafx.h"), "StdAfx.h");
    EXPECT_EQ(forwarded("Parts\\dialog.h"), "parts/Dialog.h");
    EXPECT_EQ(forwarded("..\\resource.h"), "Resource.h");
    EXPECT_EQ(forwarded("../PARTS/DIALOG.H"), "parts/Dialog.h") << "above the folder that is searched";
    EXPECT_EQ(forwarded("Math.H"), "system/math.h");
    EXPECT_EQ(forwarded("STDAFX.H"), "") << "headers of the system are not looked into";
    EXPECT_EQ(forwarded("Exact.h"), "");
    EXPECT_NE(read(m_options.dependencies).find("parts/Dialog.h"), std::string::npos);
}

TEST_F(ForwarderTest, FollowsChangesAndLeavesTheRestAlone) {
    write("Host.cpp", "#include \"one.h\"\n#include \"two.h\"\n");
    write("One.h", "");
    write("Two.h", "");
    EXPECT_TRUE(includes::forward(m_options).empty());
    const fs::path kept = includes::searchFolder(m_options.output) / "two.h";
    const auto before = fs::last_write_time(kept) - std::chrono::hours(1);
    fs::last_write_time(kept, before);
    write("Host.cpp", "#include \"two.h\"\n");
    EXPECT_TRUE(includes::forward(m_options).empty());
    EXPECT_EQ(forwarded("one.h"), "");
    EXPECT_EQ(fs::last_write_time(kept), before) << "sources are compiled again for nothing";
}

TEST_F(ForwarderTest, WarnsOfNamesWithTwoMeanings) {
    write("Host.cpp", "#include \"parts\\dialog.h\"\n#include \"thing.h\"\n");
    write("parts/Dialog.h", "\n#include \"thing.h\"\n");
    write("Thing.h", "");
    write("parts/Thing.h", "");
    const std::vector<std::string> warnings = includes::forward(m_options);
    ASSERT_EQ(warnings.size(), 1U);
    EXPECT_NE(warnings[0].find("Thing.h elsewhere"), std::string::npos) << warnings[0];
}

} // namespace
