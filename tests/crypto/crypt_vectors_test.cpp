// Results of the system's cryptographic service for secrets and messages; both targets must give the same bytes.

#include "tests/crypto/crypt_user.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <set>

using namespace ZOR_Basis;

namespace {

struct Vector {
    char const *secret, *plain, *encrypted, *keyBlob;
};

constexpr Vector VECTORS[] = {
#include "tests/crypto/service_vectors.inc"
};

std::string fromHex(std::string const& digits) {
    std::string bytes;
    for (std::size_t i = 0; i < digits.size(); i += 2)
        bytes += static_cast<char>(std::stoi(digits.substr(i, 2), nullptr, 16));
    return bytes;
}

std::string toHex(std::string const& bytes) {
    std::string digits;
    for (unsigned char c : bytes) {
        digits += "0123456789abcdef"[c >> 4];
        digits += "0123456789abcdef"[c & 15];
    }
    return digits;
}

struct CryptVectors : testing::Test {
    /// \param test  called with each vector and the user
    template <class Test>
    void each(Test test) {
        for (Vector const& vector : VECTORS) {
            SCOPED_TRACE(std::string("row ") + std::to_string(&vector - VECTORS + 1));
            test(vector);
        }
    }

    CryptUser user;
};

} // namespace

TEST_F(CryptVectors, are_many_and_differ) {
    EXPECT_GE(std::size(VECTORS), 60u);
    std::set<std::string> results;
    std::set<std::size_t> lengths;
    for (Vector const& vector : VECTORS) {
        results.insert(vector.encrypted);
        lengths.insert(std::string(vector.plain).size() / 2);
    }
    EXPECT_EQ(results.size(), std::size(VECTORS));
    EXPECT_GE(lengths.size(), 40u);
}

TEST_F(CryptVectors, are_what_encrypting_gives) {
    each([&](Vector const& v) {
        EXPECT_EQ(toHex(encrypted(*user.key(fromHex(v.secret)), fromHex(v.plain))), v.encrypted);
    });
}

TEST_F(CryptVectors, are_what_decrypting_takes) {
    each([&](Vector const& v) {
        Blob out;
        ASSERT_TRUE(user.key(fromHex(v.secret))->decrypt(blobOf(fromHex(v.encrypted)), out));
        EXPECT_EQ(toHex(bytesOf(out)), v.plain);
    });
}

TEST_F(CryptVectors, are_what_exported_keys_look_like) {
    each([&](Vector const& v) {
        SecretBlob out;
        ASSERT_TRUE(user.hash(fromHex(v.secret))->exportKey(out));
        EXPECT_EQ(toHex(bytesOf(out)), v.keyBlob);
        EXPECT_EQ(out.sizeBuf(), 28u);
    });
}

TEST_F(CryptVectors, do_not_depend_on_the_pieces_in_which_a_secret_comes) {
    each([&](Vector const& v) {
        std::string const secret = fromHex(v.secret);
        for (std::size_t piece : {1, 3, 63, 64, 65}) {
            CrHashPtr hash(user.crypt.get());
            for (std::size_t at = 0; at < secret.size(); at += piece)
                ASSERT_TRUE(hash->hashData(secret.data() + at, std::min(piece, secret.size() - at)));
            std::unique_ptr<CrKey> const key(user.crypt->deriveKey(hash));
            EXPECT_EQ(toHex(encrypted(*key, fromHex(v.plain))), v.encrypted) << piece;
        }
    });
}
