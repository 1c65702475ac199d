#include "FileText.h"

#include <algorithm>
#include <array>
#include <map>

namespace {

constexpr std::string_view utf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view editedEnd = "\r\n";

/// The ends of lines that an edit control knows, longer ones first: those of the desktops, and the paragraph separator.
constexpr std::array<std::string_view, 4> ends = {"\r\n", "\n", "\r", "\xE2\x80\xA9"};

/// The end of a line that stands at a place of a text; empty when none does.
std::string_view endAt(std::string_view text, std::size_t at) {
    const auto* end =
        std::find_if(ends.begin(), ends.end(), [&](std::string_view e) { return text.substr(at, e.size()) == e; });
    return end != ends.end() ? *end : std::string_view();
}

std::vector<std::string_view> linesOf(std::string_view edited) {
    std::vector<std::string_view> lines;
    for (std::size_t at; (at = edited.find(editedEnd)) != std::string_view::npos;) {
        lines.push_back(edited.substr(0, at));
        edited.remove_prefix(at + editedEnd.size());
    }
    lines.push_back(edited);
    return lines;
}

} // namespace

FileText::FileText(std::string_view bytes) {
    if (bytes.starts_with(utf8Mark)) {
        m_mark = utf8Mark;
        bytes.remove_prefix(utf8Mark.size());
    }
    m_lines.clear();
    std::size_t begin = 0;
    for (std::size_t at = 0; at < bytes.size();) {
        const std::string_view end = endAt(bytes, at);
        if (end.empty()) {
            ++at;
            continue;
        }
        m_lines.push_back({std::string(bytes.substr(begin, at - begin)), std::string(end)});
        at += end.size();
        begin = at;
    }
    m_lines.push_back({std::string(bytes.substr(begin)), {}});
}

std::string FileText::edited() const {
    std::string text;
    for (const Line& line : m_lines) {
        text += line.text;
        text += line.end.empty() ? std::string_view() : editedEnd;
    }
    return text;
}

std::string FileText::usualEnd() const {
    std::map<std::string_view, std::size_t> counts;
    for (const Line& line : m_lines) {
        counts[line.end] += line.end.empty() ? 0 : 1;
    }
    const auto most = std::max_element(counts.begin(), counts.end(),
                                       [](const auto& a, const auto& b) { return a.second < b.second; });
    return most->second > 0 ? std::string(most->first) : "\n";
}

std::string FileText::bytesOf(std::string_view edited) const {
    const std::vector<std::string_view> lines = linesOf(edited);
    const auto same = [](const Line& old, std::string_view now) { return old.text == now; };
    const auto [firstOld, firstNew] = std::mismatch(m_lines.begin(), m_lines.end(), lines.begin(), lines.end(), same);
    const auto before = firstNew - lines.begin();
    const auto lastOld =
        std::mismatch(m_lines.rbegin(), m_lines.rend() - before, lines.rbegin(), lines.rend() - before, same).first;
    const auto behind = lastOld - m_lines.rbegin();
    const auto oldSize = static_cast<std::ptrdiff_t>(m_lines.size());
    const auto newSize = static_cast<std::ptrdiff_t>(lines.size());
    const std::string usual = usualEnd();

    std::string bytes = m_mark;
    for (std::ptrdiff_t i = 0; i < newSize; ++i) {
        const std::ptrdiff_t old = i >= newSize - behind ? i + oldSize - newSize : i;
        const bool replaces = old < oldSize - behind || i >= newSize - behind;
        const std::string& end = replaces ? m_lines[static_cast<std::size_t>(old)].end : usual;
        bytes += lines[static_cast<std::size_t>(i)];
        if (i + 1 < newSize) {
            bytes += end.empty() ? usual : end;
        }
    }
    return bytes;
}
