// What file names ask the file system and the network.
#include "s/FileName.h"

#include "platform/base/Text.h"
#include "platform/win/Drives.h"
#include "platform/win/Files.h"
#include "s/FileNameNetwork.h"
#include "s/FileNameRecord.h"
#include "s/FileNameText.h"

#include <algorithm>

using namespace FileNameText;

namespace {

constexpr const char* probeName = "__tvx__.___";

int uncFlag = 1;

/// The form in which the file system is asked. A drive alone means its root.
CString fileSystemForm(const Gui_FileName& name) {
    const CString form = name.GetFullName(0, nullptr, nullptr, nullptr, nullptr, 1);
    return form.GetLength() == 2 && form[1] == ':' ? form + "\\." : form;
}

tvx::FileKind kindOf(const Gui_FileName& name) {
    return tvx::allocating([&name] { return tvx::fileKind(fileSystemForm(name)); });
}

/// Removable media may be write-protected without the system knowing: only writing tells.
bool canCreateFileIn(const CString& root) {
    const CString probe = root + probeName;
    const HANDLE file = CreateFileA(probe, GENERIC_WRITE, 0, nullptr, OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) {
        return false;
    }
    CloseHandle(file);
    DeleteFileA(probe);
    return true;
}

bool isDriveWritable(const CString& root) {
    switch (GetDriveTypeA(root)) {
    case DRIVE_CDROM:
        return false;
    case DRIVE_REMOVABLE:
        return canCreateFileIn(root);
    default:
        return true;
    }
}

bool isWritable(const CString& form) {
    const DWORD attributes = GetFileAttributesA(form);
    if (attributes == INVALID_FILE_ATTRIBUTES || (attributes & FILE_ATTRIBUTE_READONLY)) {
        return false;
    }
    return form.GetLength() < 3 || form[1] != ':' || isDriveWritable(form.Left(2) + Separator);
}

} // namespace

int Gui_FileName::Exists() const {
    return kindOf(*this) != tvx::FileKind::None;
}

int Gui_FileName::IsReadable() const {
    return Exists();
}

int Gui_FileName::IsDirectory() const {
    return kindOf(*this) == tvx::FileKind::Folder;
}

int Gui_FileName::IsFile() const {
    const tvx::FileKind kind = kindOf(*this);
    return kind == tvx::FileKind::File || kind == tvx::FileKind::Device;
}

int Gui_FileName::IsWritable() const {
    return tvx::allocating([this] { return isWritable(fileSystemForm(*this)); });
}

int Gui_FileName::IsDeletable() const {
    return IsWritable();
}

int Gui_FileName::IsExecutable() const {
    constexpr const char* programs[] = {".BAT", ".EXE", ".COM"};
    const auto hasExtension = [this](const char* extension) { return HasExtension(extension) != 0; };
    return std::ranges::any_of(programs, hasExtension) && Exists();
}

int Gui_FileName::GetRemoteMountName(CString& mount, int uncOnly) {
    if (!GetUncFlag() || mount.View().starts_with(NetworkMark)) {
        return 1;
    }
    const char letter = mount.IsEmpty() ? '\0' : static_cast<char>(mount[0] | 0x20);
    const CString share = letter >= 'a' && letter <= 'z' ? ShareOfDrive(letter) : CString();
    if (share.IsEmpty() || (uncOnly && !share.View().starts_with(NetworkMark))) {
        return 0;
    }
    mount = share;
    mount.MakeLower();
    return 1;
}

int Gui_FileName::GetNetworkName(CString&) {
    return 0;
}

void Gui_FileName::SetUncFlag(int flag) {
    uncFlag = flag;
}

int Gui_FileName::GetUncFlag() {
    return uncFlag;
}
