#pragma once

#include <string>

/// A folder whose file system does not answer, as that of a server that has gone: to open it takes until the object
/// ends. Stands in this program for the system's call.
class HangingFolder {
public:
    /// @param folder in the system's form, without a separator at the end
    explicit HangingFolder(std::string folder);
    ~HangingFolder();
    HangingFolder(const HangingFolder&) = delete;
    HangingFolder& operator=(const HangingFolder&) = delete;

    /// Lets it answer.
    void answer();
};
