#include "platform/sec/TreeCtrl.h"

IMPLEMENT_DYNAMIC(SECTreeCtrl, CTreeCtrl)

void SECTreeCtrl::SetMultiSelect(BOOL on) {
    SetExtendedStyle(TVS_EX_MULTISELECT, on ? TVS_EX_MULTISELECT : 0);
}

HTREEITEM SECTreeCtrl::GetNextItem(HTREEITEM item) const {
    if (const HTREEITEM child = item ? GetChildItem(item) : nullptr) {
        return child;
    }
    for (; item; item = GetParentItem(item)) {
        if (const HTREEITEM next = GetNextSiblingItem(item)) {
            return next;
        }
    }
    return nullptr;
}

HTREEITEM SECTreeCtrl::GetIndexItem(int index) const {
    HTREEITEM item = index >= 0 ? GetRootItem() : nullptr;
    for (; item && index > 0; --index) {
        item = GetNextItem(item);
    }
    return item;
}
