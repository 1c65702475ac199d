#include "platform/afx/core/CmdTarget.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/MessageMap.h"

#include <array>

using tvx::afx::MessageCall;

IMPLEMENT_DYNAMIC(CCmdTarget, CObject)

const AFX_MSGMAP* CCmdTarget::GetThisMessageMap() {
    static const AFX_MSGMAP_ENTRY entries[] = {{0, 0, 0, 0, nullptr, nullptr}};
    static const AFX_MSGMAP map = {nullptr, entries};
    return &map;
}

const AFX_MSGMAP* CCmdTarget::GetMessageMap() const {
    return GetThisMessageMap();
}

namespace {

bool matches(const AFX_MSGMAP_ENTRY& entry, UINT message, UINT code, UINT id) {
    if (entry.registered) {
        return *entry.registered == message;
    }
    // Codes of WM_NOTIFY are negative numbers, of which the road of commands keeps 16 bits.
    const UINT looked = message == WM_NOTIFY ? 0xFFFFU : ~0U;
    return entry.nMessage == message && ((static_cast<UINT>(entry.nCode) ^ code) & looked) == 0 && id >= entry.nID &&
           id <= entry.nLastID;
}

const AFX_MSGMAP_ENTRY* search(const AFX_MSGMAP* map, UINT message, UINT code, UINT id) {
    while (map) {
        for (const AFX_MSGMAP_ENTRY* entry = map->lpEntries; entry->pfn; ++entry) {
            if (matches(*entry, message, code, id)) {
                return entry;
            }
        }
        map = map->pfnGetBaseMap ? map->pfnGetBaseMap() : nullptr;
    }
    return nullptr;
}

/// Window messages are looked up for every message of every window; commands are not.
struct CachedSearch {
    const AFX_MSGMAP* map = nullptr;
    UINT message = 0;
    const AFX_MSGMAP_ENTRY* entry = nullptr;
};
thread_local std::array<CachedSearch, 512> cache;

} // namespace

const AFX_MSGMAP_ENTRY* CCmdTarget::FindMessageEntry(UINT message, UINT code, UINT id) const {
    const AFX_MSGMAP* map = GetMessageMap();
    // Entries of registered messages name a variable, whose number may not be known yet.
    if (message == WM_COMMAND || message == WM_NOTIFY || message >= 0xC000) {
        return search(map, message, code, id);
    }
    const auto slot = (reinterpret_cast<std::uintptr_t>(map) / 16 + message) % cache.size();
    CachedSearch& cached = cache[slot];
    if (cached.map != map || cached.message != message) {
        cached = {map, message, search(map, message, code, id)};
    }
    return cached.entry;
}

BOOL CCmdTarget::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    UINT message = WM_COMMAND;
    auto plainCode = static_cast<UINT>(code);
    if (code != CN_UPDATE_COMMAND_UI) {
        // A notification by WM_NOTIFY carries its message in the upper half of the code; commands and older
        // notifications have 0 there.
        message = HIWORD(static_cast<std::uintptr_t>(static_cast<DWORD>(code)));
        plainCode = LOWORD(static_cast<std::uintptr_t>(static_cast<DWORD>(code)));
        message = message == 0 ? WM_COMMAND : message;
    }
    for (const AFX_MSGMAP* map = GetMessageMap(); map; map = map->pfnGetBaseMap ? map->pfnGetBaseMap() : nullptr) {
        for (const AFX_MSGMAP_ENTRY* entry = map->lpEntries; entry->pfn; ++entry) {
            if (!matches(*entry, message, plainCode, id)) {
                continue;
            }
            if (info) {
                info->pTarget = this;
                info->pmf = entry->pfn;
                return TRUE;
            }
            MessageCall call;
            call.message = message;
            call.id = id;
            call.extra = extra;
            return entry->pfn(*this, call) ? TRUE : FALSE;
        }
    }
    return FALSE;
}

// --- wait cursor ---

void CCmdTarget::BeginWaitCursor() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(1);
    }
}

void CCmdTarget::EndWaitCursor() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(-1);
    }
}

void CCmdTarget::RestoreWaitCursor() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(0);
    }
}

CWaitCursor::CWaitCursor() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(1);
    }
}

CWaitCursor::~CWaitCursor() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(-1);
    }
}

void CWaitCursor::Restore() {
    if (CWinApp* app = AfxGetApp()) {
        app->DoWaitCursor(0);
    }
}
