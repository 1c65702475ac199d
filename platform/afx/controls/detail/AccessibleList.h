#pragma once

namespace tvx::afx {

/// Has list boxes answer assistive tools, from now on: as a list with an item for each line.
void answerForLists();

} // namespace tvx::afx
