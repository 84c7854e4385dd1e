// The DLL has its own runtime and so its own new-handler, so this is tested with the library's objects in the program.

#include "zor_basis/text/auto_ptr_cstr.h"

#include <gtest/gtest.h>

#include <limits>
#include <new>

namespace {

int handlerCalls;

void giveUpAtTheThirdCall() {
    if (++handlerCalls == 3) std::set_new_handler(nullptr);
}

} // namespace

TEST(AutoPtrCStrNewHandler, asks_the_new_handler_again_and_again) {
    handlerCalls = 0;
    std::new_handler const before = std::set_new_handler(giveUpAtTheThirdCall);
    EXPECT_THROW(Auto_ptr_CStr{std::numeric_limits<std::uint64_t>::max() / 2}, std::bad_alloc);
    std::set_new_handler(before);
    EXPECT_EQ(handlerCalls, 3);
}
