#include "tests/crypto/crypt_fixture.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

using CrHashOfUser = CryptFixture;

} // namespace

TEST_F(CrHashOfUser, takes_no_more_data_once_a_key_has_been_made_of_it) {
    std::unique_ptr<CrHash> const derived = user.hash("secret");
    std::unique_ptr<CrKey> const first(user.crypt->deriveKey(derived.get()));
    EXPECT_FALSE(derived->hashData("more", 4));
    std::unique_ptr<CrKey> const second(user.crypt->deriveKey(derived.get()));
    EXPECT_EQ(encrypted(*first, "message"), encrypted(*second, "message"));
    EXPECT_EQ(encrypted(*first, "message"), encrypted(*key, "message"));

    std::unique_ptr<CrHash> const exported = user.hash("secret");
    SecretBlob a, b;
    EXPECT_TRUE(exported->exportKey(a));
    EXPECT_FALSE(exported->hashData("more", 4));
    EXPECT_TRUE(exported->exportKey(b));
    EXPECT_EQ(a, b);
    EXPECT_TRUE(derived->exportKey(b)) << "also behind a derived key";
    EXPECT_EQ(a, b);
    EXPECT_TRUE(exported->isValid());
}

TEST_F(CrHashOfUser, takes_nothing_as_nothing) {
    CrHashPtr hash(user.crypt.get());
    EXPECT_TRUE(hash->hashData(nullptr, 0));
    EXPECT_TRUE(hash->hashData("x", 0));
    EXPECT_FALSE(hash->hashData(nullptr, 6));
    EXPECT_TRUE(hash->hashData("secret", 6));
    EXPECT_TRUE(hash->hashData(nullptr, 0));
    std::unique_ptr<CrKey> const made(user.crypt->deriveKey(hash));
    EXPECT_EQ(encrypted(*made, "message"), encrypted(*key, "message"));
}

TEST_F(CrHashOfUser, exports_its_key_in_28_bytes) {
    // The digest of no bytes at all is in RFC 1321.
    static constexpr char EXPECTED[] = "\x08\x02\0\0\x02\x66\0\0\x10\0\0\0"
                                       "\xd4\x1d\x8c\xd9\x8f\x00\xb2\x04\xe9\x80\x09\x98\xec\xf8\x42\x7e";
    CrHashPtr hash(user.crypt.get());
    SecretBlob blob;
    ASSERT_TRUE(hash->exportKey(blob));
    EXPECT_EQ(bytesOf(blob), std::string(EXPECTED, 28));
    EXPECT_EQ(blob.sizeBuf(), 28u);
}

TEST_F(CrHashOfUser, exports_into_the_present_block_where_it_has_room) {
    SecretBlob expected;
    ASSERT_TRUE(user.hash("secret")->exportKey(expected));
    struct Case {
        Row row;
        std::uint64_t room, size, roomAfter;
    };
    for (Case const& c : {
             Case{{}, 0, 0, 28},
             Case{{}, 27, 27, 28},
             Case{{}, 28, 5, 28},
             Case{{}, 28, 28, 28},
             Case{{}, 100, 0, 100},
             Case{{}, 100, 100, 100},
         }) {
        SCOPED_TRACE(c.row);
        SecretBlob blob;
        blob.alloc(c.room, false);
        if (c.size != 0) std::memset(blob.buf(), 'x', c.size);
        blob.setSize(c.size);
        char const* const block = blob.val();
        ASSERT_TRUE(user.hash("secret")->exportKey(blob));
        EXPECT_EQ(blob.size(), 28u);
        EXPECT_EQ(blob.sizeBuf(), c.roomAfter);
        if (c.room >= 28) { EXPECT_EQ(blob.val(), block); }
        EXPECT_EQ(blob, expected);
    }
}
