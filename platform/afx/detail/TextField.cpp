#include "platform/afx/detail/TextField.h"

#include <QAbstractTextDocumentLayout>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QScrollBar>
#include <QTextBlock>
#include <QTextLayout>

#include <limits>

namespace tvx::afx {

namespace {

class LineField : public TextField {
public:
    LineField(QWidget* parent, std::function<void()> changed) : m_edit(new QLineEdit(parent)) {
        m_edit->setMaxLength(std::numeric_limits<int>::max()); // the limit is counted in bytes, by the control
        QObject::connect(m_edit, &QLineEdit::textChanged, m_edit, [changed = std::move(changed)] { changed(); });
    }
    QWidget* widget() const override {
        return m_edit;
    }
    QString text() const override {
        return m_edit->text();
    }
    void setText(const QString& text) override {
        m_edit->setText(text);
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
    void insert(const QString& text) override {
        const bool locked = m_edit->isReadOnly();
        m_edit->setReadOnly(false);
        m_edit->insert(text);
        m_edit->setReadOnly(locked);
    }
    void undo() override {
        m_edit->isUndoAvailable() ? m_edit->undo() : m_edit->redo();
    }
    bool canUndo() const override {
        return m_edit->isUndoAvailable() || m_edit->isRedoAvailable();
    }
    void forgetUndo() override {
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
    std::vector<int> lineStarts() const override {
        return {0};
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

Qt::ScrollBarPolicy policy(bool bar) {
    return bar ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAlwaysOff;
}

class AreaField : public TextField {
public:
    AreaField(QWidget* parent, const AreaOptions& options, std::function<void()> changed)
        : m_edit(new QPlainTextEdit(parent)) {
        m_edit->setTabChangesFocus(false);
        m_edit->setLineWrapMode(options.wraps ? QPlainTextEdit::WidgetWidth : QPlainTextEdit::NoWrap);
        m_edit->setVerticalScrollBarPolicy(policy(options.verticalBar));
        m_edit->setHorizontalScrollBarPolicy(policy(options.horizontalBar));
        m_edit->document()->setDocumentMargin(2);
        QObject::connect(m_edit, &QPlainTextEdit::textChanged, m_edit, [changed = std::move(changed)] { changed(); });
    }
    QWidget* widget() const override {
        return m_edit;
    }
    QString text() const override {
        return m_edit->toPlainText();
    }
    void setText(const QString& text) override {
        m_edit->setPlainText(text);
    }
    TextRange selection() const override {
        const QTextCursor cursor = m_edit->textCursor();
        return {cursor.anchor(), cursor.position()};
    }
    void select(const TextRange& range) override {
        QTextCursor cursor = m_edit->textCursor();
        cursor.setPosition(range.anchor);
        cursor.setPosition(range.caret, QTextCursor::KeepAnchor);
        m_edit->setTextCursor(cursor);
    }
    void insert(const QString& text) override {
        m_edit->textCursor().insertText(text);
        m_edit->ensureCursorVisible();
    }
    void undo() override {
        m_edit->document()->isUndoAvailable() ? m_edit->undo() : m_edit->redo();
    }
    bool canUndo() const override {
        return m_edit->document()->isUndoAvailable() || m_edit->document()->isRedoAvailable();
    }
    void forgetUndo() override {
        m_edit->document()->clearUndoRedoStacks();
    }
    bool isModified() const override {
        return m_edit->document()->isModified();
    }
    void setModified(bool modified) override {
        m_edit->document()->setModified(modified);
    }
    void setReadOnly(bool readOnly) override {
        m_edit->setReadOnly(readOnly);
    }
    void setPassword(bool) override {}
    void setAlignment(Qt::Alignment alignment) override {
        QTextOption option = m_edit->document()->defaultTextOption();
        option.setAlignment(alignment);
        m_edit->document()->setDefaultTextOption(option);
    }
    void setFrame(bool frame) override {
        m_edit->setFrameStyle(frame ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
    }
    void cut() override {
        m_edit->cut();
    }
    void copy() override {
        m_edit->copy();
    }
    std::vector<int> lineStarts() const override {
        std::vector<int> starts;
        QAbstractTextDocumentLayout* layouts = m_edit->document()->documentLayout();
        for (QTextBlock block = m_edit->document()->firstBlock(); block.isValid(); block = block.next()) {
            layouts->blockBoundingRect(block); // lays the block out
            const QTextLayout* layout = block.layout();
            starts.push_back(block.position());
            for (int line = 1; line < layout->lineCount(); ++line) {
                starts.push_back(block.position() + layout->lineAt(line).textStart());
            }
        }
        return starts;
    }
    int firstVisibleLine() const override {
        return m_edit->verticalScrollBar()->value();
    }
    void scrollLines(int lines) override {
        m_edit->verticalScrollBar()->setValue(m_edit->verticalScrollBar()->value() + lines);
    }
    void showCaret() override {
        m_edit->ensureCursorVisible();
    }
    QMenu* makeMenu() override {
        return m_edit->createStandardContextMenu();
    }

private:
    QPlainTextEdit* m_edit;
};

} // namespace

std::unique_ptr<TextField> makeLineField(QWidget* parent, std::function<void()> changed) {
    return std::make_unique<LineField>(parent, std::move(changed));
}

std::unique_ptr<TextField> makeAreaField(QWidget* parent, const AreaOptions& options, std::function<void()> changed) {
    return std::make_unique<AreaField>(parent, options, std::move(changed));
}

} // namespace tvx::afx
