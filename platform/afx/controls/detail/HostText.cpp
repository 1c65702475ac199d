#include "platform/afx/controls/detail/HostText.h"

#include <algorithm>
#include <numeric>

namespace tvx::afx {

namespace {

/// Bytes of the character that begins at `at`, and the units it takes.
struct Step {
    int bytes = 1;
    int units = 1;
};

/// A byte that belongs to no character (see toQt).
bool isStrayByte(QChar c) {
    return c.unicode() >= 0xDC80 && c.unicode() <= 0xDCFF;
}

Step stepAt(const QString& text, int at) {
    const QChar c = text.at(at);
    if (c == QLatin1Char('\n')) {
        return {ParagraphBytes::lineEnd, 1};
    }
    if (c.isHighSurrogate() && at + 1 < text.size() && text.at(at + 1).isLowSurrogate()) {
        return {4, 2};
    }
    return {c.unicode() < 0x80 || isStrayByte(c) ? 1 : c.unicode() < 0x800 ? 2 : 3, 1};
}

} // namespace

int hostBytes(const QString& text, int units) {
    int bytes = 0;
    for (int at = 0; at < units && at < text.size();) {
        const Step step = stepAt(text, at);
        bytes += step.bytes;
        at += step.units;
    }
    return bytes;
}

int hostBytes(const QString& text) {
    return hostBytes(text, static_cast<int>(text.size()));
}

int toolkitUnits(const QString& text, int bytes) {
    int at = 0;
    while (at < text.size()) {
        const Step step = stepAt(text, at);
        if (step.bytes > bytes) {
            break;
        }
        bytes -= step.bytes;
        at += step.units;
    }
    return at;
}

QString plainLines(QString text) {
    text.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return text;
}

QString firstLine(const QString& text) {
    const QString plain = plainLines(text);
    return plain.left(plain.indexOf(QLatin1Char('\n'))); // all of it where there is none
}

void ParagraphBytes::replace(int first, int removed, const std::vector<int>& sizes) {
    const auto at = m_sizes.begin() + first;
    m_total -= std::accumulate(at, at + removed, 0);
    m_total += std::accumulate(sizes.begin(), sizes.end(), 0);
    const int both = std::min(removed, static_cast<int>(sizes.size()));
    std::copy_n(sizes.begin(), both, at);
    if (removed > both) {
        m_sizes.erase(at + both, at + removed);
    } else {
        m_sizes.insert(at + both, sizes.begin() + both, sizes.end());
    }
}

int ParagraphBytes::before(int paragraph) const {
    const auto at = m_sizes.begin() + paragraph;
    // From the nearer end: logs are changed at their ends.
    return paragraph <= count() / 2 ? std::accumulate(m_sizes.begin(), at, 0)
                                    : m_total - std::accumulate(at, m_sizes.end(), 0);
}

ParagraphBytes::Place ParagraphBytes::find(int bytes) const {
    bytes = std::clamp(bytes, 0, std::max(total(), 0));
    int paragraph = 0;
    int start = 0;
    if (bytes <= m_total / 2) {
        while (paragraph + 1 < count() && start + m_sizes[static_cast<std::size_t>(paragraph)] <= bytes) {
            start += m_sizes[static_cast<std::size_t>(paragraph++)];
        }
        return {paragraph, bytes - start};
    }
    start = m_total;
    paragraph = count();
    while (start > bytes) {
        start -= m_sizes[static_cast<std::size_t>(--paragraph)];
    }
    return {paragraph, bytes - start};
}

} // namespace tvx::afx
