#pragma once

/// @file
/// The toolkit's tree as the window of a tree control uses it.

#include "platform/afx/controls/detail/TreeModel.h"

#include <QItemSelectionModel>
#include <QTreeView>

namespace tvx::afx {

class TreeArea;

/// Why something happens to the selection or an item, for what the parent is told.
enum class TreeCause { Unknown, Mouse, Keyboard };

/// What the user does, as the window of the tree takes part in it.
class TreeEvents {
public:
    /// Whether the selection may move to an item; the root for none.
    virtual bool maySelect(TreeNode& node) = 0;
    /// An action of the user has ended that may have changed the selection.
    virtual void selectionSettled(TreeCause cause) = 0;
    /// Expands or collapses for the user.
    virtual void toggle(TreeNode& node, bool expand) = 0;
    virtual void startEditing(TreeNode& node) = 0;
    /// Answers whether the parent wants nothing else to be done.
    virtual bool tellMouse(UINT code) = 0;
    /// Tells the view of items that it has not been told of yet.
    virtual void tellItems() = 0;

protected:
    ~TreeEvents() = default;
};

/// Asks before a selection moves.
class TreeSelection : public QItemSelectionModel {
public:
    TreeSelection(QAbstractItemModel* model, TreeArea& area);
    void setCurrentIndex(const QModelIndex& index, QItemSelectionModel::SelectionFlags command) override;
    void select(const QItemSelection& selection, QItemSelectionModel::SelectionFlags command) override;
    void select(const QModelIndex& index, QItemSelectionModel::SelectionFlags command) override;

private:
    TreeArea& m_area;
};

/// Between these overrides and the place of ours below stand frames of the toolkit, which cannot be unwound: what a
/// host's handler throws is stored.
class TreeArea : public QTreeView {
public:
    TreeArea(QWidget* parent, TreeModel& model, TreeEvents& events);

    void setMultiple(bool multiple);
    bool isMultiple() const {
        return selectionMode() == ExtendedSelection;
    }
    /// Whether items have buttons to expand and collapse them by.
    void setButtons(bool shown, bool atRoot);
    /// Whether what is selected can be seen without the keyboard.
    void setShowsSelectionAlways(bool always) {
        m_showsSelectionAlways = always;
    }
    bool showsSelection() const;
    /// Whether the selection may move there now; asks once in an action of the user.
    bool allows(const QModelIndex& index);
    /// The button of an item, empty for one without.
    QRect buttonRect(const QModelIndex& index) const;
    /// Picture and text of an item.
    QRect labelRect(const QModelIndex& index) const;
    bool hasShownButtons() const {
        return m_buttons;
    }
    /// Carries out a layout that is still to come.
    void layOut() {
        executeDelayedItemsLayout();
    }
    bool isEditing() const {
        return state() == EditingState;
    }
    /// Lets the selection be set by the host without being asked.
    class Quiet {
    public:
        explicit Quiet(TreeArea& area) : m_area(area) {
            ++m_area.m_quiet;
        }
        ~Quiet() {
            --m_area.m_quiet;
        }
        Quiet(const Quiet&) = delete;
        Quiet& operator=(const Quiet&) = delete;

    private:
        TreeArea& m_area;
    };
    bool isQuiet() const {
        return m_quiet > 0;
    }
    bool isInAction() const {
        return m_inAction;
    }

    void doItemsLayout() override;
    void keyboardSearch(const QString& search) override;

protected:
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool viewportEvent(QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void drawBranches(QPainter* painter, const QRect& rect, const QModelIndex& index) const override;
    QItemSelectionModel::SelectionFlags selectionCommand(const QModelIndex& index, const QEvent* event) const override;

private:
    template <class Call>
    void act(TreeCause cause, Call&& call);
    bool expandKey(const QKeyEvent& event);
    void expandAll(const QModelIndex& index, bool asks);
    void moveSideways(bool forward);
    bool pressButton(QPoint point);

    TreeModel& m_model;
    TreeEvents& m_events;
    QModelIndex m_asked; ///< of the action that goes on, and whether the selection may move there
    bool m_mayMove = true;
    bool m_inAction = false;
    int m_quiet = 0;
    bool m_buttons = false;
    bool m_showsSelectionAlways = false;
};

} // namespace tvx::afx
