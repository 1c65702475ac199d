#include "platform/port/detail/OptionSpec.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <charconv>
#include <optional>

namespace Port::detail {

namespace {

constexpr std::string_view blanks = " \t\r\f\v";

std::string_view trim(std::string_view text) {
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) {
        return {};
    }
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

std::string quoted(std::string_view text) {
    return '"' + std::string(text) + '"';
}

std::string_view takeWord(std::string_view& rest) {
    rest = trim(rest);
    const std::string_view word = rest.substr(0, rest.find_first_of(blanks));
    rest.remove_prefix(word.size());
    return word;
}

bool isNameCharacter(char character) {
    const auto byte = static_cast<unsigned char>(character);
    return byte >= 0x80 || (byte >= '0' && byte <= '9') || (byte >= 'A' && byte <= 'Z') ||
           (byte >= 'a' && byte <= 'z') || byte == '_' || byte == '-' || byte == '.';
}

/// Names do not begin with a digit or a sign, so that they cannot be taken for negative numbers.
bool isName(std::string_view name) {
    return !name.empty() && std::all_of(name.begin(), name.end(), isNameCharacter) &&
           std::string_view("0123456789-.").find(name.front()) == std::string_view::npos;
}

bool meansHelp(std::string_view word) {
    return tvx::text::equalNoCase(word, "h") || word == "?";
}

std::optional<ValueKind> kindOf(std::string_view word) {
    struct Kind {
        std::string_view word;
        ValueKind kind;
    };
    constexpr Kind kinds[] = {{"none", ValueKind::None},
                              {"text", ValueKind::Text},
                              {"integer", ValueKind::Integer},
                              {"real", ValueKind::Real}};
    for (const Kind& known : kinds) {
        if (tvx::text::equalNoCase(word, known.word)) {
            return known.kind;
        }
    }
    return std::nullopt;
}

std::optional<std::size_t> toCount(std::string_view text) {
    std::size_t count = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), count);
    if (text.empty() || error != std::errc() || end != text.data() + text.size()) {
        return std::nullopt;
    }
    return count;
}

class SpecReader {
public:
    OptionSpec read(std::string_view text) {
        while (!text.empty()) {
            const std::size_t end = std::min(text.find_first_of("\r\n"), text.size());
            ++m_line;
            readLine(trim(text.substr(0, end)));
            const std::size_t lineEnd = text.substr(end).starts_with("\r\n") ? 2 : 1;
            text.remove_prefix(std::min(end + lineEnd, text.size()));
        }
        if (!isKnown("help")) {
            m_spec.options.push_back({"help", ValueKind::None, Need::Optional, Times::Once, "Show this summary."});
        }
        return std::move(m_spec);
    }

private:
    void readLine(std::string_view line) {
        if (line.empty() || line.front() == '#') {
            return;
        }
        const std::size_t colon = std::min(line.find(':'), line.size());
        const std::string_view help = colon < line.size() ? trim(line.substr(colon + 1)) : std::string_view();
        std::string_view declaration = trim(line.substr(0, colon));
        if (declaration.empty()) {
            refuse("there is nothing before \":\"");
        } else if (declaration.front() == '<') {
            readPlain(declaration, help);
        } else {
            readOption(declaration, help);
        }
    }

    void readOption(std::string_view declaration, std::string_view help) {
        OptionRule rule;
        rule.name = takeWord(declaration);
        rule.help = help;
        const std::string_view kind = takeWord(declaration);
        if (!isName(rule.name)) {
            return refuse(quoted(rule.name) + " cannot be the name of an option");
        }
        if (tvx::text::equalNoCase(rule.name, "f") && tvx::text::equalNoCase(kind, "text") && declaration.empty()) {
            m_spec.commandFileHelp = help;
            return;
        }
        if (meansHelp(rule.name) || tvx::text::equalNoCase(rule.name, "f")) {
            return refuse(quoted(rule.name) + " has a fixed meaning on every command line");
        }
        if (isKnown(rule.name)) {
            return refuse("option " + quoted(rule.name) + " is there already");
        }
        if (kind.empty()) {
            return refuse("option " + quoted(rule.name) + " has no value kind (none, text, integer, real)");
        }
        if (!kindOf(kind)) {
            return refuse(quoted(kind) + " is no value kind (none, text, integer, real)");
        }
        rule.kind = *kindOf(kind);
        if (!readAttributes(declaration, rule)) {
            return;
        }
        if (isHelp(rule) && (rule.kind != ValueKind::None || rule.need == Need::Required)) {
            return refuse("option \"help\" cannot take a value or be required");
        }
        m_spec.options.push_back(std::move(rule));
    }

    bool readAttributes(std::string_view declaration, OptionRule& rule) {
        for (std::string_view word = takeWord(declaration); !word.empty(); word = takeWord(declaration)) {
            if (tvx::text::equalNoCase(word, "required")) {
                rule.need = Need::Required;
            } else if (tvx::text::equalNoCase(word, "repeatable")) {
                rule.times = Times::Repeatable;
            } else {
                refuse(quoted(word) + " is neither \"required\" nor \"repeatable\" (help texts begin with \":\")");
                return false;
            }
        }
        return true;
    }

    void readPlain(std::string_view declaration, std::string_view help) {
        const std::size_t close = declaration.find('>');
        if (close == std::string_view::npos) {
            return refuse("\">\" is missing");
        }
        const std::string_view name = trim(declaration.substr(1, close - 1));
        if (name.empty()) {
            return refuse("the plain arguments have no name between \"<\" and \">\"");
        }
        if (!m_spec.plain.name.empty()) {
            return refuse("the plain arguments are there already");
        }
        PlainRule rule;
        rule.name = name;
        rule.help = help;
        const std::string_view range = trim(declaration.substr(close + 1));
        if (!readRange(range, rule)) {
            return refuse(quoted(range) + " is no count range such as \"1\", \"0..3\" or \"1..*\"");
        }
        m_spec.plain = std::move(rule);
    }

    static bool readRange(std::string_view range, PlainRule& rule) {
        const std::size_t dots = range.find("..");
        const std::string_view from = trim(range.substr(0, dots));
        const std::string_view to = dots == std::string_view::npos ? from : trim(range.substr(dots + 2));
        const auto least = toCount(from);
        const auto most = to == "*" ? PlainRule::unlimited : toCount(to);
        if (!least || !most || *least > *most) {
            return false;
        }
        rule.least = *least;
        rule.most = *most;
        return true;
    }

    bool isKnown(std::string_view name) const {
        return std::any_of(m_spec.options.begin(), m_spec.options.end(),
                           [&](const OptionRule& rule) { return tvx::text::equalNoCase(rule.name, name); });
    }

    void refuse(std::string reason) {
        m_spec.problems.push_back({m_line, std::move(reason)});
    }

    OptionSpec m_spec;
    std::size_t m_line = 0;
};

} // namespace

std::vector<const OptionRule*> OptionSpec::find(std::string_view word) const {
    if (meansHelp(word)) {
        word = "help";
    }
    std::vector<const OptionRule*> found;
    for (const OptionRule& rule : options) {
        if (tvx::text::equalNoCase(rule.name, word)) {
            return {&rule};
        }
        if (!word.empty() && tvx::text::startsWithNoCase(rule.name, word)) {
            found.push_back(&rule);
        }
    }
    return found;
}

OptionSpec parseOptionSpec(std::string_view text) {
    return SpecReader().read(text);
}

std::string_view valueName(ValueKind kind) {
    switch (kind) {
    case ValueKind::None:
        return "";
    case ValueKind::Text:
        return "<text>";
    case ValueKind::Integer:
        return "<integer>";
    case ValueKind::Real:
        return "<number>";
    }
    return "";
}

bool isHelp(const OptionRule& rule) {
    return tvx::text::equalNoCase(rule.name, "help");
}

} // namespace Port::detail
