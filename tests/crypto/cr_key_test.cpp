#include "tests/crypto/crypt_fixture.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

using namespace ZOR_Basis;

namespace {

using CrKeyOfUser = CryptFixture;

std::string randomBytes(std::mt19937_64& random, std::size_t n) {
    std::string bytes(n, '\0');
    for (char& c : bytes) c = static_cast<char>(random());
    return bytes;
}

std::size_t paddedSize(std::size_t n) { return n / 8 * 8 + 8; }

} // namespace

TEST_F(CrKeyOfUser, pads_to_whole_blocks) {
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

TEST_F(CrKeyOfUser, takes_the_padding_away_from_nothing_but_padding) {
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

TEST_F(CrKeyOfUser, starts_afresh_with_each_message) {
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

TEST_F(CrKeyOfUser, works_in_place) {
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

TEST_F(CrKeyOfUser, uses_the_targets_block_where_it_has_room) {
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

TEST_F(CrKeyOfUser, refuses_what_is_not_whole_blocks) {
    std::string const message = encrypted(*key, "a message of some blocks");
    ASSERT_EQ(message.size(), 32u);
    for (std::size_t n = 0; n < message.size(); ++n) {
        std::string const truncated = message.substr(0, n);
        Blob out = blobOf("what there was");
        if (n % 8 != 0 || n == 0) {
            EXPECT_FALSE(key->decrypt(blobOf(truncated), out)) << n;
            EXPECT_EQ(bytesOf(out), truncated) << "the message was copied there";
        } else {
            EXPECT_FALSE(key->decrypt(blobOf(truncated), out) && bytesOf(out) == "a message of some blocks") << n;
        }
    }
    Blob empty;
    EXPECT_FALSE(key->decrypt(empty, empty));
    EXPECT_EQ(empty.val(), nullptr);
}

TEST_F(CrKeyOfUser, refuses_a_padding_in_which_one_bit_has_changed) {
    // A bit that changes in one encrypted block changes in the next block of the message, which here is only padding.
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
    EXPECT_TRUE(key->decrypt(blobOf(message), out)) << "the key still works";
}

namespace {

struct End {
    Row row;
    std::string bytes; // of the last block
    int taken;         // bytes of padding; -1: none
};

End const ENDS[] = {
    {{}, std::string(1, '\x01'), 1},          {{}, std::string(2, '\x02'), 2},
    {{}, std::string(7, '\x07'), 7},          {{}, std::string(8, '\x08'), 8},
    {{}, std::string(3, '\x02'), 2},          {{}, std::string(8, '\x01'), 1},
    {{}, std::string(1, '\x02'), -1},         {{}, std::string(7, '\x08'), -1},
    {{}, std::string("\x02\x03\x03", 3), -1}, {{}, std::string("\x03\x02\x03", 3), -1},
    {{}, std::string(9, '\x09'), -1},         {{}, std::string(16, '\x10'), -1},
    {{}, std::string(8, '\0'), -1},           {{}, std::string(1, '\xFF'), -1},
};

} // namespace

TEST_F(CrKeyOfUser, takes_only_1_to_8_equal_bytes_for_a_padding) {
    for (End const& c : ENDS) {
        SCOPED_TRACE(c.row);
        // Without the block of padding that encrypting added, the message ends with the bytes of the row.
        std::string const plain = std::string(16 - c.bytes.size(), 'm') + c.bytes;
        Blob out;
        bool const done = key->decrypt(blobOf(encrypted(*key, plain).substr(0, 16)), out);
        EXPECT_EQ(done, c.taken >= 0);
        EXPECT_EQ(out.size(), done ? 16u - static_cast<unsigned>(c.taken) : 16u);
        if (done) { EXPECT_EQ(bytesOf(out), plain.substr(0, out.size())); }
    }
}

TEST_F(CrKeyOfUser, never_gives_the_message_back_when_a_byte_has_changed) {
    std::string const plain = "a message of some blocks, and then some more";
    std::string const message = encrypted(*key, plain);
    for (std::size_t at = 0; at < message.size(); ++at) {
        std::string changed = message;
        changed[at] = static_cast<char>(changed[at] ^ 0x55);
        Blob out;
        EXPECT_FALSE(key->decrypt(blobOf(changed), out) && bytesOf(out) == plain) << at;
    }
}

TEST_F(CrKeyOfUser, never_gives_the_message_to_another_key) {
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

TEST_F(CrKeyOfUser, gives_random_messages_back) {
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
