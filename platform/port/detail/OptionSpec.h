#pragma once

#include "platform/base/Export.h"

#include <cstddef>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace Port::detail {

enum class ValueKind { None, Text, Integer, Real };
enum class Need { Optional, Required };
enum class Times { Once, Repeatable };

struct OptionRule {
    std::string name;
    ValueKind kind = ValueKind::None;
    Need need = Need::Optional;
    Times times = Times::Once;
    std::string help;
};

/// The plain arguments, with a name for the usage summary. Without a line for them none are allowed.
struct PlainRule {
    static constexpr std::size_t unlimited = std::numeric_limits<std::size_t>::max();

    std::string name;
    std::size_t least = 0;
    std::size_t most = 0;
    std::string help;
};

/// A line of a specification that is wrong and why.
struct SpecProblem {
    std::size_t line;
    std::string reason;
};

/// An option specification. "help" is always among the options.
struct TVX_PLATFORM_API OptionSpec {
    std::vector<OptionRule> options;
    PlainRule plain;
    std::string commandFileHelp = "Take arguments from files."; ///< of "-f"
    std::vector<SpecProblem> problems;

    /// The options that @p word may mean, without regard to case: the one of exactly that name, else all whose names
    /// begin with it. "h" and "?" mean "help". Pointers into `options`.
    [[nodiscard]] std::vector<const OptionRule*> find(std::string_view word) const;
};

/// Reads a specification; wrong lines are left out and listed in `problems`.
[[nodiscard]] TVX_PLATFORM_API OptionSpec parseOptionSpec(std::string_view text);

/// What the usage summary calls the value of an option, such as "<number>"; empty for an option without value.
[[nodiscard]] std::string_view valueName(ValueKind kind);

[[nodiscard]] bool isHelp(const OptionRule& rule);

} // namespace Port::detail
