#pragma once

#include "app/ExportOffers.h"
#include "platform/FilePanel.h"

#include <optional>
#include <string>

class BMessage;
class BTabView;
class BView;
class DataFolder;

/// Writes what the page in front shows: a menu has what there is, a panel asks for a place, and a notice tells what
/// came of it. Nothing of the model changes, and no step is made.
class ExportAssistant {
public:
    /// The codes by which the menu and the panel send their answers to the window, which hands them back to `ask` and
    /// to `write`.
    static constexpr uint32 kChosen = 'TExC';
    static constexpr uint32 kPlaced = 'TExS';

    /// Window, tabs and files outlive this. The panel opens first in the folder that the data folder stands in.
    ExportAssistant(PLWindow& window, const BTabView& tabs, const DataFiles& files, const DataFolder& folder,
                    const ExportOffers& offers);

    /// Opens the menu below `button`.
    void open(const BView& button) const;
    /// Opens the panel for what was chosen.
    void ask(const BMessage* message);
    void write(const BMessage* message);

    /// Where a file is first proposed: the folder that the data folder stands in; empty for the home folder.
    static std::string firstFolder(const DataFolder& folder);
    static std::string nameOf(const std::string& path);
    /// "Not written: ..." The place was just chosen: its name is enough, and leaves room for the reason.
    static std::string failureText(const std::string& path, const std::string& reason);

private:
    /// That of the page in front with this label; nothing when it is not there, or has become impossible.
    std::optional<ExportOffer> find(const std::string& label) const;
    /// The text for a notice.
    std::string written(const ExportOffer& offer, const std::string& path) const;
    void tellFailure(const std::string& text);

    PLWindow& window_;
    const BTabView& tabs_;
    const DataFiles& files_;
    ExportOffers offers_;
    std::string asked_; // the label of what the panel is asking for
    BFilePanel panel_;
};
