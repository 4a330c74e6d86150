#include "app/Shortcuts.h"

#include "app/FirstSteps.h"
#include "app/ReportAssistant.h"
#include "platform/Button.h"
#include "platform/ListView.h"
#include "platform/Message.h"
#include "platform/TabView.h"
#include "platform/Window.h"
#include "views/PageView.h"

#include <cstring>
#include <vector>

namespace {

constexpr uint32 kShowTab = 'KyTb';
constexpr uint32 kLoad = 'KyLd';
constexpr uint32 kSave = 'KySv';
constexpr uint32 kAdd = 'KyAd';
constexpr uint32 kUndo = 'KyUn';
constexpr uint32 kRedo = 'KyRe';
constexpr uint32 kFind = 'KyFi';

void press(BView* button)
{
    if (auto* control = dynamic_cast<BButton*>(button))
        control->Invoke();
}

bool isAdd(const BView* view)
{
    const auto* button = dynamic_cast<const BButton*>(view);
    return button != nullptr && std::strcmp(button->Label(), PageView::kAddLabel) == 0;
}

/// The button that adds among the children of `view` or, failing that, of the view around it, and so on.
BView* addButtonAround(const BView* view)
{
    for (; view != nullptr; view = view->Parent()) {
        for (int32 i = 0; i < view->CountChildren(); ++i) {
            if (isAdd(view->ChildAt(i)))
                return view->ChildAt(i);
        }
    }
    return nullptr;
}

void collectAddButtons(BView& view, std::vector<BView*>& found)
{
    if (isAdd(&view))
        found.push_back(&view);
    for (int32 i = 0; i < view.CountChildren(); ++i)
        collectAddButtons(*view.ChildAt(i), found);
}

BView* firstListOf(BView& view)
{
    if (dynamic_cast<BListView*>(&view) != nullptr)
        return &view;
    for (int32 i = 0; i < view.CountChildren(); ++i) {
        if (BView* found = firstListOf(*view.ChildAt(i)))
            return found;
    }
    return nullptr;
}

} // namespace

Shortcuts::Shortcuts(BWindow& window, BTabView& tabs) : window_(window), tabs_(tabs)
{
    for (int32 i = 0; i < tabs.CountTabs(); ++i) {
        auto* message = new BMessage(kShowTab);
        message->AddInt32("tab", i);
        window.AddShortcut('1' + static_cast<uint32>(i), B_COMMAND_KEY, message, this);
    }
    window.AddShortcut('O', B_CONTROL_KEY, new BMessage(kLoad), this);
    window.AddShortcut('O', B_CONTROL_KEY | B_SHIFT_KEY, new BMessage(FirstSteps::kOpenLast), &window);
    window.AddShortcut('S', B_CONTROL_KEY, new BMessage(kSave), this);
    window.AddShortcut('N', B_CONTROL_KEY, new BMessage(kAdd), this);
    window.AddShortcut('P', B_CONTROL_KEY, new BMessage(ReportAssistant::kAsked));
    window.AddShortcut('F', B_CONTROL_KEY, new BMessage(kFind), this);
    window.AddShortcut('Z', B_CONTROL_KEY, new BMessage(kUndo), this);
    window.AddShortcut('Z', B_CONTROL_KEY | B_SHIFT_KEY, new BMessage(kRedo), this);
}

BLooper* Shortcuts::Looper() const
{
    return &window_;
}

void Shortcuts::MessageReceived(BMessage* message)
{
    int32 tab;
    switch (message->what) {
    case kShowTab:
        if (message->FindInt32("tab", &tab) == B_OK)
            tabs_.Select(tab);
        break;
    case kLoad:
        pressFileButton("btnLoadMarket", "btnLoadPortoFolio");
        break;
    case kSave:
        pressFileButton("btnSaveMarket", "btnSavePortoFolio");
        break;
    case kAdd:
        pressAdd();
        break;
    case kUndo:
        press(window_.FindView("btnUndo"));
        break;
    case kRedo:
        press(window_.FindView("btnRedo"));
        break;
    case kFind:
        find();
        break;
    default:
        BHandler::MessageReceived(message);
    }
}

BView& Shortcuts::front() const
{
    return *tabs_.TabAt(tabs_.Selection())->View();
}

void Shortcuts::pressFileButton(const char* ofMarkets, const char* ofPortfolio)
{
    if (BView* button = front().FindView(ofMarkets)) {
        press(button);
        return;
    }
    // What a save or a load is about goes by the page in front.
    for (int32 i = 0; front().FindView(ofPortfolio) == nullptr && i < tabs_.CountTabs(); ++i) {
        if (tabs_.TabAt(i)->View()->FindView(ofPortfolio) != nullptr)
            tabs_.Select(i);
    }
    press(front().FindView(ofPortfolio));
}

void Shortcuts::pressAdd()
{
    if (BView* button = addButtonAround(window_.CurrentFocus())) {
        press(button);
        return;
    }
    std::vector<BView*> buttons;
    collectAddButtons(front(), buttons);
    if (buttons.size() == 1)
        press(buttons.front());
}

void Shortcuts::find()
{
    // A list finds what is typed while it has the keyboard.
    BView* place = front().FindView("txtFilter");
    if (place == nullptr)
        place = firstListOf(front());
    if (place != nullptr)
        place->MakeFocus();
}
