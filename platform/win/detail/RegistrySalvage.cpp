#include "platform/win/detail/RegistrySalvage.h"

#include "platform/base/Text.h"
#include "platform/win/detail/RegistryImage.h"

#include <optional>

namespace tvx::registry {

namespace {

template <typename Type>
const Type* as(const Image::Row& row, std::size_t column) {
    return std::get_if<Type>(&row.columns[column]);
}

/// A key from its row: a number that stands for none, its parent's, path and name.
std::optional<KeyPath> keyOf(const Image::Row& row) {
    if (!row.isOfTable || row.columns.size() != 4) {
        return std::nullopt;
    }
    const auto* const path = as<std::string>(row, 2);
    const auto* const name = as<std::string>(row, 3);
    return path && name ? soundKey(*path, *name) : std::nullopt;
}

/// A key from the index of paths, which has it without case: path and number.
std::optional<std::pair<std::int64_t, KeyPath>> indexedKeyOf(const Image::Row& row) {
    if (row.isOfTable || row.columns.size() != 2) {
        return std::nullopt;
    }
    const auto* const path = as<std::string>(row, 0);
    const auto* const number = as<std::int64_t>(row, 1);
    auto key = path && number ? soundKey(*path, lastPart(*path)) : std::nullopt;
    return key ? std::optional(std::pair(*number, std::move(*key))) : std::nullopt;
}

void takeValue(const Image::Row& row, Salvage& result) {
    if (row.isOfTable || row.columns.size() != 5) {
        return;
    }
    const auto* const key = as<std::int64_t>(row, 0);
    const auto* const folded = as<std::string>(row, 1);
    const auto* const name = as<std::string>(row, 2);
    const auto* const type = as<std::int64_t>(row, 3);
    const auto* const data = as<Image::Bytes>(row, 4);
    if (key && folded && name && type && data && isValueName(*name) && text::foldCase(*name) == *folded) {
        result.values.try_emplace({*key, *folded}, Value{*name, static_cast<DWORD>(*type), data->data});
    }
}

Salvage read(std::string_view file, std::string_view log, std::uint32_t pageSize) {
    // Where the tables and the index of paths begin: they are made in this order.
    constexpr Image::Number keys = 2;
    constexpr Image::Number paths = 3;
    constexpr Image::Number values = 5;
    Salvage result;
    result.keys.try_emplace(1); // the root
    std::map<std::int64_t, KeyPath> indexed;
    Image(file, log, pageSize).forEachRow({keys, paths, values}, [&](const Image::Row& row) {
        if (auto key = keyOf(row)) {
            result.keys.try_emplace(row.number, std::move(*key));
        } else if (auto found = indexedKeyOf(row)) {
            indexed.insert(std::move(*found));
        } else {
            takeValue(row, result);
        }
    });
    result.keys.merge(indexed);
    return result;
}

} // namespace

Salvage salvage(std::string_view file, std::string_view log) {
    constexpr std::uint32_t usual = 4096;
    Salvage result = read(file, log, usual);
    // The head may be what is damaged.
    if (const auto named = Image::pageSizeOf(file); named && *named != usual) {
        Salvage other = read(file, log, *named);
        if (other.values.size() > result.values.size()) {
            return other;
        }
    }
    return result;
}

} // namespace tvx::registry
