#include "platform/port/CmdFile.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/port/MsgManData.h"
#include "platform/port/detail/CommandFile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <fcntl.h>
#include <span>
#include <string>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <vector>

namespace {

constexpr std::size_t deepestNesting = 64;
/// A file larger than this is no command file but a mistake.
constexpr std::size_t largestFile = 64u << 20;

/// A file in expansion. Device and inode tell it whatever name leads to it.
struct ActiveFile {
    std::string name;
    dev_t device;
    ino_t inode;
};

/// The files being expanded, the outermost first.
std::vector<const ActiveFile*>& chain() {
    thread_local std::vector<const ActiveFile*> files;
    return files;
}

std::string chainText() {
    std::string text;
    for (const ActiveFile* file : chain()) {
        text += (text.empty() ? "" : " -> ") + file->name;
    }
    return text;
}

class Descriptor {
public:
    /// Opening a pipe would wait for its writer.
    explicit Descriptor(const char* name)
        : m_number(::open(tvx::systemPath(name).value_or(name).c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK)) {
    }
    ~Descriptor() {
        if (m_number >= 0) {
            ::close(m_number);
        }
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int number() const {
        return m_number;
    }

private:
    int m_number;
};

std::string systemReason() {
    return std::generic_category().message(errno);
}

/// Reads all of a file; the reason when that cannot be done, else an empty text.
std::string readAll(const Descriptor& file, std::string& text) {
    std::array<char, 65536> buffer;
    for (;;) {
        const ssize_t count = ::read(file.number(), buffer.data(), buffer.size());
        if (count == 0) {
            break;
        }
        if (count > 0) {
            text.append(buffer.data(), static_cast<std::size_t>(count));
        } else if (errno != EINTR) {
            return systemReason();
        }
        if (text.size() > largestFile) {
            return "it is larger than 64 MB";
        }
    }
    return text.find('\0') == std::string::npos ? "" : "it holds zero bytes, so it is not a text in UTF-8";
}

bool isCommandFileSwitch(const char* argument) {
    return (argument[0] == '-' || argument[0] == '/') && tvx::text::equalNoCase(argument + 1, "f");
}

} // namespace

struct UT_CMDFILE::Impl {
    explicit Impl(Reporting reporting) : m_reporting(reporting) {}

    ~Impl() {
        std::erase(chain(), &m_file);
    }

    void expand(std::span<const char* const> arguments) {
        const auto first = arguments.empty() ? arguments.begin() : arguments.begin() + 1;
        const auto found = std::find_if(first, arguments.end(), isCommandFileSwitch);
        m_words.assign(arguments.begin(), found);
        if (arguments.end() - found >= 2) {
            addFile(found[1]);
            m_words.insert(m_words.end(), found + 2, arguments.end());
        } else {
            m_words.insert(m_words.end(), found, arguments.end());
        }
        for (std::string& word : m_words) {
            m_vector.push_back(word.data());
        }
        m_vector.push_back(nullptr);
    }

    void addFile(const char* name) {
        const Descriptor file(name);
        struct stat status{};
        m_file.name = name;
        if (file.number() < 0 || ::fstat(file.number(), &status) != 0) {
            return refuseUnreadable(systemReason());
        }
        // Who goes through a command line twice would get nothing the second time, or wait for ever.
        if (!S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode)) {
            return refuseUnreadable("it is a pipe or a device, and not a file");
        }
        m_file.device = status.st_dev;
        m_file.inode = status.st_ino;
        if (isBeingExpanded()) {
            return refuse("is being expanded already", chainText() + " -> " + m_file.name);
        }
        if (chain().size() >= deepestNesting) {
            return refuse("is nested too deep", chainText() + " -> " + m_file.name);
        }
        std::string text;
        const std::string reason = readAll(file, text);
        if (!reason.empty()) {
            return refuseUnreadable(reason);
        }
        chain().push_back(&m_file);
        addWords(text);
    }

    bool isBeingExpanded() const {
        return std::any_of(chain().begin(), chain().end(), [this](const ActiveFile* outer) {
            return outer->device == m_file.device && outer->inode == m_file.inode;
        });
    }

    void addWords(const std::string& text) {
        Port::detail::CommandWords read = Port::detail::splitCommandText(text);
        m_words.insert(m_words.end(), std::make_move_iterator(read.words.begin()),
                       std::make_move_iterator(read.words.end()));
        for (const std::size_t line : read.unclosedLines) {
            fail(tvx::text::format("Command file \"%s\", line %zu: a quote is not closed.", m_file.name.c_str(), line));
        }
    }

    void refuseUnreadable(const std::string& reason) {
        refuse("cannot be read", chain().empty() ? reason : reason + " (named in " + chainText() + ")");
    }

    void refuse(const char* what, const std::string& reason) {
        fail(tvx::text::format("Command file \"%s\" %s: %s.", m_file.name.c_str(), what, reason.c_str()));
    }

    void fail(const std::string& message) {
        m_errors.push_back(message);
        if (m_reporting == Reporting::Issue) {
            Port_MsgManData::createObject("Port", "platform/port/CmdFile", __LINE__, "")
                .issueError("%s", message.c_str());
        }
    }

    Reporting m_reporting;
    ActiveFile m_file{};
    std::vector<std::string> m_words;
    std::vector<char*> m_vector;
    std::vector<std::string> m_errors;
};

UT_CMDFILE::UT_CMDFILE(int argc, const char* const* argv, Reporting reporting)
    : m_impl(std::make_unique<Impl>(reporting)) {
    m_impl->expand({argv, argv && argc > 0 ? static_cast<std::size_t>(argc) : 0});
}

UT_CMDFILE::~UT_CMDFILE() = default;

int UT_CMDFILE::getargc() const {
    return static_cast<int>(m_impl->m_words.size());
}

char** UT_CMDFILE::getargv() const {
    return m_impl->m_vector.data();
}

bool UT_CMDFILE::iserror() const {
    return !m_impl->m_errors.empty();
}

const std::vector<std::string>& UT_CMDFILE::geterrors() const {
    return m_impl->m_errors;
}
