#pragma once

#include "foundation/Date.h"
#include "views/ObjectListView.h"

#include <algorithm>
#include <ranges>
#include <vector>

/// A list of objects with a date, in its order and in no other.
///
/// The rows look at the dates of their objects, so an object's row is taken out before it is destroyed.
template <class Object>
class DatedListView : public ObjectListView<Object> {
public:
    explicit DatedListView(const char* name) : ObjectListView<Object>(name, false) {}

    /// Shows these objects, given in any order, and no others. When they are what is shown already, nothing but the
    /// drawing is done.
    void showAll(std::vector<Object*> objects)
    {
        const auto dateOf = [](const Object* object) { return object->getDate(); };
        if (!std::ranges::is_sorted(objects, {}, dateOf))
            std::ranges::stable_sort(objects, {}, dateOf);
        if (!isShown(objects))
            this->setAll(objects);
        this->InvalidateItems();
    }

    /// Puts a row for the object where its date belongs, and scrolls there.
    void insert(Object* object)
    {
        const int32 index = placeFor(object->getDate(), 0, this->CountItems());
        ObjectListView<Object>::insert(object, index);
        this->ScrollTo(index);
    }

    /// Draws the object's row again; when its date has changed, at its new place.
    void update(const Object* object)
    {
        const int32 index = this->indexOf(object);
        if (index < 0)
            return;
        const int32 place = placeAfterChange(index, object->getDate());
        if (place != index) {
            this->moveRow(index, place);
            this->ScrollTo(place);
        }
        this->InvalidateItem(place);
    }

    /// Takes out the rows of all of them, in one pass over the list.
    void removeAll(const std::vector<Object*>& objects)
    {
        if (objects.size() == 1) {
            this->remove(objects.front());
            return;
        }
        for (const Object* object : objects)
            this->release(object);
        this->dropReleased();
    }

private:
    bool isShown(const std::vector<Object*>& objects) const
    {
        const auto objectAt = [this](int32 i) { return this->objectAt(i); };
        return std::ranges::equal(objects, std::views::iota(0, this->CountItems()), {}, {}, objectAt);
    }

    Date dateAt(int32 index) const { return this->objectAt(index)->getDate(); }

    /// The first row from `begin` on, and before `end`, whose date is later; `end` when there is none.
    int32 placeFor(const Date& date, int32 begin, int32 end) const
    {
        const auto dateOfRow = [this](int32 i) { return dateAt(i); };
        const auto rows = std::views::iota(begin, end);
        return begin + static_cast<int32>(std::ranges::upper_bound(rows, date, {}, dateOfRow) - rows.begin());
    }

    /// Where the row at `index` belongs among the others, now that it has this date.
    int32 placeAfterChange(int32 index, const Date& date) const
    {
        if (index > 0 && dateAt(index - 1) > date)
            return placeFor(date, 0, index);
        if (index + 1 < this->CountItems() && dateAt(index + 1) < date)
            return placeFor(date, index + 1, this->CountItems()) - 1;
        return index;
    }
};
