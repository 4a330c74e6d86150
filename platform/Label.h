#pragma once

#include "platform/View.h"

/// The label of a view that has none of its own, such as a text view. Assistive tools know the two as a pair.
class BLabel : public BView {
public:
    /// `labelled` has the same parent and outlives this. The text ends at the right side of `frame`.
    BLabel(BRect frame, const char* text, const BView& labelled);
};
