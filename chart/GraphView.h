#pragma once

#include "chart/ChartDrag.h"
#include "chart/ChartReadOut.h"
#include "chart/ChartZoom.h"
#include "chart/GraphElement.h"
#include "foundation/String.h"
#include "platform/View.h"

#include <memory>
#include <optional>

class BFilePanel;
class RangeButtons;

/// A chart of lines, polygons and points over a numeric or a calendar axis, scaled into its frame.
///
/// Lines and polygons belong to whoever adds them; they outlive the chart or leave it when they die. Points that stand
/// alone belong to the chart. A change of an element or of a setting shows at the next drawing.
///
/// The values of the day that the pointer is nearest to are read out. The wheel, dragging, keys and, where the page has
/// them, buttons show a part of the x axis, and the values are scaled to that; it stays while the data changes, as
/// `ChartZoom` says. A menu, by the right mouse button, saves the chart as a picture.
class GraphView : public BView {
public:
    GraphView(BRect frame, const char* name);
    ~GraphView() override;

    /// The size of the smallest texts, in pixels: lowest and highest value, and the labels of the axes.
    void setMinMaxSize(short size) { minMaxSize_ = size; }
    short getMinMaxSize() const { return minMaxSize_; }
    /// The size of the legends and the key, in pixels.
    void setLegendSize(short size) { legendSize_ = size; }
    short getLegendSize() const { return legendSize_; }
    /// Whether x are dates; the flags of elements and points are to be set alike.
    void setXDateBased(bool dateBased) { xDateBased_ = dateBased; }
    bool isXDateBased() const { return xDateBased_; }
    /// Stands below "No data" in a chart without any: what will be drawn here.
    void setHint(const std::string& hint) { hint_ = hint; }
    /// Covers whatever its alpha.
    void setBackgroundColor(rgb_color color) { backgroundColor_ = color; }
    rgb_color getBackgroundColor() const { return backgroundColor_; }
    /// Stands above the value axis, at the left. Intended: the pages set it to the unit of the values.
    void setXLegend(const String& legend) { xLegend_ = legend; }
    const String& getXLegend() const { return xLegend_; }
    /// Stands below the x axis, at the right.
    void setYLegend(const String& legend) { yLegend_ = legend; }
    const String& getYLegend() const { return yLegend_; }

    int addGraphElement(GraphElement* element) { return elements_.add(element); }
    /// Gives `element` back to the caller.
    int removeGraphElement(GraphElement* element) { return elements_.remove(element); }
    unsigned getNbrGraphElements() const { return elements_.getNbr(); }
    /// The elements; the array is the chart's own and valid until its next change.
    GraphElement** getAllGraphElements(unsigned* count) const { return elements_.getAll(count); }
    std::span<GraphElement* const> graphElements() const { return elements_.all(); }
    /// Destroys the points that stand alone; lines and polygons stay.
    void removeAllGraphPoints();
    /// What is marked on the first line of a chart that goes by dates.
    void setFlags(std::vector<ChartFlag> flags) { flags_ = std::move(flags); }
    void setFlagStyles(const ChartFlagStyles& styles) { flagStyles_ = styles; }
    /// Puts the buttons for the last months into the chart, once.
    void addRangeButtons();

    void Draw(BRect updateRect) override;
    void DrawOver(BRect updateRect) override;
    void MouseMoved(BPoint where, bool inside) override;
    void MouseDown(BPoint where) override;
    void DoubleClicked(BPoint where) override;
    void MouseUp(BPoint where) override;
    bool WheelTurned(BPoint where, float right, float down) override;
    void KeyDown(const char* bytes, int32 numBytes) override;
    void MenuRequested(BPoint where) override;
    void MessageReceived(BMessage* message) override;

    /// Maps pixels to data as last drawn; null when there was no data.
    const ChartScale* scale() const { return drawn_ ? &drawn_->layout.scale : nullptr; }
    /// The range that is shown, as last drawn or, where the chart says its bounds, as it will be.
    ChartRange shownRange() const { return zoom_.shown(); }
    /// What is read out now; nothing while neither pointer nor keys ask for it.
    std::optional<ChartReadOut> readOut() const;

protected:
    /// Adds what follows from the rows of the lines, which stand in the order of the elements.
    virtual void addReadOutRows(std::vector<ReadOutRow>& /*rows*/) const {}
    /// A person has asked for another part of the x axis.
    virtual void RangeChanged() {}
    /// Says what x the data has, so that `shownRange` is known before it is drawn.
    void setBounds(const ChartRange& bounds);

private:
    friend class GraphElementsToGraphView;
    struct Drawn {
        ChartContents contents;
        ChartLayout layout;
    };
    ChartContents readContents();
    void takeRange(ChartContents& contents);
    void placeFlagsOf(ChartContents& contents) const;
    void rangeChanged();
    void showRange();
    void readNext(bool isBack);
    void askForPictureFile();
    void savePicture(const BMessage& answer);

    GraphViewToGraphElements elements_;
    std::string hint_;
    String xLegend_;
    String yLegend_;
    rgb_color backgroundColor_{255, 255, 255, 0};
    bool xDateBased_ = false;
    short legendSize_ = 12;
    short minMaxSize_ = 10;
    std::vector<ChartFlag> flags_;
    ChartFlagStyles flagStyles_;
    std::unique_ptr<RangeButtons> buttons_;
    ChartZoom zoom_;
    std::optional<ChartDrag> drag_;
    std::optional<Drawn> drawn_;   // so that the pointer is matched with what is seen; none without data
    std::optional<double> readAt_; // the x that is read out
    bool isReadByKeys_ = false;    // and only while the chart has the keyboard
    std::unique_ptr<BFilePanel> savePanel_;
};
