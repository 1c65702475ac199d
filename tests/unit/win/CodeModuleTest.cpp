// Real shared objects in real folders: where they are looked for, what is refused, what they export.
#include "platform/win/Module.h"
#include "platform/win/ResourceLibrary.h"

#include "platform/win/Error.h"
#include "tests/unit/SavedEnvironment.h"
#include "tests/unit/base/FileTestFolder.h"

#include <dlfcn.h>

#include <filesystem>
#include <string>

namespace {

namespace fs = std::filesystem;

class CodeModule : public FileTestFolder {
protected:
    CodeModule() {
        fs::create_directories("mine/lib");
        fs::create_directories("path");
        setenv("MYTARVEX", (m_folder + "/mine").c_str(), 1);
        setenv("TVX_RESOURCE_PATH", (m_folder + "/path").c_str(), 1);
    }
    static void place(const std::string& name) {
        fs::copy_file(TVX_TEST_PLUG_IN, name);
    }
    /// What its function answers; -1 when it is not loaded.
    static int answer(const std::string& name) {
        const HMODULE module = LoadLibraryA(name.c_str());
        if (!module) {
            return -1;
        }
        const auto function = reinterpret_cast<int (*)()>(GetProcAddress(module, "answerOfPlugIn"));
        const int result = function ? function() : 0;
        EXPECT_TRUE(FreeLibrary(module));
        return result;
    }

private:
    SavedEnvironment m_environment;
};

} // namespace

TEST_F(CodeModule, IsFoundByNameAndByPath) {
    place("mine/lib/libplot.so");
    for (const char* name : {"plot", "plot.dll", "PLOT.DLL", "plot.so", "plot."}) {
        EXPECT_EQ(answer(name), 42) << name;
    }
    place("mine/lib/plain.so");
    EXPECT_EQ(answer("plain"), 42);
    place("plug.ext");
    EXPECT_EQ(answer(m_folder + "/plug.ext"), 42);
    EXPECT_EQ(answer(drive("plug.ext")), 42);
}

TEST_F(CodeModule, IsTakenFromTheInstallationOnly) {
    place("libplot.so");
    place("path/libplot.so");
    place("mine/lib/plot.DEU"); // code in the place of texts
    setenv("LD_LIBRARY_PATH", (m_folder + "/path").c_str(), 1);
    for (const char* name : {"plot", "libplot.so", "./libplot.so", "path/libplot.so", "libc.so.6", "m"}) {
        EXPECT_EQ(answer(name), -1) << name;
        EXPECT_EQ(GetLastError(), ERROR_MOD_NOT_FOUND) << name;
    }
    EXPECT_EQ(answer("plot.DEU"), -1);
    EXPECT_EQ(GetLastError(), ERROR_BAD_EXE_FORMAT);
}

TEST_F(CodeModule, IsRefusedWhenItIsDamaged) {
    const std::string whole = get(TVX_TEST_PLUG_IN);
    for (const std::string& bytes :
         {std::string(), whole.substr(0, 40), "\x7F" + std::string(100, 'E'), whole.substr(1)}) {
        put("mine/lib/libplot.so", bytes);
        EXPECT_EQ(answer("plot"), -1) << bytes.size();
        EXPECT_EQ(GetLastError(), ERROR_BAD_EXE_FORMAT) << bytes.size();
    }
}

TEST_F(CodeModule, IsUnloadedWhenEveryUseIsGivenBack) {
    place("mine/lib/libplot.so");
    const HMODULE module = LoadLibraryA("plot");
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(LoadLibraryA("plot.dll"), module);
    EXPECT_EQ(GetModuleHandleA("PLOT.DLL"), module);
    EXPECT_TRUE(FreeLibrary(module));
    EXPECT_NE(GetProcAddress(module, "answerOfPlugIn"), nullptr);
    const std::string file = tvx::moduleFileName(module);
    EXPECT_EQ(file, fs::canonical("mine/lib/libplot.so"));
    EXPECT_TRUE(FreeLibrary(module));
    EXPECT_EQ(dlopen(file.c_str(), RTLD_LAZY | RTLD_NOLOAD), nullptr);
    EXPECT_FALSE(FreeLibrary(module));
    EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
    EXPECT_EQ(GetModuleHandleA("plot"), nullptr);
}

TEST_F(CodeModule, IsTheModuleThatItsResourcesBelongTo) {
    const HMODULE linked = GetModuleHandleA("win-test-extension");
    ASSERT_NE(linked, nullptr);
    EXPECT_EQ(LoadLibraryA(tvx::moduleFileName(linked).c_str()), linked);
    EXPECT_TRUE(FreeLibrary(linked));
    EXPECT_EQ(GetModuleHandleA("win-test-extension"), linked);
    EXPECT_FALSE(FreeLibrary(linked));
}

TEST_F(CodeModule, AnswersForNothingThatItDoesNotExport) {
    place("mine/lib/libplot.so");
    const HMODULE module = LoadLibraryA("plot");
    const HMODULE texts = LoadLibraryA("win-tests.DEU");
    ASSERT_TRUE(module && texts);
    for (const auto& [asked, name] : {std::pair(module, "hiddenAnswerOfPlugIn"), std::pair(module, "malloc"),
                                      std::pair(module, ""), std::pair(module, MAKEINTRESOURCE(1)),
                                      std::pair(texts, "answerOfPlugIn"), std::pair(HMODULE(), "answerOfPlugIn")}) {
        SetLastError(ERROR_SUCCESS);
        EXPECT_EQ(GetProcAddress(asked, name), nullptr);
        EXPECT_EQ(GetLastError(), ERROR_PROC_NOT_FOUND);
    }
    FreeLibrary(texts);
    FreeLibrary(module);
}
