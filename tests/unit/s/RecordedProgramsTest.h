#pragma once

#include "Children.h"
#include "NoProgramsTest.h"
#include "TestApp.h"

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

/// Browsers and viewers that write down how they were started, and message boxes that are kept.
class RecordedProgramsTest : public NoProgramsTest {
protected:
    void SetUp() override {
        NoProgramsTest::SetUp();
        theApp.boxes.clear();
        setenv("RECORD", record().c_str(), 1);
        for (const char* name : {"PATH/browser", "PATH/system", "PATH/last", "my dir/browser"}) {
            install(name);
        }
    }
    void TearDown() override {
        awaitReleased(); // they write into the folder that goes
        NoProgramsTest::TearDown();
    }
    /// A program that writes down its name, its arguments and where it runs.
    void install(const std::filesystem::path& name) const {
        std::filesystem::create_directories((m_folder / name).parent_path());
        std::ofstream(m_folder / name) << "#!/bin/sh\n{ printf '%s|' \"${0##*/}\" \"$@\"; pwd; } >\"$RECORD.new\"; "
                                          "/bin/mv \"$RECORD.new\" \"$RECORD\"\n";
        std::filesystem::permissions(m_folder / name, std::filesystem::perms::owner_all);
    }
    [[nodiscard]] std::filesystem::path record() const {
        return m_folder / "record";
    }
    /// What the started program has written down, without the folder unless it is not the current one.
    [[nodiscard]] std::string started() const {
        awaitReleased();
        std::ifstream file(record());
        std::string text((std::istreambuf_iterator<char>(file)), {});
        std::filesystem::remove(record());
        const std::string here = "|" + std::filesystem::current_path().string() + "\n";
        return text.ends_with(here) ? text.substr(0, text.size() - here.size()) : text;
    }
    /// The texts of the message boxes since the last question, all of them plain.
    static std::string boxes() {
        std::string texts;
        for (const TestApp::Box& box : theApp.boxes) {
            EXPECT_EQ(box.type, UINT{MB_OK});
            texts += "[" + box.text + "]";
        }
        theApp.boxes.clear();
        return texts;
    }
};
