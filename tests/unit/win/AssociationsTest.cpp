#include "platform/win/Associations.h"

#include "platform/win/Pipe.h"
#include "platform/win/Process.h"
#include "platform/win/detail/ExecCommand.h"
#include "tests/unit/SavedEnvironment.h"
#include "tests/unit/win/RegistrySandbox.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <dlfcn.h>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

/// Runs something in a process of its own: the desktop's library reads the environment once.
std::string inChild(const std::function<std::string()>& question) {
    int ends[2];
    if (pipe(ends) != 0) {
        return "no pipe";
    }
    const pid_t child = fork();
    if (child == 0) {
        const std::string answer = question();
        const bool isWritten = ::write(ends[1], answer.data(), answer.size()) == static_cast<ssize_t>(answer.size());
        _exit(isWritten ? 0 : 1);
    }
    close(ends[1]);
    std::string answer;
    char buffer[4096];
    for (ssize_t count = 0; (count = ::read(ends[0], buffer, sizeof buffer)) > 0;) {
        answer.append(buffer, static_cast<std::size_t>(count));
    }
    close(ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    return status == 0 ? answer : "the child has failed: " + answer;
}

/// The default value of a key, "<2>" when there is none.
std::string valueOf(HKEY root, const std::string& key) {
    return TestKey(key, TestKey::Way::Open, KEY_READ, root).read("");
}

/// The command of a class of documents, found as the library finds it.
std::string commandOf(const std::string& extension) {
    const std::string name = valueOf(HKEY_CLASSES_ROOT, extension);
    return name.starts_with('<') ? name : valueOf(HKEY_CLASSES_ROOT, name + "\\shell\\open\\command");
}

/// What arrives at a program that a command of the settings is started with: its words, each in a line.
std::string arrives(std::string command, const std::string& document, DWORD* id = nullptr) {
    const bool hasMarker = command.find("%1") != std::string::npos;
    for (std::size_t at = command.find("%1"); at != std::string::npos; at = command.find("%1", at + document.size())) {
        command.replace(at, 2, document);
    }
    command += hasMarker ? "" : " " + document;
    HANDLE output = nullptr;
    HANDLE end = nullptr;
    const SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
    CreatePipe(&output, &end, &inheritable, 0);
    STARTUPINFOA startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = startup.hStdError = end;
    PROCESS_INFORMATION process;
    const BOOL started =
        CreateProcessA(nullptr, command.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &process);
    CloseHandle(end);
    if (id) {
        *id = process.dwProcessId;
    }
    std::string text;
    char buffer[4096];
    DWORD count = 0;
    while (started && ReadFile(output, buffer, sizeof buffer, &count, nullptr)) {
        text.append(buffer, count);
    }
    CloseHandle(output);
    return text;
}

/// A desktop of its own: folders for programs, desktop entries and permissions that go with the object. Each program
/// writes down its arguments.
class Associations : public testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(folder / "snap/bin");
        setenv("HOME", (folder / "home").c_str(), 1);
        setenv("XDG_DATA_HOME", (folder / "data").c_str(), 1);
        setenv("XDG_DATA_DIRS", (folder / "system").c_str(), 1);
        setenv("XDG_CONFIG_HOME", (folder / "config").c_str(), 1);
        setenv("XDG_CONFIG_DIRS", (folder / "etc").c_str(), 1);
        setenv("XDG_RUNTIME_DIR", (folder / "run").c_str(), 1);
        setenv("TVX_REGISTRY", (folder / "registry.db").c_str(), 1);
        setenv("PATH", ((folder / "bin").string() + ":/usr/bin:/bin").c_str(), 1);
        unsetenv("BROWSER");
        fs::create_directories(folder / "run");
        for (const char* name : {"show", "other", "evince"}) {
            program(name);
        }
    }
    void TearDown() override {
        tvx::registry::closeStores();
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

    std::string program(const std::string& name) const {
        return write("bin/" + name, "#!/bin/sh\necho " + name + "\nfor word do echo \"[$word]\"; done\n");
    }

    /// Installs a program that opens a type.
    void entry(const std::string& name, const std::string& exec, const std::string& more = {},
               const std::string& types = "text/html;application/pdf;text/plain;") const {
        write("system/applications/" + name + ".desktop", "[Desktop Entry]\nType=Application\nName=" + name +
                                                              "\nExec=" + exec + "\nMimeType=" + types + "\n" + more);
        std::string cache = "[MIME Cache]\n";
        for (const char* type : {"text/html", "application/pdf", "text/plain", "x-scheme-handler/http"}) {
            std::string names;
            for (const auto& file : fs::directory_iterator(folder / "system/applications")) {
                std::ifstream stream(file.path());
                const std::string text(std::istreambuf_iterator<char>(stream), {});
                names += text.find(type) != std::string::npos ? file.path().filename().string() + ";" : "";
            }
            cache += std::string(type) + "=" + names + "\n";
        }
        write("system/applications/mimeinfo.cache", cache);
    }

    /// Makes a program the user's choice.
    void choose(const std::string& lines) const {
        write("config/mimeapps.list", lines);
    }

    const SavedEnvironment environment;
    const fs::path folder = fs::canonical(fs::temp_directory_path()) / "associations";
};

TEST_F(Associations, AreTheCallsOfDesktopEntriesAsCommands) {
    const std::string helper = TVX_TEST_HELPER;
    const struct {
        std::string exec;
        std::string extension;
        std::string command; ///< "@" stands for the helper
        std::string arrived; ///< for the document "a b"
    } rows[] = {
        {"show %u", ".htm", "show \"%1\"", "show\n[a b]\n"},
        {"show %U", ".html", "show \"%1\"", "show\n[a b]\n"},
        {"show %f", ".htm", "@ --names show {} \"%1\"", "show\n[/x/a b]\n"},
        {"show -a %F -b", ".htm", "@ --names show -a {} -b \"%1\"", "show\n[-a]\n[/x/a b]\n[-b]\n"},
        {"show", ".htm", "@ --names show {} \"%1\"", "show\n[/x/a b]\n"},
        {"show %u", ".pdf", "@ show {} \"%1\"", "show\n[/x/a b]\n"},
        {"show", ".txt", "show \"%1\"", "show\n[a b]\n"},
        {"show --x=%u", ".htm", "@ show --x={} \"%1\"", "show\n[--x=a b]\n"},
        {"show %i -n %c %k %v %u", ".htm", "show -n \"%1\"", "show\n[-n]\n[a b]\n"},
        {R"(show "a b" "" 'q"q' "\\$x\\\\" %u)", ".htm", R"(show "a b" "" "q\"q" $x\ "%1")",
         "show\n[a b]\n[]\n[q\"q]\n[$x\\]\n[a b]\n"},
        {R"(show "\\"end\\\\ " %u)", ".htm", R"(show "\"end\ " "%1")", "show\n[\"end\\ ]\n[a b]\n"},
        {"show 100%% {x} {} %u", ".htm", "@ show 100{25} {7B}x} {7B}} {} \"%1\"", "show\n[100%]\n[{x}]\n[{}]\n[a b]\n"},
        {"env A=b show %u", ".htm", "env A=b show \"%1\"", "show\n[a b]\n"},
        {"show @@u %U @@", ".txt", "@ show @@u {} @@ \"%1\"", "show\n[@@u]\n[file:///x/a%20b]\n[@@]\n"},
    };
    for (const auto& row : rows) {
        entry("one", row.exec);
        std::string command = row.command;
        if (command.starts_with('@')) {
            command.replace(0, 1, helper);
        }
        EXPECT_EQ(inChild([&] { return commandOf(row.extension); }), command) << row.exec;
        const bool isHelped = row.arrived.find("/x/a") != std::string::npos;
        EXPECT_EQ(arrives(command, isHelped ? "/x/a b" : "a b"), row.arrived) << row.exec;
    }
}

TEST(AssociationCommands, AreThePlainOnesWithoutTheHelper) {
    using tvx::win::commandFor;
    using tvx::win::Opens;
    EXPECT_EQ(commandFor({"show", "--x=%u\\"}, Opens::Pages, {}), R"(show "--x=%1\\")");
    EXPECT_EQ(commandFor({"show"}, Opens::Pages, {}), "show \"%1\"");
    EXPECT_EQ(commandFor({"show", "%F"}, Opens::Papers, {}), "show \"%1\"");
    EXPECT_EQ(commandFor({"my show", "-a", "%f"}, Opens::TextsBehind, {}), "\"my show\" -a");
    EXPECT_EQ(commandFor({"show", "%f", "-a"}, Opens::TextsBehind, {}), "") << "no place behind the name";
    EXPECT_EQ(commandFor({"show", "100%%", "%f"}, Opens::Texts, {}), "") << "no marker but %1";
}

TEST_F(Associations, FollowTheChoicesOfTheUser) {
    const struct {
        const char* what;
        std::string choices;
        std::string extension;
        std::string program; ///< the first word of the command
    } rows[] = {
        {"one of the installed", "", ".txt", "other"},
        {"the default", "[Default Applications]\ntext/plain=show.desktop\n", ".txt", "show"},
        {"a missing default", "[Default Applications]\ntext/plain=gone.desktop;show.desktop\n", ".txt", "show"},
        {"a removed one", "[Removed Associations]\ntext/plain=other.desktop\n", ".txt", "show"},
        {"an added one", "[Added Associations]\ntext/html=show.desktop\n", ".htm", "show"},
        {"nothing for pages: no editor stands in", "[Default Applications]\ntext/plain=show.desktop\n", ".htm", "<2>"},
        {"the browser of addresses", "[Default Applications]\nx-scheme-handler/http=web.desktop\n", ".htm", "other"},
        {"a terminal's is passed over", "[Default Applications]\ntext/plain=terminal.desktop\n", ".txt", "other"},
        {"one whose program is missing", "[Default Applications]\ntext/plain=missing.desktop\n", ".txt", "other"},
        {"one whose condition is missing", "[Default Applications]\ntext/plain=untried.desktop\n", ".txt", "other"},
    };
    entry("show", "show %u", {}, "text/plain;");
    entry("other", "other %u", {}, "text/plain;");
    entry("web", "other %u", {}, "");
    entry("terminal", "show %u", "Terminal=true\n", "text/plain;");
    entry("missing", "not-there %u", {}, "text/plain;");
    entry("untried", "show %u", "TryExec=not-there\n", "text/plain;");
    write("system/applications/mimeinfo.cache", "[MIME Cache]\ntext/plain=other.desktop;show.desktop;\n");
    write("system/mime/subclasses", "text/html text/plain\n");
    for (const auto& row : rows) {
        choose(row.choices);
        const std::string command = inChild([&] { return commandOf(row.extension); });
        EXPECT_EQ(command.substr(0, command.find(' ')), row.program) << row.what;
    }
    setenv("XDG_CURRENT_DESKTOP", "Lathe:GNOME", 1);
    choose("[Default Applications]\ntext/plain=other.desktop\n");
    write("config/lathe-mimeapps.list", "[Default Applications]\ntext/plain=show.desktop\n");
    EXPECT_EQ(inChild([] { return commandOf(".txt"); }), "show \"%1\"") << "the choice for this desktop";
}

TEST_F(Associations, ComeBehindWhatIsStored) {
    const char* editor = R"(Software\Microsoft\Windows\CurrentVersion\App Paths\WORDPAD.EXE)";
    const char* browser = R"(Software\Classes\Applications\iexplore.exe\shell\open\command)";
    const auto now = [&](HKEY root, const std::string& key) { return inChild([&] { return valueOf(root, key); }); };
    entry("one", "show %u");
    const std::string x = program("x-www-browser");
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, ".PDF"), "tarvex.desktop.application-pdf");
    EXPECT_EQ(now(HKEY_LOCAL_MACHINE, R"(software\classes\.txt)"), "tarvex.desktop.text-plain");
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, R"(tarvex.desktop.text-plain\shell)"), "<2>") << "is there, and has no value";
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, R"(tarvex.desktop.text-plain\run)"), "<6>") << "is not there";
    EXPECT_EQ(now(HKEY_LOCAL_MACHINE, editor), "show");
    EXPECT_EQ(now(HKEY_LOCAL_MACHINE, browser), x + " \"%1\"");

    const std::string machine = (folder / "etc/tarvex/registry.db").string();
    RegistrySandbox::use(machine);
    TestKey(R"(Software\Classes\.pdf)").write("", "machine.pdf");
    TestKey(editor).write("Path", "somewhere");
    TestKey(browser).write("", "machine's browser");
    RegistrySandbox::use(folder / "registry.db");
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, ".pdf"), "machine.pdf");
    EXPECT_EQ(now(HKEY_LOCAL_MACHINE, browser), "machine's browser");
    EXPECT_EQ(now(HKEY_LOCAL_MACHINE, editor), "show") << "the machine's key has another value only";
    TestKey(".txt", TestKey::Way::Create, KEY_WRITE, HKEY_CLASSES_ROOT).write("", "own.txt");
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, ".txt"), "own.txt");
    EXPECT_EQ(now(HKEY_CLASSES_ROOT, ".htm"), "tarvex.desktop.text-html");

    const std::string listed = inChild([] {
        std::string names;
        char name[256];
        for (DWORD index = 0, size = sizeof name;
             RegEnumKeyExA(HKEY_CLASSES_ROOT, index, name, &size, nullptr, nullptr, nullptr, nullptr) == 0;
             ++index, size = sizeof name) {
            names += std::string(name) + ";";
        }
        return names;
    });
    EXPECT_EQ(listed, ".txt;") << "what the user has stored";
}

TEST_F(Associations, LoadTheDesktopsLibraryWhenTheyAreRead) {
    const std::string loaded = inChild([] {
        const auto isLoaded = [] { return dlopen("libgio-2.0.so.0", RTLD_NOW | RTLD_NOLOAD) ? "yes " : "no "; };
        (void)valueOf(HKEY_CURRENT_USER, "Software");
        (void)valueOf(HKEY_LOCAL_MACHINE, "Software");
        (void)valueOf(HKEY_CLASSES_ROOT, ".brd");
        std::string answers = isLoaded();
        const TestKey key(".htm", TestKey::Way::Open, KEY_READ, HKEY_CLASSES_ROOT);
        answers += isLoaded();
        (void)key.read("");
        return answers + isLoaded();
    });
    EXPECT_EQ(loaded, "no no yes ");
}

TEST_F(Associations, KnowTheGenericBrowsers) {
    const char* key = R"(Software\Classes\Applications\iexplore.exe\shell\open\command)";
    const auto browser = [&] { return valueOf(HKEY_LOCAL_MACHINE, key); };
    const auto file = [&](const char* name) { return (folder / "bin" / name).string() + " \"%1\""; };
    setenv("PATH", (folder / "bin").c_str(), 1);
    program("sensible-browser");
    EXPECT_EQ(browser(), "<2>") << "sensible-browser alone leads nowhere";
    program("lynx");
    fs::create_symlink("lynx", folder / "bin/www-browser");
    EXPECT_EQ(browser(), "<2>") << "there is no terminal";
    fs::remove(folder / "bin/www-browser");
    program("www-browser");
    EXPECT_EQ(browser(), file("www-browser"));
    program("gnome-www-browser");
    EXPECT_EQ(browser(), file("gnome-www-browser"));
    program("x-www-browser");
    EXPECT_EQ(browser(), file("x-www-browser"));
    setenv("BROWSER", "lynx", 1);
    EXPECT_EQ(browser(), file("x-www-browser"));
    setenv("BROWSER", "show", 1);
    EXPECT_EQ(browser(), file("sensible-browser"));
}

TEST_F(Associations, AreFollowedWhenTheyChange) {
    entry("one", "show %u");
    entry("two", "other %u");
    choose("[Default Applications]\ntext/plain=one.desktop\n");
    const std::string both = inChild([&] {
        const std::string before = commandOf(".txt");
        choose("[Default Applications]\ntext/plain=two.desktop\n");
        while (commandOf(".txt") == before) { // the desktop's library hears of it from the system
            usleep(1000);
        }
        return before + " " + commandOf(".txt");
    });
    EXPECT_EQ(both, "show \"%1\" other \"%1\"");
}

TEST_F(Associations, ReachTheirProgramsThroughTheHelper) {
    write("docs/a b.pdf", "x");
    write("docs/c.htm", "<p id='s'>");
    write("bin/own-id", "#!/bin/sh\necho $$\n");
    const std::string docs = (folder / "docs").string();
    const auto opened = [&](const std::string& exec, const std::string& extension, const std::string& document) {
        entry("one", exec);
        return arrives(inChild([&] { return commandOf(extension); }), document);
    };
    const std::string page = "evince\n[--page-index=12]\n[" + docs + "/a b.pdf]\n";
    EXPECT_EQ(opened("evince %U", ".pdf", docs + "/a b.pdf#page=12"), page);
    EXPECT_EQ(opened("evince", ".pdf", "C:" + docs + "\\a b.pdf#page=12"), page);
    EXPECT_EQ(opened("evince %f", ".pdf", "file:///C|" + docs + "/a%20b.pdf#page=12"), page);
    EXPECT_EQ(opened("show %f", ".htm", "file://" + docs + "/c.htm"), "show\n[" + docs + "/c.htm]\n");
    EXPECT_EQ(opened("show --x=%u", ".htm", "file:///C|" + docs + "/c.htm"), "show\n[--x=file://" + docs + "/c.htm]\n");
    const std::string led = opened("show %f", ".htm", "file://" + docs + "/c.htm#s");
    EXPECT_TRUE(led.starts_with("show\n[" + (folder / "run/tvxopen/").string())) << led;
    EXPECT_EQ(opened("show %u", ".htm", "https://www.example.org/?a=1&b#s"),
              "show\n[https://www.example.org/?a=1&b#s]\n");

    const char* editor = R"(Software\Microsoft\Windows\CurrentVersion\App Paths\WORDPAD.EXE)";
    const auto edited = [&](const std::string& exec) {
        entry("one", exec);
        return arrives(inChild([&] { return valueOf(HKEY_LOCAL_MACHINE, editor); }), docs + "/c.htm");
    };
    EXPECT_EQ(edited("show -n %F"), "show\n[-n]\n[" + docs + "/c.htm]\n");
    EXPECT_EQ(edited("show %f -n"), "show\n[" + docs + "/c.htm]\n[-n]\n");
    EXPECT_EQ(edited("show --file=%f"), "show\n[--file=" + docs + "/c.htm]\n");

    entry("one", "own-id %f");
    DWORD id = 0;
    const std::string said = arrives(inChild([] { return commandOf(".pdf"); }), "x.pdf", &id);
    EXPECT_EQ(said, std::to_string(id) + "\n") << "no process stands between";
}

TEST_F(Associations, TellWhatKeepsSandboxedProgramsFromDocuments) {
    write("usr/bin/snap", "#!/bin/sh\n");
    program("plain");
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
    for (const auto& row : rows) {
        EXPECT_EQ(tvx::obstacleTo(row.command, row.document), row.obstacle) << row.command << ": " << row.document;
    }
    setenv("BROWSER", "plain", 1);
    EXPECT_EQ(tvx::obstacleTo("sensible-browser", "/opt/a.htm"), "");
}

} // namespace
