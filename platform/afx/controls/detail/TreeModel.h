#pragma once

/// @file
/// The items of a tree as the toolkit's views see them.

#include "platform/afx/controls/detail/TreeNodes.h"

#include <QAbstractItemModel>
#include <QIcon>

namespace tvx::afx {

/// Answers what only the window of a tree knows. All of it is asked for items that are to be seen only.
class TreeHost {
public:
    virtual QString textOf(TreeNode& node) = 0;
    virtual bool hasChildren(TreeNode& node) = 0;
    virtual QIcon iconOf(const TreeNode& node) = 0;
    virtual bool isEditable() const = 0;
    /// The user has ended the change of a label.
    virtual void labelEdited(HTREEITEM item, const QString& text) = 0;

protected:
    ~TreeHost() = default;
};

/// A view is told of items late: of those behind the ones that it knows when it comes to show them (fetchMore) or when
/// the loop comes round. To fill a tree costs no call into the view for each item so.
class TreeModel : public QAbstractItemModel {
public:
    TreeModel(TreeHost& host, QObject* parent) : QAbstractItemModel(parent), m_host(host) {}

    TreeNodes& nodes() {
        return m_nodes;
    }
    /// The item of an index; the root for an invalid one.
    TreeNode& nodeOf(const QModelIndex& index) const;
    /// The index of an item, of which the view knows afterwards; invalid for the root.
    QModelIndex indexOf(TreeNode& node);

    TreeNode& insert(TreeNode& parent, std::size_t row, const TreeNode& content);
    void remove(TreeNode& node);
    void clear();
    void sort(TreeNode& parent);
    /// Something of an item looks different now.
    void changed(TreeNode& node);
    /// Tells the view of all children that it does not know yet.
    void tellAll(TreeNode& parent);

    QModelIndex index(int row, int column, const QModelIndex& parent) const override;
    QModelIndex parent(const QModelIndex& index) const override;
    int rowCount(const QModelIndex& parent) const override;
    int columnCount(const QModelIndex& parent) const override;
    bool hasChildren(const QModelIndex& parent) const override;
    bool canFetchMore(const QModelIndex& parent) const override;
    void fetchMore(const QModelIndex& parent) override;
    QVariant data(const QModelIndex& index, int role) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role) override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;

private:
    bool isTold(TreeNode& node) const;

    TreeHost& m_host;
    mutable TreeNodes m_nodes;
};

} // namespace tvx::afx
