// Whole names, made from the parts and what stands in for those that are missing.
#include "s/FileName.h"

#include "afxwin.h"
#include "platform/base/Text.h"
#include "platform/win/Drives.h"
#include "platform/win/Files.h"
#include "s/FileNameNetwork.h"
#include "s/FileNameRecord.h"
#include "s/FileNameText.h"

#include <algorithm>
#include <cstdlib>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

using namespace FileNameText;

namespace {

CString currentDirectory() {
    CString folder;
    DWORD room = 0;
    for (DWORD needed = GetCurrentDirectoryA(0, nullptr); needed > room;) {
        room = needed;
        needed = GetCurrentDirectoryA(room, folder.GetBuffer(static_cast<int>(room)));
        folder.ReleaseBuffer();
    }
    return folder;
}

CString currentDirectory(int drive) {
    const std::unique_ptr<char, void (*)(void*)> folder(_getdcwd(drive, nullptr, 0), &std::free);
    return folder.get();
}

/// The current folder as a path, without its drive.
/// @param drive  whose current folder: 1 for A:; 0 for that of the process
CString currentPath(int drive) {
    return tvx::allocating([drive] {
        const CString folder = drive > 0 ? currentDirectory(drive) : currentDirectory();
        return CString(AsPath(folder.View().substr(IsDrive(folder.View()) ? 2 : 0)));
    });
}

CString withoutEndSeparator(const CString& name) {
    return name.View().ends_with(Separator) ? name.Left(name.GetLength() - 1) : name;
}

using Fits = std::function<bool(const CString&)>;

/// What is left of a path when one, two, ... folders are taken off its beginning.
std::vector<std::string_view> shorterPaths(std::string_view path) {
    return tvx::allocating([path]() mutable {
        std::vector<std::string_view> paths;
        while (!PopFirst(path).empty()) {
            paths.push_back(path);
        }
        return paths;
    });
}

CString abbreviated(const Gui_FileName& name, int keepName, const Fits& fits) {
    CString whole = name.GetFullName(1, nullptr, nullptr, nullptr, nullptr, 1);
    if (fits(whole)) {
        return whole;
    }
    const Gui_FileName working(whole);
    const CString last = working.GetBaseAndExtension();
    if (!fits(last)) {
        return keepName ? last : CString();
    }
    const CString prefix = name.GetMount() + "\\...\\";
    const auto shortened = [&](std::string_view path) { return prefix + CString(path) + last; };
    const CString path = working.GetPath();
    const auto paths = shorterPaths(path.View());
    // A name with fewer folders is never longer, so the first that fits is found by halving.
    const auto found = std::ranges::partition_point(paths, [&](auto rest) { return !fits(shortened(rest)); });
    return found == paths.end() ? last : shortened(*found);
}

/// The form in which names are compared. Taken apart a second time a network name has its separators in order.
CString comparable(const Gui_FileName& name) {
    return Gui_FileName(name.GetFullName()).GetFullName();
}

} // namespace

CString Gui_FileName::GetMount(int unc) const {
    if (unc || m_record->mount.IsEmpty() || IsDrive(m_record->mount.View())) {
        return m_record->mount;
    }
    const CString drive = DriveOfShare(m_record->mount);
    return drive.IsEmpty() ? m_record->mount : drive;
}

CString Gui_FileName::GetMountAndPath(int unc, const char* defaultMount, const char* defaultPath,
                                      int stripSeparator) const {
    const int drive = HasMount() || defaultMount ? 0 : tvx::allocating(_getdrive);
    CString result;
    if (HasMount()) {
        result = GetMount(unc);
    } else if (defaultMount) {
        result = Gui_FileName(defaultMount, nullptr, nullptr, nullptr).GetMount(unc);
    } else if (drive > 0) {
        result = CString(static_cast<char>('A' + drive - 1)) + ':';
    }
    Gui_FileName folder(nullptr, m_record->path, nullptr, nullptr);
    if (!folder.HasPath()) {
        folder.SetPath(defaultPath ? defaultPath : currentPath(drive).GetString());
    }
    if (folder.HasPath() && folder.HasRelativePath() && unc) {
        result += currentPath(drive);
    }
    result += folder.GetPath();
    return stripSeparator ? withoutEndSeparator(result) : result;
}

CString Gui_FileName::GetFullName(int unc, const char* defaultMount, const char* defaultPath, const char* defaultBase,
                                  const char* defaultExtension, int stripSeparator) const {
    const CString name =
        GetMountAndPath(unc, defaultMount, defaultPath) + GetBaseAndExtension(defaultBase, defaultExtension);
    return stripSeparator ? withoutEndSeparator(name) : name;
}

Gui_FileName::operator const char*() const {
    m_record->fullText = GetFullName();
    return m_record->fullText;
}

int Gui_FileName::IsEquivalent(const Gui_FileName& other) const {
    return AfxComparePath(comparable(*this), comparable(other));
}

CString Gui_FileName::GetAbbreviatedName(int maxLength, int keepName) const {
    return abbreviated(*this, keepName, [maxLength](const CString& text) {
        return tvx::text::characterCount(text.View()) <= static_cast<std::size_t>(std::max(maxLength, 0));
    });
}

CString Gui_FileName::GetAbbreviatedName(const CDC* dc, int maxWidth, int keepName) const {
    return abbreviated(*this, keepName, [dc, maxWidth](const CString& text) {
        SIZE size{};
        const bool isMeasured = dc && GetTextExtentPoint32A(dc->m_hAttribDC, text, text.GetLength(), &size);
        return !isMeasured || size.cx <= maxWidth;
    });
}

CString Gui_FileName::AsURL() const {
    const CString name = GetFullName(0);
    if (name.GetLength() >= 2 && name[1] == ':') {
        return CString("file:///") + name[0] + '|' + name.Mid(2);
    }
    return "file:" + name;
}
