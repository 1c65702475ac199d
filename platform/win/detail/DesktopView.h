#pragma once

#include "platform/win/detail/SettingsSource.h"

namespace tvx::registry {

/// What the desktop knows, in the places where applications of the platform look for it: the programs that open pages,
/// PDF documents and texts, and the browser that Debian's alternatives name. docs/programs.md lists the keys.
///
/// It answers for its own keys only and asks the desktop when a value is read, not before. Its keys are found by their
/// names; they do not show among the keys below another.
class DesktopView : public Source {
public:
    DWORD findKey(const KeyPath& key) override;
    DWORD readValue(const KeyPath& key, std::string_view name, std::shared_ptr<const Value>& value) override;
    DWORD keyAt(const KeyPath& key, DWORD index, Cursor& cursor, std::string& name) override;
    DWORD valueAt(const KeyPath& key, DWORD index, Cursor& cursor, Value& value) override;
};

} // namespace tvx::registry
