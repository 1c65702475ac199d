#include "platform/win/Associations.h"

#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

namespace fs = std::filesystem;

namespace {

/// A desktop of its own: folders for programs, desktop entries and permissions that go with the object.
class Associations : public testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(folder / "bin");
        fs::create_directories(folder / "snap/bin");
        setenv("HOME", (folder / "home").c_str(), 1);
        setenv("XDG_DATA_HOME", (folder / "data").c_str(), 1);
        setenv("PATH", ((folder / "bin").string() + ":/usr/bin:/bin").c_str(), 1);
    }
    void TearDown() override {
        fs::remove_all(folder);
    }

    /// Writes a file below the folder, with the folders above it; programs can be run.
    std::string write(const std::string& name, const std::string& text) const {
        const fs::path file = folder / name;
        fs::create_directories(file.parent_path());
        std::ofstream(file) << text;
        fs::permissions(file, fs::perms::owner_all);
        return file.string();
    }

    const SavedEnvironment environment;
    const fs::path folder = fs::canonical(fs::temp_directory_path()) / "associations";
};

TEST_F(Associations, TellWhatKeepsSandboxedProgramsFromDocuments) {
    write("usr/bin/snap", "#!/bin/sh\n");
    write("bin/plain", "#!/bin/sh\n");
    write("bin/tvxopen", "#!/bin/sh\n");
    write("bin/flatpak", "#!/bin/sh\n");
    fs::create_symlink("../../usr/bin/snap", folder / "snap/bin/fox");
    fs::create_symlink(folder / "snap/bin/fox", folder / "alternative");
    fs::create_symlink("../alternative", folder / "bin/x-www-browser");
    write("bin/fox", "#!/bin/sh\nif true; then\n  exec " + (folder / "snap/bin/fox").string() + " \"$@\"\nfi\n");
    write("flatpak/exports/bin/org.app.Reader", "#!/bin/sh\nexec flatpak run org.app.Reader \"$@\"\n");
    write("data/flatpak/app/org.app.Reader/current/active/metadata",
          "[Application]\nname=x\nfilesystems=host;\n[Context]\nshared=network;\nfilesystems=/srv/docs:ro;~/Shared;\n");
    write("data/flatpak/app/org.app.Host/current/active/metadata", "[Context]\nfilesystems=host;\n");
    write("data/flatpak/overrides/org.app.Host", "[Context]\nfilesystems=!/opt;\n");
    const std::string home = (folder / "home").string();
    const std::string reader = (folder / "flatpak/exports/bin/org.app.Reader").string();
    const struct {
        std::string command;
        std::string document;
        std::string obstacle;
    } rows[] = {
        {"plain \"%1\"", "/opt/tarvex/a.htm", ""},
        {"missing-program", "/opt/tarvex/a.htm", ""},
        {"", "/opt/tarvex/a.htm", ""},
        {"fox \"%1\"", "/opt/tarvex/a.htm", "snap"},
        {"fox", "file:///opt/tarvex/a%20b.htm#sec", "snap"},
        {"fox", R"(file:///C|\opt\tarvex\a.htm)", "snap"},
        {"fox", R"(C:\usr\share\doc\tarvex\a.htm)", ""},
        {"fox", "https://www.example.org/a.htm", ""},
        {"fox", home + "/doc/a.htm", ""},
        {"fox", home + "/.cache/a.htm", "snap"},
        {"fox", "/tmp/a.htm", "snap"},
        {"x-www-browser %1", "/opt/a.htm", "snap"},
        {"sensible-browser", "/opt/a.htm", "snap"},
        {"env A=b fox", "/opt/a.htm", "snap"},
        {"tvxopen --names -- fox", "/opt/a.htm", "snap"},
        {"tvxopen --names plain \"%1\"", "http://www.example.org", "files only"},
        {"tvxopen --names plain \"%1\"", "file:///opt/a.htm", ""},
        {"tvxopen plain \"%1\"", "http://www.example.org", ""},
        {reader, "/usr/share/doc/a.htm", "flatpak"},
        {reader, "/srv/docs/a.htm", ""},
        {reader, "/srv/docsets/a.htm", "flatpak"},
        {reader, home + "/Shared/a.htm", ""},
        {reader, home + "/a.htm", "flatpak"},
        {reader, "mailto:x@example.org", ""},
        {"flatpak run --branch=stable org.app.Host @@u %1 @@", "/usr/share/doc/a.pdf", "flatpak"},
        {"flatpak run --branch=stable org.app.Host @@u %1 @@", "/srv/a.htm", ""},
        {"flatpak run org.app.Host", "/opt/a.htm", "flatpak"},
        {"flatpak run org.app.None @@u \"%1\" @@", "/opt/a.pdf#page=2", ""},
        {"flatpak run org.app.None @@u \"%1\" @@", "/opt/a.htm", "flatpak"},
    };
    unsetenv("BROWSER");
    for (const auto& row : rows) {
        EXPECT_EQ(tvx::obstacleTo(row.command, row.document), row.obstacle) << row.command << ": " << row.document;
    }
    setenv("BROWSER", "plain", 1);
    EXPECT_EQ(tvx::obstacleTo("sensible-browser", "/opt/a.htm"), "");
}

} // namespace
