// Look-ups while others change the list: whatever is kept or done outside, they find what a search of the list finds.

#include <zor_basis/containers/dict.h>

#include "tests/store/dict_files.h"

#include <gtest/gtest.h>

#include <chrono>
#include <optional>
#include <string>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

using List = SngList<BlobEntry>;
using Unit = List::Unit;
using Answers = std::vector<std::optional<std::string>>;

constexpr int KEYS = 100;

std::string name(int i) { return "key " + std::to_string(i); }

Answers answersOf(BlobDict const& dict) {
    Answers answers;
    for (int i = 0; i < 2 * KEYS; ++i) {
        Blob value;
        bool const found = dict.get(blob(name(i)), value);
        answers.push_back(found ? std::optional(text(value)) : std::nullopt);
    }
    return answers;
}

/// The same by a search of the list.
Answers plainAnswersOf(BlobDict const& dict) {
    Answers answers(2 * KEYS);
    for (int i = 0; i < 2 * KEYS; ++i) {
        Unit const* unit = dict.first();
        while (unit != nullptr && text(unit->value.key) != name(i)) unit = unit->next;
        if (unit != nullptr) answers[static_cast<std::size_t>(i)] = text(unit->value.value);
    }
    return answers;
}

/// Stores 100 keys in an empty dictionary and asks for each of them, which makes an index.
void fillAndAsk(BlobDict& dict) {
    for (int i = 0; i < KEYS; ++i) dict.set(blob(name(i)), blob(std::to_string(i)));
    answersOf(dict);
}

/// The dictionary answers before its list is searched: the search is a reason to use no index.
void expectPlainAnswers(BlobDict const& dict) {
    Answers const answers = answersOf(dict);
    EXPECT_EQ(answers, plainAnswersOf(dict));
}

List listOf(int from, int to) {
    List list;
    for (int i = from; i < to; ++i) list.insertBack(BlobEntry(blob(name(i)), blob("from a list")));
    return list;
}

Unit* newUnit() { return new Unit{nullptr, BlobEntry(blob(name(KEYS)), blob("new"))}; }

/// Each makes another unit of the list known to the caller, who keeps it.
struct Reached {
    int line;
    char const* how;
    Unit* (*reach)(BlobDict& dict);
};

Reached const REACHED[] = {
    {__LINE__, "first", [](BlobDict& dict) { return dict.first(); }},
    {__LINE__, "last", [](BlobDict& dict) { return dict.last(); }},
    {__LINE__, "begin", [](BlobDict& dict) { return dict.begin().unit(); }},
    {__LINE__, "constant begin", [](BlobDict& dict) { return std::as_const(dict).begin().unit()->next; }},
    {__LINE__, "cbegin", [](BlobDict& dict) { return dict.cbegin().unit()->next; }},
    {__LINE__, "the list's own first", [](BlobDict& dict) { return static_cast<List&>(dict).first(); }},
    {__LINE__, "insertFront",
     [](BlobDict& dict) {
         Unit* const unit = newUnit();
         dict.insertFront(unit);
         return unit;
     }},
    {__LINE__, "insertBack",
     [](BlobDict& dict) {
         Unit* const unit = newUnit();
         dict.insertBack(unit);
         return unit;
     }},
    {__LINE__, "insertAfter",
     [](BlobDict& dict) {
         Unit* const unit = newUnit();
         auto place = dict.end();
         dict.insertAfter(unit, place);
         return unit;
     }},
    {__LINE__, "insertBefore",
     [](BlobDict& dict) {
         Unit* const unit = newUnit();
         auto place = dict.end();
         dict.insertBefore(unit, place);
         return unit;
     }},
    {__LINE__, "merge",
     [](BlobDict& dict) {
         List list = listOf(KEYS, KEYS + 3);
         Unit* const unit = list.first();
         dict.merge(list, true);
         return unit;
     }},
    {__LINE__, "move into the list",
     [](BlobDict& dict) {
         List list = listOf(50, 150);
         Unit* const unit = list.first();
         static_cast<List&>(dict) = std::move(list);
         return unit;
     }},
};

/// Each changes the list without the dictionary.
struct Changed {
    int line;
    char const* how;
    /// Returns what it has taken out, which lives on.
    List (*change)(BlobDict& dict);
};

/// Makes a change after which nothing taken out lives on.
template <auto change>
List only(BlobDict& dict) {
    change(dict);
    return {};
}

Changed const CHANGED[] = {
    {__LINE__, "insertFront",
     only<[](BlobDict& dict) { dict.insertFront(BlobEntry(blob(name(KEYS)), blob("front"))); }>},
    {__LINE__, "insertBack", only<[](BlobDict& dict) { dict.insertBack(BlobEntry(blob(name(KEYS)), blob("back"))); }>},
    {__LINE__, "the same key once more",
     only<[](BlobDict& dict) { dict.insertFront(BlobEntry(blob(name(7)), blob("!"))); }>},
    {__LINE__, "takeFirst",
     [](BlobDict& dict) {
         List taken;
         taken.insertFront(dict.takeFirst());
         return taken;
     }},
    {__LINE__, "clear", only<[](BlobDict& dict) { dict.clear(); }>},
    {__LINE__, "clear and insert", only<[](BlobDict& dict) {
         dict.clear();
         dict.insertFront(newUnit());
     }>},
    {__LINE__, "sort", only<[](BlobDict& dict) { dict.sort(true); }>},
    {__LINE__, "reverse", only<[](BlobDict& dict) { dict.reverse(); }>},
    {__LINE__, "move out", [](BlobDict& dict) { return List(std::move(static_cast<List&>(dict))); }},
    {__LINE__, "move in", only<[](BlobDict& dict) { static_cast<List&>(dict) = listOf(90, 110); }>},
    {__LINE__, "copy in", only<[](BlobDict& dict) {
         List const list = listOf(80, 120);
         static_cast<List&>(dict) = list;
     }>},
    {__LINE__, "merge into another list",
     [](BlobDict& dict) {
         List list = listOf(0, 1);
         list.merge(dict, true);
         return list;
     }},
    {__LINE__, "merge into it", only<[](BlobDict& dict) {
         List list = listOf(KEYS, KEYS + 1);
         dict.merge(list, true);
     }>},
};

} // namespace

TEST(DictLookUp, finds_every_key_and_no_other) {
    BlobDict dict;
    fillAndAsk(dict);
    Answers const answers = answersOf(dict);
    for (int i = 0; i < KEYS; ++i) EXPECT_EQ(answers[static_cast<std::size_t>(i)], std::to_string(i));
    EXPECT_EQ(answers, plainAnswersOf(dict));
}

TEST(DictLookUp, sees_keys_that_change_in_a_unit_that_is_kept) {
    for (Reached const& row : REACHED) {
        SCOPED_TRACE(row.line);
        SCOPED_TRACE(row.how);
        BlobDict dict;
        fillAndAsk(dict);
        Unit* const kept = row.reach(dict);
        answersOf(dict);
        kept->value.key = blob(name(KEYS + 50));
        expectPlainAnswers(dict);
        kept->value.key.buf()[0] = 'K';
        expectPlainAnswers(dict);
        dict.set(blob(name(KEYS + 50)), blob("another entry"));
        dict.rm(blob(name(3)));
        expectPlainAnswers(dict);
    }
}

TEST(DictLookUp, sees_units_that_are_linked_by_hand) {
    BlobDict dict;
    fillAndAsk(dict);
    Unit* const kept = dict.first();
    answersOf(dict);
    Unit* const old = kept->next;
    kept->next = new Unit{old->next, BlobEntry(blob(name(KEYS + 1)), blob("by hand"))};
    delete old;
    expectPlainAnswers(dict);
    BlobDict other;
    fillAndAsk(other);
    other.intersect(dict);
    expectPlainAnswers(other);
}

TEST(DictLookUp, sees_what_changes_the_list_itself) {
    for (Changed const& row : CHANGED) {
        SCOPED_TRACE(row.line);
        SCOPED_TRACE(row.how);
        BlobDict dict;
        fillAndAsk(dict);
        List const taken = row.change(dict);
        expectPlainAnswers(dict);
        dict.set(blob(name(KEYS + 60)), blob("later"));
        for (int i = 0; i < 2 * KEYS; i += 3) dict.rm(blob(name(i)));
        expectPlainAnswers(dict);
    }
}

TEST(DictLookUp, sees_each_change_without_being_asked_between) {
    for (Changed const& row : CHANGED) {
        SCOPED_TRACE(row.line);
        SCOPED_TRACE(row.how);
        BlobDict dict;
        fillAndAsk(dict);
        List const taken = row.change(dict);
        BlobDict other;
        other.set(blob(name(90)), blob(""));
        dict.intersect(other);
        expectPlainAnswers(dict);
    }
}

TEST(DictLookUp, sees_a_unit_that_was_taken_before_the_list_became_empty) {
    BlobDict dict;
    fillAndAsk(dict);
    Unit* const kept = dict.takeFirst();
    dict.clean();
    fillAndAsk(dict);
    kept->value.key = blob(name(KEYS + 70));
    dict.insertFront(kept);
    expectPlainAnswers(dict);
    kept->value.key = blob(name(KEYS + 71));
    expectPlainAnswers(dict);
}

TEST(DictLookUp, stores_and_finds_many_keys_in_linear_time) {
    BlobDict dict;
    fillAndAsk(dict);
    EXPECT_NE(dict.begin(), dict.end()) << "from now on the list is searched";
    dict.clean();
    constexpr std::uint32_t COUNT = 200'000;
    auto const start = std::chrono::steady_clock::now();
    for (std::uint32_t i = 0; i < COUNT; ++i) dict.set(blob(length(i)), blob("v"));
    Blob value;
    for (std::uint32_t i = 0; i < COUNT; ++i) {
        ASSERT_TRUE(dict.get(blob(length(i)), value));
        ASSERT_FALSE(dict.get(blob(field(length(i))), value));
    }
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(20)) << "searches take minutes";
    EXPECT_EQ(dict.size(), COUNT);
}
