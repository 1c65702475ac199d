#include "StoreTest.h"
#include "TestApp.h"
#include "platform/win/ProcessMark.h"
#include "s/Process.h"
#include "s/Profile.h"
#include "tests/unit/SavedEnvironment.h"

#include <unistd.h>

namespace {

constexpr const char* recordKey = "Software\\Tarvex\\testapp\\FirstInstance";

/// The record of an application's first instance, and another process of the user's.
class Instance : public StoreTest {
protected:
    Instance() {
        EXPECT_EQ(m_other.Run("sleep 1000", nullptr, 0, 1), 1);
    }
    static void write(const char* processId, const char* windowId) {
        put("ProcessID", processId);
        put("WindowID", windowId);
    }
    static void put(const char* name, const std::string& text) {
        HKEY key = nullptr;
        RegCreateKeyExA(HKEY_CURRENT_USER, recordKey, 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr);
        RegSetValueExA(key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.c_str()),
                       static_cast<DWORD>(text.size() + 1));
        RegCloseKey(key);
    }
    std::string other() const {
        return std::to_string(m_other.GetProcessId());
    }
    static std::string own() {
        return std::to_string(::getpid());
    }
    static std::string record() {
        return stored(recordKey, "ProcessID") + " " + stored(recordKey, "WindowID");
    }

    SavedEnvironment m_environment;
    Gui_Process m_other;
};

} // namespace

TEST_F(Instance, RegistersShowsAndUnregistersItself) {
    EXPECT_EQ(theApp.IsFirstInstance(), 1);
    theApp.RegisterInstanceWindow(4711);
    EXPECT_EQ(record(), "<no value> <no value>") << "not registered yet";
    put("WindowID", "99");
    EXPECT_EQ(theApp.RegisterInstance(), 1);
    EXPECT_EQ(record(), own() + " 0") << "a window of an earlier instance is forgotten";
    EXPECT_EQ(theApp.IsFirstInstance(), 0) << "this process is alive";
    theApp.RegisterInstanceWindow(0xFFFFFFFF);
    EXPECT_EQ(record(), own() + " -1");
    theApp.UnregisterInstance();
    EXPECT_EQ(record(), "0 0");
    EXPECT_EQ(theApp.IsFirstInstance(), 1);
    theApp.RegisterInstanceWindow(5);
    EXPECT_EQ(record(), "0 5") << "the process stays one that has registered";
}

TEST_F(Instance, FollowsARecordOfALiveProcess) {
    write(other().c_str(), "0");
    EXPECT_EQ(theApp.IsFirstInstance(), 0);
    EXPECT_EQ(theApp.ShowFirstInstanceWindow(), 0) << "it has no window yet";
    put("WindowID", "1");
    EXPECT_EQ(theApp.ShowFirstInstanceWindow(), 0) << "there is no such window";
    theApp.UnregisterInstance();
    EXPECT_EQ(record(), other() + " 1") << "the record of another process";
    m_other.Terminate(3);
    m_other.Wait(INFINITE);
    EXPECT_EQ(theApp.IsFirstInstance(), 1);
    EXPECT_EQ(theApp.ShowFirstInstanceWindow(), 0);
}

TEST_F(Instance, TakesDamagedRecordsForNone) {
    for (const char* text : {"", "0", "12x", "12345678901234567890123", "-1", "99999999999"}) {
        write(text, "1");
        EXPECT_EQ(theApp.IsFirstInstance(), 1) << text;
        EXPECT_EQ(theApp.ShowFirstInstanceWindow(), 0) << text;
    }
    Gui_Profile::WriteFirstInstanceInfo("notes", "ProcessID", m_other.GetProcessId());
    EXPECT_EQ(theApp.IsFirstInstance(), 1) << "another application";
}

TEST_F(Instance, IsNotLockedOutByAProcessThatGotTheSameNumber) {
    const std::string mark = tvx::processMark(static_cast<DWORD>(m_other.GetProcessId()));
    ASSERT_TRUE(mark.starts_with(other() + " "));
    write(other().c_str(), "1");
    put("ProcessMark", mark);
    EXPECT_EQ(theApp.IsFirstInstance(), 0) << "the very process";
    put("ProcessMark", mark + "0");
    EXPECT_EQ(theApp.IsFirstInstance(), 1) << "a process that started at another time";
    EXPECT_EQ(theApp.ShowFirstInstanceWindow(), 0);
    put("ProcessMark", other() + " 01234567-0000-0000-0000-000000000000" + mark.substr(mark.rfind(' ')));
    EXPECT_EQ(theApp.IsFirstInstance(), 1) << "one that started as late after another boot";
    // What says nothing about the recorded process leaves it alive.
    for (const std::string& text : {std::string(), "1" + mark, std::string(500, '1'), std::string("damaged")}) {
        put("ProcessMark", text);
        EXPECT_EQ(theApp.IsFirstInstance(), 0) << text;
    }
}

TEST_F(Instance, LeavesTheRecordAloneWhenTheProtocolIsOff) {
    write(other().c_str(), "1");
    for (const char* off : {"0", "0x", "00"}) {
        setenv("TVX_GUI_INSTANCECHECKING", off, 1);
        EXPECT_EQ(theApp.IsFirstInstance(), 1) << off;
        EXPECT_EQ(theApp.RegisterInstance(), 1) << off;
        theApp.UnregisterInstance();
        EXPECT_EQ(record(), other() + " 1") << off;
    }
    for (const char* on : {"", "1", "no"}) {
        setenv("TVX_GUI_INSTANCECHECKING", on, 1);
        EXPECT_EQ(theApp.IsFirstInstance(), 0) << on;
    }
    write(own().c_str(), "7");
    setenv("TVX_GUI_INSTANCECHECKING", "0", 1);
    theApp.UnregisterInstance();
    EXPECT_EQ(record(), own() + " 7") << "nor is its own taken out";
}
