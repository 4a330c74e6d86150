#pragma once

#include <cstdint>
#include <type_traits>

template <class ManyEnd, class Owner, class Element, bool sorted>
class OneToManyAssociation;

/// The link of one element to its owner, held by the element; its counterpart is the owner's `OneToManyAssociation`.
///
/// Linking from either end updates the other. `OneEnd` is the relation's own class, derived from this one; it says
/// where the list lives, in a static function `list(Owner&)`. Where linking shall do more than entering the list, it
/// has `enter(Owner&, Element*)` and `leave(Owner&, Element*)` instead.
///
/// The link knows its partner and the place of its element in the partner's list, so that membership and removal need
/// no search. `sorted` links also know as which of the list's elements theirs was added.
template <class OneEnd, class Element, class Owner, bool sorted = false>
class ManyToOneAssociation {
public:
    ManyToOneAssociation() = default;
    ManyToOneAssociation(const ManyToOneAssociation&) = delete;
    ManyToOneAssociation& operator=(const ManyToOneAssociation&) = delete;

    /// `*partner` becomes the linked object, null when there is none.
    /// @return 0; -1 when not linked.
    int get(Owner** partner) const
    {
        *partner = partner_;
        return partner_ != nullptr ? 0 : -1;
    }
    /// The linked object, null when there is none.
    Owner* partner() const { return partner_; }

    /// Takes `element`, which holds this link, out of its present owner's list and into that of `p`; null only leaves.
    /// @return 0; what the old list answered when it would not let go (nothing has changed then), or what the new one
    /// answered when it refused (the element is then unlinked).
    int set(Element* element, Owner* p)
    {
        if (p == partner_)
            return 0;
        if (Owner* old = partner_) {
            partner_ = nullptr; // the list sees that the link has let go, and does not call back
            if (const int failure = OneEnd::leave(*old, element)) {
                partner_ = old;
                return failure;
            }
        }
        partner_ = p;
        if (p == nullptr)
            return 0;
        const int failure = OneEnd::enter(*p, element);
        if (failure != 0)
            partner_ = nullptr;
        return failure;
    }

protected:
    ~ManyToOneAssociation() = default; // always a member, held by value and destroyed as what it is

    /// Adds the element to the owner's list, and removes it from there.
    static int enter(Owner& owner, Element* element) { return OneEnd::list(owner).add(element); }
    static int leave(Owner& owner, Element* element) { return OneEnd::list(owner).remove(element); }

private:
    template <class ManyEnd, class AnOwner, class AnElement, bool isListSorted>
    friend class OneToManyAssociation;

    struct Turn {
        std::uint32_t number = 0;
    };
    struct NoTurn {};

    Owner* partner_ = nullptr;
    std::uint32_t place_ = 0; // index of the element in the partner's list, kept by that list
    // Rises with each addition to the list: the order of equal sort keys.
    [[no_unique_address]] std::conditional_t<sorted, Turn, NoTurn> turn_;
};
