#include "platform/win/detail/RegistryConnection.h"
#include "platform/win/detail/RegistryStore.h"

#include <map>
#include <utility>

namespace tvx::registry {

namespace {

/// What can be read of a damaged file.
struct Salvage {
    struct Key {
        std::string path;
        std::string name;
    };

    std::map<std::int64_t, Key> keys;
    std::map<std::pair<std::int64_t, std::string>, Value> values; ///< by key and name without case
};

/// Reads from both ends, each time up to the first damaged page.
Salvage read(const std::string& file) {
    Salvage result;
    Connection damaged;
    if (damaged.open(file) != SQLITE_OK) {
        return result;
    }
    damaged.keepLogOnClose();
    for (const char* sql :
         {"SELECT id, path, name FROM key ORDER BY id", "SELECT id, path, name FROM key ORDER BY id DESC"}) {
        damaged.forEachRow(sql, [&](const Query& row) {
            result.keys.try_emplace(row.number(0), Salvage::Key{std::string(row.bytes(1)), std::string(row.bytes(2))});
        });
    }
    for (const char* sql : {"SELECT key, folded, name, type, data FROM value ORDER BY key, folded",
                            "SELECT key, folded, name, type, data FROM value ORDER BY key DESC, folded DESC"}) {
        damaged.forEachRow(sql, [&](const Query& row) {
            result.values.try_emplace(
                {row.number(0), std::string(row.bytes(1))},
                Value{std::string(row.bytes(2)), static_cast<DWORD>(row.number(3)), std::string(row.bytes(4))});
        });
    }
    return result;
}

} // namespace

std::size_t Store::takeOver(const std::string& damaged) {
    const Salvage salvage = read(damaged);
    if (salvage.values.empty() || ensureOpen(Intent::Write) != ERROR_SUCCESS || m_mode != Mode::Shared) {
        return 0;
    }
    std::size_t saved = 0;
    const DWORD result = together([&] {
        for (const auto& [id, key] : salvage.keys) {
            // Keys above one are older, and have been added with their spelling.
            (void)m_connection->query(Sql::AddKey).bind(parentOf(key.path)).bind(key.path).bind(key.name).step();
            (void)addLevels({key.path, key.path});
        }
        for (const auto& [id, value] : salvage.values) {
            const auto key = salvage.keys.find(id.first);
            if (key == salvage.keys.end() || askValue(key->second.path, id.second).result != ERROR_FILE_NOT_FOUND) {
                continue; // nobody knows whose it is, or somebody has written a newer one
            }
            saved += insertValue(key->second.path, id.second, value) == ERROR_SUCCESS ? 1 : 0;
        }
        return ERROR_SUCCESS;
    });
    return result == ERROR_SUCCESS ? saved : 0;
}

} // namespace tvx::registry
