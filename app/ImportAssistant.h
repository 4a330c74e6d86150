#pragma once

#include "app/FileKind.h"
#include "platform/FilePanel.h"
#include "platform/Messenger.h"
#include "storage/DataFolder.h"

#include <memory>
#include <string>

class BMessage;
class BTabView;
class CompanyView;
class CurrencyView;
class PendingImport;
class PLWindow;

/// Brings tables of other programs in: asks for the file, has a window show what it would bring, and carries that out.
///
/// All of an import is one command, and so goes in one undo.
class ImportAssistant {
public:
    /// The code of the open panel's answer.
    static constexpr uint32 kChosen = 'TIrf';

    /// All outlive this.
    ImportAssistant(PLWindow& window, const BTabView& tabs, CompanyView& companies, CurrencyView& currencies,
                    const DataFolder& folder);
    ~ImportAssistant();

    /// Whether the page in front has something to import.
    bool isPossible() const;
    /// Asks for a table of what the page in front is about.
    void ask();
    /// The answer of the panel. Opens the window, or says in a notice why the file cannot be read.
    void open(const BMessage* message);
    /// The answer of the window. What has been shown is done, or nothing when the model is not what it was.
    void carryOut();
    /// The window was left: its plan goes, which may be large.
    void drop() { pending_.reset(); }

private:
    void tell(const std::string& text, bool isPassing);
    std::shared_ptr<PendingImport> pendingFor(const std::string& path) const;

    PLWindow& window_;
    const BTabView& tabs_;
    CompanyView& companies_;
    CurrencyView& currencies_;
    DataFolder folder_;
    BFilePanel panel_;
    FileKind kind_ = FileKind::kMarkets;     // of what the panel asks for
    bool areRates_ = false;                  // and on which page of the market data
    BMessenger dialog_;                      // valid while the window is open
    std::shared_ptr<PendingImport> pending_; // that it shows; shared with it
};
