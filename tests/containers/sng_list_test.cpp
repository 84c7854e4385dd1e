#include <zor_basis/containers/sng_list.h>

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <new>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// A value that sorts by its key alone and counts how many of it live.
struct Item {
    Item(int k, int t) : key(k), tag(t) { ++living; }
    Item(Item const& other) : key(other.key), tag(other.tag) { ++living; }
    Item& operator=(Item const&) = default;
    ~Item() { --living; }
    bool operator<(Item const& other) const { return key < other.key; }

    int key;
    int tag;
    static int living;
};
int Item::living = 0;

/// A value of which only so many copies can be made.
struct Scarce {
    Scarce() { ++living; }
    Scarce(Scarce const&) {
        if (left == 0) throw std::bad_alloc();
        --left;
        ++living;
    }
    ~Scarce() { --living; }

    static int left;
    static int living;
};
int Scarce::left = 0;
int Scarce::living = 0;

using List = SngList<Item>;

std::string text(List& list) {
    EXPECT_TRUE(list.isConsistent());
    std::string found;
    for (Item const& item : list) {
        found += std::to_string(item.key) +
                 (item.tag != 0 ? std::string(1, static_cast<char>('a' + item.tag - 1)) : "") + " ";
    }
    return found;
}

List make(std::vector<Item> const& items) {
    List list;
    for (Item const& item : items) list.insertBack(item);
    return list;
}

List::iterator at(List& list, int index) {
    List::iterator place = list.begin();
    while (index-- > 0) ++place;
    return place;
}

} // namespace

TEST(SngList, breathes) {
    List list;
    EXPECT_EQ(list.size(), 0u);
    EXPECT_EQ(list.first(), nullptr);
    EXPECT_EQ(list.last(), nullptr);
    EXPECT_TRUE(list.begin() == list.end());
    list.insertFront(Item{2, 0});
    list.insertFront(Item{1, 0});
    list.insertBack(Item{3, 0});
    EXPECT_EQ(text(list), "1 2 3 ");
    EXPECT_EQ(list.first()->value.key, 1);
    EXPECT_EQ(list.last()->value.key, 3);
    EXPECT_EQ(list.begin()->key, 1);
    EXPECT_EQ(list.begin().unit(), list.first());
}

TEST(SngList, is_walked_by_the_standard_algorithms) {
    SngList<int> list;
    for (int value : {3, 1, 2}) list.insertBack(value);
    EXPECT_EQ(std::distance(list.begin(), list.end()), 3);
    EXPECT_EQ(std::vector<int>(list.begin(), list.end()), (std::vector<int>{3, 1, 2}));
    auto place = std::find(list.begin(), list.end(), 1);
    EXPECT_EQ(*place++, 1);
    EXPECT_EQ(*place, 2);
    list.remove(place);
    EXPECT_EQ(std::vector<int>(list.begin(), list.end()), (std::vector<int>{3, 1}));
}

TEST(SngList, deletes_its_units) {
    {
        List list = make({{1, 0}, {2, 0}, {3, 0}});
        List const copy(list);
        EXPECT_EQ(Item::living, 6);
        list.clear();
        EXPECT_EQ(Item::living, 3);
        EXPECT_EQ(text(list), "");
        EXPECT_EQ(list.first(), nullptr);
        EXPECT_EQ(list.last(), nullptr);
        list.insertBack(Item{1, 0});
        EXPECT_EQ(text(list), "1 ");
    }
    EXPECT_EQ(Item::living, 0);
}

namespace {

/// A value that tells when it ends.
struct Teller {
    explicit Teller(int n) : number(n) {}
    Teller(Teller const&) = default;
    Teller& operator=(Teller const&) = default;
    ~Teller() { told.push_back(number); }

    int number;
    static std::vector<int> told;
};
std::vector<int> Teller::told;

void fill(SngList<Teller>& list) {
    for (int i : {3, 1, 2}) list.insertBack(Teller(i));
    Teller::told.clear();
}

} // namespace

TEST(SngList, deletes_its_units_from_the_front) {
    SngList<Teller> list;
    fill(list);
    list.clear();
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2}));
    fill(list);
    list.reverse();
    list.insertFront(new SngList<Teller>::Unit{nullptr, Teller(4)});
    Teller::told.clear();
    list.clear();
    EXPECT_EQ(Teller::told, (std::vector<int>{4, 2, 1, 3})) << "as they stand, not as they came";
    {
        SngList<Teller> other;
        fill(other);
    }
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2})) << "at the end of its life";
    fill(list);
    list = SngList<Teller>();
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2})) << "before others are assigned";
}

TEST(SngList, copies_values_into_units_of_its_own) {
    List list = make({{1, 0}, {2, 0}});
    List copy(list);
    copy.first()->value.key = 9;
    EXPECT_EQ(text(list), "1 2 ");
    EXPECT_EQ(text(copy), "9 2 ");
    copy = list;
    EXPECT_EQ(text(copy), "1 2 ");
    List const& self = copy;
    copy = self;
    EXPECT_EQ(text(copy), "1 2 ");
    copy = List();
    EXPECT_EQ(text(copy), "");
}

TEST(SngList, leaves_nothing_behind_when_a_value_cannot_be_copied) {
    {
        SngList<Scarce> list;
        Scarce const value;
        Scarce::left = 3;
        for (int i = 0; i < 3; ++i) list.insertBack(value);
        Scarce::left = 2;
        EXPECT_THROW(SngList<Scarce>{list}, std::bad_alloc);
        EXPECT_EQ(Scarce::living, 4);
        SngList<Scarce> other;
        Scarce::left = 1;
        EXPECT_THROW(other = list, std::bad_alloc);
        EXPECT_EQ(other.size(), 0u);
        EXPECT_EQ(Scarce::living, 4);
        EXPECT_THROW(list.insertFront(value), std::bad_alloc);
        EXPECT_TRUE(list.isConsistent());
        EXPECT_EQ(list.size(), 3u);
    }
    EXPECT_EQ(Scarce::living, 0);
}

TEST(SngList, adopts_a_chain) {
    auto* const third = new List::Unit{nullptr, {3, 0}};
    auto* const second = new List::Unit{third, {2, 0}};
    auto* const first = new List::Unit{second, {1, 0}};
    List list(first, third, 3);
    EXPECT_EQ(text(list), "1 2 3 ");
    list.insertBack(Item{4, 0});
    EXPECT_EQ(text(list), "1 2 3 4 ");
    auto* const unit = new List::Unit{first, {0, 0}}; // whatever its link says
    list.insertBack(unit);
    EXPECT_EQ(text(list), "1 2 3 4 0 ");
}

TEST(SngList, is_walked_without_being_changed) {
    List list = make({{3, 0}, {1, 0}, {2, 0}});
    List const& constant = list;
    std::string found;
    for (Item const& item : constant) found += std::to_string(item.key);
    EXPECT_EQ(found, "312");
    static_assert(std::forward_iterator<List::const_iterator> && std::forward_iterator<List::iterator>);
    static_assert(std::is_same_v<decltype(*constant.begin()), Item const&>);
    static_assert(std::is_same_v<decltype(*list.cbegin()), Item const&>);
    static_assert(std::is_convertible_v<List::iterator, List::const_iterator>);
    static_assert(!std::is_convertible_v<List::const_iterator, List::iterator>);
    List::const_iterator place = list.begin();
    EXPECT_EQ(place.unit(), list.first());
    EXPECT_EQ(place++->key, 3);
    EXPECT_EQ(place->key, 1);
    EXPECT_EQ((++place)->key, 2);
    EXPECT_TRUE(++place == constant.end() && place == list.cend() && place != list.cbegin());
    EXPECT_TRUE(list.begin() == list.cbegin() && list.cend() == list.end());
    EXPECT_EQ(std::distance(constant.begin(), constant.end()), 3);
    EXPECT_TRUE(List().cbegin() == List().cend());
}

TEST(SngList, tells_whether_it_is_empty) {
    List list;
    EXPECT_TRUE(list.empty());
    list.insertBack(Item{1, 0});
    EXPECT_FALSE(list.empty());
    list.removeFirst();
    EXPECT_TRUE(list.empty());
}

TEST(SngList, moves_its_units_and_copies_nothing) {
    static_assert(std::is_nothrow_move_constructible_v<List> && std::is_nothrow_move_assignable_v<List>);
    {
        SngList<Scarce> scarce;
        Scarce::left = 1;
        scarce.insertBack(Scarce());
        SngList<Scarce> moved(std::move(scarce));
        scarce = std::move(moved);
        EXPECT_EQ(scarce.size(), 1u) << "no copy was left to make";
    }
    EXPECT_EQ(Scarce::living, 0);
    List source = make({{1, 0}, {2, 0}, {3, 0}});
    List::Unit* const first = source.first();
    List taken(std::move(source));
    EXPECT_EQ(taken.first(), first);
    EXPECT_EQ(text(taken), "1 2 3 ");
    EXPECT_EQ(text(source), ""); // NOLINT(bugprone-use-after-move)
    source.insertBack(Item{9, 0});
    EXPECT_EQ(text(source), "9 ") << "the moved-from list is an empty one";
    EXPECT_EQ(source.last(), source.first());
    int const living = Item::living;
    source = std::move(taken);
    EXPECT_EQ(Item::living, living - 1) << "what was there before is deleted at once";
    EXPECT_EQ(source.first(), first);
    EXPECT_EQ(text(source), "1 2 3 ");
    EXPECT_EQ(text(taken), ""); // NOLINT(bugprone-use-after-move)
    source.insertBack(Item{4, 0});
    EXPECT_EQ(text(source), "1 2 3 4 ");
    List& self = source;
    source = std::move(self);
    EXPECT_EQ(text(source), "1 2 3 4 ");
    source = make({{5, 0}});
    EXPECT_EQ(text(source), "5 ");
}

TEST(SngList, inserts_behind_an_iterator) {
    struct Case {
        Row row;
        int place; // as many as there are: the end
        char const *expected, *current;
    };
    for (Case const& c : {Case{{}, 0, "1 9 2 3 ", "1"}, Case{{}, 1, "1 2 9 3 ", "2"}, Case{{}, 2, "1 2 3 9 ", "3"},
                          Case{{}, 3, "1 2 3 9 ", ""}}) {
        SCOPED_TRACE(c.row);
        List list = make({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = at(list, c.place);
        list.insertAfter(Item{9, 0}, place);
        EXPECT_EQ(text(list), c.expected);
        EXPECT_EQ(place.unit() != nullptr ? std::to_string(place->key) : "", c.current);
    }
    List empty;
    List::iterator nowhere = empty.end();
    empty.insertAfter(new List::Unit{nullptr, {5, 0}}, nowhere);
    EXPECT_EQ(text(empty), "5 ");
}

TEST(SngList, inserts_before_an_iterator_again_and_again) {
    struct Case {
        Row row;
        int place;
        char const* expected;
    };
    for (Case const& c :
         {Case{{}, 0, "8 9 1 2 3 "}, Case{{}, 1, "1 8 9 2 3 "}, Case{{}, 2, "1 2 8 9 3 "}, Case{{}, 3, "1 2 3 8 9 "}}) {
        SCOPED_TRACE(c.row);
        List list = make({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = at(list, c.place);
        list.insertBefore(Item{8, 0}, place);
        list.insertBefore(new List::Unit{nullptr, {9, 0}}, place);
        EXPECT_EQ(text(list), c.expected);
        if (c.place == 3) continue;
        list.remove(place); // the unit before it is known
        EXPECT_EQ(list.size(), 4u);
        EXPECT_TRUE(list.isConsistent());
    }
}

TEST(SngList, removes_at_an_iterator_with_the_tail_always_right) {
    struct Case {
        Row row;
        int place;
        char const *expected, *next;
    };
    for (Case const& c :
         {Case{{}, 0, "2 3 ", "2"}, Case{{}, 1, "1 3 ", "3"}, Case{{}, 2, "1 2 ", ""}, Case{{}, 3, "1 2 3 ", ""}}) {
        SCOPED_TRACE(c.row);
        List list = make({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = at(list, c.place);
        list.remove(place);
        EXPECT_EQ(text(list), c.expected);
        EXPECT_EQ(place.unit() != nullptr ? std::to_string(place->key) : "", c.next);
        list.insertBack(Item{7, 0});
        EXPECT_EQ(text(list), c.expected + std::string("7 "));
    }
    List list = make({{1, 0}, {2, 0}, {3, 0}, {4, 0}});
    for (List::iterator place = list.begin(); place != list.end();) {
        if (place->key % 2 == 0) {
            list.remove(place);
        } else {
            ++place;
        }
    }
    EXPECT_EQ(text(list), "1 3 ");
}

TEST(SngList, takes_units_out_with_their_values) {
    List list = make({{1, 0}, {2, 0}, {3, 0}});
    List::iterator place = at(list, 1);
    List::Unit* const unit = list.take(place);
    EXPECT_EQ(unit->value.key, 2);
    EXPECT_EQ(unit->next, nullptr);
    EXPECT_EQ(place->key, 3);
    EXPECT_EQ(text(list), "1 3 ");
    list.insertFront(unit);
    EXPECT_EQ(text(list), "2 1 3 ");
    List::iterator end = list.end();
    EXPECT_EQ(list.take(end), nullptr);
    List::Unit* const first = list.takeFirst();
    EXPECT_EQ(first->value.key, 2);
    delete first;
    list.removeFirst();
    list.removeFirst();
    EXPECT_EQ(text(list), "");
    EXPECT_EQ(list.last(), nullptr);
    list.removeFirst();
    EXPECT_EQ(list.takeFirst(), nullptr);
    EXPECT_EQ(text(list), "");
}

TEST(SngList, is_reversed_in_place) {
    for (int count : {0, 1, 2, 3, 10}) {
        List list;
        std::string expected;
        for (int i = 0; i < count; ++i) {
            list.insertBack(Item{i, 0});
            expected = std::to_string(i) + " " + expected;
        }
        List::Unit* const first = list.first();
        List::Unit* const last = list.last();
        list.reverse();
        EXPECT_EQ(text(list), expected);
        EXPECT_EQ(list.first(), last);
        EXPECT_EQ(list.last(), first);
    }
}

TEST(SngListSort, sorts_both_ways_and_keeps_equal_values_in_order) {
    struct Case {
        Row row;
        std::vector<Item> items;
        char const *ascending, *descending;
    };
    for (Case const& c : {
             Case{{}, {}, "", ""}, Case{{}, {{1, 0}}, "1 ", "1 "}, Case{{}, {{2, 0}, {1, 0}}, "1 2 ", "2 1 "},
             Case{{}, {{1, 0}, {2, 0}}, "1 2 ", "2 1 "}, Case{{}, {{1, 1}, {1, 2}, {1, 3}}, "1a 1b 1c ", "1a 1b 1c "},
             Case{{}, {{1, 1}, {1, 2}, {1, 3}, {1, 4}}, "1a 1b 1c 1d ", "1a 1b 1c 1d "},
             Case{{}, {{2, 1}, {1, 1}, {2, 2}, {1, 2}}, "1a 1b 2a 2b ", "2a 2b 1a 1b "},
             Case{{}, {{3, 0}, {1, 1}, {1, 2}}, "1a 1b 3 ", "3 1a 1b "}, // two equal units as a part of a list stay
         }) {
        SCOPED_TRACE(c.row);
        List list = make(c.items);
        list.sort(true);
        EXPECT_EQ(text(list), c.ascending);
        list = make(c.items);
        list.sort(false);
        EXPECT_EQ(text(list), c.descending);
    }
}

TEST(SngListSort, Kept_list_01_swaps_two_equal_values) {
    for (bool ascending : {true, false}) {
        List list = make({{1, 1}, {1, 2}});
        list.sort(ascending);
        EXPECT_EQ(text(list), "1b 1a ");
    }
}

TEST(SngListMerge, interleaves_sorted_lists) {
    struct Case {
        Row row;
        std::vector<Item> mine, theirs;
        bool ascending;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, {{1, 0}, {3, 0}}, {{2, 0}, {4, 0}}, true, "1 2 3 4 "},
             Case{{}, {{2, 0}, {4, 0}}, {{1, 0}, {3, 0}}, true, "1 2 3 4 "},
             Case{{}, {{4, 0}, {2, 0}}, {{3, 0}, {1, 0}}, false, "4 3 2 1 "},
             Case{{}, {}, {{1, 0}, {2, 0}}, true, "1 2 "},
             Case{{}, {{1, 0}, {2, 0}}, {}, true, "1 2 "},
             Case{{}, {}, {}, true, ""},
             Case{{}, {{1, 0}}, {{2, 0}, {3, 0}}, true, "1 2 3 "},
             Case{{}, {{5, 0}}, {{2, 0}, {3, 0}}, true, "2 3 5 "},
         }) {
        SCOPED_TRACE(c.row);
        List mine = make(c.mine);
        List theirs = make(c.theirs);
        mine.merge(theirs, c.ascending);
        EXPECT_EQ(text(mine), c.expected);
        EXPECT_EQ(text(theirs), "");
        EXPECT_EQ(theirs.size(), 0u);
        mine.insertBack(Item{9, 0});
        EXPECT_EQ(text(mine), c.expected + std::string("9 ")) << "the tail is right";
    }
}

TEST(SngListMerge, Kept_list_02_puts_the_other_list_first_among_equals) {
    List mine = make({{1, 1}, {2, 1}});
    List theirs = make({{1, 2}, {2, 2}});
    mine.merge(theirs, true);
    EXPECT_EQ(text(mine), "1b 1a 2b 2a ");
    mine.merge(mine, true);
    EXPECT_EQ(text(mine), "1b 1a 2b 2a ");
}

TEST(SngListComp, is_strict_both_ways) {
    List list = make({{1, 0}, {2, 0}});
    List::Unit* const one = list.first();
    List::Unit* const two = list.last();
    EXPECT_TRUE(List::comp(one, two, true) && !List::comp(two, one, true) && !List::comp(one, one, true));
    EXPECT_TRUE(List::comp(two, one, false) && !List::comp(one, two, false) && !List::comp(one, one, false));
}

// ---- against a plain vector ----------------------------------------------------------------------------------------

TEST(SngListModel, stays_what_a_plain_vector_is) {
    std::mt19937_64 random = randomSource();
    List list;
    std::vector<Item> model;
    int tag = 0;
    auto compareKeys = [](bool ascending) {
        return [ascending](Item const& a, Item const& b) { return ascending ? a.key < b.key : b.key < a.key; };
    };
    auto sortModel = [&](std::vector<Item>& items, bool ascending) {
        if (items.size() == 2 && !compareKeys(ascending)(items[0], items[1])) {
            std::swap(items[0], items[1]);
        } else if (items.size() != 2) {
            std::stable_sort(items.begin(), items.end(), compareKeys(ascending));
        }
    };
    for (std::uint64_t step = randomSteps(100'000); step > 0; --step) {
        Item const item(static_cast<int>(random() % 10), ++tag);
        auto const index = static_cast<std::ptrdiff_t>(random() % (model.size() + 1));
        List::iterator place = at(list, static_cast<int>(index));
        bool const ascending = random() % 2 == 0;
        switch (random() % 12) {
        case 0:
            list.insertFront(item);
            model.insert(model.begin(), item);
            break;
        case 1:
            list.insertBack(item);
            model.push_back(item);
            break;
        case 2:
            list.insertAfter(item, place);
            model.insert(model.begin() + std::min<std::ptrdiff_t>(index + 1, static_cast<std::ptrdiff_t>(model.size())),
                         item);
            break;
        case 3:
            list.insertBefore(item, place);
            model.insert(model.begin() + index, item);
            break;
        case 4:
        case 5:
            list.remove(place);
            if (index < static_cast<std::ptrdiff_t>(model.size())) model.erase(model.begin() + index);
            break;
        case 6:
            delete list.takeFirst();
            if (!model.empty()) model.erase(model.begin());
            break;
        case 7:
            list.reverse();
            std::reverse(model.begin(), model.end());
            break;
        case 8:
            list.sort(ascending);
            sortModel(model, ascending);
            break;
        case 9: {
            List other;
            std::vector<Item> others;
            for (std::uint64_t n = random() % 4; n > 0; --n) {
                others.emplace_back(static_cast<int>(random() % 10), ++tag);
                other.insertBack(others.back());
            }
            list.sort(ascending);
            sortModel(model, ascending);
            other.sort(ascending);
            sortModel(others, ascending);
            list.merge(other, ascending);
            std::vector<Item> merged;
            std::merge(others.begin(), others.end(), model.begin(), model.end(), std::back_inserter(merged),
                       compareKeys(ascending)); // of equal values the first range's come first
            model = merged;
            break;
        }
        case 10: {
            List const copy(list);
            list = copy;
            break;
        }
        default:
            if (model.size() > 30) {
                list.clear();
                model.clear();
            }
        }
        ASSERT_TRUE(list.isConsistent());
        ASSERT_EQ(list.size(), model.size());
        std::size_t i = 0;
        for (Item const& found : list) ASSERT_EQ(found.tag, model[i++].tag);
    }
}
