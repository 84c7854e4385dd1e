/// \file
/// `CrHashPtr`: owns one hash.
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_CRYPTO_CR_HASH_PTR_H
#define ZOR_BASIS_CRYPTO_CR_HASH_PTR_H

#include "zor_basis/crypto/cr_hash.h"
#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

namespace ZOR_Basis {

class Crypt;

class ZB_API CrHashPtr : public detail::NotDeletable<CrHashPtr> {
public:
    /// Makes and owns a new hash of the provider; owns none if `crypt` is null.
    CrHashPtr(Crypt* crypt);
    /// Adopts the hash, which may be null.
    CrHashPtr(CrHash* hash) : hash_(hash) {}
    ~CrHashPtr();

    /// The hash, which may be null.
    operator CrHash*() const { return hash_; }
    CrHash* operator->() const { return hash_; }
    CrHash* ptr() const { return hash_; }

private:
    CrHashPtr(CrHashPtr const&) = delete;
    CrHashPtr& operator=(CrHashPtr const&) = delete;

    CrHash* hash_;
};

static_assert(sizeof(CrHashPtr) == sizeof(void*));

} // namespace ZOR_Basis

#endif
