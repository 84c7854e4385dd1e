#include <zor_basis/containers/ptr_array.h>

#include "tests/support/operations.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <memory>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Exposes the capacity.
class Array : public PtrArray<int> {
public:
    using PtrArray::PtrArray;
    std::uint64_t capacity() const { return capacity_; }
};

int values[64];

} // namespace

TEST(PtrArray, breathes) {
    PtrArray<int> array;
    EXPECT_EQ(array.size(), 0u);
    EXPECT_EQ(array[0], nullptr);
    EXPECT_EQ(array.insertBack(&values[1]), 0u);
    EXPECT_EQ(array.insertBack(&values[2]), 1u);
    EXPECT_EQ(array[0], &values[1]);
    EXPECT_EQ(array[1u], &values[2]);
    EXPECT_EQ(array[2], nullptr) << "below the capacity, and not in use";
    EXPECT_EQ(array[1000], nullptr);
    EXPECT_EQ(array.size(), 2u);
}

TEST(PtrArray, at_least_doubles_when_it_grows) {
    Array array;
    EXPECT_EQ(array.capacity(), 8u);
    for (int i = 0; i < 8; ++i) array.insertBack(&values[i]);
    EXPECT_EQ(array.capacity(), 8u);
    array.insertBack(&values[8]);
    EXPECT_EQ(array.capacity(), 16u);
    for (int i = 0; i < 9; ++i) EXPECT_EQ(array[i], &values[i]);
    array.set(&values[9], 16);
    EXPECT_EQ(array.capacity(), 32u) << "the capacity at least doubles";
}

TEST(PtrArray, leaves_skipped_slots_null) {
    Array array;
    array.set(&values[0], 20);
    EXPECT_EQ(array.capacity(), 21u);
    EXPECT_EQ(array.size(), 21u);
    for (int i = 0; i < 20; ++i) EXPECT_EQ(array[i], nullptr);
    EXPECT_EQ(array[20], &values[0]);
    array.set(&values[1], 3);
    EXPECT_EQ(array.size(), 21u);
    EXPECT_EQ(array[3], &values[1]);
    EXPECT_EQ(array.insertBack(&values[2]), 21u);
    EXPECT_EQ(array.capacity(), 42u);
}

TEST(PtrArray, leaves_skipped_slots_null_in_blocks_that_others_have_used) {
    for (std::uint64_t n = 1; n <= 300; ++n) {
        // The next block of this size is one of these, and still holds what was written.
        std::vector<std::unique_ptr<char[]>> used(8);
        for (auto& block : used) {
            block = std::make_unique_for_overwrite<char[]>(n * sizeof(int*));
            std::memset(block.get(), 'x', n * sizeof(int*));
        }
        used.clear();
        Array array(n);
        array.set(&values[0], n - 1);
        EXPECT_EQ(array.capacity(), n);
        for (std::uint64_t i = 0; i + 1 < n; ++i) ASSERT_EQ(array[i], nullptr) << i << " of " << n;
    }
}

TEST(PtrArray, is_walked_from_its_first_slot_to_its_size) {
    PtrArray<int> array;
    PtrArray<int> const& constant = array;
    EXPECT_EQ(array.begin(), array.end());
    EXPECT_EQ(constant.begin(), constant.end());
    array.insertBack(&values[1]);
    array.set(&values[2], 9); // beyond the first block
    std::vector<int*> const expected{&values[1], nullptr, nullptr, nullptr, nullptr,
                                     nullptr,    nullptr, nullptr, nullptr, &values[2]};
    EXPECT_EQ(std::vector<int*>(array.begin(), array.end()), expected);
    EXPECT_EQ(std::vector<int*>(constant.begin(), constant.end()), expected);
    int found = 0;
    for (int* pointer : constant) found += pointer != nullptr ? 1 : 0;
    EXPECT_EQ(found, 2);
    EXPECT_EQ(std::find(constant.begin(), constant.end(), &values[2]) - constant.begin(), 9);
    std::replace(array.begin(), array.end(), &values[1], &values[3]);
    EXPECT_EQ(array[0], &values[3]);
    static_assert(std::is_same_v<decltype(*constant.begin()), int* const&>);
}

TEST(PtrArray, takes_a_capacity_of_0_for_1) {
    Array array(0);
    EXPECT_EQ(array.capacity(), 1u);
    array.insertBack(&values[0]);
    array.insertBack(&values[1]);
    EXPECT_EQ(array.capacity(), 2u);
    EXPECT_EQ(array[1], &values[1]);
}

TEST(PtrArray, copies_the_slots_into_a_block_of_its_own) {
    Array source(4);
    for (int i = 0; i < 3; ++i) source.insertBack(&values[i]);
    Array target;
    for (int i = 0; i < 8; ++i) target.insertBack(&values[63]);
    target = source;
    EXPECT_EQ(target.size(), 3u);
    for (int i = 0; i < 3; ++i) EXPECT_EQ(target[i], &values[i]);
    target.set(&values[9], 5);
    EXPECT_EQ(target[3], nullptr) << "what was there before is gone";
    EXPECT_EQ(source.size(), 3u);
    source.insertBack(&values[7]);
    source.insertBack(&values[8]); // grows, and frees its old block
    EXPECT_EQ(target[0], &values[0]);

    Array large;
    large.set(&values[1], 40);
    target = large;
    EXPECT_EQ(target.size(), 41u);
    EXPECT_EQ(target[40], &values[1]);
    Array const& self = target;
    target = self;
    EXPECT_EQ(target[40], &values[1]);
    Array const copy(target);
    EXPECT_EQ(copy[40], &values[1]);
}

namespace {

struct ArrayBesideVector {
    std::uint64_t below(std::uint64_t bound) { return random() % bound; }
    int* pointer() { return below(5) == 0 ? nullptr : &values[below(64)]; }

    std::mt19937_64 random = randomSource();
    Array array{below(3)};
    std::vector<int*> pointers;
};

void insertBack(ArrayBesideVector& both) {
    int* const pointer = both.pointer();
    ASSERT_EQ(both.array.insertBack(pointer), both.pointers.size());
    both.pointers.push_back(pointer);
}

void set(ArrayBesideVector& both) {
    int* const pointer = both.pointer();
    std::uint64_t const index = both.below(40);
    both.array.set(pointer, index);
    if (index >= both.pointers.size()) both.pointers.resize(index + 1);
    both.pointers[index] = pointer;
}

void makeAnew(ArrayBesideVector& both) {
    both.array = Array(both.below(20));
    both.pointers.clear();
}

constexpr Operation<ArrayBesideVector> ARRAY_OPERATIONS[] = {
    {"insert at the back", 20, insertBack},
    {"set", 20, set},
    {"make anew", 1, makeAnew},
};

} // namespace

TEST(PtrArrayModel, stays_what_a_plain_vector_is) {
    ArrayBesideVector both;
    for (std::uint64_t step = randomSteps(100'000); step > 0; --step) {
        Operation<ArrayBesideVector> const& operation = drawn(ARRAY_OPERATIONS, both.random);
        std::uint64_t const capacity = both.array.capacity();
        operation.act(both);
        ASSERT_FALSE(testing::Test::HasFatalFailure()) << operation.name;
        ASSERT_TRUE(both.array.capacity() == capacity || both.array.capacity() >= 2 * capacity ||
                    both.pointers.empty());
        ASSERT_EQ(both.array.size(), both.pointers.size());
        std::uint64_t const index = both.below(both.pointers.size() + 5);
        ASSERT_EQ(both.array[index], index < both.pointers.size() ? both.pointers[index] : nullptr);
    }
}
