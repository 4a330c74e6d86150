#pragma once

#include "platform/View.h"

#include <string>

/// A frame with a title around a group of controls, which are its children.
class BBox : public BView {
public:
    BBox(BRect frame, const char* name);

    void SetLabel(const char* label);
    const char* Label() const { return label_.c_str(); }
    void Draw(BRect updateRect) override;

private:
    std::string label_;
};
