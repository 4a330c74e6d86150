#include "tools/tour/TourHand.h"

#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/ListView.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/Message.h"
#include "platform/Messenger.h"
#include "platform/Screenshot.h"
#include "platform/TabView.h"
#include "platform/TextControl.h"
#include "platform/Window.h"

#include <iostream>
#include <stdexcept>

namespace {

BTabView& tabsOf(const BWindow& window)
{
    return dynamic_cast<BTabView&>(*window.FindView("TabView"));
}

} // namespace

template <class View>
View& TourHand::find(const char* name)
{
    // On other pages there are controls of the same name.
    const BTabView& tabs = tabsOf(window_);
    auto* view = dynamic_cast<View*>(tabs.TabAt(tabs.Selection())->View()->FindView(name));
    if (view == nullptr)
        throw std::runtime_error(std::string(name) + ": is not on the page");
    return *view;
}

void TourHand::turnTo(int32 page)
{
    tabsOf(window_).Select(page);
    handle_pending_messages();
}

void TourHand::type(const std::vector<std::pair<const char*, const char*>>& fields)
{
    // As a person leaves a field: the text changes, and then the field says so.
    for (const auto& [name, text] : fields) {
        auto& field = find<BTextControl>(name);
        field.SetText(text);
        field.TextModified();
        field.Invoke();
    }
    handle_pending_messages();
}

void TourHand::press(const char* button)
{
    find<BButton>(button).Invoke();
    handle_pending_messages();
}

void TourHand::tick(const char* box, bool on)
{
    auto& shown = find<BCheckBox>(box);
    shown.SetValue(on ? B_CONTROL_ON : B_CONTROL_OFF);
    shown.Invoke();
    handle_pending_messages();
}

void TourHand::choose(const char* menu, const char* item)
{
    choose(find<BMenuField>(menu), item);
}

void TourHand::chooseInFront(const char* menu, const char* item)
{
    choose(dynamic_cast<BMenuField&>(*BWindow::newest()->FindView(menu)), item);
}

void TourHand::choose(BMenuField& menu, const char* item)
{
    BMenuItem* chosen = menu.Menu()->FindItem(item);
    if (chosen == nullptr)
        throw std::runtime_error(std::string(item) + ": is not in the menu " + menu.Name());
    chosen->SetMarked(true);
    chosen->Invoke();
    handle_pending_messages();
}

void TourHand::select(const char* list, int32 first, int32 last)
{
    auto& rows = find<BListView>(list);
    if (rows.CountItems() <= last)
        throw std::runtime_error(std::string(list) + ": has no row " + std::to_string(last));
    rows.Select(first, last, false);
    handle_pending_messages();
}

void TourHand::command(uint32 code)
{
    const BMessage message(code);
    BMessenger(&window_).SendMessage(&message);
    handle_pending_messages();
}

void TourHand::closeMenu()
{
    close_menu();
    handle_pending_messages();
}

void TourHand::dismissNotice()
{
    window_.FindView("txtNotice")->MouseDown({});
    handle_pending_messages();
}

void TourHand::picture(const char* name, BRect part)
{
    writePicture(window_, name, part);
}

void TourHand::pressInFront(const char* button)
{
    dynamic_cast<BButton&>(*BWindow::newest()->FindView(button)).Invoke();
    handle_pending_messages();
}

void TourHand::pictureInFront(const char* name)
{
    const BWindow& front = *BWindow::newest();
    writePicture(front, name, front.Bounds());
}

void TourHand::writePicture(const BWindow& window, const char* name, BRect part)
{
    // What the last step has set going is to be seen on the picture.
    handle_pending_messages();
    const std::string path = pictures_ + '/' + name + ".png";
    if (save_screenshot(window, part, path.c_str()) != B_OK)
        throw std::runtime_error(path + ": cannot be written");
    std::cout << path << '\n';
}
