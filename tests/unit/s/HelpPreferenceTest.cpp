#include "s/HelpPreference.h"

#include "NoProgramsTest.h"
#include "TestApp.h"
#include "s/Profile.h"

namespace {

/// The application's registry key is "Maker" and its title "Drafts".
class HelpPreference : public NoProgramsTest {
protected:
    void SetUp() override {
        NoProgramsTest::SetUp();
        ::unsetenv("TVX_GUI_HELP_ALWAYS_TO_WEB");
        ::unsetenv("TVX_GUI_HELP_WEB_LOCATION");
        theApp.SetRegistryKey("Maker");
    }

    inline static const char* const settings = "Software\\Maker\\Common\\Settings";
    Gui_HelpPreference m_preference;
};

TEST_F(HelpPreference, GoesToTheWebWhenTheSettingIsOne) {
    EXPECT_FALSE(m_preference.IsAlwaysGoToWeb());
    EXPECT_EQ(stored(settings, "AlwayOnWeb"), "<no key>") << "asking makes nothing";
    for (const auto& [value, expected] : std::vector<std::pair<const char*, bool>>{
             {"1", true}, {"01", true}, {" 1", true}, {"2", false}, {"yes", false}, {"1 ", false}, {"", false}}) {
        store(settings, "AlwayOnWeb", value);
        EXPECT_EQ(m_preference.IsAlwaysGoToWeb(), expected) << '"' << value << '"';
    }
    Gui_Profile::WriteString("1", "AlwayOnWeb", nullptr);
    EXPECT_FALSE(m_preference.IsAlwaysGoToWeb()) << "the application's own settings do not count";
    ::setenv("TVX_GUI_HELP_ALWAYS_TO_WEB", "0", 1);
    EXPECT_TRUE(m_preference.IsAlwaysGoToWeb()) << "to be set is enough";
}

TEST_F(HelpPreference, TakesTheLocationFromEnvironmentAndSettings) {
    EXPECT_TRUE(m_preference.GetUrlPrefix().IsEmpty());
    store(settings, "HelpUrlPrefix", "https://docs/a");
    EXPECT_EQ(m_preference.GetUrlPrefix().str(), "https://docs/a") << "as it is, without a slash of ours";
    ::setenv("TVX_GUI_HELP_WEB_LOCATION", "https://other/", 1);
    EXPECT_EQ(m_preference.GetUrlPrefix().str(), "https://other/");
    ::setenv("TVX_GUI_HELP_WEB_LOCATION", "", 1);
    EXPECT_TRUE(m_preference.GetUrlPrefix().IsEmpty()) << "also an empty one";
}

} // namespace
