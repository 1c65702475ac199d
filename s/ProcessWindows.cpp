// What a process object does with windows: its child's, and those that show its output.
#include "afxwin.h"
#include "platform/afx/core/HandleWatch.h"
#include "platform/win/Error.h"
#include "platform/win/Process.h"
#include "s/Edit.h"
#include "s/Process.h"
#include "s/ProcessRecord.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <string>
#include <string_view>
#include <utility>

// Output

namespace {

/// How long output is read before the user's input gets its turn. What waits when the reading begins takes a fraction.
constexpr std::chrono::milliseconds readingTime{8};

/// How long the rest of a character or a line end is waited for. Programs write it at once unless their buffer was
/// full.
constexpr std::chrono::milliseconds patience{200};

/// The most text that an edit control without a limit gets.
constexpr std::size_t mostWithoutLimit = 60000;

std::size_t limitOf(CEdit& edit) {
    const UINT limit = edit.GetLimitText();
    return limit == 0 ? mostWithoutLimit : limit;
}

/// Appends a piece. Of text beyond the limit only the end will be seen; the control cuts it between characters, which
/// have at most four bytes.
void appendEnd(std::string& text, std::string_view piece, std::size_t limit) {
    const std::size_t most = limit + 4;
    if (piece.size() >= most) {
        text.clear();
    } else if (text.size() > 2 * most) {
        text.erase(0, text.size() - most);
    }
    text += piece.substr(piece.size() - std::min(piece.size(), most));
}

/// The length of what must not be shown before its rest is there: the first bytes of a character, half a line end.
std::size_t unfinishedLength(std::string_view text) {
    if (text.ends_with('\r')) {
        return 1;
    }
    for (std::size_t length = 1; length <= std::min<std::size_t>(text.size(), 3); ++length) {
        const auto byte = static_cast<unsigned char>(text[text.size() - length]);
        if (byte >= 0xC0) {
            const std::size_t whole = byte >= 0xF0 ? 4 : byte >= 0xE0 ? 3 : 2;
            return whole > length ? length : 0;
        }
        if (byte < 0x80) {
            break;
        }
    }
    return 0;
}

} // namespace

void Gui_Process::Record::HoldBack(CString& text) {
    const std::size_t length = unfinishedLength(text.View());
    if (length > 0) {
        const std::size_t rest = text.View().size() - length;
        unfinished = text.View().substr(rest);
        unfinishedSince = std::chrono::steady_clock::now();
        text.Truncate(static_cast<int>(rest));
    }
}

std::chrono::milliseconds Gui_Process::Record::Patience(std::chrono::steady_clock::time_point now) const {
    // A program that the child started may hold the pipe, but what the child began it does not end.
    if (lastError == ERROR_BROKEN_PIPE || WaitForSingleObject(process, 0) == WAIT_OBJECT_0) {
        return std::chrono::milliseconds(0);
    }
    const auto left = unfinishedSince + patience - now;
    return std::max(std::chrono::ceil<std::chrono::milliseconds>(left), std::chrono::milliseconds(0));
}

int Gui_Process::AppendOutput(CEdit& edit, CString* lastChunk) {
    using Clock = std::chrono::steady_clock;
    Record& record = *m_record;
    const auto begin = Clock::now();
    const std::size_t limit = limitOf(edit);
    std::string text;
    CString& chunk = record.chunk;
    const auto take = [&] {
        tvx::allocating([&] { appendEnd(text, chunk.View(), limit); });
        if (lastChunk && !chunk.IsEmpty()) {
            *lastChunk = chunk;
        }
    };
    while (record.WaitingBytes() > 0) {
        GetOutput(chunk);
        record.HoldBack(chunk);
        take();
        if (Clock::now() >= begin + readingTime) {
            break;
        }
    }
    // Asked for in this order: what the child wrote before its end is in the pipe by then.
    const bool isDue = !record.unfinished.empty() && record.Patience(begin).count() == 0;
    if (isDue && record.WaitingBytes() == 0) {
        chunk = CString(std::exchange(record.unfinished, {}));
        take();
    }
    if (text.empty()) {
        return 0;
    }
    Gui_Edit::AppendText(edit, CString(text));
    return 1;
}

int Gui_Process::NotifyWindow(HWND window, unsigned int message) {
    Record& record = *m_record;
    std::array<HANDLE, 2> handles{};
    std::size_t count = 0;
    if (record.exitCode == STILL_ACTIVE) {
        handles[count++] = record.process;
    }
    // A pipe at its end is readable for ever: only what is held back is still to be shown then.
    const bool isHeldBack = !record.unfinished.empty();
    if (isHeldBack || PeekNamedPipe(record.outputPipe, nullptr, 0, nullptr, nullptr, nullptr)) {
        handles[count++] = record.outputPipe;
    }
    const auto now = std::chrono::steady_clock::now();
    const DWORD timeout = isHeldBack ? static_cast<DWORD>(record.Patience(now).count()) : INFINITE;
    if (count == 0 || !tvx::postWhenSignalled(std::span(handles).first(count), window, message, timeout)) {
        return 0;
    }
    record.notifies = true;
    return 1;
}

void Gui_Process::Record::StopNotifying() {
    if (!std::exchange(notifies, false)) {
        return;
    }
    tvx::cancelPosts(process);
    tvx::cancelPosts(outputPipe);
}

// Windows of the child

namespace {

/// Classes of windows that are there for their process, not for its user.
constexpr std::string_view helperClasses[] = {
    "#32772",
    "tooltips_class32",
    "OleMainThreadWndClass",
    "OleDdeWndClass",
    "OleMainThreadWndClass 0x######## ",
    "OleDdeWndClass 0x######## ",
};

bool isHelper(HWND window) {
    char name[101] = "";
    const int length = GetClassNameA(window, name, sizeof name);
    return std::ranges::find(helperClasses, std::string_view(name, static_cast<std::size_t>(length))) !=
           std::end(helperClasses);
}

BOOL CALLBACK bringToFront(HWND window, LPARAM) {
    if (GetParent(window) || isHelper(window) || !IsWindow(window)) {
        return TRUE;
    }
    if (IsIconic(window)) {
        ShowWindow(window, SW_RESTORE);
        return TRUE;
    }
    // Hidden and shown again, a window comes in front of the others.
    const bool maximized = IsZoomed(window);
    ShowWindow(window, SW_HIDE);
    ShowWindow(window, maximized ? SW_SHOWMAXIMIZED : SW_SHOWNORMAL);
    return TRUE;
}

} // namespace

int Gui_Process::ShowMainWindow() const {
    Record& record = *m_record;
    if (record.CurrentExitCode() == STILL_ACTIVE && record.mainThreadId != 0) {
        EnumThreadWindows(record.mainThreadId, &bringToFront, 0);
    }
    return 0;
}
