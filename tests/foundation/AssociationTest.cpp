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

/// Two kinds of list for one kind of link, as charts have them.
template <bool sorted>
class BoxToItems final : public OneToManyAssociation<BoxToItems<sorted>, Box, Item, sorted> {
public:
    using OneToManyAssociation<BoxToItems<sorted>, Box, Item, sorted>::OneToManyAssociation;
    static auto& link(auto& item) { return item.box; }
    static int compare(const void* a, const void* b) requires sorted
    {
        const int left = keyOf(*static_cast<Item*const*>(a)), right = keyOf(*static_cast<Item*const*>(b));
        return left < right ? -1 : left > right;
    }
    static int keyOf(const auto* item) { return item->key; }
};

class ItemsToBox final : public ManyToOneAssociation<ItemsToBox, Item, Box, true> {
public:
    static int enter(auto& box, Item* item) { return box.enter(item); }
    static int leave(auto& box, Item* item) { return box.remove(item); }
};

struct Item {
    explicit Item(char n, int k = 0) : name(n), key(k) {}
    ~Item()
    {
        if (obituary != nullptr)
            *obituary += name;
        setBox(nullptr);
    }
    int setBox(Box* newBox);

    std::string* obituary = nullptr; // gets the name in the end
    char name;
    int key;
    ItemsToBox box;
};

struct Box {
    explicit Box(bool sorted = false) : isSorted(sorted) {}
    ~Box()
    {
        sortedItems.unlinkAll();
        items.unlinkAll();
    }
    /// Calls `use` with the list that the box has.
    auto with(auto use) const { return isSorted ? use(sortedItems) : use(items); }
    /// What would enter is answered `entry`, when that is not 0.
    int enter(Item* item) { return entry != 0 ? entry : add(item); }
    int add(Item* item) const
    {
        return with([=](auto& list) { return list.add(item); });
    }
    int remove(Item* item) const
    {
        return with([=](auto& list) { return list.remove(item); });
    }

    int entry = 0;
    bool isSorted;
    mutable BoxToItems<true> sortedItems{this};
    mutable BoxToItems<false> items{this};
};

int Item::setBox(Box* newBox)
{
    return box.set(this, newBox);
}

/// The names in list order, read with `getAll`, after a check that `getAt`, `getElement` and the links agree.
std::string names(const Box& box)
{
    return box.with([&box](auto& list) {
        unsigned n;
        Item** items = list.getAll(&n);
        EXPECT_EQ(n, list.getNbr());
        EXPECT_EQ(items == nullptr, n == 0);
        std::string result;
        for (unsigned i = 0; i < n; ++i) {
            Item* item;
            unsigned index = n;
            EXPECT_EQ(list.getAt(&item, i), 0);
            EXPECT_EQ(item, items[i]);
            EXPECT_EQ(list.getElement(item, &index), 0);
            EXPECT_EQ(index, i);
            EXPECT_EQ(item->box.partner(), &box);
            result += item->name;
        }
        return result;
    });
}

} // namespace

TEST(AssociationTest, WhatIsRefusedOrNotThereHasNoEffect)
{
    Box former, box;
    Item a('a'), b('b');
    former.add(&a);
    box.entry = 7;
    EXPECT_EQ(a.setBox(&box), 7);
    EXPECT_EQ(names(former) + "|" + names(box), "|") << "it has left, and is nowhere";
    EXPECT_EQ(a.box.partner(), nullptr);
    box.entry = 0;
    for (const char* turn : {"new", "again"})
        EXPECT_EQ(box.add(&a), 0) << turn;
    EXPECT_EQ(box.remove(&b), 0) << "what is not there";
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
                now->with([](auto& list) { list.changeNotice(); });
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
                next->with([item](auto& list) { list.addNew(item); });
            else if (below(2) == 0)
                item->setBox(next);
            else
                next != nullptr ? next->add(item) : now->remove(item);
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
            box.add(item);
        }
        box.with([](auto& list) { list.deleteAll(); });
        EXPECT_EQ(order, c.order) << c.why;
        EXPECT_EQ(names(box), "");
    }
}
