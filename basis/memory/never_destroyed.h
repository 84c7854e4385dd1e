/// \file
/// Statics that outlive all others: threads and static destructors may use them while the process ends.

#ifndef BASIS_MEMORY_NEVER_DESTROYED_H
#define BASIS_MEMORY_NEVER_DESTROYED_H

#include <new>
#include <utility>

namespace ZOR_Basis {

template <class T>
class NeverDestroyed {
public:
    template <class... Arguments>
    explicit NeverDestroyed(Arguments&&... arguments) {
        new (memory_) T(std::forward<Arguments>(arguments)...);
    }
    NeverDestroyed(NeverDestroyed const&) = delete;
    NeverDestroyed& operator=(NeverDestroyed const&) = delete;

    T& operator*() { return *std::launder(reinterpret_cast<T*>(memory_)); }

private:
    alignas(T) unsigned char memory_[sizeof(T)];
};

} // namespace ZOR_Basis

#endif
