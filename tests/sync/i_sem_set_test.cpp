#include <zor_basis/sync/i_sem_set.h>

#include <gtest/gtest.h>

#include <memory>
#include <type_traits>

using namespace ZOR_Basis;

TEST(ISemSet, is_deleted_through_its_interface) {
    struct Counted : ISemSet {
        explicit Counted(int& deletions) : deletions_(deletions) {}
        ~Counted() override { ++deletions_; }
        bool take(std::uint64_t /*key*/) override { return true; }
        bool give(std::uint64_t /*key*/) override { return true; }
        int& deletions_;
    };
    static_assert(!std::is_copy_constructible_v<Counted>);
    int deletions = 0;
    std::unique_ptr<ISemSet> set = std::make_unique<Counted>(deletions);
    EXPECT_TRUE(set->take(1) && set->give(1));
    set.reset();
    EXPECT_EQ(deletions, 1);
}
