#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// @file
/// Drawings and their text format (docs/drawing-format.md). Nothing in here knows of windows.

namespace board {

enum class ShapeKind { Rectangle, Ellipse, Line, Text };

/// 0xRRGGBB, or noColor for a shape that is not filled.
using Color = std::uint32_t;
inline constexpr Color noColor = 0xFF000000;

/// Coordinates reach from -maxCoordinate to maxCoordinate, in pixels.
inline constexpr int maxCoordinate = 100000;
/// Limits of Shape::size, in pixels.
inline constexpr int minTextSize = 4;
inline constexpr int maxTextSize = 400;

struct Point {
    int x = 0;
    int y = 0;
    bool operator==(const Point&) const = default;
};

/// One shape of a drawing. Two points carry it: the ends of a line, opposite corners of the box of all others.
struct Shape {
    ShapeKind kind = ShapeKind::Rectangle;
    Point from;
    Point to;
    Color color = 0;         ///< Of the outline, or of the text.
    Color fill = noColor;    ///< Of the area; lines have none.
    int width = 1;           ///< Of the outline, 1 to 20 pixels.
    int size = 16;           ///< Height of a text's characters.
    std::string text;        ///< UTF-8, may hold line ends. Of texts only.
    std::string linesBefore; ///< Comments and empty lines that stand before the shape in the file, as they are.

    /// Whether a click at @p point means this shape: on or near a line, anywhere inside of the others.
    [[nodiscard]] bool contains(Point point) const;
    /// Moves the shape by the distance; it stops at the limits of coordinates without changing its size.
    void moveBy(int dx, int dy);

    bool operator==(const Shape&) const = default;
};

/// The shapes, the lowest first, and what else stands in the file.
struct Drawing {
    std::vector<Shape> shapes;
    std::string linesAfter; ///< Comments and empty lines behind the last shape.

    /// The number of the topmost shape at @p point, -1 for none.
    [[nodiscard]] int shapeAt(Point point) const;
    /// The lower right corner of all that is drawn, at least (0, 0).
    [[nodiscard]] Point extent() const;

    bool operator==(const Drawing&) const = default;
};

/// What can be wrong with the text of a drawing, in the order of the sentences for the user, IDS_FAULT_FIRST and on.
enum class Fault {
    NoDrawing,
    UnknownVersion, ///< the version
    UnknownShape,   ///< the word in its place
    FewCoordinates,
    NoNumber, ///< of what, the word in its place, the least and the greatest number
    NoColor,  ///< the word in its place
    NoText,
    OpenText,
    NoBlankAfterText,
    UnknownEscape,
    UnknownAttribute, ///< the shape, the attribute
    ZeroByte,
};

/// What reading gives: a drawing, or what is wrong and where.
struct ReadResult {
    Drawing drawing;
    int line = 0; ///< Of the first fault, counted from 1; 0 when there is none.
    Fault fault{};
    std::vector<std::string> details; ///< What the fault's sentence is filled with.

    [[nodiscard]] bool ok() const {
        return line == 0;
    }
};

/// Reads the text of a drawing. A drawing with a fault is refused as a whole, so that saving cannot lose what was not
/// understood.
[[nodiscard]] ReadResult readDrawing(std::string_view text);

/// The line of a shape in a file, without the comments before it.
[[nodiscard]] std::string writeShape(const Shape& shape);
/// The text of a drawing; reading it gives the same drawing.
[[nodiscard]] std::string writeDrawing(const Drawing& drawing);

/// One change of a drawing: some shapes leave, others come. It holds these shapes and no others, so that a change of a
/// large drawing is small.
struct Change {
    int from = 0;               ///< The number of the first shape that leaves.
    std::vector<Shape> removed; ///< The shapes that leave; they stand side by side.
    int to = 0;                 ///< The number that the first shape has which comes, when the others have left.
    std::vector<Shape> added;
    std::string linesBehind; ///< Comments of a shape that left, put before the lines behind the last shape.

    /// Puts a shape above all others.
    [[nodiscard]] static Change addition(const Drawing& drawing, Shape shape);
    /// Puts a shape in the place of another one.
    [[nodiscard]] static Change replacement(const Drawing& drawing, int number, Shape shape);
    /// Takes a shape away. The comments before it stay, with the shape that follows it.
    [[nodiscard]] static Change deletion(const Drawing& drawing, int number);
    /// Moves a shape to another place in the order of all.
    [[nodiscard]] static Change move(const Drawing& drawing, int from, int to);

    /// Whether making it leaves the drawing as it is.
    [[nodiscard]] bool isNothing() const {
        return from == to && removed == added && linesBehind.empty();
    }
    void make(Drawing& drawing) const;
    void takeBack(Drawing& drawing) const;
};

/// The changes of a drawing that Undo and Redo go through.
class History {
public:
    /// Forgets everything; the drawing counts as saved.
    void clear();
    /// Makes a change and remembers it; changes that were undone are forgotten.
    /// @return the change, valid until the next one is made
    const Change& make(Change change, Drawing& drawing);
    [[nodiscard]] bool canUndo() const {
        return m_made > 0;
    }
    [[nodiscard]] bool canRedo() const {
        return m_made < m_changes.size();
    }
    /// Takes the last change back, or makes the one again that was taken back last. There must be one. The result as
    /// of make().
    const Change& undo(Drawing& drawing);
    const Change& redo(Drawing& drawing);

    /// Notes that the drawing's file has it as it is now.
    void save();
    /// Whether the drawing is as it was when it was saved.
    [[nodiscard]] bool isSaved() const {
        return m_saved == m_made;
    }

private:
    std::vector<Change> m_changes;
    std::size_t m_made = 0;                ///< How many of them are made; the others were taken back.
    std::optional<std::size_t> m_saved{0}; ///< How many were made when the drawing was saved, if they still are known.
};

} // namespace board
