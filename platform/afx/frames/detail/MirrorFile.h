#pragma once

#include "platform/base/File.h"

#include <filesystem>
#include <string>
#include <sys/stat.h>

namespace tvx::afx {

/// A file that replaces another one only when it is complete: opened for creation it is written beside the named file
/// and takes its place in Close. Abort, or its end without Close, leaves the named file as it was.
///
/// Permissions are kept. A symbolic link goes on pointing to its file; a file with several names keeps them, since then
/// the contents are copied into it. The same happens in folders that no new file can be made in.
///
/// A named pipe is refused with ESPIPE: opening it would wait for somebody at its other end.
class TVX_PLATFORM_API MirrorFile : public CFile {
public:
    MirrorFile() = default;
    ~MirrorFile() override;

    BOOL Open(LPCTSTR fileName, UINT openFlags, CFileException* error = nullptr) override;
    void Close() override;
    void Abort() override;

private:
    bool openBeside(LPCTSTR fileName, CFileException* error);
    int makeBeside(const std::filesystem::path& target, const struct stat* replaced);
    void forget();
    std::string m_target;    ///< The system's name of the file to be replaced; empty for files written in place.
    std::string m_temporary; ///< Where it is written meanwhile.
    bool m_copies = false;   ///< Whether the contents are copied instead of the name moved.
};

} // namespace tvx::afx
