#pragma once

#include "platform/base/Export.h"
#include "platform/win/Error.h"
#include "platform/win/detail/Patience.h"
#include "platform/win/detail/RegistryFile.h"
#include "platform/win/detail/RegistryPath.h"
#include "platform/win/detail/RegistryValue.h"

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <unordered_map>
#include <utility>
#include <vector>

namespace tvx::registry {

class Connection;
struct Salvage;

/// Where an enumeration stands, so that the next name is found without counting from the beginning.
struct Cursor {
    DWORD index = 0;
    std::string folded; ///< name of the entry at `index`
    bool isSet = false;
};

/// A mutex that its owner may lock again, and that can be let go in the child of a fork.
class StoreMutex {
public:
    void lock();
    void unlock();
    [[nodiscard]] bool isMine() const {
        return m_owner.load(std::memory_order_relaxed) == std::this_thread::get_id();
    }

private:
    std::mutex m_mutex;
    std::atomic<std::thread::id> m_owner;
    int m_depth = 0;
};

/// The settings of one hive. There is one object a hive and process; it opens its file when it is first needed and
/// again when another file has taken its place.
///
/// The operations answer the platform's numbers. They are to be called with the mutex locked; what the user is to be
/// told meanwhile is taken from takeNotices() after it is unlocked.
class Store {
public:
    explicit Store(Hive hive);
    ~Store();
    Store(const Store&) = delete;
    Store& operator=(const Store&) = delete;

    /// The process's store.
    static Store& of(Hive hive);

    StoreMutex mutex;

    [[nodiscard]] DWORD findKey(const KeyPath& key);
    [[nodiscard]] DWORD createKey(const KeyPath& key, bool& created);
    [[nodiscard]] DWORD deleteKey(const KeyPath& key);
    [[nodiscard]] DWORD readValue(const KeyPath& key, std::string_view name, std::shared_ptr<const Value>& value);
    [[nodiscard]] DWORD writeValue(const KeyPath& key, const Value& value);
    [[nodiscard]] DWORD deleteValue(const KeyPath& key, std::string_view name);
    /// The name of the key at `index` below `key`.
    [[nodiscard]] DWORD keyAt(const KeyPath& key, DWORD index, Cursor& cursor, std::string& name);
    /// The value at `index` of `key`.
    [[nodiscard]] DWORD valueAt(const KeyPath& key, DWORD index, Cursor& cursor, Value& value);

    [[nodiscard]] DWORD begin();
    [[nodiscard]] DWORD commit();
    void rollback();

    /// What happens to the log on closing: brought into the file by the last process, or left as it is.
    enum class Log { Merge, Keep };
    /// Closes the file; the next operation opens it again. Does nothing within a transaction.
    void close(Log log = Log::Merge);
    /// Looks at the contents again when the file is opened next, as another process would.
    void forgetChecks() {
        m_checked = {};
    }
    /// Leaves an open transaction to the process that this one is a fork of.
    void leaveToParent();

    /// What the user is to be told; nothing within a transaction, while others wait.
    [[nodiscard]] std::vector<std::string> takeNotices();

private:
    enum class Intent { Read, Write };
    /// How the open file can be used.
    enum class Mode { Closed, Shared, ReadOnly, Copy };
    /// Faults that last, so that the user is told once about each.
    enum class Fault { Unusable, Newer, NotSaved };

    /// What a question was answered with.
    struct Reply {
        DWORD result = 0;
        std::shared_ptr<const Value> value;
    };
    using Replies = std::unordered_map<std::string, Reply>;
    struct Memory;

    template <typename Operation>
    DWORD run(Intent intent, Operation operation);
    template <typename Operation>
    DWORD change(Operation operation);
    DWORD written(DWORD result);
    DWORD together(const std::function<DWORD()>& operation);
    template <typename Question>
    Reply remembered(std::string_view subject, std::string_view detail, Question question);
    Reply askKey(std::string_view path);
    Reply askValue(std::string_view path, std::string_view folded);
    DWORD insertValue(std::string_view path, std::string_view folded, const Value& value);
    DWORD addLevels(const KeyPath& key);
    DWORD removeKey(const KeyPath& key);
    /// The replies to what was asked since anybody's last write; null when that cannot be told cheaply.
    Replies* replies();

    void closeConnection(Log log);
    DWORD ensureOpen(Intent intent);
    DWORD open(Intent intent);
    DWORD openFile(Intent intent);
    DWORD connect(const std::string& file);
    DWORD checkSchema();
    /// What a file says of itself; nothing when it cannot be asked.
    struct Head {
        std::int64_t id = 0;
        std::int64_t version = 0;
        std::int64_t tables = 0;

        [[nodiscard]] bool isNew() const {
            return id == 0 && tables == 0;
        }
    };
    [[nodiscard]] std::optional<Head> head();
    DWORD checkContents(std::int64_t version);
    [[nodiscard]] bool isOfNewerVersion(std::int64_t version);
    DWORD initialise();
    DWORD openCopy(DWORD reason);
    DWORD createFile();
    DWORD replaceDamaged();
    DWORD beginAnew();
    DWORD takeOver(const Salvage& found, std::size_t& saved);
    void chooseJournal();
    [[nodiscard]] bool isCurrent() const;

    /// The platform's number for a result of the database.
    DWORD failed(int result);
    void tell(Fault fault, std::string text);

    const Hive m_hive;
    std::string m_name; ///< where the file is expected
    std::string m_file; ///< where links lead from there
    FileIdentity m_identity;
    FileIdentity m_checked; ///< the file whose contents have been looked at
    FileStamp m_stamp;
    FileStamp m_logStamp;
    Mode m_mode = Mode::Closed;
    DWORD m_writeError = ERROR_ACCESS_DENIED; ///< what a write is answered where none is possible
    bool m_inTransaction = false;
    bool m_isLost = false; ///< the process is the child of one that forked within a transaction
    Waiting m_waiting;
    std::unique_ptr<Connection> m_connection;
    std::unique_ptr<FileCopy> m_copy;
    std::unique_ptr<Memory> m_memory;
    std::vector<std::string> m_notices;
    std::set<std::pair<Fault, std::string>> m_told; ///< with the file's name
};

/// Closes the files of all hives, as at the end of the process. They are opened again when needed.
TVX_PLATFORM_API void closeStores();

} // namespace tvx::registry
