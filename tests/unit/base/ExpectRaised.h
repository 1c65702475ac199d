#pragma once

#include "platform/base/Exception.h"

#include <gtest/gtest.h>

/// Runs something that must raise a framework exception of a class, and ends the exception.
template <typename Exception, typename Function>
void expectRaised(Function function) {
    try {
        function();
        ADD_FAILURE() << "nothing was raised";
    } catch (Exception* e) {
        e->Delete();
    }
}
