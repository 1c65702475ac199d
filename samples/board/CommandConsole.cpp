#include "CommandConsole.h"

#include "Board.h"
#include "Resource.h"
#include "platform/base/SystemPath.h"
#include "s/FileName.h"
#include "s/Msg.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <utility>

using board::Change;
using board::Drawing;

namespace {

constexpr ULONGLONG largestScript = 1024 * 1024;
constexpr std::size_t deepestScript = 20;

/// The field's callback knows no object.
CCommandConsole* theConsole = nullptr;

/// The first word of a text; the rest, without blanks around it, stays.
CString TakeWord(CString& text) {
    text.Trim();
    const int end = text.FindOneOf(" \t");
    const CString word = end == -1 ? text : text.Left(end);
    text = end == -1 ? CString() : text.Mid(end).Trim();
    return word;
}

/// A file's name, which may stand in quotes.
CString FileWord(CString words) {
    words.Trim();
    const int length = words.GetLength();
    const bool quoted = length >= 2 && words[0] == '"' && words[length - 1] == '"';
    return quoted ? words.Mid(1, length - 2) : words;
}

bool IsNumber(const CString& word, int& number) {
    const char* const end = word.GetString() + word.GetLength();
    const auto result = std::from_chars(word.GetString(), end, number);
    return !word.IsEmpty() && result.ec == std::errc() && result.ptr == end;
}

CString Reason(const CException& problem) {
    char reason[512] = {};
    problem.GetErrorMessage(reason, sizeof(reason));
    return reason;
}

/// Gives a variable another value as long as this lives, also when the host throws.
template <class Value>
class Restored {
public:
    Restored(Value& place, Value now) : m_place(place), m_before(std::exchange(place, std::move(now))) {}
    ~Restored() {
        m_place = std::move(m_before);
    }
    Restored(const Restored&) = delete;
    Restored& operator=(const Restored&) = delete;

private:
    Value& m_place;
    Value m_before;
};

CString ShownName(const CString& path) {
    return tvx::shownName(path.GetString()).c_str();
}

} // namespace

// The order is that of the texts from IDS_COMMAND_FIRST on.
const CCommandConsole::Command CCommandConsole::commands[] = {
    {"new", &CCommandConsole::OnNew, false},      {"open", &CCommandConsole::OnOpen, false},
    {"save", &CCommandConsole::OnSave, true},     {"close", &CCommandConsole::OnClose, true},
    {"list", &CCommandConsole::OnList, true},     {"draw", &CCommandConsole::OnDraw, true},
    {"delete", &CCommandConsole::OnDelete, true}, {"front", &CCommandConsole::OnFront, true},
    {"back", &CCommandConsole::OnBack, true},     {"undo", &CCommandConsole::OnUndo, true},
    {"redo", &CCommandConsole::OnRedo, true},     {"set", &CCommandConsole::OnSet, false},
    {"run", &CCommandConsole::OnRun, false},      {"help", &CCommandConsole::OnHelp, false},
};

CCommandConsole::CCommandConsole() : m_console(OnCommand, 0) {
    theConsole = this;
}

void CCommandConsole::Init() {
    m_console.Init();
    SetOptions(theApp.GetOptions());
}

void CCommandConsole::SetOptions(const Options& options) {
    m_console.SetShowCommandStatusFlag(options.showStatus);
    m_console.SetKeepRecallFlag(options.keepCommands);
}

void CCommandConsole::Open() {
    m_console.Open();
}

// --- running ---

int CCommandConsole::OnCommand(const char* text) {
    Gui_Console& console = theConsole->m_console;
    console.AddCommand(text);
    const bool done = theConsole->Execute(text);
    // A drawing that was opened has the keyboard now, but the user goes on typing commands.
    if (console.IsOpen()) {
        console.Open();
    }
    return done ? 1 : 0;
}

bool CCommandConsole::Execute(const CString& text) {
    CString words = text;
    const CString name = TakeWord(words);
    const auto* command = std::find_if(std::begin(commands), std::end(commands),
                                       [&](const Command& known) { return name.CompareNoCase(known.name) == 0; });
    if (command == std::end(commands)) {
        Report(IDS_COMMAND_UNKNOWN, name);
        return false;
    }
    if (command->needsDrawing && !CBoardDoc::GetCurrent()) {
        Report(IDS_COMMAND_NO_DRAWING);
        return false;
    }
    const Restored<const Command*> running(m_running, command);
    return (this->*command->run)(words);
}

// --- files ---

bool CCommandConsole::OnNew(const CString& words) {
    if (!words.IsEmpty()) {
        return Expected();
    }
    const CBoardDoc* const before = CBoardDoc::GetCurrent();
    theApp.OnFileNew();
    const CBoardDoc* const drawing = CBoardDoc::GetCurrent();
    if (!drawing || drawing == before) {
        Report(IDS_COMMAND_NO_DRAWING);
        return false;
    }
    Report(IDS_COMMAND_NEW_DONE, drawing->GetTitle());
    return true;
}

bool CCommandConsole::OnOpen(const CString& words) {
    const CString word = FileWord(words);
    if (word.IsEmpty()) {
        return Expected();
    }
    const CString path = Gui_FileName(CBoardApp::DrawingName(word)).GetFullName();
    // What is wrong with the file has been told in a message box when there is no document.
    const bool done = theApp.OpenDocumentFile(path) != nullptr;
    Report(done ? IDS_COMMAND_OPEN_DONE : IDS_COMMAND_OPEN_FAILED, ShownName(path));
    return done;
}

bool CCommandConsole::OnSave(const CString& words) {
    CBoardDoc& drawing = *CBoardDoc::GetCurrent();
    const CString word = FileWord(words);
    CString path = drawing.GetPathName();
    if (word.IsEmpty() && path.IsEmpty()) {
        return Expected();
    }
    if (!word.IsEmpty()) {
        Gui_FileName name(word);
        if (!name.HasExtension()) {
            name.SetExtension("brd");
        }
        const CString chosen = name.GetFullName();
        if (name.Exists() && tvx::systemPath(chosen.View()) != tvx::systemPath(path.View())) {
            Report(IDS_COMMAND_FILE_EXISTS, ShownName(chosen));
            return false;
        }
        path = chosen;
    }
    const bool done = drawing.DoSave(path) != FALSE;
    Report(done ? IDS_COMMAND_SAVE_DONE : IDS_COMMAND_SAVE_FAILED, ShownName(path));
    return done;
}

bool CCommandConsole::OnClose(const CString& words) {
    CBoardDoc& drawing = *CBoardDoc::GetCurrent();
    const CString title = drawing.GetTitle();
    if (!words.IsEmpty()) {
        return Expected();
    }
    if (!drawing.SaveModified()) {
        Report(IDS_COMMAND_CLOSE_FAILED, title);
        return false;
    }
    drawing.OnCloseDocument();
    Report(IDS_COMMAND_CLOSE_DONE, title);
    return true;
}

// --- shapes ---

bool CCommandConsole::OnList(const CString& words) {
    if (!words.IsEmpty()) {
        return Expected();
    }
    const Drawing& drawing = CBoardDoc::GetCurrent()->GetDrawing();
    CString title = CBoardDoc::GetCurrent()->GetTitle();
    CString count;
    count.Format("%zu", drawing.shapes.size());
    Report((Gui_Msg(IDS_COMMAND_LIST_DONE) << title << count).GetValue());
    int number = 0;
    for (const board::Shape& shape : drawing.shapes) {
        CString line;
        line.Format("%d: %s", ++number, board::writeShape(shape).c_str());
        Report(line);
    }
    return true;
}

bool CCommandConsole::OnDraw(const CString& words) {
    if (words.IsEmpty()) {
        return Expected();
    }
    // The words are a line of a drawing's file.
    CBoardDoc& document = *CBoardDoc::GetCurrent();
    board::ReadResult result = board::readDrawing(("board 1\n" + words).GetString());
    if (!result.ok()) {
        Report(CBoardDoc::Sentence(result));
        return Expected();
    }
    if (result.drawing.shapes.empty()) {
        return Expected();
    }
    document.Change(Change::addition(document.GetDrawing(), std::move(result.drawing.shapes.front())));
    CString number;
    number.Format("%zu", document.GetDrawing().shapes.size());
    Report(IDS_COMMAND_DRAW_DONE, number);
    return true;
}

int CCommandConsole::ShapeNumber(const CString& words) {
    const auto count = static_cast<int>(CBoardDoc::GetCurrent()->GetDrawing().shapes.size());
    int number = 0;
    if (IsNumber(words, number) && number >= 1 && number <= count) {
        return number - 1;
    }
    Expected();
    CString most;
    most.Format("%d", count);
    Report(count > 0 ? IDS_COMMAND_SHAPE_RANGE : IDS_COMMAND_NO_SHAPES, most);
    return -1;
}

bool CCommandConsole::ChangeShape(const CString& words, UINT doneId, Change (*change)(const Drawing&, int)) {
    const int number = ShapeNumber(words);
    if (number == -1) {
        return false;
    }
    CBoardDoc& document = *CBoardDoc::GetCurrent();
    document.Change(change(document.GetDrawing(), number));
    Report(doneId, words);
    return true;
}

bool CCommandConsole::OnDelete(const CString& words) {
    return ChangeShape(words, IDS_COMMAND_DELETE_DONE,
                       [](const Drawing& drawing, int number) { return Change::deletion(drawing, number); });
}

bool CCommandConsole::OnFront(const CString& words) {
    return ChangeShape(words, IDS_COMMAND_FRONT_DONE, [](const Drawing& drawing, int number) {
        return Change::move(drawing, number, static_cast<int>(drawing.shapes.size()) - 1);
    });
}

bool CCommandConsole::OnBack(const CString& words) {
    return ChangeShape(words, IDS_COMMAND_BACK_DONE,
                       [](const Drawing& drawing, int number) { return Change::move(drawing, number, 0); });
}

bool CCommandConsole::OnUndo(const CString& words) {
    if (!words.IsEmpty()) {
        return Expected();
    }
    const bool done = CBoardDoc::GetCurrent()->Undo();
    Report(done ? IDS_COMMAND_UNDO_DONE : IDS_COMMAND_UNDO_NOTHING);
    return done;
}

bool CCommandConsole::OnRedo(const CString& words) {
    if (!words.IsEmpty()) {
        return Expected();
    }
    const bool done = CBoardDoc::GetCurrent()->Redo();
    Report(done ? IDS_COMMAND_REDO_DONE : IDS_COMMAND_REDO_NOTHING);
    return done;
}

// --- settings ---

bool CCommandConsole::OnSet(const CString& words) {
    CString value = words;
    const CString name = TakeWord(value);
    if (name.IsEmpty()) {
        ListSettings();
        return true;
    }
    if (name.CompareNoCase("grid") == 0) {
        return SetGrid(value);
    }
    if (name.CompareNoCase("status") == 0) {
        return SetFlag(value, &CCommandConsole::ShowStatus);
    }
    if (name.CompareNoCase("keep") == 0) {
        return SetFlag(value, &CCommandConsole::KeepCommands);
    }
    return Expected();
}

bool CCommandConsole::SetGrid(const CString& value) {
    int distance = 0;
    if (!IsNumber(value, distance) || distance < 0 || distance > 1000) {
        return Expected();
    }
    Options options = theApp.GetOptions();
    options.gridDistance = distance;
    theApp.SetOptions(options);
    Report("grid " + value);
    return true;
}

bool CCommandConsole::SetFlag(const CString& value, void (CCommandConsole::*set)(bool)) {
    const bool on = value.CompareNoCase("on") == 0;
    if (!on && value.CompareNoCase("off") != 0) {
        return Expected();
    }
    (this->*set)(on);
    ListSettings();
    return true;
}

void CCommandConsole::ShowStatus(bool show) {
    Options options = theApp.GetOptions();
    options.showStatus = show;
    theApp.SetOptions(options);
}

void CCommandConsole::KeepCommands(bool keep) {
    Options options = theApp.GetOptions();
    options.keepCommands = keep;
    theApp.SetOptions(options);
    theApp.WriteProfileInt("Settings", "KeepCommands", keep ? 1 : 0);
}

void CCommandConsole::ListSettings() {
    CString grid;
    grid.Format("grid %d", theApp.GetOptions().gridDistance);
    Report(grid);
    Report(m_console.GetShowCommandStatusFlag() ? "status on" : "status off");
    Report(m_console.GetKeepRecallFlag() ? "keep on" : "keep off");
}

// --- scripts ---

bool CCommandConsole::OnRun(const CString& words) {
    const CString word = FileWord(words);
    if (word.IsEmpty()) {
        return Expected();
    }
    const CString path = Gui_FileName(word).GetFullName();
    const bool runs = std::find(m_scripts.begin(), m_scripts.end(), path) != m_scripts.end();
    if (runs || m_scripts.size() == deepestScript) {
        Report(IDS_COMMAND_SCRIPT_RUNS, ShownName(path));
        return false;
    }
    std::vector<CString> scripts = m_scripts;
    scripts.push_back(path);
    const Restored<std::vector<CString>> running(m_scripts, std::move(scripts));
    return ExecuteFile(path);
}

bool CCommandConsole::ExecuteFile(const CString& path) {
    std::vector<CString> lines;
    if (!ReadLines(path, lines)) {
        return false;
    }
    int number = 0;
    int count = 0;
    for (CString line : lines) {
        ++number;
        line.Trim();
        if (line.IsEmpty() || line[0] == '#') {
            continue;
        }
        ++count;
        if (!Execute(line)) {
            CString at;
            at.Format("%d", number);
            Report((Gui_Msg(IDS_COMMAND_SCRIPT_STOPPED) << ShownName(path) << at << line).GetValue());
            return false;
        }
    }
    CString all;
    all.Format("%d", count);
    Report((Gui_Msg(IDS_COMMAND_SCRIPT_DONE) << ShownName(path) << all).GetValue());
    return true;
}

bool CCommandConsole::ReadLines(const CString& path, std::vector<CString>& lines) {
    CFile file;
    CFileException error;
    if (!file.Open(path, CFile::modeRead | CFile::shareDenyWrite, &error)) {
        Report(Reason(error));
        return false;
    }
    std::string text;
    try {
        const ULONGLONG length = file.GetLength();
        if (length <= largestScript) {
            text.resize(length);
            text.resize(file.Read(text.data(), static_cast<UINT>(length)));
        }
        if (length > largestScript || text.find('\0') != std::string::npos) {
            Report(IDS_COMMAND_NO_SCRIPT, ShownName(path));
            return false;
        }
    } catch (CException* problem) {
        Report(Reason(*problem));
        problem->Delete();
        return false;
    }
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\n', at), text.size());
        lines.emplace_back(text.substr(at, end - at).c_str());
        at = end + 1;
    }
    return true;
}

// --- reporting ---

bool CCommandConsole::OnHelp(const CString& words) {
    bool found = false;
    for (const Command& command : commands) {
        if (words.IsEmpty() || words.CompareNoCase(command.name) == 0) {
            CString text;
            text.LoadString(IDS_COMMAND_FIRST + static_cast<UINT>(&command - commands));
            Report(text);
            found = true;
        }
    }
    return found || Expected();
}

bool CCommandConsole::Expected() {
    CString text;
    text.LoadString(IDS_COMMAND_FIRST + static_cast<UINT>(m_running - commands));
    Report(IDS_COMMAND_EXPECTED, text);
    return false;
}

void CCommandConsole::Report(UINT id) {
    CString text;
    text.LoadString(id);
    Report(text);
}

void CCommandConsole::Report(UINT id, const CString& detail) {
    Report((Gui_Msg(id) << detail).GetValue());
}

void CCommandConsole::Report(const CString& text) {
    m_console.AddStatusLine(text);
    auto* const frame = static_cast<CFrameWnd*>(theApp.m_pMainWnd);
    if (frame) {
        frame->SetMessageText(text);
    }
}
