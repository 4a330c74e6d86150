#pragma once

#include "platform/Rect.h"

#include <memory>
#include <vector>

class BView;

/// Shares a height that is less than views were laid out for among them.
///
/// Lists, charts and texts of several lines give way, each down to what is of use, and so does room that nobody needs.
/// Where that is not enough, what stands below one another moves closer together as well. Everything else keeps its
/// size; what stands in one row stays in one row, and boxes share what they get in the same way.
class HeightSharing {
public:
    /// Keeps in mind how the views in `view` stand now, of which `height` shows.
    HeightSharing(const BView& view, float height);
    ~HeightSharing();

    /// Below this nothing gives way any more.
    float least() const;
    /// Lays the views out for `height`, or for `least()` where that is more. What is more than they were laid out for
    /// stays free.
    void share(float height) const;

private:
    /// A height, what it comes down to without harm, and what it comes down to at the utmost.
    struct Length {
        float whole = 0;
        float easy = 0;
        float closest = 0;

        /// Where so much of either has been given, from 0 to 1.
        float given(float first, float last) const { return whole - first * (whole - easy) - last * (easy - closest); }
    };
    struct Member {
        BView* view;
        BRect frame;
        Length height;
        std::unique_ptr<HeightSharing> inside; // of a box
    };
    /// Views beside each other, and the gap above them.
    struct Row {
        Length gap;
        BRect frame;
        Length height;
        std::vector<Member> members;

        Row(Member first, float end);
        void add(Member member);
    };
    /// Rows that stand above each other, beside those of other columns.
    struct Column {
        std::vector<Row> rows;
        Length sum; // with all gaps

        Column(std::vector<Member> members, float height);
        void share(float height) const;
    };

    static Member memberOf(BView& view);

    std::vector<Column> columns_;
};
