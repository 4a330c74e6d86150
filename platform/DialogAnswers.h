#pragma once

#include "platform/SupportDefs.h"

#include <functional>
#include <string>

class BFilePanel;

/// Who answers the program's questions. As long as a function is empty, which is how it starts, the person at the
/// screen does, in a dialog; tests and the tour set their own.
struct DialogAnswers {
    /// Gets title and text of an alert. @return the index of the button.
    std::function<int32(const char* title, const char* text)> alert;
    /// @return the path that is chosen in a file panel; empty cancels it.
    std::function<std::string(const BFilePanel& panel)> panel;
    /// Opens a file in the place of another program. @return whether that has started.
    std::function<bool(const std::string& path)> launch;

    static DialogAnswers& current()
    {
        static DialogAnswers answers;
        return answers;
    }
};
