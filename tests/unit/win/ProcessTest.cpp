#include "platform/win/Process.h"

#include "platform/win/Error.h"
#include "platform/win/ProcessMark.h"
#include "platform/win/detail/ProcessObject.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <optional>
#include <sstream>
#include <sys/prctl.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

/// A started child, held until the test ends.
class Child {
public:
    explicit Child(const std::string& line, const char* directory = nullptr, WORD show = 5) {
        const SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
        HANDLE writeEnd = nullptr;
        CreatePipe(&m_output, &writeEnd, &inheritable, 0);
        STARTUPINFOA startup;
        startup.dwFlags = STARTF_USESTDHANDLES | STARTF_USESHOWWINDOW;
        startup.wShowWindow = show;
        startup.hStdOutput = startup.hStdError = writeEnd;
        std::string text = line;
        SetLastError(0);
        started = CreateProcessA(nullptr, text.data(), nullptr, nullptr, TRUE, 0, nullptr, directory, &startup,
                                 &information) == TRUE;
        error = GetLastError();
        CloseHandle(writeEnd);
    }
    ~Child() {
        CloseHandle(m_output);
        if (started) {
            CloseHandle(information.hProcess);
            CloseHandle(information.hThread);
        }
    }
    Child(const Child&) = delete;
    Child& operator=(const Child&) = delete;

    /// All that it writes.
    std::string output() const {
        std::string text = output(INT_MAX);
        EXPECT_EQ(GetLastError(), ERROR_BROKEN_PIPE);
        return text;
    }

    /// The first lines that it writes, or more.
    std::string output(int lines) const {
        std::string text;
        char buffer[4096];
        DWORD count = 0;
        while (std::ranges::count(text, '\n') < lines && ReadFile(m_output, buffer, sizeof buffer, &count, nullptr)) {
            text.append(buffer, count);
        }
        return text;
    }

    DWORD code() const {
        EXPECT_EQ(WaitForSingleObject(information.hProcess, INFINITE), WAIT_OBJECT_0);
        DWORD code = 0;
        EXPECT_TRUE(GetExitCodeProcess(information.hProcess, &code));
        return code;
    }

    bool started = false;
    DWORD error = 0;
    PROCESS_INFORMATION information;

private:
    HANDLE m_output = nullptr;
};

/// A shell command. It must not hold double quotes.
std::string shell(const std::string& command) {
    return "/bin/sh -c \"" + command + "\"";
}

class ProcessFiles : public testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(folder);
    }

    std::string write(const std::string& name, const std::string& text, fs::perms mode = fs::perms::owner_all) const {
        const fs::path file = folder / name;
        std::ofstream(file) << text;
        fs::permissions(file, mode);
        return file.string();
    }

    const fs::path folder = fs::temp_directory_path() / "my programs";
};

std::string lineWith(const std::string& text, const std::string& start) {
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with(start)) {
            return line;
        }
    }
    return {};
}

} // namespace

TEST(Process, TellsItsExitCode) {
    EXPECT_EQ(Child("true").code(), 0u);
    EXPECT_EQ(Child(shell("exit 77")).code(), 77u);
    const Child sleeper("sleep 1000");
    DWORD code = 0;
    ASSERT_TRUE(GetExitCodeProcess(sleeper.information.hProcess, &code));
    EXPECT_EQ(code, STILL_ACTIVE);
    EXPECT_EQ(WaitForSingleObject(sleeper.information.hThread, 0), WAIT_TIMEOUT);
    EXPECT_TRUE(TerminateProcess(sleeper.information.hProcess, 4711));
    EXPECT_EQ(sleeper.code(), 4711u);
    EXPECT_FALSE(TerminateProcess(sleeper.information.hProcess, 1));
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
    EXPECT_EQ(sleeper.code(), 4711u);
}

TEST(Process, EndsWithThoseThatKeptItsGroup) {
    const Child parent(shell("sleep 1000 & echo $!; setsid sleep 1000 & echo $!; wait"));
    std::istringstream ids(parent.output(2));
    DWORD kept = 0;
    DWORD left = 0;
    ASSERT_TRUE(ids >> kept >> left);
    const HANDLE inGroup = OpenProcess(PROCESS_QUERY_INFORMATION, FALSE, kept);
    const HANDLE outside = OpenProcess(PROCESS_QUERY_INFORMATION, FALSE, left);
    ASSERT_TRUE(inGroup && outside);
    while (::getpgid(static_cast<pid_t>(left)) != static_cast<pid_t>(left)) {
        ::usleep(1000); // until it has left the group
    }
    EXPECT_TRUE(TerminateProcess(parent.information.hProcess, 7));
    EXPECT_EQ(parent.code(), 7u);
    EXPECT_EQ(WaitForSingleObject(inGroup, INFINITE), WAIT_OBJECT_0);
    EXPECT_EQ(WaitForSingleObject(outside, 0), WAIT_TIMEOUT);
    ::kill(static_cast<pid_t>(left), SIGKILL);
    CloseHandle(inGroup);
    CloseHandle(outside);
}

TEST(Process, DeathsBySignalHaveThePlatformsCodes) {
    const struct {
        const char* signal;
        DWORD code;
    } cases[] = {
        {"INT", 0xC000013A},     {"SEGV", 0xC0000005},    {"ILL", 0xC000001D},   {"FPE", 0xC0000094},
        {"BUS", 0xC0000006},     {"TRAP", 0x80000003},    {"ABRT", 0xC0000420},  {"QUIT", 0xC0000003},
        {"TERM", 128 + SIGTERM}, {"KILL", 128 + SIGKILL}, {"HUP", 128 + SIGHUP}, {"PIPE", 128 + SIGPIPE},
    };
    for (const auto& [signal, code] : cases) {
        const Child child(shell("ulimit -c 0; kill -" + std::string(signal) + " $$"));
        EXPECT_EQ(child.code(), code) << signal;
    }
}

TEST_F(ProcessFiles, FailuresOfTheStartAreTold) {
    write("plain.txt", "text", fs::perms::owner_read);
    write("no-program", "neither binary nor script");
    const std::string path = folder.string();
    const struct {
        std::string line;
        DWORD error;
    } cases[] = {
        {"no-such-program-anywhere", ERROR_FILE_NOT_FOUND},
        {"'quoted' strangely", ERROR_FILE_NOT_FOUND},
        {"\"\" x", ERROR_FILE_NOT_FOUND},
        {"\"" + path + "/missing\"", ERROR_FILE_NOT_FOUND},
        {path + "/missing -a", ERROR_FILE_NOT_FOUND},
        {"\"" + path + "/missing/folder/tool\"", ERROR_PATH_NOT_FOUND},
        {"Q:\\tool", ERROR_PATH_NOT_FOUND},
        {"\"" + path + "\"", ERROR_ACCESS_DENIED},
        {"\"" + path + "\\no-program\" x", ERROR_BAD_EXE_FORMAT},
        {"true " + std::string(200000, 'x'), ERROR_FILENAME_EXCED_RANGE},
        {std::string(300, 'x') + " a", ERROR_FILENAME_EXCED_RANGE},
        {"\"" + path + "/" + std::string(300, 'x') + "\"", ERROR_FILENAME_EXCED_RANGE},
        {"C:\\" + std::string(5000, 'x'), ERROR_FILENAME_EXCED_RANGE},
        {"", ERROR_INVALID_PARAMETER},
        {" \t", ERROR_INVALID_PARAMETER},
    };
    for (const auto& [line, error] : cases) {
        const Child child(line);
        EXPECT_FALSE(child.started) << line;
        EXPECT_EQ(child.error, error) << line.substr(0, 80);
    }
    // The superuser may execute what has an executable bit for anybody.
    EXPECT_EQ(Child("\"" + path + "/plain.txt\"").error, ERROR_ACCESS_DENIED);
    EXPECT_EQ(Child("true", "/no/such/folder").error, ERROR_DIRECTORY);
    EXPECT_EQ(Child("true", (path + "/no-program").c_str()).error, ERROR_DIRECTORY);
}

TEST_F(ProcessFiles, FindsProgramsAsThePlatformDoes) {
    write("my tool", "#!/bin/sh\necho \"$0\" \"$@\"\n");
    const std::string tool = (folder / "my tool").string();
    EXPECT_EQ(Child("\"" + tool + "\" a").output(), tool + " a\n");
    EXPECT_EQ(Child(tool + " a").output(), tool + " a\n") << "blanks without quotes";
    EXPECT_EQ(Child("\"C:" + tool + ".EXE\" a").output(), tool + " a\n");
    EXPECT_EQ(Child("echo.exe a").output(), "a\n");

    // A program of the system comes before a file in the current folder, which does not count at all.
    write("echo", "#!/bin/sh\nprintf 'planted\\n'\n");
    const fs::path before = fs::current_path();
    fs::current_path(folder);
    EXPECT_EQ(Child("echo a").output(), "a\n");
    const std::string path = std::getenv("PATH");
    for (const std::string& entries : {path, ":" + path + ":", path + "::.:../my programs"}) {
        ::setenv("PATH", entries.c_str(), 1);
        EXPECT_EQ(Child("\"my tool\" a").error, ERROR_FILE_NOT_FOUND) << entries;
    }
    ::setenv("PATH", (path + ":" + folder.string()).c_str(), 1);
    EXPECT_EQ(Child("\"my tool\" a").output(), tool + " a\n");
    ::setenv("PATH", path.c_str(), 1);
    EXPECT_EQ(Child("\"./my tool\" a", "/").output(), (folder / "./my tool").string() + " a\n");
    fs::current_path(before);
}

TEST_F(ProcessFiles, HandsOverItsWords) {
    EXPECT_EQ(Child(R"(printf "[%s]" a "b c" "" d\"e C:\usr)").output(), "[a][b c][][d\"e][/usr]");
    EXPECT_EQ(Child("pwd -P", folder.c_str()).output(), fs::canonical(folder).string() + "\n");
    EXPECT_EQ(Child("pwd -P", "C:\\").output(), "/\n");
    std::string words = "-a";
    EXPECT_EQ(Child("printf %s").output(), "");
    STARTUPINFOA startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    PROCESS_INFORMATION child;
    ASSERT_TRUE(
        CreateProcessA("/bin/true", words.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &child));
    CloseHandle(child.hThread);
    CloseHandle(child.hProcess);
}

TEST(ProcessInheritance, OnlyTheThreeDescriptorsAreInherited) {
    const int file = ::open("/dev/zero", O_RDONLY);
    ASSERT_GE(file, 3);
    const int other = ::fcntl(file, F_DUPFD, 200); // without the close-on-exec flag
    // The listing has a descriptor of its own for the folder.
    EXPECT_EQ(Child("ls /proc/self/fd").output(), "0\n1\n2\n3\n");
    EXPECT_EQ(Child("readlink /proc/self/fd/0").output(), "/dev/null\n");
    ::close(other);
    ::close(file);
}

TEST(ProcessInheritance, StandardDescriptorsMayBeClosedHere) {
    const int kept[] = {::dup(0), ::dup(1), ::dup(2)};
    for (int descriptor = 0; descriptor < 3; ++descriptor) {
        ::close(descriptor);
    }
    // What is made now gets their numbers at first.
    std::optional<Child> child(std::in_place,
                               shell("echo out; echo err >&2; readlink /proc/self/fd/0; exec sleep 1000"));
    for (int descriptor = 0; descriptor < 3; ++descriptor) {
        ::dup2(kept[descriptor], descriptor);
        ::close(kept[descriptor]);
    }
    const std::string text = child->output(3);
    EXPECT_TRUE(TerminateProcess(child->information.hProcess, 9));
    EXPECT_EQ(child->code(), 9u);
    EXPECT_EQ(text, "out\nerr\n/dev/null\n");
}

TEST(ProcessInheritance, TheEnvironmentIsTheUsers) {
    ::setenv("PLAIN", "kept", 1);
    ::setenv("TVX_BUNDLE_VARIABLES", "LD_LIBRARY_PATH::XDG_DATA_DIRS:EMPTY", 1);
    ::setenv("LD_LIBRARY_PATH", "/bundle/lib:/usr/lib", 1);
    ::setenv("XDG_DATA_DIRS", "/bundle/share:/usr/share", 1);
    ::setenv("TVX_USER_XDG_DATA_DIRS", "/usr/share", 1);
    ::setenv("EMPTY", "bundle", 1);
    ::setenv("TVX_USER_EMPTY", "", 1);
    const std::string text = Child("env").output();
    EXPECT_EQ(lineWith(text, "PLAIN="), "PLAIN=kept");
    EXPECT_EQ(lineWith(text, "LD_LIBRARY_PATH"), "") << "was not set by the user";
    EXPECT_EQ(lineWith(text, "XDG_DATA_DIRS"), "XDG_DATA_DIRS=/usr/share");
    EXPECT_EQ(lineWith(text, "EMPTY"), "EMPTY=");
    EXPECT_EQ(lineWith(text, "TVX_BUNDLE"), "");
    EXPECT_EQ(lineWith(text, "TVX_USER"), "");
    EXPECT_STREQ(std::getenv("LD_LIBRARY_PATH"), "/bundle/lib:/usr/lib") << "the host's own stays";
}

TEST(ProcessInheritance, AStartupIdIsFreshAndOfTheLastInput) {
    ::setenv("DESKTOP_STARTUP_ID", "ours_TIME1", 1);
    ::setenv("XDG_ACTIVATION_TOKEN", "ours", 1);
    ::setenv("GIO_LAUNCHED_DESKTOP_FILE", "/ours.desktop", 1);
    std::string text = Child("env").output();
    EXPECT_EQ(lineWith(text, "DESKTOP_STARTUP_ID"), "") << "there was no input";
    EXPECT_EQ(lineWith(text, "XDG_ACTIVATION_TOKEN"), "");
    EXPECT_EQ(lineWith(text, "GIO_LAUNCHED"), "");
    tvx::setLastInputTime(4'000'000'000);
    const std::string first = lineWith(Child("env").output(), "DESKTOP_STARTUP_ID=");
    const std::string second = lineWith(Child("env").output(), "DESKTOP_STARTUP_ID=");
    EXPECT_TRUE(first.ends_with("_TIME4000000000")) << first;
    EXPECT_TRUE(second.ends_with("_TIME4000000000")) << second;
    EXPECT_NE(first, second);
    EXPECT_EQ(lineWith(Child("env", nullptr, 0).output(), "DESKTOP_STARTUP_ID"), "") << "no window is wanted";
    tvx::setLastInputTime(0);
}

TEST(ProcessInheritance, TheWishToBeHiddenReachesTheChildOnly) {
    EXPECT_EQ(lineWith(Child("env", nullptr, 0).output(), "TVX_START_HIDDEN"), "TVX_START_HIDDEN=1");
    STARTUPINFOA startup;
    GetStartupInfoA(&startup);
    EXPECT_EQ(startup.dwFlags, 0u);
    ::setenv("TVX_START_HIDDEN", "1", 1);
    GetStartupInfoA(&startup);
    EXPECT_EQ(startup.dwFlags, STARTF_USESHOWWINDOW);
    EXPECT_EQ(startup.wShowWindow, 0);
    EXPECT_EQ(lineWith(Child("env").output(), "TVX_START_HIDDEN"), "") << "not inherited further";
}

TEST(ProcessInheritance, SignalsAreAsTheyWereForTheUser) {
    ::signal(SIGPIPE, SIG_IGN);
    ::signal(SIGUSR1, SIG_IGN); // stands for what the process was started to ignore
    ::signal(SIGUSR2, [](int) {});
    sigset_t blocked;
    sigemptyset(&blocked);
    sigaddset(&blocked, SIGTERM);
    ::sigprocmask(SIG_BLOCK, &blocked, nullptr);
    const std::string status = Child("cat /proc/self/status").output();
    ::sigprocmask(SIG_UNBLOCK, &blocked, nullptr);
    EXPECT_EQ(lineWith(status, "SigBlk"), "SigBlk:\t0000000000000000");
    EXPECT_EQ(lineWith(status, "SigIgn"), "SigIgn:\t0000000000000200");
    for (const int number : {SIGPIPE, SIGUSR1, SIGUSR2}) {
        ::signal(number, SIG_DFL);
    }
}

namespace {

/// Has the system answer one call as if it did not know it, as older ones and sandboxes do.
void forget(long call) {
    sock_filter steps[] = {
        BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr)),
        BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, static_cast<unsigned>(call), 0, 1),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | ENOSYS),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW),
    };
    const sock_fprog program{std::size(steps), steps};
    if (::prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0 || ::prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &program) != 0) {
        std::abort();
    }
}

} // namespace

TEST(ProcessInheritance, SignalsAreResetWhereTheSystemDoesNotDoItAtOnce) {
    const auto startWithoutHelp = [] {
        ::signal(SIGUSR2, [](int) {});
        ::signal(SIGPIPE, SIG_IGN);
        forget(SYS_clone3);
        const std::string status = Child("cat /proc/self/status").output();
        std::exit(lineWith(status, "SigCgt") == "SigCgt:\t0000000000000000" &&
                          lineWith(status, "SigIgn") == "SigIgn:\t0000000000000000"
                      ? 7
                      : 1);
    };
    EXPECT_EXIT(startWithoutHelp(), testing::ExitedWithCode(7), "");
}

TEST(ProcessInheritance, OnlyInheritableEndsReachTheChild) {
    HANDLE readEnd = nullptr;
    HANDLE writeEnd = nullptr;
    ASSERT_TRUE(CreatePipe(&readEnd, &writeEnd, nullptr, 0));
    STARTUPINFOA startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = writeEnd;
    char line[] = "echo lost";
    PROCESS_INFORMATION child;
    ASSERT_TRUE(CreateProcessA(nullptr, line, nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &child));
    CloseHandle(writeEnd);
    EXPECT_EQ(WaitForSingleObject(child.hProcess, INFINITE), WAIT_OBJECT_0);
    EXPECT_FALSE(PeekNamedPipe(readEnd, nullptr, 0, nullptr, nullptr, nullptr));
    EXPECT_EQ(GetLastError(), ERROR_BROKEN_PIPE);
    for (const HANDLE handle : {readEnd, child.hProcess, child.hThread}) {
        EXPECT_TRUE(CloseHandle(handle));
    }
}

TEST(Handles, StaleAndForeignOnesAreRefused) {
    HANDLE readEnd = nullptr;
    HANDLE writeEnd = nullptr;
    ASSERT_TRUE(CreatePipe(&readEnd, &writeEnd, nullptr, 0));
    DWORD number = 0;
    EXPECT_FALSE(GetExitCodeProcess(readEnd, &number));
    EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
    HANDLE copy = nullptr;
    ASSERT_TRUE(DuplicateHandle(GetCurrentProcess(), writeEnd, GetCurrentProcess(), &copy, 0, FALSE,
                                DUPLICATE_SAME_ACCESS | DUPLICATE_CLOSE_SOURCE));
    EXPECT_FALSE(CloseHandle(writeEnd));
    EXPECT_TRUE(PeekNamedPipe(readEnd, nullptr, 0, nullptr, &number, nullptr)) << "the copy keeps the pipe";
    EXPECT_EQ(number, 0u);
    EXPECT_TRUE(CloseHandle(copy));
    EXPECT_FALSE(PeekNamedPipe(readEnd, nullptr, 0, nullptr, &number, nullptr));
    EXPECT_TRUE(CloseHandle(readEnd));
    for (const HANDLE none : {readEnd, HANDLE{nullptr}, INVALID_HANDLE_VALUE}) {
        EXPECT_FALSE(CloseHandle(none));
        EXPECT_EQ(WaitForSingleObject(none, 0), WAIT_FAILED);
        EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
    }
}

TEST(ProcessEnd, IsSeenWhenAHandlerOfTheHostCollectsAllChildren) {
    ::signal(SIGCHLD, SIG_IGN); // the system collects them at once
    const Child child(shell("exit 3"));
    EXPECT_EQ(child.code(), 0xC0000000) << "nobody can tell the code";
    ::signal(SIGCHLD, SIG_DFL);
    EXPECT_EQ(Child(shell("exit 3")).code(), 3u);
}

TEST(ProcessEnd, RingsTheBellOfReleasedChildren) {
    auto& released = tvx::win::ReleasedChildren::instance();
    // Children of other tests that run in this process.
    for (; released.count() > 0; released.collect()) {
        tvx::win::waitReadable(released.bell(), INFINITE);
    }
    DWORD id = 0;
    {
        const Child child("sleep 1000");
        id = child.information.dwProcessId;
    }
    ASSERT_EQ(released.count(), 1u);
    EXPECT_EQ(tvx::win::waitReadable(released.bell(), 0), 0);
    ::kill(static_cast<pid_t>(id), SIGKILL);
    EXPECT_NE(tvx::win::waitReadable(released.bell(), INFINITE), 0);
    released.collect();
    EXPECT_EQ(released.count(), 0u);
    EXPECT_EQ(tvx::win::waitReadable(released.bell(), 0), 0);
    EXPECT_EQ(::kill(static_cast<pid_t>(id), 0), -1) << "no zombie";
}

TEST(ProcessMark, IsThatOfOneProcessWhateverItsProgramIsCalled) {
    const fs::path program = fs::temp_directory_path() / "a) S 1 2 (b";
    fs::copy_file("/bin/sleep", program, fs::copy_options::overwrite_existing);
    const Child child("\"" + program.string() + "\" 1000");
    ASSERT_TRUE(child.started);
    const DWORD id = child.information.dwProcessId;
    const std::string mark = tvx::processMark(id);
    std::istringstream words(mark);
    std::string boot;
    DWORD number = 0;
    long long ticks = 0;
    words >> number >> boot >> ticks;
    EXPECT_EQ(number, id) << mark;
    EXPECT_EQ(boot.size(), 36u) << mark;
    EXPECT_GT(ticks, 0) << mark;
    EXPECT_TRUE(words.eof()) << mark;
    EXPECT_FALSE(tvx::isOtherProcess(id, mark));
    EXPECT_TRUE(tvx::isOtherProcess(id, mark + "1"));
    EXPECT_FALSE(tvx::isOtherProcess(id + 1, mark + "1")) << "a mark of another number tells nothing";
    EXPECT_EQ(tvx::processMark(0x7FFFFFFF), "");
    EXPECT_FALSE(tvx::isOtherProcess(0x7FFFFFFF, "2147483647 x 1")) << "no such process";
    TerminateProcess(child.information.hProcess, 1);
    fs::remove(program);
}
