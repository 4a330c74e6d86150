#pragma once

#include <memory>

/// Tells a command that blocks whether a person has pressed Escape, or closes the window, since the watch began. The
/// kits have none.
///
/// Looking also puts on the screen what is to be drawn, so that a window that waits is not blank, and does nothing
/// else: messages wait for their turn, and what a person types, clicks and closes meanwhile is handed on in its order
/// when the watch ends. Only Escape is not: it was for the command.
class EscapeWatch {
public:
    EscapeWatch();
    ~EscapeWatch();
    EscapeWatch(const EscapeWatch&) = delete;
    EscapeWatch& operator=(const EscapeWatch&) = delete;

    /// To be asked some times a second. Asked more often it answers from memory.
    bool IsPressed();

private:
    class Filter;
    std::unique_ptr<Filter> filter_;
};
