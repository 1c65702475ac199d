#pragma once

/// @file
/// CDocument: what an application edits, apart from how it is shown.

#include "platform/afx/core/MessageMap.h"
#include "platform/base/Archive.h"
#include "platform/base/File.h"
#include "platform/base/List.h"

#include <vector>

class CDocTemplate;
class CFrameWnd;
class CView;

/// The data of one file, or of one that has not been saved yet. Its template makes it; it deletes itself when its last
/// view is gone, unless m_bAutoDelete is FALSE.
///
/// A derived class keeps the data, stores and loads it in Serialize, empties it in DeleteContents, and calls
/// SetModifiedFlag and UpdateAllViews after each change.
///
/// Saving never destroys what was saved before: the file is written beside the old one and takes its place when all of
/// it has been written. Permissions stay, a symbolic link goes on pointing to the file.
class TVX_PLATFORM_API CDocument : public CCmdTarget {
    DECLARE_DYNAMIC(CDocument)

public:
    CDocument() = default;
    ~CDocument() override;

    /// Whether the document deletes itself when its last view is gone. TRUE at first.
    BOOL m_bAutoDelete = TRUE;

    // --- name and state ---

    /// The title: the file's name or "Board1".
    const CString& GetTitle() const {
        return m_strTitle;
    }
    /// Changes the title and the captions of all frames.
    virtual void SetTitle(LPCSTR title);
    /// The file's full name, empty while there is none.
    const CString& GetPathName() const {
        return m_strPathName;
    }
    /// Names the file; the title becomes its last part.
    /// @param addToRecent whether it becomes the first of the recent files
    virtual void SetPathName(LPCSTR path, BOOL addToRecent = TRUE);
    /// The template that made the document and lists it, null for a document made without one.
    CDocTemplate* GetDocTemplate() const {
        return m_pDocTemplate;
    }
    /// Whether there are changes that have not been saved.
    virtual BOOL IsModified() {
        return m_bModified;
    }
    /// Notes that the contents have changed or, with FALSE, that they are as saved. It changes no caption.
    virtual void SetModifiedFlag(BOOL modified = TRUE) {
        m_bModified = modified;
    }

    // --- views ---

    /// Ties a view to this document. The framework does it when a view is created.
    void AddView(CView* view);
    /// Unties a view; the last one's end deletes the document.
    void RemoveView(CView* view);
    /// Where a walk over the views begins; null when there is none.
    virtual POSITION GetFirstViewPosition() const;
    /// The view at a position, which moves on to the next one; null position: no more.
    virtual CView* GetNextView(POSITION& position) const;
    /// Tells every view but `sender` (null: every view) of a change.
    /// @param hint,object kept for the views' OnUpdate: what has changed
    void UpdateAllViews(CView* sender, LPARAM hint = 0, CObject* object = nullptr);
    /// Called when a view was added or removed. The base numbers the frames' captions and deletes the document when no
    /// view is left.
    virtual void OnChangedViewList();
    /// Puts numbers (":1", ":2") behind the title where several frames show this document, and updates the captions.
    virtual void UpdateFrameCounts();
    /// Calls OnInitialUpdate of every view: for a host that fills the document anew by other means than opening a file.
    void SendInitialUpdate();

    // --- life of the contents; FALSE means that it failed or was refused and the user has been told ---

    /// Empties the document. Called before a new or opened one begins and when it is closed.
    virtual void DeleteContents();
    /// Begins an empty document: the base calls DeleteContents and forgets name and changes. A derived class calls it
    /// first.
    virtual BOOL OnNewDocument();
    /// Loads a file through Serialize.
    virtual BOOL OnOpenDocument(LPCSTR path);
    /// Stores into a file through Serialize.
    virtual BOOL OnSaveDocument(LPCSTR path);
    /// Ends the document: destroys the frames that show only it, empties it and deletes it.
    virtual void OnCloseDocument();
    /// Tells the user why loading or saving failed.
    /// @param error what was raised, null when nothing was
    /// @param saving whether it happened while saving
    /// @param fallback the string for errors without a description of their own
    virtual void ReportSaveLoadException(LPCSTR path, CException* error, BOOL saving, UINT fallback);
    /// Opens the file for loading (modeRead) or storing (modeCreate). Answers an object that ReleaseFile ends, or null
    /// with the reason in `error`. The base writes beside the file; see the class.
    virtual CFile* GetFile(LPCSTR fileName, UINT openFlags, CFileException* error);
    /// Ends the use of a file that GetFile answered.
    /// @param abort TRUE leaves the file on disk as it was
    virtual void ReleaseFile(CFile* file, BOOL abort);

    // --- closing and saving ---

    /// Whether a frame of this document may be closed. Asks about changes when it is the last one.
    virtual BOOL CanCloseFrame(CFrameWnd* frame);
    /// Asks about unsaved changes and saves when the user wants it. FALSE when the user cancelled or saving failed.
    virtual BOOL SaveModified();
    /// Saves under the present name, or asks for one when there is none or the file may not be written.
    virtual BOOL DoFileSave();
    /// Saves under `path`; null or empty asks for a name.
    /// @param replace whether the document goes on under the new name
    virtual BOOL DoSave(LPCSTR path, BOOL replace = TRUE);
    /// Called before the document is closed by its template or the application.
    virtual void PreCloseFrame(CFrameWnd* frame);
    /// Called when the application is idle.
    virtual void OnIdle();

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;

    /// File Save, File Save As and File Close, bound by this class.
    /// @{
    afx_msg void OnFileSave();
    afx_msg void OnFileSaveAs();
    afx_msg void OnFileClose();
    /// @}

protected:
    friend class CDocTemplate;
    friend class CSingleDocTemplate;

    CString m_strTitle;
    CString m_strPathName;
    CDocTemplate* m_pDocTemplate = nullptr;
    BOOL m_bModified = FALSE;

    DECLARE_MESSAGE_MAP()

private:
    void disconnectViews();
    std::vector<CFrameWnd*> frames() const;
    bool askForPath(CString& path, BOOL replace);
    std::vector<CView*> m_views;
    bool m_embedded = false;
};
