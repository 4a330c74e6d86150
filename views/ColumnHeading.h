#pragma once

#include "platform/View.h"

#include <chrono>
#include <optional>
#include <string>

class ColumnListView;

/// The titles above the columns of a list. A click on one sorts the list; the lines between them are dragged to widen a
/// column, and fit it to its texts by a double click.
class ColumnHeading final : public BView {
public:
    /// `list` outlives this, or goes with it.
    ColumnHeading(BRect frame, ColumnListView& list);

    void Draw(BRect updateRect) override;
    void MouseDown(BPoint where) override;
    void MouseMoved(BPoint where, bool inside) override;
    void MouseUp(BPoint where) override;

private:
    struct Drag {
        std::size_t column;
        float offset; // from the pointer to the column's width
    };
    using Clock = std::chrono::steady_clock;

    /// The room for a title; an arrow may stand beside it.
    float titleRoom(std::size_t column) const;
    /// A title that is cut.
    std::string toolTipAt(float x) const;
    void drawTitle(std::size_t column, float left);
    void drawArrow(float left, bool isDown);
    /// The column whose right end is near; the one that is below the pointer.
    std::optional<std::size_t> separatorAt(float x) const;
    std::optional<std::size_t> columnAt(float x) const;

    ColumnListView& list_;
    std::string toolTip_;
    std::optional<Drag> drag_;
    std::optional<std::size_t> pressed_; // a title
    std::optional<std::size_t> lastSeparator_;
    Clock::time_point lastPress_; // on a separator
};
