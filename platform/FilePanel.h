#pragma once

#include "platform/Messenger.h"

#include <memory>
#include <string>

class BMessage;
class QFileDialog;
struct entry_ref;

enum file_panel_mode { B_OPEN_PANEL, B_SAVE_PANEL };

/// Which entries a panel lets a person choose: files, and in a save panel also folders.
enum : uint32 { B_FILE_NODE = 1, B_DIRECTORY_NODE = 2 };

/// The dialog in which a person chooses a file. It answers with a message to its target.
///
/// An open panel sends `B_REFS_RECEIVED` with the chosen file as "refs", a save panel `B_SAVE_REQUESTED` with the
/// folder as the reference "directory" and the file's name as the string "name"; a save panel has asked before when
/// there is such a file already. A panel that is left without a choice sends nothing.
///
/// One file is chosen, and the panel hides when that is done. Folders are for going into; where they can be chosen,
/// that is done by their names. There is no filter.
class BFilePanel {
public:
    /// `target` is copied; `start` may be null. `message`, owned from now on, replaces the code above.
    explicit BFilePanel(file_panel_mode mode = B_OPEN_PANEL, const BMessenger* target = nullptr,
                        const entry_ref* start = nullptr, uint32 nodeFlavors = B_FILE_NODE, BMessage* message = nullptr,
                        bool modal = false);
    ~BFilePanel();
    BFilePanel(const BFilePanel&) = delete;
    BFilePanel& operator=(const BFilePanel&) = delete;

    /// Without it the panel begins in the person's home folder.
    void SetPanelDirectory(const char* path);
    const std::string& PanelDirectory() const { return directory_; }
    /// "Load" or "Save" until it is set. In the kits it is the panel's window that has one.
    void SetTitle(const char* title) { title_ = title; }
    /// The name that a save panel comes up with, none when it is empty. `ending` is added to a name that is typed
    /// without one, unless it is empty.
    void SetSaveText(const char* text, const char* ending = "");
    const std::string& SaveText() const { return saveText_; }
    void SetNodeFlavors(uint32 flavors) { flavors_ = flavors; }
    void Show();

private:
    QFileDialog& dialog();
    void accept();
    void send(const std::string& path) const;

    file_panel_mode mode_;
    BMessenger target_;
    std::string title_;
    std::string directory_;
    std::string saveText_;
    std::string saveEnding_;
    std::unique_ptr<BMessage> message_;
    uint32 flavors_;
    bool modal_;
    std::unique_ptr<QFileDialog> dialog_; // made when first shown: that takes its time
};
