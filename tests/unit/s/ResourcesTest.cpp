// What the library brings is found as hosts look for it: by number, without naming the library.
#include "platform/base/String.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"
#include "res/resource.h"

#include <gtest/gtest.h>
#include <map>
#include <string>

namespace {

const std::map<UINT, std::string> strings = {
    {20019, "Please type only a single command number after the command recall character \"!\" (ex. !21)."},
    {20020, "Console\n\n\n\n\n\n"},
    {20025, "Opens Tarvex Software manuals collection\nSoftware Manuals"},
    {20026, "Display program information and copyright\nAbout"},
    {20027, "Copy selected commands to the clipboard\nCopy"},
    {20028, "Run the selected commands\nRun"},
    {20029, "&Done"},
    {20030, "%1 was taken from %2"},
    {20031, "Press the key to look for."},
    {20032, "a command without a menu item"},
    {20033, "No command matches."},
    {20034, "Unavailable now."},
    {20035, "unavailable"},
    {20036, "checked"},
    {20037, "Press the key a second time to be done."},
    {20038, "Give this view a window of its own, or bring it back\nFloat"},
    {20039, "Bring all views with windows of their own back\nDock All"},
    {20045, "Command %1>"},
    {20046, "Find: %1"},
    {20047, "Status: %1"},
    {20048, "Not found: %1"},
    {20049, "&Search"},
    {20051, "There are changes that were not applied.\nDo you want to discard them?"},
    {20052, "&Defaults"},
    {20054, "Reading the directory..."},
    {20055, "Checking the directory..."},
    {20056, "Creating the folder..."},
    {20057, "New Folder"},
    {20058, "Name of the new folder:"},
    {20059, "The folder %1 could not be created.\n%2"},
    {20060, "The tutorial program %1 could not be started."},
    {20061, "%1 is assigned to %2"},
    {20062, "%1 is assigned to the %2 menu"},
    {20063, "%1 is unassigned"},
    {20064, "Press the Specify button to begin the definition of the accelerator key."},
    {20065, "Type the accelerator key and press the Done button."},
    {20066, "About %1"},
    {20067, "The specified directory does not exist.\nPlease make another selection."},
    {20068, "The specified directory is not writable.\nPlease make another selection or adjust the directory "
            "permissions."},
    {20069, "Please choose a command number between 1 and the last command number."},
    {20070, "Please put the command pattern directly after the recall command character \"!\" (ex. !run)"},
    {20071, "There was no previous command with the pattern you gave.  At this time, wildcard characters are not "
            "supported.  You may want to check the command list and recall using the command number (ex. !21).  "},
    {20072, "Application Version: %1"},
    {20073, "Release Version: %1"},
    {20076, "UNKNOWN"},
    {20077, "Tarvex %1"},
    {20078, "Could not find the PDF viewer"},
    {20079, "Web Browser"},
    {20081, "&Dock"},
    {20083, "%1: failed.\nPlease set environment variable TVX_GUI_HELP_BROWSER_PATH and run the program again. Trying "
            "system default browser.\n"},
    {20084, "%1 runs in a sandbox (%2) and cannot read %3."},
    {20085, "%1 opens files only and cannot show %3."},
    {20086, "%1 : System default browser failed. Trying Internet Explorer.\n"},
    {20087, "The page was opened in another way."},
    {20088, "System default browser not set. Trying Internet Explorer.\n"},
    {20089, "%1: failed.\nPlease install Internet Explorer or Netscape as system default browser."},
    {20090, "Cannot find Internet Explorer program.\nPlease install Internet Explorer or Netscape as system default "
            "browser."},
    {20091, "Internal error: Help Package name was not set."},
    {20092, "%1 : Help file for this package was not installed or does not have read permission.\nContext sensitive "
            "help would be unavailable.\nPlease check if help files are installed."},
    {20093, "Help not found for topic %1 %2"},
    {20094, "&Float Window"},
    {20095, "&Dock Window"},
    {20096, "Close"},
    {20098, "%1 Arrow"},
    {20099, "Opens the Tarvex Support home page\nSupport Web Page"},
};

const std::uint8_t* find(LPCSTR name, LPCSTR type, DWORD& size) {
    const HMODULE module = AfxFindResourceHandle(name, type);
    const HRSRC resource = FindResourceA(module, name, type);
    size = resource ? SizeofResource(module, resource) : 0;
    return resource ? static_cast<const std::uint8_t*>(LockResource(LoadResource(module, resource))) : nullptr;
}

int number(const std::uint8_t* bytes, int size) {
    int value = 0;
    for (int i = size; i-- > 0;) {
        value = value << 8 | bytes[i];
    }
    return value;
}

/// Width, height and bits of a pixel, as the picture's header says.
struct Picture {
    int width, height, bits;
    bool operator==(const Picture&) const = default;
};

Picture picture(LPCSTR name) {
    DWORD size = 0;
    const std::uint8_t* header = find(name, RT_BITMAP, size);
    return header && size > 40 ? Picture{number(header + 4, 4), number(header + 8, 4), number(header + 14, 2)}
                               : Picture{};
}

} // namespace

TEST(Resources, EveryStringIsThereAndNoOther) {
    for (UINT id = 20000; id < 20100; ++id) {
        const auto expected = strings.find(id);
        CString text;
        EXPECT_EQ(text.LoadString(id) != FALSE, expected != strings.end()) << id;
        EXPECT_EQ(text.View(), expected != strings.end() ? expected->second : "") << id;
    }
}

TEST(Resources, EveryDialogAndTheMenuAreThere) {
    DWORD size = 0;
    for (int id = GUI_IDD_SPLASH; id <= GUI_IDD_COMMANDS; ++id) {
        EXPECT_NE(find(MAKEINTRESOURCE(id), RT_DIALOG, size), nullptr) << id;
    }
    EXPECT_NE(find(MAKEINTRESOURCE(GUI_IDM_CONSOLE), RT_MENU, size), nullptr);
}

TEST(Resources, PicturesHaveTheirSizes) {
    EXPECT_EQ(picture("CDSPLASHBMP"), (Picture{332, 260, 24}));
    EXPECT_EQ(picture("CDDIRDLGBMP"), (Picture{8 * 23, 14, 4}));
    EXPECT_EQ(picture("CDDIRDLG2BMP"), (Picture{3 * 16, 12, 4}));
    EXPECT_EQ(picture(MAKEINTRESOURCE(GUI_IDB_FLOAT)), (Picture{13, 12, 1}));
    EXPECT_EQ(picture(MAKEINTRESOURCE(GUI_IDB_DOCK)), (Picture{13, 12, 1}));
}
