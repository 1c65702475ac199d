#pragma once

#include <string>
#include <string_view>
#include <vector>

/// The words of what a user has typed to find something, without case: blanks separate them.
[[nodiscard]] std::vector<std::string> FoldedWords(std::string_view typed);

/// Whether every word occurs somewhere in a text without case.
[[nodiscard]] bool HasAllWords(std::string_view folded, const std::vector<std::string>& words);

/// A command as it is looked for. All texts without case.
struct CommandText {
    std::string label;         ///< the menus around it and its name
    std::size_t nameStart = 0; ///< where in the label the name begins
    std::string key;           ///< its key
};

/// How well a command fits the words that were typed: 0 when one of them is not found, the more the better otherwise.
/// A word is found at the beginning of words ("dra" in "Draw Rectangle"), as beginnings of several words one behind the
/// other ("bf", "brifro" in "Bring to Front"), anywhere in the label, or in the key. The name counts more than the
/// menus around it. No words fit everything.
[[nodiscard]] int MatchRank(const CommandText& command, const std::vector<std::string>& words);
