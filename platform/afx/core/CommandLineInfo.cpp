#include "platform/afx/core/CommandLineInfo.h"

#include "platform/base/Exception.h"
#include "platform/base/Text.h"

#include <filesystem>
#include <string_view>
#include <system_error>

void CCommandLineInfo::ParseParam(const char* param, BOOL isSwitch, BOOL isLast) {
    if (isSwitch) {
        ParseParamFlag(param);
    } else {
        ParseParamNotFlag(param);
    }
    ParseLast(isLast);
}

void CCommandLineInfo::ParseParamFlag(const char* param) {
    const std::string_view word(param);
    const auto is = [&](std::string_view name) { return tvx::text::equalNoCase(word, name); };
    // The desktop's own switches have one spelling, those for people any case.
    if (word == "pt") {
        m_nShellCommand = FilePrintTo;
    } else if (word == "p") {
        m_nShellCommand = FilePrint;
    } else if (word == "dde") {
        m_nShellCommand = FileDDE;
    } else if (is("Register") || is("Regserver")) {
        m_nShellCommand = AppRegister;
    } else if (is("Unregister") || is("Unregserver")) {
        m_nShellCommand = AppUnregister;
    } else if (is("Embedding")) {
        m_bRunEmbedded = TRUE;
    } else if (is("Automation")) {
        m_bRunAutomated = TRUE;
    }
}

void CCommandLineInfo::ParseParamNotFlag(const char* param) {
    if (m_strFileName.IsEmpty()) {
        m_strFileName = param;
        // Not left to the end of the parsing: a derived class may keep the last word, and that it is the last, to
        // itself.
        if (m_nShellCommand == FileNew && !m_strFileName.IsEmpty()) {
            m_nShellCommand = FileOpen;
        }
    } else if (m_nShellCommand == FilePrintTo) {
        CString* const places[] = {&m_strPrinterName, &m_strDriverName, &m_strPortName};
        for (CString* place : places) {
            if (!place->IsEmpty()) {
                continue;
            }
            *place = param;
            break;
        }
    }
}

void CCommandLineInfo::ParseLast(BOOL isLast) {
    if (!isLast) {
        return;
    }
    if (m_nShellCommand == FileNew && !m_strFileName.IsEmpty()) {
        m_nShellCommand = FileOpen;
    }
    if (m_bRunEmbedded || m_bRunAutomated) {
        // Another program drives this one; its user has not asked for it.
        m_bShowSplash = FALSE;
    }
}

tvx::afx::CommandLineWord tvx::afx::takeApart(const char* word) {
    if (word[0] != '-' && word[0] != '/') {
        return {word, false};
    }
    const auto exists = [word] {
        std::error_code ignored;
        return std::filesystem::exists(word, ignored);
    };
    if (word[0] == '/' && tvx::allocating(exists)) {
        return {word, false};
    }
    return {word + 1, true};
}
