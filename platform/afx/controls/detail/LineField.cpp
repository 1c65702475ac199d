#include "platform/afx/controls/detail/HostText.h"
#include "platform/afx/controls/detail/TextField.h"
#include "platform/afx/core/detail/Connect.h"

#include <QLineEdit>

#include <limits>

namespace tvx::afx {

namespace {

class LineField : public TextField {
public:
    LineField(QWidget* parent, std::function<void()> changed) : m_edit(new QLineEdit(parent)) {
        m_edit->setMaxLength(std::numeric_limits<int>::max()); // the limit is counted in bytes, by the control
        connectStoring(m_edit, &QLineEdit::textChanged, m_edit, std::move(changed));
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
        const int caret = m_edit->cursorPosition();
        if (!m_edit->hasSelectedText()) {
            return {caret, caret};
        }
        const int first = m_edit->selectionStart();
        const int last = m_edit->selectionEnd();
        return caret == first ? TextRange{last, first} : TextRange{first, last};
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
        // One step each way, as hosts know it: undone twice, the change is there again.
        m_edit->isUndoAvailable() ? m_edit->undo() : m_edit->redo();
    }
    bool canUndo() const override {
        return m_edit->isUndoAvailable() || m_edit->isRedoAvailable();
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
    QMenu* makeMenu() override {
        return m_edit->createStandardContextMenu();
    }

private:
    QLineEdit* m_edit;
};

} // namespace

std::unique_ptr<TextField> makeLineField(QWidget* parent, std::function<void()> changed) {
    return std::make_unique<LineField>(parent, std::move(changed));
}

} // namespace tvx::afx
