// Takes arbitrary text apart as file names, a list of mounts and a list of drives, and checks what holds for each.
#include "s/FileName.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Files.h"
#include "platform/win/detail/DriveTable.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string>

namespace {

void require(bool holds) {
    if (!holds) {
        std::abort();
    }
}

/// Without network names, all but names of shares come back as they were, with backslashes.
void checkParts(std::string text) {
    Gui_FileName::SetUncFlag(0);
    const Gui_FileName name(text.c_str());
    std::ranges::replace(text, '/', '\\');
    require(name.HasNetworkMount() || name.GetName() == text.c_str());
    Gui_FileName::SetUncFlag(1);
}

void checkTakingApart(const std::string& text) {
    const Gui_FileName name(text.c_str());
    Gui_FileName popped(name);
    while (!popped.PopPathStart().IsEmpty()) {
    }
    popped = name;
    while (!popped.PopPathEnd().IsEmpty()) {
    }
}

/// Questions that ask the file system, which costs more than everything else: one of them for each input.
void checkAgainstFiles(const std::string& text) {
    const Gui_FileName name(text.c_str());
    switch (text.size() % 5) {
    case 0: {
        const CString shortened = name.GetAbbreviatedName(30, 0);
        require(shortened.IsEmpty() || tvx::text::characterCount(shortened.View()) <= 30);
        break;
    }
    case 1:
        require(name.IsEquivalent(name));
        break;
    case 2:
        require(name.Exists() == name.IsFile() + name.IsDirectory());
        break;
    case 3:
        require(name.AsURL().View().starts_with("file:"));
        break;
    default:
        (void)tvx::fullName(text);
        (void)tvx::driveName(text);
    }
}

void checkTable(const tvx::win::DriveTable& table) {
    for (const tvx::win::Drive& drive : table.drives()) {
        require(drive.folder.starts_with('/') && (drive.folder == "/" || !drive.folder.ends_with("//")));
        require(!drive.letter || table.find(drive.letter) == &drive);
        require(drive.remoteName.empty() || table.findShare(drive.remoteName));
        require(tvx::rootLength(drive.remoteName) == drive.remoteName.size());
        require(!drive.letter || table.holding(drive.folder));
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    ::setenv("TVX_DRIVES", "C=/;E=/dev/null|removable;X=/nowhere|\\\\srv\\data", 1);
    checkParts(text);
    checkTakingApart(text);
    checkAgainstFiles(text);
    checkTable(tvx::win::DriveTable::fromMounts(text, [](std::string_view device) { return device.ends_with('1'); }));
    std::vector<std::string> mistakes;
    checkTable(tvx::win::DriveTable::fromText(text, mistakes));
    return 0;
}
