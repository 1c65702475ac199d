#pragma once

#include "platform/base/Export.h"

#include <exception>
#include <string>

namespace Port {

/// What the portability library and code written against it throw. The application's run loop catches it, lets it
/// report itself and ends with 1.
///
///     throw Port::Exception("The drawing's layer table is damaged.");
class TVX_PLATFORM_API Exception : public std::exception {
public:
    /// @param message what went wrong, for the user, in UTF-8.
    explicit Exception(std::string message);
    ~Exception() override;

    /// The message given to the constructor.
    const char* what() const noexcept override;

    /// Issues the message as an error message through the dispatcher. Derived classes override it to say more.
    virtual void report() const;

private:
    std::string m_message;
};

} // namespace Port
