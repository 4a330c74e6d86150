#include "chart/GraphView.h"

#include "chart/ChartLayout.h"
#include "chart/ChartPainter.h"
#include "chart/ChartSeries.h"
#include "chart/GraphElement.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"
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
constexpr float kPointerReach = 24; // of the read-out, in pixels
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
    const ChartContents contents = readContents();
    if (contents.series.empty()) {
        scale_.reset(); // there is nothing that the pointer could be near to
        painter.drawNotice("No data", kNoDataPlace, contents.legendFont.size);
        return;
    }
    const ChartLayout layout = layOutChart(contents);
    scale_ = layout.scale; // stays until the next drawing, so that the pointer is matched with what is seen
    painter.drawChart(layout, contents.series);
}

void GraphView::DrawOver(BRect)
{
    ChartPainter painter(*this, backgroundColor_);
    if (IsFocus())
        painter.drawFocus();
    if (!pointer_)
        return;
    // A pointer over a chart without data finds no point: `nearestPoint` needs the scale, and there is none.
    if (const GraphPoint* point = nearestPoint(*pointer_, kPointerReach))
        painter.drawReadOut(layOutReadOut(*point, xDateBased_, *scale_, fontOf(legendSize_), Bounds()));
}

void GraphView::MouseMoved(BPoint where, bool inside)
{
    pointer_ = inside ? std::optional(where) : std::nullopt;
    RefreshOver(); // only the layer above the chart is drawn again
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
    if (message->what == kPictureFile)
        savePicture(*message);
    else
        BView::MessageReceived(message);
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

ChartContents GraphView::readContents() const
{
    return {Bounds(),
            seriesOf(graphElements(), xDateBased_),
            xDateBased_,
            std::string(xLegend_.bytes()),
            std::string(yLegend_.bytes()),
            fontOf(minMaxSize_),
            fontOf(legendSize_)};
}

GraphPoint* GraphView::nearestPoint(BPoint where, float reach) const
{
    if (!scale_)
        return nullptr;
    // From here on `reach` is the distance of the nearest point found: of equally near ones the first stays.
    GraphPoint* nearest = nullptr;
    for (GraphElement* element : graphElements()) {
        if (element->getType() == GraphPolygon::kType || element->isUndefined())
            continue; // the corners of a polygon are no values
        GraphPoint* single;
        for (GraphPoint* candidate : pointsOf(*element, single)) {
            const ChartPoint point = chartPointOf(*candidate, xDateBased_);
            const BPoint away = scale_->pixel(point) - where;
            const float distance = std::hypot(away.x, away.y);
            if (hasPlace(point) && distance <= reach && (nearest == nullptr || distance < reach)) {
                nearest = candidate;
                reach = distance;
            }
        }
    }
    return nearest;
}
