#include "zor_basis/crypto/cr_hash_ptr.h"

#include "zor_basis/crypto/crypt.h"

namespace ZOR_Basis {

CrHashPtr::CrHashPtr(Crypt* crypt) : hash_(crypt != nullptr ? crypt->createHash() : nullptr) {}

CrHashPtr::~CrHashPtr() { delete hash_; }

} // namespace ZOR_Basis
