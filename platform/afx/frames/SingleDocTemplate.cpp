#include "platform/afx/core/App.h"
#include "platform/afx/frames/DocTemplate.h"
#include "platform/afx/frames/Document.h"

IMPLEMENT_DYNAMIC(CSingleDocTemplate, CDocTemplate)

CSingleDocTemplate::CSingleDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass,
                                       CRuntimeClass* viewClass)
    : CDocTemplate(id, docClass, frameClass, viewClass) {}

CSingleDocTemplate::~CSingleDocTemplate() {
    if (m_pOnlyDoc) {
        CDocTemplate::RemoveDocument(m_pOnlyDoc);
    }
}

void CSingleDocTemplate::AddDocument(CDocument* document) {
    m_pOnlyDoc = document;
    CDocTemplate::AddDocument(document);
}

void CSingleDocTemplate::RemoveDocument(CDocument* document) {
    m_pOnlyDoc = nullptr;
    CDocTemplate::RemoveDocument(document);
}

POSITION CSingleDocTemplate::GetFirstDocPosition() const {
    return reinterpret_cast<POSITION>(m_pOnlyDoc);
}

CDocument* CSingleDocTemplate::GetNextDoc(POSITION& position) const {
    position = nullptr;
    return m_pOnlyDoc;
}

void CSingleDocTemplate::SetDefaultTitle(CDocument* document) {
    CString title;
    if (!GetDocString(title, docName) || title.IsEmpty()) {
        title.LoadString(AFX_IDS_UNTITLED);
    }
    document->SetTitle(title);
}

/// What OpenDocumentFile works on.
struct CSingleDocTemplate::Opened {
    CDocument* document = nullptr;
    CFrameWnd* frame = nullptr;
    bool isNew = false;
};

CDocument* CSingleDocTemplate::OpenDocumentFile(LPCSTR path, BOOL makeVisible) {
    Opened opened;
    opened.document = m_pOnlyDoc;
    if (opened.document) {
        if (!opened.document->SaveModified()) {
            return nullptr;
        }
        opened.frame = DYNAMIC_DOWNCAST(CFrameWnd, AfxGetMainWnd());
    } else {
        opened.document = CreateNewDocument();
        opened.isNew = true;
    }
    if (!opened.document) {
        AfxMessageBox(AFX_IDP_FAILED_TO_CREATE_DOC);
        return nullptr;
    }
    if (!opened.frame) {
        // A frame that fails takes its view with it; the document must not delete itself with that.
        const BOOL autoDelete = std::exchange(opened.document->m_bAutoDelete, FALSE);
        opened.frame = CreateNewFrame(opened.document, nullptr);
        opened.document->m_bAutoDelete = autoDelete;
        if (!opened.frame) {
            AfxMessageBox(AFX_IDP_FAILED_TO_CREATE_DOC);
            delete opened.document;
            return nullptr;
        }
    }
    if (!fill(opened, path)) {
        return nullptr;
    }
    CWinApp* app = AfxGetApp();
    if (opened.isNew && app && !app->m_pMainWnd) {
        app->m_pMainWnd = opened.frame;
    }
    InitialUpdateFrame(opened.frame, opened.document, makeVisible);
    return opened.document;
}

bool CSingleDocTemplate::fill(Opened& opened, LPCSTR path) {
    CDocument& document = *opened.document;
    const auto giveUp = [&opened] {
        if (opened.isNew) {
            opened.frame->DestroyWindow(); // the document goes with its view
        }
        return false;
    };
    if (!path) {
        SetDefaultTitle(&document);
        return document.OnNewDocument() || giveUp();
    }
    const BOOL wasModified = document.IsModified();
    document.SetModifiedFlag(FALSE);
    if (document.OnOpenDocument(path)) {
        document.SetPathName(path);
        return true;
    }
    if (!opened.isNew && !document.IsModified()) {
        document.SetModifiedFlag(wasModified); // nothing has been touched
    } else if (!opened.isNew) {
        // The file was found but not understood: go on with an empty document under no name.
        SetDefaultTitle(&document);
        document.OnNewDocument();
        document.UpdateAllViews(nullptr);
    }
    return giveUp();
}
