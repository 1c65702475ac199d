// Records of windows, bars and fonts in the settings, on the toolkit's screen of 800 by 800 pixels.
#include "s/Profile.h"

#include "afxext.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/frames/SettingsFolder.h"

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>

namespace {

/// The last two numbers of a placement.
std::string screen() {
    return std::to_string(GetSystemMetrics(SM_CXSCREEN)) + "," + std::to_string(GetSystemMetrics(SM_CYSCREEN));
}

class ProfileWindows : public testing::Test {
protected:
    void SetUp() override {
        testApplication.SetRegistryKey("Maker");
    }
    static std::string stored(const char* entry, const char* section = "Settings") {
        return testApplication.GetProfileString(section, entry).GetString();
    }
    static void store(const char* entry, const std::string& text) {
        ASSERT_TRUE(testApplication.WriteProfileString("Settings", entry, text.c_str()));
    }
    static std::string familyValue(const char* name) {
        HKEY key = nullptr;
        char text[200] = {};
        DWORD size = sizeof text;
        DWORD type = REG_NONE;
        RegOpenKeyExA(HKEY_CURRENT_USER, "Software\\Tarvex\\Common", 0, KEY_READ, &key);
        RegQueryValueExA(key, name, nullptr, &type, reinterpret_cast<BYTE*>(text), &size);
        RegCloseKey(key);
        return type == REG_SZ && text[size - 1] == '\0' ? text : "<no text>";
    }
    static void storeFamilyValue(const char* name, const std::string& text) {
        HKEY key = nullptr;
        RegCreateKeyExA(HKEY_CURRENT_USER, "Software\\Tarvex\\Common", 0, nullptr, 0, KEY_WRITE, nullptr, &key,
                        nullptr);
        ASSERT_EQ(RegSetValueExA(key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.data()),
                                 static_cast<DWORD>(text.size())), // without its zero
                  ERROR_SUCCESS);
        RegCloseKey(key);
    }

    SettingsFolder settings;
};

WINDOWPLACEMENT examplePlacement() {
    WINDOWPLACEMENT placement{};
    placement.length = sizeof placement;
    placement.flags = WPF_RESTORETOMAXIMIZED;
    placement.showCmd = SW_SHOWMINIMIZED;
    placement.ptMinPosition = {-1, -2};
    placement.ptMaxPosition = {-3, -4};
    placement.rcNormalPosition = {-10000, 20, 300, 400};
    return placement;
}

LOGFONTA exampleFont(const char* face) {
    LOGFONTA font{};
    font.lfHeight = -13;
    font.lfWidth = 1;
    font.lfEscapement = 2;
    font.lfOrientation = 3;
    font.lfWeight = 700;
    font.lfItalic = 255;
    font.lfCharSet = 204;
    font.lfPitchAndFamily = 49;
    std::strncpy(font.lfFaceName, face, LF_FACESIZE - 1);
    return font;
}

} // namespace

TEST_F(ProfileWindows, PlacementsAreTwelveNumbers) {
    WINDOWPLACEMENT written = examplePlacement();
    Gui_Profile::WriteWindowPlacement(written, nullptr, nullptr);
    EXPECT_EQ(stored("WindowPlacement"), "2,2,-1,-2,-3,-4,-10000,20,300,400," + screen());
    WINDOWPLACEMENT read{};
    ASSERT_EQ(Gui_Profile::ReadWindowPlacement(read, nullptr, nullptr), 1);
    EXPECT_EQ(std::memcmp(&read, &written, sizeof read), 0) << "also off the screen and minimised";
    EXPECT_EQ(read.length, 44U);
    Gui_Profile::WriteWindowPlacement(written, "Second", "Windows");
    EXPECT_EQ(stored("Second", "Windows"), stored("WindowPlacement"));
}

TEST_F(ProfileWindows, PlacementsThatDoNotCountLeaveTheVariableAlone) {
    const std::string ten = "0,1,-1,-1,-1,-1,10,20,300,400,";
    for (const std::string& text :
         {std::string(), std::string("nonsense"), ten, ten + screen().substr(0, screen().find(',')), ten + "1280,1024",
          ten + "x," + screen(), "," + ten + screen(), "0 " + ten + screen()}) {
        store("WindowPlacement", text);
        WINDOWPLACEMENT placement = examplePlacement();
        const WINDOWPLACEMENT before = placement;
        EXPECT_EQ(Gui_Profile::ReadWindowPlacement(placement, nullptr, nullptr), 0) << text;
        EXPECT_EQ(std::memcmp(&placement, &before, sizeof placement), 0) << text;
    }
    WINDOWPLACEMENT placement;
    for (const std::string& text : {ten + screen() + ",13", " " + ten + " " + screen() + " and more"}) {
        store("WindowPlacement", text);
        EXPECT_EQ(Gui_Profile::ReadWindowPlacement(placement, nullptr, nullptr), 1) << text;
        EXPECT_EQ(CRect(placement.rcNormalPosition), CRect(10, 20, 300, 400));
    }
}

TEST_F(ProfileWindows, DialogsOfTheFamilyShareTheirPlacements) {
    WINDOWPLACEMENT placement = examplePlacement();
    EXPECT_EQ(Gui_Profile::ReadDialogWindowPlacement("Options", placement), 0);
    Gui_Profile::WriteDialogWindowPlacement("Options", placement);
    EXPECT_EQ(familyValue("Options"), "2,2,-1,-2,-3,-4,-10000,20,300,400," + screen());
    testApplication.SetRegistryKey("Another");
    WINDOWPLACEMENT read{};
    ASSERT_EQ(Gui_Profile::ReadDialogWindowPlacement("Options", read), 1);
    EXPECT_EQ(std::memcmp(&read, &placement, sizeof read), 0);
    storeFamilyValue("Options", "0,1,0,0,0,0,1,2,3,4," + screen());
    ASSERT_EQ(Gui_Profile::ReadDialogWindowPlacement("Options", read), 1);
    EXPECT_EQ(CRect(read.rcNormalPosition), CRect(1, 2, 3, 4));
    storeFamilyValue("Options", "");
    EXPECT_EQ(Gui_Profile::ReadDialogWindowPlacement("Options", read), 0);
}

TEST_F(ProfileWindows, FontsKeepTheirFacesSpaces) {
    LOGFONTA written = exampleFont("DejaVu Sans Mono");
    Gui_Profile::WriteLogFont(written, nullptr, nullptr);
    EXPECT_EQ(stored("Font"), "-13,1,2,3,700,255,0,0,204,0,0,0,49,DejaVu~Sans~Mono");
    EXPECT_STREQ(written.lfFaceName, "DejaVu Sans Mono");
    LOGFONTA read{};
    ASSERT_EQ(Gui_Profile::ReadLogFont(read, nullptr, nullptr), 1);
    EXPECT_EQ(std::memcmp(&read, &written, sizeof read), 0);
    LOGFONTA tilde = exampleFont("A~B C");
    Gui_Profile::WriteLogFont(tilde, "List", "Fonts");
    EXPECT_STREQ(tilde.lfFaceName, "A B C");
    ASSERT_EQ(Gui_Profile::ReadLogFont(read, "List", "Fonts"), 1);
    EXPECT_STREQ(read.lfFaceName, "A B C");
}

TEST_F(ProfileWindows, FontsTakeTheLowBitsOfTheirSmallFields) {
    store("Font", "-13,0,0,0,400,300,-1,256,0,0,0,0,0,Sans  rest");
    LOGFONTA font{};
    ASSERT_EQ(Gui_Profile::ReadLogFont(font, nullptr, nullptr), 1);
    EXPECT_EQ(font.lfItalic, 44);
    EXPECT_EQ(font.lfUnderline, 255);
    EXPECT_EQ(font.lfStrikeOut, 0);
    EXPECT_STREQ(font.lfFaceName, "Sans");
}

TEST_F(ProfileWindows, FontsThatDoNotCountLeaveTheVariableAlone) {
    LOGFONTA nameless = exampleFont("");
    Gui_Profile::WriteLogFont(nameless, nullptr, nullptr);
    const std::string thirteen = stored("Font");
    ASSERT_EQ(thirteen.back(), ',');
    for (const std::string& text : {thirteen, thirteen + "   ", thirteen.substr(0, thirteen.size() - 1),
                                    std::string("Sans"), thirteen + std::string(32, 'x')}) {
        store("Font", text);
        LOGFONTA font = exampleFont("Before");
        const LOGFONTA before = font;
        EXPECT_EQ(Gui_Profile::ReadLogFont(font, nullptr, nullptr), 0) << text;
        EXPECT_EQ(std::memcmp(&font, &before, sizeof font), 0) << text;
    }
    LOGFONTA font{};
    store("Font", thirteen + std::string(31, 'x'));
    EXPECT_EQ(Gui_Profile::ReadLogFont(font, nullptr, nullptr), 1);
    EXPECT_EQ(std::strlen(font.lfFaceName), 31U);
    std::memset(font.lfFaceName, 'y', sizeof font.lfFaceName); // without its zero
    Gui_Profile::WriteLogFont(font, nullptr, nullptr);
    EXPECT_EQ(Gui_Profile::ReadLogFont(font, nullptr, nullptr), 1);
    EXPECT_EQ(std::strlen(font.lfFaceName), 31U);
}

// --- bars ---

namespace {

constexpr UINT barId = AFX_IDW_CONTROLBAR_FIRST + 40;

class BarFrame : public CFrameWnd {
public:
    explicit BarFrame(UINT id = barId) {
        Create(nullptr, "Bars");
        EnableDocking(CBRS_ALIGN_ANY);
        bar.CreateEx(this, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP, CRect(), id);
        bar.EnableDocking(CBRS_ALIGN_ANY);
        DockControlBar(&bar);
    }
    ~BarFrame() override {
        DestroyWindow();
    }
    CToolBar bar;

protected:
    void PostNcDestroy() override {}
};

} // namespace

TEST_F(ProfileWindows, BarStatesComeBack) {
    BarFrame frame;
    EXPECT_EQ(Gui_Profile::CheckBarState(&frame, nullptr), 1) << "nothing is kept";
    EXPECT_EQ(Gui_Profile::ReadBarState(&frame, nullptr), 1);
    frame.DockControlBar(&frame.bar, AFX_IDW_DOCKBAR_RIGHT);
    Gui_Profile::WriteBarState(&frame, nullptr);
    EXPECT_EQ(stored("Bars", "ControlBar-Summary"), "1");
    EXPECT_EQ(stored("BarID", "ControlBar-Bar0"), std::to_string(barId));
    BarFrame next;
    EXPECT_EQ(Gui_Profile::ReadBarState(&next, nullptr), 1);
    EXPECT_EQ(next.bar.GetDockSide(), UINT{AFX_IDW_DOCKBAR_RIGHT});
}

TEST_F(ProfileWindows, BarStatesOfMissingDockedBarsAreNotLoaded) {
    BarFrame frame;
    frame.DockControlBar(&frame.bar, AFX_IDW_DOCKBAR_RIGHT);
    Gui_Profile::WriteBarState(&frame, "Bars");
    testApplication.WriteProfileString("Bars-Summary", "Bars", "2");
    BarFrame next;
    EXPECT_EQ(Gui_Profile::CheckBarState(&next, "Bars"), 0) << "the second record is missing";
    testApplication.WriteProfileString("Bars-Bar1", "BarID", std::to_string(barId + 1).c_str());
    EXPECT_EQ(Gui_Profile::CheckBarState(&next, "Bars"), 0);
    EXPECT_EQ(Gui_Profile::ReadBarState(&next, "Bars"), 1);
    EXPECT_EQ(next.bar.GetDockSide(), UINT{AFX_IDW_DOCKBAR_TOP}) << "ignored whole";
    EXPECT_EQ(stored("Bars", "Bars-Summary"), "2") << "and kept";
    testApplication.WriteProfileString("Bars-Bar1", "Floating", "1");
    EXPECT_EQ(Gui_Profile::CheckBarState(&next, "Bars"), 1);
    Gui_Profile::ReadBarState(&next, "Bars");
    EXPECT_EQ(next.bar.GetDockSide(), UINT{AFX_IDW_DOCKBAR_RIGHT});
}
