#include "platform/afx/controls/TreeCtrl.h"

#include "platform/afx/controls/Edit.h"

#include <vector>

IMPLEMENT_DYNAMIC(CTreeCtrl, CWnd)

BOOL CTreeCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("SysTreeView32", nullptr, style, rect, parent, id);
}

HTREEITEM CTreeCtrl::InsertItem(UINT mask, LPCSTR text, int image, int selectedImage, UINT state, UINT stateMask,
                                LPARAM data, HTREEITEM parent, HTREEITEM after) {
    TVINSERTSTRUCT insert{parent, after, {}};
    insert.item.mask = mask;
    insert.item.pszText = const_cast<LPSTR>(text);
    insert.item.iImage = image;
    insert.item.iSelectedImage = selectedImage;
    insert.item.state = state;
    insert.item.stateMask = stateMask;
    insert.item.lParam = data;
    return InsertItem(&insert);
}

namespace {

TVITEM itemOf(HTREEITEM handle, UINT mask) {
    TVITEM item{};
    item.hItem = handle;
    item.mask = mask;
    return item;
}

} // namespace

BOOL CTreeCtrl::ItemHasChildren(HTREEITEM handle) const {
    TVITEM item = itemOf(handle, TVIF_CHILDREN);
    return GetItem(&item) && item.cChildren != 0;
}

CString CTreeCtrl::GetItemText(HTREEITEM handle) const {
    // A text that fills its buffer may have been cut.
    std::vector<char> buffer(256);
    for (;;) {
        TVITEM item = itemOf(handle, TVIF_TEXT);
        item.pszText = buffer.data();
        item.cchTextMax = static_cast<int>(buffer.size());
        if (!GetItem(&item)) {
            return {};
        }
        CString text(item.pszText);
        // The control cuts between characters, of at most four bytes.
        if (text.GetLength() + 4 < item.cchTextMax) {
            return text;
        }
        buffer.resize(buffer.size() * 4);
    }
}

BOOL CTreeCtrl::SetItemText(HTREEITEM handle, LPCSTR text) {
    TVITEM item = itemOf(handle, TVIF_TEXT);
    item.pszText = const_cast<LPSTR>(text);
    return SetItem(&item);
}

DWORD_PTR CTreeCtrl::GetItemData(HTREEITEM handle) const {
    TVITEM item = itemOf(handle, TVIF_PARAM);
    return GetItem(&item) ? static_cast<DWORD_PTR>(item.lParam) : 0;
}

BOOL CTreeCtrl::SetItemData(HTREEITEM handle, DWORD_PTR data) {
    TVITEM item = itemOf(handle, TVIF_PARAM);
    item.lParam = static_cast<LPARAM>(data);
    return SetItem(&item);
}

BOOL CTreeCtrl::GetItemImage(HTREEITEM handle, int& image, int& selectedImage) const {
    TVITEM item = itemOf(handle, TVIF_IMAGE | TVIF_SELECTEDIMAGE);
    if (!GetItem(&item)) {
        return FALSE;
    }
    image = item.iImage;
    selectedImage = item.iSelectedImage;
    return TRUE;
}

BOOL CTreeCtrl::SetItemImage(HTREEITEM handle, int image, int selectedImage) {
    TVITEM item = itemOf(handle, TVIF_IMAGE | TVIF_SELECTEDIMAGE);
    item.iImage = image;
    item.iSelectedImage = selectedImage;
    return SetItem(&item);
}

UINT CTreeCtrl::GetItemState(HTREEITEM handle, UINT mask) const {
    TVITEM item = itemOf(handle, TVIF_STATE);
    return GetItem(&item) ? item.state & mask : 0;
}

BOOL CTreeCtrl::SetItemState(HTREEITEM handle, UINT state, UINT mask) {
    TVITEM item = itemOf(handle, TVIF_STATE);
    item.state = state;
    item.stateMask = mask;
    return SetItem(&item);
}

HTREEITEM CTreeCtrl::HitTest(CPoint point, UINT* flags) const {
    TVHITTESTINFO info{point, 0, nullptr};
    const HTREEITEM item = HitTest(&info);
    if (flags) {
        *flags = info.flags;
    }
    return item;
}

BOOL CTreeCtrl::GetItemRect(HTREEITEM item, RECT* rect, BOOL textOnly) const {
    // The message reads the item from where it writes the rectangle, which need not be aligned for a handle.
    union {
        HTREEITEM handle;
        RECT place;
    } question{item};
    if (!SendMessage(TVM_GETITEMRECT, static_cast<WPARAM>(textOnly), reinterpret_cast<LPARAM>(&question))) {
        return FALSE;
    }
    *rect = question.place;
    return TRUE;
}

CImageList* CTreeCtrl::GetImageList(UINT kind) const {
    return CImageList::FromHandle(reinterpret_cast<HIMAGELIST>(SendMessage(TVM_GETIMAGELIST, kind)));
}

CImageList* CTreeCtrl::SetImageList(CImageList* list, int kind) {
    const HIMAGELIST handle = list ? list->GetSafeHandle() : nullptr;
    return CImageList::FromHandle(reinterpret_cast<HIMAGELIST>(
        SendMessage(TVM_SETIMAGELIST, static_cast<WPARAM>(kind), reinterpret_cast<LPARAM>(handle))));
}

CEdit* CTreeCtrl::EditLabel(HTREEITEM item) {
    SendMessage(TVM_EDITLABELA, 0, reinterpret_cast<LPARAM>(item));
    return GetEditControl();
}

CEdit* CTreeCtrl::GetEditControl() const {
    const auto field = reinterpret_cast<HWND>(SendMessage(TVM_GETEDITCONTROL));
    return field ? static_cast<CEdit*>(CWnd::FromHandle(field)) : nullptr;
}
