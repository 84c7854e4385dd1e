// UTF-8 to UTF-16 and back, beside ICU, Qt, GLib and iconv. Every side writes into an output that it keeps, where its
// interface lets it; every result is compared with the expected text once before it is timed.

#include "bench/text/convert_texts.h"

#include <zor_basis/text/convert.h>

#include <benchmark/benchmark.h>

#include <emmintrin.h>

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#ifdef BENCH_HAS_ICU
#include <unicode/ustring.h>
#endif
#ifdef BENCH_HAS_QT
#include <QString>
#include <QStringConverter>
#endif
#ifdef BENCH_HAS_GLIB
#include <glib.h>
#endif
#include <iconv.h>

using namespace ZOR_Basis;

namespace {

using bench::Pool;
using bench::Text;

std::vector<char16_t> wideRoom(1 << 18);
std::vector<char> narrowRoom(1 << 18);

std::u16string_view wideResult(std::size_t units) { return {wideRoom.data(), units}; }
std::string_view narrowResult(std::size_t bytes) { return {narrowRoom.data(), bytes}; }

// ---- the sides: each returns a view of its result -------------------------------------------------------------------

struct Ours {
    static std::u16string_view toWide(Text const& text) {
        static WBStr wide;
        Convert::Utf8ToWide(text.narrow.c_str(), wide, text.narrow.size());
        return {wide.wstr(), wide.size()};
    }

    static std::string_view toUtf8(Text const& text) {
        static BufStr<255> narrow;
        Convert::WideToUtf8(text.wide.c_str(), narrow, text.wide.size());
        return {narrow.c_str(), narrow.size()};
    }
};

/// The usual call: the output is new.
struct OursFresh {
    static std::u16string_view toWide(Text const& text) {
        WBStr wide;
        Convert::Utf8ToWide(text.narrow.c_str(), wide, text.narrow.size());
        benchmark::DoNotOptimize(wide.wstr());
        return text.wide;
    }

    static std::string_view toUtf8(Text const& text) {
        BufStr<255> narrow;
        Convert::WideToUtf8(text.wide.c_str(), narrow, text.wide.size());
        benchmark::DoNotOptimize(narrow.c_str());
        return text.narrow;
    }
};

/// What a fresh output costs at least: the conversion, and a block where the text does not fit inside the object.
struct KeptAndBlock {
    static constexpr std::size_t INSIDE = 255;

    static void useBlock(std::size_t size, std::size_t unit) {
        if (size <= INSIDE) return;
        std::unique_ptr<void, void (*)(void*)> const block(std::malloc((size + 1) * unit), std::free);
        benchmark::DoNotOptimize(block.get());
    }

    static std::u16string_view toWide(Text const& text) {
        std::u16string_view const result = Ours::toWide(text);
        useBlock(result.size(), sizeof(char16_t));
        return result;
    }

    static std::string_view toUtf8(Text const& text) {
        std::string_view const result = Ours::toUtf8(text);
        useBlock(result.size(), 1);
        return result;
    }
};

#ifdef BENCH_HAS_ICU
struct Icu {
    static std::u16string_view toWide(Text const& text) {
        int32_t written = 0;
        UErrorCode error = U_ZERO_ERROR;
        u_strFromUTF8(wideRoom.data(), static_cast<int32_t>(wideRoom.size()), &written, text.narrow.data(),
                      static_cast<int32_t>(text.narrow.size()), &error);
        return wideResult(static_cast<std::size_t>(written));
    }

    static std::string_view toUtf8(Text const& text) {
        int32_t written = 0;
        UErrorCode error = U_ZERO_ERROR;
        u_strToUTF8(narrowRoom.data(), static_cast<int32_t>(narrowRoom.size()), &written, text.wide.data(),
                    static_cast<int32_t>(text.wide.size()), &error);
        return narrowResult(static_cast<std::size_t>(written));
    }
};
#endif

#ifdef BENCH_HAS_QT
struct Qt {
    static std::u16string_view toWide(Text const& text) {
        QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
        auto* const room = reinterpret_cast<QChar*>(wideRoom.data());
        QByteArrayView const bytes(text.narrow.data(), static_cast<qsizetype>(text.narrow.size()));
        return wideResult(static_cast<std::size_t>(decoder.appendToBuffer(room, bytes) - room));
    }

    static std::string_view toUtf8(Text const& text) {
        QStringEncoder encoder(QStringEncoder::Utf8, QStringEncoder::Flag::Stateless);
        QStringView const units(text.wide.data(), static_cast<qsizetype>(text.wide.size()));
        return narrowResult(
            static_cast<std::size_t>(encoder.appendToBuffer(narrowRoom.data(), units) - narrowRoom.data()));
    }
};
#endif

#ifdef BENCH_HAS_GLIB
/// Gives a new block each time, which is freed at the next call.
struct Glib {
    static std::u16string_view toWide(Text const& text) {
        static std::unique_ptr<gunichar2, void (*)(void*)> wide(nullptr, g_free);
        glong units = 0;
        wide.reset(
            g_utf8_to_utf16(text.narrow.data(), static_cast<glong>(text.narrow.size()), nullptr, &units, nullptr));
        return {reinterpret_cast<char16_t const*>(wide.get()), static_cast<std::size_t>(units)};
    }

    static std::string_view toUtf8(Text const& text) {
        static std::unique_ptr<char, void (*)(void*)> narrow(nullptr, g_free);
        glong bytes = 0;
        narrow.reset(g_utf16_to_utf8(reinterpret_cast<gunichar2 const*>(text.wide.data()),
                                     static_cast<glong>(text.wide.size()), nullptr, &bytes, nullptr));
        return {narrow.get(), static_cast<std::size_t>(bytes)};
    }
};
#endif

struct Iconv {
    static std::size_t convert(iconv_t converter, void const* from, std::size_t size, void* to, std::size_t room) {
        auto* in = const_cast<char*>(static_cast<char const*>(from));
        auto* out = static_cast<char*>(to);
        std::size_t left = room;
        iconv(converter, &in, &size, &out, &left);
        return room - left;
    }

    static std::u16string_view toWide(Text const& text) {
        static iconv_t const converter = iconv_open("UTF-16LE", "UTF-8");
        std::size_t const bytes = convert(converter, text.narrow.data(), text.narrow.size(), wideRoom.data(),
                                          wideRoom.size() * sizeof(char16_t));
        return wideResult(bytes / sizeof(char16_t));
    }

    static std::string_view toUtf8(Text const& text) {
        static iconv_t const converter = iconv_open("UTF-8", "UTF-16LE");
        return narrowResult(convert(converter, text.wide.data(), text.wide.size() * sizeof(char16_t), narrowRoom.data(),
                                    narrowRoom.size()));
    }
};

/// What no conversion of ASCII can beat by much: it looks at nothing.
struct Sse2Loop {
    static std::u16string_view toWide(Text const& text) {
        __m128i const zero = _mm_setzero_si128();
        std::size_t i = 0;
        for (; i + 16 <= text.narrow.size(); i += 16) {
            __m128i const block = _mm_loadu_si128(reinterpret_cast<__m128i const*>(text.narrow.data() + i));
            _mm_storeu_si128(reinterpret_cast<__m128i*>(wideRoom.data() + i), _mm_unpacklo_epi8(block, zero));
            _mm_storeu_si128(reinterpret_cast<__m128i*>(wideRoom.data() + i + 8), _mm_unpackhi_epi8(block, zero));
        }
        for (; i < text.narrow.size(); ++i) wideRoom[i] = static_cast<unsigned char>(text.narrow[i]);
        return wideResult(text.narrow.size());
    }

    static std::string_view toUtf8(Text const& text) {
        std::size_t i = 0;
        for (; i + 16 <= text.wide.size(); i += 16) {
            auto const* const from = reinterpret_cast<__m128i const*>(text.wide.data() + i);
            _mm_storeu_si128(reinterpret_cast<__m128i*>(narrowRoom.data() + i),
                             _mm_packus_epi16(_mm_loadu_si128(from), _mm_loadu_si128(from + 1)));
        }
        for (; i < text.wide.size(); ++i) narrowRoom[i] = static_cast<char>(text.wide[i]);
        return narrowResult(text.wide.size());
    }
};

// ---- rows -----------------------------------------------------------------------------------------------------------

void require(bool good, std::string const& name) {
    if (good) return;
    std::fprintf(stderr, "%s: wrong result\n", name.c_str());
    std::abort();
}

/// Registers one side of a row, after a look at all its results.
template <class Convert, class Expected>
void addRow(std::string const& name, Pool const& pool, Convert convert, Expected expected) {
    for (Text const& text : pool.texts) require(convert(text) == expected(text), name);
    benchmark::RegisterBenchmark(name.c_str(), [&pool, convert](benchmark::State& state) {
        std::size_t next = 0;
        for (auto _ : state) {
            benchmark::DoNotOptimize(convert(pool.texts[next]));
            benchmark::ClobberMemory();
            next = next + 1 == pool.texts.size() ? 0 : next + 1;
        }
    });
}

template <class Side>
void addSide(std::string const& row, Pool const& pool, std::string const& who) {
    addRow(row + "to-wide-" + pool.name + "/" + who, pool, Side::toWide,
           [](Text const& text) { return std::u16string_view(text.wide); });
    addRow(row + "to-utf8-" + pool.name + "/" + who, pool, Side::toUtf8,
           [](Text const& text) { return std::string_view(text.narrow); });
}

bool registerAll() {
    static std::vector<Pool> const pools = bench::makePools();
    for (Pool const& pool : pools) {
        addSide<Ours>("", pool, "ours");
        addSide<Iconv>("", pool, "iconv");
#ifdef BENCH_HAS_ICU
        addSide<Icu>("", pool, "icu");
#endif
#ifdef BENCH_HAS_QT
        addSide<Qt>("", pool, "qt");
#endif
#ifdef BENCH_HAS_GLIB
        addSide<Glib>("", pool, "glib");
#endif
        if (pool.name.starts_with("ascii")) addSide<Sse2Loop>("", pool, "sse2-loop");
        addSide<OursFresh>("fresh-", pool, "ours");
        addSide<KeptAndBlock>("fresh-", pool, "kept-and-block");
    }
    return true;
}

bool const registered = registerAll();

} // namespace
