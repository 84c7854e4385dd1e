/// \file
/// The cryptographic service, one function for each of its calls: crypt_service_win.cpp asks the system,
/// crypt_service_posix.cpp does the same over nettle. Everything goes through one table, so that tests can make each
/// call fail.

#ifndef BASIS_CRYPTO_CRYPT_SERVICE_H
#define BASIS_CRYPTO_CRYPT_SERVICE_H

#include <cstdint>

namespace ZOR_Basis {

/// Names for the boolean arguments.
inline constexpr bool NEW_KEY_SET = true;
inline constexpr bool EXISTING_KEY_SET = false;
inline constexpr bool EXPORTABLE = true;
inline constexpr bool NOT_EXPORTABLE = false;

/// The functions return whether they succeeded; a handle of 0 makes them fail.
struct CryptService {
    /// A provider, a hash or a key; 0 is none.
    using Handle = std::uint64_t;

    /// \param newKeySet  makes a set of keys where there is none
    bool (*acquire)(Handle& provider, bool newKeySet);
    bool (*createHash)(Handle provider, Handle& hash);
    bool (*hashData)(Handle hash, void const* data, std::uint32_t n);
    void (*destroyHash)(Handle hash);
    /// \param exportable  asks for 128 bits and for a key that `exportKey` takes; otherwise the service's default
    ///     length
    bool (*deriveKey)(Handle provider, Handle hash, bool exportable, Handle& key);
    /// \param n  the room in bytes; becomes the length of the key blob
    /// \param blob  null: only the length is wanted
    bool (*exportKey)(Handle key, char* blob, std::uint32_t& n);
    /// Encrypts a whole message in place.
    /// \param n  its length; becomes the padded one
    /// \param data  null: only the length is wanted
    bool (*encrypt)(Handle key, char* data, std::uint32_t& n, std::uint32_t room);
    /// Decrypts a whole message in place.
    /// \param n  its length; becomes that without the padding
    bool (*decrypt)(Handle key, char* data, std::uint32_t& n);
    void (*destroyKey)(Handle key);
    /// The code of the calling thread's last error.
    std::uint32_t (*lastError)();
};

/// Replaced by tests only, while nothing else runs.
extern CryptService cryptService;

/// The bytes that are encrypted together, and whether a message is made of whole ones.
inline constexpr std::uint32_t CRYPT_BLOCK = 8;
inline constexpr bool isWholeBlocks(std::uint64_t n) { return n != 0 && n % CRYPT_BLOCK == 0; }

} // namespace ZOR_Basis

#endif
