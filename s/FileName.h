#pragma once

#include "afx.h"
#include "s/Export.h"

#include <memory>

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
/// empty text. No operation reports an error, except that an exhausted heap raises the framework's memory exception.
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
    /// Sets mount and path from the name of a folder, and keeps base and extension.
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

    /// What stands between folders: the backslash.
    static char GetPathSeparator();

    /// Switches network names on (non-zero) or off, for the whole process. They are on at first: setting a mount turns
    /// a drive into the share that it is connected to, so that stored names mean the same on every machine.
    static void SetUncFlag(int flag);
    /// What SetUncFlag was given last; 1 at first.
    static int GetUncFlag();

private:
    struct Record;

    std::unique_ptr<Record> m_record;
};
