#include "platform/win/detail/DesktopHandlers.h"

#include <algorithm>
#include <dlfcn.h>
#include <gio/gdesktopappinfo.h>
#include <gio/gio.h>
#include <memory>
#include <string_view>

namespace tvx::win {

namespace {

/// The calls of the desktop's library. It is not linked: loading it takes a millisecond, which most runs of most
/// applications have no use for.
struct Gio {
    decltype(&g_app_info_get_default_for_type) defaultFor = nullptr;
    decltype(&g_app_info_get_recommended_for_type) recommendedFor = nullptr;
    decltype(&g_app_info_get_commandline) commandLineOf = nullptr;
    decltype(&g_app_info_equal) areEqual = nullptr;
    decltype(&g_desktop_app_info_get_boolean) isSet = nullptr;
    decltype(&g_shell_parse_argv) split = nullptr;
    decltype(&g_strfreev) freeWords = nullptr;
    decltype(&g_list_free) freeList = nullptr;
    decltype(&g_object_unref) release = nullptr;
    bool isComplete = false;

    Gio() {
        void* library = ::dlopen("libgio-2.0.so.0", RTLD_NOW | RTLD_LOCAL);
        isComplete = library && find(library, defaultFor, "g_app_info_get_default_for_type") &&
                     find(library, recommendedFor, "g_app_info_get_recommended_for_type") &&
                     find(library, commandLineOf, "g_app_info_get_commandline") &&
                     find(library, areEqual, "g_app_info_equal") &&
                     find(library, isSet, "g_desktop_app_info_get_boolean") &&
                     find(library, split, "g_shell_parse_argv") && find(library, freeWords, "g_strfreev") &&
                     find(library, freeList, "g_list_free") && find(library, release, "g_object_unref");
    }

    template <typename Call>
    static bool find(void* library, Call& call, const char* name) {
        call = reinterpret_cast<Call>(::dlsym(library, name));
        return call != nullptr;
    }
};

/// Loaded once and never unloaded: it has threads of its own.
const Gio& gio() {
    static const Gio* const loaded = new Gio;
    return *loaded;
}

struct Release {
    void operator()(void* object) const {
        gio().release(object);
    }
};
using Program = std::unique_ptr<GAppInfo, Release>;

std::vector<Program> recommended(const char* type) {
    std::vector<Program> programs;
    GList* list = gio().recommendedFor(type);
    for (const GList* item = list; item; item = item->next) {
        programs.emplace_back(static_cast<GAppInfo*>(item->data));
    }
    gio().freeList(list);
    return programs;
}

bool holds(const std::vector<Program>& programs, GAppInfo* program) {
    return std::ranges::any_of(programs,
                               [program](const Program& other) { return gio().areEqual(other.get(), program) != 0; });
}

/// Where a type has no program, the library answers with that of a type which it is a kind of: for pages that would be
/// an editor of texts, which is no browser.
bool isForTextsOnly(const char* type, const std::vector<Program>& own, GAppInfo* program) {
    constexpr const char* texts = "text/plain";
    if (std::string_view(type) == texts || holds(own, program)) {
        return false;
    }
    const Program editor(gio().defaultFor(texts, FALSE));
    return editor && gio().areEqual(editor.get(), program);
}

std::vector<Program> programsFor(const char* type) {
    std::vector<Program> programs = recommended(type);
    Program first(gio().defaultFor(type, FALSE));
    if (first && !isForTextsOnly(type, programs, first.get())) {
        programs.insert(programs.begin(), std::move(first));
    }
    return programs;
}

bool needsTerminal(GAppInfo* program) {
    return gio().isSet(reinterpret_cast<GDesktopAppInfo*>(program), "Terminal") != 0;
}

std::vector<std::string> wordsOf(GAppInfo* program) {
    const char* line = gio().commandLineOf(program);
    gchar** split = nullptr;
    gint count = 0;
    std::vector<std::string> words;
    if (line && gio().split(line, &count, &split, nullptr)) {
        words.assign(split, split + count);
        gio().freeWords(split);
    }
    return words;
}

} // namespace

std::vector<std::vector<std::string>> handlersOf(const char* type) {
    std::vector<std::vector<std::string>> calls;
    if (!gio().isComplete) {
        return calls;
    }
    for (const Program& program : programsFor(type)) {
        if (std::vector<std::string> words = wordsOf(program.get()); !words.empty() && !needsTerminal(program.get())) {
            calls.push_back(std::move(words));
        }
    }
    return calls;
}

} // namespace tvx::win
