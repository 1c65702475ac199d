#include "s/WebHosts.h"

#include "s/InstalledValue.h"

namespace {

using String = Port::StringBase<char>;

String installedValue(const char* key, const char* preset) {
    const String value = InstalledValue(key);
    return value.IsEmpty() ? String(preset) : value;
}

} // namespace

String DocumentationLocation() {
    return installedValue("docLocation", TVX_DOC_LOCATION);
}

String RedirectHost() {
    return installedValue("redirectHost", TVX_REDIRECT_HOST);
}
