#include "s/CommandFilter.h"

#include "platform/base/Text.h"

#include <algorithm>

namespace {

// How a word was found. The name's bonus is smaller than the steps between them.
constexpr int wholeWord = 50;
constexpr int beginning = 40;
constexpr int beginnings = 30;
constexpr int somewhere = 10;
constexpr int inName = 6;
constexpr int firstInName = 3;

/// Letters of other scripts are bytes from 0x80 on.
bool isLetter(char character) {
    const auto byte = static_cast<unsigned char>(character);
    return byte >= 0x80 || (byte >= '0' && byte <= '9') || (byte >= 'a' && byte <= 'z');
}

/// Where the words of a text begin.
std::vector<std::size_t> wordStarts(std::string_view text) {
    std::vector<std::size_t> starts;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (isLetter(text[i]) && (i == 0 || !isLetter(text[i - 1]))) {
            starts.push_back(i);
        }
    }
    return starts;
}

std::size_t commonLength(std::string_view text, std::string_view other) {
    const auto [end, otherEnd] = std::mismatch(text.begin(), text.end(), other.begin(), other.end());
    return static_cast<std::size_t>(end - text.begin());
}

/// Whether a word is beginnings of a text's words, one behind the other; words between them may be left out.
bool isOfBeginnings(std::string_view word, std::string_view text, const std::vector<std::size_t>& starts) {
    // How much of the word can have been found before each of the text's words.
    std::vector<bool> reached(word.size() + 1, false);
    reached[0] = true;
    for (const std::size_t start : starts) {
        // From behind, so that one word of the text is used once.
        for (std::size_t at = word.size(); at-- > 0;) {
            if (!reached[at]) {
                continue;
            }
            const std::size_t most = commonLength(word.substr(at), text.substr(start));
            for (std::size_t length = 1; length <= most && isLetter(text[start + length - 1]); ++length) {
                reached[at + length] = true;
            }
        }
        if (reached[word.size()]) {
            return true;
        }
    }
    return false;
}

int rankIn(std::string_view text, std::string_view word) {
    const std::vector<std::size_t> starts = wordStarts(text);
    int best = 0;
    for (const std::size_t start : starts) {
        if (text.substr(start).starts_with(word)) {
            const std::size_t end = start + word.size();
            const bool isWhole = end == text.size() || !isLetter(text[end]);
            best = std::max(best, (isWhole ? wholeWord : beginning) + (start == starts.front() ? firstInName : 0));
        }
    }
    if (best == 0 && isOfBeginnings(word, text, starts)) {
        best = beginnings;
    }
    if (best == 0 && text.find(word) != std::string_view::npos) {
        best = somewhere;
    }
    return best;
}

int rankOf(const CommandText& command, std::string_view word) {
    const std::string_view label = command.label;
    const int name = rankIn(label.substr(command.nameStart), word);
    const int whole = name < beginnings ? rankIn(label, word) / 2 : 0;
    int key = 0;
    if (!command.key.empty() && command.key.find(word) != std::string::npos) {
        key = command.key == word ? wholeWord : somewhere;
    }
    return std::max({name > 0 ? name + inName : 0, whole, key});
}

} // namespace

std::vector<std::string> FoldedWords(std::string_view typed) {
    std::vector<std::string> words;
    const std::string folded = tvx::text::foldCase(typed);
    std::size_t end = 0;
    for (std::size_t start = folded.find_first_not_of(" \t"); start != std::string::npos;
         start = folded.find_first_not_of(" \t", end)) {
        end = std::min(folded.find_first_of(" \t", start), folded.size());
        words.push_back(folded.substr(start, end - start));
    }
    return words;
}

bool HasAllWords(std::string_view folded, const std::vector<std::string>& words) {
    return std::all_of(words.begin(), words.end(),
                       [folded](const std::string& word) { return folded.find(word) != std::string_view::npos; });
}

int MatchRank(const CommandText& command, const std::vector<std::string>& words) {
    int sum = 1;
    for (const std::string& word : words) {
        const int rank = rankOf(command, word);
        if (rank == 0) {
            return 0;
        }
        sum += rank;
    }
    return sum;
}
