#include "platform/afx/controls/detail/HostText.h"
#include "platform/afx/controls/detail/TextField.h"
#include "platform/afx/core/detail/Connect.h"

#include <QAbstractTextDocumentLayout>
#include <QDropEvent>
#include <QKeyEvent>
#include <QMimeData>
#include <QPlainTextEdit>
#include <QScrollBar>
#include <QStyleOptionFrame>
#include <QStylePainter>
#include <QTextBlock>
#include <QTextCursor>
#include <QTextLayout>

namespace tvx::afx {

namespace {

Qt::ScrollBarPolicy policy(bool bar) {
    return bar ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAlwaysOff;
}

/// A text as it was set. The toolkit's own plain text has blanks in the place of those that must not be broken, and
/// line ends in the place of other separators.
QString plainText(QString raw) {
    return raw.replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
}

TextRange selectionOf(const QPlainTextEdit& edit) {
    const QTextCursor cursor = edit.textCursor();
    return {cursor.anchor(), cursor.position()};
}

/// The toolkit's field for many lines, with habits of its own. What concerns the clipboard is the control's. Its frame
/// shows the keyboard as that of one line does. Its text is offered to others as nothing but text, so that no word
/// processor takes fonts and colours along.
class AreaEdit : public QPlainTextEdit {
public:
    AreaEdit(QWidget* parent, FieldEvents events) : QPlainTextEdit(parent), m_events(std::move(events)) {}

protected:
    void keyPressEvent(QKeyEvent* event) override {
        const auto command = fieldCommandOf(*event);
        // In many lines the toolkit deletes the ends of lines without a look at the clipboard.
        if (command && *command != FieldCommand::CutToEnd && *command != FieldCommand::CutAll) {
            event->accept();
            storing([&] { m_events.asked(*command); });
        } else {
            QPlainTextEdit::keyPressEvent(event);
        }
    }
    void dropEvent(QDropEvent* event) override {
        QDragLeaveEvent leave;
        QPlainTextEdit::dragLeaveEvent(&leave);
        if (isReadOnly() || !event->mimeData()->hasText()) {
            event->ignore();
            return;
        }
        const int position = cursorForPosition(event->position().toPoint()).position();
        DroppedText dropped{event->mimeData()->text(), position, std::nullopt};
        const bool own = event->source() == this || event->source() == viewport();
        if (own && event->dropAction() == Qt::MoveAction) {
            dropped.movedFrom = selectionOf(*this);
        }
        event->acceptProposedAction();
        storing([&] { m_events.dropped(dropped); });
    }
    bool event(QEvent* event) override {
        if (event->type() == QEvent::Paint && hasFocus() && frameWidth() > 0) {
            QStylePainter painter(this);
            QStyleOptionFrame frame;
            frame.initFrom(this);
            frame.state |= QStyle::State_Sunken;
            frame.lineWidth = frameWidth();
            painter.drawPrimitive(QStyle::PE_FrameLineEdit, frame);
            return true;
        }
        if (event->type() == QEvent::FocusIn || event->type() == QEvent::FocusOut) {
            update();
        }
        if (event->type() == QEvent::FontChange) {
            placeText();
        }
        return QPlainTextEdit::event(event);
    }
    void resizeEvent(QResizeEvent* event) override {
        placeText();
        QPlainTextEdit::resizeEvent(event);
    }
    QMimeData* createMimeDataFromSelection() const override {
        auto* data = new QMimeData;
        data->setText(plainText(textCursor().selectedText()));
        return data;
    }

private:
    /// In a field that has room for one line only, the line stands where that of a field of one line does.
    void placeText() {
        constexpr int usual = 2;
        const int inside = height() - 2 * frameWidth();
        const int line = fontMetrics().lineSpacing();
        const bool bars = verticalScrollBarPolicy() != Qt::ScrollBarAlwaysOff ||
                          horizontalScrollBarPolicy() != Qt::ScrollBarAlwaysOff;
        const bool isOneLine = !bars && inside < 2 * line + 2 * usual;
        const int margin = isOneLine ? std::max((inside - line) / 2, 0) : usual;
        if (document()->documentMargin() != margin) {
            document()->setDocumentMargin(margin);
        }
    }
    FieldEvents m_events;
};

class AreaField : public TextField {
public:
    AreaField(QWidget* parent, const AreaOptions& options, FieldEvents events)
        : m_edit(new AreaEdit(parent, events)), m_wraps(options.wraps) {
        count(0, 0);
        connectStoring(m_edit->document(), &QTextDocument::contentsChange, m_edit,
                       [this](int position, int, int added) { count(position, added); });
        // Tab moves on by the keys of dialogs; what comes through to here is text.
        m_edit->setTabChangesFocus(false);
        m_edit->setLineWrapMode(options.wraps ? QPlainTextEdit::WidgetWidth : QPlainTextEdit::NoWrap);
        m_edit->setVerticalScrollBarPolicy(policy(options.verticalBar));
        m_edit->setHorizontalScrollBarPolicy(policy(options.horizontalBar));
        connectStoring(m_edit, &QPlainTextEdit::textChanged, m_edit, std::move(events.changed));
    }
    QWidget* widget() const override {
        return m_edit;
    }
    QString text() const override {
        return plainText(m_edit->document()->toRawText());
    }
    void setText(const QString& text) override {
        m_edit->setPlainText(text);
    }
    TextRange selection() const override {
        return selectionOf(*m_edit);
    }
    void select(const TextRange& range) override {
        QTextCursor cursor = m_edit->textCursor();
        cursor.setPosition(range.anchor);
        cursor.setPosition(range.caret, QTextCursor::KeepAnchor);
        m_edit->setTextCursor(cursor);
    }
    void insert(const QString& text, Undo undo) override {
        if (undo == Undo::Forget) {
            // With undo switched off the change is not recorded at all: logs that grow by the line would pay for each.
            forgetUndo();
            m_edit->setUndoRedoEnabled(false);
        }
        m_edit->textCursor().insertText(text);
        if (undo == Undo::Forget) {
            // Not otherwise: with it the toolkit forgets at which change the text was unmodified.
            m_edit->setUndoRedoEnabled(true);
        }
        // A program that only deletes goes on with something else; the view need not go there and back.
        if (undo == Undo::Keep || !text.isEmpty()) {
            m_edit->ensureCursorVisible();
        }
    }
    void undo() override {
        m_edit->undo();
    }
    bool canUndo() const override {
        return m_edit->document()->isUndoAvailable();
    }
    void redo() override {
        m_edit->redo();
    }
    bool canRedo() const override {
        return m_edit->document()->isRedoAvailable();
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
    int bytes() const override {
        return m_bytes.total();
    }
    int bytesAt(int position) const override {
        const QTextBlock block = m_edit->document()->findBlock(position);
        return block.isValid()
                   ? m_bytes.before(block.blockNumber()) + hostBytes(block.text(), position - block.position())
                   : m_bytes.total();
    }
    int positionAt(int bytes) const override {
        const ParagraphBytes::Place place = m_bytes.find(bytes);
        const QTextBlock block = m_edit->document()->findBlockByNumber(place.paragraph);
        return block.position() + toolkitUnits(block.text(), place.bytes);
    }
    int lineCount() const override {
        layOut();
        return m_edit->document()->lineCount();
    }
    int lineAt(int position) const override {
        layOut();
        const QTextBlock block = m_edit->document()->findBlock(position);
        const QTextLine line = block.layout()->lineForTextPosition(position - block.position());
        return block.firstLineNumber() + (line.isValid() ? line.lineNumber() : 0);
    }
    Line line(int number) const override {
        layOut();
        const QTextBlock block = m_edit->document()->findBlockByLineNumber(number);
        if (!m_wraps || block.layout()->lineCount() == 0) {
            return {block.position(), block.text()};
        }
        const QTextLine line = block.layout()->lineAt(number - block.firstLineNumber());
        return {block.position() + line.textStart(), block.text().mid(line.textStart(), line.textLength())};
    }
    int firstVisibleLine() const override {
        // The bar of this widget counts lines, not pixels.
        return m_edit->verticalScrollBar()->value();
    }
    void scrollLines(int lines) override {
        m_edit->verticalScrollBar()->setValue(m_edit->verticalScrollBar()->value() + lines);
    }
    void showCaret() override {
        m_edit->ensureCursorVisible();
    }
    int positionNear(QPoint point) const override {
        return m_edit->cursorForPosition(point).position();
    }

private:
    /// Wrapped lines are known of paragraphs only that have been laid out.
    void layOut() const {
        if (!m_wraps) {
            return;
        }
        QAbstractTextDocumentLayout* layouts = m_edit->document()->documentLayout();
        for (QTextBlock block = m_edit->document()->firstBlock(); block.isValid(); block = block.next()) {
            layouts->blockBoundingRect(block);
        }
    }
    /// Counts the paragraphs again that a change has touched.
    void count(int position, int added) {
        // The toolkit's count of characters has the end of the last paragraph in it, where no block can be found.
        const QTextDocument& document = *m_edit->document();
        const int last = document.findBlock(std::min(position + added, document.characterCount() - 1)).blockNumber();
        const int behind = document.blockCount() - 1 - last;
        QTextBlock block = document.findBlock(std::min(position, document.characterCount() - 1));
        const int first = std::min(block.blockNumber(), m_bytes.count());
        std::vector<int> sizes;
        for (int number = first; number <= last; ++number, block = block.next()) {
            sizes.push_back(hostBytes(block.text()) + ParagraphBytes::lineEnd);
        }
        m_bytes.replace(first, std::max(m_bytes.count() - behind - first, 0), sizes);
    }

    QPlainTextEdit* m_edit;
    bool m_wraps;
    ParagraphBytes m_bytes;
};

} // namespace

std::unique_ptr<TextField> makeAreaField(QWidget* parent, const AreaOptions& options, FieldEvents events) {
    return std::make_unique<AreaField>(parent, options, std::move(events));
}

} // namespace tvx::afx
