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
    constexpr char32_t kStrayByte = 0xDC00;
    for (std::size_t at = 0; at < text.size();) {
        char32_t character = tvx::text::decode(text, at);
        if (character >= kStrayByte + 0x80 && character <= kStrayByte + 0xFF) {
            character -= kStrayByte;
        }
        shown += QString::fromUcs4(&character, 1);
    }
    return shown;
}

TextLine::TextLine(const RealizedFont& font, std::string_view text) : font_(font), text_(shownText(text)) {}

std::size_t TextLine::characterCount() const {
    return static_cast<std::size_t>(text_.toUcs4().size());
}

void TextLine::setAdvances(std::vector<int> advances) {
    advances_ = std::move(advances);
}

int TextLine::width() const {
    if (!advances_.empty()) {
        return std::accumulate(advances_.begin(), advances_.end(), 0);
    }
    return font_.metrics.horizontalAdvance(text_);
}

void TextLine::fillBackground(Canvas& canvas, QPoint left, const Ink& ink) const {
    const QRect cell(0, -font_.metrics.ascent(), width(), font_.metrics.height());
    if (font_.angle == 0) {
        canvas.fill(cell.translated(left), ink);
        return;
    }
    QTransform turned = QTransform::fromTranslate(left.x(), left.y());
    turned.rotate(-font_.angle);
    const std::array polygons = {turned.map(QPolygonF(QRectF(cell)))};
    canvas.fill(polygonSpans(polygons, FillRule::winding, canvas.bounds()), ink);
}

void TextLine::draw(Canvas& canvas, QPoint left, Pixel color) const {
    if (text_.isEmpty() || canvas.clip.isEmpty()) {
        return;
    }
    QPainter painter(canvas.image);
    painter.setClipRegion(canvas.clip.translated(canvas.origin));
    QFont font = font_.font;
    if (canvas.format == PixelFormat::monochrome) {
        font.setStyleStrategy(static_cast<QFont::StyleStrategy>(QFont::NoAntialias | QFont::PreferNoShaping));
    }
    painter.setFont(font);
    painter.setPen(QColor::fromRgb(color));
    painter.translate(left + canvas.origin);
    painter.rotate(-font_.angle);
    if (advances_.empty()) {
        painter.drawText(0, 0, text_);
    } else {
        int x = 0;
        const QList<uint> characters = text_.toUcs4();
        for (std::size_t i = 0; i < advances_.size(); x += advances_[i++]) {
            const auto character = static_cast<char32_t>(characters[static_cast<qsizetype>(i)]);
            painter.drawText(x, 0, QString::fromUcs4(&character, 1));
        }
    }
    // Slanted characters and those with advances of the caller's may leave their cells.
    const int margin = font_.metrics.height();
    const QRect cell(0, -font_.metrics.ascent(), width(), font_.metrics.height());
    canvas.touch(
        QTransform().rotate(-font_.angle).mapRect(cell).adjusted(-margin, -margin, margin, margin).translated(left));
}

TabStops::TabStops(int count, const int* stops, int averageWidth) : every_(std::max(1, 8 * averageWidth)) {
    if (count == 1 && stops && stops[0] != 0) {
        every_ = std::abs(stops[0]);
    } else if (count > 1 && stops) {
        stops_.assign(stops, stops + count);
    }
}

int TabStops::after(int x) const {
    const auto stop = std::ranges::find_if(stops_, [x](int stop) { return std::abs(stop) > x; });
    if (stop != stops_.end()) {
        return std::abs(*stop);
    }
    const int whole = x >= 0 ? x / every_ : (x - every_ + 1) / every_;
    return (whole + 1) * every_;
}

} // namespace tvx::afx
