// What no relation of the model comes to; the rest is in the tests of series of quotes and of wallets, which change
// them at random from both ends.

#include "foundation/ManyToOneAssociation.h"
#include "foundation/OneToManyAssociation.h"

#include <gtest/gtest.h>

namespace {

struct Item;
struct Box;

class BoxToItems final : public OneToManyAssociation<BoxToItems, Box, Item> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& item) { return item.box; }
};

class ItemsToBox final : public ManyToOneAssociation<ItemsToBox, Item, Box> {
public:
    static int enter(auto& box, Item* item) { return box.entry != 0 ? box.entry : box.items.add(item); }
    static int leave(auto& box, Item* item) { return box.items.remove(item); }
};

struct Item {
    ~Item() { setBox(nullptr); }
    int setBox(Box* newBox) { return box.set(this, newBox); }

    ItemsToBox box;
};

struct Box {
    ~Box() { items.unlinkAll(); }

    int entry = 0; // what is answered to whatever would enter, when it is not 0
    BoxToItems items{this};
};

} // namespace

TEST(AssociationTest, WhatIsRefusedOrNotThereHasNoEffect)
{
    Box former, box;
    Item a, b;
    former.items.add(&a);
    box.entry = 7;
    EXPECT_EQ(a.setBox(&box), 7);
    EXPECT_EQ(former.items.getNbr() + box.items.getNbr(), 0U) << "it has left, and is nowhere";
    EXPECT_EQ(a.box.partner(), nullptr);
    box.entry = 0;
    for (const char* turn : {"new", "again"})
        EXPECT_EQ(box.items.add(&a), 0) << turn;
    EXPECT_EQ(box.items.remove(&b), 0) << "what is not there";
    EXPECT_EQ(box.items.getNbr(), 1U);
    EXPECT_EQ(box.items.at(0), &a);
}
