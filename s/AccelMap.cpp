#include "s/AccelMap.h"

#include "s/KeyIndex.h"
#include "s/KeyTexts.h"
#include "s/MenuStr.h"
#include "s/Record.h"

#include <algorithm>
#include <memory>
#include <new>
#include <optional>
#include <span>
#include <vector>

namespace {

constexpr INT_PTR blockSize = 10;

void* asKey(unsigned long packed) {
    return reinterpret_cast<void*>(static_cast<std::uintptr_t>(packed));
}

/// Calls a function with each entry, in the order of the hash table: that depends on how the map was filled.
template <typename Function>
void forEach(const Gui_AccelMapImpl& map, Function function) {
    for (POSITION at = map.GetStartPosition(); at;) {
        void* packed = nullptr;
        Gui_Accel accel;
        map.GetNextAssoc(at, packed, accel.cmd);
        accel.DecodeFlagsAndKey(static_cast<unsigned long>(reinterpret_cast<std::uintptr_t>(packed)));
        function(accel);
    }
}

/// The order in which accelerators come out of a map.
constexpr auto isBefore = [](const Gui_Accel& first, const Gui_Accel& second) {
    return first.EncodeFlagsAndKey() < second.EncodeFlagsAndKey();
};

std::vector<Gui_Accel> keysOf(const Gui_AccelMapImpl& map, unsigned short command) {
    std::vector<Gui_Accel> keys;
    forEach(map, [&](const Gui_Accel& accel) {
        if (accel.cmd == command) {
            tvx::allocating([&] { keys.push_back(accel); });
        }
    });
    return keys;
}

} // namespace

Gui_AccelMapImpl::Gui_AccelMapImpl() : CMapPtrToWord(blockSize) {}

Gui_AccelMapImpl::~Gui_AccelMapImpl() = default;

Gui_AccelMap::Gui_AccelMap() : m_impl(MakeRecord<Gui_AccelMapImpl>()) {}

Gui_AccelMap::Gui_AccelMap(HACCEL table) : Gui_AccelMap() {
    AddAll(table);
}

Gui_AccelMap::Gui_AccelMap(const tagACCEL* accels, int count) : Gui_AccelMap() {
    AddAll(accels, count);
}

Gui_AccelMap::Gui_AccelMap(const Gui_AccelMap& other) : Gui_AccelMap() {
    forEach(*other.m_impl, [this](const Gui_Accel& accel) { Add(accel); });
}

Gui_AccelMap::~Gui_AccelMap() = default;

Gui_AccelMap& Gui_AccelMap::operator=(const Gui_AccelMap& other) {
    if (this != &other) {
        RemoveAll();
        forEach(*other.m_impl, [this](const Gui_Accel& accel) { Add(accel); });
    }
    return *this;
}

void Gui_AccelMap::Add(const Gui_Accel& accel) {
    const unsigned long packed = accel.EncodeFlagsAndKey();
    m_impl->RemoveKey(asKey(packed & ~static_cast<unsigned long>(FNOINVERT)));
    m_impl->RemoveKey(asKey(packed));
    m_impl->SetAt(asKey(packed), accel.cmd);
}

void Gui_AccelMap::AddAll(const tagACCEL* accels, int count) {
    for (int i = 0; accels && i < count; ++i) {
        Add(accels[i]);
    }
}

void Gui_AccelMap::AddAll(HACCEL table) {
    std::vector<tagACCEL> accels;
    tvx::allocating([&] { accels.resize(static_cast<std::size_t>(CopyAcceleratorTableA(table, nullptr, 0))); });
    AddAll(accels.data(), CopyAcceleratorTableA(table, accels.data(), static_cast<int>(accels.size())));
}

void Gui_AccelMap::Remove(unsigned short command) {
    for (const Gui_Accel& accel : keysOf(*m_impl, command)) {
        Remove(accel);
    }
}

void Gui_AccelMap::Remove(const Gui_Accel& accel) {
    m_impl->RemoveKey(asKey(accel.EncodeFlagsAndKey()));
}

void Gui_AccelMap::RemoveAll() {
    m_impl->RemoveAll();
}

int Gui_AccelMap::GetCmdAt(const Gui_Accel& accel, unsigned short& command) const {
    command = 0;
    return m_impl->Lookup(asKey(accel.EncodeFlagsAndKey()), command) ? 1 : 0;
}

int Gui_AccelMap::GetAccelAt(unsigned short command, int index, Gui_Accel& accel) const {
    std::vector<Gui_Accel> keys = keysOf(*m_impl, command);
    if (index < 0 || index >= static_cast<int>(keys.size())) {
        accel.Clear();
        return 0;
    }
    const auto found = keys.begin() + index;
    std::nth_element(keys.begin(), found, keys.end(), isBefore);
    accel = *found;
    return 1;
}

void Gui_AccelMap::GetAll(int& count, tagACCEL*& table) const {
    count = 0;
    table = m_impl->IsEmpty() ? nullptr : new (std::nothrow) tagACCEL[static_cast<std::size_t>(m_impl->GetCount())];
    if (table) {
        forEach(*m_impl, [&](const Gui_Accel& accel) { table[count++] = accel; });
        std::sort(table, table + count, isBefore);
    }
}

bool Gui_AccelMap::IsSame(const Gui_AccelMap& other) const {
    bool isSame = m_impl->GetCount() == other.m_impl->GetCount();
    forEach(*m_impl, [&](const Gui_Accel& accel) {
        unsigned short command = 0;
        isSame = isSame && other.GetCmdAt(accel, command) && command == accel.cmd;
    });
    return isSame;
}

HACCEL Gui_AccelMap::CreateTable() const {
    int count = 0;
    tagACCEL* table = nullptr;
    GetAll(count, table);
    const std::unique_ptr<tagACCEL[]> owner(table);
    return CreateAcceleratorTableA(table, count);
}

// Menus

namespace {

/// The shortcut that an item is to show, which shows one now; nothing where its command has no key.
std::optional<CString> shortCutOf(std::span<const Gui_Accel> keys, const CString& shown, KeyTexts& texts) {
    std::optional<CString> first;
    for (const Gui_Accel& accel : keys) {
        CString text = texts.textOf(accel);
        if (text == shown) {
            return text;
        }
        if (!first) {
            first = std::move(text);
        }
    }
    return first;
}

void annotate(CMenu& menu, const KeyIndex& keys, KeyTexts& texts) {
    const auto count = static_cast<int>(menu.GetMenuItemCount()); // -1 for what is no menu
    for (int item = 0; item < count; ++item) {
        const UINT command = menu.GetMenuItemID(item);
        if (command == 0) {
            continue;
        }
        if (CMenu* popup = command == static_cast<UINT>(-1) ? menu.GetSubMenu(item) : nullptr) {
            annotate(*popup, keys, texts);
            continue;
        }
        Gui_MenuStr text(&menu, item, MF_BYPOSITION);
        if (const auto shortCut = shortCutOf(keys.keysOf(command), text.GetShortCutKeyText(), texts)) {
            text.SetShortCutKeyText(*shortCut);
        } else {
            text.ClearShortCutKeyText();
        }
        menu.ModifyMenu(static_cast<UINT>(item), MF_BYPOSITION | MF_STRING, command, text);
    }
}

} // namespace

void Gui_AccelMap::AnnotateMenu(CMenu* menu) const {
    if (menu) {
        KeyTexts texts;
        annotate(*menu, KeyIndex(*this), texts);
    }
}
