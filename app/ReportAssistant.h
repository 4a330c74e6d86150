#pragma once

#include "platform/Messenger.h"

#include <string>

class BMessage;
class BTabView;
class DataFiles;
class DataFolder;
class PLWindow;

/// Shows the portfolio as a report on paper, at the date of the page PortoFolio and without what is simulated, and
/// saves it. Nothing of the model changes, and no step is made.
class ReportAssistant {
public:
    /// The code by which Ctrl+P and the menu ask for it.
    static constexpr uint32 kAsked = 'TRpt';

    /// All outlive this. Reports are saved first in the folder that the data folder stands in.
    ReportAssistant(PLWindow& window, const BTabView& tabs, const DataFiles& files, const DataFolder& folder);

    /// Opens the window of the report, or says in a notice why there is none.
    void open();
    /// The answer of its panel.
    void save(const BMessage* message);

private:
    void tell(const std::string& text, bool isFailure);

    PLWindow& window_;
    const BTabView& tabs_;
    const DataFiles& files_;
    std::string folder_; // that of the last report; empty for the home folder
    BMessenger dialog_;  // valid while the window is open
};
