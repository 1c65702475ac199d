#include "platform/afx/frames/DockState.h"

#include "platform/afx/core/App.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/Registry.h"

#include <charconv>
#include <memory>
#include <optional>
#include <string>

IMPLEMENT_DYNAMIC(CDockState, CObject)

namespace {

/// Damaged counts must not keep the start waiting.
constexpr int mostBars = AFX_IDW_CONTROLBAR_LAST - AFX_IDW_CONTROLBAR_FIRST + 1;

std::optional<int> readNumber(const CString& section, LPCSTR entry) {
    CWinApp* app = AfxGetApp();
    const CString text = app ? app->GetProfileStringA(section, entry) : CString();
    const char* begin = text.GetString();
    const char* end = begin + text.GetLength();
    int number = 0;
    const auto [stop, error] = std::from_chars(begin, end, number);
    return error == std::errc() && stop == end ? std::optional(number) : std::nullopt;
}

bool writeNumber(const CString& section, LPCSTR entry, int number) {
    CWinApp* app = AfxGetApp();
    return app && app->WriteProfileStringA(section, entry, std::to_string(number).c_str());
}

CString barSection(LPCSTR profileName, int index) {
    CString section;
    section.Format("%s-Bar%d", profileName, index);
    return section;
}

CString summarySection(LPCSTR profileName) {
    return CString(profileName) + "-Summary";
}

} // namespace

BOOL CControlBarInfo::LoadState(LPCSTR profileName, int index, CDockState*) {
    const CString section = barSection(profileName, index);
    const auto id = readNumber(section, "BarID");
    if (!id || *id <= 0) {
        return FALSE;
    }
    const auto read = [&](LPCSTR entry, int standard) { return readNumber(section, entry).value_or(standard); };
    *this = CControlBarInfo();
    m_nBarID = static_cast<UINT>(*id);
    m_bVisible = read("Visible", 1) != 0 ? TRUE : FALSE;
    m_bFloating = read("Floating", 0) != 0 ? TRUE : FALSE;
    m_pointPos = CPoint(read("XPos", 0), read("YPos", 0));
    m_uMRUDockID = static_cast<UINT>(read("MRUDockID", 0));
    m_nRow = read("Row", 0);
    m_nPlace = read("Place", 0);
    return TRUE;
}

BOOL CControlBarInfo::SaveState(LPCSTR profileName, int index) const {
    const CString section = barSection(profileName, index);
    const std::pair<LPCSTR, int> values[] = {{"BarID", static_cast<int>(m_nBarID)},
                                             {"Visible", m_bVisible},
                                             {"Floating", m_bFloating},
                                             {"XPos", m_pointPos.x},
                                             {"YPos", m_pointPos.y},
                                             {"MRUDockID", static_cast<int>(m_uMRUDockID)},
                                             {"Row", m_nRow},
                                             {"Place", m_nPlace}};
    bool written = true;
    for (const auto& [entry, value] : values) {
        written = writeNumber(section, entry, value) && written;
    }
    return written ? TRUE : FALSE;
}

CDockState::~CDockState() {
    Clear();
}

void CDockState::Clear() {
    for (INT_PTR i = 0; i < m_arrBarInfo.GetSize(); ++i) {
        delete static_cast<CControlBarInfo*>(m_arrBarInfo[i]);
    }
    m_arrBarInfo.RemoveAll();
}

void CDockState::LoadState(LPCSTR profileName) {
    Clear();
    const int count = readNumber(summarySection(profileName), "Bars").value_or(0);
    if (count < 0 || count > mostBars) {
        return;
    }
    for (int i = 0; i < count; ++i) {
        auto info = std::make_unique<CControlBarInfo>();
        m_arrBarInfo.Add(info->LoadState(profileName, i, this) ? info.release() : nullptr);
    }
}

void CDockState::SaveState(LPCSTR profileName) const {
    // Many values: a busy store is waited for once, and a bar is never half kept.
    tvx::RegistryTransaction together;
    const LSTATUS begun = together.begin();
    if (begun != ERROR_SUCCESS && begun != ERROR_INVALID_FUNCTION) { // the second: the caller has begun one
        return;
    }
    int count = 0;
    for (INT_PTR i = 0; i < m_arrBarInfo.GetSize(); ++i) {
        if (const auto* info = static_cast<const CControlBarInfo*>(m_arrBarInfo[i])) {
            info->SaveState(profileName, count++);
        }
    }
    writeNumber(summarySection(profileName), "Bars", count);
    (void)together.commit();
}
