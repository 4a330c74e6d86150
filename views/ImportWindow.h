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
/// "Import" sends `kImported` to the window that has opened this one; "Cancel", Escape and closing send `kLeft`. It is
/// modal; what becomes of the model meanwhile is the receiver's to find out.
///
/// An answer shows a new sheet. What was pressed or chosen on the one before, and comes later, counts no more: a person
/// imports what they have seen.
class ImportWindow final : public BWindow {
public:
    static constexpr uint32 kImported = 'TIdo';
    static constexpr uint32 kLeft = 'TIno';

    /// `middle` is the middle of the upper edge, on the screen. `first` is what `preview` shows at first.
    ImportWindow(BPoint middle, const std::shared_ptr<ImportPreview>& preview, ImportSheet first,
                 const BMessenger& target);
    ~ImportWindow() override;

    void MessageReceived(BMessage* message) override;
    bool QuitRequested() override;
    void GiveWay(float width, float height) override;

private:
    /// What a control of the sheet that is shown sends.
    BMessage answer(uint32 code, const char* control = "") const;
    /// In place of what is shown.
    void show(ImportSheet sheet);
    void showAgain() { show(preview_->sheet()); }
    float makeLines(BRect area, const ImportSheet& sheet);
    float makeQuestions(BRect area, const ImportSheet& sheet);
    void makeLists(BRect area, ImportSheet& sheet);
    void makeButtons(BRect area, const ImportSheet& sheet);
    BView* makeMenu(BRect frame, const ImportSheet::Question& question);
    BView* makeField(BRect frame, const ImportSheet::Question& question);

    std::shared_ptr<ImportPreview> preview_;
    BMessenger target_;
    PageView* panel_ = nullptr; // with all that is shown
    BStringView* headline_ = nullptr;
    int32 sheet_ = 0; // the number of what is shown
    bool isImported_ = false;
};
