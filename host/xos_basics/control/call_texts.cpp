#include "host/xos_basics/control/call_texts.h"

#include <algorithm>
#include <cstring>
#include <mutex>
#include <new>
#include <thread>
#include <utility>

namespace host {

namespace {

constexpr std::size_t LEAST_SIZE = 256;

constexpr std::size_t LONG = 128;

/// Copies in steps of a fixed size; the last one may overlap the one before.
template <std::size_t STEP>
HOST_INLINE void copySteps(char* to, char const* from, std::size_t size) {
    for (std::size_t done = 0; done + STEP < size; done += STEP) { std::memcpy(to + done, from + done, STEP); }
    std::memcpy(to + size - STEP, from + size - STEP, STEP);
}

/// Most texts are short; for them a call of `memcpy` takes longer than the rest of the record.
HOST_INLINE void copyText(char* to, char const* from, std::size_t size) {
    if (size >= LONG) {
        std::memcpy(to, from, size);
    } else if (size >= 16) {
        copySteps<16>(to, from, size);
    } else if (size >= 4) {
        copySteps<4>(to, from, size);
    } else {
        copySteps<1>(to, from, size);
    }
}

} // namespace

std::uint64_t CallTexts::add(char const* text) {
    if (text == nullptr) return NULL_TEXT;
    std::size_t const size = std::strlen(text) + 1;
    if (size > size_ - used_ && !grow(used_ + size)) return NULL_TEXT;
    std::uint64_t const place = used_;
    copyText(bytes_.get() + place, text, size);
    used_ += size;
    return place;
}

bool CallTexts::grow(std::size_t size) {
    std::size_t const larger = std::max({size, 2 * size_, LEAST_SIZE});
    std::unique_ptr<char[]> bytes{new (std::nothrow) char[larger]};
    if (bytes == nullptr) return false;
    std::copy_n(bytes_.get(), used_, bytes.get());
    bytes_ = std::move(bytes);
    size_ = larger;
    return true;
}

void CallTexts::awaitReader() {
    do {
        isWritten_.store(false, std::memory_order_release);
        std::lock_guard const lock{mutex_};
    } while (isReadAfterMark());
}

void CallTexts::lock() {
    mutex_.lock();
    isRead_.exchange(true, std::memory_order_seq_cst);
    if (hasProcessBarrier) passProcessBarrier();
    while (isWritten_.load(std::memory_order_seq_cst)) { std::this_thread::yield(); }
}

void CallTexts::unlock() {
    isRead_.store(false, std::memory_order_release);
    mutex_.unlock();
}

} // namespace host
