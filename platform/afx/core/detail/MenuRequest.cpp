#include "platform/afx/core/detail/MenuRequest.h"

#include "platform/afx/core/detail/Window.h"

#include <QScopedValueRollback>

namespace tvx::afx {

namespace {

struct Request {
    WPARAM window = 0; ///< As the message names it. Others may be asked for in loops of those who take this one.
    bool untaken = false;
};

constinit Request* current = nullptr;

} // namespace

bool parentsTakeMenu(const Window& window, WPARAM wParam, LPARAM lParam) {
    if (!window.parent()) {
        return false;
    }
    Request request{wParam};
    const QScopedValueRollback scope(current, &request);
    SendMessageA(window.parent()->handle(), WM_CONTEXTMENU, wParam, lParam);
    return !request.untaken;
}

void noteMenuUntaken(WPARAM wParam) {
    if (current && current->window == wParam) {
        current->untaken = true;
    }
}

} // namespace tvx::afx
