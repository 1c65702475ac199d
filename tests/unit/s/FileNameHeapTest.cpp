// File names while the heap runs out at every place where it can.
#include "s/FileName.h"

#include <cstdlib>
#include <functional>
#include <gtest/gtest.h>
#include <new>

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

[[gnu::noinline]] void* operator new(std::size_t size) {
    void* memory = allocationsLeft == 0 ? nullptr : std::malloc(size ? size : 1);
    if (!memory) {
        throw std::bad_alloc();
    }
    allocationsLeft -= allocationsLeft > 0;
    return memory;
}

[[gnu::noinline]] void operator delete(void* memory) noexcept {
    std::free(memory);
}

[[gnu::noinline]] void operator delete(void* memory, std::size_t /*size*/) noexcept {
    std::free(memory);
}

TEST(FileNameHeap, AnExhaustedOneRaisesTheFrameworksException) {
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
