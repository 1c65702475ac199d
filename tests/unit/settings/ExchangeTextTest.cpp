#include "tools/settings/ExchangeText.h"

#include <gtest/gtest.h>

using namespace settings;

namespace {

std::vector<Change> read(const std::string& lines) {
    return readExchangeText("REGEDIT4\n" + lines);
}

/// The one value of a text.
Setting readOne(const std::string& line) {
    const auto changes = read("[HKEY_CURRENT_USER\\k]\n" + line);
    EXPECT_EQ(changes.size(), 2u);
    return changes.size() == 2 ? changes[1].setting : Setting{};
}

/// "line: message" of what is wrong with a text.
std::string faultOf(const std::string& text) {
    try {
        (void)readExchangeText(text);
    } catch (const TextFault& fault) {
        return std::to_string(fault.line) + ": " + fault.message;
    }
    return "nothing";
}

TEST(ExchangeText, HoldsKeysWithValuesOfEveryType) {
    const auto changes = read("; a comment\r\n"
                              "\r\n"
                              "[HKEY_CURRENT_USER\\Software\\Tarvex]\r\n"
                              "@=\"default\"\r\n"
                              "\"a \\\"quoted\\\" name\" = \"C:\\\\bin\\\\x.exe \\\"%1\\\"\"\r\n"
                              "\"n\"=dword:fffffFFE\r\n"
                              "\"b\"=hex:00,01,\\\r\n"
                              "  ff\r\n"
                              "\"e\"=hex(2):25,00\r\n"
                              "\"gone\"=-\r\n"
                              "[-hkcu\\Old]\r\n");
    ASSERT_EQ(changes.size(), 8u);
    EXPECT_EQ(changes[0].kind, Change::Kind::MakeKey);
    EXPECT_EQ(changes[0].key.path, "Software\\Tarvex");
    EXPECT_EQ(changes[0].line, 4);
    EXPECT_EQ(changes[1].setting.name, "");
    EXPECT_EQ(changes[1].setting.data, std::string("default\0", 8));
    EXPECT_EQ(changes[2].setting.name, "a \"quoted\" name");
    EXPECT_EQ(changes[2].setting.data, std::string("C:\\bin\\x.exe \"%1\"\0", 18));
    EXPECT_EQ(changes[3].setting.type, REG_DWORD);
    EXPECT_EQ(changes[3].setting.data, "\xFE\xFF\xFF\xFF");
    EXPECT_EQ(changes[4].setting.type, REG_BINARY);
    EXPECT_EQ(changes[4].setting.data, std::string("\0\1\xFF", 3));
    EXPECT_EQ(changes[5].setting.type, REG_EXPAND_SZ);
    EXPECT_EQ(changes[5].setting.data, std::string("%\0", 2));
    EXPECT_EQ(changes[6].kind, Change::Kind::DeleteValue);
    EXPECT_EQ(changes[6].line, 11);
    EXPECT_EQ(changes[7].kind, Change::Kind::DeleteKey);
    EXPECT_EQ(changes[7].key.root, HKEY_CURRENT_USER);
}

TEST(ExchangeText, JoinsLinesOfTextsAndBytes) {
    EXPECT_EQ(readOne("\"a\"=\"one \\\ntwo\"").data, std::string("one two\0", 8));
    EXPECT_EQ(readOne("\"a\\\nb\"=\"\"").name, "ab");
    EXPECT_EQ(readOne("\"a\"=\"one\\ntwo\\t\\x41\"").data, std::string("one\ntwo\tA\0", 10));
    EXPECT_EQ(readOne("\"a\"=hex:01\\\n,\\\n  02 , 3").data, "\1\2\3");
    EXPECT_EQ(readOne("\"a\"=hex:").data, "");
}

TEST(ExchangeText, TellsTheLineOfWhatIsWrong) {
    const std::string key = "REGEDIT4\n[HKEY_CURRENT_USER\\k]\n";
    EXPECT_EQ(faultOf(""), "0: the first line must be REGEDIT4");
    EXPECT_EQ(faultOf("Something else\n"), "1: the first line must be REGEDIT4");
    EXPECT_EQ(faultOf("REGEDIT4\n\n\"a\"=\"b\"\n"), "3: a value stands before the first key");
    EXPECT_EQ(faultOf("REGEDIT4\n[HKEY_CURRENT_USER\\k\n"), "2: the ] of the key is missing");
    EXPECT_EQ(faultOf("REGEDIT4\n[Software]\n"), "2: the key does not begin with a root such as HKEY_CURRENT_USER");
    EXPECT_EQ(faultOf("REGEDIT4\n[-HKEY_CURRENT_USER]\n"), "2: a root cannot be deleted");
    EXPECT_EQ(faultOf("REGEDIT4\n[-HKCU\\a]\n@=\"\"\n"), "3: a value stands below a deleted key");
    EXPECT_EQ(faultOf(key + "a=1\n"), "3: expected a key in brackets, a name in quotes or @");
    EXPECT_EQ(faultOf(key + "\"a\"\n"), "3: expected = behind the name");
    EXPECT_EQ(faultOf(key + "\"a\"=b\n"), "3: expected a text in quotes, dword:, hex: or -");
    EXPECT_EQ(faultOf(key + "\n\"a\"=\"b\n\"c\"=\"d\"\n"), "4: a quote is not closed");
    EXPECT_EQ(faultOf(key + "\"a\"=\"b\" c\n"), "3: nothing may follow the value");
    EXPECT_EQ(faultOf(key + "\"a\"=\"\\q\"\n"), "3: unknown escape \\q");
    EXPECT_EQ(faultOf(key + "\"a\"=\"b\\"), "3: the text goes on behind the end of the file");
    EXPECT_EQ(faultOf(key + "\"a\"=hex:00,\\\n  zz\n"), "4: expected bytes of two hexadecimal digits");
    EXPECT_EQ(faultOf(key + "\"a\"=hex:00 01\n"), "3: expected a comma between the bytes");
    EXPECT_EQ(faultOf(key + "\"a\"=hex:00,\\"), "3: the bytes go on behind the end of the file");
    EXPECT_EQ(faultOf(key + "\"a\"=hex(x):00\n"), "3: expected a type in hexadecimal digits behind hex(");
    EXPECT_EQ(faultOf(key + "\"a\"=dword:123456789\n"), "3: nothing may follow the value");
    EXPECT_EQ(faultOf(std::string("R\0E\0", 4)), "1: this is no text in UTF-8: it holds zero bytes");
}

TEST(ExchangeText, TakesOtherTextsForTheWesternCodePage) {
    EXPECT_EQ(readOne("\"gr\xFC\xDF\"=\"\x80\"").name, "grüß");
    EXPECT_EQ(readOne("\"gr\xFC\xDF\"=\"\x80\"").data, std::string("€\0", 4));
    EXPECT_EQ(readExchangeText("\xEF\xBB\xBFREGEDIT4\n[HKCU\\größe]\n").at(0).key.path, "größe");
}

TEST(ExchangeText, GivesBackWhatWasWritten) {
    std::string allBytes;
    for (int i = 0; i < 600; ++i) {
        allBytes += static_cast<char>(i % 256);
    }
    const std::vector<Setting> settings = {
        {"", REG_SZ, std::string("x\0", 2)},
        {"quoted \"\\ name\n\x7F\xFF", REG_SZ, std::string("\"C:\\größe\\\"\0", 14)},
        {"lines", REG_SZ, std::string("a\r\nb\0", 5)},
        {"no zero", REG_SZ, "abc"},
        {"no text", REG_SZ, ""},
        {"zero inside", REG_SZ, std::string("a\0b\0", 4)},
        {"broken", REG_SZ, std::string("\xC3\0", 2)},
        {"number", REG_DWORD, std::string("\1\0\0\x80", 4)},
        {"short number", REG_DWORD, "\1"},
        {"bytes", REG_BINARY, allBytes},
        {"other", 0xFFFFFFFF, allBytes},
        {"several", REG_MULTI_SZ, std::string("a\0b\0\0", 5)},
    };
    std::string text = writeHeader() + writeKey({HKEY_CURRENT_USER, "a ] b"});
    for (const Setting& setting : settings) {
        text += writeSetting(setting);
    }
    const auto changes = readExchangeText(text);
    ASSERT_EQ(changes.size(), settings.size() + 1);
    EXPECT_EQ(changes[0].key.path, "a ] b");
    for (std::size_t i = 0; i < settings.size(); ++i) {
        EXPECT_EQ(changes[i + 1].setting.name, settings[i].name);
        EXPECT_EQ(changes[i + 1].setting.type, settings[i].type) << settings[i].name;
        EXPECT_EQ(changes[i + 1].setting.data, settings[i].data) << settings[i].name;
    }
    for (std::size_t at = 0, end = 0; end != std::string::npos; at = end + 1) {
        end = text.find('\n', at);
        EXPECT_LE(std::min(end, text.size()) - at, 82u) << text.substr(at, 100);
    }
}

} // namespace
