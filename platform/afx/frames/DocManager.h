#pragma once

/// @file
/// CDocManager: the templates of an application, and the commands that make and open documents.

#include "platform/afx/frames/DocTemplate.h"
#include "platform/base/List.h"

/// Holds the document templates. The application object makes one when its first template is added, unless a class
/// derived from it stands in CWinApp::m_pDocManager already; it deletes it in its destructor.
class TVX_PLATFORM_API CDocManager : public CObject {
    DECLARE_DYNCREATE(CDocManager)

public:
    CDocManager() = default;
    /// Deletes the templates.
    ~CDocManager() override;

    /// Takes a template over. Adding one a second time changes nothing.
    virtual void AddDocTemplate(CDocTemplate* docTemplate);
    /// Where a walk over the templates begins, in the order they were added; null when there is none.
    virtual POSITION GetFirstDocTemplatePosition() const;
    /// The template at a position, which moves on to the next one; null position: no more. The template stays this
    /// object's.
    virtual CDocTemplate* GetNextDocTemplate(POSITION& position) const;
    /// File New: makes a document; where several templates have a name for File New, the user chooses.
    virtual void OnFileNew();
    /// File Open: asks for a file and opens it.
    virtual void OnFileOpen();
    /// Asks the user for a file name.
    /// @param fileName   in: the name shown first; out: the chosen one, unchanged when the user cancelled
    /// @param titleId    string that becomes the dialog's title
    /// @param flags      OFN_... bits
    /// @param openDialog TRUE to open a file, FALSE to save one
    /// @param docTemplate whose filter is offered; null for those of all templates
    /// @return whether a name was chosen
    virtual BOOL DoPromptFileName(CString& fileName, UINT titleId, DWORD flags, BOOL openDialog,
                                  CDocTemplate* docTemplate);
    /// Opens a file with the template that fits it best, or activates it when it is open already. Null when it failed.
    virtual CDocument* OpenDocumentFile(LPCSTR fileName);
    /// Asks for each modified document of all templates. FALSE at the first one that the user cancelled or that could
    /// not be saved; those before it have been saved.
    virtual BOOL SaveAllModified();
    /// Closes all documents without asking; call SaveAllModified first.
    /// @param endSession handed on to the templates
    virtual void CloseAllDocuments(BOOL endSession);
    /// Number of open documents of all templates.
    virtual int GetOpenDocumentCount();

protected:
    std::vector<CDocTemplate*> m_templates;

private:
    CDocTemplate* bestTemplate(LPCSTR fileName, CDocument*& open) const;
    CDocTemplate* chooseTemplate() const;
};
