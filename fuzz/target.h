/// \file
/// What a fuzz target consists of: a function that reads any bytes and aborts if something is wrong. Programs that
/// fuzz contain one target, the ordinary tests replay the committed inputs of all of them.

#ifndef FUZZ_TARGET_H
#define FUZZ_TARGET_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <vector>

struct FuzzTarget {
    using Run = void (*)(unsigned char const* data, std::size_t size);

    /// \param name  also that of its folder of inputs
    FuzzTarget(char const* targetName, Run function) : name(targetName), run(function) { all().push_back(this); }
    FuzzTarget(FuzzTarget const&) = delete;
    FuzzTarget& operator=(FuzzTarget const&) = delete;

    /// Those of the program.
    static std::vector<FuzzTarget*>& all() {
        static std::vector<FuzzTarget*> targets;
        return targets;
    }

    char const* const name;
    Run const run;
};

/// Aborts unless something holds, and reports where.
inline void require(bool condition, char const* file = __builtin_FILE(), int line = __builtin_LINE()) {
    if (condition) return;
    std::fprintf(stderr, "%s:%d: this does not hold\n", file, line);
    std::abort();
}

/// The bytes of an input as random numbers, two at a time; zeros once they are used up.
class RandomBytes {
public:
    RandomBytes(unsigned char const* data, std::size_t size) : at_(data), end_(data + size) {}

    std::uint64_t operator()() {
        std::uint64_t const high = byte();
        return high << 8 | byte();
    }
    std::uint64_t byte() { return at_ != end_ ? *at_++ : 0; }
    std::uint64_t word() {
        std::uint64_t number = 0;
        for (int i = 0; i < 8; ++i) number = number << 8 | byte();
        return number;
    }
    std::uint64_t below(std::uint64_t bound) { return (*this)() % bound; }
    bool isUsedUp() const { return at_ == end_; }

private:
    unsigned char const* at_;
    unsigned char const* end_;
};

#endif
