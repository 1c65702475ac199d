#include "samples/board/Drawing.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <malloc.h>
#include <random>

using namespace board;

namespace {

std::string contents(const std::filesystem::path& file) {
    std::ifstream in(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

TEST(Drawing, ShippedOnesAreReadAndWrittenWithoutLoss) {
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator(BOARD_DRAWINGS)) {
        SCOPED_TRACE(entry.path().string());
        const std::string text = contents(entry.path());
        const ReadResult first = readDrawing(text);
        ASSERT_TRUE(first.ok()) << first.line << ": fault " << static_cast<int>(first.fault);
        EXPECT_FALSE(first.drawing.shapes.empty());
        const std::string written = writeDrawing(first.drawing);
        const ReadResult second = readDrawing(written);
        ASSERT_TRUE(second.ok());
        EXPECT_EQ(second.drawing, first.drawing);
        EXPECT_EQ(writeDrawing(second.drawing), written);
        ++count;
    }
    EXPECT_GE(count, 2);
}

TEST(Drawing, KeepsCommentsWithTheirShapes) {
    const std::string text = "board 1\n# bearing\n\nline 1 2 3 4 color=#c00000\n# the end\n";
    const ReadResult read = readDrawing(text);
    ASSERT_TRUE(read.ok()) << read.line;
    const std::string written = writeDrawing(read.drawing);
    EXPECT_NE(written.find("# bearing\n\nline 1 2 3 4"), std::string::npos) << written;
    EXPECT_NE(written.find("# the end\n"), std::string::npos) << written;
}

TEST(Drawing, AcceptsAMarkAndForeignLineEnds) {
    const ReadResult read = readDrawing("\xEF\xBB\xBF"
                                        "board 1\r\nellipse 0 0 9 9 fill=#ffffff\r\n");
    ASSERT_TRUE(read.ok()) << read.line;
    EXPECT_EQ(read.drawing.shapes.at(0).fill, 0xFFFFFFU);
}

TEST(Drawing, TextsOfAnyBytesSurvive) {
    std::mt19937 random(7);
    for (int round = 0; round < 300; ++round) {
        Shape shape;
        shape.kind = ShapeKind::Text;
        shape.to = {100, 20};
        for (int i = 0; i < round % 40; ++i) {
            shape.text += static_cast<char>(1 + random() % 255);
        }
        Drawing drawing;
        drawing.shapes.push_back(shape);
        const ReadResult read = readDrawing(writeDrawing(drawing));
        ASSERT_TRUE(read.ok()) << read.line;
        EXPECT_EQ(read.drawing, drawing);
    }
}

TEST(Drawing, FaultsAreNamedWithTheirLine) {
    struct Case {
        const char* text;
        int line;
        Fault fault;
        std::vector<std::string> details{};
    };
    for (const Case& c : {
             Case{"", 1, Fault::NoDrawing},
             Case{"board 2\n", 1, Fault::UnknownVersion, {"2"}},
             Case{"board 1\ncircle 1 2 3\n", 2, Fault::UnknownShape, {"circle"}},
             Case{"board 1\n\nline 1 2 3\n", 3, Fault::FewCoordinates},
             Case{"board 1\nline 1 2 3 x\n", 2, Fault::NoNumber, {"x, y", "x", "-100000", "100000"}},
             Case{"board 1\nline 1 2 3 4 color=#12345\n", 2, Fault::NoColor, {"#12345"}},
             Case{"board 1\nline 1 2 3 4 fill=#000000\n", 2, Fault::UnknownAttribute, {"line", "fill"}},
             Case{"board 1\ntext 0 0 9 9 size=8\n", 2, Fault::NoText},
             Case{"board 1\ntext 0 0 9 9 \"open\n", 2, Fault::OpenText},
             Case{"board 1\ntext 0 0 9 9 \"a\"b\n", 2, Fault::NoBlankAfterText},
             Case{"board 1\ntext 0 0 9 9 \"\\t\"\n", 2, Fault::UnknownEscape},
             Case{"board 1\nrectangle 0 0 999999999999 1\n",
                  2,
                  Fault::NoNumber,
                  {"x, y", "999999999999", "-100000", "100000"}},
             Case{"board 1\nrectangle 0 0 1 1 width=0\n", 2, Fault::NoNumber, {"width", "0", "1", "20"}},
         }) {
        SCOPED_TRACE(c.text);
        const ReadResult read = readDrawing(c.text);
        EXPECT_EQ(read.line, c.line);
        EXPECT_EQ(read.fault, c.fault);
        EXPECT_EQ(read.details, c.details);
    }
}

TEST(Drawing, NoDamageCrashesTheReader) {
    std::mt19937 random(3);
    const std::string good = contents(std::filesystem::path(BOARD_DRAWINGS) / "plan.brd");
    for (int round = 0; round < 2000; ++round) {
        std::string text = good.substr(0, random() % good.size());
        if (!text.empty()) {
            text[random() % text.size()] = static_cast<char>(random());
        }
        const ReadResult read = readDrawing(text);
        EXPECT_TRUE(read.ok() || read.drawing.shapes.empty());
    }
}

TEST(Drawing, HitsTheTopmostShapeAndMovesWithinItsLimits) {
    const ReadResult read = readDrawing("board 1\nrectangle 0 0 50 50\nellipse 10 10 40 40\nline 60 0 60 90\n");
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.drawing.shapeAt({25, 25}), 1);
    EXPECT_EQ(read.drawing.shapeAt({2, 2}), 0);
    EXPECT_EQ(read.drawing.shapeAt({61, 45}), 2);
    EXPECT_EQ(read.drawing.shapeAt({200, 200}), -1);
    Shape shape = read.drawing.shapes[0];
    shape.moveBy(10 * maxCoordinate, -10 * maxCoordinate);
    EXPECT_EQ(shape.to.x, maxCoordinate);
    EXPECT_EQ(shape.to.x - shape.from.x, 50);
    EXPECT_EQ(shape.to.y - shape.from.y, 50);
}

Drawing drawingOf(int count) {
    Drawing drawing;
    for (int i = 0; i < count; ++i) {
        drawing.shapes.emplace_back().linesBefore = "# " + std::to_string(i);
    }
    drawing.linesAfter = "# end";
    return drawing;
}

Shape shapeOf(const std::string& text) {
    Shape shape;
    shape.text = text;
    return shape;
}

/// A change of any kind, of any shape.
Change anyChange(const Drawing& drawing, std::mt19937& random) {
    const int count = static_cast<int>(drawing.shapes.size());
    const int number = count > 0 ? static_cast<int>(random() % count) : 0;
    switch (count > 0 ? random() % 5 : 0) {
    case 0:
        return Change::addition(drawing, shapeOf(std::to_string(random())));
    case 1:
        return Change::deletion(drawing, number);
    case 2:
        return Change::move(drawing, number, count - 1);
    case 3:
        return Change::move(drawing, number, 0);
    default:
        return Change::replacement(drawing, number, shapeOf(std::to_string(random())));
    }
}

TEST(History, GoesThroughAllChangesBackAndForth) {
    std::mt19937 random(3);
    History history;
    Drawing drawing = drawingOf(6);
    std::vector<Drawing> states{drawing};
    for (int i = 0; i < 400; ++i) {
        history.make(anyChange(drawing, random), drawing);
        states.push_back(drawing);
    }
    for (std::size_t at = states.size() - 1; at-- > 0;) {
        history.undo(drawing);
        ASSERT_EQ(drawing, states[at]) << at;
    }
    EXPECT_FALSE(history.canUndo());
    for (std::size_t at = 1; at < states.size(); ++at) {
        history.redo(drawing);
        ASSERT_EQ(drawing, states[at]) << at;
    }
    history.undo(drawing);
    history.make(anyChange(drawing, random), drawing);
    EXPECT_FALSE(history.canRedo()) << "something new was done";
}

TEST(Change, DeletionKeepsCommentsAndMovesKeepTheOthersInOrder) {
    const auto order = [](const Drawing& drawing) {
        std::string lines;
        for (const Shape& shape : drawing.shapes) {
            lines += shape.linesBefore + '|';
        }
        return lines + drawing.linesAfter;
    };
    Drawing drawing = drawingOf(4);
    Change::move(drawing, 1, 3).make(drawing);
    EXPECT_EQ(order(drawing), "# 0|# 2|# 3|# 1|# end");
    Change::deletion(drawing, 1).make(drawing);
    EXPECT_EQ(order(drawing), "# 0|# 2# 3|# 1|# end");
    Change::deletion(drawing, 2).make(drawing);
    EXPECT_EQ(order(drawing), "# 0|# 2# 3|# 1# end");
    EXPECT_TRUE(Change::replacement(drawing, 0, drawing.shapes[0]).isNothing());
}

TEST(History, KnowsWhenTheDrawingIsAsItWasSaved) {
    History history;
    Drawing drawing = drawingOf(2);
    EXPECT_TRUE(history.isSaved());
    history.make(Change::deletion(drawing, 0), drawing);
    EXPECT_FALSE(history.isSaved());
    history.save();
    history.undo(drawing);
    EXPECT_FALSE(history.isSaved());
    history.redo(drawing);
    EXPECT_TRUE(history.isSaved());
    history.undo(drawing);
    history.make(Change::deletion(drawing, 0), drawing);
    EXPECT_FALSE(history.isSaved()) << "as many changes, but others";
    history.undo(drawing);
    EXPECT_FALSE(history.isSaved());
}

TEST(History, HoldsWhatHasChangedAndNotTheWholeDrawing) {
    const auto used = [] {
        const struct mallinfo2 heap = mallinfo2();
        return heap.uordblks + heap.hblkhd;
    };
    Drawing drawing = drawingOf(20000);
    History history;
    const std::size_t before = used();
    constexpr int nudges = 100;
    for (int i = 0; i < nudges; ++i) {
        Shape shape = drawing.shapes[10000];
        shape.moveBy(1, 0);
        history.make(Change::replacement(drawing, 10000, shape), drawing);
    }
    EXPECT_LT(used() - before, nudges * 2000U);
}

} // namespace
