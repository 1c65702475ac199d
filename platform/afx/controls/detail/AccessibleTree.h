#pragma once

namespace tvx::afx {

/// Has trees answer assistive tools, from now on: as a tree with an item for each line, as the toolkit's own do.
void answerForTrees();

} // namespace tvx::afx
