#include "platform/afx/core/App.h"
#include "platform/afx/frames/DocTemplate.h"
#include "platform/afx/frames/Document.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

IMPLEMENT_DYNAMIC(CMultiDocTemplate, CDocTemplate)

CMultiDocTemplate::CMultiDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass,
                                     CRuntimeClass* viewClass)
    : CDocTemplate(id, docClass, frameClass, viewClass) {}

CMultiDocTemplate::~CMultiDocTemplate() {
    ::DestroyMenu(m_hMenuShared);
    ::DestroyAcceleratorTable(m_hAccelTable);
    const auto all = m_documents;
    for (CDocument* document : all) {
        CDocTemplate::RemoveDocument(document);
    }
}

void CMultiDocTemplate::LoadTemplate() {
    CDocTemplate::LoadTemplate();
    const LPCSTR name = MAKEINTRESOURCE(m_nIDResource);
    if (m_nIDResource != 0 && !m_hMenuShared) {
        m_hMenuShared = ::LoadMenuA(AfxFindResourceHandle(name, RT_MENU), name);
        m_hAccelTable = ::LoadAcceleratorsA(AfxFindResourceHandle(name, RT_ACCELERATOR), name);
    }
}

void CMultiDocTemplate::AddDocument(CDocument* document) {
    CDocTemplate::AddDocument(document);
    m_documents.push_back(document);
}

void CMultiDocTemplate::RemoveDocument(CDocument* document) {
    CDocTemplate::RemoveDocument(document);
    std::erase(m_documents, document);
}

POSITION CMultiDocTemplate::GetFirstDocPosition() const {
    return m_documents.empty() ? nullptr : reinterpret_cast<POSITION>(std::uintptr_t{1});
}

CDocument* CMultiDocTemplate::GetNextDoc(POSITION& position) const {
    // A position is the document's number, counted from 1.
    const auto number = reinterpret_cast<std::uintptr_t>(position);
    position = number < m_documents.size() ? reinterpret_cast<POSITION>(number + 1) : nullptr;
    return number >= 1 && number <= m_documents.size() ? m_documents[number - 1] : nullptr;
}

void CMultiDocTemplate::SetDefaultTitle(CDocument* document) {
    CString title;
    if (GetDocString(title, docName) && !title.IsEmpty()) {
        title.AppendFormat("%u", m_nUntitledCount + 1);
    } else {
        title.LoadString(AFX_IDS_UNTITLED);
    }
    document->SetTitle(title);
}

CDocument* CMultiDocTemplate::OpenDocumentFile(LPCSTR path, BOOL makeVisible) {
    CDocument* document = CreateNewDocument();
    if (!document) {
        AfxMessageBox(AFX_IDP_FAILED_TO_CREATE_DOC);
        return nullptr;
    }
    // A frame that fails takes its view with it; the document must not delete itself with that.
    const BOOL autoDelete = std::exchange(document->m_bAutoDelete, FALSE);
    CFrameWnd* frame = CreateNewFrame(document, nullptr);
    document->m_bAutoDelete = autoDelete;
    if (!frame) {
        AfxMessageBox(AFX_IDP_FAILED_TO_CREATE_DOC);
        delete document;
        return nullptr;
    }
    bool filled = false;
    if (!path) {
        SetDefaultTitle(document);
        filled = document->OnNewDocument() != FALSE;
        m_nUntitledCount += filled ? 1 : 0;
    } else {
        filled = document->OnOpenDocument(path) != FALSE;
        if (filled) {
            document->SetPathName(path);
        }
    }
    if (!filled) {
        frame->DestroyWindow(); // the document goes with its view
        return nullptr;
    }
    InitialUpdateFrame(frame, document, makeVisible);
    return document;
}
