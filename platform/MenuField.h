#pragma once

#include "platform/View.h"

#include <memory>

class BMenu;
class QComboBox;
class QLabel;

/// A label with a menu of which the marked item shows.
class BMenuField : public BView {
public:
    /// Takes ownership of `menu`.
    BMenuField(BRect frame, const char* name, const char* label, BMenu* menu);
    ~BMenuField() override;

    BMenu* Menu() const { return menu_.get(); }
    /// Where the menu begins, in pixels from the left.
    void SetDivider(float x);
    void SetAlignment(alignment label);
    /// Items that have no target send to the window.
    void AttachedToWindow() override;
    void FrameResized(float /*width*/, float /*height*/) override { layOut(); }

private:
    void layOut();
    void fill();
    void choose(int index);

    std::unique_ptr<BMenu> menu_;
    QComboBox* field_; // a part of the widget
    QLabel* caption_;  // and so is this
    float divider_;
};
