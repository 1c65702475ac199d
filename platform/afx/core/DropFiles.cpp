#include "platform/afx/core/DropFiles.h"

#include "platform/afx/core/detail/Drops.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/HandleTable.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"

#include <QDropEvent>
#include <QMimeData>
#include <QUrl>

#include <algorithm>
#include <cstring>

using namespace tvx::afx;

namespace {

using Names = std::vector<std::string>;

HandleTable<Names>& drops() {
    static auto* table = new HandleTable<Names>(11);
    return *table;
}

Names namesOf(const QMimeData& data) {
    Names names;
    const auto urls = data.urls();
    for (const QUrl& url : urls) {
        // What is dragged out of a browser has no name that a host could open.
        if (url.isLocalFile()) {
            names.push_back(tvx::driveName(fromQt(url.toLocalFile())));
        }
    }
    return names;
}

} // namespace

UINT DragQueryFileA(HDROP drop, UINT index, LPSTR buffer, UINT size) {
    const auto names = drops().find(reinterpret_cast<std::uintptr_t>(drop));
    if (!names) {
        return 0;
    }
    if (index == 0xFFFFFFFF) {
        return static_cast<UINT>(names->size());
    }
    if (index >= names->size()) {
        return 0;
    }
    const std::string& name = (*names)[index];
    if (!buffer || size == 0) {
        return static_cast<UINT>(name.size());
    }
    const std::size_t length = tvx::text::characterStart(name, std::min<std::size_t>(name.size(), size - 1));
    std::memcpy(buffer, name.data(), length);
    buffer[length] = '\0';
    return static_cast<UINT>(length);
}

void DragFinish(HDROP drop) {
    drops().take(reinterpret_cast<std::uintptr_t>(drop));
}

void DragAcceptFiles(HWND handle, BOOL accept) {
    if (Window* window = Window::from(handle)) {
        const DWORD with = window->exStyle() | WS_EX_ACCEPTFILES;
        window->setStyle(window->style(), accept ? with : with & ~DWORD{WS_EX_ACCEPTFILES});
    }
}

bool tvx::afx::translateDrop(Window& window, QEvent& event) {
    if ((window.exStyle() & WS_EX_ACCEPTFILES) == 0) {
        return false;
    }
    auto& drop = static_cast<QDropEvent&>(event);
    Names names = namesOf(*drop.mimeData());
    if (names.empty()) {
        return false;
    }
    drop.setDropAction(Qt::CopyAction);
    drop.accept();
    if (event.type() == QEvent::Drop) {
        // Posted: the other program waits until the toolkit has answered it.
        const auto handle = drops().add(std::make_shared<Names>(std::move(names)));
        PostMessageA(window.handle(), WM_DROPFILES, handle, 0);
    }
    return true;
}
