#pragma once

#include "afx.h"

#include <memory>
#include <utility>

/// Makes the private record of an object. An exhausted heap raises the framework's memory exception.
template <typename Record, typename... Arguments>
std::unique_ptr<Record> MakeRecord(Arguments&&... arguments) {
    std::unique_ptr<Record> record;
    tvx::allocating([&] { record.reset(new Record{std::forward<Arguments>(arguments)...}); });
    return record;
}
