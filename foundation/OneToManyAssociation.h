#pragma once

#include "foundation/ManyToOneAssociation.h"

#include <algorithm>
#include <cassert>
#include <cstdlib>
#include <new>
#include <span>

/// The list of an owner's elements; each element holds the counterpart, a `ManyToOneAssociation`.
///
/// `ManyEnd` is the relation's own class, derived from this one. It says where the link lives, in a static function
/// `link(Element&)`, and, when the list is `sorted`, in which order, by a static function `compare` as for `qsort`.
///
/// Membership, addition and removal take constant time. A sorted list is put in order by the next read after a change
/// that may have disturbed it; elements with equal keys keep the order in which they were added. An unsorted list does
/// not keep its order on removal: the last element takes the free place.
///
/// The list does not own its elements. The owner empties it (`deleteAll` or `unlinkAll`) before it dies.
template <class ManyEnd, class Owner, class Element, bool sorted = false>
class OneToManyAssociation {
public:
    /// `owner` is the object that holds this list.
    explicit OneToManyAssociation(Owner* owner) : owner_(owner) {}
    OneToManyAssociation(const OneToManyAssociation&) = delete;
    OneToManyAssociation& operator=(const OneToManyAssociation&) = delete;
    ~OneToManyAssociation()
    {
        assert(count_ == 0); // the elements would keep a link to a list that is gone
        std::free(elements_);
    }

    /// @return -1 for null; 0 without effect for an element that is here already; otherwise what linking the element
    /// back to the owner gives, after a failure of which the element is not in the list.
    int add(Element* e)
    {
        if (e == nullptr)
            return -1;
        if (contains(e))
            return 0;
        append(e);
        const int failure = ManyEnd::link(*e).partner_ == owner_ ? 0 : ManyEnd::link(*e).set(e, owner_);
        if (failure != 0)
            --count_;
        else
            settle(ManyEnd::link(*e));
        return failure;
    }

    /// The same for an element that has just been made: it is in no list, and nobody refuses it. `add` would ask, which
    /// counts where there are millions.
    void addNew(Element* e)
    {
        auto& link = ManyEnd::link(*e);
        assert(link.partner_ == nullptr);
        append(e);
        link.partner_ = owner_;
        settle(link);
    }

    /// @return 0 without effect for an element that is not here; otherwise what unlinking the element gives, after a
    /// failure of which nothing has changed.
    int remove(Element* e)
    {
        if (e == nullptr || !contains(e))
            return 0;
        // The link goes first and comes back here once it is free, so that a refusal leaves both ends as they were.
        if (ManyEnd::link(*e).partner_ == owner_)
            return xUnSet(e);
        const std::uint32_t place = placeOf(e);
        if (--count_ != place) {
            elements_[place] = elements_[count_];
            ManyEnd::link(*elements_[place]).place_ = place;
            changeNotice();
        }
        shrink();
        return 0;
    }

    /// `*out` becomes element `i`, null with -1 when `i` is out of range.
    int getAt(Element** out, unsigned i) const
    {
        if (i >= count_) {
            *out = nullptr;
            return -1;
        }
        sortWhenDirty();
        *out = elements_[i];
        return 0;
    }
    /// The element at `i`, null out of range.
    Element* at(unsigned i) const
    {
        Element* e;
        getAt(&e, i);
        return e;
    }
    /// The list's own array, in order; valid until the next change. `*n` becomes the count; null when empty.
    Element** getAll(unsigned* n) const
    {
        sortWhenDirty();
        *n = count_;
        return count_ > 0 ? elements_ : nullptr; // a refused addition leaves room behind
    }
    /// The same as a range.
    std::span<Element* const> all() const
    {
        sortWhenDirty();
        return {elements_, count_};
    }
    unsigned getNbr() const { return count_; }
    /// `*index` becomes the element's place as the list stands: only `getAt` and `getAll` put a sorted one in order.
    /// @return 0; -1 when it is not here.
    int getElement(Element* e, unsigned* index) const
    {
        if (e == nullptr || !contains(e))
            return -1;
        *index = placeOf(e);
        return 0;
    }
    bool contains(Element* e) const { return placeOf(e) < count_; }

    /// Puts the list in order now; an unsorted list stays as it is.
    void sort() const
    {
        if constexpr (sorted) {
            // What stands in order at the front, often nearly all, is only merged with the rest.
            Element** end = elements_ + count_;
            Element** rest = std::is_sorted_until(elements_, end, isBefore);
            std::sort(rest, end, isBefore);
            std::inplace_merge(elements_, rest, end, isBefore);
            notePlaces();
        }
    }
    /// To be called when the sort key of an element has changed.
    void changeNotice()
    {
        if constexpr (sorted)
            order_.isDisturbed = true;
    }

    /// Keeps a turn in the order of equal keys for an element that is added later and then given it by `setTurn`.
    std::uint32_t reserveTurn() { return order_.nextTurn++; }
    void setTurn(Element* e, std::uint32_t turn)
    {
        ManyEnd::link(*e).turn_.number = turn;
        changeNotice();
    }

    int xUnSet(Element* e) { return ManyEnd::link(*e).set(e, nullptr); }

    /// Makes room for `count` elements at once; only a saving, never needed.
    void reserve(std::uint32_t count)
    {
        if (count > capacity_)
            setCapacity(count);
    }

    /// Destroys every element, always the first of the list as it then stands; each unlinks itself.
    ///
    /// In an unsorted list the last element takes the place of each one that goes. Intended: it settles in which order
    /// an element's other owners, who lose it, too, are left with the rest of theirs.
    void deleteAll()
    {
        if constexpr (sorted)
            turnRound();
        while (count_ > 0) {
            if constexpr (sorted)
                if (!order_.isDisturbed) // an element's end has read the list, and so put it in order again
                    turnRound();
            delete elements_[sorted ? count_ - 1 : 0];
        }
    }
    /// Empties the list without a word to its elements: for those that all cease to be at once.
    void forgetAll()
    {
        count_ = 0;
        shrink();
    }
    /// Unlinks every element and leaves it alone otherwise; stops at one that will not be unlinked.
    void unlinkAll()
    {
        while (count_ > 0 && remove(elements_[count_ - 1]) == 0) {
        }
    }

private:
    /// What only a sorted list knows.
    struct Order {
        std::uint32_t nextTurn = 0;
        bool isDisturbed = false; // an element may stand in the wrong place
    };
    struct NoOrder {};

    /// The place of `e`, or a number from `count_` up when it is not here. While `add` is linking its element, that
    /// stands at the end, but its link still remembers the place in the list it is leaving.
    std::uint32_t placeOf(Element* e) const
    {
        const std::uint32_t place = ManyEnd::link(*e).place_;
        if (place < count_ && elements_[place] == e)
            return place;
        return count_ > 0 && elements_[count_ - 1] == e ? count_ - 1 : count_;
    }

    void append(Element* e)
    {
        if (count_ == capacity_)
            setCapacity(capacity_ + capacity_ / 2 + 2);
        if constexpr (sorted)
            if (!order_.isDisturbed && count_ > 0 && ManyEnd::compare(&elements_[count_ - 1], &e) > 0)
                changeNotice();
        elements_[count_++] = e;
    }

    /// Tells the link of the last element its place, and its turn among those of equal keys.
    template <class Link>
    void settle(Link& link)
    {
        link.place_ = count_ - 1;
        if constexpr (sorted)
            link.turn_.number = order_.nextTurn++;
    }

    static bool isBefore(Element* a, Element* b)
    {
        const int order = ManyEnd::compare(&a, &b);
        return order != 0 ? order < 0 : ManyEnd::link(*a).turn_.number < ManyEnd::link(*b).turn_.number;
    }

    /// Tells every link where its element stands.
    void notePlaces() const
    {
        for (std::uint32_t i = 0; i < count_; ++i)
            ManyEnd::link(*elements_[i]).place_ = i;
    }

    void sortWhenDirty() const
    {
        if constexpr (sorted) {
            if (!order_.isDisturbed)
                return;
            order_.isDisturbed = false;
            sort();
        }
    }

    /// Puts a sorted list in order from the last to the first, so that the first one can leave without moving others.
    /// The list counts as disturbed from here on: whoever reads it finds it in order.
    void turnRound()
    {
        sortWhenDirty();
        std::reverse(elements_, elements_ + count_);
        notePlaces();
        changeNotice();
    }

    void shrink()
    {
        if (count_ == 0) {
            std::free(elements_);
            elements_ = nullptr;
            capacity_ = 0;
            order_ = {};
        } else if (capacity_ > 16 && count_ <= capacity_ / 4)
            setCapacity(capacity_ / 2);
    }

    void setCapacity(std::uint32_t capacity)
    {
        void* moved = std::realloc(elements_, capacity * sizeof(Element*));
        if (moved == nullptr)
            throw std::bad_alloc();
        elements_ = static_cast<Element**>(moved);
        capacity_ = capacity;
    }

    Owner* owner_;
    Element** elements_ = nullptr; // malloc'ed, owned; null when empty
    std::uint32_t count_ = 0;
    std::uint32_t capacity_ = 0;
    [[no_unique_address]] mutable std::conditional_t<sorted, Order, NoOrder> order_;
};
