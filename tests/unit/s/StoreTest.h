#pragma once

#include "platform/win/Registry.h"
#include "platform/win/detail/RegistryStore.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>

/// A settings store of its own for each test.
class StoreTest : public ::testing::Test {
protected:
    void SetUp() override {
        std::string name = (std::filesystem::temp_directory_path() / "store.XXXXXX").string();
        m_folder = mkdtemp(name.data());
        tvx::registry::closeStores();
        setenv("TVX_REGISTRY", (m_folder / "registry.db").c_str(), 1);
    }
    void TearDown() override {
        tvx::registry::closeStores();
        std::filesystem::remove_all(m_folder);
    }
    /// A text as the store holds it, or what it holds instead.
    static std::string stored(const std::string& path, const char* name) {
        HKEY key = nullptr;
        if (RegOpenKeyExA(HKEY_CURRENT_USER, path.c_str(), 0, KEY_READ, &key) != ERROR_SUCCESS) {
            return "<no key>";
        }
        char text[100] = {};
        DWORD size = sizeof text;
        DWORD type = REG_NONE;
        const LSTATUS result = RegQueryValueExA(key, name, nullptr, &type, reinterpret_cast<BYTE*>(text), &size);
        RegCloseKey(key);
        return result != ERROR_SUCCESS ? "<no value>" : type != REG_SZ ? "<no text>" : text;
    }

    std::filesystem::path m_folder;
};
