#pragma once

#include "foundation/Date.h"
#include "views/ObjectListView.h"

#include <algorithm>
#include <vector>

/// A list of objects with a date, in its order; several can be selected.
///
/// The rows look at the dates of their objects, so an object's row is taken out before it is destroyed.
template <class Object>
class DatedListView : public ObjectListView<Object> {
public:
    explicit DatedListView(const char* name) : ObjectListView<Object>(name, B_MULTIPLE_SELECTION_LIST) {}

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
        this->add(object, index);
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
            this->move(index, place);
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
        bool isSame = static_cast<int32>(objects.size()) == this->CountItems();
        for (int32 i = 0; isSame && i < this->CountItems(); ++i)
            isSame = this->objectAt(i) == objects[static_cast<std::size_t>(i)];
        return isSame;
    }

    Date dateAt(int32 index) const { return this->objectAt(index)->getDate(); }

    /// The first row from `begin` on, and before `end`, whose date is later; `end` when there is none.
    int32 placeFor(const Date& date, int32 begin, int32 end) const
    {
        while (begin < end) {
            const int32 middle = begin + (end - begin) / 2;
            if (dateAt(middle) > date)
                end = middle;
            else
                begin = middle + 1;
        }
        return begin;
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
