// The library while the heap runs out at every place where it can.
#include "TestApp.h"
#include "platform/port/MsgManData.h"
#include "res/resource.h"
#include "s/AccelMap.h"
#include "s/CommandLineState.h"
#include "s/ConsoleHistory.h"
#include "s/FileName.h"
#include "s/HelpMap.h"
#include "s/MessageManager.h"
#include "s/String.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <new>
#include <string>

namespace {

/// Allocations that this thread may still make; negative for any number.
thread_local int allocationsLeft = -1;

/// Runs something with one allocation more each time, until they suffice. Each failure must raise the framework's
/// exception.
/// @return how often it failed
int failuresOf(const std::function<void()>& function) {
    for (int allocations = 0;; ++allocations) {
        try {
            allocationsLeft = allocations;
            function();
            allocationsLeft = -1;
            return allocations;
        } catch (CMemoryException* e) {
            allocationsLeft = -1;
            e->Delete();
        } catch (const std::bad_alloc&) {
            allocationsLeft = -1;
            ADD_FAILURE() << "the standard exception, after allocation " << allocations;
        }
    }
}

} // namespace

[[gnu::noinline]] void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    void* memory = allocationsLeft == 0 ? nullptr : std::malloc(size ? size : 1);
    allocationsLeft -= memory && allocationsLeft > 0;
    return memory;
}

[[gnu::noinline]] void* operator new(std::size_t size) {
    void* memory = operator new(size, std::nothrow);
    if (!memory) {
        throw std::bad_alloc();
    }
    return memory;
}

// The sanitizer's own arrays would not come here.
[[gnu::noinline]] void* operator new[](std::size_t size, const std::nothrow_t&) noexcept {
    return operator new(size, std::nothrow);
}

[[gnu::noinline]] void operator delete[](void* memory) noexcept {
    std::free(memory);
}

[[gnu::noinline]] void operator delete[](void* memory, std::size_t /*size*/) noexcept {
    std::free(memory);
}

[[gnu::noinline]] void* operator new[](std::size_t size) {
    return operator new(size);
}

[[gnu::noinline]] void operator delete(void* memory) noexcept {
    std::free(memory);
}

[[gnu::noinline]] void operator delete(void* memory, std::size_t /*size*/) noexcept {
    std::free(memory);
}

TEST(Heap, AnExhaustedOneRaisesTheFrameworksExceptionFromTexts) {
    const std::string word(100, 'x');
    EXPECT_GT(failuresOf([&] {
                  CString text;
                  text.Format("%s %s", word.c_str(), word.c_str());
                  text.AppendFormat("%s", word.c_str());
              }),
              0);
    EXPECT_GT(failuresOf([] {
                  CString text;
                  EXPECT_TRUE(text.LoadString(GUI_IDS_TUTORIAL_FAILED));
              }),
              0);
    const Gui_String fields((word + ',' + word + ",\"" + word + '"').c_str());
    EXPECT_GT(failuresOf([&] { delete fields.GetStringArray(", \t;, and many more separators", 1, 0); }), 0);
}

namespace {

class Manager : public Gui_MessageManager {
public:
    Manager() : Gui_MessageManager([](CString) {}, [](CString) {}) {}
    using Gui_MessageManager::msgWrite;
};

class CommandLine : public Gui_CommandLineInfo {
public:
    CString GetCmdOpcodes() const override {
        return "layer text repeatable : Layer to show, with a help text of some length.\n";
    }
    CString GetUsageText() const override {
        return "A text behind the usage summary.";
    }
};

} // namespace

TEST(Heap, AnExhaustedOneRaisesTheFrameworksExceptionFromMessagesAndTheCommandLine) {
    Manager manager;
    EXPECT_GT(failuresOf([&] { manager.msgWrite(Port_MsgMan::MsgTypeError, L"a message of some length\nand a line"); }),
              0);
    EXPECT_GT(
        failuresOf([&] { manager.msgWrite(Port_MsgMan::MsgTypeStatus, L"a message of some length\nand a line"); }), 0);

    const std::string file = std::filesystem::temp_directory_path() / "words of some length.cmd";
    std::ofstream(file) << "-layer 'a layer with a name of some length'";
    theApp.start({"-layer", "a layer with a name of some length", "-f", file}, [] {
        EXPECT_GT(failuresOf([] {
                      CommandLine info;
                      theApp.ParseCommandLine(info);
                  }),
                  0);
        CommandLine info;
        theApp.ParseCommandLine(info);
        EXPECT_GT(failuresOf([&] { EXPECT_EQ(theApp.ProcessCommandLine(info), 1); }), 0);
    });
    std::filesystem::remove(file);
}

TEST(Heap, AnExhaustedOneRaisesTheFrameworksExceptionFromFileNames) {
    ::setenv("TVX_DRIVES", "C=/;X=/nowhere/where a share would be|\\\\server\\a share with a long name", 1);
    const Gui_FileName relative("folder with a long name\\another folder with one\\a file with a long name.exe");
    const Gui_FileName share(
        "\\\\server\\a share with a long name\\folder with a long name\\file with a long name.exe");
    EXPECT_GT(failuresOf([&] { (void)relative.IsEquivalent(share); }), 0);
    EXPECT_GT(failuresOf([&] { (void)relative.GetAbbreviatedName(40, 1); }), 0);
    EXPECT_GT(failuresOf([&] { (void)share.GetFullName(0); }), 0);
    for (const Gui_FileName* name : {&relative, &share}) {
        EXPECT_GT(failuresOf([name] { (void)name->IsFile(); }), 0);
        EXPECT_GT(failuresOf([name] { (void)name->IsWritable(); }), 0);
        EXPECT_GT(failuresOf([name] { (void)name->IsExecutable(); }), 0);
    }
    ::unsetenv("TVX_DRIVES");
}

TEST(Heap, AnExhaustedOneRaisesTheFrameworksExceptionFromHelpMaps) {
    namespace fs = std::filesystem;
    const std::string root = fs::temp_directory_path() / "an installation with a long name";
    fs::create_directories(root + "/share/helpmap");
    fs::current_path(root + "/share/helpmap");
    std::ofstream("a.map") << "[topic  1]\nfile = a document with a long name.htm\n# b\ntitle = Title\n[topic 2]\n";
    std::ofstream("b.map") << "[topic 3]\ntitle = no document";
    ::setenv("TARVEX", root.c_str(), 1);
    EXPECT_GT(failuresOf([] { EXPECT_FALSE(GetMapFileForPackage("a").IsEmpty()); }), 0);
    EXPECT_GT(failuresOf([] {
                  Gui_HelpMap read;
                  EXPECT_TRUE(read.Read("a.map"));
              }),
              0);
    Gui_HelpMap map;
    EXPECT_TRUE(map.Read("a.map"));
    EXPECT_GT(failuresOf([&] {
                  Port::StringBase<char> type;
                  EXPECT_FALSE(map.LookupContext(1, type).IsEmpty());
              }),
              0);
    ::unsetenv("TARVEX");
    fs::current_path("/");
    fs::remove_all(root);
}

TEST(Heap, AnExhaustedOneGivesNoTableOfAccelerators) {
    const tagACCEL accels[] = {{FVIRTKEY, VK_F2, 1}, {FVIRTKEY, VK_F3, 2}};
    Gui_AccelMap map;
    EXPECT_GT(failuresOf([&] { map = Gui_AccelMap(accels, 2); }), 0);
    int count = 7;
    tagACCEL anything{};
    tagACCEL* table = &anything;
    allocationsLeft = 0;
    map.GetAll(count, table);
    allocationsLeft = -1;
    EXPECT_EQ(count, 0);
    EXPECT_EQ(table, nullptr);
}

TEST(Heap, AnExhaustedOneLeavesNoHalfLinesInAConsolesHistory) {
    Gui_ConsoleHistory history;
    const unsigned long first = NextCommandNumber();
    for (int i = 0; i < 40; ++i) {
        EXPECT_GT(failuresOf([&] { history.AddCommand("run b"); }), 0);
    }
    EXPECT_EQ(40, history.GetCommands().GetSize());
    EXPECT_EQ(40, history.GetLines().GetSize());
    EXPECT_EQ(first + 40, NextCommandNumber());
    EXPECT_TRUE(history.Resolve("!run").runs);
}
