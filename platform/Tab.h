#pragma once

#include <string>

class BView;

/// One tab of a tab view: its label, and the view that it shows.
class BTab {
public:
    /// Owns `contents` once it stands in a tab view.
    explicit BTab(BView* contents) : view_(contents) {}

    void SetLabel(const char* label) { label_ = label; }
    const char* Label() const { return label_.c_str(); }
    /// To be set before the tab stands in a tab view.
    void SetToolTip(const char* text) { toolTip_ = text; }
    const char* ToolTip() const { return toolTip_.c_str(); }
    BView* View() const { return view_; }

private:
    BView* view_;
    std::string label_;
    std::string toolTip_;
};
