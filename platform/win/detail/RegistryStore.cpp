#include "platform/win/detail/RegistryStore.h"

#include "platform/base/Text.h"
#include "platform/win/detail/RegistryConnection.h"
#include "platform/win/detail/RegistryMemory.h"

#include <cerrno>
#include <utility>

namespace tvx::registry {

void StoreMutex::lock() {
    if (!isMine()) {
        m_mutex.lock();
        m_owner.store(std::this_thread::get_id(), std::memory_order_relaxed);
    }
    ++m_depth;
}

void StoreMutex::unlock() {
    if (--m_depth == 0) {
        m_owner.store({}, std::memory_order_relaxed);
        m_mutex.unlock();
    }
}

// --- operations ---

/// Opens the file and does something with it. Where the file turns out to be damaged another one takes its place and it
/// is done again.
template <typename Operation>
DWORD Store::run(Intent intent, Operation operation) {
    DWORD result = ERROR_REGISTRY_CORRUPT;
    for (int attempt = 0; attempt < 2 && result == ERROR_REGISTRY_CORRUPT; ++attempt) {
        result = ensureOpen(intent);
        if (result == ERROR_SUCCESS) {
            result = operation();
        }
        if (result == ERROR_REGISTRY_CORRUPT && (m_inTransaction || replaceDamaged() != ERROR_SUCCESS)) {
            break;
        }
    }
    return result;
}

/// The same with an operation that writes.
template <typename Operation>
DWORD Store::change(Operation operation) {
    return written(run(Intent::Write, [&] { return m_mode == Mode::Shared ? operation() : m_writeError; }));
}

/// Tells what could not be written.
DWORD Store::written(DWORD result) {
    if (result == ERROR_SUCCESS) {
        m_waiting.end();
    }
    if (result == ERROR_DISK_FULL || result == ERROR_BUSY || result == ERROR_REGISTRY_IO_FAILED) {
        tell(Fault::NotSaved, "Settings could not be saved in " + m_file + ". " + errorText(result));
    }
    return result;
}

/// Does several changes, all or none.
DWORD Store::together(const std::function<DWORD()>& operation) {
    if (m_inTransaction) {
        return operation();
    }
    DWORD result = failed(m_connection->query(Sql::Begin).step());
    if (result != ERROR_SUCCESS) {
        return result;
    }
    result = operation();
    if (result == ERROR_SUCCESS) {
        result = failed(m_connection->query(Sql::Commit).step());
    }
    if (result != ERROR_SUCCESS) {
        (void)m_connection->query(Sql::Rollback).step();
    }
    return result;
}

Store::Replies* Store::replies() {
    return m_inTransaction || m_mode == Mode::Closed ? nullptr : m_memory->current(*m_connection);
}

template <typename Question>
Store::Reply Store::remembered(std::string_view subject, std::string_view detail, Question question) {
    Replies* known = replies();
    if (!known) {
        return question();
    }
    std::string key;
    key.reserve(subject.size() + detail.size() + 1);
    key.append(subject).append(1, '\0').append(detail);
    if (const auto found = known->find(key); found != known->end()) {
        return found->second;
    }
    Reply reply = question();
    if (reply.result == ERROR_SUCCESS || reply.result == ERROR_FILE_NOT_FOUND || reply.result == ERROR_KEY_DELETED) {
        known->emplace(std::move(key), reply);
    }
    return reply;
}

Store::Reply Store::askKey(std::string_view path) {
    const int step = m_connection->query(Sql::FindKey).bind(path).step();
    return {step == SQLITE_DONE ? ERROR_FILE_NOT_FOUND : failed(step), nullptr};
}

Store::Reply Store::askValue(std::string_view path, std::string_view folded) {
    Query query = m_connection->query(Sql::ReadValue);
    const int step = query.bind(path).bind(folded).step();
    if (step == SQLITE_ROW) {
        return {ERROR_SUCCESS,
                std::make_shared<Value>(Value{std::string(query.bytes(0)), static_cast<DWORD>(query.number(1)),
                                              std::string(query.bytes(2))})};
    }
    if (step != SQLITE_DONE) {
        return {failed(step), nullptr};
    }
    const DWORD keyResult = askKey(path).result;
    return {keyResult == ERROR_FILE_NOT_FOUND ? ERROR_KEY_DELETED
            : keyResult == 0                  ? ERROR_FILE_NOT_FOUND
                                              : keyResult,
            nullptr};
}

DWORD Store::findKey(const KeyPath& key) {
    if (key.folded.empty()) {
        return ERROR_SUCCESS; // a root is there before its file
    }
    // No value has a zero in its name, so this cannot be mistaken for one.
    constexpr std::string_view noValue("\0", 1);
    return run(Intent::Read,
               [&] { return remembered(key.folded, noValue, [&] { return askKey(key.folded); }).result; });
}

DWORD Store::readValue(const KeyPath& key, std::string_view name, std::shared_ptr<const Value>& value) {
    const std::string folded = text::foldCase(name);
    return run(Intent::Read, [&] {
        Reply reply = remembered(key.folded, folded, [&] { return askValue(key.folded, folded); });
        value = std::move(reply.value);
        return reply.result;
    });
}

DWORD Store::createKey(const KeyPath& key, bool& created) {
    created = false;
    const DWORD found = findKey(key);
    if (found != ERROR_FILE_NOT_FOUND) {
        return found;
    }
    return change([&] {
        const DWORD result = together([&] { return addLevels(key); });
        created = result == ERROR_SUCCESS;
        return result;
    });
}

DWORD Store::addLevels(const KeyPath& key) {
    for (const KeyPath& level : levelsOf(key)) {
        const int step = m_connection->query(Sql::AddKey)
                             .bind(parentOf(level.folded))
                             .bind(level.folded)
                             .bind(lastPart(level.spelled))
                             .step();
        if (step != SQLITE_DONE) {
            return failed(step);
        }
    }
    return ERROR_SUCCESS;
}

DWORD Store::deleteKey(const KeyPath& key) {
    const DWORD found = findKey(key);
    if (found != ERROR_SUCCESS) {
        return found;
    }
    return change([&] { return together([&] { return removeKey(key); }); });
}

DWORD Store::removeKey(const KeyPath& key) {
    {
        Query query = m_connection->query(Sql::HasSubKeys);
        const int step = query.bind(key.folded).step();
        if (step != SQLITE_ROW) {
            return failed(step);
        }
        if (query.number(0) != 0) {
            return ERROR_ACCESS_DENIED;
        }
    }
    int step = m_connection->query(Sql::DeleteValues).bind(key.folded).step();
    if (step == SQLITE_DONE) {
        step = m_connection->query(Sql::DeleteKey).bind(key.folded).step();
    }
    return step == SQLITE_DONE && m_connection->changes() == 0 ? ERROR_FILE_NOT_FOUND : failed(step);
}

DWORD Store::writeValue(const KeyPath& key, const Value& value) {
    const std::string folded = text::foldCase(value.name);
    return change([&] { return insertValue(key.folded, folded, value); });
}

DWORD Store::insertValue(std::string_view path, std::string_view folded, const Value& value) {
    const int step = m_connection->query(Sql::WriteValue)
                         .bind(path)
                         .bind(folded)
                         .bind(value.name)
                         .bind(std::int64_t{value.type})
                         .bindBytes(value.data)
                         .step();
    return step == SQLITE_DONE && m_connection->changes() == 0 ? ERROR_KEY_DELETED : failed(step);
}

DWORD Store::deleteValue(const KeyPath& key, std::string_view name) {
    std::shared_ptr<const Value> value;
    const DWORD found = readValue(key, name, value);
    if (found != ERROR_SUCCESS) {
        return found;
    }
    const std::string folded = text::foldCase(name);
    return change([&] {
        const int step = m_connection->query(Sql::DeleteValue).bind(key.folded).bind(folded).step();
        return step == SQLITE_DONE && m_connection->changes() == 0 ? ERROR_FILE_NOT_FOUND : failed(step);
    });
}

// --- enumerations ---

namespace {

/// Whether an enumeration goes on where it stands.
bool follows(const Cursor& cursor, DWORD index) {
    return cursor.isSet && index == cursor.index + 1;
}

/// A root is there without a file, and empty.
DWORD endOfMissing(DWORD result) {
    return result == ERROR_FILE_NOT_FOUND ? ERROR_NO_MORE_ITEMS : result;
}

} // namespace

DWORD Store::keyAt(const KeyPath& key, DWORD index, Cursor& cursor, std::string& name) {
    const DWORD found = findKey(key);
    if (found != ERROR_SUCCESS) {
        return found == ERROR_FILE_NOT_FOUND ? ERROR_KEY_DELETED : found;
    }
    const DWORD result = run(Intent::Read, [&] {
        const std::string last = cursor.folded;
        Query query = m_connection->query(follows(cursor, index) ? Sql::KeyAfter : Sql::KeyAt);
        query.bind(key.folded);
        const int step = (follows(cursor, index) ? query.bind(last) : query.bind(std::int64_t{index})).step();
        if (step != SQLITE_ROW) {
            return step == SQLITE_DONE ? ERROR_NO_MORE_ITEMS : failed(step);
        }
        name = query.bytes(0);
        cursor = {index, std::string(query.bytes(1)), true};
        return ERROR_SUCCESS;
    });
    return endOfMissing(result);
}

DWORD Store::valueAt(const KeyPath& key, DWORD index, Cursor& cursor, Value& value) {
    const DWORD found = findKey(key);
    if (found != ERROR_SUCCESS) {
        return found == ERROR_FILE_NOT_FOUND ? ERROR_KEY_DELETED : found;
    }
    const DWORD result = run(Intent::Read, [&] {
        const std::string last = cursor.folded;
        Query query = m_connection->query(follows(cursor, index) ? Sql::ValueAfter : Sql::ValueAt);
        query.bind(key.folded);
        const int step = (follows(cursor, index) ? query.bind(last) : query.bind(std::int64_t{index})).step();
        if (step != SQLITE_ROW) {
            return step == SQLITE_DONE ? ERROR_NO_MORE_ITEMS : failed(step);
        }
        value = {std::string(query.bytes(0)), static_cast<DWORD>(query.number(1)), std::string(query.bytes(2))};
        cursor = {index, std::string(query.bytes(3)), true};
        return ERROR_SUCCESS;
    });
    return endOfMissing(result);
}

// --- transactions ---

DWORD Store::begin() {
    if (m_inTransaction) {
        return ERROR_INVALID_FUNCTION;
    }
    return change([&] {
        const DWORD result = failed(m_connection->query(Sql::Begin).step());
        m_inTransaction = result == ERROR_SUCCESS;
        return result;
    });
}

DWORD Store::commit() {
    if (!m_inTransaction || m_isLost) {
        return ERROR_INVALID_FUNCTION;
    }
    const DWORD result = failed(m_connection->query(Sql::Commit).step());
    if (result != ERROR_SUCCESS) {
        (void)m_connection->query(Sql::Rollback).step();
    }
    m_inTransaction = false;
    return written(result);
}

void Store::rollback() {
    if (m_inTransaction && !m_isLost) {
        (void)m_connection->query(Sql::Rollback).step();
    }
    m_inTransaction = false;
}

// --- faults ---

DWORD Store::failed(int result) {
    switch (result & 0xFF) {
    case SQLITE_OK:
    case SQLITE_ROW:
    case SQLITE_DONE:
        return ERROR_SUCCESS;
    case SQLITE_BUSY:
    case SQLITE_LOCKED:
        return ERROR_BUSY;
    case SQLITE_CORRUPT:
    case SQLITE_NOTADB:
        return ERROR_REGISTRY_CORRUPT;
    case SQLITE_READONLY:
    case SQLITE_PERM:
    case SQLITE_AUTH:
    case SQLITE_CANTOPEN:
        return ERROR_ACCESS_DENIED;
    case SQLITE_FULL:
        return ERROR_DISK_FULL;
    case SQLITE_NOMEM:
        return ERROR_NOT_ENOUGH_MEMORY;
    case SQLITE_TOOBIG:
        return ERROR_INVALID_PARAMETER;
    default:
        break;
    }
    const int reason = m_connection->systemError();
    return reason == ENOSPC || reason == EDQUOT || reason == EFBIG ? ERROR_DISK_FULL : ERROR_REGISTRY_IO_FAILED;
}

void Store::tell(Fault fault, std::string text) {
    if (m_told.emplace(fault, m_name).second) {
        m_notices.push_back(std::move(text));
    }
}

std::vector<std::string> Store::takeNotices() {
    return m_inTransaction ? std::vector<std::string>() : std::exchange(m_notices, {});
}

} // namespace tvx::registry
