#include "s/PropTree.h"

#include "platform/base/Text.h"
#include "s/CommandFilter.h"

#include <algorithm>

/// Keeps changes of the control from being taken for the user's.
class PropTree::Quiet {
public:
    explicit Quiet(PropTree& tree) : m_tree(tree) {
        ++m_tree.m_quiet;
    }
    ~Quiet() {
        --m_tree.m_quiet;
    }
    Quiet(const Quiet&) = delete;
    Quiet& operator=(const Quiet&) = delete;

private:
    PropTree& m_tree;
};

// --- making ---

void PropTree::attach(CWnd& sheet, UINT id, bool multipleSelection) {
    forget();
    control.SubclassDlgItem(id, &sheet);
    control.SetMultiSelect(multipleSelection ? TRUE : FALSE);
}

void PropTree::forget() {
    m_entries.clear();
    m_places.clear();
    m_isFiltered = false;
}

void PropTree::build(const std::vector<Gui_PropItem*>& items) {
    const Quiet quiet(*this);
    for (Gui_PropItem* item : items) {
        add(item);
    }
    for (Entry& entry : m_entries) {
        insert(entry);
    }
    showInitialStates();
}

/// Gives an item its place behind that of its parent, and answers it.
int PropTree::add(Gui_PropItem* item) {
    // Taken before the parent is looked at: items that stand above each other in a circle end here.
    const auto [place, isNew] = m_places.try_emplace(item, -1);
    if (!isNew) {
        return place->second;
    }
    Gui_PropItem* const parent = item->GetParentItem();
    Entry entry;
    entry.item = item;
    entry.parent = parent ? add(parent) : -1;
    place->second = static_cast<int>(m_entries.size());
    m_entries.push_back(entry);
    return place->second;
}

void PropTree::insert(Entry& entry) {
    const CString label = labelOf(entry.item);
    const HTREEITEM above = entry.parent >= 0 ? m_entries[static_cast<std::size_t>(entry.parent)].node : nullptr;
    const UINT bold = showsChanges && entry.item->IsChanged() ? TVIS_BOLD : 0;
    TVINSERTSTRUCT description{};
    description.hParent = above ? above : TVI_ROOT;
    description.hInsertAfter = TVI_LAST;
    description.item.mask = TVIF_TEXT | TVIF_PARAM | TVIF_STATE;
    description.item.pszText = const_cast<LPSTR>(label.GetString());
    description.item.lParam = reinterpret_cast<LPARAM>(entry.item);
    description.item.state = bold;
    description.item.stateMask = TVIS_BOLD;
    entry.node = control.InsertItem(&description);
}

void PropTree::showInitialStates() {
    for (const Entry& entry : m_entries) {
        const Gui_PropItem::InitialState state = entry.item->GetInitialState();
        if (state != Gui_PropItem::StateDefault) {
            control.Expand(entry.node, state == Gui_PropItem::StateExpanded ? TVE_EXPAND : TVE_COLLAPSE);
        }
    }
}

// --- nodes and items ---

HTREEITEM PropTree::nodeOf(const Gui_PropItem* item) const {
    const auto place = m_places.find(item);
    return place != m_places.end() ? m_entries[static_cast<std::size_t>(place->second)].node : nullptr;
}

Gui_PropItem* PropTree::itemOf(HTREEITEM node) const {
    return node ? reinterpret_cast<Gui_PropItem*>(control.GetItemData(node)) : nullptr;
}

Gui_PropItem* PropTree::firstItem() const {
    return itemOf(control.GetRootItem());
}

std::vector<Gui_PropItem*> PropTree::selectedItems() const {
    std::vector<Gui_PropItem*> items;
    if (!control.m_hWnd) {
        return items;
    }
    for (HTREEITEM node = control.GetFirstSelectedItem(); node; node = control.GetNextSelectedItem(node)) {
        items.push_back(itemOf(node));
    }
    return items;
}

void PropTree::select(const std::vector<Gui_PropItem*>& items) {
    const Quiet quiet(*this);
    bool first = true;
    for (const Gui_PropItem* item : items) {
        const HTREEITEM node = nodeOf(item);
        if (!node) {
            continue;
        }
        if (!first && control.IsMultiSelect()) {
            control.SelectItem(node, TRUE);
        } else if (first) {
            control.SelectItem(node);
            control.EnsureVisible(node);
        }
        first = false;
    }
}

// --- labels ---

CString PropTree::labelOf(const Gui_PropItem* item) const {
    const CString name = item->GetName().c_str();
    return showsChanges && item->IsChanged() ? name + " *" : name;
}

void PropTree::relabel() {
    for (const Entry& entry : m_entries) {
        if (entry.node) {
            control.SetItemText(entry.node, labelOf(entry.item));
        }
    }
}

void PropTree::relabel(const Gui_PropItem* item) {
    const HTREEITEM node = nodeOf(item);
    if (!node || !control.m_hWnd) {
        return;
    }
    control.SetItemText(node, labelOf(item));
    control.SetItemState(node, showsChanges && item->IsChanged() ? TVIS_BOLD : 0, TVIS_BOLD);
}

// --- searching ---

void PropTree::rememberExpanded() {
    for (Entry& entry : m_entries) {
        entry.expanded = (control.GetItemState(entry.node, TVIS_EXPANDED) & TVIS_EXPANDED) != 0;
        const Port::StringBase<char> text = entry.item->GetName() + "\n" + entry.item->GetPageTitle() + "\n" +
                                            entry.item->GetPageSubTitle() + "\n" + entry.item->GetKeywords();
        entry.searched = tvx::text::foldCase(text.str());
    }
}

void PropTree::findEntries(const CString& words) {
    const std::vector<std::string> folded = FoldedWords(words.View());
    for (Entry& entry : m_entries) {
        entry.found = !folded.empty() && HasAllWords(entry.searched, folded);
        entry.above = false;
        // Of what was found everything below is there, too: a category is looked for to see what is in it.
        const bool below = entry.parent >= 0 && m_entries[static_cast<std::size_t>(entry.parent)].shown;
        entry.shown = folded.empty() || entry.found || below;
    }
    for (auto entry = m_entries.rbegin(); entry != m_entries.rend(); ++entry) {
        entry->shown = entry->shown || entry->above;
        if (entry->parent >= 0 && (entry->found || entry->above)) {
            m_entries[static_cast<std::size_t>(entry->parent)].above = true;
        }
    }
}

void PropTree::filter(const CString& words, const std::vector<Gui_PropItem*>& chosen) {
    const bool isFiltered = !FoldedWords(words.View()).empty();
    if (!isFiltered && !m_isFiltered) {
        return;
    }
    const Quiet quiet(*this);
    if (!m_isFiltered) {
        rememberExpanded();
    }
    m_isFiltered = isFiltered;
    findEntries(words);
    control.SetRedraw(FALSE);
    control.DeleteAllItems();
    for (Entry& entry : m_entries) {
        entry.node = nullptr;
        if (entry.shown) {
            insert(entry);
        }
    }
    for (const Entry& entry : m_entries) {
        if (isFiltered ? entry.above : entry.expanded) {
            control.Expand(entry.node, TVE_EXPAND);
        }
    }
    select(chosen);
    control.SetRedraw(TRUE);
}

Gui_PropItem* PropTree::nextFound(const Gui_PropItem* after) const {
    Gui_PropItem* first = nullptr;
    bool isBehind = false;
    for (HTREEITEM node = control.GetRootItem(); m_isFiltered && node; node = control.GetNextItem(node)) {
        Gui_PropItem* const item = itemOf(node);
        if (m_entries[static_cast<std::size_t>(m_places.at(item))].found) {
            if (isBehind) {
                return item;
            }
            first = first ? first : item;
        }
        isBehind = isBehind || item == after;
    }
    return first;
}

// --- paths ---

CString PropTree::pathOf(const Gui_PropItem* item) const {
    CString path;
    const auto place = m_places.find(item);
    for (int at = place != m_places.end() ? place->second : -1; at >= 0;
         at = m_entries[static_cast<std::size_t>(at)].parent) {
        const CString name = m_entries[static_cast<std::size_t>(at)].item->GetName().c_str();
        path = path.IsEmpty() ? name : name + "\t" + path;
    }
    return path;
}

Gui_PropItem* PropTree::itemAt(const CString& path) const {
    const auto found = std::ranges::find_if(m_entries, [&](const Entry& entry) { return pathOf(entry.item) == path; });
    return path.IsEmpty() || found == m_entries.end() ? nullptr : found->item;
}
