// crypto_vectors: has the system's cryptographic service encrypt messages with keys derived from secrets, and prints
// what came out as rows of a C++ table, {secret, plain, encrypted, key blob} in hexadecimal digits. Uses nothing of the
// library.
//
//     cmake --build --preset windows --target crypto_vectors
//     cmake/windows/wine-run build/windows/bin/crypto_vectors.exe > tests/crypto/service_vectors.inc

#include "basis/platform/windows_api_win.h"

#include <wincrypt.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <io.h>
#include <string>
#include <vector>

namespace {

using Bytes = std::string;

constexpr DWORD EXPORTABLE_128_BITS = 128u << 16 | CRYPT_EXPORTABLE;
constexpr DWORD BLOCK = 8;

void need(BOOL done, char const* what) {
    if (done) return;
    std::fprintf(stderr, "crypto_vectors: %s failed: %lu\n", what, GetLastError());
    std::exit(1);
}

/// The same bytes at every run.
class Source {
public:
    Bytes bytes(std::size_t n) {
        Bytes made(n, '\0');
        for (char& c : made) c = static_cast<char>(next() >> 24);
        return made;
    }

private:
    std::uint32_t next() { return state_ = state_ * 1664525 + 1013904223; }
    std::uint32_t state_ = 20'211;
};

HCRYPTKEY derive(HCRYPTPROV provider, Bytes const& secret, DWORD flags) {
    HCRYPTHASH hash = 0;
    HCRYPTKEY key = 0;
    need(CryptCreateHash(provider, CALG_MD5, 0, 0, &hash), "CryptCreateHash");
    need(CryptHashData(hash, reinterpret_cast<BYTE const*>(secret.data()), static_cast<DWORD>(secret.size()), 0),
         "CryptHashData");
    need(CryptDeriveKey(provider, CALG_RC2, hash, flags, &key), "CryptDeriveKey");
    CryptDestroyHash(hash);
    return key;
}

Bytes encrypted(HCRYPTPROV provider, Bytes const& secret, Bytes const& plain) {
    HCRYPTKEY const key = derive(provider, secret, 0);
    Bytes data = plain;
    data.resize(plain.size() + BLOCK);
    DWORD n = static_cast<DWORD>(plain.size());
    need(CryptEncrypt(key, 0, TRUE, 0, reinterpret_cast<BYTE*>(data.data()), &n, static_cast<DWORD>(data.size())),
         "CryptEncrypt");
    data.resize(n);
    CryptDestroyKey(key);
    return data;
}

Bytes keyBlob(HCRYPTPROV provider, Bytes const& secret) {
    HCRYPTKEY const key = derive(provider, secret, EXPORTABLE_128_BITS);
    DWORD n = 0;
    need(CryptExportKey(key, 0, PLAINTEXTKEYBLOB, 0, nullptr, &n), "CryptExportKey");
    Bytes blob(n, '\0');
    need(CryptExportKey(key, 0, PLAINTEXTKEYBLOB, 0, reinterpret_cast<BYTE*>(blob.data()), &n), "CryptExportKey");
    CryptDestroyKey(key);
    return blob;
}

void printHex(Bytes const& bytes, char const* behind) {
    std::putchar('"');
    for (unsigned char c : bytes) std::printf("%02x", c);
    std::printf("\"%s", behind);
}

void printRow(HCRYPTPROV provider, Bytes const& secret, Bytes const& plain) {
    std::printf("{");
    printHex(secret, ", ");
    printHex(plain, ", ");
    printHex(encrypted(provider, secret, plain), ", ");
    printHex(keyBlob(provider, secret), "},\n");
}

/// Texts as people choose them, then every way to fill the blocks of the hash.
std::vector<Bytes> makeSecrets(Source& source) {
    std::vector<Bytes> secrets{
        "secret", "a", "correct horse battery staple", "gr\xC3\xBC\xC3\x9F dich", Bytes(16, '\0'), Bytes(64, '\xFF')};
    for (std::size_t n : {0, 1, 2, 7, 8, 15, 16, 17, 31, 33, 54, 55, 56, 57, 63, 64, 65, 119, 120, 128, 129, 1000})
        secrets.push_back(source.bytes(n));
    return secrets;
}

/// What looks like padding, then every way to fill the blocks of the key.
std::vector<Bytes> makeMessages(Source& source) {
    std::vector<Bytes> messages{Bytes(8, '\0'),
                                Bytes(7, '\1'),
                                Bytes(8, '\1'),
                                Bytes(8, '\x08'),
                                Bytes(16, '\x08'),
                                Bytes(15, '\xFF'),
                                "The quick brown fox jumps over the lazy dog"};
    for (std::size_t n = 0; n <= 33; ++n) messages.push_back(source.bytes(n));
    for (std::size_t n : {39, 40, 41, 63, 64, 65, 127, 128, 129, 255, 256, 257, 504, 511, 512, 513, 520, 1000})
        messages.push_back(source.bytes(n));
    return messages;
}

} // namespace

int main() {
    _setmode(_fileno(stdout), _O_BINARY);
    HCRYPTPROV provider = 0;
    need(CryptAcquireContextA(&provider, nullptr, nullptr, PROV_RSA_FULL, CRYPT_VERIFYCONTEXT), "CryptAcquireContext");
    Source source;
    std::vector<Bytes> const secrets = makeSecrets(source);
    std::vector<Bytes> const messages = makeMessages(source);
    std::printf("// {secret, plain, encrypted, key blob}, made under Wine by tools/crypto_vectors.\n");
    for (std::size_t i = 0; i < messages.size(); ++i) printRow(provider, secrets[i % secrets.size()], messages[i]);
    for (Bytes const& secret : secrets) printRow(provider, secret, "message");
    CryptReleaseContext(provider, 0);
}
