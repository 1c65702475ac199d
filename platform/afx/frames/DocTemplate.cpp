#include "platform/afx/frames/DocTemplate.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Paths.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/View.h"
#include "platform/base/Text.h"

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CDocTemplate, CCmdTarget)

CDocTemplate::CDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass, CRuntimeClass* viewClass)
    : m_nIDResource(id), m_pDocClass(docClass), m_pFrameClass(frameClass), m_pViewClass(viewClass) {
    m_strDocStrings.LoadString(id);
}

CDocTemplate::~CDocTemplate() = default;

void CDocTemplate::LoadTemplate() {
    if (m_strDocStrings.IsEmpty()) {
        m_strDocStrings.LoadString(m_nIDResource);
    }
}

BOOL CDocTemplate::GetDocString(CString& text, DocStringIndex index) const {
    return AfxExtractSubString(text, m_strDocStrings, static_cast<int>(index));
}

CDocTemplate::Confidence CDocTemplate::MatchDocType(LPCSTR path, CDocument*& match) {
    match = nullptr;
    for (POSITION at = GetFirstDocPosition(); at;) {
        CDocument* document = GetNextDoc(at);
        if (sameFile(document->GetPathName(), path)) {
            match = document;
            return yesAlreadyOpen;
        }
    }
    CString wanted;
    const bool native = GetDocString(wanted, filterExt) && !wanted.IsEmpty() &&
                        tvx::text::compareNoCase(wanted.View(), extensionOf(path).View()) == 0;
    // A file with another extension may still be one of these: opening it tells.
    return native ? yesAttemptNative : yesAttemptForeign;
}

// --- documents ---

void CDocTemplate::AddDocument(CDocument* document) {
    document->m_pDocTemplate = this;
}

void CDocTemplate::RemoveDocument(CDocument* document) {
    document->m_pDocTemplate = nullptr;
}

CDocument* CDocTemplate::CreateNewDocument() {
    CObject* made = m_pDocClass ? m_pDocClass->CreateObject() : nullptr;
    auto* document = DYNAMIC_DOWNCAST(CDocument, made);
    if (!document) {
        delete made;
        return nullptr;
    }
    AddDocument(document);
    return document;
}

CFrameWnd* CDocTemplate::CreateNewFrame(CDocument* document, CFrameWnd* other) {
    CCreateContext context;
    context.m_pCurrentFrame = other;
    context.m_pCurrentDoc = document;
    context.m_pNewViewClass = m_pViewClass;
    context.m_pNewDocTemplate = this;
    CObject* made = m_pFrameClass ? m_pFrameClass->CreateObject() : nullptr;
    auto* frame = DYNAMIC_DOWNCAST(CFrameWnd, made);
    if (!frame) {
        delete made;
        return nullptr;
    }
    // A frame that could not be created has deleted itself.
    return frame->LoadFrame(m_nIDResource, WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE, nullptr, &context) ? frame : nullptr;
}

void CDocTemplate::InitialUpdateFrame(CFrameWnd* frame, CDocument* document, BOOL makeVisible) {
    frame->InitialUpdateFrame(document, makeVisible);
}

BOOL CDocTemplate::SaveAllModified() {
    for (POSITION at = GetFirstDocPosition(); at;) {
        if (!GetNextDoc(at)->SaveModified()) {
            return FALSE;
        }
    }
    return TRUE;
}

void CDocTemplate::CloseAllDocuments(BOOL) {
    std::vector<CDocument*> all;
    for (POSITION at = GetFirstDocPosition(); at;) {
        all.push_back(GetNextDoc(at));
    }
    for (CDocument* document : all) {
        document->OnCloseDocument();
    }
}

void CDocTemplate::OnIdle() {
    for (POSITION at = GetFirstDocPosition(); at;) {
        GetNextDoc(at)->OnIdle();
    }
}

BOOL CDocTemplate::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    return CCmdTarget::OnCmdMsg(id, code, extra, info);
}
