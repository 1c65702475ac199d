// Real files in real folders: where resource libraries are looked for, what is refused, what is found in them.
#include "platform/win/ResourceLibrary.h"

#include "platform/base/String.h"
#include "platform/win/Error.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/Module.h"
#include "platform/win/Resource.h"
#include "tests/data/resources/resource.h"
#include "tests/unit/SavedEnvironment.h"
#include "tests/unit/base/FileTestFolder.h"

#include <filesystem>
#include <memory>
#include <string>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

/// The test program's own resource library, which is built beside it.
fs::path built() {
    return fs::path(tvx::moduleFileName(nullptr)).parent_path() / "win-tests.DEU";
}

class ResourceLibrary : public FileTestFolder {
protected:
    ResourceLibrary() {
        for (const char* folder : {"mine/lib", "mine/share/locale", "all/lib", "all/share/locale", "path", "last"}) {
            fs::create_directories(folder);
        }
        setenv("MYTARVEX", (m_folder + "/mine").c_str(), 1);
        setenv("TARVEX", (m_folder + "/all").c_str(), 1);
        setenv("TVX_RESOURCE_PATH", (":path:" + m_folder + "/path:" + m_folder + "/last:").c_str(), 1);
    }
    static void place(const std::string& name) {
        fs::copy_file(built(), name);
    }
    /// Where it is found, below the test's folder; empty when it is not.
    std::string found(const char* name) const {
        const HMODULE library = LoadLibraryA(name);
        if (!library) {
            return {};
        }
        const std::string file = tvx::moduleFileName(library);
        EXPECT_TRUE(FreeLibrary(library));
        return fs::relative(file, fs::canonical(m_folder));
    }

private:
    SavedEnvironment m_environment;
};

CString stringOf(UINT id) {
    CString text;
    text.LoadString(id);
    return text;
}

} // namespace

TEST_F(ResourceLibrary, IsSearchedInTheInstallationThenInTheListedFolders) {
    EXPECT_EQ(found("host.DEU"), "");
    EXPECT_EQ(GetLastError(), ERROR_MOD_NOT_FOUND);
    for (const char* place : {"last/host.DEU", "path/host.DEU", "all/share/locale/host.DEU", "all/lib/host.DEU",
                              "mine/share/locale/host.DEU", "mine/lib/host.DEU"}) {
        ResourceLibrary::place(place);
        EXPECT_EQ(found("host.DEU"), place);
    }
}

TEST_F(ResourceLibrary, IsSearchedBesideItsModuleAndBesideTheApplication) {
    place("mine/lib/win-tests.DEU");
    place("mine/lib/win-test-extension.JPN");
    const HMODULE own = LoadLibraryA("win-tests.DEU");
    EXPECT_EQ(tvx::moduleFileName(own), built().string());
    const HMODULE extension = LoadLibraryA("win-test-extension.JPN");
    fs::path beside = tvx::moduleFileName(GetModuleHandleA("win-test-extension"));
    EXPECT_EQ(tvx::moduleFileName(extension), beside.replace_filename("win-test-extension.JPN").string());
}

TEST_F(ResourceLibrary, IsFoundInAnyCaseButTheExactNameComesFirst) {
    place("path/HOST.deu");
    EXPECT_EQ(found("host.DEU"), "path/HOST.deu");
    place("path/host.DEU");
    EXPECT_EQ(found("host.DEU"), "path/host.DEU");
}

TEST_F(ResourceLibrary, IsNeverTakenFromTheCurrentFolder) {
    place("host.DEU");
    unsetenv("TVX_RESOURCE_PATH");
    setenv("TARVEX", ".", 1);
    fs::create_directories("lib");
    place("lib/host.DEU");
    for (const char* name : {"host.DEU", "./host.DEU", "lib/host.DEU", ".\\host.DEU", "../host.DEU", "", "/"}) {
        EXPECT_EQ(found(name), "") << name;
        EXPECT_EQ(GetLastError(), *name ? ERROR_MOD_NOT_FOUND : ERROR_INVALID_PARAMETER) << name;
    }
    EXPECT_EQ(LoadLibraryA(nullptr), nullptr);
    EXPECT_EQ(found((m_folder + "/host.DEU").c_str()), "host.DEU");
    EXPECT_EQ(found(drive("host.DEU").c_str()), "host.DEU");
}

TEST_F(ResourceLibrary, IsRefusedWhenItIsDamaged) {
    const std::string whole = get(built());
    place("last/host.DEU");
    for (const std::size_t length : {std::size_t{0}, std::size_t{31}, std::size_t{33}, whole.size() / 2}) {
        put("path/host.DEU", whole.substr(0, length));
        EXPECT_EQ(found("host.DEU"), "") << length;
        EXPECT_EQ(GetLastError(), ERROR_BAD_EXE_FORMAT) << length;
    }
    put("path/host.DEU", "\x7F"
                         "ELF, and not at all compiled resources");
    EXPECT_EQ(found("host.DEU"), "");
    // Folders of that name are no libraries; the search goes on.
    fs::remove("path/host.DEU");
    fs::create_directory("path/host.DEU");
    EXPECT_EQ(found("host.DEU"), "last/host.DEU");
}

TEST_F(ResourceLibrary, IsRefusedWhenItCannotBeRead) {
    if (geteuid() == 0) {
        GTEST_SKIP() << "everything can be read by root";
    }
    place("path/host.DEU");
    fs::permissions("path/host.DEU", fs::perms::none);
    EXPECT_EQ(found("host.DEU"), "");
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
}

TEST_F(ResourceLibrary, IsRefusedWhenItIsHuge) {
    put("path/host.DEU");
    fs::resize_file("path/host.DEU", (64U << 20) + 1);
    EXPECT_EQ(found("host.DEU"), "");
    EXPECT_EQ(GetLastError(), ERROR_FILE_TOO_LARGE);
}

TEST_F(ResourceLibrary, IsOneModuleHoweverOftenItIsLoaded) {
    place("path/host.DEU");
    fs::create_symlink("host.DEU", "path/link.DEU");
    const HMODULE first = LoadLibraryA("host.DEU");
    ASSERT_NE(first, nullptr);
    EXPECT_EQ(LoadLibrary("link.DEU"), first);
    EXPECT_EQ(GetModuleHandleA("host.deu"), first);
    EXPECT_TRUE(FreeLibrary(first));
    EXPECT_NE(FindResourceA(first, MAKEINTRESOURCE(IDS_GREETING / 16 + 1), RT_STRING), nullptr);
    EXPECT_TRUE(FreeLibrary(first));
    EXPECT_FALSE(FreeLibrary(first));
    EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
    EXPECT_FALSE(FreeLibrary(nullptr));
    EXPECT_FALSE(FreeLibrary(GetModuleHandleA("win-test-extension")));
    EXPECT_EQ(FindResourceA(first, MAKEINTRESOURCE(IDS_GREETING / 16 + 1), RT_STRING), nullptr);
}

TEST_F(ResourceLibrary, StandsBeforeItsModuleInTheSearch) {
    const HMODULE library = LoadLibraryA("win-tests.DEU");
    ASSERT_NE(library, nullptr);
    const CString original = stringOf(IDS_GREETING);
    AfxSetResourceHandle(library);
    EXPECT_EQ(stringOf(IDS_GREETING), "Hallo\tWelt\n");
    // What it lacks comes from the application: a string of the same block, and a picture.
    EXPECT_EQ(stringOf(IDS_SHADOWED), "of the program");
    EXPECT_EQ(AfxFindResourceHandle("grid", RT_BITMAP), AfxGetInstanceHandle());
    AfxSetResourceHandle(nullptr);
    EXPECT_EQ(stringOf(IDS_GREETING), original);
}

TEST_F(ResourceLibrary, StandsBeforeAnExtensionModuleInTheSearch) {
    const HMODULE library = LoadLibraryA("win-test-extension.JPN");
    ASSERT_NE(library, nullptr);
    AFX_EXTENSION_MODULE state;
    AfxInitExtensionModule(state, GetModuleHandleA("win-test-extension"));
    state.hResource = library;
    // Ending the module would take out the link that the library itself made when it was loaded, too.
    const auto link = std::make_unique<CDynLinkLibrary>(state);
    EXPECT_EQ(stringOf(IDS_EXTENSION_ONLY), "aus der Erweiterung");
    EXPECT_EQ(stringOf(IDS_SHADOWED), "of the program");
}

TEST_F(ResourceLibrary, OfTheLayerHasItsTextsInTheUsersLanguage) {
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    const HMODULE library = tvx::loadTranslation(tvx::platformModule());
    ASSERT_NE(library, nullptr);
    EXPECT_EQ(tvx::resourceString(library, AFX_IDP_FAILED_TO_SAVE_DOC),
              "Das Dokument konnte nicht gespeichert werden.");
}

TEST_F(ResourceLibrary, IsNotLookedForInEnglishSessions) {
    place("path/win-tests.ENG");
    setenv("LC_ALL", "en_GB.UTF-8", 1);
    EXPECT_EQ(tvx::loadTranslation(nullptr), nullptr);
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    EXPECT_NE(tvx::loadTranslation(nullptr), nullptr);
}

TEST(PlainModuleName, LeavesOutWhatTheSystemAddsToLibraries) {
    EXPECT_EQ(tvx::plainModuleName("/opt/lib/libGuiUtilities.so.1.0.0"), "/opt/lib/GuiUtilities");
    EXPECT_EQ(tvx::plainModuleName("libsmall.SO"), "small");
    EXPECT_EQ(tvx::plainModuleName("/opt/lib.so.d/board"), "/opt/lib.so.d/board");
    EXPECT_EQ(tvx::plainModuleName("/opt/library"), "/opt/library");
    EXPECT_EQ(tvx::plainModuleName("/opt/plug.so"), "/opt/plug");
    EXPECT_EQ(tvx::plainModuleName(""), "");
}
