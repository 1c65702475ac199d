#include "platform/afx/core/detail/OwnText.h"

#include "platform/base/String.h"

namespace tvx::afx {

QString ownText(UINT id) {
    CString text;
    (void)text.LoadString(id);
    return QString::fromUtf8(text.GetString(), text.GetLength());
}

} // namespace tvx::afx
