#include "platform/afx/core/Menu.h"

#include "platform/afx/core/MessageMap.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/HandleMap.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

IMPLEMENT_DYNCREATE(CMenu, CObject)

namespace {

tvx::afx::HandleMap<CMenu>& objects() {
    static auto* map = new tvx::afx::HandleMap<CMenu>;
    return *map;
}

} // namespace

CMenu::~CMenu() {
    DestroyMenu();
}

CMenu* CMenu::FromHandle(HMENU menu) {
    if (!IsMenu(menu)) {
        return nullptr;
    }
    if (CMenu* known = objects().find(menu)) {
        return known;
    }
    auto made = std::make_unique<CMenu>();
    made->m_hMenu = menu;
    return objects().addTemporary(menu, std::move(made));
}

CMenu* CMenu::FromHandlePermanent(HMENU menu) {
    return IsMenu(menu) ? objects().findPermanent(menu) : nullptr;
}

void CMenu::DeleteTempMap() {
    // Their destructor must not destroy menus that they only looked at.
    objects().deleteTemporaries([](CMenu& menu) { menu.m_hMenu = nullptr; });
}

CMenu* tvx::afx::menuOf(HMENU handle) {
    return CMenu::FromHandle(handle);
}

BOOL CMenu::Attach(HMENU menu) {
    if (m_hMenu || !IsMenu(menu)) {
        return FALSE;
    }
    m_hMenu = menu;
    objects().addPermanent(menu, *this);
    return TRUE;
}

HMENU CMenu::Detach() {
    objects().removePermanent(m_hMenu, *this);
    return std::exchange(m_hMenu, nullptr);
}

BOOL CMenu::CreateMenu() {
    return Attach(::CreateMenu());
}

BOOL CMenu::CreatePopupMenu() {
    return Attach(::CreatePopupMenu());
}

BOOL CMenu::LoadMenu(LPCSTR name) {
    return Attach(::LoadMenuA(AfxFindResourceHandle(name, RT_MENU), name));
}

BOOL CMenu::LoadMenu(UINT id) {
    return LoadMenu(MAKEINTRESOURCE(id));
}

BOOL CMenu::DestroyMenu() {
    return m_hMenu ? ::DestroyMenu(Detach()) : FALSE;
}

BOOL CMenu::AppendMenu(UINT flags, UINT_PTR id, LPCSTR text) {
    return ::AppendMenuA(m_hMenu, flags, id, text);
}

BOOL CMenu::InsertMenu(UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    return ::InsertMenuA(m_hMenu, position, flags, id, text);
}

BOOL CMenu::ModifyMenu(UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    return ::ModifyMenuA(m_hMenu, position, flags, id, text);
}

BOOL CMenu::RemoveMenu(UINT position, UINT flags) {
    return ::RemoveMenu(m_hMenu, position, flags);
}

BOOL CMenu::DeleteMenu(UINT position, UINT flags) {
    return ::DeleteMenu(m_hMenu, position, flags);
}

UINT CMenu::EnableMenuItem(UINT item, UINT flags) {
    return static_cast<UINT>(::EnableMenuItem(m_hMenu, item, flags));
}

UINT CMenu::CheckMenuItem(UINT item, UINT flags) {
    return ::CheckMenuItem(m_hMenu, item, flags);
}

BOOL CMenu::CheckMenuRadioItem(UINT first, UINT last, UINT checked, UINT flags) {
    return ::CheckMenuRadioItem(m_hMenu, first, last, checked, flags);
}

BOOL CMenu::SetDefaultItem(UINT item, BOOL byPosition) {
    return ::SetMenuDefaultItem(m_hMenu, item, byPosition ? 1 : 0);
}

BOOL CMenu::SetMenuItemBitmaps(UINT position, UINT flags, const CBitmap* unchecked, const CBitmap* checked) {
    const auto handleOf = [](const CBitmap* bitmap) { return bitmap ? static_cast<HBITMAP>(*bitmap) : nullptr; };
    return ::SetMenuItemBitmaps(m_hMenu, position, flags, handleOf(unchecked), handleOf(checked));
}

UINT CMenu::GetMenuItemCount() const {
    return static_cast<UINT>(::GetMenuItemCount(m_hMenu));
}

UINT CMenu::GetMenuItemID(int position) const {
    return ::GetMenuItemID(m_hMenu, position);
}

UINT CMenu::GetMenuState(UINT item, UINT flags) const {
    return ::GetMenuState(m_hMenu, item, flags);
}

int CMenu::GetMenuString(UINT item, LPSTR buffer, int size, UINT flags) const {
    return ::GetMenuStringA(m_hMenu, item, buffer, size, flags);
}

int CMenu::GetMenuString(UINT item, CString& text, UINT flags) const {
    const int length = ::GetMenuStringA(m_hMenu, item, nullptr, 0, flags);
    ::GetMenuStringA(m_hMenu, item, text.GetBuffer(length), length + 1, flags);
    text.ReleaseBuffer();
    return length;
}

CMenu* CMenu::GetSubMenu(int position) const {
    return FromHandle(::GetSubMenu(m_hMenu, position));
}

BOOL CMenu::TrackPopupMenu(UINT flags, int x, int y, CWnd* owner, const RECT* rect) {
    return ::TrackPopupMenu(m_hMenu, flags, x, y, 0, owner ? owner->m_hWnd : nullptr, rect);
}

// --- menus of windows ---

CMenu* CWnd::GetMenu() const {
    return CMenu::FromHandle(::GetMenu(m_hWnd));
}

BOOL CWnd::SetMenu(CMenu* menu) {
    return ::SetMenu(m_hWnd, menu ? menu->m_hMenu : nullptr);
}

void CWnd::DrawMenuBar() {
    ::DrawMenuBar(m_hWnd);
}

CMenu* CWnd::GetSystemMenu(BOOL revert) const {
    return CMenu::FromHandle(::GetSystemMenu(m_hWnd, revert));
}
