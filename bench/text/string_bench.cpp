// Strings beside std::string and llvm::SmallString. All sides get the same texts, at the same place where strings are
// made of them, through pointers and lengths that the compiler cannot see through.

#include <zor_basis/text.h>

#include <benchmark/benchmark.h>

#include <cstring>
#include <memory>
#include <string>
#include <string_view>

#ifdef BENCH_HAS_LLVM
#include <llvm/ADT/SmallString.h>
#endif

using namespace ZOR_Basis;

namespace {

/// A text of `size` bytes whose bytes and length are unknown to the compiler.
std::string makeText(std::size_t size) {
    std::string text;
    for (std::size_t i = 0; i < size; ++i) text += static_cast<char>('a' + i % 26);
    benchmark::DoNotOptimize(text);
    return text;
}

constexpr std::size_t PAGE = 4096;

/// A text that begins so many bytes before a page ends.
char const* textBeforePageEnd(std::size_t size, std::size_t before) {
    alignas(PAGE) static char room[2 * PAGE];
    return static_cast<char const*>(std::memcpy(room + PAGE - before, makeText(size).c_str(), size + 1));
}

/// Where texts mostly lie: in one page, aligned as blocks of the heap are.
constexpr std::size_t IN_ONE_PAGE = PAGE - 16;

template <class String>
struct Maker {
    static String make(char const* text, std::size_t size) { return String(text, size); }
};

template <std::uint64_t N>
struct Maker<BufStr<N>> {
    static BufStr<N> make(char const* text, std::size_t size) { return BufStr<N>(text, size); }
    static void append(BufStr<N>& s, char c) { s += c; }
};

template <>
struct Maker<std::string> {
    static std::string make(char const* text, std::size_t size) { return {text, size}; }
    static void append(std::string& s, char c) { s += c; }
};

#ifdef BENCH_HAS_LLVM
template <unsigned N>
struct Maker<llvm::SmallString<N>> {
    static llvm::SmallString<N> make(char const* text, std::size_t size) {
        return llvm::SmallString<N>(llvm::StringRef(text, size));
    }
    static void append(llvm::SmallString<N>& s, char c) { s.push_back(c); }
};
#endif

template <class String>
void construct(benchmark::State& state, std::size_t size, std::size_t beforePageEnd) {
    char const* source = textBeforePageEnd(size, beforePageEnd);
    std::size_t length = size;
    for (auto _ : state) {
        benchmark::DoNotOptimize(source);
        benchmark::DoNotOptimize(length);
        String s = Maker<String>::make(source, length);
        benchmark::DoNotOptimize(s);
        benchmark::ClobberMemory();
    }
}

template <class String>
void copy(benchmark::State& state, std::size_t size) {
    String const original = Maker<String>::make(makeText(size).data(), size);
    String const* source = &original;
    for (auto _ : state) {
        benchmark::DoNotOptimize(source);
        String s(*source);
        benchmark::DoNotOptimize(s);
        benchmark::ClobberMemory();
    }
}

template <class String>
void append(benchmark::State& state, std::size_t count) {
    for (auto _ : state) {
        String s;
        benchmark::DoNotOptimize(s);
        for (std::size_t i = 0; i < count; ++i) Maker<String>::append(s, static_cast<char>('a' + (i & 15)));
        benchmark::DoNotOptimize(s);
        benchmark::ClobberMemory();
    }
}

/// Where the texts of a pair differ.
enum class Difference { NONE, EARLY, LATE };

std::size_t placeOf(Difference difference, std::size_t pair, std::size_t size) {
    std::size_t const place = pair % std::min<std::size_t>(size, 4);
    return difference == Difference::EARLY ? place : size - 1 - place;
}

/// Sixteen pairs, the same ones for everybody.
template <class String>
struct Pairs {
    static constexpr std::size_t COUNT = 16;
    Pairs(std::size_t size, Difference difference) {
        for (std::size_t i = 0; i < COUNT; ++i) {
            std::string text = makeText(size);
            left[i] = std::make_unique<String>(Maker<String>::make(text.data(), size));
            if (difference != Difference::NONE) text[placeOf(difference, i, size)] = '!';
            right[i] = std::make_unique<String>(Maker<String>::make(text.data(), size));
        }
    }
    std::unique_ptr<String> left[COUNT];
    std::unique_ptr<String> right[COUNT];
};

template <class String, class Compare>
void compare(benchmark::State& state, std::size_t size, Difference difference, Compare compareOne) {
    Pairs<String> const pairs(size, difference);
    std::size_t i = 0;
    for (auto _ : state) {
        String const* left = pairs.left[i].get();
        String const* right = pairs.right[i].get();
        i = (i + 1) % Pairs<String>::COUNT;
        benchmark::DoNotOptimize(left);
        benchmark::DoNotOptimize(right);
        auto result = compareOne(*left, *right);
        benchmark::DoNotOptimize(result);
    }
}

template <class... Arguments>
void add(std::string const& row, char const* who, Arguments... arguments) {
    benchmark::RegisterBenchmark((row + "/" + who).c_str(), arguments...);
}

template <class String>
void addMaking(std::string const& kind, char const* who, std::size_t size) {
    std::string const suffix = kind + "/" + std::to_string(size) + "B";
    add("construct/" + suffix, who, [size](benchmark::State& state) { construct<String>(state, size, IN_ONE_PAGE); });
    add("copy/" + suffix, who, [size](benchmark::State& state) { copy<String>(state, size); });
}

/// The rare case: nothing may be read behind the page's end unless the text goes on.
template <class String>
void addMakingAcrossPages(char const* who, std::size_t size) {
    add("construct-across-pages/" + std::to_string(size) + "B", who,
        [size](benchmark::State& state) { construct<String>(state, size, size / 2); });
}

template <class String>
void addAppending(std::string const& row, char const* who, std::size_t count) {
    add(row, who, [count](benchmark::State& state) { append<String>(state, count); });
}

template <class String>
void addComparing(std::string const& kind, char const* who, std::size_t size) {
    for (auto const& [difference, name] : {std::pair{Difference::NONE, "same"}, std::pair{Difference::EARLY, "early"},
                                           std::pair{Difference::LATE, "late"}}) {
        std::string const suffix = kind + "/" + std::to_string(size) + "B-" + name;
        auto const row = [&, where = difference](std::string const& operation, auto compareOne) {
            add(operation + suffix, who, [size, where, compareOne](benchmark::State& state) {
                compare<String>(state, size, where, compareOne);
            });
        };
        row("equal/", [](String const& a, String const& b) { return a == b; });
        row("compare/", [](String const& a, String const& b) { return a.compare(b); });
        row("less/", [](String const& a, String const& b) { return a < b; });
    }
}

bool registerAll() {
    for (std::size_t size : {5U, 14U, 40U, 200U}) {
        addMaking<BufStr<255>>("BufStr255", "ours", size);
        addMaking<std::string>("BufStr255", "std::string", size);
#ifdef BENCH_HAS_LLVM
        addMaking<llvm::SmallString<255>>("BufStr255", "llvm::SmallString", size);
#endif
    }
    addMakingAcrossPages<BufStr<255>>("ours", 200);
    addMakingAcrossPages<std::string>("std::string", 200);
#ifdef BENCH_HAS_LLVM
    addMakingAcrossPages<llvm::SmallString<255>>("llvm::SmallString", 200);
#endif
    for (std::size_t size : {5U, 12U, 14U, 400U}) {
        addMaking<BufStr<15>>("BufStr15", "ours", size);
        addMaking<std::string>("BufStr15", "std::string", size);
#ifdef BENCH_HAS_LLVM
        addMaking<llvm::SmallString<15>>("BufStr15", "llvm::SmallString", size);
#endif
    }
    addAppending<BufStr<15>>("append/BufStr15/14", "ours", 14);
    addAppending<std::string>("append/BufStr15/14", "std::string", 14);
    addAppending<BufStr<255>>("append/BufStr255/200", "ours", 200);
    addAppending<std::string>("append/BufStr255/200", "std::string", 200);
#ifdef BENCH_HAS_LLVM
    addAppending<llvm::SmallString<15>>("append/BufStr15/14", "llvm::SmallString", 14);
    addAppending<llvm::SmallString<255>>("append/BufStr255/200", "llvm::SmallString", 200);
#endif
    for (std::size_t size : {5U, 14U, 40U, 100U, 200U, 400U}) {
        std::string const kind = size <= 14 ? "BufStr15" : "BufStr255";
        if (size <= 14) {
            addComparing<BufStr<15>>(kind, "ours", size);
        } else {
            addComparing<BufStr<255>>(kind, "ours", size);
        }
        addComparing<std::string>(kind, "std::string", size);
    }
    return true;
}

[[maybe_unused]] bool const registered = registerAll();

} // namespace
