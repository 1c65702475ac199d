#include "s/ProductTexts.h"

#include "res/resource.h"
#include "s/InstalledValue.h"
#include "s/Msg.h"
#include "s/WinApp.h"

namespace {

/// Not translated: notices are given in English.
constexpr const char* copyrightNotice = "Copyright (c) 2026 Tarvex. All rights reserved.";

CString releaseVersion() {
    CString version = InstalledValue("version").c_str();
    if (version.IsEmpty()) {
        version.LoadString(GUI_IDS_UNKNOWN_VERSION);
    }
    return version;
}

CString applicationVersion() {
    auto* app = dynamic_cast<Gui_WinApp*>(AfxGetApp());
    return app ? app->GetAppVersion() : CString();
}

CString line(unsigned int format, const CString& version) {
    Gui_Msg message(format);
    message << version;
    return message.GetValue();
}

} // namespace

ProductTexts GetProductTexts() {
    ProductTexts texts;
    texts.name = AfxGetAppName();
    texts.release = line(GUI_IDS_RELEASE_VERSION, releaseVersion());
    texts.version = line(GUI_IDS_APP_VERSION, applicationVersion());
    SplitCopyright(copyrightNotice, texts.copyright1, texts.copyright2);
    return texts;
}
