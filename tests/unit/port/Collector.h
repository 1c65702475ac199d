#pragma once

#include "platform/port/MsgDispatcher.h"
#include "platform/port/Str.h"

#include <string>
#include <vector>

/// Gathers the messages issued while it lives, as they were issued.
class Collector : public Port_MsgMan {
public:
    struct Message {
        MsgType type;
        std::string text;
    };

    Collector() : Port_MsgMan("Collector") {
        Port_MsgDispatcher::addMsgMan(this);
    }

    std::vector<std::string> texts() const {
        std::vector<std::string> result;
        for (const Message& message : messages) {
            result.push_back(message.text);
        }
        return result;
    }

    std::vector<Message> messages;

protected:
    void msgWrite(MsgType type, const wchar_t* text) override {
        messages.push_back({type, UT_STR::WstrToMbstr(text)});
    }
};
