/// \file
/// The content of each block when it is released. For one source of a program that is linked with
/// `-Wl,--wrap=malloc,--wrap=free`. The linker then redirects every `malloc` and `free` of the program's objects, the
/// library's included, to this file.

#ifndef TESTS_SUPPORT_WATCHED_BLOCKS_H
#define TESTS_SUPPORT_WATCHED_BLOCKS_H

#include <cstddef>
#include <cstdlib>

extern "C" {
void* __real_malloc(std::size_t n);
void __real_free(void* block);
void* __wrap_malloc(std::size_t n);
void __wrap_free(void* block);
}

/// Blocks made while watched, and whether they were all zero when they were released.
struct Watch {
    static constexpr std::size_t MOST = 32;
    struct Block {
        void* place;
        std::size_t size;
        bool released;
        bool wiped;
    };
    bool on = false;
    bool hasMemory = true;
    std::size_t lacking = MOST; // the number of the one block for which there is no memory
    std::size_t asked = 0;
    std::size_t made = 0;
    Block blocks[MOST];
};
inline Watch watch;

[[gnu::used]] inline void* __wrap_malloc(std::size_t n) {
    if (!watch.on) return __real_malloc(n);
    if (!watch.hasMemory || watch.asked++ == watch.lacking || watch.made == Watch::MOST) return nullptr;
    void* const block = __real_malloc(n);
    watch.blocks[watch.made++] = {block, n, false, false};
    return block;
}

[[gnu::used]] inline void __wrap_free(void* block) {
    for (std::size_t i = 0; watch.on && i < watch.made; ++i) {
        Watch::Block& known = watch.blocks[i];
        if (known.place != block || known.released) continue;
        known.released = true;
        known.wiped = true;
        for (std::size_t at = 0; at < known.size; ++at) known.wiped &= static_cast<char*>(block)[at] == 0;
    }
    __real_free(block);
}

#endif
