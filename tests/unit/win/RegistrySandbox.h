#pragma once

#include "platform/win/Registry.h"
#include "platform/win/detail/RegistryStore.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>
#include <unistd.h>

/// A store of its own for a test: a file that does not exist yet in a folder that goes with this object.
class RegistrySandbox {
public:
    RegistrySandbox() {
        std::string name = (std::filesystem::temp_directory_path() / "registry.XXXXXX").string();
        folder = mkdtemp(name.data());
        file = folder / "store" / "registry.db";
        use(file);
    }
    ~RegistrySandbox() {
        tvx::registry::closeStores();
        std::filesystem::remove_all(folder);
    }
    RegistrySandbox(const RegistrySandbox&) = delete;
    RegistrySandbox& operator=(const RegistrySandbox&) = delete;

    /// Makes another file the store.
    static void use(const std::filesystem::path& name) {
        tvx::registry::closeStores();
        setenv("TVX_REGISTRY", name.c_str(), 1);
    }

    std::filesystem::path folder;
    std::filesystem::path file;
};

/// An open key that closes itself.
class TestKey {
public:
    enum class Way { Create, Open };

    explicit TestKey(const std::string& path, Way way = Way::Create, REGSAM access = KEY_READ | KEY_WRITE,
                     HKEY root = HKEY_CURRENT_USER) {
        result = way == Way::Create ? RegCreateKeyExA(root, path.c_str(), 0, nullptr, REG_OPTION_NON_VOLATILE, access,
                                                      nullptr, &handle, &disposition)
                                    : RegOpenKeyExA(root, path.c_str(), 0, access, &handle);
    }
    ~TestKey() {
        if (handle) {
            RegCloseKey(handle);
        }
    }
    TestKey(const TestKey&) = delete;
    TestKey& operator=(const TestKey&) = delete;

    LSTATUS write(const char* name, const std::string& text, DWORD type = REG_SZ) const {
        const DWORD size = static_cast<DWORD>(text.size() + (type == REG_SZ ? 1 : 0));
        return RegSetValueExA(handle, name, 0, type, reinterpret_cast<const BYTE*>(text.c_str()), size);
    }
    /// The bytes of a value, a text without its zero; "<number>" when it cannot be read.
    [[nodiscard]] std::string read(const char* name, DWORD* type = nullptr) const {
        DWORD size = 0;
        DWORD kind = 0;
        LSTATUS answer = RegQueryValueExA(handle, name, nullptr, &kind, nullptr, &size);
        std::string bytes(size, '\0');
        if (answer == ERROR_SUCCESS) {
            answer = RegQueryValueExA(handle, name, nullptr, &kind, reinterpret_cast<BYTE*>(bytes.data()), &size);
        }
        if (answer != ERROR_SUCCESS) {
            return "<" + std::to_string(answer) + ">";
        }
        if (kind == REG_SZ && bytes.ends_with('\0')) {
            bytes.pop_back();
        }
        if (type) {
            *type = kind;
        }
        return bytes;
    }

    HKEY handle = nullptr;
    LSTATUS result = 0;
    DWORD disposition = 0;
};
