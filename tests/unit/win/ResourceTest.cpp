#include "platform/win/Resource.h"

#include "platform/base/String.h"
#include "platform/base/SystemPath.h"
#include "platform/win/Error.h"
#include "platform/win/ExtensionModule.h"
#include "tests/data/resources/resource.h"

#include <afxres.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>

namespace {

std::string textOf(tvx::ResourceBytes bytes) {
    return {bytes.begin(), bytes.end()};
}

HMODULE extension() {
    return GetModuleHandleA("win-test-extension");
}

} // namespace

TEST(Module, FilesAreKnownByTheirRealPath) {
    EXPECT_EQ(std::filesystem::path(tvx::moduleFileName(nullptr)), std::filesystem::canonical("/proc/self/exe"));
    ASSERT_NE(extension(), nullptr);
    EXPECT_EQ(std::filesystem::path(tvx::moduleFileName(extension())).filename(), "libwin-test-extension.so");
    EXPECT_EQ(GetModuleHandleA("LIBWIN-TEST-EXTENSION.SO.1"), extension());
    EXPECT_EQ(GetModuleHandleA("win-tests.exe"), GetModuleHandleA(nullptr));
    EXPECT_EQ(GetModuleHandleA("nothing"), nullptr);
    EXPECT_EQ(GetLastError(), ERROR_MOD_NOT_FOUND);
}

TEST(Module, FileNameIsCutToTheBuffer) {
    const std::string path = tvx::driveName(tvx::moduleFileName(nullptr));
    char buffer[MAX_PATH * 4] = "";
    EXPECT_EQ(GetModuleFileNameA(nullptr, buffer, sizeof buffer), path.size());
    EXPECT_EQ(buffer, path);
    EXPECT_EQ(GetModuleFileName(nullptr, buffer, sizeof buffer), path.size()) << "its name without a letter";
    EXPECT_EQ(GetModuleFileNameA(nullptr, buffer, 4), 4u);
    EXPECT_EQ(buffer, path.substr(0, 3));
    EXPECT_EQ(GetLastError(), ERROR_INSUFFICIENT_BUFFER);
    int noModule = 0;
    EXPECT_EQ(GetModuleFileNameA(reinterpret_cast<HMODULE>(&noModule), buffer, sizeof buffer), 0u);
}

TEST(Resource, NamesCompareWithoutCaseAndNumbersHaveAText) {
    EXPECT_EQ(textOf(tvx::resourceBytes(nullptr, "NOTES", "text")), "plain notes\n");
    EXPECT_NE(FindResourceA(nullptr, "grid", RT_BITMAP), nullptr);
    EXPECT_EQ(FindResourceA(nullptr, "#140", "#2"), FindResourceA(nullptr, MAKEINTRESOURCE(IDB_STRIPES), RT_BITMAP));
    EXPECT_EQ(tvx::firstResource(nullptr, RT_GROUP_ICON), "#128");
    EXPECT_EQ(tvx::firstResource(nullptr, "nothing"), "");
}

TEST(Resource, DataIsReachedThroughItsHandle) {
    const HRSRC found = FindResourceA(nullptr, "notes", "TEXT");
    ASSERT_NE(found, nullptr);
    ASSERT_EQ(SizeofResource(nullptr, found), 12u);
    EXPECT_EQ(std::string(static_cast<char*>(LockResource(LoadResource(nullptr, found))), 12), "plain notes\n");
    EXPECT_EQ(LoadResource(nullptr, nullptr), nullptr);
    EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
}

TEST(Resource, MissingOnesTellWhichPartIsMissing) {
    EXPECT_EQ(FindResourceA(nullptr, "notes", "MUSIC"), nullptr);
    EXPECT_EQ(GetLastError(), ERROR_RESOURCE_TYPE_NOT_FOUND);
    EXPECT_EQ(FindResourceA(nullptr, "nothing", "TEXT"), nullptr);
    EXPECT_EQ(GetLastError(), ERROR_RESOURCE_NAME_NOT_FOUND);
    EXPECT_EQ(FindResourceExA(nullptr, RT_RCDATA, MAKEINTRESOURCE(7), MAKELANGID(17, 1)), nullptr);
    EXPECT_EQ(GetLastError(), ERROR_RESOURCE_LANG_NOT_FOUND);
}

TEST(Resource, NeutralLanguageWinsUnlessOneIsAskedFor) {
    EXPECT_EQ(textOf(tvx::resourceBytes(nullptr, MAKEINTRESOURCE(7), RT_RCDATA)), "neutral");
    const HRSRC german = FindResourceEx(nullptr, RT_RCDATA, MAKEINTRESOURCE(7), MAKELANGID(7, 1));
    ASSERT_NE(german, nullptr);
    const HGLOBAL data = LoadResource(nullptr, german);
    EXPECT_FALSE(FreeResource(data));
    EXPECT_EQ(std::string(static_cast<char*>(data), 7), "deutsch") << "there is nothing to free";
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_GREETING), "Hello\tworld\n");
}

TEST(Resource, StringsAreUtf8) {
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_MIXED), "Grüße, 世界 😀");
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_LAST_OF_BLOCK), "last");
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_WESTERN), "café 5 €");
    EXPECT_EQ(tvx::resourceString(extension(), IDS_EXTENSION_ONLY), "only in the library: Žluťoučký");
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_MIXED + 1), std::nullopt);
    EXPECT_EQ(tvx::resourceString(nullptr, IDS_MIXED + 0x10000), std::nullopt);
}

TEST(Resource, LoadedStringIsCutBetweenCharacters) {
    char buffer[8] = "junk";
    EXPECT_EQ(LoadStringA(nullptr, IDS_MIXED, nullptr, 0), 20);
    EXPECT_EQ(LoadStringA(nullptr, IDS_MIXED, buffer, 4), 2);
    EXPECT_STREQ(buffer, "Gr");
    EXPECT_EQ(LoadStringA(nullptr, IDS_MIXED, buffer, 5), 4);
    EXPECT_STREQ(buffer, "Grü");
    EXPECT_EQ(LoadStringA(nullptr, 9999, buffer, sizeof buffer), 0);
    EXPECT_STREQ(buffer, "");
}

TEST(ExtensionModule, SearchGoesFromTheApplicationToTheChain) {
    EXPECT_EQ(AfxFindResourceHandle(MAKEINTRESOURCE(IDD_SAMPLE), RT_DIALOG), AfxGetInstanceHandle());
    EXPECT_EQ(AfxFindResourceHandle(MAKEINTRESOURCE(IDD_SHARED), RT_RCDATA), extension());
    EXPECT_EQ(AfxFindResourceHandle(MAKEINTRESOURCE(999), RT_DIALOG), AfxGetResourceHandle());
    CString text;
    EXPECT_TRUE(text.LoadString(IDS_SHADOWED));
    EXPECT_STREQ(text, "of the program");
    EXPECT_TRUE(text.LoadString(IDS_EXTENSION_ONLY));
    EXPECT_STREQ(text, "only in the library: Žluťoučký");
    EXPECT_FALSE(text.LoadString(9999));
}

TEST(ExtensionModule, FrameworksOwnResourcesComeLast) {
    EXPECT_EQ(AfxFindStringResourceHandle(AFX_IDS_ALLFILTER), tvx::platformModule());
    CString text;
    EXPECT_TRUE(text.LoadString(AFX_IDS_ALLFILTER));
    EXPECT_STREQ(text, "All Files (*.*)");
    EXPECT_TRUE(text.LoadString(AFX_IDS_IDLEMESSAGE));
    EXPECT_STREQ(text, "For help, press F1") << "the program has a string of its own for it";
    EXPECT_EQ(AfxFindResourceHandle(MAKEINTRESOURCE(AFX_IDD_NEWTYPEDLG), RT_DIALOG), tvx::platformModule());
}

TEST(ExtensionModule, CurrentResourceModuleIsSearchedFirst) {
    AfxSetResourceHandle(extension());
    EXPECT_EQ(AfxGetResourceHandle(), extension());
    char text[40];
    EXPECT_GT(AfxLoadString(IDS_SHADOWED, text, sizeof text), 0);
    EXPECT_STREQ(text, "of the library");
    EXPECT_GT(AfxLoadString(IDS_MIXED, text, sizeof text), 0);
    AfxSetResourceHandle(nullptr);
    EXPECT_EQ(AfxGetResourceHandle(), AfxGetInstanceHandle());
}

TEST(ExtensionModule, ReplacedResourceModuleStandsBeforeTheLibrary) {
    AFX_EXTENSION_MODULE state;
    int library = 0;
    AfxInitExtensionModule(state, reinterpret_cast<HMODULE>(&library));
    EXPECT_EQ(state.hResource, state.hModule);
    state.hResource = AfxGetInstanceHandle();
    AfxSetResourceHandle(extension());
    new CDynLinkLibrary(state);
    EXPECT_EQ(AfxFindResourceHandle("notes", "TEXT"), AfxGetInstanceHandle());
    AfxTermExtensionModule(state);
    EXPECT_FALSE(state.bInitialized);
    AfxSetResourceHandle(nullptr);
}
