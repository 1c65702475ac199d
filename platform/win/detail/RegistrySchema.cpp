#include "platform/win/detail/RegistrySchema.h"

#include <string>

#define TVX_KEY_TABLE                                                                                                  \
    "CREATE TABLE key (id INTEGER PRIMARY KEY, parent INTEGER NOT NULL,"                                               \
    " path TEXT NOT NULL UNIQUE, name TEXT NOT NULL)"
#define TVX_PARENT_INDEX "CREATE INDEX key_parent ON key (parent, path)"
#define TVX_VALUE_TABLE                                                                                                \
    "CREATE TABLE value (key INTEGER NOT NULL, folded TEXT NOT NULL, name TEXT NOT NULL,"                              \
    " type INTEGER NOT NULL, data BLOB NOT NULL, PRIMARY KEY (key, folded)) WITHOUT ROWID"

namespace tvx::registry::schema {

namespace {

struct Question {
    const char* sql;
    const char* answer;
};

/// The pages and what the file brings with it that would be run.
constexpr Question forAnyVersion[] = {
    {"SELECT count(*) FROM sqlite_schema WHERE type IN ('view', 'trigger') OR sql LIKE 'CREATE VIRTUAL%'", "0"},
    {"PRAGMA encoding", "UTF-8"},
    {"PRAGMA integrity_check(1)", "ok"},
};

/// What the database keeps of the tables is the text they were made with.
constexpr Question forOurs[] = {
    {"SELECT count(*) FROM sqlite_schema WHERE (name = 'key' AND sql = '" TVX_KEY_TABLE "')"
     " OR (name = 'key_parent' AND sql = '" TVX_PARENT_INDEX "') OR (name = 'value' AND sql = '" TVX_VALUE_TABLE "')",
     "3"},
    {"SELECT count(*) FROM key WHERE id = 1 AND parent = 0 AND path = '' AND name = ''", "1"},
    // The beginning of a path up to its last backslash is what is left when all other letters are taken off its end.
    {"SELECT count(*) FROM key k LEFT JOIN key p ON p.id = k.parent WHERE k.id <> 1 AND (p.id IS NULL OR k.name = ''"
     " OR instr(k.name, '\\') <> 0 OR substr(k.path, -1) = '\\' OR rtrim(k.path, replace(k.path, '\\', '')) <>"
     " CASE p.path WHEN '' THEN '' ELSE p.path || '\\' END)",
     "0"},
    // Where names are of ASCII alone, to be found without case is to be found in small letters.
    {"SELECT count(*) FROM value WHERE folded <> lower(name) AND length(name) = length(CAST(name AS BLOB))", "0"},
    {"SELECT count(*) FROM key WHERE length(path) = length(CAST(path AS BLOB))"
     " AND substr(path, -length(name)) <> lower(name) AND id <> 1",
     "0"},
};

int ask(Connection& connection, const Question& question) {
    const std::optional<std::string> answer = connection.text(question.sql);
    if (!answer) {
        return connection.error();
    }
    return *answer == question.answer ? SQLITE_OK : SQLITE_CORRUPT;
}

} // namespace

static_assert(applicationId == 1414944850 && version == 1);
const char* const make = TVX_KEY_TABLE ";" TVX_PARENT_INDEX ";" TVX_VALUE_TABLE ";"
                                       "INSERT INTO key VALUES (1, 0, '', '');"
                                       "PRAGMA application_id = 1414944850;"
                                       "PRAGMA user_version = 1";

int examine(Connection& connection, std::int64_t version) {
    int result = SQLITE_OK;
    const auto next = [&](const Question& question) {
        result = result == SQLITE_OK ? ask(connection, question) : result;
    };
    for (const Question& question : forAnyVersion) {
        next(question);
    }
    for (const Question& question : forOurs) {
        if (version <= schema::version) {
            next(question);
        }
    }
    return result;
}

} // namespace tvx::registry::schema
