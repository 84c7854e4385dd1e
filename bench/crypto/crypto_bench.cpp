// Hashing, deriving, encrypting and decrypting beside the bare calls of nettle, and beside OpenSSL's legacy provider.

#include <zor_basis/crypto.h>
#include <zor_basis/text/blob.h>

#include <benchmark/benchmark.h>

#include <nettle/arctwo.h>
#include <nettle/cbc.h>
#include <nettle/md5.h>
#include <nettle/nettle-meta.h>

#ifdef BENCH_HAS_OPENSSL
#include <openssl/evp.h>
#include <openssl/provider.h>
#endif

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

constexpr std::size_t BLOCK = 8;
constexpr std::size_t SMALL = 64;
constexpr std::size_t LARGE = 64 * 1024;

using Bytes = std::vector<std::uint8_t>;

Bytes makeMessage(std::size_t n) {
    Bytes message(n);
    for (std::size_t i = 0; i < n; ++i) message[i] = static_cast<std::uint8_t>(i * 7 + i / 251);
    return message;
}

Blob blobOf(Bytes const& bytes) { return {bytes.size(), reinterpret_cast<char const*>(bytes.data())}; }

Crypt& provider() {
    static Crypt& made = *Crypt::make("");
    return made;
}

CrKey& key() {
    static CrKey& made = [&]() -> CrKey& {
        CrHashPtr hash(&provider());
        hash->hashData("secret", 6);
        return *provider().deriveKey(hash);
    }();
    return made;
}

struct Digest {
    std::uint8_t bytes[MD5_DIGEST_SIZE];
};

Digest secretDigest() {
    Digest digest;
    md5_ctx hash;
    md5_init(&hash);
    md5_update(&hash, 6, reinterpret_cast<std::uint8_t const*>("secret"));
    md5_digest(&hash, sizeof digest.bytes, digest.bytes);
    return digest;
}

[[noreturn]] void differ(char const* what) {
    std::fprintf(stderr, "crypto_bench: %s gives other bytes\n", what);
    std::abort();
}

void expectSame(Blob const& ours, std::uint8_t const* theirs, std::size_t n, char const* what) {
    if (ours.size() != n || std::memcmp(ours.val(), theirs, n) != 0) differ(what);
}

/* Hashing */

void hash(benchmark::State& state, std::size_t n) {
    Bytes const message = makeMessage(n);
    CrHashPtr running(&provider());
    for (auto _ : state) running->hashData(message.data(), message.size());
}

void hashNettle(benchmark::State& state, std::size_t n) {
    Bytes const message = makeMessage(n);
    md5_ctx running;
    md5_init(&running);
    for (auto _ : state) {
        md5_update(&running, message.size(), message.data());
        benchmark::DoNotOptimize(&running);
    }
}

/* From a secret to a key that its caller owns */

void derive(benchmark::State& state, std::size_t n) {
    Bytes const secret = makeMessage(n);
    for (auto _ : state) {
        CrHashPtr running(&provider());
        running->hashData(secret.data(), secret.size());
        std::unique_ptr<CrKey> const made(provider().deriveKey(running));
        benchmark::DoNotOptimize(made.get());
    }
}

void deriveNettle(benchmark::State& state, std::size_t n) {
    Bytes const secret = makeMessage(n);
    for (auto _ : state) {
        auto const running = std::make_unique<md5_ctx>();
        md5_init(running.get());
        md5_update(running.get(), secret.size(), secret.data());
        Digest digest;
        md5_digest(running.get(), sizeof digest.bytes, digest.bytes);
        auto const made = std::make_unique<arctwo_ctx>();
        arctwo_set_key(made.get(), sizeof digest.bytes, digest.bytes);
        benchmark::DoNotOptimize(made.get());
    }
}

/* From a secret to an exported key */

void exportKey(benchmark::State& state, std::size_t n) {
    Bytes const secret = makeMessage(n);
    Blob out;
    for (auto _ : state) {
        CrHashPtr running(&provider());
        running->hashData(secret.data(), secret.size());
        benchmark::DoNotOptimize(running->exportKey(out));
    }
}

void exportKeyNettle(benchmark::State& state, std::size_t n) {
    Bytes const secret = makeMessage(n);
    Digest out;
    for (auto _ : state) {
        md5_ctx running;
        md5_init(&running);
        md5_update(&running, secret.size(), secret.data());
        md5_digest(&running, sizeof out.bytes, out.bytes);
        benchmark::DoNotOptimize(out);
    }
}

/* Encrypting from one buffer into another */

void encrypt(benchmark::State& state, std::size_t n) {
    Blob const plain = blobOf(makeMessage(n));
    Blob out;
    for (auto _ : state) key().encrypt(plain, out);
}

arctwo_ctx nettleKey() {
    arctwo_ctx made;
    arctwo_set_key(&made, MD5_DIGEST_SIZE, secretDigest().bytes);
    return made;
}

void encryptNettle(benchmark::State& state, std::size_t n) {
    Bytes const plain = makeMessage(n);
    arctwo_ctx const schedule = nettleKey();
    Bytes out(n + BLOCK);
    for (auto _ : state) {
        std::memcpy(out.data(), plain.data(), n);
        std::memset(out.data() + n, BLOCK, BLOCK);
        std::uint8_t chain[BLOCK] = {};
        cbc_encrypt(&schedule, nettle_arctwo128.encrypt, BLOCK, chain, out.size(), out.data(), out.data());
        benchmark::DoNotOptimize(out.data());
    }
    Blob ours;
    key().encrypt(blobOf(plain), ours);
    expectSame(ours, out.data(), out.size(), "nettle");
}

/* Decrypting likewise */

Blob encryptedMessage(std::size_t n) {
    Blob out;
    key().encrypt(blobOf(makeMessage(n)), out);
    return out;
}

void decrypt(benchmark::State& state, std::size_t n) {
    Blob const message = encryptedMessage(n);
    Blob out;
    for (auto _ : state) key().decrypt(message, out);
}

void decryptNettle(benchmark::State& state, std::size_t n) {
    Blob const message = encryptedMessage(n);
    arctwo_ctx const schedule = nettleKey();
    Bytes out(message.size());
    for (auto _ : state) {
        std::uint8_t chain[BLOCK] = {};
        std::memcpy(out.data(), message.val(), out.size());
        cbc_decrypt(&schedule, nettle_arctwo128.decrypt, BLOCK, chain, out.size(), out.data(), out.data());
        benchmark::DoNotOptimize(out.data());
    }
    expectSame(blobOf(makeMessage(n)), out.data(), n, "nettle");
}

#ifdef BENCH_HAS_OPENSSL

/// A key of the legacy provider, set up once; a message only sets the chain back.
class OpenSslKey {
public:
    explicit OpenSslKey(int encrypts) : context_(EVP_CIPHER_CTX_new()), encrypts_(encrypts) {
        static OSSL_PROVIDER* const legacy = OSSL_PROVIDER_load(nullptr, "legacy");
        static EVP_CIPHER* const cipher = EVP_CIPHER_fetch(nullptr, "RC2-CBC", nullptr);
        if (legacy == nullptr || cipher == nullptr) differ("a missing legacy provider");
        EVP_CipherInit_ex2(context_, cipher, secretDigest().bytes, START, encrypts_, nullptr);
    }
    ~OpenSslKey() { EVP_CIPHER_CTX_free(context_); }
    OpenSslKey(OpenSslKey const&) = delete;
    OpenSslKey& operator=(OpenSslKey const&) = delete;

    std::size_t run(std::uint8_t* out, std::uint8_t const* in, std::size_t n) {
        int first = 0, last = 0;
        EVP_CipherInit_ex2(context_, nullptr, nullptr, START, encrypts_, nullptr);
        EVP_CipherUpdate(context_, out, &first, in, static_cast<int>(n));
        EVP_CipherFinal_ex(context_, out + first, &last);
        return static_cast<std::size_t>(first + last);
    }

private:
    static constexpr std::uint8_t START[BLOCK] = {};
    EVP_CIPHER_CTX* context_;
    int encrypts_;
};

void encryptOpenSsl(benchmark::State& state, std::size_t n) {
    Bytes const plain = makeMessage(n);
    Bytes out(n + BLOCK);
    OpenSslKey openSsl(1);
    std::size_t made = 0;
    for (auto _ : state) {
        made = openSsl.run(out.data(), plain.data(), n);
        benchmark::DoNotOptimize(out.data());
    }
    expectSame(encryptedMessage(n), out.data(), made, "OpenSSL");
}

void decryptOpenSsl(benchmark::State& state, std::size_t n) {
    Blob const message = encryptedMessage(n);
    Bytes out(message.size() + BLOCK);
    OpenSslKey openSsl(0);
    std::size_t made = 0;
    for (auto _ : state) {
        made = openSsl.run(out.data(), reinterpret_cast<std::uint8_t const*>(message.val()), message.size());
        benchmark::DoNotOptimize(out.data());
    }
    expectSame(blobOf(makeMessage(n)), out.data(), made, "OpenSSL");
}

BENCHMARK_CAPTURE(encryptOpenSsl, 64, SMALL)->Name("encrypt-64/openssl");
BENCHMARK_CAPTURE(encryptOpenSsl, 64k, LARGE)->Name("encrypt-64k/openssl");
BENCHMARK_CAPTURE(decryptOpenSsl, 64, SMALL)->Name("decrypt-64/openssl");
BENCHMARK_CAPTURE(decryptOpenSsl, 64k, LARGE)->Name("decrypt-64k/openssl");

#endif

BENCHMARK_CAPTURE(hash, 64, SMALL)->Name("hash-64/ours");
BENCHMARK_CAPTURE(hashNettle, 64, SMALL)->Name("hash-64/nettle");
BENCHMARK_CAPTURE(hash, 64k, LARGE)->Name("hash-64k/ours");
BENCHMARK_CAPTURE(hashNettle, 64k, LARGE)->Name("hash-64k/nettle");
BENCHMARK_CAPTURE(derive, 64, SMALL)->Name("derive-64/ours");
BENCHMARK_CAPTURE(deriveNettle, 64, SMALL)->Name("derive-64/nettle");
BENCHMARK_CAPTURE(derive, 64k, LARGE)->Name("derive-64k/ours");
BENCHMARK_CAPTURE(deriveNettle, 64k, LARGE)->Name("derive-64k/nettle");
BENCHMARK_CAPTURE(exportKey, 64, SMALL)->Name("export-64/ours");
BENCHMARK_CAPTURE(exportKeyNettle, 64, SMALL)->Name("export-64/nettle");
BENCHMARK_CAPTURE(encrypt, 64, SMALL)->Name("encrypt-64/ours");
BENCHMARK_CAPTURE(encryptNettle, 64, SMALL)->Name("encrypt-64/nettle");
BENCHMARK_CAPTURE(encrypt, 64k, LARGE)->Name("encrypt-64k/ours");
BENCHMARK_CAPTURE(encryptNettle, 64k, LARGE)->Name("encrypt-64k/nettle");
BENCHMARK_CAPTURE(decrypt, 64, SMALL)->Name("decrypt-64/ours");
BENCHMARK_CAPTURE(decryptNettle, 64, SMALL)->Name("decrypt-64/nettle");
BENCHMARK_CAPTURE(decrypt, 64k, LARGE)->Name("decrypt-64k/ours");
BENCHMARK_CAPTURE(decryptNettle, 64k, LARGE)->Name("decrypt-64k/nettle");

} // namespace
