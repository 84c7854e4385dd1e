#include "zor_basis/sync/sem_set.h"

#include "basis/sync/sem_array.h"

#include <new>

namespace ZOR_Basis {

SemSet::SemSet(std::size_t size) : set_(new (std::nothrow) SemArray(size)) {}
SemSet& SemSet::operator=(SemSet const& other) = default;
SemSet::~SemSet() { delete set_; }

} // namespace ZOR_Basis
