#include "platform/win/detail/RegistryConnection.h"

#include <algorithm>

namespace tvx::registry {

namespace {

constexpr std::array<const char*, static_cast<std::size_t>(Sql::Count)> statements = {
    // findKey
    "SELECT id FROM key WHERE path = ?1",
    // addKey: parent's path, path, name
    "INSERT INTO key (parent, path, name) SELECT id, ?2, ?3 FROM key WHERE path = ?1 ON CONFLICT (path) DO NOTHING",
    // deleteKey
    "DELETE FROM key WHERE path = ?1",
    // deleteValues
    "DELETE FROM value WHERE key = (SELECT id FROM key WHERE path = ?1)",
    // hasSubKeys
    "SELECT EXISTS (SELECT 1 FROM key WHERE parent = (SELECT id FROM key WHERE path = ?1))",
    // keyAfter
    "SELECT name, path FROM key WHERE parent = (SELECT id FROM key WHERE path = ?1) AND path > ?2"
    " ORDER BY path LIMIT 1",
    // keyAt
    "SELECT name, path FROM key WHERE parent = (SELECT id FROM key WHERE path = ?1) ORDER BY path LIMIT 1 OFFSET ?2",
    // readValue
    "SELECT v.name, v.type, v.data FROM key k JOIN value v ON v.key = k.id WHERE k.path = ?1 AND v.folded = ?2",
    // writeValue
    "INSERT INTO value (key, folded, name, type, data) SELECT id, ?2, ?3, ?4, ?5 FROM key WHERE path = ?1"
    " ON CONFLICT (key, folded) DO UPDATE SET type = excluded.type, data = excluded.data",
    // deleteValue
    "DELETE FROM value WHERE key = (SELECT id FROM key WHERE path = ?1) AND folded = ?2",
    // valueAfter
    "SELECT name, type, data, folded FROM value WHERE key = (SELECT id FROM key WHERE path = ?1) AND folded > ?2"
    " ORDER BY folded LIMIT 1",
    // valueAt
    "SELECT name, type, data, folded FROM value WHERE key = (SELECT id FROM key WHERE path = ?1)"
    " ORDER BY folded LIMIT 1 OFFSET ?2",
    "BEGIN IMMEDIATE",
    "COMMIT",
    "ROLLBACK",
};

/// Called by the database while another process writes; `tries` begins anew with each wait.
int waitForOthers(void* context, int tries) {
    return static_cast<Waiting*>(context)->wait(tries == 0) ? 1 : 0;
}

constexpr const char* manner = "PRAGMA temp_store = MEMORY; PRAGMA synchronous = FULL";

} // namespace

Query& Query::bind(std::string_view text) {
    sqlite3_bind_text(m_statement, ++m_bound, text.data() ? text.data() : "", static_cast<int>(text.size()),
                      SQLITE_STATIC);
    return *this;
}

Query& Query::bindBytes(std::string_view bytes) {
    if (bytes.empty()) {
        sqlite3_bind_zeroblob(m_statement, ++m_bound, 0);
    } else {
        sqlite3_bind_blob64(m_statement, ++m_bound, bytes.data(), bytes.size(), SQLITE_STATIC);
    }
    return *this;
}

Query& Query::bind(std::int64_t number) {
    sqlite3_bind_int64(m_statement, ++m_bound, number);
    return *this;
}

std::string_view Query::bytes(int column) const {
    const void* data = sqlite3_column_blob(m_statement, column);
    const int size = sqlite3_column_bytes(m_statement, column);
    return data ? std::string_view(static_cast<const char*>(data), static_cast<std::size_t>(size)) : std::string_view();
}

Connection::~Connection() {
    for (sqlite3_stmt* statement : m_statements) {
        sqlite3_finalize(statement);
    }
    sqlite3_close(m_database);
}

int Connection::open(const std::string& file, Waiting& waiting) {
    // A file that may not be written is opened for reading by the database itself.
    const int result = sqlite3_open_v2(file.c_str(), &m_database,
                                       SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_PRIVATECACHE, nullptr);
    if (result != SQLITE_OK) {
        return result;
    }
    sqlite3_extended_result_codes(m_database, 1);
    sqlite3_busy_handler(m_database, &waitForOthers, &waiting);
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
    return execute(manner);
}

int Connection::openToReplace(const std::string& file, Waiting& waiting) {
    // This looks at the file as far as it can be, and so shares its log with others.
    (void)open(file, waiting);
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_RESET_DATABASE, 1, nullptr);
    return execute(manner);
}

int Connection::execute(const char* sql) {
    return sqlite3_exec(m_database, sql, nullptr, nullptr, nullptr);
}

std::optional<std::int64_t> Connection::number(const char* sql) {
    sqlite3_stmt* statement = nullptr;
    if (sqlite3_prepare_v2(m_database, sql, -1, &statement, nullptr) != SQLITE_OK) {
        return std::nullopt;
    }
    std::optional<std::int64_t> answer;
    if (sqlite3_step(statement) == SQLITE_ROW) {
        answer = sqlite3_column_int64(statement, 0);
    }
    sqlite3_finalize(statement);
    return answer;
}

std::optional<std::string> Connection::text(const char* sql) {
    sqlite3_stmt* statement = nullptr;
    if (sqlite3_prepare_v2(m_database, sql, -1, &statement, nullptr) != SQLITE_OK) {
        return std::nullopt;
    }
    const int step = sqlite3_step(statement);
    std::optional<std::string> answer;
    if (step == SQLITE_ROW || step == SQLITE_DONE) {
        const unsigned char* text = step == SQLITE_ROW ? sqlite3_column_text(statement, 0) : nullptr;
        answer = text ? reinterpret_cast<const char*>(text) : "";
    }
    sqlite3_finalize(statement);
    return answer;
}

Query Connection::query(Sql sql) {
    const auto index = static_cast<std::size_t>(sql);
    sqlite3_stmt*& statement = m_statements[index];
    int result = SQLITE_OK;
    if (!statement) {
        result = sqlite3_prepare_v3(m_database, statements[index], -1, SQLITE_PREPARE_PERSISTENT, &statement, nullptr);
    }
    return {statement, result};
}

int Query::step() {
    return m_statement ? sqlite3_step(m_statement) : m_error;
}

sqlite3_file* Connection::file() const {
    sqlite3_file* file = nullptr;
    const int result = sqlite3_file_control(m_database, "main", SQLITE_FCNTL_FILE_POINTER, &file);
    return result == SQLITE_OK && file && file->pMethods ? file : nullptr;
}

std::optional<std::string> Connection::fileBytes() const {
    constexpr sqlite3_int64 most = 1 << 30;
    constexpr sqlite3_int64 step = 4096;
    sqlite3_file* const opened = file();
    sqlite3_int64 size = 0;
    if (!opened || opened->pMethods->xFileSize(opened, &size) != SQLITE_OK || size > most) {
        return std::nullopt;
    }
    std::string bytes(static_cast<std::size_t>(size), '\0');
    for (sqlite3_int64 at = 0; at < size; at += step) {
        const auto length = static_cast<int>(std::min(step, size - at));
        (void)opened->pMethods->xRead(opened, bytes.data() + at, length, at);
    }
    return bytes;
}

Replacement::Replacement(Connection& file, Connection& fresh)
    : m_backup(sqlite3_backup_init(file.m_database, "main", fresh.m_database, "main")) {}

Replacement::~Replacement() {
    sqlite3_backup_finish(m_backup);
}

int Replacement::begin() {
    return m_backup ? sqlite3_backup_step(m_backup, 0) : SQLITE_NOMEM;
}

int Replacement::end() {
    constexpr int allPages = -1;
    const int result = sqlite3_backup_step(m_backup, allPages);
    return result == SQLITE_DONE ? SQLITE_OK : result;
}

bool Connection::shareLog() {
    constexpr int regionSize = 32768; // the database maps its index in regions of this size (walformat.html, 2.0)
    sqlite3_file* const opened = file();
    void* region = nullptr;
    const bool hasMemory =
        opened && opened->pMethods->iVersion >= 2 && text("PRAGMA journal_mode") == "wal" &&
        opened->pMethods->xShmMap(opened, 0, regionSize, 0, const_cast<void volatile**>(&region)) == SQLITE_OK;
    m_log = hasMemory ? static_cast<const volatile std::uint32_t*>(region) : nullptr;
    return m_log != nullptr;
}

void Connection::keepLogOnClose() {
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_NO_CKPT_ON_CLOSE, 1, nullptr);
}

} // namespace tvx::registry
