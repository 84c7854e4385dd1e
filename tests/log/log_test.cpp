#include <zor_basis/log.h>

#include <gtest/gtest.h>

#include <type_traits>

using namespace ZOR_Basis;

static_assert(!std::is_copy_constructible_v<Log> && !std::is_copy_assignable_v<Log>);
static_assert(std::has_virtual_destructor_v<Logger> && std::is_abstract_v<Logger>);

TEST(Log, without_a_name_drops_everything) {
    Log byDefault;
    Log byNull(nullptr);
    for (Log* log : {&byDefault, &byNull}) {
        log->out("%s %d", "text", 5);
        log->newSession();
        EXPECT_TRUE(log->flush());
        log->init(nullptr);
        log->out("again");
    }
}
