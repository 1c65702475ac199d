#include "platform/win/detail/RegistryConnection.h"

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
    auto& patience = *static_cast<std::optional<Patience>*>(context);
    if (tries == 0 || !patience) {
        patience.emplace();
    }
    return patience->wait() ? 1 : 0;
}

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

int Connection::open(const std::string& file) {
    // A file that may not be written is opened for reading by the database itself.
    const int result = sqlite3_open_v2(file.c_str(), &m_database,
                                       SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_PRIVATECACHE, nullptr);
    if (result != SQLITE_OK) {
        return result;
    }
    sqlite3_extended_result_codes(m_database, 1);
    sqlite3_busy_handler(m_database, &waitForOthers, &m_patience);
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
    return execute("PRAGMA synchronous = FULL; PRAGMA temp_store = MEMORY");
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

std::string Connection::text(const char* sql) {
    sqlite3_stmt* statement = nullptr;
    std::string answer;
    if (sqlite3_prepare_v2(m_database, sql, -1, &statement, nullptr) == SQLITE_OK &&
        sqlite3_step(statement) == SQLITE_ROW) {
        answer = reinterpret_cast<const char*>(sqlite3_column_text(statement, 0));
    }
    sqlite3_finalize(statement);
    return answer;
}

Query Connection::query(Sql sql) {
    const auto index = static_cast<std::size_t>(sql);
    sqlite3_stmt*& statement = m_statements[index];
    if (!statement) {
        sqlite3_prepare_v3(m_database, statements[index], -1, SQLITE_PREPARE_PERSISTENT, &statement, nullptr);
    }
    return Query(statement);
}

void Connection::forEachRow(const char* sql, const std::function<void(const Query& row)>& take) {
    sqlite3_stmt* statement = nullptr;
    if (sqlite3_prepare_v2(m_database, sql, -1, &statement, nullptr) != SQLITE_OK) {
        return;
    }
    {
        Query rows(statement);
        while (rows.step() == SQLITE_ROW) {
            take(rows);
        }
    }
    sqlite3_finalize(statement);
}

int Query::step() {
    return m_statement ? sqlite3_step(m_statement) : SQLITE_SCHEMA;
}

bool Connection::shareLog() {
    constexpr int regionSize = 32768; // the database maps its index in regions of this size (walformat.html, 2.0)
    sqlite3_file* file = nullptr;
    void* region = nullptr;
    const bool hasMemory =
        sqlite3_file_control(m_database, "main", SQLITE_FCNTL_FILE_POINTER, &file) == SQLITE_OK && file &&
        file->pMethods && file->pMethods->iVersion >= 2 && text("PRAGMA journal_mode") == "wal" &&
        file->pMethods->xShmMap(file, 0, regionSize, 0, const_cast<void volatile**>(&region)) == SQLITE_OK;
    m_log = hasMemory ? static_cast<const volatile std::uint32_t*>(region) : nullptr;
    return m_log != nullptr;
}

void Connection::keepLogOnClose() {
    sqlite3_db_config(m_database, SQLITE_DBCONFIG_NO_CKPT_ON_CLOSE, 1, nullptr);
}

} // namespace tvx::registry
