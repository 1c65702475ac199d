#pragma once

#include "platform/win/detail/LogHead.h"
#include "platform/win/detail/Patience.h"

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <sqlite3.h>
#include <string>
#include <string_view>

namespace tvx::registry {

/// The statements of the store, prepared when first used.
enum class Sql {
    FindKey,
    AddKey,
    DeleteKey,
    DeleteValues,
    HasSubKeys,
    KeyAfter,
    KeyAt,
    ReadValue,
    WriteValue,
    DeleteValue,
    ValueAfter,
    ValueAt,
    Begin,
    Commit,
    Rollback,
    Count,
};

/// One use of a prepared statement: arguments are bound in order, and the statement is free again when this ends.
class Query {
public:
    explicit Query(sqlite3_stmt* statement) : m_statement(statement) {}
    ~Query() {
        if (!m_statement) {
            return; // could not be prepared: a file of another version
        }
        sqlite3_reset(m_statement);
        sqlite3_clear_bindings(m_statement);
    }
    Query(const Query&) = delete;
    Query& operator=(const Query&) = delete;

    /// The argument must live as long as the query.
    Query& bind(std::string_view text);
    Query& bindBytes(std::string_view bytes);
    Query& bind(std::int64_t number);
    /// The next row, or the statement's end: SQLITE_ROW, SQLITE_DONE or an error.
    [[nodiscard]] int step();
    /// The bytes of a column of the row, valid until the next step.
    [[nodiscard]] std::string_view bytes(int column) const;
    [[nodiscard]] std::int64_t number(int column) const {
        return sqlite3_column_int64(m_statement, column);
    }

private:
    sqlite3_stmt* m_statement;
    int m_bound = 0;
};

/// An open database with its statements.
class Connection {
public:
    Connection() = default;
    ~Connection();
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    /// Opens an existing file. Results are the database's (SQLITE_OK, ...).
    [[nodiscard]] int open(const std::string& file);
    [[nodiscard]] int execute(const char* sql);
    /// Asks for one number; nothing when that fails, with the reason in error().
    [[nodiscard]] std::optional<std::int64_t> number(const char* sql);
    /// Asks for one text; empty when that fails.
    [[nodiscard]] std::string text(const char* sql);
    [[nodiscard]] Query query(Sql sql);
    /// Hands out the rows of a question up to its end or the first that cannot be read.
    void forEachRow(const char* sql, const std::function<void(const Query& row)>& take);

    /// Result of the last call that failed, with its details.
    [[nodiscard]] int error() const {
        return sqlite3_extended_errcode(m_database);
    }
    /// The system's error number behind it.
    [[nodiscard]] int systemError() const {
        return sqlite3_system_errno(m_database);
    }
    [[nodiscard]] bool isReadOnly() const {
        return sqlite3_db_readonly(m_database, "main") == 1;
    }
    [[nodiscard]] int changes() const {
        return sqlite3_changes(m_database);
    }
    /// Whether the log is shared with other processes, so that its head can be looked at.
    [[nodiscard]] bool shareLog();
    /// The head as it is now; nothing when it does not tell, and the database must be asked.
    [[nodiscard]] std::optional<LogHead> logHead() const {
        return readLogHead(m_log);
    }
    /// Leaves the log for others to bring into the file.
    void keepLogOnClose();

private:
    sqlite3* m_database = nullptr;
    std::optional<Patience> m_patience; ///< of the wait that is going on
    const volatile std::uint32_t* m_log = nullptr;
    std::array<sqlite3_stmt*, static_cast<std::size_t>(Sql::Count)> m_statements{};
};

} // namespace tvx::registry
