// Reads arbitrary text as the installation's file and checks what holds for every one.
#include "s/Version.h"

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <iterator>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

namespace {

/// An installation of its own, in memory where there is a file system for that.
class Installation {
public:
    Installation() {
        const bool inMemory = ::access("/dev/shm", W_OK) == 0;
        std::string pattern = std::string(inMemory ? "/dev/shm" : "/tmp") + "/tvx-fuzz.XXXXXX";
        m_root = ::mkdtemp(pattern.data());
        ::setenv("TARVEX", m_root.c_str(), 1);
        ::unsetenv("MYTARVEX");
        m_file = ::open((m_root + "/fileset.txt").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
    }
    ~Installation() {
        ::close(m_file);
        std::filesystem::remove_all(m_root);
    }
    Installation(const Installation&) = delete;
    Installation& operator=(const Installation&) = delete;

    /// Replaces the file's contents by newer ones.
    void write(const std::string& contents) {
        const timespec stamps[] = {{++m_time, 0}, {m_time, 0}};
        if (::ftruncate(m_file, 0) != 0 ||
            ::pwrite(m_file, contents.data(), contents.size(), 0) != static_cast<ssize_t>(contents.size()) ||
            ::futimens(m_file, stamps) != 0) {
            std::abort();
        }
    }

private:
    std::string m_root;
    int m_file;
    long m_time = 0;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static Installation installation;
    const std::string text(reinterpret_cast<const char*>(data), size);
    installation.write(text);
    // Each question asks the file system anew, which costs more than all the reading: one for each input.
    static constexpr const char* keys[] = {"version", "summary", "pdfViewer", "a"};
    const char* const key = keys[size % std::size(keys)];
    const char* const value = Gui_InstallInfo::GetValue(key);
    // Nothing stays behind of the input before either.
    if (value && (std::strlen(value) > 255 || text.find(key) == std::string::npos)) {
        std::abort();
    }
    return 0;
}
