#include "tests/crypto/crypt_fixture.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

using CrHashPtrOfUser = CryptFixture;

} // namespace

TEST_F(CrHashPtrOfUser, owns_the_hash) {
    int deaths = 0;
    {
        CrHash* const hash = new MortalHash(deaths);
        CrHashPtr const pointer(hash);
        EXPECT_EQ(pointer.ptr(), hash);
        EXPECT_EQ(static_cast<CrHash*>(pointer), hash);
        EXPECT_EQ(pointer.operator->(), hash);
        EXPECT_TRUE(pointer->isValid());
        EXPECT_EQ(deaths, 0);
    }
    EXPECT_EQ(deaths, 1);
    CrHashPtr const made(user.crypt.get());
    EXPECT_TRUE(made->isValid());
}

TEST_F(CrHashPtrOfUser, may_be_empty) {
    CrHashPtr const none(static_cast<CrHash*>(nullptr));
    EXPECT_EQ(none.ptr(), nullptr);
    CrHashPtr const noProvider(static_cast<Crypt*>(nullptr));
    EXPECT_EQ(noProvider.ptr(), nullptr);
}
