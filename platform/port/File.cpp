#include "platform/port/File.h"

#include <unistd.h>

namespace Port {

Stream& File::getCout() {
    static Stream& stream = *new Stream(STDOUT_FILENO);
    return stream;
}

Stream& File::getCerr() {
    static Stream& stream = *new Stream(STDERR_FILENO);
    return stream;
}

} // namespace Port
