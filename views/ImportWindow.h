#pragma once

#include "platform/Messenger.h"
#include "platform/Window.h"
#include "views/ImportPreview.h"

#include <memory>
#include <string>

class BStringView;
class PageView;

/// Shows what an import will bring, has a person say what the table leaves open, and asks whether to do it; does
/// nothing itself.
///
/// "Import" sends `kImported` to the window that has opened this one. "Cancel", Escape and closing send nothing. It is
/// modal; what becomes of the model meanwhile is the receiver's to find out.
class ImportWindow final : public BWindow {
public:
    static constexpr uint32 kImported = 'TIdo';

    /// `middle` is the middle of the upper edge, on the screen. `first` is what `preview` shows at first.
    ImportWindow(BPoint middle, const std::shared_ptr<ImportPreview>& preview, ImportSheet first,
                 const BMessenger& target);
    ~ImportWindow() override;

    void MessageReceived(BMessage* message) override;

private:
    /// In place of what is shown.
    void show(ImportSheet sheet);
    void showAgain() { show(preview_->sheet()); }
    float makeLines(BRect area, const ImportSheet& sheet);
    float makeQuestions(BRect area, const ImportSheet& sheet);
    void makeLists(BRect area, ImportSheet& sheet);
    void makeButtons(BRect area, const ImportSheet& sheet);

    std::shared_ptr<ImportPreview> preview_;
    BMessenger target_;
    PageView* panel_ = nullptr; // with all that is shown
    BStringView* headline_ = nullptr;
};
