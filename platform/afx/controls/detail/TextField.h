#pragma once

/// @file
/// The toolkit's two text fields, one line and many lines, seen alike. Positions are the toolkit's: units of UTF-16, a
/// line's end counting as one.

#include <QString>

#include <functional>
#include <memory>
#include <optional>

class QKeyEvent;
class QPoint;
class QWidget;

namespace tvx::afx {

/// A stretch of text; the caret stands at `caret`.
struct TextRange {
    int anchor = 0;
    int caret = 0;
    int first() const {
        return std::min(anchor, caret);
    }
    int last() const {
        return std::max(anchor, caret);
    }
};

/// What becomes of the changes that could be taken back when the program makes another one.
enum class Undo { Keep, Forget };

/// A line as it is shown: where it begins, and its text without its end.
struct Line {
    int start = 0;
    QString text;
};

/// What keys ask a field for that concerns others than the field: the control asks for it by its messages.
enum class FieldCommand { Undo, Redo, Cut, CutToEnd, CutAll, Copy, Paste, PasteSelection, SelectAll };
/// The command of a key press; none for all other keys.
[[nodiscard]] std::optional<FieldCommand> fieldCommandOf(const QKeyEvent& event);

/// A text that was dropped on a field.
struct DroppedText {
    QString text;
    int position = 0;                   ///< Where it was dropped.
    std::optional<TextRange> movedFrom; ///< Where it came from, when it was moved within the field.
};

/// What a field tells its control. None of it may stay empty.
struct FieldEvents {
    std::function<void()> changed; ///< After each change of the text.
    std::function<void(FieldCommand)> asked;
    std::function<void(const DroppedText&)> dropped;
};

/// What an edit control needs of a text field.
class TextField {
public:
    virtual ~TextField() = default;
    virtual QWidget* widget() const = 0;
    virtual QString text() const = 0;
    virtual void setText(const QString& text) = 0;
    virtual TextRange selection() const = 0;
    virtual void select(const TextRange& range) = 0;
    /// Replaces the selection.
    virtual void insert(const QString& text, Undo undo) = 0;
    virtual void undo() = 0;
    virtual bool canUndo() const = 0;
    virtual void redo() = 0;
    virtual bool canRedo() const = 0;
    virtual void forgetUndo() = 0;
    virtual bool isModified() const = 0;
    virtual void setModified(bool modified) = 0;
    virtual void setReadOnly(bool readOnly) = 0;
    virtual void setPassword(bool password) = 0;
    virtual void setAlignment(Qt::Alignment alignment) = 0;
    virtual void setFrame(bool frame) = 0;
    virtual void cut() = 0;
    virtual void copy() = 0;
    /// Length of the text in bytes, as hosts count them.
    virtual int bytes() const = 0;
    /// Bytes before a position.
    virtual int bytesAt(int position) const = 0;
    /// The position of a byte; one within a character is moved to its beginning.
    virtual int positionAt(int bytes) const = 0;
    /// Number of lines, wrapped ones counted singly.
    virtual int lineCount() const = 0;
    /// The line of a position.
    virtual int lineAt(int position) const = 0;
    /// @param number of an existing line
    virtual Line line(int number) const = 0;
    virtual int firstVisibleLine() const = 0;
    virtual void scrollLines(int lines) = 0;
    virtual void showCaret() = 0;
    /// The position nearest to a point of the client area.
    virtual int positionNear(QPoint point) const = 0;
};

/// A field of one line; its widget is a QLineEdit.
std::unique_ptr<TextField> makeLineField(QWidget* parent, FieldEvents events);

struct AreaOptions {
    bool wraps = true;
    bool verticalBar = false;
    bool horizontalBar = false;
};
/// A field of many lines.
std::unique_ptr<TextField> makeAreaField(QWidget* parent, const AreaOptions& options, FieldEvents events);

} // namespace tvx::afx
