/// \file
/// Texts at any distance from the end of a page.

#ifndef TESTS_TEXT_PAGES_H
#define TESTS_TEXT_PAGES_H

#include <cstdint>
#include <cstring>
#include <memory>

inline constexpr std::size_t PAGE_SIZE = 4096;

/// Memory that begins at a page boundary. Only the terminators of its texts are zero.
class Pages {
public:
    Pages() { std::memset(room_.get(), '~', 4 * PAGE_SIZE); }
    char* at(std::size_t place) { return base() + place; }
    /// A terminated text of `size` different letters that ends `before` bytes before the second page.
    char* text(std::size_t size, std::size_t before) {
        char* begin = base() + PAGE_SIZE - before;
        for (std::size_t i = 0; i < size; ++i) begin[i] = static_cast<char>('a' + i % 26);
        begin[size] = '\0';
        return begin;
    }

private:
    char* base() {
        auto const address = reinterpret_cast<std::uintptr_t>(room_.get());
        return room_.get() + (PAGE_SIZE - address % PAGE_SIZE) % PAGE_SIZE;
    }
    std::unique_ptr<char[]> room_ = std::make_unique<char[]>(4 * PAGE_SIZE);
};

#endif
