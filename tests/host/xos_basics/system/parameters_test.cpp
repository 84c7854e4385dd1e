#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>

namespace {

void* resolve(void* module, char const* name) {
    return module == nullptr && std::strcmp(name, "known") == 0 ? reinterpret_cast<void*>(resolve) : nullptr;
}

constexpr std::uint32_t RESOLVER = 0xFFFF8006;

TEST(HostParameters, give_the_resolver_that_was_set) {
    xos_HostSetResolver(resolve);
    xos_HostResolver found = nullptr;
    EXPECT_EQ(xos_BasicsParamLookup(RESOLVER, &found, sizeof found), 8);
    ASSERT_EQ(found, resolve);
    EXPECT_NE(found(nullptr, "known"), nullptr);
    xos_HostSetResolver(nullptr);
}

TEST(HostParameters, are_unknown_otherwise) {
    void* out = nullptr;
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, &out, sizeof out), 1) << "none was set";
    xos_HostSetResolver(resolve);
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER + 1, &out, sizeof out), 1);
    EXPECT_LT(xos_BasicsParamLookup(0, &out, sizeof out), 1);
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, &out, sizeof out - 1), 1) << "no room";
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, nullptr, sizeof out), 1);
    EXPECT_EQ(out, nullptr) << "nothing was stored";
    xos_HostSetResolver(nullptr);
}

} // namespace
