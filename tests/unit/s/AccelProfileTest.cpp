#include "s/AccelProfile.h"

#include "StoreTest.h"
#include "TestApp.h"
#include "s/Profile.h"

#include <string>
#include <vector>

namespace {

constexpr WORD newFile = 100;
constexpr WORD openFile = 101;
constexpr WORD saveFile = 102;

Gui_Accel ctrl(char key, WORD command) {
    return {FVIRTKEY | FCONTROL, static_cast<WORD>(key), command};
}

/// "Ctrl+N 100, ..."
std::string textOf(const Gui_AccelMap& map) {
    int count = 0;
    tagACCEL* table = nullptr;
    map.GetAll(count, table);
    std::string text;
    for (int i = 0; i < count; ++i) {
        text +=
            (i > 0 ? ", " : "") + std::string(Gui_Accel(table[i]).GetKeyText()) + ' ' + std::to_string(table[i].cmd);
    }
    delete[] table;
    return text;
}

class AccelProfile : public StoreTest {
protected:
    void SetUp() override {
        StoreTest::SetUp();
        theApp.SetRegistryKey("AccelProfile");
        for (const Gui_Accel& accel : {ctrl('N', newFile), ctrl('O', openFile), ctrl('S', saveFile)}) {
            m_own.Add(accel);
        }
    }
    /// The keys in force over the application's own ones.
    static std::string read(Gui_AccelMap map) {
        Gui_AccelProfile::Read(map, "Keys", nullptr);
        return textOf(map);
    }
    static CString kept() {
        CString text;
        Gui_Profile::ReadString(text, "Keys", nullptr);
        return text;
    }
    Gui_AccelMap m_own;
};

TEST_F(AccelProfile, KeepsWhatTheUserHasChangedAndNothingElse) {
    Gui_AccelMap nothing = m_own;
    EXPECT_EQ(Gui_AccelProfile::Read(nothing, "Keys", nullptr), 0);
    Gui_AccelMap map = m_own;
    map.Remove(ctrl('S', 0));
    map.Add(ctrl('O', newFile)); // taken from its owner
    map.Add(ctrl('G', openFile));
    Gui_AccelProfile::Write(map, m_own, "Keys", nullptr);
    EXPECT_EQ(read(m_own), textOf(map));

    // A later version: another key for Save, Ctrl+N and Ctrl+S for others, nothing for Open any more.
    Gui_AccelMap later;
    for (const Gui_Accel& accel : {ctrl('N', 200), ctrl('W', saveFile), ctrl('S', 201), ctrl('T', 202)}) {
        later.Add(accel);
    }
    EXPECT_EQ(read(later), "Ctrl+G 101, Ctrl+N 200, Ctrl+O 100, Ctrl+S 201, Ctrl+T 202, Ctrl+W 102");
    EXPECT_EQ(read(m_own), textOf(map)) << "reading changes nothing";

    Gui_AccelProfile::Write(m_own, m_own, "Keys", nullptr);
    EXPECT_TRUE(kept().IsEmpty()) << "the application's own keys need no record";
    Gui_AccelProfile::Write(Gui_AccelMap(), m_own, "Keys", nullptr);
    EXPECT_EQ(read(m_own), "") << "removed keys stay removed";
    Gui_AccelProfile::Forget("Keys", nullptr);
    EXPECT_EQ(read(m_own), textOf(m_own));
}

TEST_F(AccelProfile, PassesOverLinesThatItDoesNotKnow) {
    const std::vector<std::string> foreign = {"",
                                              "G",
                                              "+",
                                              "+0047000B",
                                              "+0047000B 0",
                                              "+0047000B 65536",
                                              "+0047000B -5",
                                              "+0047000B 5 6",
                                              "+0047000B  5",
                                              "+0047010B 5",
                                              "+0047002B 5",
                                              "+0000000B 5",
                                              "+100470000B 5",
                                              "*0047000B 5",
                                              "+0047000Z 5",
                                              "+ 47000B 5",
                                              "\xFF\xFE",
                                              "+99999999999999999999999 5"};
    std::string text = "-0053000B 102\r\n";
    for (const std::string& line : foreign) {
        text += line + '\n';
    }
    text += "+0047000b 101";
    Gui_Profile::WriteString(text.c_str(), "Keys", nullptr);
    EXPECT_EQ(read(m_own), "Ctrl+G 101, Ctrl+N 100, Ctrl+O 101");
    for (const std::string& line : foreign) {
        Gui_Profile::WriteString(line.c_str(), "Keys", nullptr);
        EXPECT_EQ(read(m_own), textOf(m_own)) << line;
    }
}

} // namespace
