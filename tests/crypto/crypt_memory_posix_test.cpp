// The content of each block when it is released, and calls for which there is no memory. The linker redirects every
// `malloc` and `free` of this program's objects, the library's included, to this file.

#include "tests/crypto/crypt_user.h"
#include "tests/support/watched_blocks.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

/// Blocks are watched during its lifetime.
struct Watched {
    explicit Watched(std::size_t lacking = Watch::MOST) {
        watch = {};
        watch.lacking = lacking;
        watch.on = true;
    }
    ~Watched() { watch.on = false; }
};

} // namespace

TEST(CryptMemoryPosix, is_wiped_before_it_is_released) {
    CryptUser const user;
    {
        Watched const watched;
        {
            CrHashPtr hash(user.crypt.get());
            hash->hashData("a secret of more bytes than the one block that the hash takes at a time, and then some",
                           86);
            SecretBlob exported;
            exported.copy(5, "small");
            ASSERT_TRUE(hash->exportKey(exported));
            std::unique_ptr<CrKey> const key(user.crypt->deriveKey(hash));
            SecretBlob message;
            message.copy(7, "message");
            ASSERT_TRUE(key->encrypt(message, message));
            ASSERT_TRUE(key->decrypt(message, message));
        }
    }
    EXPECT_EQ(watch.made, 7u) << "hash, two blocks of the blob, exported key, key, two blocks of the message";
    for (std::size_t i = 0; i < watch.made; ++i) {
        EXPECT_TRUE(watch.blocks[i].released) << i;
        EXPECT_TRUE(watch.blocks[i].wiped) << i;
    }
}

TEST(CryptMemoryPosix, may_be_short_for_a_hash) {
    CryptUser const user;
    Watched const watched(0);
    std::unique_ptr<CrHash> const hash(user.crypt->createHash());
    ASSERT_NE(hash, nullptr);
    EXPECT_FALSE(hash->isValid());
    EXPECT_FALSE(hash->hashData("x", 1));
}

TEST(CryptMemoryPosix, may_be_short_for_a_key) {
    CryptUser const user;
    std::unique_ptr<CrHash> const hash = user.hash("secret");
    Watched const watched(0);
    std::unique_ptr<CrKey> const key(user.crypt->deriveKey(hash.get()));
    ASSERT_NE(key, nullptr);
    EXPECT_FALSE(key->isValid());
}

TEST(CryptMemoryPosix, may_be_short_for_an_exported_key) {
    CryptUser const user;
    std::unique_ptr<CrHash> const hash = user.hash("secret");
    for (std::size_t lacking : {0, 1}) {
        SecretBlob out;
        out.copy(3, "abc");
        {
            Watched const watched(lacking);
            EXPECT_FALSE(hash->exportKey(out)) << lacking;
        }
        EXPECT_EQ(bytesOf(out), "abc") << lacking;
        for (std::size_t i = 0; i < watch.made; ++i) EXPECT_TRUE(watch.blocks[i].released) << lacking;
    }
}

TEST(CryptMemoryPosix, may_be_short_for_a_message) {
    CryptUser const user;
    std::unique_ptr<CrKey> const key = user.key("secret");
    Blob const plain = blobOf("message");
    Blob same = plain;
    Blob out = blobOf("abc");
    {
        Watched const watched(0);
        EXPECT_FALSE(key->encrypt(same, same));
        EXPECT_FALSE(watch.asked == 0);
    }
    EXPECT_EQ(bytesOf(same), "message");
    {
        Watched const watched(0);
        EXPECT_FALSE(key->encrypt(plain, out));
    }
    EXPECT_EQ(bytesOf(out), "abc");
    Blob const encryptedOne = blobOf(encrypted(*key, "message"));
    {
        Watched const watched(0);
        EXPECT_FALSE(key->decrypt(encryptedOne, out));
    }
    EXPECT_EQ(bytesOf(out), "abc");
    EXPECT_TRUE(key->decrypt(encryptedOne, out));
    EXPECT_EQ(bytesOf(out), "message");
}
