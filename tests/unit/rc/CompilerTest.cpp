#include "tools/rc/Compiler.h"

#include <gtest/gtest.h>

#include <unistd.h>

#include <fstream>
#include <iterator>

namespace {

namespace fs = std::filesystem;

// A folder with a host's script, compiled as a build does it.
class CompilerTest : public testing::Test {
protected:
    CompilerTest() : m_folder(fs::path(testing::TempDir()) / ("rc-" + std::to_string(::getpid()))) {
        fs::create_directories(m_folder);
        m_options.script = m_folder / "host.rc";
        m_options.output = m_folder / "host.res";
        m_options.dependencies = m_folder / "host.d";
        m_options.includes = {TVX_SOURCE_DIR "/platform/include", TVX_SOURCE_DIR};
    }
    ~CompilerTest() override {
        fs::remove_all(m_folder);
    }

    void write(const fs::path& name, const std::string& text) {
        fs::create_directories((m_folder / name).parent_path());
        std::ofstream(m_folder / name, std::ios::binary) << text;
    }
    std::string read(const fs::path& name) {
        std::ifstream file(m_folder / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    void compile(const std::string& script) {
        write("host.rc", script);
        rc::compile(m_options);
    }
    /// "line: message" of the fault in `script`, empty when there is none.
    std::string faultIn(const std::string& script) {
        try {
            compile(script);
            return {};
        } catch (const rc::Fault& fault) {
            if (fault.place.line == 0) {
                return fault.message;
            }
            EXPECT_EQ(fs::path(fault.place.file).filename(), m_faultyFile);
            return std::to_string(fault.place.line) + ": " + fault.message;
        }
    }
    bool outputHolds(std::string_view bytes) {
        return read("host.res").find(bytes) != std::string::npos;
    }

    fs::path m_folder;
    rc::Options m_options;
    std::string m_faultyFile = "host.rc";
};

} // namespace

TEST_F(CompilerTest, FaultsNameTheAuthorsLine) {
    const std::string good = "#include \"afxres.h\"\n\nSTRINGTABLE BEGIN 1 \"a\" END\n";
    EXPECT_EQ(faultIn(good + "5 DIALOG 0,0,9,9\nBEGIN\n LTEXT \"x\", IDD_NONE, 1,1,2,2\nEND\n7 RCDATA BEGIN 1 END\n"),
              "6: Error parsing file: expected '-', '~', integer or '(', got IDD_NONE");
    EXPECT_EQ(faultIn(good + "5 TOOLBAR 16, 15\nBEGIN\n BUTTON ID_FILE_NEW\n BUTON 7\nEND\n"),
              "7: expected BUTTON, got BUTON");
    EXPECT_EQ(faultIn(good + "5 TOOLBAR 16, 15\nBEGIN\n BUTTON 70000\nEND\n"),
              "6: expected a number of 16 bits, got 70000");
    EXPECT_EQ(faultIn(good + "5 TOOLBAR 16, 15\nBEGIN\n BUTTON 7\n"), "6: expected BUTTON behind this line");
    EXPECT_EQ(faultIn(good + "5 BITMAP \"none.bmp\"\n"), "4: file not found: none.bmp");
    EXPECT_EQ(faultIn(good + "5 MENUEX BEGIN POPUP \"x\"\nBEGIN\nEND END\n"), "6: expected MENUITEM or POPUP, got END");
    EXPECT_EQ(faultIn(good + "5 ACCELERATORS BEGIN\n \"ab\", 5, ASCII, ALT\nEND\n"),
              "5: expected one character, got \"ab\"");
}

TEST_F(CompilerTest, FaultsInIncludedFilesNameThose) {
    m_faultyFile = "part.rc2";
    write("part.rc2", "\n\n5 BITMAP \"none.bmp\"\n");
    EXPECT_EQ(faultIn("#include \"part.rc2\"\n"), "3: file not found: none.bmp");
    EXPECT_NE(faultIn("\n#include \"absent.h\"\n").find("host.rc:2"), std::string::npos);
}

TEST_F(CompilerTest, IncludedFilesInUtf16AreRefused) {
    m_faultyFile = "wide.rc2";
    write("wide.rc2", std::string("\xFF\xFE\x35\0\n\0", 6));
    EXPECT_EQ(faultIn("#include \"wide.rc2\"\n"), "1: an included file in UTF-16: save it as UTF-8");
}

TEST_F(CompilerTest, FailureLeavesTheLastResult) {
    compile("5 RCDATA BEGIN \"first\" END\n");
    EXPECT_NE(faultIn("5 RCDATA BEGIN ? END\n"), "");
    EXPECT_TRUE(outputHolds("first"));
    write("host.rc", "");
    fs::remove(m_folder / "host.rc");
    EXPECT_THROW(rc::compile(m_options), rc::Fault);
}

TEST_F(CompilerTest, EveryFileThatWasReadIsADependency) {
    write("my ids.h", "#define FIVE 5\nint declaredFunction(int);\n");
    write("Data/Notes.txt", "notes");
    compile("#include \"My Ids.h\"\nFIVE RCDATA \"data\\\\notes.TXT\"\n");
    EXPECT_TRUE(outputHolds("notes"));
    const std::string rule = read("host.d");
    for (const char* name : {"host.rc", "my\\ ids.h", "Data/Notes.txt"}) {
        EXPECT_NE(rule.find(name), std::string::npos) << name << " in " << rule;
    }
}

TEST_F(CompilerTest, TextsAreReadInTheirEncoding) {
    compile("STRINGTABLE BEGIN 1 \"\xC3\xA4\xF0\x9F\x98\x80\" END\n");
    const std::string expected("\xE4\0\x3D\xD8\0\xDE", 6);
    EXPECT_TRUE(outputHolds(expected));
    compile("\xEF\xBB\xBFSTRINGTABLE BEGIN 1 \"\xC3\xA4\xF0\x9F\x98\x80\" END\n");
    EXPECT_TRUE(outputHolds(expected));
    compile("STRINGTABLE BEGIN 1 \"\xE4\x80\" END\n");
    EXPECT_TRUE(outputHolds(std::string("\xE4\0\xAC\x20", 4)));
    std::string wide = "\xFF\xFE";
    for (const char c : std::string("5 RCDATA BEGIN \"wide\" END\r\n")) {
        wide += {c, '\0'};
    }
    compile(wide);
    EXPECT_TRUE(outputHolds("wide"));
}

TEST_F(CompilerTest, PlatformNamesOfThisSystemAreNoMacros) {
    compile("#ifdef unix\n#error\n#endif\n#ifndef RC_INVOKED\n#error\n#endif\nlinux RCDATA BEGIN 1 END\n");
    EXPECT_TRUE(outputHolds(std::string("L\0I\0N\0U\0X\0", 10)));
}
