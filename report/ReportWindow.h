#pragma once

#include "platform/FilePanel.h"
#include "platform/Messenger.h"
#include "platform/PaperDocument.h"
#include "platform/Window.h"

#include <memory>
#include <string>

class BMenuField;
class BStringView;
class PaperView;
class PortfolioReport;

/// Shows a report as it will be on paper, with the year and the size of paper that are chosen, and prints it.
///
/// "Save as PDF..." asks for a place, and sends what was chosen to the window that has opened this one, as `kPlaced`;
/// what came of it is told by `tell`. It is modal, and shows a portfolio that nothing changes meanwhile.
class ReportWindow final : public BWindow {
public:
    static constexpr uint32 kPlaced = 'TRpS';

    /// `middle` is the middle of the upper edge, on the screen. The panel proposes the name `fileName`, without ending,
    /// and comes up in `folder`.
    ReportWindow(BPoint middle, std::shared_ptr<const PortfolioReport> report, const std::string& fileName,
                 const std::string& folder, const BMessenger& target);

    const PaperDocument& document() const;
    /// Shows what came of a save; `isFailure` makes it stand out.
    void tell(const std::string& text, bool isFailure);

    void MessageReceived(BMessage* message) override;

private:
    void makeControls(BView* panel, BRect area);
    void show();
    void print();

    std::shared_ptr<const PortfolioReport> report_;
    std::string fileName_;
    BMessenger target_;
    BFilePanel savePanel_;
    // Owned by the window.
    BMenuField* year_ = nullptr;
    BMenuField* size_ = nullptr;
    BStringView* told_ = nullptr;
    PaperView* paper_ = nullptr;
};
