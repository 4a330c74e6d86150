#pragma once

#include "platform/Messenger.h"
#include "platform/Window.h"
#include "valuation/SplitPlan.h"
#include "views/SplitLists.h"

class BBox;
class BButton;
class BCheckBox;
class BStringView;
class PageView;

/// Shows what a split will do, and asks whether to do it; does nothing itself.
///
/// "Apply" sends `kApplied` to the window that has opened this one, with an int32 "quotes" that tells whether the
/// quotes are to be split, too. "Cancel", Escape and closing send nothing. It is modal, and what it shows is copied:
/// what becomes of the model meanwhile is the receiver's to find out.
class SplitWindow final : public BWindow {
public:
    static constexpr uint32 kApplied = 'SpAp';

    /// Two plans of one split: `split` with its quotes, `kept` without them; neither has a problem. `middle` is the
    /// middle of the upper edge, on the screen.
    SplitWindow(BPoint middle, const SplitPlan& split, const SplitPlan& kept, const BMessenger& target);

    void MessageReceived(BMessage* message) override;
    void GiveWay(float width, float height) override;

private:
    void makeQuotes(BView* panel, BRect area);
    void makeTrades(BView* panel, BRect area);
    void makeButtons(BView* panel, BRect area);
    bool areQuotesSplit() const;
    /// Shows the plan that the tick at the quotes asks for.
    void showPlan();

    SplitPlan split_;
    SplitPlan kept_;
    BMessenger target_;
    PageView* panel_ = nullptr;
    BCheckBox* quotes_ = nullptr;
    BStringView* sample_ = nullptr;
    // Null without trades.
    SplitTradeListView* trades_ = nullptr;
    SplitHoldingListView* holdings_ = nullptr;
    BBox* valueBox_ = nullptr;
    BStringView* settlement_ = nullptr;
    BButton* apply_ = nullptr;
    BButton* cancel_ = nullptr;
};

/// What a person should know before a split is applied, a line each: that it was applied before, that the quotes look
/// split already. Empty when nothing speaks against it.
std::vector<std::string> splitWarnings(const SplitPlan& plan);
