#include "s/WebHosts.h"

#include "platform/port/File.h"
#include "platform/port/TarvexPath.h"
#include "platform/port/Version.h"

namespace {

using String = Port::StringBase<char>;

/// Whether there is a file to ask. To ask without one is an error that the user would be told of.
bool hasInstallationFile() {
    for (const String& root : Port::TarvexPath::GetInstance()) {
        if (Port::File::canread((root + "/fileset.txt").c_str())) {
            return true;
        }
    }
    return false;
}

String installedValue(const char* key, const char* preset) {
    const String value = hasInstallationFile() ? Port::Version::getValue(key) : String();
    return value.IsEmpty() ? String(preset) : value;
}

} // namespace

String DocumentationLocation() {
    return installedValue("docLocation", TVX_DOC_LOCATION);
}

String RedirectHost() {
    return installedValue("redirectHost", TVX_REDIRECT_HOST);
}
