#include "BoardView.h"

#include "Board.h"
#include "BoardColors.h"
#include "Resource.h"
#include "ShapePainter.h"
#include "TextDialog.h"

#include <algorithm>
#include <array>

using namespace board;

namespace {

/// Half the width of a handle, in pixels.
constexpr int handleReach = 4;
/// A drag shorter than this draws nothing, in pixels.
constexpr int leastDrag = 4;

std::array<Point, 4> cornersOf(const Shape& shape) {
    return {{shape.from, {shape.to.x, shape.from.y}, shape.to, {shape.from.x, shape.to.y}}};
}

bool hasHandle(const Shape& shape, std::size_t handle) {
    return shape.kind != ShapeKind::Line || handle % 2 == 0;
}

void moveHandle(Shape& shape, int handle, Point point) {
    point.x = std::clamp(point.x, -maxCoordinate, maxCoordinate);
    point.y = std::clamp(point.y, -maxCoordinate, maxCoordinate);
    (handle == 0 || handle == 3 ? shape.from.x : shape.to.x) = point.x;
    (handle == 0 || handle == 1 ? shape.from.y : shape.to.y) = point.y;
}

bool isTiny(const Shape& shape) {
    return std::abs(shape.to.x - shape.from.x) < leastDrag && std::abs(shape.to.y - shape.from.y) < leastDrag;
}

} // namespace

IMPLEMENT_DYNCREATE(CBoardView, CScrollView)

// clang-format off
BEGIN_MESSAGE_MAP(CBoardView, CScrollView)
    ON_WM_ERASEBKGND()
    ON_WM_LBUTTONDOWN()
    ON_WM_MOUSEMOVE()
    ON_WM_LBUTTONUP()
    ON_WM_LBUTTONDBLCLK()
    ON_WM_CAPTURECHANGED()
    ON_WM_CONTEXTMENU()
    ON_WM_KEYDOWN()
    ON_WM_SETCURSOR()
    ON_COMMAND_RANGE(ID_TOOL_SELECT, ID_TOOL_TEXT, &CBoardView::OnTool)
    ON_UPDATE_COMMAND_UI_RANGE(ID_TOOL_SELECT, ID_TOOL_TEXT, &CBoardView::OnUpdateTool)
    ON_COMMAND_RANGE(ID_COLOR_FIRST, ID_COLOR_LAST, &CBoardView::OnColor)
    ON_UPDATE_COMMAND_UI_RANGE(ID_COLOR_FIRST, ID_COLOR_LAST, &CBoardView::OnUpdateColor)
    ON_COMMAND_RANGE(ID_FILL_FIRST, ID_FILL_LAST, &CBoardView::OnFill)
    ON_UPDATE_COMMAND_UI_RANGE(ID_FILL_FIRST, ID_FILL_LAST, &CBoardView::OnUpdateFill)
    ON_COMMAND(ID_EDIT_CLEAR, &CBoardView::OnEditClear)
    ON_COMMAND(ID_SHAPE_EDIT_TEXT, &CBoardView::OnEditText)
    ON_COMMAND(ID_SHAPE_TO_FRONT, &CBoardView::OnToFront)
    ON_COMMAND(ID_SHAPE_TO_BACK, &CBoardView::OnToBack)
    ON_UPDATE_COMMAND_UI(ID_EDIT_CLEAR, &CBoardView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_SHAPE_TO_FRONT, &CBoardView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_SHAPE_TO_BACK, &CBoardView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_SHAPE_EDIT_TEXT, &CBoardView::OnUpdateEditText)
    ON_UPDATE_COMMAND_UI(ID_INDICATOR_POSITION, &CBoardView::OnUpdatePosition)
END_MESSAGE_MAP()
// clang-format on

BOOL CBoardView::PreCreateWindow(CREATESTRUCT& cs) {
    if (!CScrollView::PreCreateWindow(cs)) {
        return FALSE;
    }
    cs.lpszClass = AfxRegisterWndClass(CS_DBLCLKS, theApp.LoadStandardCursor(IDC_ARROW),
                                       static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH)));
    return TRUE;
}

// --- showing ---

void CBoardView::OnActivateView(BOOL activate, CView* activated, CView* deactivated) {
    CScrollView::OnActivateView(activate, activated, deactivated);
    if (activate) {
        GetDocument()->MakeCurrent();
    }
}

void CBoardView::OnInitialUpdate() {
    TakeColors();
    ShowScrollArea(); // before the base class, which draws
    CScrollView::OnInitialUpdate();
}

void CBoardView::OnUpdate(CView*, LPARAM hint, CObject*) {
    if (m_selected >= static_cast<int>(GetDocument()->GetDrawing().shapes.size())) {
        m_selected = -1;
    }
    ShowScrollArea();
    const auto* change = reinterpret_cast<const Change*>(hint);
    if (!change) {
        Invalidate();
        return;
    }
    for (const auto* shapes : {&change->removed, &change->added}) {
        for (const Shape& shape : *shapes) {
            InvalidateArea(ReachOf(shape));
        }
    }
    InvalidateMarked();
}

// What was chosen for a new shape stays, unless another choice for all drawings was made.
void CBoardView::OptionsChanged(const Options& before) {
    const Options& now = theApp.GetOptions();
    if (now.outline != before.outline || now.filled != before.filled || now.fill != before.fill) {
        TakeColors();
    }
    Invalidate();
}

void CBoardView::TakeColors() {
    const Options& options = theApp.GetOptions();
    m_color = FromColorRef(options.outline);
    m_fill = options.filled ? FromColorRef(options.fill) : noColor;
}

BOOL CBoardView::OnEraseBkgnd(CDC* dc) {
    CRect area;
    GetClientRect(area);
    dc->FillSolidRect(area, theApp.GetOptions().paper);
    return TRUE;
}

/// The shape that has handles: the draft, else the selected one.
const Shape* CBoardView::Marked() const {
    return m_draft ? &*m_draft : Selected();
}

void CBoardView::InvalidateArea(CRect area) {
    area.InflateRect(handleReach, handleReach);
    area.OffsetRect(-GetScrollPosition());
    InvalidateRect(area);
}

// A large drawing is not drawn again for one shape: only where the shape with the handles was, and where it is now.
void CBoardView::InvalidateMarked() {
    InvalidateArea(m_markedArea);
    if (const Shape* shape = Marked()) {
        InvalidateArea(ReachOf(*shape));
    }
}

void CBoardView::ShowScrollArea() {
    constexpr int margin = 20;
    const Point corner = GetDocument()->GetDrawing().extent();
    SetScrollSizes(MM_TEXT, CSize(corner.x + margin, corner.y + margin));
}

void CBoardView::OnDraw(CDC* dc) {
    DrawGrid(*dc);
    CRect clip;
    dc->GetClipBox(clip);
    const auto& shapes = GetDocument()->GetDrawing().shapes;
    for (int i = 0; i < static_cast<int>(shapes.size()); ++i) {
        const bool drafted = m_draft && !m_draftIsNew && i == m_selected;
        const Shape& shape = drafted ? *m_draft : shapes[i];
        if (CRect().IntersectRect(clip, ReachOf(shape))) {
            DrawShape(*dc, shape, theApp.GetOptions());
        }
    }
    if (m_draft && m_draftIsNew) {
        DrawShape(*dc, *m_draft, theApp.GetOptions());
    }
    const Shape* marked = Marked();
    m_markedArea = marked ? ReachOf(*marked) : CRect();
    if (marked) {
        DrawHandles(*dc, *marked);
    }
}

void CBoardView::DrawGrid(CDC& dc) const {
    const Options& options = theApp.GetOptions();
    const int step = options.gridDistance;
    if (!options.gridShown || step < 4) { // closer points would be a grey area
        return;
    }
    CRect area;
    dc.GetClipBox(area);
    for (int y = area.top - area.top % step; y < area.bottom; y += step) {
        for (int x = area.left - area.left % step; x < area.right; x += step) {
            dc.SetPixelV(x, y, options.gridColor);
        }
    }
}

void CBoardView::DrawHandles(CDC& dc, const Shape& shape) const {
    const auto corners = cornersOf(shape);
    for (std::size_t i = 0; i < corners.size(); ++i) {
        if (hasHandle(shape, i)) {
            CRect handle(CPoint(corners[i].x, corners[i].y), CSize(1, 1));
            handle.InflateRect(handleReach, handleReach);
            dc.FillSolidRect(handle, theApp.GetOptions().handles);
            handle.DeflateRect(1, 1);
            dc.FillSolidRect(handle, theApp.GetOptions().paper);
        }
    }
}

Point CBoardView::ToDrawing(CPoint point) const {
    point += GetScrollPosition();
    return {point.x, point.y};
}

Point CBoardView::Snapped(Point point) const {
    const Options& options = theApp.GetOptions();
    const int step = options.snap ? std::max(options.gridDistance, 1) : 1;
    const auto snap = [step](int value) { return (value + (value < 0 ? -step : step) / 2) / step * step; };
    return {snap(point.x), snap(point.y)};
}

// --- selecting ---

const Shape* CBoardView::Selected() const {
    return m_selected < 0 ? nullptr : &GetDocument()->GetDrawing().shapes[m_selected];
}

void CBoardView::Select(int index) {
    if (index != m_selected) {
        m_selected = index;
        InvalidateMarked();
    }
}

int CBoardView::HandleAt(Point point) const {
    const Shape* shape = Selected();
    if (!shape) {
        return -1;
    }
    const auto corners = cornersOf(*shape);
    for (std::size_t i = 0; i < corners.size(); ++i) {
        const bool near =
            std::abs(corners[i].x - point.x) <= handleReach && std::abs(corners[i].y - point.y) <= handleReach;
        if (near && hasHandle(*shape, i)) {
            return static_cast<int>(i);
        }
    }
    return -1;
}

// --- the mouse ---

void CBoardView::OnLButtonDown(UINT, CPoint point) {
    const Point place = ToDrawing(point);
    if (m_tool == Tool::Select) {
        StartSelecting(place);
    } else {
        StartDrawing(Snapped(place));
    }
}

void CBoardView::StartSelecting(Point point) {
    if (const int handle = HandleAt(point); handle >= 0) {
        StartDrag(Drag::Resize, handle, point);
        return;
    }
    Select(GetDocument()->GetDrawing().shapeAt(point));
    if (m_selected >= 0) {
        StartDrag(Drag::Move, -1, Snapped(point));
    }
}

void CBoardView::StartDrawing(Point point) {
    Select(-1);
    Shape shape;
    shape.kind = static_cast<ShapeKind>(static_cast<int>(m_tool) - 1);
    shape.from = shape.to = point;
    shape.color = m_color;
    shape.fill = shape.kind == ShapeKind::Line ? noColor : m_fill;
    shape.width = shape.kind == ShapeKind::Text ? 1 : theApp.GetOptions().lineWidth;
    shape.size = theApp.GetOptions().textSize;
    StartDrag(Drag::Resize, 2, point);
    m_draft = std::move(shape);
    m_draftIsNew = true;
}

void CBoardView::StartDrag(Drag drag, int handle, Point point) {
    m_drag = drag;
    m_handle = handle;
    m_last = point;
    m_draftIsNew = false;
    if (const Shape* shape = Selected()) {
        m_draft = *shape;
    }
    SetCapture();
}

void CBoardView::OnMouseMove(UINT, CPoint point) {
    m_pointer = ToDrawing(point);
    if (m_drag == Drag::None || !m_draft) {
        return;
    }
    const Point place = Snapped(m_pointer);
    if (m_drag == Drag::Move) {
        m_draft->moveBy(place.x - m_last.x, place.y - m_last.y);
    } else if (!(place == m_last)) {
        moveHandle(*m_draft, m_handle, place);
    }
    m_last = place;
    InvalidateMarked();
}

void CBoardView::OnLButtonUp(UINT, CPoint) {
    if (m_drag != Drag::None) {
        EndDrag(true);
    }
}

// The capture also goes when another window or a message box comes up: the drag is given up then.
void CBoardView::OnCaptureChanged(CWnd*) {
    if (m_drag != Drag::None) {
        EndDrag(false);
    }
}

void CBoardView::EndDrag(bool keep) {
    m_drag = Drag::None;
    if (GetCapture() == this) {
        ReleaseCapture();
    }
    if (keep && m_draft) {
        KeepDraft();
    }
    m_draft.reset();
    InvalidateMarked();
}

void CBoardView::KeepDraft() {
    Shape shape = *m_draft;
    if (!m_draftIsNew) {
        ReplaceSelected(std::move(shape));
        return;
    }
    m_tool = Tool::Select;
    if (isTiny(shape)) {
        return;
    }
    if (shape.kind == ShapeKind::Text) {
        CTextDialog dialog("", this);
        if (dialog.DoModal() != IDOK || dialog.GetText().IsEmpty()) {
            return;
        }
        shape.text = dialog.GetText().GetString();
    }
    const Drawing& drawing = GetDocument()->GetDrawing();
    const int number = static_cast<int>(drawing.shapes.size());
    GetDocument()->Change(Change::addition(drawing, std::move(shape)));
    Select(number);
}

void CBoardView::ReplaceSelected(Shape shape) {
    GetDocument()->Change(Change::replacement(GetDocument()->GetDrawing(), m_selected, std::move(shape)));
}

void CBoardView::MoveSelected(int place) {
    const Change change = Change::move(GetDocument()->GetDrawing(), m_selected, place);
    m_selected = place;
    GetDocument()->Change(change);
}

void CBoardView::OnLButtonDblClk(UINT flags, CPoint point) {
    OnLButtonDown(flags, point);
    if (m_tool == Tool::Select && Selected() && Selected()->kind == ShapeKind::Text) {
        EndDrag(false);
        OnEditText();
    }
}

void CBoardView::OnContextMenu(CWnd*, CPoint point) {
    CPoint inside = point;
    ScreenToClient(&inside);
    if (point == CPoint(-1, -1)) { // asked for with the keyboard
        inside = CPoint(10, 10);
        point = inside;
        ClientToScreen(&point);
    } else {
        Select(GetDocument()->GetDrawing().shapeAt(ToDrawing(inside)));
    }
    CMenu menu;
    menu.LoadMenu(IDR_CONTEXT);
    menu.GetSubMenu(0)->TrackPopupMenu(TPM_LEFTALIGN | TPM_RIGHTBUTTON, point.x, point.y, GetTopLevelFrame());
}

BOOL CBoardView::OnSetCursor(CWnd* window, UINT hitTest, UINT message) {
    if (hitTest != HTCLIENT || m_tool == Tool::Select) {
        return CScrollView::OnSetCursor(window, hitTest, message);
    }
    ::SetCursor(theApp.LoadStandardCursor(IDC_CROSS));
    return TRUE;
}

void CBoardView::OnKeyDown(UINT key, UINT repeat, UINT flags) {
    if (key == VK_ESCAPE) {
        m_tool = Tool::Select;
        EndDrag(false);
        Select(-1);
        return;
    }
    const int dx = key == VK_LEFT ? -1 : key == VK_RIGHT ? 1 : 0;
    const int dy = key == VK_UP ? -1 : key == VK_DOWN ? 1 : 0;
    if (!Selected() || (dx == 0 && dy == 0)) {
        CScrollView::OnKeyDown(key, repeat, flags);
        return;
    }
    Shape shape = *Selected();
    shape.moveBy(dx * static_cast<int>(repeat), dy * static_cast<int>(repeat));
    ReplaceSelected(std::move(shape));
}

// --- commands ---

void CBoardView::OnTool(UINT id) {
    m_tool = static_cast<Tool>(id - ID_TOOL_SELECT);
    Select(-1);
}

void CBoardView::OnUpdateTool(CCmdUI* item) {
    item->Enable();
    item->SetRadio(static_cast<UINT>(m_tool) == item->m_nID - ID_TOOL_SELECT);
}

void CBoardView::OnColor(UINT id) {
    m_color = outlineColors[id - ID_COLOR_FIRST];
    if (Selected()) {
        Shape shape = *Selected();
        shape.color = m_color;
        ReplaceSelected(std::move(shape));
    }
}

void CBoardView::OnUpdateColor(CCmdUI* item) {
    const Color shown = Selected() ? Selected()->color : m_color;
    item->SetRadio(shown == outlineColors[item->m_nID - ID_COLOR_FIRST]);
}

void CBoardView::OnFill(UINT id) {
    m_fill = fillColors[id - ID_FILL_FIRST];
    if (Selected() && Selected()->kind != ShapeKind::Line) {
        Shape shape = *Selected();
        shape.fill = m_fill;
        ReplaceSelected(std::move(shape));
    }
}

void CBoardView::OnUpdateFill(CCmdUI* item) {
    const Color shown = Selected() ? Selected()->fill : m_fill;
    item->SetRadio(shown == fillColors[item->m_nID - ID_FILL_FIRST]);
}

void CBoardView::OnEditClear() {
    const Change change = Change::deletion(GetDocument()->GetDrawing(), m_selected);
    m_selected = -1;
    GetDocument()->Change(change);
}

void CBoardView::OnEditText() {
    Shape shape = *Selected();
    CTextDialog dialog(shape.text.c_str(), this);
    if (dialog.DoModal() == IDOK) {
        shape.text = dialog.GetText().GetString();
        ReplaceSelected(std::move(shape));
    }
}

void CBoardView::OnToFront() {
    MoveSelected(static_cast<int>(GetDocument()->GetDrawing().shapes.size()) - 1);
}

void CBoardView::OnToBack() {
    MoveSelected(0);
}

void CBoardView::OnUpdateSelected(CCmdUI* item) {
    item->Enable(Selected() != nullptr);
}

void CBoardView::OnUpdateEditText(CCmdUI* item) {
    item->Enable(Selected() && Selected()->kind == ShapeKind::Text);
}

void CBoardView::OnUpdatePosition(CCmdUI* item) {
    CString text;
    text.Format("%d, %d", m_pointer.x, m_pointer.y);
    item->Enable();
    item->SetText(text);
}
