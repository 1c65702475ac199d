#include "platform/afx/controls/detail/TreeModel.h"

#include "platform/afx/core/detail/Loop.h"

#include <QFont>

namespace tvx::afx {

namespace {

/// What hosts give of an item, without what ties it to its place.
void copyContent(TreeNode& to, const TreeNode& from) {
    to.text = from.text;
    to.data = from.data;
    to.image = from.image;
    to.selectedImage = from.selectedImage;
    to.childrenHint = from.childrenHint;
    to.asksText = from.asksText;
    to.isBold = from.isBold;
}

} // namespace

// --- items and indexes ---

TreeNode& TreeModel::nodeOf(const QModelIndex& index) const {
    return index.isValid() ? *static_cast<TreeNode*>(index.internalPointer()) : m_nodes.root();
}

bool TreeModel::isTold(TreeNode& node) const {
    for (TreeNode* at = &node; at->parent; at = at->parent) {
        if (TreeNodes::rowOf(*at) >= at->parent->told) {
            return false;
        }
    }
    return true;
}

QModelIndex TreeModel::indexOf(TreeNode& node) {
    if (!node.parent) {
        return {};
    }
    const int row = TreeNodes::rowOf(node);
    if (row >= node.parent->told || !isTold(*node.parent)) {
        indexOf(*node.parent);
        tellAll(*node.parent);
    }
    return createIndex(row, 0, &node);
}

void TreeModel::tellAll(TreeNode& parent) {
    const int count = static_cast<int>(parent.children.size());
    if (parent.told < count) {
        beginInsertRows(indexOf(parent), parent.told, count - 1);
        parent.told = count;
        endInsertRows();
    }
}

TreeNode& TreeModel::insert(TreeNode& parent, std::size_t row, const TreeNode& content) {
    const bool isFirst = parent.children.empty();
    // The first child gives its parent a button; whom the view knows shows it.
    if (static_cast<int>(row) < parent.told || (isFirst && isTold(parent))) {
        beginInsertRows(indexOf(parent), static_cast<int>(row), static_cast<int>(row));
        TreeNode& node = m_nodes.insert(parent, row);
        copyContent(node, content);
        ++parent.told;
        endInsertRows();
        return node;
    }
    TreeNode& node = m_nodes.insert(parent, row);
    copyContent(node, content);
    return node;
}

void TreeModel::remove(TreeNode& node) {
    TreeNode& parent = *node.parent;
    if (!isTold(node)) {
        m_nodes.remove(node);
        return;
    }
    const int row = TreeNodes::rowOf(node);
    beginRemoveRows(indexOf(parent), row, row);
    m_nodes.remove(node);
    --parent.told;
    endRemoveRows();
}

void TreeModel::clear() {
    beginResetModel();
    m_nodes.clear();
    endResetModel();
}

void TreeModel::sort(TreeNode& parent) {
    tellAll(parent);
    const QList<QPersistentModelIndex> parents{QPersistentModelIndex(indexOf(parent))};
    Q_EMIT layoutAboutToBeChanged(parents, VerticalSortHint);
    const QModelIndexList before = persistentIndexList();
    TreeNodes::sort(parent);
    QModelIndexList after;
    for (const QModelIndex& index : before) {
        TreeNode& node = nodeOf(index);
        after.append(createIndex(TreeNodes::rowOf(node), 0, &node));
    }
    changePersistentIndexList(before, after);
    Q_EMIT layoutChanged(parents, VerticalSortHint);
}

void TreeModel::changed(TreeNode& node) {
    if (isTold(node)) {
        const QModelIndex index = indexOf(node);
        Q_EMIT dataChanged(index, index);
    }
}

// --- what views ask ---

QModelIndex TreeModel::index(int row, int column, const QModelIndex& parent) const {
    const TreeNode& above = nodeOf(parent);
    if (column != 0 || row < 0 || row >= above.told) {
        return {};
    }
    return createIndex(row, 0, above.children[static_cast<std::size_t>(row)]);
}

QModelIndex TreeModel::parent(const QModelIndex& index) const {
    TreeNode* above = nodeOf(index).parent;
    return above && above->parent ? createIndex(TreeNodes::rowOf(*above), 0, above) : QModelIndex();
}

int TreeModel::rowCount(const QModelIndex& parent) const {
    return nodeOf(parent).told;
}

int TreeModel::columnCount(const QModelIndex&) const {
    return 1;
}

bool TreeModel::hasChildren(const QModelIndex& parent) const {
    TreeNode& node = nodeOf(parent);
    bool has = !node.children.empty();
    if (!has && node.parent) {
        storing([&] { has = m_host.hasChildren(node); });
    }
    return has;
}

bool TreeModel::canFetchMore(const QModelIndex& parent) const {
    const TreeNode& node = nodeOf(parent);
    return node.told < static_cast<int>(node.children.size());
}

void TreeModel::fetchMore(const QModelIndex& parent) {
    tellAll(nodeOf(parent));
}

QVariant TreeModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) {
        return {};
    }
    TreeNode& node = nodeOf(index);
    QVariant answer;
    storing([&] {
        if (role == Qt::DisplayRole || role == Qt::EditRole) {
            answer = m_host.textOf(node);
        } else if (role == Qt::DecorationRole) {
            const QIcon icon = m_host.iconOf(node);
            answer = icon.isNull() ? QVariant() : QVariant(icon);
        } else if (role == Qt::FontRole && node.isBold) {
            QFont bold;
            bold.setBold(true);
            answer = bold;
        }
    });
    return answer;
}

bool TreeModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (!index.isValid() || role != Qt::EditRole) {
        return false;
    }
    storing([&] { m_host.labelEdited(TreeNodes::handleOf(&nodeOf(index)), value.toString()); });
    return true;
}

Qt::ItemFlags TreeModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) {
        return Qt::NoItemFlags;
    }
    const Qt::ItemFlags shown = Qt::ItemIsEnabled | Qt::ItemIsSelectable;
    return m_host.isEditable() ? shown | Qt::ItemIsEditable : shown;
}

} // namespace tvx::afx
