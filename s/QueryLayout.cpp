#include "s/QueryLayout.h"

#include <algorithm>

namespace {

int buttonRowWidth(const QueryMeasures& m) {
    const int two = 3 * m.margin.cx / 2 + 2 * m.button.cx;
    return m.hasHelp ? two + m.button.cx + m.margin.cx : two;
}

int contentWidth(const QueryMeasures& m) {
    const int row = std::min<int>(m.prompt.cx + m.margin.cx + m.field.cx, m.widest);
    return std::max(row, buttonRowWidth(m));
}

} // namespace

int WidestPrompt(const QueryMeasures& m) {
    // The field gives way first, down to half of the room.
    const int field = std::min<int>(m.field.cx, m.widest / 2);
    return std::max<int>(m.widest - m.margin.cx - field, 1);
}

QueryLayout LayOutQuery(const QueryMeasures& m) {
    QueryLayout layout;
    const int content = contentWidth(m);
    const int row = std::max<int>(m.field.cy, m.prompt.cy);
    const bool tall = m.prompt.cy > m.field.cy;
    const int promptShift = tall ? 0 : (m.field.cy - m.promptClient.cy) / 2;
    layout.prompt = CRect(CPoint(m.margin.cx, m.margin.cy + promptShift), m.prompt);
    const int fieldLeft = m.margin.cx / 2 + m.prompt.cx + m.margin.cx;
    layout.field = CRect(CPoint(fieldLeft, m.margin.cy + (row - m.field.cy) / 2),
                         CSize(std::max(content - fieldLeft, 1), m.field.cy));
    const int buttonTop = row + m.margin.cy + m.margin.cx;
    const int step = m.button.cx + m.margin.cx;
    layout.ok = CPoint((content - buttonRowWidth(m)) / 2 + m.margin.cx, buttonTop);
    layout.cancel = layout.ok + CPoint(step, 0);
    layout.help = layout.cancel + CPoint(step, 0);
    layout.dialog = CSize(content + 2 * m.margin.cx, buttonTop + 3 * m.margin.cy + m.button.cy);
    return layout;
}
