// How the classes call the cryptographic service, and what they do when a call fails.

#include "tests/crypto/crypt_user.h"

#include "basis/crypto/crypt_service.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <map>
#include <set>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Handle = CryptService::Handle;

/// Records calls and lets selected ones fail.
struct Record {
    CryptService real;
    /// Calls by name, and which of them fail: the number of the first, and how many.
    std::map<std::string, int> calls;
    std::map<std::string, std::pair<int, int>> failures;
    std::vector<bool> newKeySets;
    std::vector<bool> exportables;
    std::vector<std::uint32_t> pieces;
    /// Whether an export received a block, and the length that it received.
    std::vector<std::pair<bool, std::uint32_t>> exported;
    bool readsData = true;
    std::set<Handle> hashes, keys;
    std::size_t wronglyDestroyed = 0;
    int lastErrors = 0;

    /// Counts a call. \return false if it is to fail
    bool goesOn(std::string const& name) {
        int const number = calls[name]++;
        auto const found = failures.find(name);
        if (found == failures.end()) return true;
        auto const [first, times] = found->second;
        return number < first || number >= first + times;
    }
};

Record* record = nullptr;

bool acquire(Handle& provider, bool newKeySet) {
    record->newKeySets.push_back(newKeySet);
    return record->goesOn("acquire") && record->real.acquire(provider, newKeySet);
}
bool createHash(Handle provider, Handle& hash) {
    if (!record->goesOn("createHash") || !record->real.createHash(provider, hash)) return false;
    record->hashes.insert(hash);
    return true;
}
bool hashData(Handle hash, void const* data, std::uint32_t n) {
    record->pieces.push_back(n);
    return record->goesOn("hashData") && (!record->readsData || record->real.hashData(hash, data, n));
}
void destroyHash(Handle hash) {
    record->wronglyDestroyed += 1 - record->hashes.erase(hash);
    record->real.destroyHash(hash);
}
bool deriveKey(Handle provider, Handle hash, bool exportable, Handle& key) {
    record->exportables.push_back(exportable);
    if (!record->goesOn("deriveKey") || !record->real.deriveKey(provider, hash, exportable, key)) return false;
    record->keys.insert(key);
    return true;
}
bool exportKey(Handle key, char* blob, std::uint32_t& n) {
    record->exported.emplace_back(blob != nullptr, n);
    return record->goesOn(blob == nullptr ? "exportLength" : "exportKey") && record->real.exportKey(key, blob, n);
}
bool encrypt(Handle key, char* data, std::uint32_t& n, std::uint32_t room) {
    return record->goesOn(data == nullptr ? "paddedLength" : "encrypt") && record->real.encrypt(key, data, n, room);
}
bool decrypt(Handle key, char* data, std::uint32_t& n) {
    return record->goesOn("decrypt") && record->real.decrypt(key, data, n);
}
void destroyKey(Handle key) {
    record->wronglyDestroyed += 1 - record->keys.erase(key);
    record->real.destroyKey(key);
}
std::uint32_t lastError() {
    ++record->lastErrors;
    return record->real.lastError();
}

struct CryptServiceRecorded : testing::Test {
    CryptServiceRecorded() {
        record = &record_;
        record_.real = cryptService;
        cryptService = {acquire,   createHash, hashData, destroyHash, deriveKey,
                        exportKey, encrypt,    decrypt,  destroyKey,  lastError};
    }
    ~CryptServiceRecorded() override {
        EXPECT_TRUE(record_.hashes.empty());
        EXPECT_TRUE(record_.keys.empty());
        EXPECT_EQ(record_.wronglyDestroyed, 0u);
        cryptService = record_.real;
    }

    /// Lets the next calls of this name fail.
    void fail(std::string const& name, int times = 1) { record_.failures[name] = {record_.calls[name], times}; }

    Record record_;
};

void expectUseless(CrHash* hash) {
    ASSERT_NE(hash, nullptr);
    EXPECT_FALSE(hash->isValid());
    EXPECT_FALSE(hash->hashData("secret", 6));
    EXPECT_FALSE(hash->hashData(nullptr, 0));
    SecretBlob out;
    out.copy(3, "abc");
    EXPECT_FALSE(hash->exportKey(out));
    EXPECT_EQ(bytesOf(out), "abc");
}

void expectUseless(CrKey* key) {
    ASSERT_NE(key, nullptr);
    EXPECT_FALSE(key->isValid());
    Blob const plain = blobOf("12345678");
    Blob out;
    EXPECT_FALSE(key->encrypt(plain, out));
    EXPECT_EQ(bytesOf(out), "12345678");
    EXPECT_FALSE(key->decrypt(plain, out));
    EXPECT_EQ(bytesOf(out), "12345678");
    Blob none;
    EXPECT_FALSE(key->encrypt(none, none));
    EXPECT_EQ(none.size(), 0u);
    EXPECT_FALSE(key->decrypt(none, none));
}

} // namespace

TEST_F(CryptServiceRecorded, is_asked_for_a_new_set_of_keys_only_where_there_is_none) {
    std::unique_ptr<Crypt> const first(Crypt::make(""));
    EXPECT_TRUE(first->isValid());
    EXPECT_EQ(record_.newKeySets, std::vector<bool>{false});

    record_.newKeySets.clear();
    fail("acquire");
    std::unique_ptr<Crypt> const second(Crypt::make(""));
    EXPECT_TRUE(second->isValid());
    EXPECT_EQ(record_.newKeySets, (std::vector<bool>{false, true}));
    EXPECT_EQ(record_.lastErrors, 0);
}

TEST_F(CryptServiceRecorded, Kept_crypto_03_may_be_missing_and_nobody_is_told) {
    fail("acquire", 100);
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    std::unique_ptr<Crypt> const crypt(Crypt::make("any"));
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    ASSERT_NE(crypt, nullptr);
    EXPECT_FALSE(crypt->isValid());
    EXPECT_EQ(record_.newKeySets, (std::vector<bool>{false, true})) << "it is asked twice";
    EXPECT_EQ(record_.lastErrors, 1);

    std::unique_ptr<CrHash> const hash(crypt->createHash());
    expectUseless(hash.get());
    std::unique_ptr<CrKey> const key(crypt->deriveKey(hash.get()));
    expectUseless(key.get());
    std::unique_ptr<CrKey> const none(crypt->deriveKey(nullptr));
    expectUseless(none.get());
}

TEST_F(CryptServiceRecorded, may_refuse_a_hash) {
    CryptUser const user;
    fail("createHash");
    std::unique_ptr<CrHash> const hash(user.crypt->createHash());
    expectUseless(hash.get());
    std::unique_ptr<CrKey> const key(user.crypt->deriveKey(hash.get()));
    expectUseless(key.get());
    EXPECT_TRUE(user.hash("secret")->isValid()) << "the next one is good";
}

TEST_F(CryptServiceRecorded, may_refuse_data) {
    CryptUser const user;
    std::unique_ptr<CrHash> const hash(user.crypt->createHash());
    fail("hashData");
    EXPECT_FALSE(hash->hashData("secret", 6));
    EXPECT_TRUE(hash->isValid());
    EXPECT_TRUE(hash->hashData("secret", 6));
}

TEST_F(CryptServiceRecorded, may_refuse_a_key) {
    CryptUser const user;
    fail("deriveKey");
    expectUseless(user.key("secret").get());
    EXPECT_TRUE(user.key("secret")->isValid()) << "the next one is good";
    EXPECT_EQ(record_.exportables, (std::vector<bool>{false, false}));
}

TEST_F(CryptServiceRecorded, may_refuse_to_export) {
    CryptUser const user;
    for (char const* name : {"deriveKey", "exportLength", "exportKey"}) {
        SCOPED_TRACE(name);
        for (std::uint64_t room : {0, 28, 100}) {
            std::unique_ptr<CrHash> const hash = user.hash("secret");
            SecretBlob out;
            out.alloc(room, false);
            fail(name);
            EXPECT_FALSE(hash->exportKey(out));
            EXPECT_EQ(out.size(), 0u);
            EXPECT_TRUE(record_.keys.empty()) << "the key for the export is destroyed";
            record_.exportables.clear();
            EXPECT_TRUE(hash->exportKey(out)) << "the next time it does";
            EXPECT_EQ(record_.exportables, std::vector<bool>{true});
            EXPECT_TRUE(record_.keys.empty());
        }
    }
}

TEST_F(CryptServiceRecorded, is_asked_to_export_by_the_length_that_it_told) {
    CryptUser const user;
    for (std::uint64_t room : {0, 5, 27, 28, 29, 100}) {
        SCOPED_TRACE(room);
        SecretBlob out;
        out.alloc(room, false);
        record_.exported.clear();
        EXPECT_TRUE(user.hash("secret")->exportKey(out));
        EXPECT_EQ(record_.exported, (std::vector<std::pair<bool, std::uint32_t>>{{false, 0}, {true, 28}}))
            << "whatever room there is";
        EXPECT_EQ(out.size(), 28u);
    }
}

TEST_F(CryptServiceRecorded, may_export_less_than_it_told) {
    CryptUser const user;
    static bool (*real)(Handle, char*, std::uint32_t&);
    real = cryptService.exportKey;
    cryptService.exportKey = [](Handle key, char* blob, std::uint32_t& n) {
        if (blob == nullptr) {
            n = 40;
            return true;
        }
        EXPECT_EQ(n, 40u);
        return real(key, blob, n);
    };
    SecretBlob out;
    EXPECT_TRUE(user.hash("secret")->exportKey(out));
    EXPECT_EQ(out.size(), 28u);
    EXPECT_EQ(out.sizeBuf(), 40u);
}

TEST_F(CryptServiceRecorded, Kept_crypto_04_may_refuse_to_encrypt_and_leaves_the_message) {
    CryptUser const user;
    std::unique_ptr<CrKey> const key = user.key("secret");
    Blob const plain = blobOf("message");
    Blob out;
    fail("encrypt");
    EXPECT_FALSE(key->encrypt(plain, out));
    EXPECT_EQ(bytesOf(out), "message");
    EXPECT_EQ(out.sizeBuf(), 8u);
    Blob same = plain;
    fail("encrypt");
    EXPECT_FALSE(key->encrypt(same, same));
    EXPECT_EQ(bytesOf(same), "message");
    ASSERT_TRUE(key->encrypt(same, same)) << "the next time it does";
    ASSERT_TRUE(key->encrypt(plain, out));
    EXPECT_EQ(same, out);
}

TEST_F(CryptServiceRecorded, need_not_tell_the_padded_length_where_there_is_room) {
    CryptUser const user;
    std::unique_ptr<CrKey> const key = user.key("secret");
    std::string const expected = encrypted(*key, "message");
    struct Case {
        Row row;
        std::uint64_t room;
        bool done;
    };
    for (Case const& c : {Case{{}, 0, false}, Case{{}, 7, false}, Case{{}, 8, true}, Case{{}, 20, true}}) {
        SCOPED_TRACE(c.row);
        Blob out;
        out.alloc(c.room, false);
        fail("paddedLength");
        EXPECT_EQ(key->encrypt(blobOf("message"), out), c.done);
        EXPECT_EQ(bytesOf(out), c.done ? expected : "message");
    }
    Blob none;
    fail("paddedLength");
    EXPECT_FALSE(key->encrypt(none, none));
    EXPECT_EQ(none.size(), 0u);
}

TEST_F(CryptServiceRecorded, may_refuse_to_decrypt) {
    CryptUser const user;
    std::unique_ptr<CrKey> const key = user.key("secret");
    Blob const message = blobOf(encrypted(*key, "message"));
    Blob out;
    fail("decrypt");
    EXPECT_FALSE(key->decrypt(message, out));
    EXPECT_EQ(out, message);
    EXPECT_TRUE(key->decrypt(message, out)) << "the next time it does";
    EXPECT_EQ(bytesOf(out), "message");
}

TEST_F(CryptServiceRecorded, never_leaves_anything_behind_whichever_call_fails) {
    // From secret to message and back, with every call failing in turn, once or permanently.
    for (int times : {1, 1000}) {
        for (char const* name : {"acquire", "createHash", "hashData", "deriveKey", "exportLength", "exportKey",
                                 "paddedLength", "encrypt", "decrypt"}) {
            SCOPED_TRACE(name);
            fail(name, times);
            {
                CryptUser const user;
                SecretBlob exported;
                user.hash("secret")->exportKey(exported);
                std::unique_ptr<CrKey> const key = user.key("secret");
                Blob blob = blobOf("message");
                if (key->encrypt(blob, blob)) {
                    if (key->decrypt(blob, blob)) { EXPECT_EQ(blob.size(), 7u); }
                } else {
                    EXPECT_EQ(bytesOf(blob), "message");
                }
            }
            EXPECT_TRUE(record_.hashes.empty());
            EXPECT_TRUE(record_.keys.empty());
            record_.failures.clear();
        }
    }
}

TEST_F(CryptServiceRecorded, gets_back_all_that_10000_calls_took) {
    CryptUser const user;
    std::size_t most = 0;
    for (int i = 0; i < 10'000; ++i) {
        std::unique_ptr<CrKey> const key = user.key("secret");
        SecretBlob exported;
        ASSERT_TRUE(user.hash("secret")->exportKey(exported));
        ASSERT_EQ(encrypted(*key, "message").size(), 8u);
        most = std::max(most, record_.hashes.size() + record_.keys.size());
    }
    EXPECT_EQ(most, 1u);
    EXPECT_EQ(record_.calls["createHash"], 20'000);
    EXPECT_EQ(record_.calls["deriveKey"], 20'000);
    EXPECT_EQ(record_.calls["acquire"], 1);
}

TEST_F(CryptServiceRecorded, is_fed_lengths_beyond_32_bits_in_pieces) {
    CryptUser const user;
    std::unique_ptr<CrHash> const hash(user.crypt->createHash());
    record_.readsData = false; // so much memory there need not be
    std::uint64_t const length = (std::uint64_t{1} << 33) + 5;
    EXPECT_TRUE(hash->hashData("x", length));
    std::uint64_t sum = 0;
    for (std::uint32_t piece : record_.pieces) sum += piece;
    EXPECT_EQ(sum, length);

    record_.pieces.clear();
    fail("hashData");
    EXPECT_FALSE(hash->hashData("x", length));
    EXPECT_EQ(record_.pieces.size(), 1u) << "the first failure ends it";
    record_.pieces.clear();
    record_.failures["hashData"] = {record_.calls["hashData"] + 2, 1};
    EXPECT_FALSE(hash->hashData("x", length));
    EXPECT_EQ(record_.pieces.size(), 3u);
    record_.pieces.clear();
    EXPECT_TRUE(hash->hashData("x", std::uint64_t{1} << 30));
    EXPECT_EQ(record_.pieces, std::vector<std::uint32_t>{1u << 30});
    record_.readsData = true;
}

TEST_F(CryptServiceRecorded, is_not_asked_for_messages_that_it_cannot_count) {
    CryptUser const user;
    std::unique_ptr<CrKey> const key = user.key("secret");
    std::uint64_t const largest = 4'294'967'287;
    for (std::uint64_t size : {largest + 1, largest + 8, largest + 9, largest + 14, std::uint64_t{1} << 40}) {
        Blob huge = blobOf("a few bytes that are there");
        huge.setSize(size);
        Blob out = blobOf("what there was");
        record_.calls.clear();
        EXPECT_FALSE(key->encrypt(huge, huge)) << size;
        EXPECT_FALSE(key->encrypt(huge, out)) << size;
        if (size > largest + 1) {
            EXPECT_FALSE(key->decrypt(huge, huge)) << size;
            EXPECT_FALSE(key->decrypt(huge, out)) << size;
        }
        EXPECT_EQ(huge.size(), size);
        EXPECT_EQ(bytesOf(out), "what there was");
        EXPECT_TRUE(record_.calls.empty()) << size;
    }
}
