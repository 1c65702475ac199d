#pragma once

class QEvent;

namespace tvx::afx {

class Window;

/// Handles the toolkit's drag events for windows that accept files. False for other windows and other contents.
bool translateDrop(Window& window, QEvent& event);

} // namespace tvx::afx
