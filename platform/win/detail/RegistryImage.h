#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace tvx::registry {

/// The pages of a database's file, read without the database: for files that it refuses. Nothing in them is believed,
/// so any bytes do.
///
/// The format is SQLite's: sqlite.org/fileformat2.html, chapters 1 (pages), 2 (records) and 4 (log).
class Image {
public:
    using Number = std::uint32_t; ///< of a page, counted from 1

    /// A column of a row: nothing (also a number that is not whole), a whole number, a text, or bytes.
    struct Bytes {
        std::string data;
    };
    using Column = std::variant<std::monostate, std::int64_t, std::string, Bytes>;
    /// A row of a table, or an entry of an index, which has no number of its own.
    struct Row {
        bool isOfTable = false;
        std::int64_t number = 0;
        std::vector<Column> columns;
    };

    /// The size of pages that a file names in its head; nothing when it names none.
    [[nodiscard]] static std::optional<std::uint32_t> pageSizeOf(std::string_view file);

    /// @param file  the file's bytes; they must live as long as this object
    /// @param log   those of the log beside it, empty when there is none; the same
    Image(std::string_view file, std::string_view log, std::uint32_t pageSize);

    /// Hands out what can be read: first of the trees with these roots, then of all other pages that are not marked as
    /// free. What is in the latter may be older than what is in the former.
    void forEachRow(const std::vector<Number>& roots, const std::function<void(const Row& row)>& take);

private:
    void layOver(std::string_view log);
    [[nodiscard]] std::string_view page(Number number) const;
    [[nodiscard]] std::vector<Number> inOrder(const std::vector<Number>& roots) const;
    void markFree(std::vector<bool>& isKnown) const;
    void readRows(Number number, const std::function<void(const Row& row)>& take);
    [[nodiscard]] std::string payload(std::string_view cell, std::uint64_t size, bool isOfTable);

    std::string_view m_file;
    std::map<Number, std::string_view> m_newer; ///< pages of the log
    std::uint32_t m_pageSize;
    Number m_count = 0;
    std::vector<bool> m_isSpent; ///< pages of long rows: each belongs to one, so a circle of them ends
};

} // namespace tvx::registry
