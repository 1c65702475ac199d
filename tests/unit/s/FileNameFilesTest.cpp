// File names on real folders, with a table of drives of the test's own.
#include "s/FileName.h"

#include "platform/base/SystemPath.h"
#include "platform/win/Network.h"
#include "tests/unit/base/FileTestFolder.h"

#include <algorithm>
#include <cstdlib>
#include <random>
#include <sys/file.h>
#include <sys/stat.h>

namespace {

/// D: is a folder of work, E: a removable medium, F: a disc, X: a share; network names are on.
class FileNameFiles : public FileTestFolder {
protected:
    FileNameFiles() {
        for (const char* folder : {"work", "stick", "disc", "data"}) {
            std::filesystem::create_directory(folder);
        }
        m_table = "C=/;D=" + m_folder + "/work;E=" + m_folder + "/stick|removable;F=" + m_folder +
                  "/disc|cdrom;X=" + m_folder + "/data|\\\\Srv\\Data";
        ::setenv("TVX_DRIVES", m_table.c_str(), 1);
        Gui_FileName::SetUncFlag(1);
    }
    ~FileNameFiles() override {
        Gui_FileName::SetUncFlag(1);
        ::unsetenv("TVX_DRIVES");
    }

    static void enter(const char* folder) {
        std::filesystem::create_directories(folder);
        std::filesystem::current_path(folder);
    }
    static CString full(const char* name, int unc = 1) {
        return Gui_FileName(name).GetFullName(unc);
    }

    std::string m_table;
};

} // namespace

TEST_F(FileNameFiles, AreCompletedWithTheCurrentDriveAndFolder) {
    enter("work/deep");
    EXPECT_EQ(full("sub\\f.txt"), "D:\\deep\\sub\\f.txt");
    EXPECT_EQ(full("sub\\f.txt", 0), "D:sub\\f.txt");
    EXPECT_EQ(full("f"), "D:\\deep\\f");
    EXPECT_EQ(full("f", 0), "D:\\deep\\f");
    EXPECT_EQ(full(""), "D:\\deep\\");
    EXPECT_EQ(full("\\f"), "D:\\f");
    EXPECT_EQ(full("E:f"), "E:\\deep\\f");
    EXPECT_EQ(full("E:"), "E:\\deep\\");
    EXPECT_EQ(full("E:\\f"), "E:\\f");
    enter("../../work");
    EXPECT_EQ(full("f"), "D:\\f");
}

TEST_F(FileNameFiles, AreCompletedWithDefaults) {
    const Gui_FileName folder("C:\\dir\\");
    EXPECT_EQ(folder.GetFullName(1, nullptr, nullptr, "untitled", "txt"), "C:\\dir\\untitled.txt");
    EXPECT_EQ(folder.GetFullName(1, nullptr, nullptr, "untitled", ""), "C:\\dir\\untitled");
    EXPECT_EQ(folder.GetFullName(1, nullptr, nullptr, nullptr, nullptr, 1), "C:\\dir");
    const Gui_FileName name("a.b");
    EXPECT_EQ(name.GetFullName(1, "e", "/p"), "e:\\p\\a.b");
    EXPECT_EQ(name.GetFullName(1, "", "\\p"), "\\p\\a.b");
    EXPECT_EQ(name.GetFullName(1, "E:", ""), "E:a.b");
    EXPECT_EQ(name.GetFullName(0, "E:", "p"), "E:p\\a.b");
    EXPECT_EQ(name.GetMountAndPath(1, "E:", "\\p", 1), "E:\\p");
    EXPECT_EQ(name.GetMountAndPath(1, "X:", "\\p"), "\\\\srv\\data\\p\\");
    EXPECT_EQ(name.GetMountAndPath(0, "X:", "\\p"), "X:\\p\\");
    EXPECT_EQ(name.GetName(), "a.b") << "completing leaves the name as it was";
}

TEST_F(FileNameFiles, WithoutACurrentDriveTheMountStaysEmpty) {
    ::setenv("TVX_DRIVES", "D=/nowhere", 1);
    std::string folder = m_folder;
    std::ranges::replace(folder, '/', '\\');
    EXPECT_EQ(full("a"), (folder + "\\a").c_str());
    put("a");
    EXPECT_EQ(Gui_FileName("a").Exists(), 1);
}

TEST_F(FileNameFiles, TheTextOfTheConversionStays) {
    Gui_FileName name("C:\\a\\b.c");
    const char* text = name;
    name.SetBase("x");
    EXPECT_STREQ(text, "C:\\a\\b.c");
    EXPECT_STREQ(static_cast<const char*>(name), "C:\\a\\x.c");
}

TEST_F(FileNameFiles, LongFoldersAreKeptWhole) {
    std::string path = m_folder;
    for (int i = 0; i < 8; ++i) {
        std::filesystem::current_path([&] {
            const std::string part(100, static_cast<char>('a' + i));
            std::filesystem::create_directory(part);
            path += "/" + part;
            return part;
        }());
    }
    std::ranges::replace(path, '/', '\\');
    EXPECT_EQ(full("f"), ("C:" + path + "\\f").c_str());
    put("f");
    EXPECT_EQ(Gui_FileName("f").IsFile(), 1);
}

TEST_F(FileNameFiles, EquivalentNamesDenoteTheSameFile) {
    enter("work");
    EXPECT_TRUE(Gui_FileName("C:\\Dir\\A.TXT").IsEquivalent("c:/dir/a.txt"));
    EXPECT_TRUE(Gui_FileName("sub\\a").IsEquivalent("D:\\SUB\\A"));
    EXPECT_TRUE(Gui_FileName("X:\\a").IsEquivalent("\\\\SRV\\DATA\\a"));
    EXPECT_TRUE(Gui_FileName("é").IsEquivalent("É"));
    EXPECT_FALSE(Gui_FileName("a").IsEquivalent("b"));
    EXPECT_FALSE(Gui_FileName("E:\\a").IsEquivalent("D:\\a"));
}

TEST_F(FileNameFiles, AreShortenedForDisplay) {
    const Gui_FileName name("C:\\proj\\src\\gui\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(24, 1), "C:\\proj\\src\\gui\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(23, 1), "C:\\...\\src\\gui\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(22, 1), "C:\\...\\gui\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(20, 1), "C:\\...\\gui\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(15, 1), "C:\\...\\main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(14, 1), "main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(7, 1), "main.cpp");
    EXPECT_EQ(name.GetAbbreviatedName(7, 0), "");
    EXPECT_EQ(name.GetAbbreviatedName(-1, 0), "");
    EXPECT_EQ(Gui_FileName("C:\\dir\\").GetAbbreviatedName(6, 1), "C:\\dir");
    EXPECT_EQ(Gui_FileName("C:\\Übergröße\\ä.b").GetAbbreviatedName(16, 1), "C:\\Übergröße\\ä.b") << "16 characters";
    EXPECT_EQ(name.GetAbbreviatedName(nullptr, 0, 1), "C:\\proj\\src\\gui\\main.cpp");
    EXPECT_EQ(Gui_FileName("\\\\s\\d\\one\\two\\x").GetAbbreviatedName(14, 1), "\\\\s\\d\\...\\x");
    EXPECT_EQ(Gui_FileName("\\one\\two\\x").GetAbbreviatedName(9, 1), "\\...\\x") << "the mount as it is: none";
    // A great many folders take no time worth waiting for.
    std::string deep = "C:";
    for (int i = 0; i < 100000; ++i) {
        deep += "\\x";
    }
    EXPECT_EQ(Gui_FileName((deep + "\\f").c_str()).GetAbbreviatedName(12, 0), "C:\\...\\x\\x\\f");
}

TEST_F(FileNameFiles, BecomeAddresses) {
    EXPECT_EQ(Gui_FileName("C:\\a b\\x.htm").AsURL(), "file:///C|\\a b\\x.htm");
    EXPECT_EQ(Gui_FileName("\\\\server\\share\\a.htm").AsURL(), "file:\\\\server\\share\\a.htm");
    EXPECT_EQ(Gui_FileName("\\\\SRV\\Data\\a.htm").AsURL(), "file:///X|\\a.htm");
}

TEST_F(FileNameFiles, DrivesBecomeTheirSharesAndBack) {
    const Gui_FileName name("x:\\a");
    EXPECT_EQ(name.GetMount(), "\\\\srv\\data");
    EXPECT_EQ(name.GetMount(0), "X:");
    EXPECT_EQ(name.GetFullName(0), "X:\\a");
    EXPECT_EQ(Gui_FileName("\\\\SRV\\data\\a").GetMount(0), "X:");
    EXPECT_EQ(Gui_FileName("\\\\SRV\\data\\a").GetMount(), "\\\\SRV\\data");
    EXPECT_EQ(Gui_FileName("\\\\srv\\other\\a").GetMount(0), "\\\\srv\\other");
    EXPECT_EQ(Gui_FileName("d:\\a").GetMount(), "d:");
    EXPECT_EQ(Gui_FileName().GetMount(0), "");
    Gui_FileName chosen;
    chosen.SetMount("X:  \\\\srv\\data"); // as lists of drives show it
    EXPECT_EQ(chosen.GetMount(0), "X:");
    Gui_FileName::SetUncFlag(0);
    EXPECT_EQ(Gui_FileName("x:\\a").GetMount(), "x:");
    EXPECT_EQ(Gui_FileName("\\\\SRV\\data\\a").GetMount(0), "X:");
}

TEST_F(FileNameFiles, TheMappingTellsWhetherItHolds) {
    const auto map = [](const char* mount, int uncOnly = 1) {
        CString text(mount);
        const int result = Gui_FileName::GetRemoteMountName(text, uncOnly);
        return text + (result ? " 1" : " 0");
    };
    EXPECT_EQ(map("x:"), "\\\\srv\\data 1");
    EXPECT_EQ(map("x:", 0), "\\\\srv\\data 1");
    EXPECT_EQ(map("D:"), "D: 0");
    EXPECT_EQ(map(""), " 0");
    EXPECT_EQ(map("é:"), "é: 0");
    EXPECT_EQ(map("\\\\Srv\\Data"), "\\\\Srv\\Data 1");
    Gui_FileName::SetUncFlag(0);
    EXPECT_EQ(map("x:"), "x: 1");
    EXPECT_EQ(map(""), " 1");
    CString name("x");
    EXPECT_EQ(Gui_FileName::GetNetworkName(name), 0);
    EXPECT_EQ(name, "x");
}

TEST_F(FileNameFiles, NamesOfConnectionsMayBeOfAnyLength) {
    const std::string share = "\\\\server\\" + std::string(5000, 'S');
    std::string table = "C=/;D=/d|" + share + ";E=/e|\\\\server\\short";
    for (char letter = 'F'; letter <= 'Z'; ++letter) {
        table += std::string(";") + letter + "=/f|\\\\server\\" + std::string(150, letter);
    }
    ::setenv("TVX_DRIVES", table.c_str(), 1);
    EXPECT_EQ(Gui_FileName("D:\\").GetMount().GetLength(), static_cast<int>(share.size()));
    EXPECT_EQ(Gui_FileName("E:\\").GetMount(), "\\\\server\\short");
    EXPECT_EQ(Gui_FileName("Z:\\").GetMount().Right(3), "zzz");
    EXPECT_EQ(Gui_FileName((share + "\\a").c_str()).GetMount(0), "D:");
    EXPECT_EQ(Gui_FileName(("\\\\server\\" + std::string(150, 'y') + "\\a").c_str()).GetMount(0), "Y:");
}

TEST_F(FileNameFiles, ExistAsFileOrFolder) {
    put("work/a.txt");
    for (const char* name : {"D:\\a.txt", "D:/A.TXT", "work\\a.txt"}) {
        const Gui_FileName file(name);
        EXPECT_EQ(file.Exists(), 1) << name;
        EXPECT_EQ(file.IsReadable(), 1) << name;
        EXPECT_EQ(file.IsFile(), 1) << name;
        EXPECT_EQ(file.IsDirectory(), 0) << name;
        EXPECT_EQ(file.IsWritable(), 1) << name;
        EXPECT_EQ(file.IsDeletable(), 1) << name;
    }
    Gui_FileName drive;
    drive.SetMount("C:");
    drive.SetPath("\\");
    for (const Gui_FileName& folder : {Gui_FileName("work"), Gui_FileName("D:\\"), Gui_FileName(), drive}) {
        EXPECT_EQ(folder.IsDirectory(), 1) << folder.GetFullName();
        EXPECT_EQ(folder.IsFile(), 0) << folder.GetFullName();
    }
    for (const char* name : {"D:\\b", "Q:\\", "\\\\no\\share\\a", "D:\\a.txt\\x"}) {
        const Gui_FileName missing(name);
        EXPECT_FALSE(missing.Exists() || missing.IsFile() || missing.IsDirectory() || missing.IsWritable()) << name;
    }
    put("data/on.share");
    EXPECT_EQ(Gui_FileName("\\\\srv\\data\\on.share").IsFile(), 1);
    EXPECT_EQ(Gui_FileName("\\\\srv\\data\\on.share").IsWritable(), 1);
}

TEST_F(FileNameFiles, AreFoundUnderTheSystemsNameOnAnyCurrentDrive) {
    put("plan.txt");
    enter("work");
    EXPECT_EQ(Gui_FileName((m_folder + "/plan.txt").c_str()).IsFile(), 1);
}

TEST_F(FileNameFiles, NamesInAnyBytesAreFound) {
    put("work/Größe/Maß 1.txt");
    put("work/broken\xFF\xC3.txt");
    EXPECT_EQ(Gui_FileName("D:\\GRÖSSE\\maß 1.TXT").IsFile(), 0) << "ß is no SS";
    EXPECT_EQ(Gui_FileName("D:\\GRÖßE\\maß 1.TXT").IsFile(), 1);
    EXPECT_EQ(Gui_FileName("D:\\BROKEN\xFF\xC3.txt").IsFile(), 1);
    EXPECT_EQ(Gui_FileName("D:\\broken\xFF.txt").IsFile(), 0);
}

TEST_F(FileNameFiles, ReadOnlyOnesAreNotWritable) {
    put("work/a");
    ::chmod("work/a", 0444);
    EXPECT_EQ(Gui_FileName("D:\\a").IsWritable(), 0);
    EXPECT_EQ(Gui_FileName("D:\\a").IsDeletable(), 0);
    ::chmod("work", 0555);
    EXPECT_EQ(Gui_FileName("D:\\").IsWritable(), 0);
    ::chmod("work", 0755);
    put("disc/a");
    EXPECT_EQ(Gui_FileName("F:\\").IsWritable(), 0);
    EXPECT_EQ(Gui_FileName("F:\\a").IsWritable(), 0);
}

TEST_F(FileNameFiles, RemovableMediaAreTried) {
    std::filesystem::create_directories("stick/sub");
    put("stick/__tvx__.___", "left over");
    EXPECT_EQ(Gui_FileName("E:\\sub\\").IsWritable(), 1);
    EXPECT_FALSE(std::filesystem::exists("stick/__tvx__.___"));
    EXPECT_EQ(std::distance(std::filesystem::recursive_directory_iterator("stick"), {}), 1);
    // Another process that tries at the same moment holds the file.
    put("stick/__tvx__.___");
    const int held = ::open("stick/__tvx__.___", O_WRONLY | O_CLOEXEC);
    ::flock(held, LOCK_EX);
    EXPECT_EQ(Gui_FileName("E:\\").IsWritable(), 0);
    ::close(held);
    EXPECT_EQ(Gui_FileName("E:\\").IsWritable(), 1);
    // A folder in its place cannot be written, as on a protected medium.
    std::filesystem::create_directory("stick/__tvx__.___");
    EXPECT_EQ(Gui_FileName("E:\\sub\\").IsWritable(), 0);
    enter("stick");
    std::filesystem::remove("__tvx__.___");
    EXPECT_EQ(Gui_FileName("sub\\").IsWritable(), 1);
    EXPECT_EQ(std::distance(std::filesystem::recursive_directory_iterator("."), {}), 1) << "tried in the root only";
}

TEST_F(FileNameFiles, ProgramsAreToldByTheirExtension) {
    put("work/tool.Exe");
    put("work/tool.cmd");
    put("work/tool");
    EXPECT_EQ(Gui_FileName("D:\\tool.Exe").IsExecutable(), 1);
    for (const char* name : {"D:\\tool.cmd", "D:\\tool", "D:\\missing.exe"}) {
        EXPECT_EQ(Gui_FileName(name).IsExecutable(), 0) << name;
    }
}

TEST_F(FileNameFiles, NoTextBreaksAnyQuestion) {
    std::mt19937 random(11);
    const std::string alphabet = "\\\\\\//:..cdeXq\xC3\xA4\xFF srvdata";
    for (int round = 0; round < 3000; ++round) {
        std::string text(random() % 20, ' ');
        for (char& character : text) {
            character = alphabet[random() % alphabet.size()];
        }
        const Gui_FileName name(text.c_str());
        const CString whole = name.GetFullName();
        // Once completed, completing changes nothing more, except that network names get their separators in order.
        if (!whole.View().starts_with("\\\\")) {
            ASSERT_EQ(full(whole), whole) << text;
        }
        ASSERT_TRUE(name.IsEquivalent(name)) << text;
        const int limit = static_cast<int>(random() % 30);
        ASSERT_LE(name.GetAbbreviatedName(limit, 0).GetLength(), 4 * limit);
        ASSERT_EQ(name.Exists(), name.IsFile() + name.IsDirectory()) << text;
        ASSERT_LE(name.IsDeletable(), name.Exists()) << text;
    }
}
