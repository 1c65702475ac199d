#include "s/FileName.h"

#include "tests/unit/base/ExpectRaised.h"

#include <gtest/gtest.h>
#include <memory>
#include <ostream>
#include <random>
#include <string>

namespace {

/// The parts of a name as the tests compare them.
struct Parts {
    std::string mount;
    std::string path;
    std::string base;
    std::string extension;

    bool operator==(const Parts&) const = default;
};

std::ostream& operator<<(std::ostream& stream, const Parts& parts) {
    return stream << parts.mount << "|" << parts.path << "|" << parts.base << "|" << parts.extension;
}

Parts partsOf(const Gui_FileName& name) {
    const std::string whole(name.GetName().View());
    const std::string path(name.GetPath().View());
    const std::string base(name.GetBase().View());
    const std::string extension(name.GetExtension().View());
    return {whole.substr(0, whole.size() - path.size() - base.size() - extension.size()), path, base, extension};
}

/// With network names switched off, so that the machine's own connections do not show.
class FileName : public testing::Test {
protected:
    FileName() : m_flag(Gui_FileName::GetUncFlag()) {
        Gui_FileName::SetUncFlag(0);
    }
    ~FileName() override {
        Gui_FileName::SetUncFlag(m_flag);
    }

private:
    int m_flag;
};

} // namespace

TEST_F(FileName, TakesNamesApart) {
    EXPECT_EQ(partsOf("C:\\dir\\sub\\file.txt"), (Parts{"C:", "\\dir\\sub\\", "file", ".txt"}));
    EXPECT_EQ(partsOf("C:/dir/file.txt"), (Parts{"C:", "\\dir\\", "file", ".txt"}));
    EXPECT_EQ(partsOf("/dir/file.txt"), (Parts{"", "\\dir\\", "file", ".txt"}));
    EXPECT_EQ(partsOf("c:file"), (Parts{"c:", "", "file", ""}));
    EXPECT_EQ(partsOf("file."), (Parts{"", "", "file", "."}));
    EXPECT_EQ(partsOf(".profile"), (Parts{"", "", "", ".profile"}));
    EXPECT_EQ(partsOf("dir.d\\"), (Parts{"", "dir.d\\", "", ""}));
    EXPECT_EQ(partsOf("dir.d\\file"), (Parts{"", "dir.d\\", "file", ""}));
    EXPECT_EQ(partsOf("Größe\\Übersicht.Zeichnung"), (Parts{"", "Größe\\", "Übersicht", ".Zeichnung"}));
    EXPECT_TRUE(Gui_FileName(nullptr).IsEmpty());
    EXPECT_TRUE(Gui_FileName("").IsEmpty());
}

TEST_F(FileName, TakesNetworkNamesApart) {
    const Gui_FileName name("\\\\Server\\Share\\dir\\a.b.c");
    EXPECT_EQ(partsOf(name), (Parts{"\\\\Server\\Share", "\\dir\\", "a.b", ".c"}));
    EXPECT_EQ(name.HasNetworkMount(), 1);
    EXPECT_EQ(partsOf("\\\\server\\share"), (Parts{"\\\\server\\", "\\", "share", ""}));
    EXPECT_EQ(partsOf("\\\\"), (Parts{"\\\\\\", "\\", "", ""}));
    EXPECT_EQ(partsOf("\\\\server/share/a"), (Parts{"\\\\server\\share", "\\", "a", ""}));
    const Gui_FileName slashes("//server/share/a");
    EXPECT_EQ(partsOf(slashes), (Parts{"", "\\\\server\\share\\", "a", ""}));
    EXPECT_EQ(slashes.HasMount(), 0);
}

TEST_F(FileName, SettersCompleteTheirPart) {
    Gui_FileName name;
    name.SetMount("d");
    name.SetPath("a/b");
    name.SetBase("x.y");
    name.SetExtension("txt");
    EXPECT_EQ(partsOf(name), (Parts{"d:", "a\\b\\", "x.y", ".txt"}));
    name.SetExtension(".doc");
    EXPECT_EQ(name.GetExtension(), ".doc");
    name.SetMountAndPath("E:\\one/two.d");
    EXPECT_EQ(partsOf(name), (Parts{"E:", "\\one\\two.d\\", "x.y", ".doc"}));
    name.SetBaseAndExtension("F:\\gone\\new.brd");
    EXPECT_EQ(partsOf(name), (Parts{"E:", "\\one\\two.d\\", "new", ".brd"}));
    name.SetMountAndPath("//server/share/dir");
    EXPECT_EQ(partsOf(name), (Parts{"\\\\server\\share", "\\dir\\", "new", ".brd"}));
    name.SetMountAndPath("");
    EXPECT_EQ(partsOf(name), (Parts{"", "\\", "new", ".brd"}));
    name.SetMountAndPath(nullptr);
    EXPECT_EQ(partsOf(name), (Parts{"", "", "new", ".brd"}));
    name.SetMount("\\\\server\\share");
    EXPECT_EQ(name.GetName(), "\\\\server\\sharenew.brd");
    for (const auto set :
         {&Gui_FileName::SetMount, &Gui_FileName::SetPath, &Gui_FileName::SetBase, &Gui_FileName::SetExtension}) {
        (name.*set)(nullptr);
    }
    EXPECT_EQ(name.IsEmpty(), 1);
    EXPECT_EQ(partsOf(Gui_FileName("c", "p", nullptr, "e")), (Parts{"c:", "p\\", "", ".e"}));
}

TEST_F(FileName, FoldersArePushedAndPopped) {
    Gui_FileName name("\\a\\b\\c\\");
    EXPECT_EQ(name.PopPathStart(), "a");
    EXPECT_EQ(name.GetPath(), "b\\c\\");
    name.SetPath("\\a\\b\\c\\");
    EXPECT_EQ(name.PopPathEnd(), "c");
    EXPECT_EQ(name.GetPath(), "\\a\\b\\");
    name.SetPath("single");
    EXPECT_EQ(name.PopPathEnd(), "single");
    EXPECT_EQ(name.PopPathEnd(), "");
    EXPECT_EQ(name.PopPathStart(), "");
    EXPECT_EQ(name.GetPath(), "");
    name.SetPath("\\a\\");
    name.PushPathEnd("/x");
    EXPECT_EQ(name.GetPath(), "\\a\\x\\");
    name.SetPath("a\\");
    name.PushPathStart("/r");
    EXPECT_EQ(name.GetPath(), "\\r\\a\\");
    name.SetPath(nullptr);
    name.PushPathEnd("/");
    EXPECT_EQ(name.GetPath(), "\\");
    name.SetPath("\\r\\a");
    name.PushPathEnd(nullptr);
    name.PushPathStart("");
    EXPECT_EQ(name.GetPath(), "\\r\\a\\");
}

TEST_F(FileName, AnswersAboutItsParts) {
    const Gui_FileName name("dir\\a.txt");
    EXPECT_EQ(name.HasMount(), 0);
    EXPECT_EQ(name.HasPath(), 1);
    EXPECT_EQ(name.HasAbsolutePath(), 0);
    EXPECT_EQ(name.HasRelativePath(), 1);
    EXPECT_EQ(Gui_FileName("x").HasRelativePath(), 1);
    for (const char* extension : {"TXT", ".Txt", "txt"}) {
        EXPECT_EQ(name.HasExtension(extension), 1) << extension;
    }
    for (const char* extension : {"tx", "txtx", ".", "", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(name.HasExtension(extension), 0);
    }
    EXPECT_EQ(Gui_FileName("dir.d\\a").HasExtension(""), 1);
    EXPECT_EQ(Gui_FileName("a.").HasExtension(""), 0);
    EXPECT_EQ(Gui_FileName("a.").HasExtension("."), 1);
}

TEST_F(FileName, DefaultsFillEmptyParts) {
    EXPECT_EQ(Gui_FileName("dir\\").GetBaseAndExtension("untitled", "txt"), "untitled.txt");
    EXPECT_EQ(Gui_FileName("dir\\").GetBaseAndExtension("untitled", ""), "untitled");
    EXPECT_EQ(Gui_FileName("a").GetBaseAndExtension("untitled", ".txt"), "a.txt");
    EXPECT_EQ(Gui_FileName("a.brd").GetBaseAndExtension("untitled", "txt"), "a.brd");
    EXPECT_EQ(Gui_FileName("").GetBaseAndExtension(), "");
}

TEST_F(FileName, IsAValue) {
    const Gui_FileName name("C:\\dir\\file.txt");
    Gui_FileName copy(name);
    copy.SetBase("other");
    EXPECT_EQ(name.GetBase(), "file");
    copy = name;
    const Gui_FileName& itself = copy;
    copy = itself;
    EXPECT_EQ(partsOf(copy), partsOf(name));
    copy = "x.y";
    EXPECT_EQ(partsOf(copy), (Parts{"", "", "x", ".y"}));
    copy.Empty();
    EXPECT_EQ(copy.IsEmpty(), 1);
}

TEST_F(FileName, IsStoredAsFourTexts) {
    CMemFile file;
    Gui_FileName name("C:\\dir\\file.txt");
    {
        CArchive archive(&file, CArchive::store);
        name.Serialize(archive);
        archive << static_cast<CObject*>(&name);
        archive.Close();
    }
    file.SeekToBegin();
    CArchive archive(&file, CArchive::load);
    CString mount;
    CString path;
    CString base;
    CString extension;
    archive >> mount >> path >> base >> extension;
    EXPECT_EQ(mount + path + base + extension, "C:\\dir\\file.txt");
    Gui_FileName* loaded = nullptr;
    archive >> loaded;
    const std::unique_ptr<Gui_FileName> owned(loaded);
    EXPECT_EQ(partsOf(*owned), partsOf(name));
    EXPECT_EQ(RUNTIME_CLASS(Gui_FileName)->m_wSchema, 1u);
    // What is missing leaves the name as it was.
    expectRaised<CArchiveException>([&] { owned->Serialize(archive); });
    EXPECT_EQ(partsOf(*owned), partsOf(name));
}

TEST_F(FileName, AnyTextIsKeptWhole) {
    std::mt19937 random(20240229);
    const std::string alphabet = "\\\\//::..aB \xC3\xA4\xFF";
    for (int round = 0; round < 20000; ++round) {
        std::string text(random() % 24, ' ');
        for (char& character : text) {
            character = alphabet[random() % alphabet.size()];
        }
        std::string expected = text;
        for (char& character : expected) {
            character = character == '/' ? '\\' : character;
        }
        const Gui_FileName name(text.c_str());
        const CString composed = name.GetName();
        if (!text.starts_with("\\\\")) {
            ASSERT_EQ(composed, expected.c_str()) << text;
        }
        // Two slashes at the beginning are an ordinary path, which reads back as a network name; and network names
        // without a server or a share are completed by separators.
        const bool isNetwork = composed.View().starts_with("\\\\");
        if (!isNetwork || (name.HasNetworkMount() && composed[2] != '\\' && !partsOf(name).mount.ends_with('\\'))) {
            ASSERT_EQ(partsOf(Gui_FileName(composed)), partsOf(name)) << text;
        }
    }
    const std::string longText(100000, 'x');
    EXPECT_EQ(Gui_FileName(("C:\\" + longText + "\\" + longText + "." + longText).c_str()).GetName().GetLength(),
              300005);
}
