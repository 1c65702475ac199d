#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <gtest/gtest.h>

/// An empty folder that is the current one while a test runs.
class FileTestFolder : public testing::Test {
protected:
    FileTestFolder() : m_previous(std::filesystem::current_path()) {
        std::string pattern = (std::filesystem::temp_directory_path() / "files.XXXXXX").string();
        m_folder = ::mkdtemp(pattern.data());
        std::filesystem::current_path(m_folder);
    }
    ~FileTestFolder() override {
        std::filesystem::current_path(m_previous);
        std::filesystem::remove_all(m_folder);
    }

    static void put(const std::string& name, const std::string& contents = "") {
        if (const auto folder = std::filesystem::path(name).parent_path(); !folder.empty()) {
            std::filesystem::create_directories(folder);
        }
        std::ofstream(name, std::ios::binary) << contents;
    }
    static std::string get(const std::string& name) {
        std::ifstream file(name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    /// A name below the folder in the framework's form.
    std::string drive(const std::string& rest) const {
        std::string name = "C:" + m_folder + "/" + rest;
        for (char& character : name) {
            character = character == '/' ? '\\' : character;
        }
        return name;
    }

    std::string m_folder;

private:
    std::filesystem::path m_previous;
};
