#pragma once

#include "platform/Tab.h"
#include "platform/View.h"

#include <functional>
#include <memory>
#include <vector>

class QTabWidget;

/// A row of tabs, each showing its view when it is chosen.
class BTabView : public BView {
public:
    BTabView(BRect frame, const char* name, button_width width = B_WIDTH_AS_USUAL, uint32 resizingMode = B_FOLLOW_ALL,
             uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
    ~BTabView() override;

    /// Takes ownership of both. The view keeps its frame, counted from below the tabs; what does not fit is cut off.
    /// Without one the tab shows nothing until it is filled.
    void AddTab(BView* target, BTab* tab);
    /// Gives the tab of that index, which has none yet, its view, as if it had been added with it.
    void FillTab(int32 index, BView* target);
    int32 CountTabs() const { return static_cast<int32>(tabs_.size()); }
    BTab* TabAt(int32 index) const;
    virtual void Select(int32 index);
    /// `hook` is called whenever another tab was chosen, in whatever way. The kits have `Select` do that.
    void SetSelectionHook(const std::function<void()>& hook);
    float TabHeight() const;
    /// From here on what does not fit is scrolled. The kits leave it to the views.
    void ScrollTabs();
    /// Index of the tab that is shown, negative without any.
    int32 Selection() const;

    QWidget* childHost() const override { return host_; }

private:
    QTabWidget& tabWidget() const;
    void scroll(BView& view);
    /// Has the Tab key come to all that stands in the tabs before what stands beside them: buttons and the like.
    void putFirst();

    std::vector<std::unique_ptr<BTab>> tabs_;
    bool areScrolled_ = false;
    QWidget* host_ = nullptr; // the page that the next child goes into
};
