#include "chart/GraphView.h"

#include "chart/ChartPainter.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/RangeButtons.h"
#include "platform/Alert.h"
#include "platform/Entry.h"
#include "platform/FilePanel.h"
#include "platform/MenuItem.h"
#include "platform/Message.h"
#include "platform/Path.h"
#include "platform/PopUpMenu.h"
#include "platform/Screenshot.h"
#include "platform/ShortText.h"

#include <algorithm>
#include <cmath>

namespace {

const BPoint kNoDataPlace(10, 20);
const BPoint kHintPlace(10, 40);
constexpr float kFlagReach = 6;       // of the pointer, in pixels
constexpr double kLeastDays = 4;      // a shorter range is not shown
constexpr double kLeastShare = 0.001; // and no smaller part of an axis of numbers
constexpr uint32 kPictureFile = 'GSav';

ChartFont fontOf(short size)
{
    BFont font = *be_plain_font;
    // A size of 0 or less has no font; the smallest one is used.
    font.SetSize(std::max<short>(size, 1));
    font_height height;
    font.GetHeight(&height);
    return {font.Size(), height.ascent, height.descent,
            [font](const std::string& text) { return font.StringWidth(text.c_str()); }};
}

} // namespace

GraphView::GraphView(BRect frame, const char* name)
    : BView(frame, name, B_FOLLOW_ALL_SIDES, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE | B_NAVIGABLE), elements_(this)
{}

GraphView::~GraphView()
{
    // The single points are ours and go. What is left are lines and polygons of the page: they only lose their link.
    removeAllGraphPoints();
    elements_.unlinkAll();
}

void GraphView::removeAllGraphPoints()
{
    for (unsigned i = 0; i < elements_.getNbr();) {
        GraphElement* element = elements_.at(i);
        if (element->getType() == GraphPoint::kType)
            delete element; // takes itself out, and another element takes its place
        else
            ++i;
    }
}

void GraphView::Draw(BRect)
{
    ChartPainter painter(*this, backgroundColor_);
    painter.fillBackground();
    // The elements are read anew for each drawing: they do not tell of their changes.
    ChartContents contents = readContents();
    if (contents.series.empty()) {
        drawn_.reset(); // there is nothing to read out, and no range to change
        painter.drawNotice("No data", kNoDataPlace, contents.legendFont.size);
        painter.drawNotice(hint_.c_str(), kHintPlace, contents.legendFont.size);
        return;
    }
    ChartLayout layout = layOutChart(contents);
    painter.drawChart(layout, contents);
    drawn_.emplace(Drawn{std::move(contents), std::move(layout)});
    showRange(); // the data may have another end now
}

void GraphView::DrawOver(BRect)
{
    ChartPainter painter(*this, backgroundColor_);
    if (IsFocus())
        painter.drawFocus();
    if (!drawn_)
        return;
    const ChartLayout& layout = drawn_->layout;
    if (const auto selected = drag_ ? drag_->selection() : std::nullopt)
        painter.drawSelection(layout.plot, layout.scale.pixelX(selected->min), layout.scale.pixelX(selected->max));
    if (const std::optional<ChartReadOut> shown = readOut())
        painter.drawReadOut(*shown, layout.plot);
}

std::optional<ChartReadOut> GraphView::readOut() const
{
    if (!drawn_ || !readAt_ || (isReadByKeys_ && !IsFocus()))
        return std::nullopt;
    // The data may have changed under a pointer that rests.
    const std::optional<double> x = readOutPlace(drawn_->contents, *readAt_, 0);
    if (!x)
        return std::nullopt;
    std::vector<ReadOutRow> rows = readOutRows(drawn_->contents, *x);
    addReadOutRows(rows);
    return layOutReadOut(drawn_->contents, drawn_->layout, *x, rows);
}

void GraphView::MouseMoved(BPoint where, bool inside)
{
    if (drag_) {
        const ChartRange before = zoom_.shown();
        drag_->moveTo(where, zoom_);
        if (zoom_.shown() != before)
            rangeChanged();
    }
    isReadByKeys_ = false;
    readAt_.reset();
    if (inside && drawn_) {
        const ChartScale& scale = drawn_->layout.scale;
        readAt_ = readOutPlace(drawn_->contents, scale.x(where.x), kFlagReach / scale.pixelsPerX());
    }
    RefreshOver(); // only the layer above the chart is drawn again
}

void GraphView::MouseDown(BPoint where)
{
    if (!drawn_)
        return;
    const bool isPan = (modifiers() & B_SHIFT_KEY) != 0;
    drag_.emplace(isPan ? ChartDrag::Kind::kPan : ChartDrag::Kind::kSelect, where, drawn_->layout.scale, zoom_.shown());
}

void GraphView::DoubleClicked(BPoint)
{
    drag_.reset();
    zoom_.showAll();
    rangeChanged();
}

void GraphView::MouseUp(BPoint where)
{
    if (!drag_)
        return;
    drag_->moveTo(where, zoom_);
    if (const auto selected = drag_->selection())
        zoom_.show(*selected);
    drag_.reset();
    rangeChanged();
}

bool GraphView::WheelTurned(BPoint where, float right, float down)
{
    if (!drawn_)
        return false;
    constexpr double kStep = 1.25;
    constexpr double kShare = 0.1;
    if ((modifiers() & B_SHIFT_KEY) != 0)
        right += std::exchange(down, 0.0F);
    zoom_.zoom(drawn_->layout.scale.x(where.x), std::pow(kStep, down));
    zoom_.pan(static_cast<double>(right) * kShare * zoom_.shown().length());
    rangeChanged();
    return true;
}

void GraphView::KeyDown(const char* bytes, int32)
{
    if (!drawn_)
        return;
    constexpr double kStep = 1.5;
    constexpr double kShare = 0.2;
    const ChartRange range = zoom_.shown();
    const double middle = readAt_.value_or((range.min + range.max) / 2);
    switch (bytes[0]) {
    case '+':
    case '=': // the same key without Shift
        zoom_.zoom(middle, 1 / kStep);
        break;
    case '-':
        zoom_.zoom(middle, kStep);
        break;
    case B_LEFT_ARROW:
        zoom_.pan(-kShare * range.length());
        break;
    case B_RIGHT_ARROW:
        zoom_.pan(kShare * range.length());
        break;
    case B_HOME:
        zoom_.pan(-zoom_.bounds().length());
        break;
    case B_END:
        zoom_.pan(zoom_.bounds().length());
        break;
    case B_UP_ARROW:
    case B_DOWN_ARROW:
        return readNext(bytes[0] == B_DOWN_ARROW);
    case B_ESCAPE:
        if (!drag_)
            zoom_.showAll();
        drag_.reset();
        break;
    default:
        return;
    }
    rangeChanged();
}

void GraphView::readNext(bool isBack)
{
    isReadByKeys_ = true;
    const ChartRange range = zoom_.shown();
    // The first key begins at the last day that is shown.
    const double next = readAt_ ? nextReadOutPlace(drawn_->contents, *readAt_, isBack) : range.max;
    if (next == readAt_) {
        // What is drawn ends here; the next key finds more when there is more.
        zoom_.pan((isBack ? -1 : 1) * range.length() / 10);
        rangeChanged();
    }
    readAt_ = next;
    RefreshOver();
}

void GraphView::addRangeButtons()
{
    buttons_ = std::make_unique<RangeButtons>(*this);
    showRange();
}

void GraphView::rangeChanged()
{
    showRange();
    Invalidate();
    RangeChanged();
}

void GraphView::setBounds(const ChartRange& bounds)
{
    zoom_.setBounds(bounds, xDateBased_ ? kLeastDays : kLeastShare * bounds.length());
}

void GraphView::showRange()
{
    constexpr int kOther = -1;
    if (buttons_ != nullptr)
        buttons_->show(zoom_.lastMonths() > 0 ? zoom_.lastMonths() : zoom_.isAll() ? 0 : kOther);
}

void GraphView::MenuRequested(BPoint where)
{
    // Made for each time; the program waits here until it has gone.
    BPopUpMenu menu("chartMenu");
    menu.AddItem(new BMenuItem("Save as PNG...", nullptr));
    if (menu.Go(ConvertToScreen(where)) != nullptr)
        askForPictureFile();
}

void GraphView::askForPictureFile()
{
    const BMessenger self(this);
    // The panel is made when it is first asked for, and then kept: it remembers its folder.
    if (savePanel_ == nullptr)
        savePanel_ =
            std::make_unique<BFilePanel>(B_SAVE_PANEL, &self, nullptr, B_FILE_NODE, new BMessage(kPictureFile), true);
    // The first line is what the chart is about, as it is for the marks of the lowest and the highest value.
    const auto line = std::ranges::find(graphElements(), GraphLine::kType, &GraphElement::getType);
    std::string name = line != graphElements().end() ? legendOf(**line) : "";
    constexpr std::size_t kLongest = 200; // bytes; the name of a file has 255
    name.resize(wholeCharacters(name, kLongest));
    std::replace(name.begin(), name.end(), '/', '-');
    savePanel_->SetSaveText(((name.empty() ? "Chart" : name) + ".png").c_str(), "png");
    savePanel_->Show();
}

void GraphView::MessageReceived(BMessage* message)
{
    int32 months;
    if (message->what == kPictureFile) {
        savePicture(*message);
    } else if (message->what == RangeButtons::kPressed && message->FindInt32("months", &months) == B_OK) {
        if (months > 0)
            zoom_.showLast(months);
        else
            zoom_.showAll();
        rangeChanged();
    } else {
        BView::MessageReceived(message);
    }
}

void GraphView::savePicture(const BMessage& answer)
{
    entry_ref folder;
    const char* name;
    // Not an answer of the panel.
    if (answer.FindRef("directory", &folder) != B_OK || answer.FindString("name", &name) != B_OK)
        return;
    BPath path;
    BEntry(&folder).GetPath(&path);
    path.Append(name);
    // The chart as it was drawn last, without frame and read-out.
    if (save_picture(*this, path.Path()) != B_OK)
        (new BAlert("Save as PNG", (std::string("The picture could not be written to ") + path.Path()).c_str(), "OK"))
            ->Go();
}

ChartContents GraphView::readContents()
{
    ChartContents contents;
    contents.bounds = Bounds();
    contents.series = seriesOf(graphElements(), xDateBased_);
    contents.isDateBased = xDateBased_;
    contents.xLegend = std::string(xLegend_.bytes());
    contents.yLegend = std::string(yLegend_.bytes());
    contents.legendFont = fontOf(legendSize_);
    if (buttons_ != nullptr)
        contents.controls = buttons_->frame();
    if (contents.series.empty())
        return contents;
    contents.labelFont = fontOf(minMaxSize_); // there is nothing to label otherwise
    placeFlagsOf(contents);
    takeRange(contents);
    return contents;
}

/// All flags, before anything is cut: the key is the same whatever part is shown.
void GraphView::placeFlagsOf(ChartContents& contents) const
{
    if (!xDateBased_)
        return;
    contents.flags = placeFlags(flags_, *mainSeries(contents.series));
    for (const PlacedFlag& flag : contents.flags) {
        const auto shape = static_cast<std::size_t>(flag.shape);
        contents.flagStyles[shape] = flagStyles_[shape];
    }
}

/// Cuts the contents down to what is to be shown.
void GraphView::takeRange(ChartContents& contents)
{
    ChartRange all = rangeOf(contents.series);
    for (const PlacedFlag& flag : contents.flags)
        all.include(flag.where.x);
    setBounds(all);
    contents.x = zoom_.shown();
    if (zoom_.isAll())
        return;
    std::vector<ChartSeries> part = cropped(contents.series, contents.x);
    if (part.empty()) { // some flags are there, and no value
        zoom_.showAll();
        contents.x = all;
        return;
    }
    contents.series = std::move(part);
    contents.goesOnBefore = contents.x.min > all.min;
    contents.goesOnBehind = contents.x.max < all.max;
    std::erase_if(contents.flags, [&](const PlacedFlag& flag) {
        return flag.where.x < contents.x.min || flag.where.x > contents.x.max;
    });
}
