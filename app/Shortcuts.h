#pragma once

#include "platform/Handler.h"

class BTabView;
class BView;
class BWindow;

/// The window's keys. Each does what a click on a tab or a button does, and nothing else.
///
/// Alt+1 to Alt+5 show the tabs. Ctrl+O and Ctrl+S press the buttons that load and save on the page in front; a page
/// that has none is about the portfolio, and the portfolio's page comes to the front for it. Ctrl+N presses the button
/// that adds in the box where the keyboard is; outside of all boxes the page's only one, if there is only one. Ctrl+F
/// goes to the filter of the page in front, or to its first list, which finds what is typed. Ctrl+Z and Ctrl+Shift+Z
/// press the buttons that undo and redo, unless they are about what is being typed in a field. Ctrl+P opens the report
/// on paper, as the menu of "Export..." does.
class Shortcuts final : public BHandler {
public:
    /// Both outlive this.
    Shortcuts(BWindow& window, BTabView& tabs);

    BLooper* Looper() const override;
    void MessageReceived(BMessage* message) override;

private:
    BView& front() const;
    void pressFileButton(const char* ofMarkets, const char* ofPortfolio);
    void pressAdd();
    void find();

    BWindow& window_;
    BTabView& tabs_;
};
