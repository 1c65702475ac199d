#include "platform/port/CmdArgs.h"

#include "platform/base/Text.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/MsgManData.h"
#include "platform/port/detail/OptionSpec.h"

#include <cstdlib>
#include <memory>
#include <span>
#include <string>
#include <unordered_map>
#include <vector>

using namespace Port::detail;

namespace {

Port_MsgManData origin(int line) {
    return Port_MsgManData::createObject("Port", "platform/port/CmdArgs", line, "");
}

bool isWhole(const char* text, const char* end) {
    return end != text && *end == '\0';
}

/// Whether @p text is a value of @p kind. Whole numbers beyond the 32-bit range are: they clamp to it when they are
/// read.
bool isValue(const char* text, ValueKind kind) {
    const char* end = text;
    if (kind == ValueKind::Integer) {
        tvx::text::toInt32(text, &end);
    } else if (kind == ValueKind::Real) {
        tvx::text::toDouble(text, &end);
    } else {
        return true;
    }
    return isWhole(text, end);
}

/// "-" alone is a plain argument; by custom it stands for a standard stream.
bool isOption(const char* argument) {
    return argument[0] == '-' && argument[1] != '\0';
}

const char* valueNoun(ValueKind kind) {
    if (kind == ValueKind::Integer) {
        return "a whole number";
    }
    return kind == ValueKind::Real ? "a number" : "a text";
}

std::string listOf(const std::vector<const OptionRule*>& rules) {
    std::string list;
    for (const OptionRule* rule : rules) {
        list += (list.empty() ? "-" : rule == rules.back() ? " or -" : ", -") + rule->name;
    }
    return list;
}

/// Goes through one command line and gathers what is wrong with it.
class Checker {
public:
    Checker(const OptionSpec& spec, std::span<const char* const> arguments) : m_spec(spec), m_arguments(arguments) {}

    void run() {
        while (m_next < m_arguments.size()) {
            const char* argument = m_arguments[m_next++];
            if (isOption(argument)) {
                takeOption(argument);
            } else {
                m_plain.push_back(argument);
            }
        }
        checkRequired();
        checkPlainCount();
    }

    bool wantsHelp() const {
        return m_wantsHelp;
    }
    const std::vector<std::string>& errors() const {
        return m_errors;
    }

private:
    void takeOption(const char* argument) {
        const auto found = m_spec.find(argument + 1);
        if (found.empty()) {
            m_errors.push_back(tvx::text::format("Unknown option \"%s\".", argument));
        } else if (found.size() > 1) {
            m_errors.push_back(
                tvx::text::format("Option \"%s\" is ambiguous: it may mean %s.", argument, listOf(found).c_str()));
        } else {
            takeKnown(*found.front());
        }
    }

    void takeKnown(const OptionRule& rule) {
        m_wantsHelp = m_wantsHelp || isHelp(rule);
        // Exactly the second time, so that an option given five times is told of once.
        if (++m_given[&rule] == 2 && rule.times == Times::Once && !isHelp(rule)) {
            m_errors.push_back(tvx::text::format("Option \"-%s\" is given more than once.", rule.name.c_str()));
        }
        if (rule.kind != ValueKind::None) {
            takeValue(rule);
        }
    }

    void takeValue(const OptionRule& rule) {
        const char* value = m_next < m_arguments.size() ? m_arguments[m_next] : nullptr;
        // A negative number begins like an option; where a number is wanted it is one.
        const bool isNegative = value && rule.kind != ValueKind::Text && isValue(value, rule.kind);
        if (!value || (isOption(value) && !isNegative)) {
            m_errors.push_back(
                tvx::text::format("Option \"-%s\" needs %s after it.", rule.name.c_str(), valueNoun(rule.kind)));
            return;
        }
        ++m_next;
        if (!isValue(value, rule.kind)) {
            m_errors.push_back(
                tvx::text::format("Option \"-%s\": \"%s\" is not %s.", rule.name.c_str(), value, valueNoun(rule.kind)));
        }
    }

    void checkRequired() {
        for (const OptionRule& rule : m_spec.options) {
            if (rule.need == Need::Required && !m_given.contains(&rule)) {
                m_errors.push_back(tvx::text::format("Option \"-%s\" is required.", rule.name.c_str()));
            }
        }
    }

    void checkPlainCount() {
        const PlainRule& rule = m_spec.plain;
        const std::size_t given = m_plain.size();
        if (given > rule.most && rule.most == 0) {
            m_errors.push_back(tvx::text::format("Unexpected argument \"%s\".", m_plain.front()));
        } else if (given > rule.most) {
            m_errors.push_back(tvx::text::format("Unexpected argument \"%s\": %zu <%s> allowed, %zu given.",
                                                 m_plain[rule.most], rule.most, rule.name.c_str(), given));
        } else if (given < rule.least) {
            m_errors.push_back(tvx::text::format("Too few arguments: %zu <%s> needed, %zu given.", rule.least,
                                                 rule.name.c_str(), given));
        }
    }

    const OptionSpec& m_spec;
    std::span<const char* const> m_arguments;
    std::size_t m_next = 0;
    std::vector<const char*> m_plain;
    std::unordered_map<const OptionRule*, int> m_given;
    std::vector<std::string> m_errors;
    bool m_wantsHelp = false;
};

void issueUsage(const char* specification) {
    const std::unique_ptr<char, decltype(&std::free)> usage(UT_CMDOPCODES(specification).usage(), &std::free);
    if (usage) {
        origin(__LINE__).issueStatus("%s\n", usage.get());
    }
}

std::span<const char* const> argumentsOf(int argc, const char* const* argv, unsigned short flags) {
    const std::span all(argv, argv && argc > 0 ? static_cast<std::size_t>(argc) : 0);
    return flags & UT_CMDARGS::NoProgramName || all.empty() ? all : all.subspan(1);
}

} // namespace

UT_CMDARGS::UT_CMDARGS(int argc, const char* const* argv, const char* specification, void (*usagefunction)(),
                       unsigned short flags) {
    const OptionSpec spec = parseOptionSpec(specification ? specification : "");
    for (const SpecProblem& problem : spec.problems) {
        origin(__LINE__).issueInternal("Line %zu of the option specification: %s.", problem.line,
                                       problem.reason.c_str());
    }
    m_isError = !spec.problems.empty();
    if (m_isError) {
        return;
    }
    Checker checker(spec, argumentsOf(argc, argv, flags));
    checker.run();
    m_gaveUsage = checker.wantsHelp();
    m_isError = !m_gaveUsage && !checker.errors().empty();
    if (m_isError) {
        for (const std::string& error : checker.errors()) {
            origin(__LINE__).issueError("%s", error.c_str());
        }
    }
    if (m_gaveUsage) {
        issueUsage(specification);
    }
    if (m_gaveUsage && usagefunction) {
        usagefunction();
    }
}

bool UT_CMDARGS::gaveusage() const {
    return m_gaveUsage;
}

bool UT_CMDARGS::iserror() const {
    return m_isError;
}
