#include "platform/afx/gdi/detail/Fonts.h"

#include "platform/afx/gdi/detail/Mapping.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"

#include <QFontDatabase>
#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <cstring>
#include <functional>
#include <map>
#include <string>
#include <tuple>

namespace tvx::afx {

namespace {

/// Families in order of preference; the first one that is installed is taken.
using Choices = std::array<const char*, 3>;

/// For labels and dialogs. At 8 points the condensed face has the average width (6) and height (13) that dialog
/// templates were laid out for; the normal one is a fifth wider, so that texts would be cut.
constexpr Choices interface = {"DejaVu Sans Condensed", "DejaVu Sans", "Noto Sans"};
/// For documents: faces with the same advances as the ones named, then any of the kind.
constexpr Choices sans = {"Liberation Sans", "Nimbus Sans", "DejaVu Sans"};
constexpr Choices serif = {"Liberation Serif", "Nimbus Roman", "DejaVu Serif"};
/// Terminal faces had drawn pixels and no outlines; of the fixed ones this one is the most legible at small sizes.
constexpr Choices fixedPitch = {"DejaVu Sans Mono", "Liberation Mono", "Nimbus Mono PS"};
constexpr Choices typewriter = {"Liberation Mono", "DejaVu Sans Mono", "Nimbus Mono PS"};

struct Substitute {
    std::string_view face;
    const Choices& choices;
};

const Substitute substitutes[] = {
    {"MS Sans Serif", interface},
    {"MS Shell Dlg", interface},
    {"MS Shell Dlg 2", interface},
    {"Microsoft Sans Serif", interface},
    {"System", interface},
    {"Tahoma", interface},
    {"Helv", interface},
    {"Arial", sans},
    {"Helvetica", sans},
    {"Times New Roman", serif},
    {"Times", serif},
    {"Tms Rmn", serif},
    {"MS Serif", serif},
    {"Courier", fixedPitch},
    {"FixedSys", fixedPitch},
    {"Terminal", fixedPitch},
    {"Courier New", typewriter},
};

/// Whether there is a family of a name. The toolkit asks the desktop's list of fonts each time, which takes longer than
/// to make the control that the font is for; so its answers are kept, as the fonts themselves are.
bool isInstalled(std::string_view faceName) {
    static std::map<std::string, bool, std::less<>> known;
    const auto answer = known.find(faceName);
    if (answer != known.end()) {
        return answer->second;
    }
    const bool isThere =
        !faceName.empty() &&
        QFontDatabase::hasFamily(QString::fromUtf8(faceName.data(), static_cast<qsizetype>(faceName.size())));
    known.emplace(faceName, isThere);
    return isThere;
}

QString firstInstalled(const Choices& choices) {
    for (const char* family : choices) {
        if (isInstalled(family)) {
            return QString::fromLatin1(family);
        }
    }
    return QGuiApplication::font().family();
}

const Choices& choicesByFamily(BYTE pitchAndFamily) {
    if ((pitchAndFamily & 0xF0) == FF_MODERN || (pitchAndFamily & 3) == FIXED_PITCH) {
        return fixedPitch;
    }
    return (pitchAndFamily & 0xF0) == FF_ROMAN ? serif : interface;
}

std::string_view faceName(const LOGFONTA& description) {
    return {description.lfFaceName, strnlen(description.lfFaceName, LF_FACESIZE)};
}

} // namespace

namespace {

const Choices* substitutesFor(std::string_view faceName) {
    const auto* found = std::ranges::find_if(
        substitutes, [&](const Substitute& substitute) { return text::equalNoCase(substitute.face, faceName); });
    return found != std::end(substitutes) ? &found->choices : nullptr;
}

} // namespace

QString familyFor(std::string_view faceName, BYTE pitchAndFamily) {
    if (isInstalled(faceName)) {
        return QString::fromUtf8(faceName.data(), static_cast<qsizetype>(faceName.size()));
    }
    const Choices* found = substitutesFor(faceName);
    return firstInstalled(found ? *found : choicesByFamily(pitchAndFamily));
}

bool isInterfaceFace(std::string_view faceName) {
    return !isInstalled(faceName) && substitutesFor(faceName) == &interface;
}

namespace {

/// Cell height in pixels that a description without a height gets.
constexpr int defaultCellHeight = 16;
constexpr int largestHeight = 4096;

/// The largest em size whose characters fit cells of `cellHeight`.
void fitCell(QFont& font, int cellHeight) {
    int size = cellHeight;
    font.setPixelSize(size);
    while (size > 1 && QFontMetrics(font).height() > cellHeight) {
        font.setPixelSize(--size);
    }
}

void setHeight(QFont& font, int height) {
    height = std::clamp(height, -largestHeight, largestHeight);
    if (height < 0) {
        font.setPixelSize(-height);
    } else {
        fitCell(font, height == 0 ? defaultCellHeight : height);
    }
}

QFont::Weight weightOf(LONG weight) {
    if (weight <= 0) {
        return QFont::Normal;
    }
    // The two scales have the same numbers.
    return static_cast<QFont::Weight>(std::clamp<LONG>(weight, QFont::Thin, QFont::Black));
}

/// Stretches the face until its average character has the width asked for.
void setWidth(QFont& font, int width) {
    const int natural = QFontMetrics(font).averageCharWidth();
    if (width != 0 && natural > 0) {
        font.setStretch(std::clamp(scaled(std::abs(width), 100, natural), 1, 4000));
    }
}

QFont::StyleStrategy styleStrategy(BYTE quality) {
    // Subpixel rendering follows the desktop's settings; pixels are to be the same on every machine. Scripts that can
    // do without shaping do without: a ligature is drawn otherwise than its characters one by one.
    const int edges = quality == NONANTIALIASED_QUALITY ? QFont::NoAntialias : QFont::NoSubpixelAntialias;
    return static_cast<QFont::StyleStrategy>(edges | QFont::PreferNoShaping);
}

QFont makeFont(const LOGFONTA& description) {
    QFont font(familyFor(faceName(description), description.lfPitchAndFamily));
    font.setStyleStrategy(styleStrategy(description.lfQuality));
    font.setHintingPreference(QFont::PreferFullHinting);
    // Hosts measure a text in pieces and add up: that is right only while characters do not move towards each other.
    font.setKerning(false);
    font.setWeight(weightOf(description.lfWeight));
    font.setItalic(description.lfItalic != 0);
    font.setUnderline(description.lfUnderline != 0);
    font.setStrikeOut(description.lfStrikeOut != 0);
    setHeight(font, description.lfHeight);
    setWidth(font, description.lfWidth);
    return font;
}

using FontKey = std::tuple<int, int, int, int, bool, bool, bool, BYTE, BYTE, std::string>;

FontKey keyOf(const LOGFONTA& font) {
    return {font.lfHeight,         font.lfWidth,
            font.lfEscapement,     font.lfWeight,
            font.lfItalic != 0,    font.lfUnderline != 0,
            font.lfStrikeOut != 0, font.lfQuality,
            font.lfPitchAndFamily, std::string(faceName(font))};
}

} // namespace

std::shared_ptr<const RealizedFont> realizeFont(const LOGFONTA& description) {
    // Fonts must not outlive the connection to the desktop; a host has few different ones.
    static std::map<FontKey, std::shared_ptr<const RealizedFont>> fonts;
    static LOGFONTA lastAsked{}; // measuring line after line asks for one font again and again
    static std::shared_ptr<const RealizedFont> last;
    if (last && std::memcmp(&lastAsked, &description, sizeof(description)) == 0) {
        return last;
    }
    if (!ensureGui()) {
        return nullptr;
    }
    [[maybe_unused]] static const bool cleared = (qAddPostRoutine([] {
                                                      fonts.clear();
                                                      last.reset();
                                                  }),
                                                  true);
    constexpr std::size_t mostFonts = 256;
    if (fonts.size() > mostFonts) {
        fonts.clear();
    }
    auto& kept = fonts[keyOf(description)];
    if (!kept) {
        auto font = std::make_shared<RealizedFont>(makeFont(description));
        font->angle = (description.lfEscapement % 3600) / 10.0;
        kept = std::move(font);
    }
    lastAsked = description;
    last = kept;
    return kept;
}

QFont controlFont(const LOGFONTA& description) {
    return makeFont(description);
}

LOGFONTA pointFont(int tenthsOfPoint, std::string_view faceName) {
    LOGFONTA font{};
    font.lfHeight = -scaled(tenthsOfPoint, pixelsPerInch, 720);
    font.lfCharSet = DEFAULT_CHARSET;
    text::copyCut(faceName, font.lfFaceName, LF_FACESIZE);
    return font;
}

LOGFONT describeFont(const QFont& font, int height) {
    LOGFONT description{};
    description.lfHeight = -height;
    description.lfWeight = font.weight();
    description.lfItalic = font.italic() ? 1 : 0;
    description.lfUnderline = font.underline() ? 1 : 0;
    description.lfStrikeOut = font.strikeOut() ? 1 : 0;
    description.lfCharSet = DEFAULT_CHARSET;
    text::copyCut(font.family().toStdString(), description.lfFaceName, LF_FACESIZE);
    return description;
}

QSize dialogBaseUnits(const QFont& font) {
    static const QString letters = QStringLiteral("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz");
    const QFontMetrics metrics(font);
    // The average of 52 letters, rounded: the rule that dialog templates were laid out by.
    return {(metrics.horizontalAdvance(letters) / 26 + 1) / 2, metrics.height()};
}

} // namespace tvx::afx
