#include "platform/win/detail/RegistryConnection.h"
#include "platform/win/detail/RegistryMemory.h"
#include "platform/win/detail/RegistrySchema.h"
#include "platform/win/detail/RegistryStore.h"

#include <cstdlib>
#include <pthread.h>

namespace tvx::registry {

namespace {

struct Stores {
    Store user{Hive::User};
    Store machine{Hive::Machine};
};

/// Never destroyed: objects that end later than this may still keep their settings.
Stores& stores();

/// The database must not be carried over a fork, not even to be closed in the child: both would believe in locks that
/// only one of them has. So it is closed before, and each of the two opens it again when it needs it.
void beforeFork() {
    for (Store* store : {&stores().user, &stores().machine}) {
        store->mutex.lock();
        store->close(Store::Log::Keep);
    }
}

void afterForkInParent() {
    for (Store* store : {&stores().user, &stores().machine}) {
        store->mutex.unlock();
    }
}

void afterForkInChild() {
    for (Store* store : {&stores().user, &stores().machine}) {
        store->leaveToParent();
        store->mutex.unlock();
    }
}

Stores& stores() {
    static Stores* const all = [] {
        pthread_atfork(&beforeFork, &afterForkInParent, &afterForkInChild);
        std::atexit(&closeStores);
        return new Stores;
    }();
    return *all;
}

} // namespace

Store::Store(Hive hive) : m_hive(hive), m_memory(std::make_unique<Memory>()) {}

Store::~Store() = default;

Store& Store::of(Hive hive) {
    return hive == Hive::User ? stores().user : stores().machine;
}

void closeStores() {
    for (Store* store : {&stores().user, &stores().machine}) {
        const std::lock_guard lock(store->mutex);
        store->close();
        store->forgetChecks();
    }
}

void Store::close(Log log) {
    if (m_inTransaction) {
        return;
    }
    if (m_connection) {
        closeConnection(log);
    }
    m_memory->replies.clear();
    m_memory->watch = Memory::Watch::None;
    m_copy.reset();
    m_mode = Mode::Closed;
}

void Store::closeConnection(Log log) {
    // Merging deletes the log by its name. Where another file has taken the place, that would be the other file's.
    if (log == Log::Keep || m_mode != Mode::Shared || !isCurrent()) {
        m_connection->keepLogOnClose();
    }
    m_connection.reset();
}

void Store::leaveToParent() {
    m_isLost = m_inTransaction;
}

bool Store::isCurrent() const {
    switch (m_mode) {
    case Mode::Closed:
        return false;
    case Mode::Copy:
        return m_stamp == stampOf(m_file) && m_logStamp == stampOf(m_file + "-wal");
    default:
        return m_identity == identityOf(m_name);
    }
}

DWORD Store::ensureOpen(Intent intent) {
    if (m_isLost || (intent == Intent::Write && m_hive == Hive::Machine)) {
        return ERROR_ACCESS_DENIED;
    }
    if (m_inTransaction) {
        return ERROR_SUCCESS;
    }
    // What could not be written before may have become possible.
    const bool isEnough = m_mode == Mode::Shared || intent == Intent::Read;
    return isEnough && isCurrent() ? ERROR_SUCCESS : open(intent);
}

DWORD Store::open(Intent intent) {
    close();
    m_name = locate(m_hive);
    if (m_name.empty() && intent == Intent::Write) {
        tell(Fault::NotSaved, "Settings cannot be saved: there is no folder to keep them in.");
    }
    if (m_name.empty()) {
        return intent == Intent::Read ? ERROR_FILE_NOT_FOUND : ERROR_PATH_NOT_FOUND;
    }
    m_file = resolve(m_name);
    const FileKind kind = kindOf(m_file);
    if (kind == FileKind::Missing) {
        if (intent == Intent::Read) {
            return ERROR_FILE_NOT_FOUND;
        }
        if (const DWORD result = createFile(); result != ERROR_SUCCESS) {
            return result;
        }
    } else if (kind != FileKind::Regular) {
        tell(Fault::Unusable, "The settings cannot be used: " + m_name +
                                  (kind == FileKind::Other ? " is no file." : " cannot be reached."));
        return ERROR_ACCESS_DENIED;
    }
    return openFile(intent);
}

DWORD Store::createFile() {
    // A link that leads nowhere says where the file is wanted, but a missing folder there may be a disk that is not in
    // its place at the moment.
    DWORD result = m_file == m_name ? makeFolderOf(m_file) : ERROR_SUCCESS;
    if (result == ERROR_SUCCESS) {
        result = makeFile(m_file);
    }
    if (result != ERROR_SUCCESS) {
        tell(Fault::NotSaved, "Settings cannot be saved: " + m_file + " cannot be made. " + errorText(result));
    }
    return result;
}

DWORD Store::openFile(Intent intent) {
    m_writeError = ERROR_ACCESS_DENIED;
    const DWORD result = connect(m_file);
    if (result == ERROR_SUCCESS || result == ERROR_REGISTRY_CORRUPT) {
        return result;
    }
    close(Log::Keep);
    if (m_identity == FileIdentity{} || m_identity != identityOf(m_name)) {
        return open(intent); // somebody has taken it away just now
    }
    const bool isPlaceBad =
        result == ERROR_ACCESS_DENIED || result == ERROR_DISK_FULL || result == ERROR_REGISTRY_IO_FAILED;
    return isPlaceBad ? openCopy(result) : result;
}

DWORD Store::connect(const std::string& file) {
    m_identity = identityOf(m_name); // first: should another file come in between, it is noticed by the next call
    m_connection = std::make_unique<Connection>();
    DWORD result = failed(m_connection->open(file, m_waiting));
    if (result == ERROR_SUCCESS) {
        result = checkSchema();
    }
    if (result != ERROR_SUCCESS) {
        return result;
    }
    m_memory->watch = m_copy                     ? Memory::Watch::Nothing
                      : m_connection->shareLog() ? Memory::Watch::Log
                                                 : Memory::Watch::None;
    return ERROR_SUCCESS;
}

std::optional<Store::Head> Store::head() {
    const auto id = m_connection->number("PRAGMA application_id");
    const auto version = id ? m_connection->number("PRAGMA user_version") : std::nullopt;
    const auto tables = version ? m_connection->number("SELECT count(*) FROM sqlite_schema") : std::nullopt;
    return tables ? std::optional(Head{*id, *version, *tables}) : std::nullopt;
}

DWORD Store::checkSchema() {
    // All from one moment: another process may be making the store right now.
    (void)m_connection->execute("BEGIN");
    const std::optional<Head> found = head();
    const DWORD result = found ? ERROR_SUCCESS : failed(m_connection->error());
    (void)m_connection->execute("COMMIT");
    if (!found) {
        return result;
    }
    if (found->id != schema::applicationId && !found->isNew()) {
        tell(Fault::Unusable, "The settings cannot be used: " + m_file + " belongs to another program.");
        return ERROR_BAD_FORMAT;
    }
    const bool isForReading = m_connection->isReadOnly() || m_hive == Hive::Machine || isOfNewerVersion(found->version);
    m_mode = m_copy ? Mode::Copy : isForReading ? Mode::ReadOnly : Mode::Shared;
    if (m_mode == Mode::Shared) {
        chooseJournal();
    }
    return found->isNew() ? initialise() : checkContents(found->version);
}

bool Store::isOfNewerVersion(std::int64_t version) {
    if (version <= schema::version) {
        return false;
    }
    tell(Fault::Newer, "The settings in " + m_file +
                           " were written by a newer version of this software. They are read as far as possible and "
                           "not changed.");
    return true;
}

void Store::chooseJournal() {
    const char* wanted = allowsSharedMemory(m_file) ? "wal" : "delete";
    if (m_connection->text("PRAGMA journal_mode") == wanted) {
        return;
    }
    // Where the file is in use this fails, and it stays as it is: every kind is safe, some are only slower.
    (void)m_connection->execute((std::string("PRAGMA journal_mode = ") + wanted).c_str());
}

DWORD Store::initialise() {
    if (m_mode != Mode::Shared) {
        return ERROR_FILE_NOT_FOUND;
    }
    return together([&]() -> DWORD {
        const std::optional<Head> found = head();
        if (!found || !found->isNew()) {
            return found ? ERROR_SUCCESS : failed(m_connection->error()); // another process was faster
        }
        return failed(m_connection->execute(schema::make));
    });
}

DWORD Store::openCopy(DWORD reason) {
    m_writeError = reason;
    m_stamp = stampOf(m_file);
    m_logStamp = stampOf(m_file + "-wal");
    if (m_stamp.size == 0) {
        return reason; // there is nothing to be read
    }
    m_copy = std::make_unique<FileCopy>(m_file);
    if (!m_copy->name().empty() && connect(m_copy->name()) == ERROR_SUCCESS && isCurrent()) {
        return ERROR_SUCCESS;
    }
    close();
    // What a full disk lets nobody read cannot be written either: that is told once.
    tell(reason == ERROR_DISK_FULL ? Fault::NotSaved : Fault::Unusable,
         "The settings in " + m_file + " cannot be read. " + errorText(reason));
    return reason;
}

} // namespace tvx::registry
