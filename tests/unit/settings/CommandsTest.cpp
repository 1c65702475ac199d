#include "tools/settings/Commands.h"

#include "tests/unit/win/RegistrySandbox.h"

#include <fstream>
#include <sstream>

using settings::Outcome;

namespace {

class Commands : public ::testing::Test {
protected:
    Outcome run(const std::vector<std::string>& words, const std::string& input = {}) {
        std::istringstream in(input);
        std::ostringstream out;
        std::ostringstream errors;
        const Outcome outcome = settings::run(words, in, out, errors);
        m_out = out.str();
        m_errors = errors.str();
        return outcome;
    }
    /// All that is stored, as text.
    std::string everything() {
        EXPECT_EQ(run({"export"}), Outcome::Done);
        return m_out;
    }

    RegistrySandbox m_sandbox;
    std::string m_out;
    std::string m_errors;
};

TEST_F(Commands, SetAndGetValues) {
    const std::string key = "Software\\Tarvex";
    EXPECT_EQ(run({"set", key, "Unit", "größe 1"}), Outcome::Done);
    EXPECT_EQ(run({"set", "-t", "number", key, "N", "0x10"}), Outcome::Done);
    EXPECT_EQ(run({"set", "-t", "bytes", key, "B", "00 ff,7a"}), Outcome::Done);
    EXPECT_EQ(run({"set", "--", key, "@", "-x"}), Outcome::Done);
    EXPECT_EQ(run({"get", key, "unit"}), Outcome::Done);
    EXPECT_EQ(m_out, "größe 1\n");
    EXPECT_EQ(run({"get", "HKEY_CURRENT_USER\\" + key, "N"}), Outcome::Done);
    EXPECT_EQ(m_out, "16\n");
    EXPECT_EQ(run({"get", key, "B"}), Outcome::Done);
    EXPECT_EQ(m_out, "00 ff 7a\n");
    EXPECT_EQ(run({"get", key, "@"}), Outcome::Done);
    EXPECT_EQ(m_out, "-x\n");
    EXPECT_EQ(run({"list", "Software"}), Outcome::Done);
    EXPECT_EQ(m_out, "[HKEY_CURRENT_USER\\Software\\Tarvex]\n");
    EXPECT_EQ(run({"list", key}), Outcome::Done);
    EXPECT_EQ(m_out, "@=\"-x\"\n\"B\"=hex:00,ff,7a\n\"N\"=dword:00000010\n\"Unit\"=\"größe 1\"\n");
}

TEST_F(Commands, TellWhatIsMissing) {
    EXPECT_EQ(run({"get", "Software", "a"}), Outcome::Missing);
    EXPECT_EQ(m_errors, "tvxsettings: HKEY_CURRENT_USER\\Software: it does not exist.\n");
    run({"set", "Software", "b", "1"});
    EXPECT_EQ(run({"get", "Software", "a"}), Outcome::Missing);
    EXPECT_EQ(m_errors, "tvxsettings: HKEY_CURRENT_USER\\Software, \"a\": it does not exist.\n");
    EXPECT_EQ(run({"list", "Nowhere"}), Outcome::Missing);
    EXPECT_EQ(run({"delete", "-r", "Nowhere"}), Outcome::Missing);
    EXPECT_EQ(run({"set", "HKLM\\Software", "a", "1"}), Outcome::Failed);
    EXPECT_EQ(everything(), "REGEDIT4\n\n[HKEY_CURRENT_USER\\Software]\n\"b\"=\"1\"\n\n");
}

TEST_F(Commands, DeleteValuesAndTrees) {
    run({"set", "a\\b\\c", "v", "1"});
    run({"set", "a", "v", "1"});
    EXPECT_EQ(run({"delete", "a", "v"}), Outcome::Done);
    EXPECT_EQ(run({"delete", "a", "v"}), Outcome::Missing);
    EXPECT_EQ(run({"delete", "-r", "a"}), Outcome::Done);
    EXPECT_EQ(everything(), "REGEDIT4\n\n[HKEY_CURRENT_USER]\n\n");
}

TEST_F(Commands, ImportWhatWasExported) {
    run({"set", "Software\\Tarvex\\Common", "Browser", "\"C:\\x\" %1"});
    run({"set", "-t", "bytes", "Software\\Tarvex", "Bytes", std::string(1000, '5')});
    run({"set", "Empty", "a", ""});
    run({"delete", "Empty", "a"});
    const std::string text = everything();
    const std::string file = (m_sandbox.folder / "all.reg").string();
    EXPECT_EQ(run({"export", "-o", file, "Software"}), Outcome::Done);
    EXPECT_EQ(m_out, "");
    RegistrySandbox::use(m_sandbox.folder / "other.db");
    EXPECT_EQ(run({"import", "-"}, text), Outcome::Done);
    EXPECT_EQ(everything(), text);
    RegistrySandbox::use(m_sandbox.folder / "third.db");
    EXPECT_EQ(run({"import", file}), Outcome::Done);
    EXPECT_EQ(everything(), "REGEDIT4\n\n" + text.substr(text.find("[HKEY_CURRENT_USER\\Software")));
}

TEST_F(Commands, ImportAllOrNothing) {
    run({"set", "k", "old", "1"});
    const std::string before = everything();
    const std::string head = "REGEDIT4\n[-HKCU\\k]\n[HKCU\\new]\n\"a\"=\"1\"\n";
    EXPECT_EQ(run({"import", "-"}, head + "\"b\"=nonsense\n"), Outcome::BadFile);
    EXPECT_EQ(m_errors, "tvxsettings: standard input:5: expected a text in quotes, dword:, hex: or -\n");
    EXPECT_EQ(everything(), before);
    EXPECT_EQ(run({"import", "-"}, head + "[HKLM\\Software]\n"), Outcome::Failed);
    EXPECT_EQ(m_errors.substr(0, 30), "tvxsettings: standard input:5:");
    EXPECT_EQ(everything(), before);
    EXPECT_EQ(run({"import", (m_sandbox.folder / "none.reg").string()}), Outcome::BadFile);
    EXPECT_NE(m_errors.find("none.reg: No such file"), std::string::npos) << m_errors;
    EXPECT_EQ(run({"import", "-"}, head + "[-HKCU\\never]\n[HKCU\\new]\n\"never\"=-\n"), Outcome::Done);
    EXPECT_EQ(everything(), "REGEDIT4\n\n[HKEY_CURRENT_USER\\new]\n\"a\"=\"1\"\n\n");
}

TEST_F(Commands, TellOfPlacesThatAreOfNoUse) {
    EXPECT_EQ(run({"import", m_sandbox.folder.string()}), Outcome::BadFile);
    EXPECT_EQ(m_errors, "tvxsettings: " + m_sandbox.folder.string() + ": Is a directory\n");
    const auto before = std::filesystem::current_path();
    const auto gone = m_sandbox.folder / "gone";
    std::filesystem::create_directory(gone);
    std::filesystem::current_path(gone);
    std::filesystem::remove(gone);
    RegistrySandbox::use("registry.db");
    EXPECT_EQ(run({"set", "Software", "a", "1"}), Outcome::Failed);
    std::filesystem::current_path(before);
}

TEST_F(Commands, ExplainThemselves) {
    EXPECT_EQ(run({"--help"}), Outcome::Done);
    EXPECT_NE(m_out.find("import FILE"), std::string::npos);
    EXPECT_EQ(run({"get", "--help"}), Outcome::Done);
    EXPECT_EQ(run({}), Outcome::Misused);
    EXPECT_EQ(run({"frob"}), Outcome::Misused);
    EXPECT_EQ(m_errors, "tvxsettings: unknown command \"frob\". See tvxsettings --help.\n");
    EXPECT_EQ(run({"get", "a"}), Outcome::Misused);
    EXPECT_EQ(run({"get", "a", "b", "c"}), Outcome::Misused);
    EXPECT_EQ(run({"list", "-x"}), Outcome::Misused);
    EXPECT_EQ(run({"delete", "a"}), Outcome::Misused);
    EXPECT_EQ(run({"set", "-t", "number", "a", "b", "-1"}), Outcome::Misused);
    EXPECT_EQ(run({"set", "-t", "bytes", "a", "b", "123"}), Outcome::Misused);
    EXPECT_FALSE(std::filesystem::exists(m_sandbox.file));
}

} // namespace
