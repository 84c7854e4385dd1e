#include "zor_basis/text/heap_str.h"

#include <cstdlib>
#include <limits>

namespace ZOR_Basis {

namespace {

std::uint64_t measured(char const* text) noexcept { return text != nullptr ? detail::textLength(text) : 0; }

} // namespace

HeapStr::HeapStr(char const* text) : HeapStr(text, measured(text)) {}
HeapStr::HeapStr(char const* text, std::uint64_t n) : capacity_(0) { copy(text, n); }
HeapStr::HeapStr(Str const& text) : HeapStr(text.c_str(), text.size()) {}
HeapStr::HeapStr(std::string const& text) : HeapStr(text.c_str(), text.size()) {}
HeapStr::HeapStr(HeapStr const& other) : HeapStr(other.text_, other.size_) {}

HeapStr::~HeapStr() {
    if (hasBlock()) free();
    capacity_ = 0;
}

HeapStr& HeapStr::operator=(HeapStr const& other) { // NOLINT(bugprone-unhandled-self-assignment): set() handles it
    return set(other.text_, other.size_);
}
HeapStr& HeapStr::operator=(Str const& text) { return set(text.c_str(), text.size()); }
HeapStr& HeapStr::operator=(std::string const& text) { return set(text.c_str(), text.size()); }
HeapStr& HeapStr::operator=(char const* text) { return set(text); }

HeapStr& HeapStr::set(char const* text) { return set(text, measured(text)); }

HeapStr& HeapStr::set(char const* text, std::uint64_t n) {
    reassign(text, n);
    return *this;
}

HeapStr& HeapStr::clear() noexcept {
    if (hasBlock()) free();
    capacity_ = 0;
    setEmpty();
    return *this;
}

HeapStr& HeapStr::cut() noexcept { return size_ > 0 ? cut(size_ - 1) : *this; }

HeapStr& HeapStr::cut(std::uint64_t n) noexcept {
    if (n < size_) size_ = n;
    if (text_ != StrEmpty) buffer()[size_] = '\0';
    return *this;
}

HeapStr& HeapStr::toLower() noexcept {
    ToLower(buffer(), size_);
    return *this;
}

HeapStr& HeapStr::toUpper() noexcept {
    ToUpper(buffer(), size_);
    return *this;
}

void HeapStr::alloc(std::uint64_t n) {
    bool const possible = n != std::numeric_limits<std::uint64_t>::max();
    auto* block = static_cast<char*>(possible ? std::malloc(n + 1) : nullptr);
    if (block == nullptr) std::abort();
    text_ = block;
    size_ = n;
    capacity_ = n;
}

void HeapStr::copy(char const* text, std::uint64_t n) {
    // kept text-13: what is stored is stored with its length, an empty view of a longer text included
    if (n == 0 || text == nullptr) return setEmpty();
    alloc(n);
    detail::copyText(buffer(), text, n);
    buffer()[n] = '\0';
}

void HeapStr::reassign(char const* text, std::uint64_t n) {
    if (n == 0 || text == nullptr) {
        clear();
        return;
    }
    if (hasBlock() && capacity_ == n) {
        detail::copyText(buffer(), text, n);
        size_ = n;
        buffer()[n] = '\0';
        return;
    }
    void* old = hasBlock() ? buffer() : nullptr;
    copy(text, n);
    std::free(old);
}

void HeapStr::setEmpty() noexcept {
    text_ = StrEmpty;
    size_ = 0;
}

void HeapStr::free() noexcept { std::free(buffer()); }

} // namespace ZOR_Basis
