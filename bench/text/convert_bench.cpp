// UTF-8 to UTF-16 and back, beside ICU, Qt, GLib and iconv. Every side writes into a buffer that it keeps, where its
// interface lets it; each result is compared with ours once before it is timed.

#include <zor_basis/text/convert.h>

#include <benchmark/benchmark.h>

#include <emmintrin.h>

#include <cstdlib>
#include <cstring>
#include <functional>
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

struct Text {
    std::string name;
    std::string narrow;
    std::u16string wide;
};

/// Text of about `size` bytes that repeats a sample, not cut inside a character.
Text makeText(std::string name, std::string_view sample, std::size_t size) {
    Text text{std::move(name), {}, {}};
    do { text.narrow += sample; } while (text.narrow.size() + sample.size() <= size);
    WBStr wide;
    Convert::Utf8ToWide(text.narrow, wide);
    text.wide.assign(wide.wstr(), wide.size());
    return text;
}

std::vector<Text> makeTexts() {
    struct Sample {
        char const* name;
        std::string_view text;
    };
    std::vector<Text> texts;
    for (auto const& [size, sizeName] : {std::pair{30u, "30B"}, std::pair{300u, "300B"}, std::pair{65536u, "64KiB"}}) {
        for (Sample const& sample : {Sample{"ascii", "page 0001"},
                                     Sample{"latin", "Gr\xC3\xBC\xC3\x9F"
                                                     "e \xC3\xA0 tous "},
                                     Sample{"cjk", "\xE6\x97\xA5\xE6\x9C\xAC\xE8\xAA\x9E\xE3\x81\xAE\xE5\x8D\xB0"},
                                     Sample{"emoji", "\xF0\x9F\x98\x80\xF0\x9F\x96\xA8\xF0\x9F\x93\x84"}}) {
            texts.push_back(makeText(std::string(sample.name) + "-" + sizeName, sample.text, size));
        }
    }
    return texts;
}

void require(bool good, std::string const& name) {
    if (good) return;
    std::fprintf(stderr, "%s: wrong result\n", name.c_str());
    std::abort();
}

/// Registers one side of a row, after a look at its result.
void add(std::string const& name, std::size_t bytes, std::function<bool()> check, std::function<void()> work) {
    require(check(), name);
    benchmark::RegisterBenchmark(name.c_str(), [bytes, work = std::move(work)](benchmark::State& state) {
        for (auto _ : state) work();
        state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * bytes));
    });
}

void addOurs(Text const& text) {
    static WBStr wide;
    static BufStr<255> narrow;
    auto toWide = [&text] {
        Convert::Utf8ToWide(text.narrow.c_str(), wide, text.narrow.size());
        benchmark::DoNotOptimize(wide.wstr());
    };
    auto toNarrow = [&text] {
        Convert::WideToUtf8(text.wide.c_str(), narrow, text.wide.size());
        benchmark::DoNotOptimize(narrow.c_str());
    };
    add(
        "to-wide-" + text.name + "/ours", text.narrow.size(),
        [&] { return toWide(), text.wide == std::u16string_view(wide.wstr(), wide.size()); }, toWide);
    add(
        "to-utf8-" + text.name + "/ours", text.narrow.size(),
        [&] { return toNarrow(), text.narrow == std::string_view(narrow.c_str(), narrow.size()); }, toNarrow);
}

std::vector<char16_t> wideRoom(1 << 18);
std::vector<char> narrowRoom(1 << 18);

#ifdef BENCH_HAS_ICU
void addIcu(Text const& text) {
    static int32_t written;
    auto toWide = [&text] {
        UErrorCode error = U_ZERO_ERROR;
        u_strFromUTF8(wideRoom.data(), static_cast<int32_t>(wideRoom.size()), &written, text.narrow.data(),
                      static_cast<int32_t>(text.narrow.size()), &error);
        benchmark::DoNotOptimize(wideRoom.data());
        benchmark::ClobberMemory();
    };
    auto toNarrow = [&text] {
        UErrorCode error = U_ZERO_ERROR;
        u_strToUTF8(narrowRoom.data(), static_cast<int32_t>(narrowRoom.size()), &written, text.wide.data(),
                    static_cast<int32_t>(text.wide.size()), &error);
        benchmark::DoNotOptimize(narrowRoom.data());
        benchmark::ClobberMemory();
    };
    add(
        "to-wide-" + text.name + "/icu", text.narrow.size(),
        [&] { return toWide(), text.wide == std::u16string_view(wideRoom.data(), static_cast<size_t>(written)); },
        toWide);
    add(
        "to-utf8-" + text.name + "/icu", text.narrow.size(),
        [&] { return toNarrow(), text.narrow == std::string_view(narrowRoom.data(), static_cast<size_t>(written)); },
        toNarrow);
}
#endif

#ifdef BENCH_HAS_QT
void addQt(Text const& text) {
    static QChar* wideEnd;
    static char* narrowEnd;
    auto toWide = [&text] {
        QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
        wideEnd =
            decoder.appendToBuffer(reinterpret_cast<QChar*>(wideRoom.data()),
                                   QByteArrayView(text.narrow.data(), static_cast<qsizetype>(text.narrow.size())));
        benchmark::DoNotOptimize(wideEnd);
        benchmark::ClobberMemory();
    };
    auto toNarrow = [&text] {
        QStringEncoder encoder(QStringEncoder::Utf8, QStringEncoder::Flag::Stateless);
        narrowEnd = encoder.appendToBuffer(narrowRoom.data(),
                                           QStringView(text.wide.data(), static_cast<qsizetype>(text.wide.size())));
        benchmark::DoNotOptimize(narrowEnd);
        benchmark::ClobberMemory();
    };
    auto units = [] { return static_cast<std::size_t>(wideEnd - reinterpret_cast<QChar*>(wideRoom.data())); };
    auto bytes = [] { return static_cast<std::size_t>(narrowEnd - narrowRoom.data()); };
    add(
        "to-wide-" + text.name + "/qt", text.narrow.size(),
        [&] { return toWide(), text.wide == std::u16string_view(wideRoom.data(), units()); }, toWide);
    add(
        "to-utf8-" + text.name + "/qt", text.narrow.size(),
        [&] { return toNarrow(), text.narrow == std::string_view(narrowRoom.data(), bytes()); }, toNarrow);
}
#endif

#ifdef BENCH_HAS_GLIB
void addGlib(Text const& text) {
    auto toWide = [&text] {
        gunichar2* const wide =
            g_utf8_to_utf16(text.narrow.data(), static_cast<glong>(text.narrow.size()), nullptr, nullptr, nullptr);
        benchmark::DoNotOptimize(*wide);
        g_free(wide);
    };
    auto toNarrow = [&text] {
        char* const narrow = g_utf16_to_utf8(reinterpret_cast<gunichar2 const*>(text.wide.data()),
                                             static_cast<glong>(text.wide.size()), nullptr, nullptr, nullptr);
        benchmark::DoNotOptimize(*narrow);
        g_free(narrow);
    };
    add(
        "to-wide-" + text.name + "/glib", text.narrow.size(), [] { return true; }, toWide);
    add(
        "to-utf8-" + text.name + "/glib", text.narrow.size(), [] { return true; }, toNarrow);
}
#endif

void addIconv(Text const& text) {
    static iconv_t const toWideConverter = iconv_open("UTF-16LE", "UTF-8");
    static std::size_t units;
    auto toWide = [&text] {
        char* in = const_cast<char*>(text.narrow.data());
        std::size_t left = text.narrow.size();
        char* out = reinterpret_cast<char*>(wideRoom.data());
        std::size_t room = wideRoom.size() * sizeof(char16_t);
        iconv(toWideConverter, &in, &left, &out, &room);
        units = static_cast<std::size_t>(out - reinterpret_cast<char*>(wideRoom.data())) / sizeof(char16_t);
        benchmark::DoNotOptimize(wideRoom.data());
        benchmark::ClobberMemory();
    };
    add(
        "to-wide-" + text.name + "/iconv", text.narrow.size(),
        [&] { return toWide(), text.wide == std::u16string_view(wideRoom.data(), units); }, toWide);
}

/// What no conversion of ASCII can beat: it looks at nothing.
void addWideningLoop(Text const& text) {
    auto toWide = [&text] {
        __m128i const zero = _mm_setzero_si128();
        std::size_t i = 0;
        for (; i + 16 <= text.narrow.size(); i += 16) {
            __m128i const block = _mm_loadu_si128(reinterpret_cast<__m128i const*>(text.narrow.data() + i));
            _mm_storeu_si128(reinterpret_cast<__m128i*>(wideRoom.data() + i), _mm_unpacklo_epi8(block, zero));
            _mm_storeu_si128(reinterpret_cast<__m128i*>(wideRoom.data() + i + 8), _mm_unpackhi_epi8(block, zero));
        }
        for (; i < text.narrow.size(); ++i) wideRoom[i] = static_cast<unsigned char>(text.narrow[i]);
        benchmark::DoNotOptimize(wideRoom.data());
        benchmark::ClobberMemory();
    };
    add(
        "to-wide-" + text.name + "/sse2-loop", text.narrow.size(),
        [&] { return toWide(), text.wide == std::u16string_view(wideRoom.data(), text.wide.size()); }, toWide);
}

bool registerAll() {
    static std::vector<Text> const texts = makeTexts();
    for (Text const& text : texts) {
        addOurs(text);
#ifdef BENCH_HAS_ICU
        addIcu(text);
#endif
#ifdef BENCH_HAS_QT
        addQt(text);
#endif
#ifdef BENCH_HAS_GLIB
        addGlib(text);
#endif
        addIconv(text);
        if (text.name == "ascii-64KiB") addWideningLoop(text);
    }
    return true;
}

bool const registered = registerAll();

} // namespace
