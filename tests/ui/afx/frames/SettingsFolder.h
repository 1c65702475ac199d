#pragma once

#include "platform/win/detail/RegistryStore.h"

#include <cstdlib>
#include <filesystem>
#include <string>

/// A store of settings of its own, in a folder that goes with the object.
class SettingsFolder {
public:
    SettingsFolder() {
        std::string name = (std::filesystem::temp_directory_path() / "settings.XXXXXX").string();
        m_folder = mkdtemp(name.data());
        tvx::registry::closeStores();
        setenv("TVX_REGISTRY", (m_folder / "registry.db").c_str(), 1);
    }
    ~SettingsFolder() {
        tvx::registry::closeStores();
        std::filesystem::remove_all(m_folder);
    }
    SettingsFolder(const SettingsFolder&) = delete;
    SettingsFolder& operator=(const SettingsFolder&) = delete;

private:
    std::filesystem::path m_folder;
};
