// Wildcard matching of 100,000 names of 30 characters, and of texts made to go back, beside the C library's, GLib's and
// a greedy loop of ten lines. Times are for all the names, or for one long text.

#include "s/ListBox.h"

#include <benchmark/benchmark.h>
#include <fnmatch.h>
#include <glib.h>
#include <random>
#include <string>
#include <string_view>
#include <vector>

namespace {

constexpr int nameCount = 100000;

const std::vector<CString>& names() {
    static const std::vector<CString> made = [] {
        std::vector<CString> all;
        std::mt19937 random(1);
        for (int i = 0; i < nameCount; ++i) {
            std::string name = random() % 3 == 0 ? "m" : "";
            while (name.size() < 26) {
                name += static_cast<char>('a' + random() % 26);
            }
            name += random() % 2 == 0 ? ".cpp" : ".txt";
            all.emplace_back(name.c_str());
        }
        return all;
    }();
    return made;
}

/// The usual loop: goes back to the last "*" and lets it take one byte more.
bool greedy(std::string_view text, std::string_view pattern) {
    std::size_t at = 0, wanted = 0, star = std::string_view::npos, resume = 0;
    while (at < text.size()) {
        if (wanted < pattern.size() && (pattern[wanted] == '?' || pattern[wanted] == text[at]) &&
            pattern[wanted] != '*') {
            ++at;
            ++wanted;
        } else if (wanted < pattern.size() && pattern[wanted] == '*') {
            star = wanted++;
            resume = at;
        } else if (star != std::string_view::npos) {
            wanted = star + 1;
            at = ++resume;
        } else {
            return false;
        }
    }
    while (wanted < pattern.size() && pattern[wanted] == '*') {
        ++wanted;
    }
    return wanted == pattern.size();
}

struct Ours {
    explicit Ours(const char* pattern) : m_pattern(pattern) {}
    bool operator()(const CString& text) {
        return Gui_ListBox::MatchString(text, m_pattern) != 0;
    }
    CString m_pattern;
};
struct Greedy {
    explicit Greedy(const char* pattern) : m_pattern(pattern) {}
    bool operator()(const CString& text) {
        return greedy(text.View(), m_pattern);
    }
    std::string_view m_pattern;
};
struct Fnmatch {
    explicit Fnmatch(const char* pattern) : m_pattern(pattern) {}
    bool operator()(const CString& text) {
        return fnmatch(m_pattern, text, 0) == 0;
    }
    const char* m_pattern;
};
struct GlibPattern {
    explicit GlibPattern(const char* pattern) : m_pattern(g_pattern_spec_new(pattern)) {}
    ~GlibPattern() {
        g_pattern_spec_free(m_pattern);
    }
    bool operator()(const CString& text) {
        return g_pattern_spec_match(m_pattern, static_cast<gsize>(text.GetLength()), text, nullptr) != 0;
    }
    GPatternSpec* m_pattern;
};

template <typename Matcher>
void manyNames(benchmark::State& state, const char* pattern) {
    Matcher matcher(pattern);
    const std::vector<CString>& all = names();
    int matched = 0;
    for (auto _ : state) {
        matched = 0;
        for (const CString& name : all) {
            matched += matcher(name) ? 1 : 0;
        }
    }
    state.counters["matched"] = matched;
    state.SetItemsProcessed(state.iterations() * nameCount);
}

template <typename Matcher>
void longText(benchmark::State& state, const char* pattern, const std::string& text) {
    Matcher matcher(pattern);
    const CString longText(text.c_str());
    for (auto _ : state) {
        benchmark::DoNotOptimize(matcher(longText));
    }
}

template <typename Matcher>
void add(const std::string& who) {
    for (const char* pattern : {"*.cpp", "*a*b*c*", "m?in*", "*xyz*"}) {
        benchmark::RegisterBenchmark((std::string(pattern) + '/' + who).c_str(), manyNames<Matcher>, pattern)
            ->Unit(benchmark::kMicrosecond);
    }
    const std::string many(10000, 'a');
    constexpr const char* attack = "*a*a*a*a*a*b";
    benchmark::RegisterBenchmark(("attack on a.../" + who).c_str(), longText<Matcher>, attack, many)
        ->Unit(benchmark::kMicrosecond);
    benchmark::RegisterBenchmark(("attack on ba.../" + who).c_str(), longText<Matcher>, attack, "b" + many)
        ->Unit(benchmark::kMicrosecond);
    benchmark::RegisterBenchmark(("*aaaaaaaab* on a.../" + who).c_str(), longText<Matcher>, "*aaaaaaaab*", many)
        ->Unit(benchmark::kMicrosecond);
    benchmark::RegisterBenchmark(("*a?a?a?b* on a.../" + who).c_str(), longText<Matcher>, "*a?a?a?b*", many)
        ->Unit(benchmark::kMicrosecond);
}

const bool added = [] {
    add<Ours>("MatchString");
    add<Greedy>("greedy");
    add<Fnmatch>("fnmatch");
    add<GlibPattern>("GLib");
    return true;
}();

} // namespace
