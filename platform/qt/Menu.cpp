#include "platform/Menu.h"

#include <algorithm>
#include <cstring>

void BMenuItem::SetMarked(bool marked)
{
    // Without a menu there are no others that would lose their mark.
    if (menu_ != nullptr)
        menu_->mark(this, marked);
    else
        marked_ = marked;
}

bool BMenu::AddItem(BMenuItem* item)
{
    items_.emplace_back(item);
    item->menu_ = this;
    // After this the item is one of the menu, which destroys it.
    changed();
    return true;
}

void BMenu::ReplaceItems(const std::vector<BMenuItem*>& items)
{
    // The former items are destroyed, so nobody may hold on to the one that was marked.
    items_.clear();
    for (BMenuItem* item : items) {
        items_.emplace_back(item);
        item->menu_ = this;
    }
    // Once for all: the menu field fills itself anew at each call.
    changed();
}

BMenuItem* BMenu::ItemAt(int32 index) const
{
    return index >= 0 && index < CountItems() ? items_[static_cast<std::size_t>(index)].get() : nullptr;
}

BMenuItem* BMenu::FindItem(const char* label) const
{
    return ItemAt(find([label](const BMenuItem& item) { return std::strcmp(item.Label(), label) == 0; }));
}

int32 BMenu::find(const std::function<bool(const BMenuItem&)>& isIt) const
{
    const auto found = std::ranges::find_if(items_, [&](const auto& item) { return isIt(*item); });
    return found != items_.end() ? static_cast<int32>(found - items_.begin()) : -1;
}

void BMenu::mark(BMenuItem* item, bool marked)
{
    // At most one item is marked, before and after.
    for (const auto& other : items_)
        other->marked_ = other->marked_ && !marked;
    item->marked_ = marked;
    changed();
}

void BMenu::changed() const
{
    if (observer_)
        observer_();
}
