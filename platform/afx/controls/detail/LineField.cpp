#include "platform/afx/controls/detail/HostText.h"
#include "platform/afx/controls/detail/TextField.h"
#include "platform/afx/core/detail/Connect.h"

#include <QDropEvent>
#include <QKeyEvent>
#include <QLineEdit>
#include <QMimeData>

#include <limits>

namespace tvx::afx {

namespace {

TextRange selectionOf(const QLineEdit& edit) {
    const int caret = edit.cursorPosition();
    if (!edit.hasSelectedText()) {
        return {caret, caret};
    }
    const int first = edit.selectionStart();
    const int last = edit.selectionEnd();
    return caret == first ? TextRange{last, first} : TextRange{first, last};
}

/// The toolkit's field for one line, but for what concerns the clipboard: that is the control's.
class LineEdit : public QLineEdit {
public:
    LineEdit(QWidget* parent, FieldEvents events) : QLineEdit(parent), m_events(std::move(events)) {}

protected:
    void keyPressEvent(QKeyEvent* event) override {
        if (const auto command = fieldCommandOf(*event)) {
            event->accept();
            storing([&] { m_events.asked(*command); });
        } else {
            QLineEdit::keyPressEvent(event);
        }
    }
    void dragEnterEvent(QDragEnterEvent* event) override {
        m_selection = selectionOf(*this); // the toolkit shows by the caret where the text would go
        QLineEdit::dragEnterEvent(event);
    }
    void dropEvent(QDropEvent* event) override {
        QDragLeaveEvent leave;
        QLineEdit::dragLeaveEvent(&leave);
        if (isReadOnly() || !event->mimeData()->hasText()) {
            event->ignore();
            return;
        }
        DroppedText dropped{event->mimeData()->text(), cursorPositionAt(event->position().toPoint()), std::nullopt};
        if (event->source() == this && event->dropAction() == Qt::MoveAction) {
            dropped.movedFrom = m_selection;
        }
        event->acceptProposedAction();
        storing([&] { m_events.dropped(dropped); });
    }

private:
    FieldEvents m_events;
    TextRange m_selection;
};

class LineField : public TextField {
public:
    LineField(QWidget* parent, FieldEvents events) : m_edit(new LineEdit(parent, events)) {
        m_edit->setMaxLength(std::numeric_limits<int>::max()); // the limit is counted in bytes, by the control
        connectStoring(m_edit, &QLineEdit::textChanged, m_edit, std::move(events.changed));
    }
    QWidget* widget() const override {
        return m_edit;
    }
    QString text() const override {
        return m_edit->text();
    }
    void setText(const QString& text) override {
        m_edit->setText(text);
        // A new text is shown from its beginning; the toolkit would show its end.
        m_edit->setCursorPosition(0);
    }
    TextRange selection() const override {
        return selectionOf(*m_edit);
    }
    void select(const TextRange& range) override {
        if (range.anchor == range.caret) {
            m_edit->deselect();
            m_edit->setCursorPosition(range.caret);
        } else {
            m_edit->setSelection(range.anchor, range.caret - range.anchor);
        }
    }
    void insert(const QString& text, Undo undo) override {
        const bool locked = m_edit->isReadOnly();
        m_edit->setReadOnly(false);
        m_edit->insert(text);
        m_edit->setReadOnly(locked);
        if (undo == Undo::Forget) {
            forgetUndo();
        }
    }
    void undo() override {
        m_edit->undo();
    }
    bool canUndo() const override {
        return m_edit->isUndoAvailable();
    }
    void redo() override {
        m_edit->redo();
    }
    bool canRedo() const override {
        return m_edit->isRedoAvailable();
    }
    void forgetUndo() override {
        // The toolkit forgets its history with a new text only, and caret and mark of change with it.
        const TextRange range = selection();
        const bool modified = m_edit->isModified();
        const QSignalBlocker quiet(m_edit);
        m_edit->setText(m_edit->text());
        select(range);
        m_edit->setModified(modified);
    }
    bool isModified() const override {
        return m_edit->isModified();
    }
    void setModified(bool modified) override {
        m_edit->setModified(modified);
    }
    void setReadOnly(bool readOnly) override {
        m_edit->setReadOnly(readOnly);
    }
    void setPassword(bool password) override {
        m_edit->setEchoMode(password ? QLineEdit::Password : QLineEdit::Normal);
    }
    void setAlignment(Qt::Alignment alignment) override {
        m_edit->setAlignment(alignment | Qt::AlignVCenter);
    }
    void setFrame(bool frame) override {
        m_edit->setFrame(frame);
    }
    void cut() override {
        m_edit->cut();
    }
    void copy() override {
        m_edit->copy();
    }
    int bytes() const override {
        return hostBytes(m_edit->text());
    }
    int bytesAt(int position) const override {
        return hostBytes(m_edit->text(), position);
    }
    int positionAt(int bytes) const override {
        return toolkitUnits(m_edit->text(), bytes);
    }
    int lineCount() const override {
        return 1;
    }
    int lineAt(int) const override {
        return 0;
    }
    Line line(int) const override {
        return {0, m_edit->text()};
    }
    int firstVisibleLine() const override {
        return 0;
    }
    void scrollLines(int) override {}
    void showCaret() override {} // it always is
    int positionNear(QPoint point) const override {
        return m_edit->cursorPositionAt(point);
    }

private:
    QLineEdit* m_edit;
};

} // namespace

std::unique_ptr<TextField> makeLineField(QWidget* parent, FieldEvents events) {
    return std::make_unique<LineField>(parent, std::move(events));
}

} // namespace tvx::afx
