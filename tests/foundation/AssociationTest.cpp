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
    ~Item() { box.set(nullptr); }
    char name;
    int key;
    ItemsToBox box{this};
};

int comparisons = 0;

int sortItemsByKey(const void* a, const void* b)
{
    ++comparisons;
    const int left = (*static_cast<Item*const*>(a))->key, right = (*static_cast<Item*const*>(b))->key;
    return left < right ? -1 : left > right;
}

/// Answers `entry` or `exit`, when they are not 0, to what would enter or leave.
struct Box {
    explicit Box(bool sorted = false) : items(this, sorted, sortItemsByKey) {}
    ~Box()
    {
        entry = exit = 0;
        items.unlinkAll();
    }
    int entry = 0;
    int exit = 0;
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
    return partner->exit != 0 ? partner->exit : partner->items.remove(owner());
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

TEST(AssociationTest, WhatIsNotThereHasNoEffect)
{
    Box box;
    Item a('a'), b('b');
    EXPECT_EQ(box.items.add(&a), 0);
    EXPECT_EQ(box.items.add(&a), 0) << "again";
    EXPECT_EQ(a.box.set(&box), 0);
    EXPECT_EQ(box.items.remove(&b), 0);
    EXPECT_EQ(box.items.remove(nullptr), 0);
    EXPECT_EQ(box.items.add(nullptr), -1);
    EXPECT_EQ(names(box), "a");
    Item* item = &a;
    EXPECT_EQ(box.items.getAt(&item, 1), -1);
    EXPECT_EQ(item, nullptr);
    unsigned index;
    EXPECT_EQ(box.items.getElement(&b, &index), -1);
    Box* partner = &box;
    EXPECT_EQ(b.box.get(&partner), -1);
    EXPECT_EQ(partner, nullptr);
}

TEST(AssociationTest, RemovalFromAnUnsortedListMovesTheLastElementIntoTheHole)
{
    Box box;
    Item a('a'), b('b'), c('c');
    auto d = std::make_unique<Item>('d');
    for (Item* item : {&a, &b, &c, d.get()})
        box.items.add(item);
    box.items.changeNotice();
    EXPECT_EQ(names(box), "abcd") << "nothing to sort by";
    box.items.remove(&a);
    EXPECT_EQ(names(box), "dbc");
    d.reset();
    EXPECT_EQ(names(box), "cb") << "an element leaves as it dies";
}

TEST(AssociationTest, EqualKeysKeepTheOrderOfAddition)
{
    Box box(true);
    Item a('a', 2), b('b', 1), c('c', 2), d('d', 1), e('e', 2);
    for (Item* item : {&a, &b, &c, &d, &e})
        item->box.set(&box);
    EXPECT_EQ(names(box), "bdace");
    box.items.remove(&b); // the last takes its place for a while
    EXPECT_EQ(names(box), "dace");
    a.key = 1;
    box.items.changeNotice();
    EXPECT_EQ(names(box), "adce") << "a was added before d";
    box.items.add(&b);
    EXPECT_EQ(names(box), "adbce") << "b has come back last";
}

TEST(AssociationTest, ARefusalIsPassedUpAndLeavesBothEndsConsistent)
{
    enum End { kOne, kMany };
    const struct {
        int entry, exit; // what the new box and the old one answer
        bool removal;
        int result;
        const char *left, *right;
    } cases[] = {{0, 0, false, 0, "cb", "xa"}, {7, 0, false, 7, "cb", "x"}, {0, 9, false, 9, "abc", "x"},
                 {7, 9, false, 9, "abc", "x"}, {7, 0, true, 0, "cb", "x"},  {0, 9, true, 9, "abc", "x"}};
    for (const auto& c : cases)
        for (const End end : {kOne, kMany}) {
            Box left, right;
            Item a('a'), b('b'), inLeft('c'), x('x');
            for (Item* item : {&a, &b, &inLeft})
                left.items.add(item);
            right.items.add(&x);
            right.entry = c.entry;
            left.exit = c.exit;
            Box* target = c.removal ? nullptr : &right;
            const int result = end == kOne ? a.box.set(target)
                               : c.removal ? left.items.remove(&a)
                                           : right.items.add(&a);
            EXPECT_EQ(result, c.result) << c.entry << c.exit << c.removal << end;
            EXPECT_EQ(names(left) + "|" + names(right), std::string(c.left) + "|" + c.right)
                << c.entry << c.exit << c.removal << end;
            EXPECT_EQ(a.box.partner(), *c.left == 'a' ? &left : right.items.contains(&a) ? &right : nullptr);
            left.exit = 0;
        }
    Box empty;
    Item a('a');
    empty.entry = 7;
    EXPECT_EQ(empty.items.add(&a), 7);
    EXPECT_EQ(names(empty), "") << "a refused addition to an empty list leaves it empty";
}

TEST(AssociationTest, RandomChangesAgreeWithAPlainList)
{
    struct Entry {
        Item* item;
        int turn;
    };
    std::mt19937 random(5);
    const auto below = [&random](int n) { return static_cast<int>(random() % static_cast<unsigned>(n)); };
    Box boxes[] = {Box(true), Box(false), Box(true)};
    std::vector<Entry> expected[3];
    std::vector<std::unique_ptr<Item>> items;
    for (char name = '0'; name < '0' + 70; ++name)
        items.push_back(std::make_unique<Item>(name));
    const auto takeOut = [&expected](Item* item) {
        for (auto& list : expected)
            for (Entry& entry : list)
                if (entry.item == item) {
                    entry = list.back();
                    list.pop_back();
                    return;
                }
    };
    for (int turn = 0; turn < 20'000; ++turn) {
        Item* item = items[static_cast<std::size_t>(below(70))].get();
        const int to = below(3);
        Box* now = item->box.partner();
        switch (below(4)) {
        case 0: // the lists fill and empty in turns of 1000
            if (turn / 1000 % 2 == 0)
                break;
            takeOut(item);
            ASSERT_EQ(now != nullptr && below(2) == 0 ? now->items.remove(item) : item->box.set(nullptr), 0);
            break;
        case 1:
            item->key = below(9);
            if (now != nullptr)
                now->items.changeNotice();
            break;
        default:
            if (now != &boxes[to]) {
                takeOut(item);
                expected[to].push_back({item, turn});
            }
            ASSERT_EQ(below(2) == 0 ? boxes[to].items.add(item) : item->box.set(&boxes[to]), 0);
        }
        if (below(3) != 0)
            continue;
        for (int i = 0; i < 3; ++i) {
            if (i != 1)
                std::sort(expected[i].begin(), expected[i].end(), [](const Entry& a, const Entry& b) {
                    return a.item->key != b.item->key ? a.item->key < b.item->key : a.turn < b.turn;
                });
            std::string want;
            for (const Entry& entry : expected[i])
                want += entry.item->name;
            ASSERT_EQ(names(boxes[i]), want) << "after change " << turn;
        }
    }
}

TEST(AssociationTest, AdditionsInOrderDoNotMakeTheListSortAgain)
{
    Box box(true);
    std::vector<std::unique_ptr<Item>> items;
    comparisons = 0;
    for (int i = 0; i < 1000; ++i) {
        items.push_back(std::make_unique<Item>('i', i / 2));
        box.items.add(items.back().get());
        EXPECT_EQ(box.items.at(static_cast<unsigned>(i)), items.back().get());
    }
    box.items.remove(items.back().get());
    EXPECT_EQ(box.items.at(0), items[0].get());
    EXPECT_LE(comparisons, 1000) << "one with the last element for each addition";
}
