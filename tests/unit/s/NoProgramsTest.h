#pragma once

#include "StoreTest.h"
#include "tests/unit/SavedEnvironment.h"

#include <cstdlib>
#include <filesystem>
#include <string>

/// A user, a machine and a desktop that know no program, until a test registers one.
class NoProgramsTest : public StoreTest {
protected:
    void SetUp() override {
        StoreTest::SetUp();
        for (const char* variable : {"XDG_DATA_HOME", "XDG_DATA_DIRS", "XDG_CONFIG_HOME", "XDG_CONFIG_DIRS", "PATH"}) {
            setenv(variable, (m_folder / variable).c_str(), 1);
        }
    }
    /// Stores a text in the user's settings; empty name: the default value.
    static void store(const std::string& path, const char* name, const std::string& text) {
        HKEY key = nullptr;
        RegCreateKeyExA(HKEY_CURRENT_USER, path.c_str(), 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr);
        RegSetValueExA(key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.c_str()),
                       static_cast<DWORD>(text.size() + 1));
        RegCloseKey(key);
    }
    /// Lets the machine have a key with this default value.
    void storeForMachine(const std::string& path, const std::string& text) const {
        const std::string user = std::getenv("TVX_REGISTRY");
        use(m_folder / "XDG_CONFIG_DIRS" / "tarvex" / "registry.db");
        store(path, "", text);
        use(user);
    }
    /// Registers a program for files of an extension such as ".htm".
    static void associate(const std::string& extension, const std::string& command) {
        store("Software\\Classes\\" + extension, "", "test" + extension);
        store("Software\\Classes\\test" + extension + "\\shell\\open\\command", "", command);
    }

    inline static const char* const family = "Software\\Tarvex\\Common";
    inline static const char* const lastBrowser = "Software\\Classes\\Applications\\iexplore.exe\\shell\\open\\command";

private:
    static void use(const std::filesystem::path& file) {
        tvx::registry::closeStores();
        setenv("TVX_REGISTRY", file.c_str(), 1);
    }

    SavedEnvironment m_environment;
};
