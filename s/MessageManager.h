#pragma once

#include "afx.h"
#include "platform/port/MsgMan.h"
#include "s/Export.h"

#include <memory>

/// Takes the messages of the portability library in an application with windows and hands them on, formatted.
///
/// The owner registers it for the time it wants the messages:
///
/// @code
/// Gui_MessageManager manager(&ShowError, &AddStatusLine);
/// Port_MsgDispatcher::addMsgMan(&manager);
/// ReadDrawing(name);
/// Port_MsgDispatcher::removeMsgMan(&manager);
/// @endcode
///
/// An exhausted heap raises the framework's memory exception from the place that issues the message.
///
/// A host that wants every error in a message box, also those of an application started from the desktop, whose
/// standard error nobody reads, keeps one without callbacks registered as long as it runs.
class GUI_API Gui_MessageManager : public Port_MsgManDefault {
public:
    /// Takes a text by value.
    using Callback = void (*)(CString text);

    /// Without callbacks: errors go to a message box with the error icon, all other lines to standard output.
    Gui_MessageManager();
    /// @param errorCallback  receives each message of the error class as one text, line feeds included; null shows it
    ///                       in a message box
    /// @param statusCallback receives every other message line by line, without the line feeds; null writes the lines
    ///                       to standard output
    Gui_MessageManager(Callback errorCallback, Callback statusCallback);
    ~Gui_MessageManager() override;

protected:
    void msgWrite(MsgType type, const wchar_t* text) override;

private:
    struct Callbacks;

    void writeError(const CString& text) const;
    void writeStatus(const CString& text) const;

    std::unique_ptr<Callbacks> m_callbacks;
};
