/// \file
/// A moment's rest inside a loop that waits for another processor.

#ifndef HOST_XOS_BASICS_WAIT_PAUSE_H
#define HOST_XOS_BASICS_WAIT_PAUSE_H

#if defined(_MSC_VER)
#include <intrin.h>
#elif defined(__x86_64__)
#include <x86intrin.h>
#endif

namespace host {

inline void pauseBriefly() {
#if defined(_MSC_VER) || defined(__x86_64__)
    _mm_pause();
#endif
}

} // namespace host

#endif
