/// \file
/// Texts at the end of readable memory.

#ifndef TESTS_TEXT_LAST_PAGE_POSIX_H
#define TESTS_TEXT_LAST_PAGE_POSIX_H

#include <sys/mman.h>

#include <cstring>
#include <string>

/// Two pages; the second is unreadable.
class LastPage {
public:
    LastPage() {
        void* pages = mmap(nullptr, 2 * PAGE_SIZE, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        begin_ = static_cast<char*>(pages);
        mprotect(begin_ + PAGE_SIZE, PAGE_SIZE, PROT_NONE);
    }
    ~LastPage() { munmap(begin_, 2 * PAGE_SIZE); }
    LastPage(LastPage const&) = delete;
    LastPage& operator=(LastPage const&) = delete;

    template <class Char>
    Char const* textAtTheEnd(std::basic_string<Char> const& text) {
        std::size_t const bytes = (text.size() + 1) * sizeof(Char);
        return static_cast<Char const*>(std::memcpy(begin_ + PAGE_SIZE - bytes, text.c_str(), bytes));
    }

private:
    static constexpr std::size_t PAGE_SIZE = 4096;

    char* begin_;
};

#endif
