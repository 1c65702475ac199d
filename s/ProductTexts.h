#pragma once

#include "afx.h"

/// What the splash window and the About box tell of the product, each line as it is shown.
struct ProductTexts {
    CString name;       ///< the application's
    CString release;    ///< "Release Version: ...", of the installation
    CString version;    ///< "Application Version: ...", of the application
    CString copyright1; ///< the notice, up to the rights reserved
    CString copyright2; ///< the rest of it; may be empty
};

/// The texts of the running application, in the user's language.
ProductTexts GetProductTexts();

/// The two lines of a copyright notice: it is split before its first "All", unless that stands at the very beginning.
/// @param second  empty when there is no such word
inline void SplitCopyright(const CString& notice, CString& first, CString& second) {
    const int all = notice.Find("All");
    const bool splits = all > 1;
    first = splits ? notice.Left(all - 1) : notice; // without the blank or line end before the word
    second = splits ? notice.Mid(all) : CString();
    first.TrimLeft();
    first.TrimRight();
    second.TrimLeft();
    second.TrimRight();
}
