#include "platform/Menu.h"

#include "platform/MenuItem.h"

#include <algorithm>
#include <cstring>

void BMenuItem::SetMarked(bool marked)
{
    if (menu_ != nullptr)
        menu_->mark(this, marked);
    else
        marked_ = marked;
}

BMenu::BMenu(const char* name) : name_(name) {}

BMenu::~BMenu() = default;

bool BMenu::AddItem(BMenuItem* item)
{
    items_.emplace_back(item);
    item->menu_ = this;
    changed();
    return true;
}

void BMenu::ReplaceItems(const std::vector<BMenuItem*>& items)
{
    items_.clear();
    for (BMenuItem* item : items) {
        items_.emplace_back(item);
        item->menu_ = this;
    }
    changed();
}

BMenuItem* BMenu::ItemAt(int32 index) const
{
    return index >= 0 && index < CountItems() ? items_[static_cast<std::size_t>(index)].get() : nullptr;
}

BMenuItem* BMenu::FindItem(const char* label) const
{
    const auto found =
        std::find_if(items_.begin(), items_.end(), [&](const auto& i) { return std::strcmp(i->Label(), label) == 0; });
    return found != items_.end() ? found->get() : nullptr;
}

BMenuItem* BMenu::FindMarked() const
{
    const auto found = std::find_if(items_.begin(), items_.end(), [](const auto& i) { return i->IsMarked(); });
    return found != items_.end() ? found->get() : nullptr;
}

int32 BMenu::IndexOf(const BMenuItem* item) const
{
    const auto found = std::find_if(items_.begin(), items_.end(), [&](const auto& i) { return i.get() == item; });
    return found != items_.end() ? static_cast<int32>(found - items_.begin()) : -1;
}

void BMenu::mark(BMenuItem* item, bool marked)
{
    for (const auto& other : items_) {
        if (marked)
            other->marked_ = false;
    }
    item->marked_ = marked;
    changed();
}

void BMenu::changed() const
{
    if (observer_)
        observer_();
}
