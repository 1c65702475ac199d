#pragma once

/// @file
/// Windows as assistive tools see them.

#include <QAccessible>
#include <QMetaEnum>

#include <string>

/// A line for each part, indented by its depth: role, name, and after "<" the names of what labels it. Parts that are
/// not shown are left out.
inline std::string accessibleTree(const QAccessibleInterface& part, int depth = 0) {
    if (part.state().invisible) {
        return {};
    }
    std::string text(static_cast<std::size_t>(depth), ' ');
    text += QMetaEnum::fromType<QAccessible::Role>().valueToKey(part.role());
    text += " \"" + part.text(QAccessible::Name).toStdString() + "\"";
    for (const auto& [label, relation] : part.relations(QAccessible::Label)) {
        text += " < " + label->text(QAccessible::Name).toStdString();
    }
    text += "\n";
    for (int i = 0; i < part.childCount(); ++i) {
        if (const QAccessibleInterface* child = part.child(i)) {
            text += accessibleTree(*child, depth + 1);
        }
    }
    return text;
}
