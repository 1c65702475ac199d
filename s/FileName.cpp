#include "s/FileName.h"

#include "platform/base/Text.h"
#include "s/FileNameRecord.h"
#include "s/FileNameText.h"
#include "s/Record.h"

#include <string>
#include <string_view>
#include <utility>

IMPLEMENT_SERIAL(Gui_FileName, CObject, 1)

using namespace FileNameText;

namespace {

/// The parts of a name, put together again they are the name.
struct Split {
    std::string_view drive;
    std::string_view folders;
    std::string_view base;
    std::string_view extension;
};

/// Takes apart a name whose separators are backslashes.
Split split(std::string_view name) {
    Split parts;
    if (name.size() >= 2 && name[1] == ':') {
        parts.drive = name.substr(0, 2);
    }
    name.remove_prefix(parts.drive.size());
    // Not found is the largest number: adding 1 gives 0, the beginning.
    parts.folders = name.substr(0, name.rfind(Separator) + 1);
    name.remove_prefix(parts.folders.size());
    parts.base = name.substr(0, name.rfind('.'));
    parts.extension = name.substr(parts.base.size());
    return parts;
}

} // namespace

Gui_FileName::Gui_FileName() : m_record(MakeRecord<Record>()) {}

Gui_FileName::Gui_FileName(const char* fullName) : Gui_FileName() {
    SetFullName(fullName);
}

Gui_FileName::Gui_FileName(const char* mount, const char* path, const char* base, const char* extension)
    : Gui_FileName() {
    SetMount(mount);
    SetPath(path);
    SetBase(base);
    SetExtension(extension);
}

Gui_FileName::Gui_FileName(const Gui_FileName& other) : CObject(), m_record(MakeRecord<Record>(*other.m_record)) {}

Gui_FileName::~Gui_FileName() = default;

Gui_FileName& Gui_FileName::operator=(const Gui_FileName& other) {
    // The full-name text stays: a pointer to it is valid until the next conversion.
    m_record->mount = other.m_record->mount;
    m_record->path = other.m_record->path;
    m_record->base = other.m_record->base;
    m_record->extension = other.m_record->extension;
    return *this;
}

Gui_FileName& Gui_FileName::operator=(const char* fullName) {
    SetFullName(fullName);
    return *this;
}

void Gui_FileName::Serialize(CArchive& archive) {
    CObject::Serialize(archive);
    if (archive.IsStoring()) {
        archive << m_record->mount << m_record->path << m_record->base << m_record->extension;
        return;
    }
    Gui_FileName loaded;
    archive >> loaded.m_record->mount >> loaded.m_record->path >> loaded.m_record->base >> loaded.m_record->extension;
    *this = loaded;
}

void Gui_FileName::Empty() {
    m_record->mount.Empty();
    m_record->path.Empty();
    m_record->base.Empty();
    m_record->extension.Empty();
}

void Gui_FileName::SetFullName(const char* fullName) {
    tvx::allocating([&] {
        const std::string_view given = View(fullName);
        const std::string name = WithBackslashes(given);
        const Split parts = split(name);
        if (!given.starts_with(NetworkMark)) {
            SetMount(std::string(parts.drive).c_str());
            m_record->path = CString(parts.folders);
        } else {
            std::string_view path = parts.folders.substr(NetworkMark.size());
            const std::string server(PopFirst(path));
            const std::string_view share = PopFirst(path);
            m_record->mount = CString(std::string(NetworkMark) + server + Separator + std::string(share));
            m_record->path = Separator + CString(path);
        }
        m_record->base = CString(parts.base);
        m_record->extension = CString(parts.extension);
    });
}

void Gui_FileName::SetName(const char* fullName) {
    SetFullName(fullName);
}

void Gui_FileName::SetMount(const char* mount) {
    m_record->mount = mount;
    if (!m_record->mount.IsEmpty() && !HasNetworkMount() && !m_record->mount.View().ends_with(':')) {
        m_record->mount += ':';
    }
    GetRemoteMountName(m_record->mount, 1);
}

void Gui_FileName::SetPath(const char* path) {
    tvx::allocating([&] { m_record->path = CString(AsPath(View(path))); });
}

void Gui_FileName::SetBase(const char* base) {
    m_record->base = base;
}

void Gui_FileName::SetExtension(const char* extension) {
    tvx::allocating([&] { m_record->extension = CString(WithDot(View(extension))); });
}

void Gui_FileName::SetMountAndPath(const char* folder) {
    const CString base = m_record->base;
    const CString extension = m_record->extension;
    tvx::allocating([&] { SetFullName(folder ? AsFolder(folder).c_str() : nullptr); });
    m_record->base = base;
    m_record->extension = extension;
}

void Gui_FileName::SetBaseAndExtension(const char* name) {
    const CString mount = m_record->mount;
    const CString path = m_record->path;
    SetFullName(name);
    m_record->mount = mount;
    m_record->path = path;
}

void Gui_FileName::PushPathStart(const char* path) {
    tvx::allocating([&] { m_record->path = CString(AsPath(View(path))) + m_record->path; });
}

void Gui_FileName::PushPathEnd(const char* path) {
    tvx::allocating([&] {
        std::string added = WithBackslashes(View(path));
        if (added.empty()) {
            return;
        }
        if (added.front() == Separator) {
            added.erase(0, 1);
        }
        m_record->path = CString(AsFolder(std::string(m_record->path.View()) + added));
    });
}

CString Gui_FileName::PopPathStart() {
    const CString path = m_record->path;
    std::string_view rest = path.View();
    const CString folder(PopFirst(rest));
    m_record->path = CString(rest);
    return folder;
}

CString Gui_FileName::PopPathEnd() {
    const CString path = m_record->path.Left(m_record->path.GetLength() - 1);
    const int start = path.ReverseFind(Separator) + 1;
    m_record->path = path.Left(start);
    return path.Mid(start);
}

CString Gui_FileName::GetPath() const {
    return m_record->path;
}

CString Gui_FileName::GetBase() const {
    return m_record->base;
}

CString Gui_FileName::GetExtension() const {
    return m_record->extension;
}

CString Gui_FileName::GetName() const {
    return m_record->mount + m_record->path + m_record->base + m_record->extension;
}

CString Gui_FileName::GetBaseAndExtension(const char* defaultBase, const char* defaultExtension) const {
    CString name = HasBase() ? m_record->base : CString(defaultBase);
    tvx::allocating([&] { name += HasExtension() ? m_record->extension : CString(WithDot(View(defaultExtension))); });
    return name;
}

int Gui_FileName::IsEmpty() const {
    return !HasMount() && !HasPath() && !HasBase() && !HasExtension();
}

int Gui_FileName::HasMount() const {
    return !m_record->mount.IsEmpty();
}

int Gui_FileName::HasPath() const {
    return !m_record->path.IsEmpty();
}

int Gui_FileName::HasBase() const {
    return !m_record->base.IsEmpty();
}

int Gui_FileName::HasExtension() const {
    return !m_record->extension.IsEmpty();
}

int Gui_FileName::HasExtension(const char* extension) const {
    const std::string_view own = m_record->extension.View();
    const std::string_view asked = View(extension);
    if (asked.empty() || own.empty()) {
        return asked.empty() && own.empty();
    }
    return tvx::text::equalNoCase(asked.front() == '.' ? own : own.substr(1), asked);
}

int Gui_FileName::HasNetworkMount() const {
    return m_record->mount.View().starts_with(NetworkMark);
}

int Gui_FileName::HasAbsolutePath() const {
    return m_record->path.View().starts_with(Separator);
}

int Gui_FileName::HasRelativePath() const {
    return !HasAbsolutePath();
}

char Gui_FileName::GetPathSeparator() {
    return Separator;
}
