#include "platform/base/Text.h"
#include "tools/settings/ExchangeText.h"

#include <algorithm>
#include <array>

namespace settings {

namespace {

constexpr std::size_t longestLine = 80;

bool isControl(char c) {
    return static_cast<unsigned char>(c) < ' ' || c == '\x7F';
}

std::string hexByte(char byte) {
    constexpr std::string_view digits = "0123456789abcdef";
    const auto value = static_cast<unsigned char>(byte);
    return {digits[value >> 4], digits[value & 0xF]};
}

std::string quoted(std::string_view text) {
    std::string result = "\"";
    for (std::size_t at = 0, length = 0; at < text.size(); at += length) {
        length = tvx::text::characterLength(text, at);
        const std::string_view character = text.substr(at, length);
        if (isControl(character[0]) || !tvx::text::isWellFormed(character)) {
            result += "\\x" + hexByte(character[0]);
        } else {
            result.append(character == "\\" || character == "\"" ? "\\" : "").append(character);
        }
    }
    return result + '"';
}

std::string hexBytes(std::string line, std::string_view bytes) {
    std::string result;
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        line += hexByte(bytes[i]);
        line += i + 1 < bytes.size() ? "," : "";
        if (line.size() >= longestLine - 4 && i + 1 < bytes.size()) {
            result += line + "\\\n";
            line = "  ";
        }
    }
    return result + line;
}

/// Whether a text can stand between quotes: one line of characters, and a zero at its end only.
bool isPlainText(const Setting& setting) {
    if (setting.type != REG_SZ || setting.data.empty() || setting.data.back() != '\0') {
        return false;
    }
    const std::string_view text(setting.data.data(), setting.data.size() - 1);
    return std::ranges::none_of(text, isControl) && tvx::text::isWellFormed(text);
}

std::string number(const std::string& data) {
    std::string digits;
    for (std::size_t i = data.size(); i > 0; --i) {
        digits += hexByte(data[i - 1]);
    }
    return digits;
}

std::string typed(DWORD type) {
    return type == REG_BINARY ? "hex:" : tvx::text::format("hex(%x):", type);
}

} // namespace

std::string writeHeader() {
    return "REGEDIT4\n\n";
}

bool canWriteKey(const KeyName& key) {
    return std::ranges::none_of(key.path, isControl) && tvx::text::isWellFormed(key.path);
}

std::string writeKey(const KeyName& key) {
    return "[" + writeKeyName(key) + "]\n";
}

std::string writeSetting(const Setting& setting) {
    const std::string name = (setting.name.empty() ? "@" : quoted(setting.name)) + "=";
    if (isPlainText(setting)) {
        return name + quoted(std::string_view(setting.data.data(), setting.data.size() - 1)) + "\n";
    }
    if (setting.type == REG_DWORD && setting.data.size() == sizeof(DWORD)) {
        return name + "dword:" + number(setting.data) + "\n";
    }
    return hexBytes(name + typed(setting.type), setting.data) + "\n";
}

} // namespace settings
