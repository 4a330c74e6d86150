#pragma once

#include "platform/Rect.h"
#include "platform/SupportDefs.h"

#include <string>
#include <utility>
#include <vector>

class BMenuField;
class BWindow;

/// Works the window by the names of its controls, as a person does by mouse and keyboard, and takes pictures of it.
///
/// A name is looked for on the page that is shown. What is asked for and is not there throws std::runtime_error with
/// one line that names it.
class TourHand {
public:
    /// The pictures go into the folder `pictures`, which is there.
    TourHand(BWindow& window, std::string pictures) : window_(window), pictures_(std::move(pictures)) {}

    /// Shows a page, counted from the left.
    void turnTo(int32 page);
    /// Types into fields and leaves them.
    void type(const std::vector<std::pair<const char*, const char*>>& fields);
    void press(const char* button);
    /// Sets a check box.
    void tick(const char* box, bool on);
    /// Chooses the item of that label in a menu.
    void choose(const char* menu, const char* item);
    /// Selects the rows of a list from `first` to `last`.
    void select(const char* list, int32 first, int32 last);
    void select(const char* list, int32 row) { select(list, row, row); }
    /// Gives a command that has a key and no button.
    void command(uint32 code);
    /// Leaves the menu that a button has opened.
    void closeMenu();
    /// Sends the notice away that is shown.
    void dismissNotice();
    /// Writes what the window shows within `part` as NAME.png, and tells the path on standard output.
    void picture(const char* name, BRect part);

    // The same of the window that has come up before the other one.
    void pressInFront(const char* button);
    void chooseInFront(const char* menu, const char* item);
    void pictureInFront(const char* name);

private:
    static void choose(BMenuField& menu, const char* item);
    void writePicture(const BWindow& window, const char* name, BRect part);
    template <class View>
    View& find(const char* name);

    BWindow& window_;
    std::string pictures_;
};
