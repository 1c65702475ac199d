#pragma once

/// @file
/// Keys and values through the registry's calls, with exceptions in place of result codes.

#include "tools/settings/ExchangeText.h"

#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace settings {

/// A call that failed. what() says which key or value is meant and why.
class Failure : public std::runtime_error {
public:
    Failure(LSTATUS result, const std::string& subject);

    [[nodiscard]] LSTATUS result() const {
        return m_result;
    }

private:
    LSTATUS m_result;
};

/// An open key. Closes itself.
class Key {
public:
    enum class Way { Read, Write, Create };

    /// Throws Failure when it cannot be opened.
    Key(const KeyName& name, Way way);
    ~Key();
    Key(const Key&) = delete;
    Key& operator=(const Key&) = delete;

    /// Names of the keys below this one.
    [[nodiscard]] std::vector<std::string> subKeys() const;
    [[nodiscard]] std::vector<Setting> settings() const;
    [[nodiscard]] Setting setting(const std::string& name) const;
    void set(const Setting& setting) const;
    void remove(const std::string& name) const;

private:
    [[nodiscard]] Failure failure(LSTATUS result, const std::string& value) const;

    KeyName m_name;
    HKEY m_key = nullptr;
};

/// The key `name` below another.
[[nodiscard]] KeyName below(const KeyName& key, const std::string& name);
/// Deletes a key with everything below it.
void removeTree(const KeyName& key);
/// The exchange text of a key and everything below it, without header.
[[nodiscard]] std::string writeTree(const KeyName& key);

/// Does all changes or, when one fails, none. `place` gives each failure the name of its file.
void apply(const std::vector<Change>& changes, const std::string& place);

} // namespace settings
