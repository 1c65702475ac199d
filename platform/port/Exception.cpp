#include "platform/port/Exception.h"

#include "platform/port/MsgManData.h"

#include <utility>

namespace Port {

Exception::Exception(std::string message) : m_message(std::move(message)) {}

Exception::~Exception() = default;

const char* Exception::what() const noexcept {
    return m_message.c_str();
}

void Exception::report() const {
    Port_MsgManData::createObject("Port", "platform/port/Exception", __LINE__, "").issueError("%s", what());
}

} // namespace Port
