#pragma once

#include <cstdint>

template <class Owner, class Element>
class OneToManyAssociation;

/// The link of one element to its owner, held by the element; its counterpart is the owner's `OneToManyAssociation`.
///
/// Linking from either end updates the other. The named subclass of each relation reaches the owner's list in `xAdd`
/// and `xRemove`. The link also remembers where its element stands in that list and as which it was added, so that
/// membership and removal need no search.
template <class Element, class Owner>
class ManyToOneAssociation {
public:
    /// `owner` is the element that holds this link.
    explicit ManyToOneAssociation(Element* owner) : owner_(owner) {}
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

    /// Leaves the present owner's list and enters that of `p`; null only leaves.
    /// @return 0; what the old list answered when it would not let go (nothing has changed then), or what the new one
    /// answered when it refused (the element is then unlinked).
    int set(Owner* p)
    {
        if (p == partner_)
            return 0;
        if (Owner* old = partner_) {
            partner_ = nullptr;
            if (const int failure = xRemove(old)) {
                partner_ = old;
                return failure;
            }
        }
        partner_ = p;
        if (p == nullptr)
            return 0;
        const int failure = xAdd(p);
        if (failure != 0)
            partner_ = nullptr;
        return failure;
    }

    int xRmv(Owner* p) { return xRemove(p); }

protected:
    ~ManyToOneAssociation() = default; // always a member, held by value and destroyed as what it is

    Element* owner() const { return owner_; }
    /// Adds this link's element to the many end of `partner`.
    virtual int xAdd(Owner* partner) = 0;
    /// Removes it from there.
    virtual int xRemove(Owner* partner) = 0;

private:
    friend class OneToManyAssociation<Owner, Element>;

    Element* owner_;
    Owner* partner_ = nullptr;
    std::uint32_t place_ = 0;    // index of the element in the partner's list, kept by that list
    std::uint32_t sequence_ = 0; // rises with each addition to the list: the order of equal sort keys
};
