#include "s/ConsoleRecall.h"

#include "platform/base/Text.h"
#include "s/ConsoleHistory.h"

#include <string>
#include <utility>

int Gui_ConsoleRecall::GetNewest() const {
    return Count() - 1;
}

int Gui_ConsoleRecall::Count() const {
    return static_cast<int>(m_earlier.size()) + static_cast<int>(m_history.GetCommands().GetSize());
}

const CString& Gui_ConsoleRecall::At(int place) const {
    const auto earlier = static_cast<int>(m_earlier.size());
    return place < earlier ? m_earlier[static_cast<std::size_t>(place)]
                           : m_history.GetCommands().LineAt(place - earlier)->m_text;
}

void Gui_ConsoleRecall::SetEarlier(std::vector<CString> texts) {
    m_earlier = std::move(texts);
    Leave();
}

void Gui_ConsoleRecall::Leave() {
    m_place = -1;
    m_unfinished.Empty();
}

// What stands in the field already, or stood there before the user changed it, would look as if the key did nothing.
bool Gui_ConsoleRecall::ShowsNothingNew(int place, const CString& text) const {
    return At(place) == text || (m_place != -1 && At(place) == At(m_place));
}

bool Gui_ConsoleRecall::Older(CString& text) {
    int place = m_place == -1 ? Count() : m_place;
    do {
        --place;
    } while (place >= 0 && ShowsNothingNew(place, text));
    if (place < 0) {
        return false;
    }
    if (m_place == -1) {
        m_unfinished = text;
    }
    m_place = place;
    text = At(place);
    return true;
}

bool Gui_ConsoleRecall::Newer(CString& text) {
    if (m_place == -1) {
        return false;
    }
    int place = m_place;
    do {
        ++place;
    } while (place < Count() && ShowsNothingNew(place, text));
    m_place = place < Count() ? place : -1;
    text = m_place == -1 ? std::exchange(m_unfinished, {}) : At(place);
    return true;
}

bool Gui_ConsoleRecall::Search(const CString& pattern, int& place, int step, CString& text) const {
    if (pattern.IsEmpty()) {
        return false;
    }
    const std::string wanted = tvx::text::foldCase(pattern.GetString());
    for (int at = place; at >= 0 && at < Count(); at += step) {
        if (tvx::text::foldCase(At(at).GetString()).find(wanted) != std::string::npos) {
            place = at;
            text = At(at);
            return true;
        }
    }
    return false;
}
