/// \file
/// How a platform function turns what its body found out into its result.

#ifndef HOST_XOS_BASICS_RESULT_H
#define HOST_XOS_BASICS_RESULT_H

#include "host/xos_basics/last_error.h"

#include <new>

namespace host {

/// The result of an `int` function that fails without a more telling value.
constexpr int FAILED = -1;

/// Runs `body`; lack of memory, which never leaves a platform function as an exception, gives `failure`.
template <class Result, class Body>
Result unlessMemoryLacks(Result failure, Body body) {
    try {
        return body();
    } catch (std::bad_alloc const&) {
        setLastError(Error::NO_MEMORY);
        return failure;
    }
}

/// The `int` result of a function whose body says whether it succeeded.
template <class Body>
int resultOf(Body body) {
    return unlessMemoryLacks(FAILED, [&] { return body() ? 0 : FAILED; });
}

/// False, with the last error set, where one of the texts is null.
template <class... Texts>
bool given(Texts const*... texts) {
    if ((... && (texts != nullptr))) return true;
    setLastError(Error::BAD_ARGUMENT);
    return false;
}

} // namespace host

#endif
