#include "s/InstalledValue.h"

#include "platform/port/File.h"
#include "platform/port/TarvexPath.h"
#include "platform/port/Version.h"

namespace {

bool hasInstallationFile() {
    for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance()) {
        if (Port::File::canread((root + "/fileset.txt").c_str())) {
            return true;
        }
    }
    return false;
}

} // namespace

Port::StringBase<char> InstalledValue(const char* key) {
    return hasInstallationFile() ? Port::Version::getValue(key) : Port::StringBase<char>();
}
