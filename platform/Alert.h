#pragma once

#include "platform/SupportDefs.h"

#include <string>
#include <vector>

/// A question that must be answered by one of up to three buttons before anything else can be done.
///
/// The last button is the one that Enter presses, unless another one is made so; Escape presses the first.
class BAlert {
public:
    BAlert(const char* title, const char* text, const char* button0, const char* button1 = nullptr,
           const char* button2 = nullptr);

    /// Makes the button of that index the one that Enter presses.
    void SetDefaultButton(int32 index) { default_ = static_cast<std::size_t>(index); }
    /// Asks, and destroys the alert, which has been made with `new`. @return the index of the button.
    int32 Go();

private:
    ~BAlert() = default;
    int32 ask() const;

    std::string title_;
    std::string text_;
    std::vector<std::string> buttons_;
    std::size_t default_;
};
