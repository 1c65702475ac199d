// Several processes with one store.
#include "platform/win/Registry.h"

#include "ChildProcess.h"
#include "RegistrySandbox.h"
#include "platform/win/detail/LogHead.h"

#include <array>
#include <chrono>
#include <fstream>
#include <memory>
#include <vector>

namespace {

class RegistrySharing : public ::testing::Test {
protected:
    static constexpr const char* path = "Software\\Tarvex\\Shared";

    RegistrySandbox m_sandbox;
};

TEST_F(RegistrySharing, SeesWhatAnotherProcessWroteAtOnce) {
    const TestKey key(path);
    key.write("a", "0");
    ChildProcess writer([](ChildProcess& parent) {
        const TestKey own(path);
        for (int i = parent.receive(); i >= 0; i = parent.receive()) {
            own.write("a", std::to_string(i));
            if (i % 5 == 0) {
                RegDeleteValueA(own.handle, "a");
            }
            if (i % 7 == 0) {
                tvx::registry::closeStores(); // as if it were another process each time
            }
            parent.send(i);
        }
    });
    for (int i = 1; i <= 200; ++i) {
        EXPECT_EQ(key.read("a"), (i - 1) % 5 == 0 && i > 1 ? "<2>" : std::to_string(i - 1));
        writer.send(i);
        ASSERT_EQ(writer.receive(), i);
        EXPECT_EQ(key.read("a"), i % 5 == 0 ? "<2>" : std::to_string(i));
    }
}

TEST_F(RegistrySharing, ReliesOnTheHeadOfTheLogOnlyInTheFormatItKnows) {
    using tvx::registry::LogHead;
    using tvx::registry::readLogHead;
    std::array<std::uint32_t, 2 * std::tuple_size_v<LogHead>> words{};
    const auto load = [&] {
        std::ifstream index(m_sandbox.file.string() + "-shm", std::ios::binary);
        index.read(reinterpret_cast<char*>(words.data()), sizeof words);
        return readLogHead(words.data());
    };
    const TestKey key(path);
    key.write("a", "1");
    const std::optional<LogHead> before = load();
    ASSERT_TRUE(before) << "the database here writes another format: settings are read without their memory";
    key.write("a", "2");
    const std::optional<LogHead> after = load();
    ASSERT_TRUE(after);
    EXPECT_NE(*before, *after);

    words[0] = words[words.size() / 2] = tvx::registry::logHeadVersion + 1;
    EXPECT_FALSE(readLogHead(words.data())) << "another version";
    (void)load();
    ++words[2];
    EXPECT_FALSE(readLogHead(words.data())) << "a writer at work: the copies differ";
}

TEST_F(RegistrySharing, AsksTheDatabaseWhenTheHeadOfTheLogIsOfAnotherVersion) {
    const TestKey key(path);
    key.write("a", "old");
    EXPECT_EQ(key.read("a"), "old"); // remembered under this head
    std::fstream index(m_sandbox.file.string() + "-shm", std::ios::binary | std::ios::in | std::ios::out);
    const std::uint32_t other = tvx::registry::logHeadVersion + 1;
    for (const std::size_t copy : {std::size_t{0}, sizeof(tvx::registry::LogHead)}) {
        index.seekp(static_cast<std::streamoff>(copy));
        index.write(reinterpret_cast<const char*>(&other), sizeof other);
    }
    index.close();
    // The database finds that the head is not right and makes it anew from the log.
    EXPECT_EQ(key.read("a"), "old");
    EXPECT_TRUE(ChildProcess([](ChildProcess&) { TestKey(path).write("a", "new"); }).end());
    EXPECT_EQ(key.read("a"), "new");
}

TEST_F(RegistrySharing, SeesThatAnotherFileHasTakenThePlace) {
    const TestKey key(path);
    key.write("a", "old");
    EXPECT_EQ(key.read("a"), "old");
    std::filesystem::remove_all(m_sandbox.file.parent_path());
    EXPECT_EQ(TestKey(path, TestKey::Way::Open).result, LSTATUS{ERROR_FILE_NOT_FOUND});
    EXPECT_TRUE(ChildProcess([](ChildProcess&) { TestKey(path).write("a", "new"); }).end());
    EXPECT_EQ(key.read("a"), "new");
    EXPECT_EQ(key.write("a", "newer"), 0);
    tvx::registry::closeStores();
    EXPECT_EQ(key.read("a"), "newer");
}

/// Writes a value. A process that is slowed down a lot (valgrind) may wait for the others until its patience ends;
/// whatever is refused earlier, or for another reason, is a fault.
LSTATUS writeWithPatience(const std::string& path, const std::string& name, const std::string& text, int& faults) {
    constexpr std::chrono::seconds patience(5);
    const auto begun = std::chrono::steady_clock::now();
    const TestKey key(path);
    const LSTATUS result = key.result == 0 ? key.write(name.c_str(), text) : key.result;
    const bool waited = std::chrono::steady_clock::now() - begun >= patience;
    faults += result == 0 || (result == ERROR_BUSY && waited) ? 0 : 1;
    return result;
}

TEST_F(RegistrySharing, LosesNoWriteOfSeveralProcesses) {
    constexpr int processes = 4;
    constexpr int writes = 150;
    const auto keyOf = [](int i) { return std::string(path) + "\\" + std::to_string(i % 10); };
    const auto nameOf = [](int process, int i) { return std::to_string(process) + "." + std::to_string(i); };
    std::vector<std::unique_ptr<ChildProcess>> writers;
    for (int process = 0; process < processes; ++process) {
        writers.push_back(std::make_unique<ChildProcess>([&, process](ChildProcess& parent) {
            (void)parent.receive(); // all begin together, with a store that does not exist
            int faults = 0;
            for (int i = 0; i < writes; ++i) {
                const LSTATUS result = writeWithPatience(keyOf(i), nameOf(process, i), "x", faults);
                writeWithPatience(keyOf(i), "everybody's", std::string(2000, static_cast<char>('a' + process)), faults);
                parent.send(result);
            }
            parent.send(faults);
        }));
    }
    for (const auto& writer : writers) {
        writer->send(0);
    }
    std::vector<std::vector<int>> results(processes, std::vector<int>(writes));
    for (int process = 0; process < processes; ++process) {
        for (int& result : results[process]) {
            result = writers[process]->receive();
        }
        EXPECT_EQ(writers[process]->receive(), 0);
        EXPECT_TRUE(writers[process]->end());
    }
    for (int process = 0; process < processes; ++process) {
        for (int i = 0; i < writes; ++i) {
            EXPECT_EQ(TestKey(keyOf(i)).read(nameOf(process, i).c_str()), results[process][i] == 0 ? "x" : "<2>");
        }
    }
    const std::string last = TestKey(keyOf(0)).read("everybody's");
    EXPECT_EQ(last, std::string(2000, last[0])) << "half a value";
}

TEST_F(RegistrySharing, KeepsWhatWasWrittenBeforeAProcessWasKilled) {
    for (int round = 0; round < 15; ++round) {
        ChildProcess writer([](ChildProcess& parent) {
            const TestKey own(path);
            for (int i = 1;; ++i) {
                if (own.write("a", std::to_string(i)) != 0 || own.write("b", std::string(i % 9000, 'b')) != 0) {
                    std::_Exit(2);
                }
                parent.send(i);
            }
        });
        int acknowledged = 0;
        while (acknowledged < 3 + 7 * round) {
            acknowledged = writer.receive();
        }
        ASSERT_GT(acknowledged, 0);
        writer.kill();
        for (int i = writer.receive(); i >= 0; i = writer.receive()) {
            acknowledged = i;
        }
        const int kept = std::stoi(TestKey(path).read("a"));
        EXPECT_GE(kept, acknowledged);
        EXPECT_LE(kept, acknowledged + 1);
    }
}

TEST_F(RegistrySharing, GivesUpOnAWriterThatDoesNotEnd) {
    const TestKey key(path);
    key.write("a", "1");
    ChildProcess writer([](ChildProcess& parent) {
        tvx::RegistryTransaction transaction;
        const LSTATUS begun = transaction.begin();
        TestKey(path).write("a", "2");
        parent.send(begun);
        (void)parent.receive();
    });
    ASSERT_EQ(writer.receive(), 0);
    EXPECT_EQ(key.read("a"), "1") << "readers need not wait";
    testing::internal::CaptureStderr();
    EXPECT_EQ(key.write("a", "3"), LSTATUS{ERROR_BUSY});
    for (int i = 0; i < 40; ++i) { // longer than a test may take, if each waited
        EXPECT_EQ(key.write(std::to_string(i).c_str(), "3"), LSTATUS{ERROR_BUSY}) << "nobody waits a second time";
    }
    EXPECT_NE(testing::internal::GetCapturedStderr().find("could not be saved"), std::string::npos);
    writer.kill();
    EXPECT_EQ(key.write("a", "3"), 0);
    EXPECT_EQ(key.read("a"), "3");
}

TEST_F(RegistrySharing, LeavesATransactionToTheProcessThatBeganIt) {
    const TestKey key(path);
    tvx::RegistryTransaction transaction;
    ASSERT_EQ(transaction.begin(), 0);
    key.write("a", "1");
    ChildProcess child([&](ChildProcess& parent) { parent.send(key.write("a", "2")); });
    EXPECT_EQ(child.receive(), LSTATUS{ERROR_ACCESS_DENIED});
    EXPECT_TRUE(child.end());
    EXPECT_EQ(transaction.commit(), 0);
    EXPECT_EQ(key.read("a"), "1");
}

} // namespace
