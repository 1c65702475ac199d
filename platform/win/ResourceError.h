#pragma once

#include <string>
#include <utility>
#include <variant>

namespace tvx {

/// Why resource data was refused: one English clause that names what is wrong and where, without a full stop.
struct ResourceError {
    std::string reason; ///< e.g. "tool bar ends within its head"
};

/// The outcome of reading resource data: the value, or the reason why the data was refused.
///
///     auto dialog = parseDialogTemplate(bytes);
///     if (!dialog)
///         return report(dialog.reason());
///     use(dialog->items);
template <class T>
class [[nodiscard]] ResourceResult {
public:
    /// A success.
    ResourceResult(T value) : m_outcome(std::move(value)) {}
    /// A refusal.
    ResourceResult(ResourceError error) : m_outcome(std::move(error)) {}

    /// Whether there is a value.
    explicit operator bool() const {
        return std::holds_alternative<T>(m_outcome);
    }
    /// The value; only after the test above said yes.
    T& operator*() {
        return std::get<T>(m_outcome);
    }
    const T& operator*() const {
        return std::get<T>(m_outcome);
    }
    T* operator->() {
        return &std::get<T>(m_outcome);
    }
    const T* operator->() const {
        return &std::get<T>(m_outcome);
    }
    /// Why there is no value; empty when there is one.
    [[nodiscard]] std::string reason() const {
        const auto* error = std::get_if<ResourceError>(&m_outcome);
        return error ? error->reason : std::string();
    }
    /// The refusal itself, to be passed on as the outcome of another reading; only when there is no value.
    [[nodiscard]] ResourceError error() const {
        return std::get<ResourceError>(m_outcome);
    }

private:
    std::variant<T, ResourceError> m_outcome;
};

} // namespace tvx
