// Stores that something is wrong with.
#include "platform/win/Registry.h"
#include "platform/win/RegistryNotice.h"

#include "ChildProcess.h"
#include "RegistrySandbox.h"

#include <algorithm>
#include <array>
#include <fstream>
#include <iterator>
#include <memory>
#include <sched.h>
#include <sqlite3.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <vector>

namespace fs = std::filesystem;

namespace {

class RegistryFaults : public ::testing::Test {
protected:
    static constexpr const char* path = "Software\\Tarvex";
    static constexpr uid_t nobody = 65534;

    RegistryFaults() {
        notices.clear();
        tvx::setRegistryNotice([](const std::string& text) { notices.push_back(text); });
    }
    ~RegistryFaults() override {
        if (geteuid() != getuid() && seteuid(getuid()) != 0) {
            std::abort();
        }
        tvx::setRegistryNotice(nullptr);
    }

    static std::string contents(const fs::path& file) {
        std::ifstream stream(file, std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    void put(const std::string& bytes) const {
        tvx::registry::closeStores();
        fs::create_directories(m_sandbox.file.parent_path());
        std::ofstream(m_sandbox.file, std::ios::binary) << bytes;
    }
    static void run(const fs::path& file, const char* sql) {
        tvx::registry::closeStores();
        sqlite3* database = nullptr;
        ASSERT_EQ(sqlite3_open(file.c_str(), &database), SQLITE_OK);
        EXPECT_EQ(sqlite3_exec(database, sql, nullptr, nullptr, nullptr), SQLITE_OK);
        sqlite3_close(database);
    }
    [[nodiscard]] std::vector<fs::path> setAside() const {
        return setAside(m_sandbox.file.parent_path());
    }
    static std::vector<fs::path> setAside(const fs::path& folder) {
        std::vector<fs::path> found;
        for (const auto& entry : fs::directory_iterator(folder)) {
            if (entry.path().filename().string().starts_with("registry-damaged-") &&
                entry.path().extension() == ".db") {
                found.push_back(entry.path());
            }
        }
        return found;
    }
    /// Goes on as a user whom the modes of files hold back, where the tests run as one whom they do not.
    void becomeOrdinary() const {
        tvx::registry::closeStores();
        if (geteuid() != 0) {
            return;
        }
        for (fs::path folder = m_sandbox.folder; folder != "/"; folder = folder.parent_path()) {
            fs::permissions(folder, fs::perms::group_exec | fs::perms::others_exec, fs::perm_options::add);
        }
        for (const auto& entry : fs::recursive_directory_iterator(m_sandbox.folder)) {
            ASSERT_EQ(chown(entry.path().c_str(), nobody, nobody), 0);
        }
        ASSERT_EQ(chown(m_sandbox.folder.c_str(), nobody, nobody), 0);
        ASSERT_EQ(seteuid(nobody), 0);
    }

    RegistrySandbox m_sandbox;
    inline static std::vector<std::string> notices;
};

TEST_F(RegistryFaults, DamagedFileIsSetAsideAndToldOnce) {
    for (const std::string& bytes : {std::string(10000, 'x'), std::string("short")}) {
        put(bytes);
        notices.clear();
        RegistrySandbox::use(m_sandbox.file);
        const auto before = setAside().size();
        EXPECT_EQ(TestKey(path, TestKey::Way::Open).result, LSTATUS{ERROR_FILE_NOT_FOUND});
        const TestKey key(path);
        EXPECT_EQ(key.write("a", "1"), 0);
        EXPECT_EQ(key.read("a"), "1");
        ASSERT_EQ(setAside().size(), before + 1);
        std::vector<std::string> kept;
        for (const fs::path& file : setAside()) {
            kept.push_back(contents(file));
        }
        EXPECT_TRUE(std::ranges::find(kept, bytes) != kept.end());
    }
}

TEST_F(RegistryFaults, DamageInsideIsFoundWhenItIsMet) {
    {
        const TestKey key(path);
        tvx::RegistryTransaction transaction;
        ASSERT_EQ(transaction.begin(), 0);
        for (int i = 0; i < 3000; ++i) {
            key.write(std::to_string(10000 + i).c_str(), std::string(50, 'v'));
        }
        ASSERT_EQ(transaction.commit(), 0);
    }
    tvx::registry::closeStores();
    const std::string whole = contents(m_sandbox.file);
    std::string damaged = whole;
    const std::size_t middle = whole.size() / 2 / 4096 * 4096;
    damaged.replace(middle, 4096, std::string(4096, '\xA5'));
    put(damaged);
    const TestKey key(path, TestKey::Way::Open);
    ASSERT_EQ(key.result, 0);
    int found = 0;
    for (int i = 0; i < 3000; ++i) {
        found += key.read(std::to_string(10000 + i).c_str()) == std::string(50, 'v') ? 1 : 0;
    }
    EXPECT_GT(found, 2500) << "only what was on the damaged page is lost";
    EXPECT_LT(found, 3000);
    EXPECT_EQ(notices.size(), 1u);
    ASSERT_EQ(setAside().size(), 1u);
    EXPECT_TRUE(contents(setAside().front()) == damaged);
    EXPECT_EQ(key.write("a", "1"), 0);
}

/// What may happen to the file of 400 settings, and how many of them must come through it.
struct Damage {
    const char* what;
    void (*apply)(std::string& bytes);
    int saved;
};
constexpr std::size_t pageSize = 4096;
const Damage damages[] = {
    {"its head is lost", [](std::string& bytes) { bytes.replace(0, 100, 100, 'x'); }, 400},
    {"its head names another size of pages", [](std::string& bytes) { bytes.replace(16, 2, std::string("\2\0", 2)); },
     400},
    {"its first page is lost", [](std::string& bytes) { bytes.replace(0, pageSize, pageSize, '\xA5'); }, 400},
    {"the page of the keys is lost", [](std::string& bytes) { bytes.replace(pageSize, pageSize, pageSize, 'k'); }, 400},
    {"a tenth is cut off", [](std::string& bytes) { bytes.resize(bytes.size() * 9 / 10); }, 300},
    {"half of it is cut off", [](std::string& bytes) { bytes.resize(bytes.size() / 2); }, 100},
    {"a page says that it holds nothing", [](std::string& bytes) { bytes.replace(10 * pageSize + 3, 2, 2, '\0'); },
     350},
    {"the root of the values is lost", [](std::string& bytes) { bytes.replace(4 * pageSize, 8, 8, '\xFF'); }, 380},
    {"all of it is lost", [](std::string& bytes) { bytes.assign(5000, 'x'); }, 0},
};

/// Six processes that start at once; each writes two settings.
void writeByManyAtOnce(const std::string& path, int& told) {
    std::vector<std::unique_ptr<ChildProcess>> children;
    for (int i = 0; i < 6; ++i) {
        children.push_back(std::make_unique<ChildProcess>([&, i](ChildProcess& parent) {
            static int notices;
            notices = 0;
            tvx::setRegistryNotice([](const std::string&) { ++notices; });
            (void)parent.receive();
            const TestKey key(path);
            const bool isWritten = key.write(("first" + std::to_string(i)).c_str(), "1") == 0 &&
                                   key.write(("second" + std::to_string(i)).c_str(), "2") == 0;
            tvx::registry::closeStores();
            parent.send(isWritten ? notices : 100);
        }));
    }
    for (const auto& child : children) {
        child->send(0);
    }
    for (const auto& child : children) {
        told += child->receive();
    }
}

TEST_F(RegistryFaults, OneOfSeveralProcessesMendsADamagedFile) {
    {
        const TestKey key(path);
        tvx::RegistryTransaction transaction;
        ASSERT_EQ(transaction.begin(), 0);
        for (int i = 0; i < 400; ++i) {
            key.write(("Name" + std::to_string(i)).c_str(), std::string(i == 7 ? 20000 : 200, 'v'));
        }
        ASSERT_EQ(transaction.commit(), 0);
    }
    tvx::registry::closeStores();
    const std::string whole = contents(m_sandbox.file);
    for (const Damage& damage : damages) {
        SCOPED_TRACE(damage.what);
        std::string damaged = whole;
        damage.apply(damaged);
        put(damaged);
        int told = 0;
        writeByManyAtOnce(path, told);
        EXPECT_EQ(told, 1);
        ASSERT_EQ(setAside().size(), 1u);
        EXPECT_TRUE(contents(setAside().front()) == damaged) << "kept byte for byte";
        fs::remove(setAside().front());
        int saved = 0;
        const TestKey key(path);
        for (int i = 0; i < 400; ++i) {
            const std::string value = key.read(("Name" + std::to_string(i)).c_str());
            saved += value == std::string(i == 7 ? 20000 : 200, 'v') ? 1 : 0;
        }
        EXPECT_GE(saved, damage.saved);
        for (int i = 0; i < 6; ++i) {
            EXPECT_EQ(key.read(("first" + std::to_string(i)).c_str()), "1");
            EXPECT_EQ(key.read(("second" + std::to_string(i)).c_str()), "2");
        }
    }
}

TEST_F(RegistryFaults, SeveralProcessesBeginTheFirstFileTogether) {
    for (int round = 0; round < 5; ++round) {
        int told = 0;
        writeByManyAtOnce(path, told);
        EXPECT_EQ(told, 0) << "nothing refused, nobody else's file";
        const TestKey key(path);
        for (int i = 0; i < 6; ++i) {
            EXPECT_EQ(key.read(("first" + std::to_string(i)).c_str()), "1");
            EXPECT_EQ(key.read(("second" + std::to_string(i)).c_str()), "2");
        }
        tvx::registry::closeStores();
        fs::remove_all(m_sandbox.file.parent_path());
    }
}

TEST_F(RegistryFaults, WhatAKilledWriterLeftInTheLogIsTakenOverFromADamagedFile) {
    ChildProcess writer([](ChildProcess& parent) {
        const TestKey key(path);
        key.write("a", "old");
        tvx::registry::closeStores();
        key.write("a", "new");
        parent.send(0);
        (void)parent.receive();
    });
    ASSERT_EQ(writer.receive(), 0);
    writer.kill();
    std::fstream(m_sandbox.file, std::ios::binary | std::ios::in | std::ios::out) << std::string(100, 'x');
    EXPECT_EQ(TestKey(path).read("a"), "new");
    EXPECT_EQ(TestKey(path).write("b", "1"), 0);
    EXPECT_EQ(notices.size(), 1u);
}

TEST_F(RegistryFaults, HostileContentsAreNotUsed) {
    static constexpr const char* endless =
        "WITH RECURSIVE endless (id, parent, path, name) AS (SELECT 1, 0, '', '' UNION ALL SELECT id, 1, 'software', "
        "'Software' FROM endless) SELECT * FROM endless";
    const std::string hostile[] = {
        "UPDATE key SET parent = 1 WHERE id = 1",
        "UPDATE key SET parent = id WHERE name = 'Tarvex'",
        "UPDATE key SET name = '' WHERE name = 'Tarvex'",
        std::string("ALTER TABLE key RENAME TO old; CREATE VIEW key AS ") + endless,
        "UPDATE value SET name = 'b'",
        "CREATE TRIGGER trap AFTER INSERT ON value BEGIN DELETE FROM value; END",
        "PRAGMA writable_schema = ON; UPDATE sqlite_schema SET sql = replace(sql, 'name TEXT', 'name BLOB')",
    };
    for (const std::string& sql : hostile) {
        SCOPED_TRACE(sql);
        TestKey(path).write("a", "1");
        run(m_sandbox.file, sql.c_str());
        notices.clear();
        RegistrySandbox::use(m_sandbox.file);
        HKEY software = nullptr;
        ASSERT_EQ(RegOpenKeyExA(HKEY_CURRENT_USER, "Software", 0, KEY_READ, &software), 0);
        std::array<char, 20> name{};
        DWORD size = name.size();
        EXPECT_EQ(RegEnumKeyExA(software, 1, name.data(), &size, nullptr, nullptr, nullptr, nullptr),
                  LSTATUS{ERROR_NO_MORE_ITEMS});
        RegCloseKey(software);
        EXPECT_EQ(notices.size(), 1u);
        EXPECT_EQ(TestKey(path).write("b", "2"), 0);
        EXPECT_EQ(TestKey(path).read("b"), "2");
    }
    EXPECT_EQ(setAside().size(), std::size(hostile));
    // A file that says of itself that it is one, in another encoding of texts.
    tvx::registry::closeStores();
    fs::remove(m_sandbox.file);
    run(m_sandbox.file, "PRAGMA encoding = 'UTF-16'; CREATE TABLE key (id); PRAGMA application_id = 1414944850;"
                        "PRAGMA user_version = 1");
    EXPECT_EQ(TestKey(path).write("b", "2"), 0);
    EXPECT_EQ(TestKey(path).read("b"), "2");
}

TEST_F(RegistryFaults, LinkStaysALink) {
    // The folder of the link is one, too: ".." is what stands above the folder that it leads to.
    const fs::path target = m_sandbox.folder / "away" / "elsewhere.db";
    fs::create_directories(m_sandbox.folder / "away" / "real");
    fs::create_directory_symlink(m_sandbox.folder / "away" / "real", m_sandbox.file.parent_path());
    fs::create_symlink("../elsewhere.db", m_sandbox.file);
    EXPECT_EQ(TestKey(path, TestKey::Way::Open).result, LSTATUS{ERROR_FILE_NOT_FOUND}) << "leads nowhere so far";
    EXPECT_EQ(TestKey(path).write("a", "1"), 0);
    EXPECT_TRUE(fs::exists(target));
    tvx::registry::closeStores();
    std::ofstream(target, std::ios::binary) << std::string(3000, 'x');
    EXPECT_EQ(TestKey(path).write("a", "2"), 0);
    EXPECT_TRUE(fs::is_symlink(m_sandbox.file));
    EXPECT_FALSE(fs::is_symlink(target));
    EXPECT_EQ(TestKey(path).read("a"), "2");
    EXPECT_EQ(notices.size(), 1u);
}

TEST_F(RegistryFaults, LinkIntoAMissingFolderIsLeftAlone) {
    fs::create_directories(m_sandbox.file.parent_path());
    fs::create_symlink(m_sandbox.folder / "unplugged" / "registry.db", m_sandbox.file);
    EXPECT_NE(TestKey(path).result, 0);
    EXPECT_EQ(TestKey(path).read("a"), "<6>");
    EXPECT_FALSE(fs::exists(m_sandbox.folder / "unplugged"));
    EXPECT_TRUE(fs::is_symlink(m_sandbox.file));
    EXPECT_EQ(notices.size(), 1u);
}

TEST_F(RegistryFaults, NoHomeAtAllIsToldOnceWhenSomethingIsToBeSaved) {
    if (geteuid() != 0) {
        GTEST_SKIP() << "nobody else can become a user who is not known";
    }
    ChildProcess child([](ChildProcess& parent) {
        for (const char* name : {"TVX_REGISTRY", "XDG_CONFIG_HOME", "HOME"}) {
            unsetenv(name);
        }
        if (setresuid(54321, 54321, 54321) != 0) {
            parent.send(100);
        }
        (void)TestKey(path, TestKey::Way::Open).read("a");
        const auto afterReading = notices.size();
        const bool isRefused = TestKey(path).result != 0 && TestKey(path).result != 0;
        parent.send(isRefused && afterReading == 0 ? static_cast<int>(notices.size()) : 100);
    });
    EXPECT_EQ(child.receive(), 1);
}

TEST_F(RegistryFaults, FolderInThePlaceOfTheFile) {
    fs::create_directories(m_sandbox.file / "inside");
    EXPECT_EQ(TestKey(path).result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(TestKey(path, TestKey::Way::Open).result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_TRUE(fs::exists(m_sandbox.file / "inside"));
    EXPECT_EQ(notices.size(), 1u);
    fs::remove_all(m_sandbox.file);
    EXPECT_EQ(TestKey(path).write("a", "1"), 0) << "once it is gone";
}

TEST_F(RegistryFaults, NewerVersionIsReadAndNotChanged) {
    TestKey(path).write("a", "1");
    run(m_sandbox.file, "PRAGMA user_version = 2; PRAGMA journal_mode = DELETE");
    const std::string before = contents(m_sandbox.file);
    const TestKey key(path);
    EXPECT_EQ(key.read("a"), "1");
    EXPECT_EQ(key.write("a", "2"), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_TRUE(contents(m_sandbox.file) == before);
    EXPECT_EQ(TestKey("Software\\Other").result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(notices.size(), 1u);
    run(m_sandbox.file, "ALTER TABLE value RENAME TO entry");
    EXPECT_NE(TestKey(path).read("a"), "1");
    EXPECT_EQ(notices.size(), 1u);
    EXPECT_EQ(setAside().size(), 0u);
}

TEST_F(RegistryFaults, FileOfAnotherProgramIsLeftAlone) {
    put("");
    run(m_sandbox.file, "CREATE TABLE songs (title TEXT)");
    const std::string before = contents(m_sandbox.file);
    EXPECT_EQ(TestKey(path).result, LSTATUS{ERROR_BAD_FORMAT});
    EXPECT_EQ(notices.size(), 1u);
    tvx::registry::closeStores();
    EXPECT_TRUE(contents(m_sandbox.file) == before);
}

TEST_F(RegistryFaults, EmptyFileIsANewStore) {
    put("");
    EXPECT_EQ(TestKey(path, TestKey::Way::Open).result, LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_EQ(TestKey(path).write("a", "1"), 0);
    EXPECT_TRUE(notices.empty());
}

TEST_F(RegistryFaults, ReadOnlyFileIsReadAndNobodyIsTold) {
    TestKey(path).write("a", "1");
    becomeOrdinary();
    fs::permissions(m_sandbox.file, fs::perms::owner_read);
    const TestKey key(path);
    EXPECT_EQ(key.read("a"), "1");
    EXPECT_EQ(key.write("a", "2"), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(TestKey("Software\\Other").result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_TRUE(notices.empty());
}

TEST_F(RegistryFaults, ReadOnlyFolderIsReadWithWhatAKilledWriterLeft) {
    ChildProcess writer([](ChildProcess& parent) {
        TestKey(path).write("a", "1");
        parent.send(0);
        (void)parent.receive();
    });
    ASSERT_EQ(writer.receive(), 0);
    writer.kill();
    const fs::path run = m_sandbox.folder / "run";
    const fs::path left = run / "tvx-settings-aaaaaa";
    fs::create_directories(left);
    std::ofstream(left / "registry.db") << "of a process that was ended from outside";
    setenv("XDG_RUNTIME_DIR", run.c_str(), 1);
    becomeOrdinary();
    const fs::path folder = m_sandbox.file.parent_path();
    fs::remove(m_sandbox.file.string() + "-shm");
    fs::permissions(folder, fs::perms::owner_read | fs::perms::owner_exec);
    const TestKey key(path);
    EXPECT_EQ(key.read("a"), "1");
    EXPECT_EQ(key.write("a", "2"), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_TRUE(notices.empty());
    EXPECT_FALSE(fs::exists(left));
    EXPECT_FALSE(fs::is_empty(run)) << "our own copy";
    fs::permissions(folder, fs::perms::owner_all);
    EXPECT_EQ(key.write("a", "2"), 0) << "as soon as it is possible";
    EXPECT_EQ(key.read("a"), "2");
}

TEST_F(RegistryFaults, UnreadableFileIsToldOnceAndLeftAlone) {
    TestKey(path).write("a", "1");
    becomeOrdinary();
    fs::permissions(m_sandbox.file, fs::perms::none);
    EXPECT_EQ(TestKey(path).result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(TestKey(path).result, LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_EQ(notices.size(), 1u);
    fs::permissions(m_sandbox.file, fs::perms::owner_read | fs::perms::owner_write);
    EXPECT_EQ(TestKey(path).read("a"), "1");
}

/// Runs on a disk of 256 KiB in a name space of its own.
class RegistryOnFullDisk : public RegistryFaults {
protected:
    void SetUp() override {
        m_disk = m_sandbox.folder / "disk";
        fs::create_directories(m_disk);
        if (unshare(CLONE_NEWNS) != 0 || mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0 ||
            mount("none", m_disk.c_str(), "tmpfs", 0, "size=256k,mode=0700") != 0) {
            GTEST_SKIP() << "disks cannot be mounted here";
        }
        RegistrySandbox::use(m_disk / "registry.db");
    }
    void TearDown() override {
        tvx::registry::closeStores();
        umount(m_disk.c_str());
    }
    void fill() const {
        std::ofstream stream(m_disk / "ballast");
        while (stream << "x" << std::flush) {
        }
    }

    fs::path m_disk;
};

TEST_F(RegistryOnFullDisk, WhatDoesNotFitIsToldOnceAndTheRestStays) {
    const TestKey key(path);
    int kept = 0;
    while (kept < 1000 && key.write(std::to_string(kept).c_str(), std::string(2000, 'v')) == 0) {
        ++kept;
    }
    ASSERT_LT(kept, 1000);
    EXPECT_EQ(key.write("another", std::string(9000, 'v')), LSTATUS{ERROR_DISK_FULL});
    EXPECT_EQ(notices.size(), 1u);
    RegistrySandbox::use(m_disk / "." / "registry.db"); // another name, so the fault is a new one
    {
        tvx::RegistryTransaction transaction;
        EXPECT_EQ(transaction.begin(), 0);
        for (int i = 0; i < 100; ++i) {
            (void)key.write(("more" + std::to_string(i)).c_str(), std::string(20000, 'v'));
        }
        EXPECT_EQ(notices.size(), 1u) << "nobody is told while others wait";
        EXPECT_NE(transaction.commit(), 0);
    }
    EXPECT_EQ(notices.size(), 2u);
    for (int i = 0; i < kept; ++i) {
        EXPECT_EQ(key.read(std::to_string(i).c_str()), std::string(2000, 'v'));
    }
}

TEST_F(RegistryOnFullDisk, StartsOnADiskThatIsFull) {
    TestKey(path).write("a", "1");
    tvx::registry::closeStores();
    fill();
    const TestKey key(path);
    EXPECT_EQ(key.read("a"), "1");
    EXPECT_EQ(key.write("a", "2"), LSTATUS{ERROR_DISK_FULL});
    EXPECT_EQ(key.read("a"), "1");
    EXPECT_EQ(notices.size(), 1u);
    fs::remove(m_disk / "ballast");
    EXPECT_EQ(key.write("a", "2"), 0) << "as soon as there is room";
    EXPECT_EQ(key.read("a"), "2");
}

TEST_F(RegistryOnFullDisk, DamageThatCannotBeSetAsideIsToldOnceAndMendedLater) {
    TestKey(path).write("a", "1");
    tvx::registry::closeStores();
    const fs::path file = m_disk / "registry.db";
    std::fstream(file, std::ios::in | std::ios::out | std::ios::binary) << std::string(100, 'x');
    fill();
    const std::string damaged = contents(file);
    EXPECT_NE(TestKey(path).result, 0);
    EXPECT_NE(TestKey(path).result, 0);
    EXPECT_EQ(notices.size(), 1u);
    EXPECT_TRUE(contents(file) == damaged);
    fs::remove(m_disk / "ballast");
    const TestKey key(path);
    EXPECT_EQ(key.read("a"), "1") << "as soon as there is room for the copy";
    EXPECT_EQ(key.write("a", "2"), 0);
    ASSERT_EQ(setAside(m_disk).size(), 1u);
    EXPECT_TRUE(contents(setAside(m_disk).front()) == damaged);
}

TEST_F(RegistryOnFullDisk, AFileThatCannotBeBegunIsTold) {
    fill();
    EXPECT_NE(TestKey(path).result, 0);
    EXPECT_EQ(notices.size(), 1u);
    fs::remove(m_disk / "ballast");
    EXPECT_EQ(TestKey(path).write("a", "1"), 0);
}

} // namespace
