#pragma once

/// @file
/// Frames, documents and views that tests work in, and the acts of a user.

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/frames/DocManager.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/MdiFrame.h"
#include "platform/afx/frames/StatusBar.h"
#include "platform/afx/frames/ToolBar.h"
#include "platform/afx/frames/View.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/base/SystemPath.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/afx/frames/FrameTestIds.h"

#include <QAbstractButton>
#include <QApplication>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QTest>
#include <QTimer>

#include <filesystem>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace frametest {

/// What the handlers of the classes below did, in order.
inline std::vector<std::string>& journal() {
    static std::vector<std::string> lines;
    return lines;
}
inline void note(std::string line) {
    journal().push_back(std::move(line));
}
inline bool noted(const std::string& line) {
    return std::find(journal().begin(), journal().end(), line) != journal().end();
}

/// A document that is one text.
class Note : public CDocument {
    DECLARE_DYNCREATE(Note)

public:
    CString text;
    bool failsHalfWay = false;

    void Serialize(CArchive& archive) override;
    void DeleteContents() override;
    afx_msg void OnDoc();

protected:
    DECLARE_MESSAGE_MAP()
};

class NoteView : public CView {
    DECLARE_DYNCREATE(NoteView)

public:
    bool grid = false;
    bool large = false;
    int updates = 0;
    LPARAM lastHint = -1;

    Note* note() const {
        return static_cast<Note*>(GetDocument());
    }
    void OnDraw(CDC* dc) override;
    void OnUpdate(CView* sender, LPARAM hint, CObject* object) override;

    afx_msg void OnDrawShape();
    afx_msg void OnGrid();
    afx_msg void OnUpdateGrid(CCmdUI* item);
    afx_msg void OnLocked();
    afx_msg void OnUpdateLocked(CCmdUI* item);
    afx_msg void OnSize1(UINT id);
    afx_msg void OnUpdateSize(CCmdUI* item);

protected:
    DECLARE_MESSAGE_MAP()
};

/// A frame with a tool bar and a status bar; `Base` is CFrameWnd or CMDIFrameWnd.
class NoteFrame : public CFrameWnd {
    DECLARE_DYNCREATE(NoteFrame)

public:
    CToolBar tools;
    CStatusBar status;

    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnFrame();

protected:
    DECLARE_MESSAGE_MAP()
};

class BoardsFrame : public CMDIFrameWnd {
    DECLARE_DYNCREATE(BoardsFrame)

public:
    CStatusBar status;
    afx_msg int OnCreate(CREATESTRUCT* cs);

protected:
    DECLARE_MESSAGE_MAP()
};

/// Makes the application object's windows and takes them down again.
class FrameTest : public testing::Test {
protected:
    void SetUp() override;
    void TearDown() override;

    /// The main frame of a note with one view, shown and active.
    NoteFrame& openNote();
    /// The main frame of boards without any, shown and active.
    BoardsFrame& openBoards();
    /// The same, not shown yet.
    BoardsFrame& makeBoards();
    CMultiDocTemplate& boards() const {
        return *m_boards;
    }
    NoteView& view() const;
    Note& document() const;
    std::filesystem::path file(const std::string& name) const {
        return m_folder / name;
    }
    /// The file's name as the framework hands it out.
    CString driveName(const std::string& name) const {
        return tvx::driveName(file(name).string()).c_str();
    }

private:
    void showMain(CFrameWnd& frame);
    std::filesystem::path m_folder;
    CMultiDocTemplate* m_boards = nullptr;
};

inline QMainWindow* widgetOf(const CFrameWnd& frame) {
    return tvx::afx::mainWindowOf(*frame.GetState());
}
inline std::string titleOf(const CWnd& window) {
    CString text;
    window.GetWindowText(text);
    return text.GetString();
}
/// Does what the loop does when no message waits.
void idle();
/// Lets posted messages and pending paints happen.
void settle();
/// Presses a key where the keyboard is.
void key(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
/// The menu that is open, null when none is.
QMenu* openMenu();
/// The item of an open menu with this text (without "&" and shortcut).
QAction* itemOf(const QMenu& menu, const QString& text);
/// Clicks an entry of a frame's menu bar.
QMenu* clickBar(const CFrameWnd& frame, const QString& text);
/// Clicks an item of an open menu.
void clickItem(QMenu& menu, const QString& text);
std::string contents(const std::filesystem::path& path);
void write(const std::filesystem::path& path, const std::string& text);

/// Waits for a message box, notes its text and presses the button with an answer.
class BoxAnswer {
public:
    explicit BoxAnswer(const QString& button);
    std::vector<std::string> texts;

private:
    QTimer m_timer;
};

/// Does something in the next nested loop.
void later(std::function<void()> act);

} // namespace frametest
