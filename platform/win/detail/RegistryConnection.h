#pragma once

#include "platform/win/detail/LogHead.h"
#include "platform/win/detail/Patience.h"

#include <array>
#include <cstdint>
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
    /// @param error  why there is no statement: the file could not be looked at, or is of another version
    Query(sqlite3_stmt* statement, int error) : m_statement(statement), m_error(error) {}
    ~Query() {
        if (!m_statement) {
            return;
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
    int m_error;
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
    /// @param waiting  of the store; must live as long as this connection
    [[nodiscard]] int open(const std::string& file, Waiting& waiting);
    /// Opens a file whatever is in it, to be filled by a Replacement.
    [[nodiscard]] int openToReplace(const std::string& file, Waiting& waiting);
    [[nodiscard]] int execute(const char* sql);
    /// Asks for one number; nothing when that fails, with the reason in error().
    [[nodiscard]] std::optional<std::int64_t> number(const char* sql);
    /// Asks for one text, empty when there is no answer; nothing when that fails, with the reason in error().
    [[nodiscard]] std::optional<std::string> text(const char* sql);
    [[nodiscard]] Query query(Sql sql);
    /// The bytes of the file without those of its log, zeros where the disk cannot read them. (Reading them past the
    /// database would end its locks.) Nothing when there are too many for a file of settings.
    [[nodiscard]] std::optional<std::string> fileBytes() const;

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
    friend class Replacement;
    [[nodiscard]] sqlite3_file* file() const;

    sqlite3* m_database = nullptr;
    const volatile std::uint32_t* m_log = nullptr;
    std::array<sqlite3_stmt*, static_cast<std::size_t>(Sql::Count)> m_statements{};
};

/// Puts what one database holds in the place of what another one holds. Others see all of it at once, whether they have
/// the file open or not. Takes everything back unless end() has succeeded.
class Replacement {
public:
    /// @param file   by openToReplace()
    /// @param fresh  what the file is to hold; may still be written between begin() and end()
    Replacement(Connection& file, Connection& fresh);
    ~Replacement();
    Replacement(const Replacement&) = delete;
    Replacement& operator=(const Replacement&) = delete;

    /// From now on nobody else writes to the file.
    [[nodiscard]] int begin();
    [[nodiscard]] int end();

private:
    sqlite3_backup* m_backup;
};

} // namespace tvx::registry
