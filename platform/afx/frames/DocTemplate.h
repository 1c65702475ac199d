#pragma once

/// @file
/// Document templates: which classes and resources make a kind of document.

#include "platform/afx/core/CmdTarget.h"
#include "platform/afx/frames/Frame.h"
#include "platform/base/List.h"

#include <vector>

class CDocument;
class CFrameWnd;

/// Ties together the document, frame and view classes of one kind of document and its resources. Made with `new` in
/// InitInstance and given to CWinApp::AddDocTemplate, which owns it from then on.
///
/// The string of its number has seven parts, with line ends between them; see DocStringIndex.
///
/// @code
/// AddDocTemplate(new CMultiDocTemplate(IDR_BOARDTYPE, RUNTIME_CLASS(CBoardDoc), RUNTIME_CLASS(CMDIChildWnd),
///                                      RUNTIME_CLASS(CBoardView)));
/// @endcode
class TVX_PLATFORM_API CDocTemplate : public CCmdTarget {
    DECLARE_DYNAMIC(CDocTemplate)

public:
    /// Parts of the string resource.
    enum DocStringIndex {
        windowTitle, ///< the application's title; for single documents only
        docName,     ///< first part of a new document's title: "Board" makes "Board1"
        fileNewName, ///< name of the kind in the choice of File New; empty keeps the kind out of it
        filterName,  ///< description in file dialogs: "Boards (*.brd)"
        filterExt,   ///< extension with its dot: ".brd"
        regFileTypeId,
        regFileTypeName
    };
    /// How well a file fits a template.
    enum Confidence {
        noAttempt,
        maybeAttemptForeign,
        maybeAttemptNative,
        yesAttemptForeign,
        yesAttemptNative,
        yesAlreadyOpen
    };

    ~CDocTemplate() override;

    /// A part of the string. FALSE when it is missing; `text` is empty then.
    virtual BOOL GetDocString(CString& text, DocStringIndex index) const;
    /// How well a file fits. The base compares the extension, without case.
    /// @param match receives the document when it is open already
    virtual Confidence MatchDocType(LPCSTR path, CDocument*& match);

    // --- documents ---

    /// Where a walk over the open documents begins; null when there is none.
    virtual POSITION GetFirstDocPosition() const = 0;
    /// The document at a position, which moves on to the next one; null position: no more. Do not
    /// close documents during the walk.
    virtual CDocument* GetNextDoc(POSITION& position) const = 0;
    /// Takes a document into the list of open ones. CreateNewDocument calls it.
    virtual void AddDocument(CDocument* document);
    /// Takes a document out of the list. The document's destructor calls it.
    virtual void RemoveDocument(CDocument* document);
    /// A new, empty document object of the template's class. Null when it cannot be made.
    virtual CDocument* CreateNewDocument();
    /// A frame with a view for a document, not shown yet. Null when that failed.
    /// @param other the frame the new one is modelled on, null for none
    virtual CFrameWnd* CreateNewFrame(CDocument* document, CFrameWnd* other);
    /// Sends the first update and shows the frame.
    virtual void InitialUpdateFrame(CFrameWnd* frame, CDocument* document, BOOL makeVisible = TRUE);
    /// Opens a file in a document with a frame of its own; null makes an empty document. Null when it failed; the user
    /// has been told.
    virtual CDocument* OpenDocumentFile(LPCSTR path, BOOL makeVisible = TRUE) = 0;
    /// Gives a document the title of a new one: the document name and a number.
    virtual void SetDefaultTitle(CDocument* document) = 0;
    /// Asks for each modified document. FALSE when the user cancelled.
    virtual BOOL SaveAllModified();
    /// Closes all documents of this kind without asking.
    /// @param endSession not used by the base
    virtual void CloseAllDocuments(BOOL endSession);
    /// Loads the resources that the frames share. Called by AddDocTemplate.
    virtual void LoadTemplate();

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    /// Hands idle time on to each open document.
    void OnIdle();

    /// Whether the application object deletes the template. TRUE.
    BOOL m_bAutoDelete = TRUE;

protected:
    CDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass, CRuntimeClass* viewClass);

    UINT m_nIDResource;
    CRuntimeClass* m_pDocClass;
    CRuntimeClass* m_pFrameClass;
    CRuntimeClass* m_pViewClass;
    CString m_strDocStrings;
};

/// The template of an application that has one document at a time. Its frame is the application's main window.
class TVX_PLATFORM_API CSingleDocTemplate : public CDocTemplate {
    DECLARE_DYNAMIC(CSingleDocTemplate)

public:
    /// @param id number of the menu, accelerators, icon and string
    /// @param docClass,frameClass,viewClass classes that can be made by name (DECLARE_DYNCREATE)
    CSingleDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass, CRuntimeClass* viewClass);
    ~CSingleDocTemplate() override;

    void AddDocument(CDocument* document) override;
    void RemoveDocument(CDocument* document) override;
    POSITION GetFirstDocPosition() const override;
    CDocument* GetNextDoc(POSITION& position) const override;
    /// The document is opened in the existing one when there is one; its changes are asked about first.
    CDocument* OpenDocumentFile(LPCSTR path, BOOL makeVisible = TRUE) override;
    void SetDefaultTitle(CDocument* document) override;

protected:
    CDocument* m_pOnlyDoc = nullptr;

private:
    struct Opened;
    bool fill(Opened& opened, LPCSTR path);
};

/// The template of an application whose documents have child frames in one main window.
class TVX_PLATFORM_API CMultiDocTemplate : public CDocTemplate {
    DECLARE_DYNAMIC(CMultiDocTemplate)

public:
    /// @param id number of the child frames' menu, accelerators, icon and string
    /// @param docClass,frameClass,viewClass classes that can be made by name; the frame's is CMDIChildWnd or derived
    /// from it
    CMultiDocTemplate(UINT id, CRuntimeClass* docClass, CRuntimeClass* frameClass, CRuntimeClass* viewClass);
    ~CMultiDocTemplate() override;

    /// The menu and the accelerators that are in force while one of its frames is active; null for the main frame's.
    HMENU m_hMenuShared = nullptr;
    HACCEL m_hAccelTable = nullptr;

    void LoadTemplate() override;
    void AddDocument(CDocument* document) override;
    void RemoveDocument(CDocument* document) override;
    POSITION GetFirstDocPosition() const override;
    CDocument* GetNextDoc(POSITION& position) const override;
    CDocument* OpenDocumentFile(LPCSTR path, BOOL makeVisible = TRUE) override;
    void SetDefaultTitle(CDocument* document) override;

protected:
    std::vector<CDocument*> m_documents;
    UINT m_nUntitledCount = 0;
};
