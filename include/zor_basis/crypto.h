/// \file
/// Cryptography: hashes, keys derived from them, and blobs encrypted with the keys.

#ifndef ZOR_BASIS_CRYPTO_H
#define ZOR_BASIS_CRYPTO_H

#include "zor_basis/crypto/cr_hash.h"
#include "zor_basis/crypto/cr_hash_ptr.h"
#include "zor_basis/crypto/cr_key.h"
#include "zor_basis/crypto/crypt.h"

#endif
