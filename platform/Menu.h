#pragma once

#include "platform/MenuItem.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

/// A list of choices, of which one is marked at a time. Owns its items.
class BMenu {
public:
    explicit BMenu(const char* name) : name_(name) {}
    virtual ~BMenu() = default;
    BMenu(const BMenu&) = delete;
    BMenu& operator=(const BMenu&) = delete;

    const char* Name() const { return name_.c_str(); }
    /// Takes ownership of `item`. @return true
    bool AddItem(BMenuItem* item);
    /// Destroys the items that are here and takes ownership of `items`.
    void ReplaceItems(const std::vector<BMenuItem*>& items);
    int32 CountItems() const { return static_cast<int32>(items_.size()); }
    /// Null out of range.
    BMenuItem* ItemAt(int32 index) const;
    /// The first item of that label; null when there is none.
    BMenuItem* FindItem(const char* label) const;
    BMenuItem* FindMarked() const
    {
        return ItemAt(find([](const BMenuItem& item) { return item.IsMarked(); }));
    }
    /// Negative when it is not here.
    int32 IndexOf(const BMenuItem* item) const
    {
        return find([=](const BMenuItem& other) { return &other == item; });
    }

    /// For the platform's own use: told of every change, so that what shows the menu can follow.
    void setObserver(std::function<void()> observer) { observer_ = std::move(observer); }

private:
    friend class BMenuItem;
    void mark(BMenuItem* item, bool marked);
    void changed() const;
    /// The index of the first item that `isIt`; negative when there is none.
    int32 find(const std::function<bool(const BMenuItem&)>& isIt) const;

    std::string name_;
    std::vector<std::unique_ptr<BMenuItem>> items_;
    std::function<void()> observer_;
};
