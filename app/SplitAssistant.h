#pragma once

#include "platform/Messenger.h"
#include "valuation/SplitPlan.h"

#include <array>
#include <optional>
#include <string>

class BMessage;
class CompanyView;
class OperationView;
class PLWindow;

/// Carries out the split that is selected among the company's events, after a window has shown what it does.
///
/// Quotes, purchases, sales and the note that tells of it change in one command, and so go in one undo.
class SplitAssistant {
public:
    /// All outlive this.
    SplitAssistant(PLWindow& window, CompanyView& page, OperationView& operations)
        : window_(window), page_(page), operations_(operations)
    {}

    /// Opens the window, or says in a notice why there is nothing to show.
    void open();
    /// The answer of the window. What has been shown is done, or nothing when the model is not what it was.
    void apply(const BMessage* message);

private:
    /// For the event that is selected; nothing unless that is a split.
    std::optional<SplitPlan> plan(bool splitsQuotes) const;
    void tell(const std::string& text);
    void showChange(const SplitPlan& plan);

    PLWindow& window_;
    CompanyView& page_;
    OperationView& operations_;
    BMessenger dialog_; // valid while the window is open
    // What it shows: the quotes left as they are, and split.
    std::array<std::optional<SplitPlan>, 2> shown_;
};
