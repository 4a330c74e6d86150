#pragma once

#include "platform/GraphicsDefs.h"

/// The measures and colours that all pages share, so that they look like one program. Lengths in pixels.
namespace look {

constexpr rgb_color kPanel = kPanelGrey;
constexpr rgb_color kHeading = {196, 203, 212, 255};
constexpr rgb_color kLine = {168, 168, 168, 255};
constexpr rgb_color kText = {0, 0, 0, 255};
constexpr rgb_color kFaint = kFaintGrey;               ///< what is there but old
constexpr rgb_color kWarning = kWarningRed;            ///< what is missing
constexpr rgb_color kGenerated = {255, 240, 204, 255}; ///< ground of what the program made up
constexpr rgb_color kNew = {255, 221, 102, 255};       ///< ground of what has just come
constexpr rgb_color kNotice = {255, 244, 206, 255};    ///< ground of notices
constexpr rgb_color kGain = {0, 104, 44, 255};
constexpr rgb_color kLoss = kWarningRed;
constexpr rgb_color kSeries = {24, 78, 148, 255}; ///< the line of a chart
constexpr rgb_color kPutIn = {204, 98, 0, 255};   ///< what was put in, beside what it is worth
constexpr rgb_color kEvent = {112, 48, 144, 255}; ///< what a company's chart marks
constexpr rgb_color kTrend = {204, 98, 0, 255};   ///< its trend
constexpr rgb_color kBand = {204, 98, 0, 48};     ///< what lies about the trend

constexpr float kPageWidth = 800;
constexpr float kPageHeight = 736; ///< what shows of a page, between the tabs and the line of notices
constexpr float kMargin = 8;       ///< between the groups of a page, and around them
constexpr float kBoxTop = 20;      ///< from the upper edge of a box to what is in it
constexpr float kBoxSide = 10;     ///< from its other edges
constexpr float kFieldHeight = 22;
constexpr float kRow = 27; ///< from one field to the one below
constexpr float kButtonHeight = 24;
constexpr float kGap = 6; ///< between neighbours in a row
constexpr float kHeadingHeight = 18;
constexpr float kListRow = 18;
constexpr float kScrollBar = 16;

} // namespace look
