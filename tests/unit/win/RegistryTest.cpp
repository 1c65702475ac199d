#include "platform/win/Registry.h"

#include "RegistrySandbox.h"

#include <array>
#include <sys/stat.h>
#include <vector>

namespace {

class Registry : public ::testing::Test {
protected:
    static std::vector<std::string> subKeys(HKEY key) {
        std::vector<std::string> names;
        std::array<char, 256> name{};
        for (DWORD i = 0, size = name.size();
             RegEnumKeyExA(key, i, name.data(), &size, nullptr, nullptr, nullptr, nullptr) == ERROR_SUCCESS;
             ++i, size = name.size()) {
            names.emplace_back(name.data(), size);
        }
        return names;
    }
    static std::vector<std::string> values(HKEY key) {
        std::vector<std::string> names;
        std::array<char, 256> name{};
        for (DWORD i = 0, size = name.size();
             RegEnumValueA(key, i, name.data(), &size, nullptr, nullptr, nullptr, nullptr) == ERROR_SUCCESS;
             ++i, size = name.size()) {
            names.emplace_back(name.data(), size);
        }
        return names;
    }

    RegistrySandbox m_sandbox;
};

TEST_F(Registry, KeepsValuesOverAnEndOfTheProcess) {
    {
        const TestKey key("Software\\Tarvex\\Common");
        EXPECT_EQ(key.disposition, REG_CREATED_NEW_KEY);
        EXPECT_EQ(key.write("Browser", "firefox %1"), ERROR_SUCCESS);
        EXPECT_EQ(key.write(nullptr, "default"), ERROR_SUCCESS);
        EXPECT_EQ(key.write("Bytes", std::string("\0\1\xFF", 3), REG_BINARY), ERROR_SUCCESS);
        EXPECT_EQ(key.write("Odd", "", 77), ERROR_SUCCESS);
    }
    tvx::registry::closeStores();
    const TestKey key("Software\\Tarvex\\Common");
    EXPECT_EQ(key.disposition, REG_OPENED_EXISTING_KEY);
    DWORD type = 0;
    EXPECT_EQ(key.read("Browser", &type), "firefox %1");
    EXPECT_EQ(type, REG_SZ);
    EXPECT_EQ(key.read(""), "default");
    EXPECT_EQ(key.read("Bytes", &type), std::string("\0\1\xFF", 3));
    EXPECT_EQ(type, REG_BINARY);
    EXPECT_EQ(key.read("Odd", &type), "");
    EXPECT_EQ(type, 77u);
}

TEST_F(Registry, FindsNamesWithoutCaseAndKeepsTheirFirstSpelling) {
    const TestKey key("Software\\Straße\\ÄRGER");
    key.write("Größe", "1");
    const TestKey again("SOFTWARE\\straße\\ärger");
    EXPECT_EQ(again.disposition, REG_OPENED_EXISTING_KEY);
    EXPECT_EQ(again.write("GRÖßE", "2"), ERROR_SUCCESS);
    EXPECT_EQ(key.read("größe"), "2");
    EXPECT_EQ(values(key.handle), std::vector<std::string>{"Größe"});
    EXPECT_EQ(subKeys(TestKey("software\\STRAßE").handle), std::vector<std::string>{"ÄRGER"});
}

TEST_F(Registry, PassesOverBackslashesTooMany) {
    TestKey("Software\\Tarvex").write("a", "1");
    EXPECT_EQ(TestKey("\\Software\\\\Tarvex\\", TestKey::Way::Open).read("a"), "1");
}

TEST_F(Registry, AnswersTheSizeOfAValueThatDoesNotFit) {
    const TestKey key("Software\\Tarvex");
    key.write("a", "1234");
    std::array<char, 4> buffer{};
    DWORD size = buffer.size();
    DWORD type = 0;
    auto* const data = reinterpret_cast<BYTE*>(buffer.data());
    EXPECT_EQ(RegQueryValueExA(key.handle, "a", nullptr, &type, data, &size), LSTATUS{ERROR_MORE_DATA});
    EXPECT_EQ(size, 5u);
    EXPECT_EQ(type, REG_SZ);
    EXPECT_EQ(RegQueryValueExA(key.handle, "b", nullptr, &type, data, &size), LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_EQ(RegQueryValueExA(key.handle, "a", nullptr, nullptr, data, nullptr), LSTATUS{ERROR_INVALID_PARAMETER});
}

TEST_F(Registry, NamesKeysAndValuesInOrderOnceEach) {
    for (const char* name : {"beta", "Alpha", "gamma"}) {
        const TestKey key(std::string("Software\\") + name);
        TestKey("Software").write(name, name);
    }
    const TestKey parent("Software");
    EXPECT_EQ(subKeys(parent.handle), (std::vector<std::string>{"Alpha", "beta", "gamma"}));
    EXPECT_EQ(values(parent.handle), (std::vector<std::string>{"Alpha", "beta", "gamma"}));
    std::array<char, 5> tooSmall{};
    DWORD size = tooSmall.size();
    EXPECT_EQ(RegEnumKeyExA(parent.handle, 0, tooSmall.data(), &size, nullptr, nullptr, nullptr, nullptr),
              LSTATUS{ERROR_MORE_DATA});
    size = tooSmall.size();
    EXPECT_EQ(RegEnumKeyExA(parent.handle, 1, tooSmall.data(), &size, nullptr, nullptr, nullptr, nullptr), 0);
    EXPECT_EQ(size, 4u);
    size = tooSmall.size();
    EXPECT_EQ(RegEnumKeyExA(parent.handle, 3, tooSmall.data(), &size, nullptr, nullptr, nullptr, nullptr),
              LSTATUS{ERROR_NO_MORE_ITEMS});
}

TEST_F(Registry, DeletesValuesAndKeysWithoutKeysBelow) {
    const TestKey key("Software\\Tarvex\\board");
    key.write("a", "1");
    EXPECT_EQ(RegDeleteValueA(key.handle, "A"), 0);
    EXPECT_EQ(RegDeleteValueA(key.handle, "a"), LSTATUS{ERROR_FILE_NOT_FOUND});
    key.write("b", "2");
    EXPECT_EQ(RegDeleteKeyA(HKEY_CURRENT_USER, "Software\\Tarvex"), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(RegDeleteKeyA(HKEY_CURRENT_USER, "Software\\Tarvex\\board"), 0);
    EXPECT_EQ(key.read("b"), "<1018>") << "the handle of a deleted key";
    EXPECT_EQ(key.write("b", "3"), LSTATUS{ERROR_KEY_DELETED});
    EXPECT_EQ(RegDeleteKeyA(HKEY_CURRENT_USER, "Software\\Tarvex\\board"), LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_EQ(TestKey("Software\\Tarvex\\board").read("b"), "<2>") << "a new key of the name has no old values";
}

TEST_F(Registry, CallsGoByTheirNamesWithoutALetterToo) {
    HKEY made = nullptr;
    HKEY opened = nullptr;
    DWORD disposition = 0;
    ASSERT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, "Software\\Tarvex", 0, nullptr, REG_OPTION_NON_VOLATILE,
                             KEY_READ | KEY_WRITE, nullptr, &made, &disposition),
              0);
    EXPECT_EQ(disposition, DWORD{REG_CREATED_NEW_KEY});
    const DWORD number = 7;
    EXPECT_EQ(RegSetValueEx(made, "a", 0, REG_DWORD, reinterpret_cast<const BYTE*>(&number), sizeof number), 0);
    ASSERT_EQ(RegOpenKeyEx(HKEY_CURRENT_USER, "Software", 0, KEY_READ, &opened), 0);
    std::array<char, 20> name{};
    DWORD size = name.size();
    EXPECT_EQ(RegEnumKeyEx(opened, 0, name.data(), &size, nullptr, nullptr, nullptr, nullptr), 0);
    EXPECT_STREQ(name.data(), "Tarvex");
    size = name.size();
    EXPECT_EQ(RegEnumValue(made, 0, name.data(), &size, nullptr, nullptr, nullptr, nullptr), 0);
    EXPECT_STREQ(name.data(), "a");
    DWORD read = 0;
    size = sizeof read;
    EXPECT_EQ(RegQueryValueEx(made, "a", nullptr, nullptr, reinterpret_cast<BYTE*>(&read), &size), 0);
    EXPECT_EQ(read, number);
    EXPECT_EQ(RegDeleteValue(made, "a"), 0);
    EXPECT_EQ(RegCloseKey(made), 0);
    EXPECT_EQ(RegDeleteKey(opened, "Tarvex"), 0);
    EXPECT_EQ(RegCloseKey(opened), 0);
    EXPECT_EQ(TestKey("Software\\Tarvex", TestKey::Way::Open).result, LSTATUS{ERROR_FILE_NOT_FOUND});
}

TEST_F(Registry, RefusesWhatAKeyWasNotOpenedFor) {
    TestKey("Software\\Tarvex").write("a", "1");
    const TestKey reading("Software\\Tarvex", TestKey::Way::Open, KEY_READ);
    EXPECT_EQ(reading.read("a"), "1");
    EXPECT_EQ(reading.write("a", "2"), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(TestKey("Software\\Tarvex", TestKey::Way::Open, KEY_WRITE).read("a"), "<5>");
    EXPECT_EQ(TestKey("Software", TestKey::Way::Create, KEY_READ, HKEY_LOCAL_MACHINE).result,
              LSTATUS{ERROR_ACCESS_DENIED});
    HKEY handle = nullptr;
    EXPECT_EQ(RegOpenKeyExA(HKEY_CURRENT_USER, "Nowhere", 0, KEY_READ, &handle), LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_EQ(handle, nullptr);
    ASSERT_EQ(RegOpenKeyExA(HKEY_CURRENT_USER, "Software", 0, KEY_READ, &handle), 0);
    EXPECT_EQ(RegCloseKey(handle), 0);
    EXPECT_EQ(RegCloseKey(handle), LSTATUS{ERROR_INVALID_HANDLE});
    EXPECT_EQ(RegCloseKey(HKEY_CURRENT_USER), 0);
    EXPECT_EQ(TestKey(std::string(256, 'x')).result, LSTATUS{ERROR_INVALID_PARAMETER});
    std::string levels = "x";
    for (int i = 1; i < 512; ++i) {
        levels += "\\x";
    }
    EXPECT_EQ(TestKey(levels).result, 0);
    EXPECT_EQ(TestKey(levels + "\\x").result, LSTATUS{ERROR_INVALID_PARAMETER});
}

TEST_F(Registry, AnswersClassesOfTheUserBeforeThoseOfTheMachine) {
    const auto machine = m_sandbox.folder / "xdg" / "tarvex" / "registry.db";
    RegistrySandbox::use(machine);
    TestKey("Software\\Classes\\.brd").write("", "machine");
    TestKey("Software\\Classes\\.pdf").write("", "viewer");
    RegistrySandbox::use(m_sandbox.file);
    setenv("XDG_CONFIG_DIRS", (m_sandbox.folder / "xdg").c_str(), 1);
    TestKey("Software\\Classes\\.brd").write("", "user");
    EXPECT_EQ(TestKey(".brd", TestKey::Way::Open, KEY_READ, HKEY_CLASSES_ROOT).read(""), "user");
    EXPECT_EQ(TestKey(".pdf", TestKey::Way::Open, KEY_READ, HKEY_CLASSES_ROOT).read(""), "viewer");
    EXPECT_EQ(TestKey("Software\\Classes\\.brd", TestKey::Way::Open, KEY_READ, HKEY_LOCAL_MACHINE).read(""), "machine");
    EXPECT_EQ(TestKey(".pdf", TestKey::Way::Open, KEY_WRITE, HKEY_CLASSES_ROOT).result, LSTATUS{ERROR_ACCESS_DENIED});
    const TestKey own(".pdf", TestKey::Way::Create, KEY_READ | KEY_WRITE, HKEY_CLASSES_ROOT);
    EXPECT_EQ(own.disposition, DWORD{REG_CREATED_NEW_KEY});
    EXPECT_EQ(own.read(""), "viewer") << "the machine's, as long as the user has a key but no value";
    own.write("", "own");
    EXPECT_EQ(own.read(""), "own");
    EXPECT_EQ(TestKey("Software\\Classes\\.pdf", TestKey::Way::Open, KEY_READ).read(""), "own");
    EXPECT_EQ(RegDeleteKeyA(HKEY_CLASSES_ROOT, ".pdf"), 0);
    EXPECT_EQ(TestKey(".pdf", TestKey::Way::Open, KEY_READ, HKEY_CLASSES_ROOT).read(""), "viewer");
}

TEST_F(Registry, MakesFileAndFolderPrivateAndOnlyWhenSomethingIsWritten) {
    HKEY handle = nullptr;
    EXPECT_EQ(RegOpenKeyExA(HKEY_CURRENT_USER, "Software", 0, KEY_READ, &handle), LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_FALSE(std::filesystem::exists(m_sandbox.file.parent_path()));
    umask(0);
    TestKey("Software").write("a", "1");
    struct stat status{};
    ASSERT_EQ(stat(m_sandbox.file.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600u);
    ASSERT_EQ(stat((m_sandbox.file.string() + "-wal").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600u);
    ASSERT_EQ(stat(m_sandbox.file.parent_path().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0700u);
}

TEST_F(Registry, KeepsChangesTogetherInATransaction) {
    const TestKey key("Software\\Tarvex");
    key.write("a", "old");
    {
        tvx::RegistryTransaction transaction;
        ASSERT_EQ(transaction.begin(), 0);
        key.write("a", "new");
        key.write("b", "new");
        EXPECT_EQ(key.read("a"), "new");
    }
    EXPECT_EQ(key.read("a"), "old");
    EXPECT_EQ(key.read("b"), "<2>");
    tvx::RegistryTransaction transaction;
    ASSERT_EQ(transaction.begin(), 0);
    key.write("a", "new");
    ASSERT_EQ(transaction.commit(), 0);
    EXPECT_EQ(key.read("a"), "new");
}

} // namespace
