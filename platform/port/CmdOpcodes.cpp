#include "platform/port/CmdOpcodes.h"

#include "platform/base/Text.h"
#include "platform/port/detail/MsgFormat.h"
#include "platform/port/detail/OptionSpec.h"

#include <cerrno>
#include <cstring>

using namespace Port::detail;

namespace {

constexpr int usageColumns = 80;
constexpr std::string_view helpIndent = "      ";

std::string withValue(const OptionRule& rule) {
    std::string text = "-" + rule.name;
    if (rule.kind != ValueKind::None) {
        (text += ' ') += valueName(rule.kind);
    }
    return text;
}

std::string plainForm(const PlainRule& rule) {
    std::string form = "<" + rule.name + ">";
    if (rule.most > 1) {
        form += " ...";
    }
    return rule.least == 0 ? "[" + form + "]" : form;
}

/// "Usage: board -scale <number> [options] [<drawing> ...]"
std::string firstLine(const OptionSpec& spec) {
    std::string line = std::string("Usage: ") + program_invocation_short_name;
    for (const OptionRule& rule : spec.options) {
        if (rule.need == Need::Required) {
            line += " " + withValue(rule);
        }
    }
    line += " [options]";
    if (spec.plain.most > 0) {
        line += " " + plainForm(spec.plain);
    }
    return line;
}

std::string_view remark(const OptionRule& rule) {
    if (rule.need == Need::Required) {
        return rule.times == Times::Repeatable ? "  (required, repeatable)" : "  (required)";
    }
    return rule.times == Times::Repeatable ? "  (repeatable)" : "";
}

std::string countRemark(const PlainRule& rule) {
    const std::string least = std::to_string(rule.least);
    if (rule.most == PlainRule::unlimited) {
        return rule.least == 0 ? "  (any number)" : "  (at least " + least + ")";
    }
    if (rule.least == rule.most) {
        return "  (" + least + ")";
    }
    return "  (" + least + " to " + std::to_string(rule.most) + ")";
}

void addEntry(std::string& text, const std::string& head, const std::string& help) {
    text += "  " + head + "\n";
    if (!help.empty()) {
        (text += helpIndent) += help + "\n";
    }
}

std::string wrapped(std::string_view text) {
    std::string result;
    for (const std::wstring& line : wrapText(tvx::text::widen(text), usageColumns)) {
        result += tvx::text::narrow(line) + '\n';
    }
    return result;
}

std::string summary(const OptionSpec& spec) {
    std::string text = firstLine(spec) + "\n";
    if (spec.plain.most > 0) {
        addEntry(text, "<" + spec.plain.name + ">" + countRemark(spec.plain), spec.plain.help);
    }
    for (const OptionRule& rule : spec.options) {
        addEntry(text, withValue(rule) + std::string(remark(rule)), rule.help);
    }
    addEntry(text, "-f <file> ...", spec.commandFileHelp);
    return wrapped(text);
}

} // namespace

UT_CMDOPCODES::UT_CMDOPCODES(const char* specification)
    : m_spec(std::make_unique<OptionSpec>(parseOptionSpec(specification ? specification : ""))) {}

UT_CMDOPCODES::~UT_CMDOPCODES() = default;

char* UT_CMDOPCODES::usage() const {
    return strdup(summary(*m_spec).c_str());
}

const char* UT_CMDOPCODES::optionname(const char* word) const {
    const auto found = m_spec->find(word ? word : "");
    return found.size() == 1 ? found.front()->name.c_str() : nullptr;
}
