#pragma once

#include "views/ColumnListView.h"
#include "views/ListPlaces.h"

#include <algorithm>
#include <span>
#include <unordered_map>
#include <vector>

/// A row for an object of the model that is found again by its own address. `kColumns` is defined for each class of
/// objects that a list shows.
template <class Object>
class ObjectItem final : public ColumnItem {
public:
    static const std::vector<ColumnOf<Object>> kColumns;

    explicit ObjectItem(Object* object) : object_(object) {}

    Object* object() const { return object_; }
    const void* key() const { return object_; }
    /// Leaves the row without object. It is not drawn any more.
    void release() { object_ = nullptr; }
    Cell cell(std::size_t column) const override { return kColumns[column].cell(*object_); }

private:
    Object* object_;
};

/// A list with a row for each of some objects of the model.
///
/// `Row` is a `ColumnItem` made from an `Object*`, with its columns in `kColumns`, and with two accessors that never
/// look into the object: `object()`, and `key()`, the address of what the row stands for, by which a selection is found
/// again after the list was filled anew (null for rows that shall not be found again). The list never looks into
/// objects by itself, but showing a row does: who destroys an object takes its row out before.
template <class Object, class Row = ObjectItem<Object>>
class ObjectListView : public ColumnListView {
public:
    explicit ObjectListView(const char* name, bool isSortable = true)
        : ColumnListView(name, {Row::kColumns.begin(), Row::kColumns.end()}, isSortable)
    {}

    /// Puts a row behind the others.
    void add(Object* object) { appendRow(makeRow(object)); }
    /// Puts it before the row at `place`, in a list that is neither sorted nor filtered.
    void insert(Object* object, int32 place) { insertRow(makeRow(object), place); }
    /// Adds rows for all of them at once. A list that is sorted or filtered shows them with `recall`, or when a
    /// selection is restored.
    void addAll(const std::vector<Object*>& objects)
    {
        std::vector<ColumnItem*> rows;
        rows.reserve(objects.size());
        for (Object* object : objects)
            rows.push_back(new Row(object));
        isIndexed_ = false;
        addRows(rows);
    }
    /// Replaces the rows; what was selected stays so where it still is, as does the place that the list is scrolled to.
    /// Sends no message.
    void setAll(const std::vector<Object*>& objects)
    {
        remember();
        clear();
        addAll(objects);
        recall();
    }

    /// Draws the object's row again.
    void modify(const Object* object)
    {
        if (Row* row = rowOf(object))
            redraw(row);
    }
    /// Takes the object's row out. @return false when there is none.
    bool remove(const Object* object)
    {
        Row* row = rowOf(object);
        if (row == nullptr)
            return false;
        rows_.erase(object);
        deselectWith(*row);
        destroyRow(row);
        return true;
    }
    /// The same, and puts the last row in its place.
    void removeByLast(const Object* object)
    {
        const Row* row = rowOf(object);
        if (row == nullptr)
            return;
        const int32 place = placeOf(row);
        remove(object);
        if (place + 1 < CountRows())
            moveRow(CountRows() - 1, place);
    }
    /// Leaves the object's row without object, in constant time, for when many objects go: `dropReleased` then takes
    /// all such rows out at once. Needs a row with `release()`. @return false when there is none.
    bool release(const Object* object)
    {
        Row* row = rowOf(object);
        if (row == nullptr)
            return false;
        deselectWith(*row);
        row->release();
        rows_.erase(object);
        hasReleased_ = true;
        return true;
    }
    void dropReleased()
    {
        if (!hasReleased_)
            return;
        std::vector<Object*> left;
        for (int32 i = 0; i < CountRows(); ++i) {
            if (Object* object = row(i)->object())
                left.push_back(object);
        }
        setAll(left);
    }
    void clear()
    {
        destroyRows();
        rows_.clear();
        isIndexed_ = false;
        hasReleased_ = false;
    }

    /// Negative when it has no row, or one that is not shown.
    int32 indexOf(const Object* object) const { return IndexOf(rowOf(object)); }
    /// Whether the object has a row, shown or not.
    bool has(const Object* object) const { return rowOf(object) != nullptr; }
    Object* objectAt(int32 index) const
    {
        const BListItem* item = ItemAt(index);
        return item != nullptr ? static_cast<const Row*>(item)->object() : nullptr;
    }
    /// The objects of all rows that are shown, from the top.
    std::vector<const Object*> allShown() const
    {
        std::vector<const Object*> objects;
        for (int32 i = 0; i < CountItems(); ++i)
            if (const Object* object = objectAt(i))
                objects.push_back(object);
        return objects;
    }
    /// The first selected object, null when there is none.
    Object* selected() const { return objectAt(CurrentSelection()); }
    /// All selected objects, from the top.
    std::vector<Object*> allSelected() const
    {
        std::vector<Object*> objects;
        for (int32 i = 0; i < CountSelected(); ++i)
            objects.push_back(objectAt(CurrentSelection(i)));
        return objects;
    }
    /// Selects the object's row alone, where it is shown, and brings it into view; sends the selection message.
    void select(const Object* object)
    {
        Select(indexOf(object));
        ScrollToSelection();
    }

    /// Keeps in mind what is selected and where the list is scrolled to, for `recall` to bring back after the list was
    /// emptied and filled.
    void remember()
    {
        if (CountRows() == 0)
            return; // it was emptied before, and what was kept in mind then still stands
        remembered_.clear();
        const ColumnItem* leading = leadingRow();
        rememberedLeading_ = leading != nullptr ? static_cast<const Row*>(leading)->key() : nullptr;
        for (int32 i = 0; i < CountSelected(); ++i) {
            if (const void* key = static_cast<const Row*>(ItemAt(CurrentSelection(i)))->key())
                remembered_.push_back(key);
        }
        rememberedTop_ = TopRow();
    }
    /// What was kept in mind no longer means anything here.
    void forget()
    {
        remembered_.clear();
        rememberedLeading_ = nullptr;
        rememberedTop_ = 0;
    }
    /// Sends no message.
    void recall()
    {
        settle();
        SetQuiet(true);
        std::sort(remembered_.begin(), remembered_.end());
        int32 first = -1; // of a run of rows that are selected together
        for (int32 i = 0; !remembered_.empty() && i <= CountItems(); ++i) {
            const void* key = i < CountItems() ? static_cast<const Row*>(ItemAt(i))->key() : nullptr;
            const bool isRemembered = key != nullptr && std::binary_search(remembered_.begin(), remembered_.end(), key);
            if (isRemembered && first < 0)
                first = i;
            if (!isRemembered && first >= 0) {
                Select(first, i - 1, true);
                first = -1;
            }
        }
        if (isSortable() && (!remembered_.empty() || rememberedLeading_ != nullptr))
            keepLeading(rowOfKey(rememberedLeading_));
        SetTopRow(rememberedTop_);
        SetQuiet(false);
        forget();
    }

    /// What is selected and in view, by place; without the rows.
    ListPlaces selection() const
    {
        ListPlaces places;
        for (int32 i = 0; i < CountSelected(); ++i)
            places.selected.push_back(placeAt(CurrentSelection(i)));
        std::ranges::sort(places.selected);
        places.top = CountItems() > 0 ? placeAt(TopRow()) : 0;
        places.count = CountRows();
        return places;
    }
    /// The same with the rows; all of them stand for one of `objects`.
    ListPlaces places(std::span<Object* const> objects) const
    {
        std::unordered_map<const Object*, std::size_t> placeOf;
        for (Object* object : objects)
            placeOf.emplace(object, placeOf.size());
        ListPlaces places = selection();
        for (int32 i = 0; i < CountRows(); ++i)
            if (const auto place = placeOf.find(row(i)->object()); place != placeOf.end())
                places.rows.push_back(place->second);
        return places;
    }
    /// Brings back selection and view, where the rows are as many as then: those that a valuation makes up may be
    /// others. Sends no message. What is not shown now is not selected.
    void restoreSelection(const ListPlaces& places)
    {
        settle();
        if (CountRows() != places.count)
            return;
        std::vector<int32> selected;
        for (const int32 place : places.selected)
            if (const int32 index = IndexOf(rowAt(place)); index >= 0)
                selected.push_back(index);
        std::ranges::sort(selected);
        SetQuiet(true);
        for (std::size_t i = 0; i < selected.size();) {
            const int32 first = selected[i]; // of a run, which is selected at once
            int32 last = first;
            while (++i < selected.size() && selected[i] == last + 1)
                ++last;
            Select(first, last, true);
        }
        // The rows may have been in another order then: in one that was chosen the view stays, but for the selection.
        if (isArranged())
            ScrollToSelection();
        else if (CountRows() > 0)
            SetTopRow(IndexOf(rowAt(places.top)));
        SetQuiet(false);
    }
    /// The same, and brings back the rows, with `objects` in the places of those of then.
    void restore(const ListPlaces& places, std::span<Object* const> objects)
    {
        std::vector<Object*> rows;
        for (const std::size_t place : places.rows)
            if (place < objects.size())
                rows.push_back(objects[place]);
        clear();
        addAll(rows);
        restoreSelection(places);
    }

private:
    Row* makeRow(Object* object)
    {
        auto* row = new Row(object);
        if (isIndexed_)
            rows_[object] = row;
        return row;
    }
    /// Of several selected rows commands take the first, in lists that can be sorted. When it goes, the others lose
    /// their selection: the fields are not about them. Sends no message.
    void deselectWith(const Row& row)
    {
        if (isSortable() && (row.IsSelected() || &row == leadingRow()))
            keepLeading(nullptr);
    }
    /// Null when there is none.
    Row* rowOfKey(const void* key) const
    {
        for (int32 i = 0; key != nullptr && i < CountRows(); ++i)
            if (row(i)->key() == key)
                return row(i);
        return nullptr;
    }
    Row* row(int32 place) const { return static_cast<Row*>(rowAt(place)); }
    int32 placeAt(int32 index) const { return placeOf(static_cast<const ColumnItem*>(ItemAt(index))); }
    /// Null when there is none.
    Row* rowOf(const Object* object) const
    {
        if (!isIndexed_) {
            rows_.clear();
            for (int32 i = 0; i < CountRows(); ++i)
                rows_[row(i)->object()] = row(i);
            isIndexed_ = true;
        }
        const auto found = rows_.find(object);
        return found != rows_.end() ? found->second : nullptr;
    }

    mutable std::unordered_map<const Object*, Row*> rows_; // when it is up to date
    mutable bool isIndexed_ = false;
    bool hasReleased_ = false; // rows that wait to be dropped
    std::vector<const void*> remembered_;
    const void* rememberedLeading_ = nullptr; // the key of the leading row
    int32 rememberedTop_ = 0;
};
