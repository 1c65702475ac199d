#include "platform/port/File.h"

#include "platform/base/SystemPath.h"

#include <fcntl.h>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

namespace Port {

namespace {

/// A stream with a descriptor of its own.
class FileStream : public Stream {
public:
    explicit FileStream(int descriptor) : Stream(descriptor), m_descriptor(descriptor) {}
    ~FileStream() override {
        ::close(m_descriptor);
    }
    FileStream(const FileStream&) = delete;
    FileStream& operator=(const FileStream&) = delete;

private:
    int m_descriptor;
};

bool isFile(int descriptor) {
    struct stat status{};
    return ::fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode);
}

std::optional<std::string> systemName(const char* path) {
    return path ? tvx::systemPath(path) : std::nullopt;
}

} // namespace

Stream& File::getCout() {
    static Stream& stream = *new Stream(STDOUT_FILENO);
    return stream;
}

Stream& File::getCerr() {
    static Stream& stream = *new Stream(STDERR_FILENO);
    return stream;
}

Stream* File::open(const char* path, Access, Flag) {
    const std::optional<std::string> name = systemName(path);
    if (!name) {
        return nullptr;
    }
    // Opening a pipe must not wait for its writer.
    const int descriptor = ::open(name->c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (descriptor >= 0 && isFile(descriptor)) {
        return new FileStream(descriptor);
    }
    if (descriptor >= 0) {
        ::close(descriptor);
    }
    return nullptr;
}

void File::close(Stream* stream) {
    delete stream;
}

bool File::exist(const char* path) {
    const std::optional<std::string> name = systemName(path);
    struct stat status{};
    return name && ::stat(name->c_str(), &status) == 0 && S_ISREG(status.st_mode);
}

bool File::canread(const char* path) {
    const std::optional<std::string> name = exist(path) ? systemName(path) : std::nullopt;
    return name && ::access(name->c_str(), R_OK) == 0;
}

bool File::getdatetime(const char* path, std::int64_t& time) {
    const std::optional<std::string> name = systemName(path);
    struct stat status{};
    if (!name || ::stat(name->c_str(), &status) != 0) {
        return false;
    }
    time = status.st_mtim.tv_sec;
    return true;
}

} // namespace Port
