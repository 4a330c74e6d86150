#pragma once

#include <string>

class BView;

/// One tab of a tab view: its label, and the view that it shows.
class BTab {
public:
    /// `contents` may be null until `SetView`; the tab view that the tab stands in owns it.
    explicit BTab(BView* contents = nullptr) : view_(contents) {}

    void SetLabel(const char* label) { label_ = label; }
    const char* Label() const { return label_.c_str(); }
    /// To be set before the tab stands in a tab view.
    void SetToolTip(const char* text) { toolTip_ = text; }
    const char* ToolTip() const { return toolTip_.c_str(); }
    BView* View() const { return view_; }
    /// For the tab view's own use; see `BTabView::FillTab`.
    void SetView(BView* contents) { view_ = contents; }

private:
    BView* view_;
    std::string label_;
    std::string toolTip_;
};
