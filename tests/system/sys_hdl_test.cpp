#include <zor_basis/system.h>

#include <gtest/gtest.h>

#include <memory>
#include <type_traits>

using namespace ZOR_Basis;

TEST(SysHdl, is_nobody_by_itself) {
    static_assert(std::has_virtual_destructor_v<SysHdl>);
    std::unique_ptr<SysHdl> const handle(new SysHdl);
    EXPECT_FALSE(handle->isValid());
    EXPECT_FALSE(Sys::impersonate(handle.get())) << "nobody to act as";
    EXPECT_TRUE(Sys::revertToSelf());
}
