#include "platform/afx/gdi/detail/TextLine.h"

#include "platform/base/Text.h"

#include <QPainter>

#include <algorithm>
#include <array>
#include <numeric>
#include <utility>

namespace tvx::afx {

QString shownText(std::string_view text) {
    QString shown;
    shown.reserve(static_cast<qsizetype>(text.size()));
    constexpr char32_t strayByte = 0xDC00;
    for (std::size_t at = 0; at < text.size();) {
        char32_t character = tvx::text::decode(text, at);
        // Bytes that are no UTF-8 are shown as the Latin-1 characters that they mostly are.
        if (character >= strayByte + 0x80 && character <= strayByte + 0xFF) {
            character -= strayByte;
        }
        shown += QString::fromUcs4(&character, 1);
    }
    return shown;
}

TextLine::TextLine(const RealizedFont& font, std::string_view text) : m_font(font), m_text(shownText(text)) {}

std::size_t TextLine::characterCount() const {
    return static_cast<std::size_t>(m_text.toUcs4().size());
}

void TextLine::setAdvances(std::vector<int> advances) {
    m_advances = std::move(advances);
}

int TextLine::width() const {
    if (!m_advances.empty()) {
        return std::accumulate(m_advances.begin(), m_advances.end(), 0);
    }
    return m_font.metrics.horizontalAdvance(m_text);
}

/// From places along the line to pixels.
QTransform TextLine::onBaseLine(const Canvas& canvas, QPoint left) const {
    const QPointF start = canvas.place(left);
    QTransform transform = QTransform::fromTranslate(start.x(), start.y());
    transform.scale(canvas.ratio, canvas.ratio);
    return transform.rotate(-m_font.angle);
}

void TextLine::fillBackground(Canvas& canvas, QPoint left, const Ink& ink) const {
    const QRect cell(0, -m_font.metrics.ascent(), width(), m_font.metrics.height());
    if (m_font.angle == 0) {
        canvas.fill(canvas.pixels(cell.translated(left)), ink);
        return;
    }
    const QTransform turned = onBaseLine(canvas, left);
    const std::array polygons = {turned.map(QPolygonF(QRectF(cell)))};
    canvas.fill(polygonSpans(polygons, FillRule::Winding, canvas.bounds()), ink);
}

void TextLine::draw(Canvas& canvas, QPoint left, Pixel color) const {
    if (m_text.isEmpty() || canvas.clip.isEmpty()) {
        return;
    }
    QPainter painter(canvas.image);
    painter.setClipRegion(canvas.clip);
    QFont font = m_font.font;
    if (canvas.format == PixelFormat::Monochrome) {
        font.setStyleStrategy(static_cast<QFont::StyleStrategy>(QFont::NoAntialias | QFont::PreferNoShaping));
    }
    painter.setFont(font);
    painter.setPen(QColor::fromRgb(color));
    const QTransform transform = onBaseLine(canvas, left);
    painter.setTransform(transform);
    if (m_advances.empty()) {
        painter.drawText(0, 0, m_text);
    } else {
        int x = 0;
        const QList<uint> characters = m_text.toUcs4();
        for (std::size_t i = 0; i < m_advances.size(); x += m_advances[i++]) {
            const auto character = static_cast<char32_t>(characters[static_cast<qsizetype>(i)]);
            painter.drawText(x, 0, QString::fromUcs4(&character, 1));
        }
    }
    // Slanted characters and those with advances of the caller's may leave their cells.
    const int margin = m_font.metrics.height();
    const QRect cell(0, -m_font.metrics.ascent(), width(), m_font.metrics.height());
    canvas.touch(transform.mapRect(cell.adjusted(-margin, -margin, margin, margin)));
}

TabStops::TabStops(int count, const int* stops, int averageWidth) : m_every(std::max(1, 8 * averageWidth)) {
    if (count == 1 && stops && stops[0] != 0) {
        m_every = std::abs(stops[0]);
    } else if (count > 1 && stops) {
        m_stops.assign(stops, stops + count);
    }
}

int TabStops::after(int x) const {
    const auto stop = std::ranges::find_if(m_stops, [x](int stop) { return std::abs(stop) > x; });
    if (stop != m_stops.end()) {
        return std::abs(*stop);
    }
    const int whole = x >= 0 ? x / m_every : (x - m_every + 1) / m_every;
    return (whole + 1) * m_every;
}

} // namespace tvx::afx
