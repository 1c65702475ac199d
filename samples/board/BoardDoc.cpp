#include "BoardDoc.h"

#include "Resource.h"
#include "platform/base/SystemPath.h"
#include "s/Msg.h"

#include <string>
#include <utility>
#include <vector>

namespace {

constexpr ULONGLONG largestFile = 64 * 1024 * 1024;

/// A word of a damaged file, which may be anything, cut to what a message has room for.
CString shown(std::string word) {
    constexpr std::size_t room = 60;
    if (word.size() > room) {
        std::size_t end = room;
        while (end > 0 && (word[end] & 0xC0) == 0x80) { // between characters
            --end;
        }
        word.replace(end, std::string::npos, "...");
    }
    return word.c_str();
}

/// The drawings that were worked with, the last one at the end.
std::vector<CBoardDoc*> used;

} // namespace

IMPLEMENT_DYNCREATE(CBoardDoc, CDocument)

// clang-format off
BEGIN_MESSAGE_MAP(CBoardDoc, CDocument)
    ON_COMMAND(ID_EDIT_UNDO, &CBoardDoc::OnEditUndo)
    ON_COMMAND(ID_EDIT_REDO, &CBoardDoc::OnEditRedo)
    ON_UPDATE_COMMAND_UI(ID_EDIT_UNDO, &CBoardDoc::OnUpdateEditUndo)
    ON_UPDATE_COMMAND_UI(ID_EDIT_REDO, &CBoardDoc::OnUpdateEditRedo)
END_MESSAGE_MAP()
// clang-format on

CBoardDoc::~CBoardDoc() {
    std::erase(used, this);
}

CBoardDoc* CBoardDoc::GetCurrent() {
    return used.empty() ? nullptr : used.back();
}

void CBoardDoc::MakeCurrent() {
    std::erase(used, this);
    used.push_back(this);
}

CString CBoardDoc::Sentence(const board::ReadResult& result) {
    Gui_Msg message(IDS_FAULT_FIRST + static_cast<UINT>(result.fault));
    for (const std::string& detail : result.details) {
        message << shown(detail);
    }
    return message.GetValue();
}

void CBoardDoc::Change(board::Change change) {
    if (!change.isNothing()) {
        Changed(m_history.make(std::move(change), m_drawing));
    }
}

void CBoardDoc::Changed(const board::Change& change) {
    SetModifiedFlag(!m_history.isSaved());
    UpdateAllViews(nullptr, reinterpret_cast<LPARAM>(&change));
}

void CBoardDoc::DeleteContents() {
    m_drawing = {};
    m_history.clear();
}

// --- the file ---

BOOL CBoardDoc::OnOpenDocument(LPCSTR path) {
    CFileException error;
    CFile* file = GetFile(path, CFile::modeRead | CFile::shareDenyWrite, &error);
    if (!file) {
        ReportSaveLoadException(path, &error, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        return FALSE;
    }
    std::string text;
    try {
        CWaitCursor wait;
        const ULONGLONG length = file->GetLength();
        if (length > largestFile) {
            ReleaseFile(file, TRUE);
            CString message;
            message.Format(IDS_TOO_LARGE, tvx::shownName(path).c_str());
            AfxMessageBox(message, MB_OK | MB_ICONEXCLAMATION, AFX_IDP_FAILED_TO_OPEN_DOC);
            return FALSE;
        }
        text.resize(length);
        text.resize(file->Read(text.data(), static_cast<UINT>(length)));
    } catch (CException* problem) {
        ReleaseFile(file, TRUE);
        ReportSaveLoadException(path, problem, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        problem->Delete();
        return FALSE;
    }
    ReleaseFile(file, FALSE);
    return Take(path, text);
}

BOOL CBoardDoc::Take(const char* path, const std::string& text) {
    board::ReadResult result = board::readDrawing(text);
    if (!result.ok()) {
        CString message;
        message.Format(IDS_DAMAGED, tvx::shownName(path).c_str(), result.line, Sentence(result).GetString());
        AfxMessageBox(message, MB_OK | MB_ICONEXCLAMATION, AFX_IDP_FAILED_TO_OPEN_DOC);
        return FALSE;
    }
    DeleteContents();
    m_drawing = std::move(result.drawing);
    SetModifiedFlag(FALSE);
    return TRUE;
}

// What GetFile gives is a new file beside the old one, whose place it takes in ReleaseFile: until all is written the
// user's file stays as it is.
BOOL CBoardDoc::OnSaveDocument(LPCSTR path) {
    CFileException error;
    CFile* file = GetFile(path, CFile::modeCreate | CFile::modeReadWrite | CFile::shareExclusive, &error);
    if (!file) {
        ReportSaveLoadException(path, &error, TRUE, AFX_IDP_INVALID_FILENAME);
        return FALSE;
    }
    try {
        CWaitCursor wait;
        const std::string text = board::writeDrawing(m_drawing);
        file->Write(text.data(), static_cast<UINT>(text.size()));
        file->Close();
    } catch (CException* problem) {
        ReleaseFile(file, TRUE);
        ReportSaveLoadException(path, problem, TRUE, AFX_IDP_FAILED_TO_SAVE_DOC);
        problem->Delete();
        return FALSE;
    }
    ReleaseFile(file, FALSE);
    m_history.save();
    SetModifiedFlag(FALSE);
    return TRUE;
}

// --- undo ---

bool CBoardDoc::Undo() {
    const bool can = m_history.canUndo();
    if (can) {
        Changed(m_history.undo(m_drawing));
    }
    return can;
}

bool CBoardDoc::Redo() {
    const bool can = m_history.canRedo();
    if (can) {
        Changed(m_history.redo(m_drawing));
    }
    return can;
}

void CBoardDoc::OnEditUndo() {
    Undo();
}

void CBoardDoc::OnEditRedo() {
    Redo();
}

void CBoardDoc::OnUpdateEditUndo(CCmdUI* item) {
    item->Enable(m_history.canUndo());
}

void CBoardDoc::OnUpdateEditRedo(CCmdUI* item) {
    item->Enable(m_history.canRedo());
}
