// The sibling is crypt_service_win.cpp.

#include "basis/crypto/crypt_service.h"

#include "basis/text/wipe.h"

#include <nettle/arctwo.h>
#include <nettle/cbc.h>
#include <nettle/md5.h>
#include <nettle/nettle-meta.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>

namespace ZOR_Basis {
namespace {

using Handle = CryptService::Handle;

static_assert(CRYPT_BLOCK == ARCTWO_BLOCK_SIZE);

/// A provider has no state.
constexpr Handle PROVIDER = 1;

/// The key is the whole digest.
constexpr std::uint32_t KEY_LENGTH = MD5_DIGEST_SIZE;

struct Hash {
    md5_ctx running;
    bool finished;
    std::uint8_t digest[KEY_LENGTH];
};

struct Key {
    std::uint8_t plain[KEY_LENGTH];
    bool exportable;
    bool scheduled;
    arctwo_ctx schedule;
};

/// What precedes the key in its blob: kind and version of the blob, the algorithm, the length.
constexpr std::uint8_t BLOB_HEAD[] = {8, 2, 0, 0, 0x02, 0x66, 0, 0, KEY_LENGTH, 0, 0, 0};
constexpr std::uint32_t BLOB_LENGTH = sizeof BLOB_HEAD + KEY_LENGTH;

template <class State>
State* of(Handle handle) {
    return reinterpret_cast<State*>(handle);
}

template <class State>
State* make(Handle& handle) {
    State* const state = static_cast<State*>(std::malloc(sizeof(State)));
    if (state != nullptr) handle = reinterpret_cast<Handle>(state);
    return state;
}

template <class State>
void destroy(Handle handle) {
    wipe(of<State>(handle), sizeof(State));
    std::free(of<State>(handle));
}

bool acquire(Handle& provider, bool) {
    provider = PROVIDER;
    return true;
}

bool createHash(Handle provider, Handle& handle) {
    if (provider != PROVIDER) return false;
    Hash* const hash = make<Hash>(handle);
    if (hash == nullptr) return false;
    md5_init(&hash->running);
    hash->finished = false;
    return true;
}

bool hashData(Handle handle, void const* data, std::uint32_t n) {
    Hash* const hash = of<Hash>(handle);
    if (hash == nullptr || hash->finished) return false;
    if (n != 0) md5_update(&hash->running, n, static_cast<std::uint8_t const*>(data));
    return true;
}

std::uint8_t const* finish(Hash& hash) {
    if (!hash.finished) md5_digest(&hash.running, KEY_LENGTH, hash.digest);
    hash.finished = true;
    return hash.digest;
}

bool deriveKey(Handle provider, Handle from, bool exportable, Handle& handle) {
    Hash* const hash = of<Hash>(from);
    if (provider != PROVIDER || hash == nullptr) return false;
    Key* const key = make<Key>(handle);
    if (key == nullptr) return false;
    std::memcpy(key->plain, finish(*hash), KEY_LENGTH);
    key->exportable = exportable;
    key->scheduled = false;
    return true;
}

bool exportKey(Handle handle, char* blob, std::uint32_t& n) {
    Key const* const key = of<Key>(handle);
    if (key == nullptr || !key->exportable) return false;
    std::uint32_t const room = n;
    n = BLOB_LENGTH;
    if (blob == nullptr) return true;
    if (room < BLOB_LENGTH) return false;
    std::memcpy(blob, BLOB_HEAD, sizeof BLOB_HEAD);
    std::memcpy(blob + sizeof BLOB_HEAD, key->plain, KEY_LENGTH);
    return true;
}

/// Made by the first message: most keys are derived to be exported, and a schedule costs more than their hash.
arctwo_ctx const& scheduleOf(Key& key) {
    if (!key.scheduled) arctwo_set_key(&key.schedule, KEY_LENGTH, key.plain);
    key.scheduled = true;
    return key.schedule;
}

bool encrypt(Handle handle, char* data, std::uint32_t& n, std::uint32_t room) {
    Key* const key = of<Key>(handle);
    if (key == nullptr) return false;
    std::uint32_t const length = n;
    std::uint32_t const padding = CRYPT_BLOCK - length % CRYPT_BLOCK;
    n = length + padding;
    if (data == nullptr) return true;
    if (n > room) return false;
    std::memset(data + length, static_cast<int>(padding), padding);
    std::uint8_t chain[CRYPT_BLOCK] = {};
    std::uint8_t* const bytes = reinterpret_cast<std::uint8_t*>(data);
    cbc_encrypt(&scheduleOf(*key), nettle_arctwo128.encrypt, CRYPT_BLOCK, chain, n, bytes, bytes);
    return true;
}

/// Whether a message ends in 1 to 8 bytes of padding, each of which is their number.
bool endsInPadding(std::uint8_t const* bytes, std::uint32_t n) {
    std::uint8_t const padding = bytes[n - 1];
    if (padding == 0 || padding > CRYPT_BLOCK) return false;
    for (std::uint32_t i = 2; i <= padding; ++i) {
        if (bytes[n - i] != padding) return false;
    }
    return true;
}

bool decrypt(Handle handle, char* data, std::uint32_t& n) {
    Key* const key = of<Key>(handle);
    if (key == nullptr || !isWholeBlocks(n)) return false;
    std::uint8_t chain[CRYPT_BLOCK] = {};
    std::uint8_t* const bytes = reinterpret_cast<std::uint8_t*>(data);
    cbc_decrypt(&scheduleOf(*key), nettle_arctwo128.decrypt, CRYPT_BLOCK, chain, n, bytes, bytes);
    if (!endsInPadding(bytes, n)) return false;
    n -= bytes[n - 1];
    return true;
}

std::uint32_t lastError() { return static_cast<std::uint32_t>(errno); }

} // namespace

CryptService cryptService{acquire,   createHash, hashData, destroy<Hash>, deriveKey,
                          exportKey, encrypt,    decrypt,  destroy<Key>,  lastError};

} // namespace ZOR_Basis
