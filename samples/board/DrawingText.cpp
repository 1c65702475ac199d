#include "Drawing.h"

#include <array>
#include <charconv>
#include <optional>
#include <utility>

// The text format of drawings: docs/drawing-format.md.

namespace board {

namespace {

constexpr std::string_view header = "board 1";
constexpr std::string_view mark = "\xEF\xBB\xBF"; // some editors begin a UTF-8 text with it

struct KindName {
    ShapeKind kind;
    std::string_view name;
};
constexpr std::array<KindName, 4> kindNames{{{ShapeKind::Rectangle, "rectangle"},
                                             {ShapeKind::Ellipse, "ellipse"},
                                             {ShapeKind::Line, "line"},
                                             {ShapeKind::Text, "text"}}};

std::string_view nameOf(ShapeKind kind) {
    for (const KindName& entry : kindNames) {
        if (entry.kind == kind) {
            return entry.name;
        }
    }
    return {};
}

bool isBlank(char c) {
    return c == ' ' || c == '\t';
}

/// A fault, on its way out of the reader.
struct Damage {
    Fault fault;
    std::vector<std::string> details{};
};

/// Reads one line of the file, word by word.
class LineReader {
public:
    explicit LineReader(std::string_view line) : m_rest(line) {
        skipBlanks();
    }

    [[nodiscard]] bool atEnd() const {
        return m_rest.empty();
    }
    [[nodiscard]] bool atQuote() const {
        return !m_rest.empty() && m_rest.front() == '"';
    }

    std::string_view word() {
        std::size_t length = 0;
        while (length < m_rest.size() && !isBlank(m_rest[length])) {
            ++length;
        }
        return take(length);
    }

    std::string quotedText() {
        std::string text;
        std::size_t at = 1;
        for (; at < m_rest.size() && m_rest[at] != '"'; ++at) {
            text += m_rest[at] == '\\' ? escaped(++at) : m_rest[at];
        }
        if (at >= m_rest.size()) {
            throw Damage{Fault::OpenText};
        }
        if (at + 1 < m_rest.size() && !isBlank(m_rest[at + 1])) {
            throw Damage{Fault::NoBlankAfterText};
        }
        take(at + 1);
        return text;
    }

private:
    [[nodiscard]] char escaped(std::size_t at) const {
        const char c = at < m_rest.size() ? m_rest[at] : '\0';
        switch (c) {
        case 'n':
            return '\n';
        case 'r':
            return '\r';
        case '"':
        case '\\':
            return c;
        default:
            throw Damage{Fault::UnknownEscape};
        }
    }

    std::string_view take(std::size_t length) {
        const std::string_view taken = m_rest.substr(0, length);
        m_rest.remove_prefix(length);
        skipBlanks();
        return taken;
    }

    void skipBlanks() {
        while (!m_rest.empty() && isBlank(m_rest.front())) {
            m_rest.remove_prefix(1);
        }
    }

    std::string_view m_rest;
};

template <class Number>
std::optional<Number> parse(std::string_view text, int base) {
    Number value{};
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, base);
    const bool whole = error == std::errc() && end == text.data() + text.size();
    return whole ? std::optional(value) : std::nullopt;
}

int parseNumber(std::string_view what, std::string_view text, int least, int most) {
    const auto value = parse<int>(text, 10);
    if (!value || *value < least || *value > most) {
        throw Damage{Fault::NoNumber,
                     {std::string(what), std::string(text), std::to_string(least), std::to_string(most)}};
    }
    return *value;
}

Color parseColor(std::string_view text) {
    const bool shaped = text.size() == 7 && text.front() == '#';
    const auto value = shaped ? parse<Color>(text.substr(1), 16) : std::nullopt;
    if (!value) {
        throw Damage{Fault::NoColor, {std::string(text)}};
    }
    return *value;
}

int parseCoordinate(LineReader& line) {
    if (line.atEnd()) {
        throw Damage{Fault::FewCoordinates};
    }
    return parseNumber("x, y", line.word(), -maxCoordinate, maxCoordinate);
}

void parseAttribute(Shape& shape, std::string_view word) {
    const std::size_t sign = word.find('=');
    const std::string_view name = word.substr(0, sign);
    const std::string_view value = sign == std::string_view::npos ? std::string_view() : word.substr(sign + 1);
    if (name == "color") {
        shape.color = parseColor(value);
    } else if (name == "fill" && shape.kind != ShapeKind::Line) {
        shape.fill = parseColor(value);
    } else if (name == "width" && shape.kind != ShapeKind::Text) {
        shape.width = parseNumber("width", value, 1, 20);
    } else if (name == "size" && shape.kind == ShapeKind::Text) {
        shape.size = parseNumber("size", value, minTextSize, maxTextSize);
    } else {
        throw Damage{Fault::UnknownAttribute, {std::string(nameOf(shape.kind)), std::string(name)}};
    }
}

ShapeKind parseKind(std::string_view word) {
    for (const KindName& entry : kindNames) {
        if (entry.name == word) {
            return entry.kind;
        }
    }
    throw Damage{Fault::UnknownShape, {std::string(word)}};
}

Shape parseShape(std::string_view text) {
    LineReader line(text);
    Shape shape;
    shape.kind = parseKind(line.word());
    for (int* coordinate : {&shape.from.x, &shape.from.y, &shape.to.x, &shape.to.y}) {
        *coordinate = parseCoordinate(line);
    }
    if (shape.kind == ShapeKind::Text) {
        if (!line.atQuote()) {
            throw Damage{Fault::NoText};
        }
        shape.text = line.quotedText();
    }
    while (!line.atEnd()) {
        parseAttribute(shape, line.word());
    }
    return shape;
}

void checkHeader(std::string_view line) {
    LineReader words(line);
    if (words.atEnd() || words.word() != "board") {
        throw Damage{Fault::NoDrawing};
    }
    const std::string_view version = words.atEnd() ? std::string_view() : words.word();
    if (version != "1" || !words.atEnd()) {
        throw Damage{Fault::UnknownVersion, {std::string(version)}};
    }
}

bool isShape(std::string_view line) {
    const std::size_t first = line.find_first_not_of(" \t");
    return first != std::string_view::npos && line[first] != '#';
}

/// Takes the next line off a text, without its end: a line feed with all the carriage returns before it, so that what
/// is written reads as the same lines again. A last line may have none.
std::string_view takeLine(std::string_view& text) {
    const std::size_t end = text.find('\n');
    std::string_view line = text.substr(0, end);
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    while (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    return line;
}

void readLine(Drawing& drawing, std::string_view line) {
    if (line.find('\0') != std::string_view::npos) {
        throw Damage{Fault::ZeroByte};
    }
    if (isShape(line)) {
        Shape shape = parseShape(line);
        shape.linesBefore = std::exchange(drawing.linesAfter, {});
        drawing.shapes.push_back(std::move(shape));
    } else {
        drawing.linesAfter.append(line).append("\n");
    }
}

void appendColor(std::string& text, std::string_view name, Color color) {
    constexpr std::string_view digits = "0123456789abcdef";
    text.append(" ").append(name).append("=#");
    for (int shift = 20; shift >= 0; shift -= 4) {
        text += digits[(color >> shift) & 0xF];
    }
}

void appendQuoted(std::string& text, std::string_view plain) {
    text += " \"";
    for (const char c : plain) {
        switch (c) {
        case '\n':
            text += "\\n";
            break;
        case '\r':
            text += "\\r";
            break;
        case '"':
        case '\\':
            text += '\\';
            [[fallthrough]];
        default:
            text += c;
        }
    }
    text += '"';
}

void appendShape(std::string& text, const Shape& shape) {
    text.append(nameOf(shape.kind));
    for (const int coordinate : {shape.from.x, shape.from.y, shape.to.x, shape.to.y}) {
        text.append(" ").append(std::to_string(coordinate));
    }
    if (shape.kind == ShapeKind::Text) {
        appendQuoted(text, shape.text);
    }
    appendColor(text, "color", shape.color);
    if (shape.fill != noColor) {
        appendColor(text, "fill", shape.fill);
    }
    if (shape.kind == ShapeKind::Text) {
        text.append(" size=").append(std::to_string(shape.size));
    } else {
        text.append(" width=").append(std::to_string(shape.width));
    }
}

} // namespace

ReadResult readDrawing(std::string_view text) {
    if (text.starts_with(mark)) {
        text.remove_prefix(mark.size());
    }
    ReadResult result;
    int number = 1;
    try {
        checkHeader(takeLine(text));
        while (!text.empty()) {
            ++number;
            readLine(result.drawing, takeLine(text));
        }
    } catch (Damage& damage) {
        result = {{}, number, damage.fault, std::move(damage.details)};
    }
    return result;
}

std::string writeShape(const Shape& shape) {
    std::string text;
    appendShape(text, shape);
    return text;
}

std::string writeDrawing(const Drawing& drawing) {
    std::string text(header);
    text += '\n';
    for (const Shape& shape : drawing.shapes) {
        text += shape.linesBefore;
        appendShape(text, shape);
        text += '\n';
    }
    return text + drawing.linesAfter;
}

} // namespace board
