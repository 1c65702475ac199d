#pragma once

/// @file
/// The one way in which signals of the toolkit reach our code.

#include "platform/afx/core/detail/Loop.h"

#include <QObject>

#include <concepts>
#include <utility>

namespace tvx::afx {

/// A call that keeps its exception for the place of ours below the toolkit, whose frames cannot be unwound. Takes as
/// many of a signal's arguments as the call does.
template <class Call>
struct StoringCall {
    Call call;

    template <class... Arguments>
        requires std::invocable<Call&, Arguments...>
    void operator()(Arguments... arguments) {
        storing([&] { call(arguments...); });
    }
};

/// Connects a signal to a call of ours. Slots run below the toolkit without an event of their own, or within one whose
/// handling must go on in the toolkit; an exception that left the call there would end the process.
/// @param context  the call ends with this object, and runs on its thread
template <class Sender, class Signal, class Call>
QMetaObject::Connection connectStoring(const Sender* sender, Signal signal, const QObject* context, Call call) {
    return QObject::connect(sender, signal, context, StoringCall<Call>{std::move(call)});
}

} // namespace tvx::afx
