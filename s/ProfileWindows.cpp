#include "s/Profile.h"

#include "afxext.h"
#include "platform/base/Text.h"
#include "s/SettingsKey.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <span>

// Where windows and bars stood, and fonts: records that are lines of decimal numbers.

namespace {

constexpr const char* placementEntry = "WindowPlacement";
constexpr const char* fontEntry = "Font";
constexpr const char* barProfile = "ControlBar";
constexpr char spaceInName = '~';

/// Reads as many numbers, separated by commas, as there is room for.
/// @return where the last one ended, null when one is missing
const char* readNumbers(const char* text, std::span<int> numbers) {
    for (std::size_t i = 0; i < numbers.size(); ++i) {
        if (i > 0 && *text++ != ',') {
            return nullptr;
        }
        const char* end = text;
        numbers[i] = tvx::text::toInt32(text, &end);
        if (end == text) {
            return nullptr;
        }
        text = end;
    }
    return text;
}

CString numbersText(std::span<const int> numbers) {
    CString text;
    for (const int number : numbers) {
        text.AppendFormat(text.IsEmpty() ? "%d" : ",%d", number);
    }
    return text;
}

CString placementText(const WINDOWPLACEMENT& placement) {
    const RECT& normal = placement.rcNormalPosition;
    const std::array<int, 12> numbers = {static_cast<int>(placement.flags),
                                         static_cast<int>(placement.showCmd),
                                         placement.ptMinPosition.x,
                                         placement.ptMinPosition.y,
                                         placement.ptMaxPosition.x,
                                         placement.ptMaxPosition.y,
                                         normal.left,
                                         normal.top,
                                         normal.right,
                                         normal.bottom,
                                         GetSystemMetrics(SM_CXSCREEN),
                                         GetSystemMetrics(SM_CYSCREEN)};
    return numbersText(numbers);
}

int parsePlacement(const CString& text, WINDOWPLACEMENT& placement) {
    std::array<int, 12> numbers{};
    if (!readNumbers(text, numbers) || numbers[10] != GetSystemMetrics(SM_CXSCREEN) ||
        numbers[11] != GetSystemMetrics(SM_CYSCREEN)) {
        return 0;
    }
    placement.length = sizeof placement;
    placement.flags = static_cast<UINT>(numbers[0]);
    placement.showCmd = static_cast<UINT>(numbers[1]);
    placement.ptMinPosition = {numbers[2], numbers[3]};
    placement.ptMaxPosition = {numbers[4], numbers[5]};
    placement.rcNormalPosition = {numbers[6], numbers[7], numbers[8], numbers[9]};
    return 1;
}

/// The face name behind the thirteenth comma: what stands up to the next white space. Empty when it does not fit.
CString parseFaceName(const char* text) {
    constexpr const char* whiteSpace = " \t\n\v\f\r";
    text += std::strspn(text, whiteSpace);
    const std::size_t length = std::strcspn(text, whiteSpace);
    return length < LF_FACESIZE ? CString(text, static_cast<int>(length)) : CString();
}

} // namespace

// --- windows ---

static_assert(sizeof(WINDOWPLACEMENT) == 44);

int Gui_Profile::ReadWindowPlacement(WINDOWPLACEMENT& placement, const char* entry, const char* section) {
    CString text;
    return ReadString(text, entry ? entry : placementEntry, section) ? parsePlacement(text, placement) : 0;
}

void Gui_Profile::WriteWindowPlacement(WINDOWPLACEMENT& placement, const char* entry, const char* section) {
    WriteString(placementText(placement), entry ? entry : placementEntry, section);
}

int Gui_Profile::ReadDialogWindowPlacement(const char* name, WINDOWPLACEMENT& placement) {
    return parsePlacement(SettingsKey(familyKey).text(name).value_or(CString()), placement);
}

void Gui_Profile::WriteDialogWindowPlacement(const char* name, WINDOWPLACEMENT& placement) {
    SettingsKey(familyKey).writeText(name, placementText(placement));
}

// --- bars ---

int Gui_Profile::CheckBarState(CFrameWnd* frame, const char* profileName) {
    CDockState state;
    state.LoadState(profileName ? profileName : barProfile);
    for (INT_PTR i = 0; i < state.m_arrBarInfo.GetSize(); ++i) {
        const auto* record = static_cast<const CControlBarInfo*>(state.m_arrBarInfo[i]);
        if (!record) {
            return 0;
        }
        if (!record->m_bFloating && !frame->GetControlBar(record->m_nBarID)) {
            return 0;
        }
    }
    return 1;
}

int Gui_Profile::ReadBarState(CFrameWnd* frame, const char* profileName) {
    if (CheckBarState(frame, profileName)) {
        frame->LoadBarState(profileName ? profileName : barProfile);
    }
    return 1;
}

void Gui_Profile::WriteBarState(CFrameWnd* frame, const char* profileName) {
    frame->SaveBarState(profileName ? profileName : barProfile);
}

// --- fonts ---

int Gui_Profile::ReadLogFont(LOGFONTA& font, const char* entry, const char* section) {
    CString text;
    std::array<int, 13> numbers{};
    if (!ReadString(text, entry ? entry : fontEntry, section)) {
        return 0;
    }
    const char* end = readNumbers(text, numbers);
    const CString name = end && *end == ',' ? parseFaceName(end + 1) : CString();
    if (name.IsEmpty()) {
        return 0;
    }
    font.lfHeight = numbers[0];
    font.lfWidth = numbers[1];
    font.lfEscapement = numbers[2];
    font.lfOrientation = numbers[3];
    font.lfWeight = numbers[4];
    const auto low = [&](std::size_t field) { return static_cast<BYTE>(numbers[field] & 0xFF); };
    font.lfItalic = low(5);
    font.lfUnderline = low(6);
    font.lfStrikeOut = low(7);
    font.lfCharSet = low(8);
    font.lfOutPrecision = low(9);
    font.lfClipPrecision = low(10);
    font.lfQuality = low(11);
    font.lfPitchAndFamily = low(12);
    std::fill(std::begin(font.lfFaceName), std::end(font.lfFaceName), '\0');
    std::replace_copy(name.GetString(), name.GetString() + name.GetLength(), font.lfFaceName, spaceInName, ' ');
    return 1;
}

void Gui_Profile::WriteLogFont(LOGFONTA& font, const char* entry, const char* section) {
    std::replace(std::begin(font.lfFaceName), std::end(font.lfFaceName), ' ', spaceInName);
    const std::array<int, 13> numbers = {
        font.lfHeight,        font.lfWidth,     font.lfEscapement,    font.lfOrientation, font.lfWeight,
        font.lfItalic,        font.lfUnderline, font.lfStrikeOut,     font.lfCharSet,     font.lfOutPrecision,
        font.lfClipPrecision, font.lfQuality,   font.lfPitchAndFamily};
    const CString name(font.lfFaceName, static_cast<int>(strnlen(font.lfFaceName, LF_FACESIZE - 1)));
    WriteString(numbersText(numbers) + "," + name, entry ? entry : fontEntry, section);
    std::replace(std::begin(font.lfFaceName), std::end(font.lfFaceName), spaceInName, ' ');
}
