#include "tests/crypto/crypt_fixture.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

using CryptOfUser = CryptFixture;

} // namespace

TEST(Crypt, breathes) {
    Crypt* const crypt = Crypt::make("any");
    ASSERT_NE(crypt, nullptr);
    EXPECT_TRUE(crypt->isValid());
    {
        CrHashPtr hash(crypt);
        EXPECT_TRUE(hash->isValid());
        EXPECT_TRUE(hash->hashData("secret", 6));
        CrKey* const key = crypt->deriveKey(hash);
        EXPECT_TRUE(key->isValid());
        Blob const plain = blobOf("a message");
        Blob out;
        EXPECT_TRUE(key->encrypt(plain, out));
        EXPECT_EQ(out.size(), 16u);
        EXPECT_TRUE(key->decrypt(out, out));
        EXPECT_EQ(out, plain);
        delete key;
    }
    delete crypt;
}

TEST(Crypt, has_interfaces_that_are_deleted_through_and_copy_nothing) {
    static_assert(std::has_virtual_destructor_v<Crypt> && std::has_virtual_destructor_v<CrHash> &&
                  std::has_virtual_destructor_v<CrKey>);
    static_assert(std::is_abstract_v<Crypt> && std::is_abstract_v<CrHash> && std::is_abstract_v<CrKey>);
    static_assert(!std::is_copy_constructible_v<CrHashPtr> && !std::is_copy_assignable_v<CrHashPtr>);
    static_assert(sizeof(Crypt) == sizeof(void*) && sizeof(CrHash) == sizeof(void*) && sizeof(CrKey) == sizeof(void*));
    int deaths = 0;
    {
        MortalHash const first(deaths);
        MortalHash const second(first);
        EXPECT_TRUE(second.isValid());
    }
    EXPECT_EQ(deaths, 2);
}

TEST(Crypt, Kept_crypto_01_ignores_the_name) {
    std::string expected;
    for (char const* name : {"", "any", static_cast<char const*>(nullptr), "no such provider", "\xFF"}) {
        CryptUser user;
        user.crypt.reset(Crypt::make(name));
        EXPECT_TRUE(user.crypt->isValid());
        std::string const made = encrypted(*user.key("secret"), "message");
        EXPECT_EQ(made.size(), 8u);
        if (expected.empty()) expected = made;
        EXPECT_EQ(made, expected);
    }
    std::unique_ptr<Crypt> const a(Crypt::make("")), b(Crypt::make(""));
    EXPECT_NE(a, b);
}

TEST(Crypt, Kept_crypto_02_leaves_hashes_and_keys_alive_when_it_is_deleted) {
    CryptUser user;
    std::string const expected = encrypted(*user.key("secret"), "message");
    std::unique_ptr<CrHash> const hash = user.hash("secret");
    std::unique_ptr<CrKey> const key = user.key("secret");
    user.crypt.reset();
    EXPECT_EQ(encrypted(*key, "message"), expected);
    SecretBlob blob;
    EXPECT_TRUE(hash->exportKey(blob)) << "which derives a key from the deleted provider's context";
    CryptUser other;
    std::unique_ptr<CrKey> const late(other.crypt->deriveKey(hash.get()));
    EXPECT_EQ(encrypted(*late, "message"), expected) << "one provider's hash serves another";
}

TEST_F(CryptOfUser, derives_equal_keys_from_equal_secrets_only) {
    std::string const expected = encrypted(*key, "message");
    EXPECT_EQ(encrypted(*user.key("secret"), "message"), expected);
    EXPECT_EQ(encrypted(*CryptUser().key("secret"), "message"), expected) << "of another provider, too";
    for (char const* other : {"", "secre", "Secret", "secret ", "terces"})
        EXPECT_NE(encrypted(*user.key(other), "message"), expected) << other;
    EXPECT_NE(encrypted(*user.key(std::string("secret\0", 7)), "message"), expected);
    Blob out;
    ASSERT_TRUE(user.key("secret")->decrypt(blobOf(expected), out));
    EXPECT_EQ(bytesOf(out), "message");
}

TEST_F(CryptOfUser, derives_an_invalid_key_from_no_hash) {
    std::unique_ptr<CrKey> const none(user.crypt->deriveKey(nullptr));
    ASSERT_NE(none, nullptr);
    EXPECT_FALSE(none->isValid());
    Blob const plain = blobOf("message");
    Blob out = blobOf("what there was");
    EXPECT_FALSE(none->encrypt(plain, out));
    EXPECT_EQ(bytesOf(out), "message");
    EXPECT_FALSE(none->decrypt(blobOf("12345678"), out));
    EXPECT_EQ(out.size(), 8u);
}
