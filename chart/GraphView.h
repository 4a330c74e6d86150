#pragma once

#include "chart/ChartScale.h"
#include "chart/GraphElement.h"
#include "foundation/String.h"
#include "platform/View.h"

#include <memory>
#include <optional>

class BFilePanel;
class GraphPoint;
struct ChartContents;

/// A chart of lines, polygons and points over a numeric or a calendar axis, scaled into its frame.
///
/// Lines and polygons belong to whoever adds them; they outlive the chart or leave it when they die. Points that stand
/// alone belong to the chart. A change of an element or of a setting shows at the next drawing.
///
/// The point that the pointer is near to is shown with its date and value. A menu, by the right mouse button, saves the
/// chart as a picture.
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

    void Draw(BRect updateRect) override;
    void DrawOver(BRect updateRect) override;
    void MouseMoved(BPoint where, bool inside) override;
    void MenuRequested(BPoint where) override;
    void MessageReceived(BMessage* message) override;

    /// Maps pixels to data as last drawn; null when there was no data.
    const ChartScale* scale() const { return scale_ ? &*scale_ : nullptr; }
    /// The point of a line, or that stands alone, nearest to `where`, at most `reach` pixels away, as last drawn; null
    /// when there is none.
    GraphPoint* nearestPoint(BPoint where, float reach) const;

private:
    friend class GraphElementsToGraphView;
    ChartContents readContents() const;
    void askForPictureFile();
    void savePicture(const BMessage& answer);

    GraphViewToGraphElements elements_;
    String xLegend_;
    String yLegend_;
    rgb_color backgroundColor_{255, 255, 255, 0};
    bool xDateBased_ = false;
    short legendSize_ = 12;
    short minMaxSize_ = 10;
    std::optional<ChartScale> scale_; // of the last drawing
    std::optional<BPoint> pointer_;   // while it is over the chart
    std::unique_ptr<BFilePanel> savePanel_;
};
