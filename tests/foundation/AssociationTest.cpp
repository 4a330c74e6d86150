#include "foundation/ManyToOneAssociation.h"
#include "foundation/OneToManyAssociation.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

struct Item;
struct Box;

class BoxToItems : public OneToManyAssociation<Box, Item> {
public:
    using OneToManyAssociation::OneToManyAssociation;

private:
    ManyToOneAssociation<Item, Box>& backLink(Item& e) const override;
};

class ItemsToBox : public ManyToOneAssociation<Item, Box> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Box* partner) override;
    int xRemove(Box* partner) override;
};

struct Item {
    explicit Item(char n, int k = 0) : name(n), key(k) {}
    ~Item()
    {
        if (obituary != nullptr)
            *obituary += name;
        box.set(nullptr);
    }
    std::string* obituary = nullptr; // gets the name in the end
    char name;
    int key;
    ItemsToBox box{this};
};

int sortItemsByKey(const void* a, const void* b)
{
    const int left = (*static_cast<Item*const*>(a))->key, right = (*static_cast<Item*const*>(b))->key;
    return left < right ? -1 : left > right;
}

/// Answers `entry`, when it is not 0, to what would enter.
struct Box {
    explicit Box(bool sorted = false) : items(this, sorted, sortItemsByKey) {}
    ~Box() { items.unlinkAll(); }
    int entry = 0;
    BoxToItems items;
};

ManyToOneAssociation<Item, Box>& BoxToItems::backLink(Item& e) const
{
    return e.box;
}

int ItemsToBox::xAdd(Box* partner)
{
    return partner->entry != 0 ? partner->entry : partner->items.add(owner());
}

int ItemsToBox::xRemove(Box* partner)
{
    return partner->items.remove(owner());
}

/// The names in list order, read with `getAll`, after a check that `getAt`, `getElement` and the links agree.
std::string names(const Box& box)
{
    unsigned n;
    Item** items = box.items.getAll(&n);
    EXPECT_EQ(n, box.items.getNbr());
    EXPECT_EQ(items == nullptr, n == 0);
    std::string result;
    for (unsigned i = 0; i < n; ++i) {
        Item* item;
        unsigned index = n;
        EXPECT_EQ(box.items.getAt(&item, i), 0);
        EXPECT_EQ(item, items[i]);
        EXPECT_EQ(box.items.getElement(item, &index), 0);
        EXPECT_EQ(index, i);
        EXPECT_EQ(item->box.partner(), &box);
        result += item->name;
    }
    return result;
}

} // namespace

TEST(AssociationTest, WhatIsRefusedOrNotThereHasNoEffect)
{
    Box former, box;
    Item a('a'), b('b');
    former.items.add(&a);
    box.entry = 7;
    EXPECT_EQ(a.box.set(&box), 7);
    EXPECT_EQ(names(former) + "|" + names(box), "|") << "it has left, and is nowhere";
    EXPECT_EQ(a.box.partner(), nullptr);
    box.entry = 0;
    for (const char* turn : {"new", "again"})
        EXPECT_EQ(box.items.add(&a), 0) << turn;
    EXPECT_EQ(box.items.remove(&b), 0) << "what is not there";
    EXPECT_EQ(names(box), "a");
}

TEST(AssociationTest, RandomChangesFromBothEndsAgreeWithPlainLists)
{
    std::mt19937 random(5);
    const auto below = [&random](std::size_t n) { return random() % n; };
    Box boxes[] = {Box(true), Box(false)};
    std::vector<Item*> expected[2]; // in the order of their addition
    std::vector<std::unique_ptr<Item>> items;
    for (char name = '0'; name < '0' + 70; ++name)
        items.push_back(std::make_unique<Item>(name));
    for (int turn = 0; turn < 20'000; ++turn) {
        Item* item = items[below(70)].get();
        Box* now = item->box.partner();
        // The lists fill and empty in turns.
        Box* next = below(8) != 0 && turn / 1000 % 2 != 0 ? nullptr : &boxes[below(2)];
        if (below(4) == 0) {
            item->key = static_cast<int>(below(9));
            if (now != nullptr)
                now->items.changeNotice();
        } else if (now != next) {
            if (now == &boxes[0])
                std::erase(expected[0], item);
            if (now == &boxes[1]) { // the last one takes the free place
                *std::ranges::find(expected[1], item) = expected[1].back();
                expected[1].pop_back();
            }
            if (next != nullptr)
                expected[next - boxes].push_back(item);
            if (now == nullptr && below(4) == 0)
                next->items.addNew(item);
            else if (below(2) == 0)
                item->box.set(next);
            else
                next != nullptr ? next->items.add(item) : now->items.remove(item);
        }
        for (int i = 0; i < 2 && turn % 3 == 0; ++i) {
            std::vector<Item*> inOrder = expected[i];
            if (i == 0)
                std::ranges::stable_sort(inOrder, {}, &Item::key);
            std::string want;
            for (const Item* listed : inOrder)
                want += listed->name;
            ASSERT_EQ(names(boxes[i]), want) << "after change " << turn;
        }
    }
}

TEST(AssociationTest, DestroyingAllGoesFromTheFront)
{
    const struct {
        bool sorted;
        const char* order;
        const char* why;
    } cases[] = {{true, "bdac", "by key"}, {false, "adcb", "the last one takes the place of the first"}};
    for (const auto& c : cases) {
        Box box(c.sorted);
        std::string order;
        for (const auto& [name, key] : {std::pair('a', 3), {'b', 1}, {'c', 9}, {'d', 2}}) {
            auto* item = new Item(name, key); // destroyed by `deleteAll`
            item->obituary = &order;
            box.items.add(item);
        }
        box.items.deleteAll();
        EXPECT_EQ(order, c.order) << c.why;
        EXPECT_EQ(box.items.getNbr(), 0U);
    }
}
