#pragma once

#include "Drawing.h"
#include "afxwin.h"

/// A drawing, with its file and the changes that Undo goes through.
class CBoardDoc : public CDocument {
    DECLARE_DYNCREATE(CBoardDoc)

public:
    ~CBoardDoc() override;

    /// The drawing that the user worked with last; null when there is none.
    static CBoardDoc* GetCurrent();
    /// Makes this one the current drawing.
    void MakeCurrent();
    /// What is wrong with a drawing, in the user's language.
    static CString Sentence(const board::ReadResult& result);

    const board::Drawing& GetDrawing() const {
        return m_drawing;
    }
    /// Makes a change that can be undone. The views are told of it: their hint is a pointer to the board::Change.
    void Change(board::Change change);
    /// Takes the last change back, or makes the one again that was taken back. Answers whether there was one.
    /// @{
    bool Undo();
    bool Redo();
    /// @}

    BOOL OnOpenDocument(LPCSTR path) override;
    BOOL OnSaveDocument(LPCSTR path) override;
    void DeleteContents() override;

    afx_msg void OnEditUndo();
    afx_msg void OnEditRedo();
    afx_msg void OnUpdateEditUndo(CCmdUI* item);
    afx_msg void OnUpdateEditRedo(CCmdUI* item);

private:
    /// Adopts what was read, or tells the user what is wrong with it.
    BOOL Take(const char* path, const std::string& text);
    void Changed(const board::Change& change);

    board::Drawing m_drawing;
    board::History m_history;

    DECLARE_MESSAGE_MAP()
};
