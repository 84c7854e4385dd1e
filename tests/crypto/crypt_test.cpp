#include "tests/crypto/crypt_user.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

std::string randomBytes(std::mt19937_64& random, std::size_t n) {
    std::string bytes(n, '\0');
    for (char& c : bytes) c = static_cast<char>(random());
    return bytes;
}

std::size_t paddedSize(std::size_t n) { return n / 8 * 8 + 8; }

struct CryptTest : testing::Test {
    CryptUser user;
    std::unique_ptr<CrKey> key = user.key("secret");
};

using CrHashTest = CryptTest;
using CrKeyTest = CryptTest;
using CrHashPtrTest = CryptTest;

/// A hash that tells of its end.
struct Mortal : CrHash {
    explicit Mortal(int& counter) : deaths(counter) {}
    ~Mortal() override { ++deaths; }
    bool hashData(void const*, std::uint64_t) override { return true; }
    bool isValid() const override { return true; }
    bool exportKey(Blob&) override { return false; }
    int& deaths;
};

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
        Mortal const first(deaths);
        Mortal const second(first);
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

TEST_F(CryptTest, derives_equal_keys_from_equal_secrets_only) {
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

TEST_F(CryptTest, derives_an_invalid_key_from_no_hash) {
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

TEST_F(CrHashTest, takes_no_more_data_once_a_key_has_been_made_of_it) {
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

TEST_F(CrHashTest, takes_nothing_as_nothing) {
    CrHashPtr hash(user.crypt.get());
    EXPECT_TRUE(hash->hashData(nullptr, 0));
    EXPECT_TRUE(hash->hashData("x", 0));
    EXPECT_FALSE(hash->hashData(nullptr, 6));
    EXPECT_TRUE(hash->hashData("secret", 6));
    EXPECT_TRUE(hash->hashData(nullptr, 0));
    std::unique_ptr<CrKey> const made(user.crypt->deriveKey(hash));
    EXPECT_EQ(encrypted(*made, "message"), encrypted(*key, "message"));
}

TEST_F(CrHashTest, exports_its_key_in_28_bytes) {
    // The digest of no bytes at all is in RFC 1321.
    static constexpr char EXPECTED[] = "\x08\x02\0\0\x02\x66\0\0\x10\0\0\0"
                                       "\xd4\x1d\x8c\xd9\x8f\x00\xb2\x04\xe9\x80\x09\x98\xec\xf8\x42\x7e";
    CrHashPtr hash(user.crypt.get());
    SecretBlob blob;
    ASSERT_TRUE(hash->exportKey(blob));
    EXPECT_EQ(bytesOf(blob), std::string(EXPECTED, 28));
    EXPECT_EQ(blob.sizeBuf(), 28u);
}

TEST_F(CrHashTest, exports_into_the_present_block_where_it_has_room) {
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

TEST_F(CrKeyTest, pads_to_whole_blocks) {
    for (std::size_t n = 0; n <= 80; ++n) {
        std::string const plain(n, 'p');
        Blob const in = blobOf(plain);
        Blob out;
        ASSERT_TRUE(key->encrypt(in, out)) << n;
        EXPECT_EQ(out.size(), paddedSize(n)) << n;
        EXPECT_EQ(out.sizeBuf(), paddedSize(n)) << n;
        EXPECT_EQ(bytesOf(in), plain);
        EXPECT_EQ(in.sizeBuf(), n);
        ASSERT_TRUE(key->decrypt(out, out)) << n;
        EXPECT_EQ(bytesOf(out), plain);
        EXPECT_EQ(out.sizeBuf(), paddedSize(n)) << "the block stays";
    }
}

TEST_F(CrKeyTest, takes_the_padding_away_from_nothing_but_padding) {
    Blob out;
    ASSERT_TRUE(key->encrypt(Blob(), out));
    EXPECT_EQ(out.size(), 8u);
    Blob plain;
    ASSERT_TRUE(key->decrypt(out, plain));
    EXPECT_EQ(plain.size(), 0u);
    for (std::string const& message : {std::string(8, '\x08'), std::string(7, '\x01'), std::string(24, '\x03')}) {
        ASSERT_TRUE(key->encrypt(blobOf(message), out));
        ASSERT_TRUE(key->decrypt(out, out));
        EXPECT_EQ(bytesOf(out), message);
    }
}

TEST_F(CrKeyTest, starts_afresh_with_each_message) {
    std::string const first = encrypted(*key, "a message of some blocks");
    EXPECT_EQ(encrypted(*key, "a message of some blocks"), first);
    Blob out;
    EXPECT_TRUE(key->decrypt(blobOf(first), out));
    EXPECT_EQ(encrypted(*key, "a message of some blocks"), first);
    EXPECT_FALSE(key->decrypt(blobOf("no such message "), out));
    EXPECT_EQ(encrypted(*key, "a message of some blocks"), first) << "after a failure, too";
    EXPECT_NE(first.substr(0, 8), encrypted(*key, "another message").substr(0, 8));
    std::string const twice = encrypted(*key, "8 bytes!8 bytes!");
    EXPECT_NE(twice.substr(0, 8), twice.substr(8, 8)) << "the blocks are chained";
}

TEST_F(CrKeyTest, works_in_place) {
    for (std::uint64_t room : {0, 24, 25, 32, 33, 100}) {
        for (std::size_t n : {0, 1, 7, 8, 23, 24}) {
            Blob blob = blobOf(std::string(n, 'p'));
            blob.alloc(room, true);
            std::uint64_t const capacity = blob.sizeBuf();
            char const* const block = blob.val();
            ASSERT_TRUE(key->encrypt(blob, blob)) << room << " " << n;
            EXPECT_EQ(bytesOf(blob), encrypted(*key, std::string(n, 'p'))) << room << " " << n;
            EXPECT_EQ(blob.sizeBuf(), std::max<std::uint64_t>(capacity, paddedSize(n)));
            if (capacity >= paddedSize(n)) { EXPECT_EQ(blob.val(), block); }
            char const* const encryptedBlock = blob.val();
            ASSERT_TRUE(key->decrypt(blob, blob));
            EXPECT_EQ(bytesOf(blob), std::string(n, 'p'));
            EXPECT_EQ(blob.val(), encryptedBlock);
        }
    }
}

TEST_F(CrKeyTest, uses_the_targets_block_where_it_has_room) {
    Blob const plain = blobOf("twelve bytes");
    for (std::uint64_t room : {15, 16, 17, 40}) {
        Blob out(room, std::string(room, 'x').data());
        char const* const block = out.val();
        ASSERT_TRUE(key->encrypt(plain, out));
        EXPECT_EQ(out.size(), 16u);
        EXPECT_EQ(out.sizeBuf(), std::max<std::uint64_t>(room, 16));
        if (room >= 16) { EXPECT_EQ(out.val(), block); }

        Blob back(room, std::string(room, 'x').data());
        ASSERT_TRUE(key->decrypt(out, back));
        EXPECT_EQ(bytesOf(back), "twelve bytes");
        EXPECT_EQ(back.sizeBuf(), std::max<std::uint64_t>(room, 16));
        EXPECT_EQ(out.size(), 16u) << "the source stays";
    }
}

TEST_F(CrKeyTest, refuses_what_is_not_whole_blocks) {
    std::string const message = encrypted(*key, "a message of some blocks");
    ASSERT_EQ(message.size(), 32u);
    for (std::size_t n = 0; n < message.size(); ++n) {
        std::string const truncated = message.substr(0, n);
        Blob out = blobOf("what there was");
        if (n % 8 != 0 || n == 0) {
            EXPECT_FALSE(key->decrypt(blobOf(truncated), out)) << n;
            EXPECT_EQ(bytesOf(out), truncated) << "it was brought there";
        } else {
            EXPECT_FALSE(key->decrypt(blobOf(truncated), out) && bytesOf(out) == "a message of some blocks") << n;
        }
    }
    Blob empty;
    EXPECT_FALSE(key->decrypt(empty, empty));
    EXPECT_EQ(empty.val(), nullptr);
}

TEST_F(CrKeyTest, refuses_a_padding_in_which_one_bit_has_changed) {
    // A bit that changes in one block changes in the message of the next one, which here is padding only.
    std::string const message = encrypted(*key, "8 bytes!");
    ASSERT_EQ(message.size(), 16u);
    for (std::size_t bit = 0; bit < 64; ++bit) {
        std::string changed = message;
        changed[bit / 8] = static_cast<char>(changed[bit / 8] ^ (1 << bit % 8));
        Blob out;
        EXPECT_FALSE(key->decrypt(blobOf(changed), out)) << bit;
        EXPECT_EQ(out.size(), 16u) << bit;
    }
    Blob out;
    EXPECT_TRUE(key->decrypt(blobOf(message), out)) << "the key is as good as before";
}

TEST_F(CrKeyTest, takes_only_1_to_8_equal_bytes_for_a_padding) {
    struct Case {
        Row row;
        std::string end; // of the last block
        int taken;       // bytes of padding; -1: none
    };
    for (Case const& c : {
             Case{{}, std::string(1, '\x01'), 1},
             Case{{}, std::string(2, '\x02'), 2},
             Case{{}, std::string(7, '\x07'), 7},
             Case{{}, std::string(8, '\x08'), 8},
             Case{{}, std::string(3, '\x02'), 2},
             Case{{}, std::string(8, '\x01'), 1},
             Case{{}, std::string(1, '\x02'), -1},
             Case{{}, std::string(7, '\x08'), -1},
             Case{{}, std::string("\x02\x03\x03", 3), -1},
             Case{{}, std::string("\x03\x02\x03", 3), -1},
             Case{{}, std::string(9, '\x09'), -1},
             Case{{}, std::string(16, '\x10'), -1},
             Case{{}, std::string(8, '\0'), -1},
             Case{{}, std::string(1, '\xFF'), -1},
         }) {
        SCOPED_TRACE(c.row);
        // Without the block of its own padding, the message ends in what the row says.
        std::string const plain = std::string(16 - c.end.size(), 'm') + c.end;
        Blob out;
        bool const done = key->decrypt(blobOf(encrypted(*key, plain).substr(0, 16)), out);
        EXPECT_EQ(done, c.taken >= 0);
        EXPECT_EQ(out.size(), done ? 16u - static_cast<unsigned>(c.taken) : 16u);
        if (done) { EXPECT_EQ(bytesOf(out), plain.substr(0, out.size())); }
    }
}

TEST_F(CrKeyTest, never_gives_the_message_back_when_a_byte_has_changed) {
    std::string const plain = "a message of some blocks, and then some more";
    std::string const message = encrypted(*key, plain);
    for (std::size_t at = 0; at < message.size(); ++at) {
        std::string changed = message;
        changed[at] = static_cast<char>(changed[at] ^ 0x55);
        Blob out;
        EXPECT_FALSE(key->decrypt(blobOf(changed), out) && bytesOf(out) == plain) << at;
    }
}

TEST_F(CrKeyTest, never_gives_the_message_to_another_key) {
    std::string const plain = "a message of some blocks";
    std::string const message = encrypted(*key, plain);
    int refused = 0;
    for (int i = 0; i < 500; ++i) {
        Blob out;
        bool const done = user.key("secret " + std::to_string(i))->decrypt(blobOf(message), out);
        EXPECT_FALSE(done && bytesOf(out) == plain) << i;
        refused += done ? 0 : 1;
    }
    EXPECT_GT(refused, 450) << "one block in 255 ends in a padding by chance";
}

TEST_F(CrKeyTest, gives_random_messages_back) {
    std::mt19937_64 random = randomSource();
    for (std::uint64_t step = randomSteps(10'000); step > 0; --step) {
        std::string const secret = randomBytes(random, random() % 100);
        std::string const plain = randomBytes(random, random() % 8 == 0 ? random() % 5000 : random() % 100);
        std::unique_ptr<CrKey> const one = user.key(secret);
        std::unique_ptr<CrKey> const other = user.key(secret);
        Blob blob = blobOf(plain);
        Blob separate = blobOf(randomBytes(random, random() % 200));
        bool const inPlace = random() % 2 == 0;
        Blob& out = inPlace ? blob : separate;
        ASSERT_TRUE(one->encrypt(blob, out));
        ASSERT_EQ(out.size(), paddedSize(plain.size()));
        if (!inPlace) { ASSERT_EQ(bytesOf(blob), plain); }
        ASSERT_NE(bytesOf(out).substr(0, plain.size()), plain.empty() ? "-" : plain);
        Blob back = blobOf(randomBytes(random, random() % 200));
        Blob& end = random() % 2 == 0 ? back : out;
        ASSERT_TRUE(other->decrypt(out, end));
        ASSERT_EQ(bytesOf(end), plain);
    }
}

TEST_F(CrHashPtrTest, owns_the_hash) {
    int deaths = 0;
    {
        CrHash* const hash = new Mortal(deaths);
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

TEST_F(CrHashPtrTest, may_be_empty) {
    CrHashPtr const none(static_cast<CrHash*>(nullptr));
    EXPECT_EQ(none.ptr(), nullptr);
    CrHashPtr const noProvider(static_cast<Crypt*>(nullptr));
    EXPECT_EQ(noProvider.ptr(), nullptr);
}
