#pragma once

#include <cstdlib>
#include <string>
#include <vector>

#include <unistd.h>

/// Gives the process its environment back when it goes, whatever a test has changed.
class SavedEnvironment {
public:
    SavedEnvironment() {
        for (char** variable = environ; *variable; ++variable) {
            m_variables.emplace_back(*variable);
        }
    }
    ~SavedEnvironment() {
        clearenv();
        for (const std::string& variable : m_variables) {
            const std::size_t equals = variable.find('=');
            setenv(variable.substr(0, equals).c_str(), variable.substr(equals + 1).c_str(), 1);
        }
    }
    SavedEnvironment(const SavedEnvironment&) = delete;
    SavedEnvironment& operator=(const SavedEnvironment&) = delete;

private:
    std::vector<std::string> m_variables;
};
