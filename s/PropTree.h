#pragma once

#include "platform/sec/TreeCtrl.h"
#include "s/PropItem.h"

#include <map>
#include <string>
#include <vector>

/// @file
/// The category tree of a property sheet. Not for hosts.

/// The tree's control, which node stands for which item, and the search that leaves only some of the nodes.
///
/// What it does to the control by itself tells the sheet nothing: while isQuiet, a change of the selection is not the
/// user's.
class PropTree {
public:
    SECTreeCtrl control; ///< control 1001 of the sheet
    /// Whether items that hold changes are marked.
    bool showsChanges = false;

    /// Takes the control over. Nodes of an earlier window are forgotten.
    void attach(CWnd& sheet, UINT id, bool multipleSelection);
    /// Gives each item a node below that of its parent, which gets one first, and shows the initial states.
    void build(const std::vector<Gui_PropItem*>& items);
    /// Forgets the nodes: the window is gone.
    void forget();

    /// Null when the item has no node, or none that the search has left.
    HTREEITEM nodeOf(const Gui_PropItem* item) const;
    /// Null for no node.
    Gui_PropItem* itemOf(HTREEITEM node) const;
    /// The item of the first node; null in an empty tree.
    Gui_PropItem* firstItem() const;
    /// The items of the selected nodes, from the top.
    std::vector<Gui_PropItem*> selectedItems() const;
    /// Selects the nodes of these items that there are, and brings the first into sight.
    void select(const std::vector<Gui_PropItem*>& items);
    /// Whether a change of the selection is not the user's.
    bool isQuiet() const {
        return m_quiet > 0 || m_entries.empty();
    }

    /// Shows names and marks anew: of all items, of one.
    /// @{
    void relabel();
    void relabel(const Gui_PropItem* item);
    /// @}

    /// Leaves the nodes of items in which all words stand, those above and those below them. Without a word all are
    /// there again, expanded as they were.
    /// @param chosen what is to be selected of what is left
    void filter(const CString& words, const std::vector<Gui_PropItem*>& chosen);
    /// The item found behind another one in the order of the tree, the first one after the last; null when nothing is
    /// looked for or found.
    Gui_PropItem* nextFound(const Gui_PropItem* after) const;

    /// The names from the top down to an item, and the item of such names; empty and null when there is none.
    /// @{
    CString pathOf(const Gui_PropItem* item) const;
    Gui_PropItem* itemAt(const CString& path) const;
    /// @}

private:
    class Quiet;
    /// What is known of one item, in the order of the first nodes: parents stand before their children.
    struct Entry {
        Gui_PropItem* item = nullptr;
        HTREEITEM node = nullptr; ///< null while the search hides it
        int parent = -1;          ///< its place; -1 at the top
        std::string searched;     ///< what the search looks at, without case
        bool found = false;       ///< by the words
        bool above = false;       ///< something below was found
        bool shown = true;        ///< is to have a node
        bool expanded = false;    ///< before the search
    };

    int add(Gui_PropItem* item);
    void insert(Entry& entry);
    void showInitialStates();
    void rememberExpanded();
    void findEntries(const CString& words);
    CString labelOf(const Gui_PropItem* item) const;

    std::vector<Entry> m_entries;
    std::map<const Gui_PropItem*, int> m_places;
    bool m_isFiltered = false;
    int m_quiet = 0;
};
