#pragma once

#include "afx.h"
#include "s/Export.h"

#include <memory>

class CDC;

/// A file name as four parts that are set one by one: mount, path, base and extension.
///
/// The mount is a drive ("C:") or a share ("\\server\share"); the path holds the folders and ends with a backslash;
/// base and extension are the name itself, the extension with its dot. Any part may be empty. Names use the family's
/// form on every system; docs/file-names.md tells how they become the system's names. Forward slashes are accepted and
/// become backslashes; nothing else is changed: case and repeated separators stay, "." and ".." are not resolved.
///
/// @code
/// Gui_FileName drawing("C:\\plans\\house.brd");
/// Gui_FileName backup(drawing);
/// backup.PushPathEnd("backup");     // C:\plans\backup\house.brd
/// backup.SetExtension("old");       // C:\plans\backup\house.old
/// @endcode
///
/// File names are values: copy and assign them freely. Texts of any length are kept whole. A null pointer counts as an
/// empty text, unless an operation says otherwise. No operation reports an error, except that an exhausted heap raises
/// the framework's memory exception.
class GUI_API Gui_FileName : public CObject {
    DECLARE_SERIAL(Gui_FileName)

public:
    /// A name whose parts are all empty.
    Gui_FileName();
    /// As SetFullName.
    Gui_FileName(const char* fullName);
    /// As the four setters SetMount, SetPath, SetBase and SetExtension.
    Gui_FileName(const char* mount, const char* path, const char* base, const char* extension);
    Gui_FileName(const Gui_FileName& other);
    ~Gui_FileName() override;

    Gui_FileName& operator=(const Gui_FileName& other);
    /// As SetFullName.
    Gui_FileName& operator=(const char* fullName);

    /// Stores or loads the four parts as texts, in their order. A name that cannot be loaded stays as it was.
    void Serialize(CArchive& archive) override;
    /// Empties the four parts.
    void Empty();

    /// @name Setting
    /// @{

    /// Takes a whole name apart. The base ends at the last dot behind the last separator, so ".profile" is an extension
    /// alone. Of a name that begins with two backslashes the first two folders are the mount; two forward slashes begin
    /// an ordinary absolute path.
    void SetFullName(const char* fullName);
    /// As SetFullName.
    void SetName(const char* fullName);
    /// Sets the mount. A colon is added to a drive without one; unless network names are switched off, a drive that is
    /// connected to a share becomes the share (see SetUncFlag).
    void SetMount(const char* mount);
    /// Sets the folders; a separator is added at the end.
    void SetPath(const char* path);
    /// Sets the name without its extension, as it is given.
    void SetBase(const char* base);
    /// Sets the extension; a dot is added in front of one without.
    void SetExtension(const char* extension);
    /// Sets mount and path from the name of a folder, and keeps base and extension. A folder without a name is the
    /// root; null empties mount and path. Two forward slashes begin a share here.
    void SetMountAndPath(const char* folder);
    /// Sets base and extension from the last part of a name, and keeps mount and path.
    void SetBaseAndExtension(const char* name);
    /// Puts folders in front of the path. An empty text changes nothing.
    void PushPathStart(const char* path);
    /// Puts folders behind the path; one separator at their beginning is dropped. An empty text changes nothing.
    void PushPathEnd(const char* path);
    /// Takes the first folder off the path.
    /// @return the folder, empty when the path is
    CString PopPathStart();
    /// Takes the last folder off the path.
    /// @return the folder, empty when the path is
    CString PopPathEnd();
    /// @}

    /// @name The parts
    /// @{

    /// The drive or share.
    /// @param unc  0: a share that is connected to a drive is given as that drive, when there is one
    CString GetMount(int unc = 1) const;
    /// The folders, with a separator at the end; absolute when they begin with one.
    CString GetPath() const;
    /// The name without its extension.
    CString GetBase() const;
    /// The extension with its dot.
    CString GetExtension() const;
    /// The four parts put together as they are, nothing completed.
    CString GetName() const;
    /// Base and extension.
    /// @param defaultBase       taken when the base is empty; may be null
    /// @param defaultExtension  taken when the extension is empty, with or without its dot; may be null
    CString GetBaseAndExtension(const char* defaultBase = nullptr, const char* defaultExtension = nullptr) const;
    /// @}

    /// @name Whole names
    ///
    /// A missing mount is the current drive, missing folders are those of the current folder, whatever drive that one
    /// lies on, unless a default stands in for them. A default that is not null but empty leaves its part empty.
    /// @{

    /// Mount and path.
    /// @param unc             non-zero: a relative path is completed with the current folder, and shares stay shares.
    ///                        0: it stays relative, and shares are given as drives where there is one
    /// @param defaultMount    taken when the mount is empty, as SetMount takes it; may be null
    /// @param defaultPath     taken when the path is empty, as SetPath takes it; may be null
    /// @param stripSeparator  non-zero: without the separator at the end
    CString GetMountAndPath(int unc = 1, const char* defaultMount = nullptr, const char* defaultPath = nullptr,
                            int stripSeparator = 0) const;
    /// The whole name: as GetMountAndPath and GetBaseAndExtension, one behind the other.
    CString GetFullName(int unc = 1, const char* defaultMount = nullptr, const char* defaultPath = nullptr,
                        const char* defaultBase = nullptr, const char* defaultExtension = nullptr,
                        int stripSeparator = 0) const;
    /// The whole name with shares. The text is valid until the next conversion of this object or its end, whatever is
    /// done to the parts meanwhile.
    operator const char*() const;
    /// Whether two names denote the same file, as far as their texts tell: both completed, compared without regard to
    /// case. Links and ".." are not looked at.
    /// @return non-zero when they do
    int IsEquivalent(const Gui_FileName& other) const;
    /// The whole name for display, with "..." in place of as many of its first folders as must be left out:
    /// "C:\...\gui\main.cpp". A name without a mount is shortened to one without.
    /// @param maxLength  characters that there is room for
    /// @param keepName   what to give when not even base and extension have room: 0 the empty text, else those
    CString GetAbbreviatedName(int maxLength, int keepName) const;
    /// The same, measured in the units of a device context in its current font. Without one, or one that cannot
    /// measure, everything has room.
    CString GetAbbreviatedName(const CDC* dc, int maxWidth, int keepName) const;
    /// The whole name as an address that the family's help understands: "file:///C|\doc\a.htm", or
    /// "file:\\server\share\a.htm" for a share without drive. Separators stay backslashes, nothing is escaped.
    CString AsURL() const;
    /// @}

    /// @name Questions about the parts: 1 or 0
    /// @{

    /// Whether all four parts are empty.
    int IsEmpty() const;
    int HasMount() const;
    int HasPath() const;
    int HasBase() const;
    int HasExtension() const;
    /// Whether the extension is @p extension, with or without its dot, in any case. Null and the empty text ask for a
    /// name without extension.
    int HasExtension(const char* extension) const;
    /// Whether the mount is a share.
    int HasNetworkMount() const;
    /// Whether the path begins at the root of its mount.
    int HasAbsolutePath() const;
    /// The opposite; an empty path is relative.
    int HasRelativePath() const;
    /// @}

    /// @name Questions to the file system: 1 or 0
    ///
    /// They are about the whole name, completed with the current drive and folder. What cannot be examined counts as
    /// not being there.
    /// @{

    /// Whether there is a file or folder of that name.
    int Exists() const;
    /// The same as Exists.
    int IsReadable() const;
    int IsDirectory() const;
    int IsFile() const;
    /// Whether it exists and may be written. On a removable medium a file is made in its root, and deleted again, to
    /// find out; a disc is never writable.
    int IsWritable() const;
    /// The same as IsWritable.
    int IsDeletable() const;
    /// Whether it exists and has the extension of a program: ".bat", ".exe" or ".com" in any case.
    int IsExecutable() const;
    /// @}

    /// What stands between folders: the backslash.
    static char GetPathSeparator();

    /// @name Network names
    /// @{

    /// Switches network names on (non-zero) or off, for the whole process. They are on at first: setting a mount turns
    /// a drive into the share that it is connected to, so that stored names mean the same on every machine.
    static void SetUncFlag(int flag);
    /// What SetUncFlag was given last; 1 at first.
    static int GetUncFlag();
    /// Turns a drive into the share that it is connected to, in lower case. Nothing happens while network names are
    /// switched off.
    /// @param mount    its first character is the drive
    /// @param uncOnly  0: also a connection whose name is no share
    /// @return 1 when the mount may be used as it is now: it became a share, was one, or names are switched off; 0 for
    ///     a drive that is not connected, which stays
    static int GetRemoteMountName(CString& mount, int uncOnly);
    /// There are no other network names than shares: 0, and the text stays.
    static int GetNetworkName(CString& name);
    /// @}

private:
    struct Record;

    std::unique_ptr<Record> m_record;
};
