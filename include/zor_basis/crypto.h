/// \file
/// Cryptography: hashes, keys that are derived from them, and blobs that are encrypted with these.

#ifndef ZOR_BASIS_CRYPTO_H
#define ZOR_BASIS_CRYPTO_H

#include "zor_basis/crypto/cr_hash.h"
#include "zor_basis/crypto/cr_hash_ptr.h"
#include "zor_basis/crypto/cr_key.h"
#include "zor_basis/crypto/crypt.h"

#endif
