// The tree of the directory dialog.
#include "res/resource.h"
#include "s/DirDlgRecord.h"

/// Shows the way from the drive's root to the directory, and then its subdirectories.
void Gui_DirDlg::fillTree() {
    const CWaitCursor wait;
    m_record->verdict = {};
    tree().DeleteAllItems();
    HTREEITEM item = insertItem(m_record->directory.GetMount(0) + "\\", TVI_ROOT, Record::PathImage, 1);
    for (Gui_FileName rest = m_record->directory; rest.HasPath();) {
        // Repeated separators have nothing between them.
        if (const CString name = rest.PopPathStart(); !name.IsEmpty()) {
            item = insertItem(name, item, Record::PathImage, 1);
        }
    }
    tree().SetItemImage(item, Record::CurrentImage, Record::CurrentImage);
    tree().SelectItem(item);
    tree().EnsureVisible(item);
    m_record->current = item;
    const auto which =
        IsDlgButtonChecked(GUI_IDC_DIR_HIDDEN) ? tvx::HiddenFolders::Include : tvx::HiddenFolders::LeaveOut;
    m_record->listing = tvx::Question<tvx::FolderNames>(
        [folder = m_record->directory.GetMountAndPath(1), which] { return tvx::readFolders(folder.View(), which); });
    if (m_record->isAnswered(m_record->listing, Record::listed)) {
        fillSubdirectories();
    } else {
        showState();
    }
}

/// Shows the subdirectories that have been read. They come in the order of sorted insertion.
void Gui_DirDlg::fillSubdirectories() {
    const tvx::FolderNames found = std::move(m_record->listing.answer());
    m_record->listing = {};
    showState();
    HTREEITEM first = nullptr;
    tree().SetRedraw(FALSE);
    for (const std::string& name : found.names) {
        // A backslash in a name cannot be written in the family's form: such a directory could not be chosen.
        if (name.find('\\') == std::string::npos) {
            const HTREEITEM item = insertItem(name.c_str(), m_record->current, Record::SubdirectoryImage, 0);
            first = first ? first : item;
        }
    }
    tree().SetRedraw(TRUE);
    tree().EnsureVisible(first ? first : m_record->current);
    if (!m_record->toSelect.IsEmpty()) {
        select(m_record->toSelect);
        m_record->toSelect.Empty();
    }
}

HTREEITEM Gui_DirDlg::insertItem(const CString& name, HTREEITEM parent, int image, int children) {
    TVINSERTSTRUCT insertion{};
    insertion.hParent = parent;
    insertion.hInsertAfter = TVI_LAST;
    insertion.item.mask = TVIF_TEXT | TVIF_IMAGE | TVIF_SELECTEDIMAGE | TVIF_CHILDREN;
    insertion.item.pszText = const_cast<char*>(name.GetString());
    insertion.item.iImage = image;
    insertion.item.iSelectedImage = image;
    insertion.item.cChildren = children;
    return tree().InsertItem(&insertion);
}

/// The directory that an item stands for: the texts on the way to it, one behind the other.
Gui_FileName Gui_DirDlg::directoryOf(HTREEITEM item) {
    CString name;
    for (; item; item = tree().GetParentItem(item)) {
        const CString part = tree().GetItemText(item);
        if (name.IsEmpty() || part.Right(1) == "\\") {
            name = part + name;
        } else {
            name.Format("%s%c%s", part.GetString(), Gui_FileName::GetPathSeparator(), CString(name).GetString());
        }
    }
    Gui_FileName directory;
    directory.SetMountAndPath(name);
    return directory;
}

/// Selects a subdirectory of the current one.
void Gui_DirDlg::select(const CString& name) {
    for (HTREEITEM item = tree().GetChildItem(m_record->current); item; item = tree().GetNextSiblingItem(item)) {
        if (tree().GetItemText(item) == name) {
            tree().SelectItem(item);
            tree().EnsureVisible(item);
            tree().SetFocus();
            return;
        }
    }
}

LRESULT Gui_DirDlg::OnListed(WPARAM, LPARAM) {
    if (m_record->listing.isAnswered()) {
        fillSubdirectories();
    }
    return 0;
}

void Gui_DirDlg::OnDblclkDirpathtree(NMHDR*, LRESULT* result) {
    // The tree itself would expand or collapse the item.
    *result = 1;
    if (const HTREEITEM item = tree().GetSelectedItem()) {
        setDirectory(directoryOf(item));
        fillTree();
        showDirectory();
    }
}

void Gui_DirDlg::OnShowHidden() {
    fillTree();
}
