#pragma once

#include "platform/base/String.h"

#include <vector>

namespace tvx::afx {

/// Lets the user choose one of several kinds of documents. Answers its index, -1 when the user cancelled.
[[nodiscard]] int chooseName(const std::vector<CString>& names);

} // namespace tvx::afx
