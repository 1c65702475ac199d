#include "platform/win/detail/RegistryConnection.h"
#include "platform/win/detail/RegistrySalvage.h"
#include "platform/win/detail/RegistrySchema.h"
#include "platform/win/detail/RegistryStore.h"

#include <algorithm>
#include <ctime>
#include <optional>
#include <utility>
#include <vector>

namespace tvx::registry {

namespace {

/// Whether a file that was found damaged has been mended by another process meanwhile, as a copy of it shows.
bool isSound(const std::string& copy, Waiting& waiting) {
    bool answer = false;
    {
        Connection connection;
        if (connection.open(copy, waiting) == SQLITE_OK &&
            connection.number("PRAGMA application_id") == schema::applicationId) {
            const auto version = connection.number("PRAGMA user_version");
            answer = version && schema::examine(connection, *version) == SQLITE_OK;
        }
        connection.keepLogOnClose();
    }
    removeShared(copy);
    return answer;
}

std::string mendedText(const std::string& file, const std::string& aside, std::size_t saved) {
    return "The file of your settings, " + file + ", was damaged. What it held is kept as " + aside + ". " +
           (saved == 0 ? std::string("No setting in it could be read.")
                       : std::to_string(saved) + " settings in it could be read and were kept.");
}

/// An empty store in memory, to be put in the place of one that is damaged.
int makeFresh(Connection& fresh, Connection& damaged, Waiting& waiting) {
    const int result = fresh.open(":memory:", waiting);
    if (result != SQLITE_OK) {
        return result;
    }
    // A file with a log keeps its size of pages.
    const std::int64_t pageSize = damaged.number("PRAGMA page_size").value_or(0);
    const std::string first = "PRAGMA page_size = " + std::to_string(pageSize) + ";";
    return fresh.execute((first + schema::make).c_str());
}

} // namespace

DWORD Store::checkContents(std::int64_t version) {
    if (m_checked == m_identity) {
        return ERROR_SUCCESS;
    }
    const DWORD result = failed(schema::examine(*m_connection, version));
    if (result == ERROR_SUCCESS) {
        m_checked = m_identity;
    }
    return result;
}

DWORD Store::replaceDamaged() {
    const FileIdentity damaged = m_identity;
    const bool isOurs = m_hive == Hive::User && !m_copy && m_mode != Mode::ReadOnly;
    close(Log::Keep);
    if (isOurs && damaged != identityOf(m_name)) {
        return ERROR_SUCCESS; // somebody has put another file in its place
    }
    DWORD result = ERROR_ACCESS_DENIED;
    if (isOurs) {
        result = beginAnew();
        close(Log::Keep);
    }
    if (result != ERROR_SUCCESS && result != ERROR_BUSY) {
        tell(Fault::Unusable, "The settings cannot be used: " + m_file + " is damaged.");
        return ERROR_ACCESS_DENIED;
    }
    return result;
}

/// Keeps the bytes of the damaged file elsewhere and fills it anew: the file stays where it is, so processes that have
/// it open, or are opening it, never have one file and another one's log.
DWORD Store::beginAnew() {
    Connection damaged;
    int result = damaged.openToReplace(m_file, m_waiting);
    damaged.keepLogOnClose();
    m_connection = std::make_unique<Connection>();
    if (result == SQLITE_OK) {
        result = makeFresh(*m_connection, damaged, m_waiting);
    }
    Replacement replacement(damaged, *m_connection);
    if (result == SQLITE_OK) {
        result = replacement.begin();
    }
    const std::optional<std::string> bytes = damaged.fileBytes();
    if (result != SQLITE_OK || !bytes) {
        return result != SQLITE_OK ? failed(result) : ERROR_ACCESS_DENIED;
    }
    // Nobody can begin the log anew meanwhile, and what is brought from it into the file stays in it.
    const std::string log = contentsOf(m_file + "-wal");
    const std::optional<std::string> aside = keepAside(m_file, *bytes, log);
    if (!aside) {
        return ERROR_ACCESS_DENIED;
    }
    std::size_t saved = 0;
    const bool isMended = isSound(*aside, m_waiting);
    DWORD filled = isMended ? ERROR_SUCCESS : takeOver(salvage(*bytes, log), saved);
    if (!isMended && filled == ERROR_SUCCESS) {
        filled = failed(replacement.end());
    }
    if (isMended || filled != ERROR_SUCCESS) {
        removeAside(*aside);
        return filled;
    }
    m_notices.push_back(mendedText(m_file, *aside, saved));
    return ERROR_SUCCESS;
}

DWORD Store::takeOver(const Salvage& found, std::size_t& saved) {
    std::vector<KeyPath> keys;
    keys.reserve(found.keys.size());
    for (const auto& [id, key] : found.keys) {
        keys.push_back(key);
    }
    // Those above first: they bring their spelling with them.
    std::ranges::sort(keys, {}, [](const KeyPath& key) { return key.folded.size(); });
    for (const KeyPath& key : keys) {
        if (const DWORD result = addLevels(key); result != ERROR_SUCCESS) {
            return result;
        }
    }
    for (const auto& [id, value] : found.values) {
        const auto key = found.keys.find(id.first);
        if (key == found.keys.end()) {
            continue; // nobody knows whose it is
        }
        if (const DWORD result = insertValue(key->second.folded, id.second, value); result != ERROR_SUCCESS) {
            return result;
        }
        ++saved;
    }
    return ERROR_SUCCESS;
}

} // namespace tvx::registry
