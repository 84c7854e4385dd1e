// The locale's character set through iconv; Windows has code pages instead (convert_win.cpp).

#include "basis/text/charset_posix.h"

#include "basis/text/utf.h"

#include <iconv.h>
#include <langinfo.h>
#include <locale.h>
#include <strings.h>

#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <cstring>

namespace ZOR_Basis::Charset {
namespace {

constexpr char WIDE[] = "UTF-16LE";
constexpr char ASCII[] = "ANSI_X3.4-1968";
constexpr std::size_t LONGEST_NAME = 63;

char const* firstSet(char const* a, char const* b, char const* c) {
    for (char const* name : {a, b, c}) {
        char const* const value = std::getenv(name);
        if (value != nullptr && *value != '\0') return value;
    }
    return "";
}

struct Name {
    char text[LONGEST_NAME + 1] = {};

    void set(char const* from, std::size_t length) {
        length = length < LONGEST_NAME ? length : LONGEST_NAME;
        std::memcpy(text, from, length);
        text[length] = '\0';
    }
};

/// The set that a locale's name tells, as in "de_DE.ISO-8859-15@euro"; ASCII where it tells none.
Name setOfName(char const* locale) {
    Name name;
    char const* const dot = std::strchr(locale, '.');
    if (dot != nullptr && dot[1] != '\0') {
        name.set(dot + 1, std::strcspn(dot + 1, "@"));
    } else {
        name.set(ASCII, std::strlen(ASCII));
    }
    return name;
}

Name setOfEnvironment() {
    locale_t const locale = newlocale(LC_CTYPE_MASK, "", static_cast<locale_t>(nullptr));
    // A locale that is not installed still says by its name what its text is.
    if (locale == static_cast<locale_t>(nullptr)) return setOfName(firstSet("LC_ALL", "LC_CTYPE", "LANG"));
    Name name;
    char const* const codeset = nl_langinfo_l(CODESET, locale);
    name.set(codeset, std::strlen(codeset));
    freelocale(locale);
    return name;
}

std::atomic<char const*> replacement{nullptr};

iconv_t const NO_CONVERTER = reinterpret_cast<iconv_t>(-1);

/// A converter that is kept for the thread's next conversion by the same set.
class Converter {
public:
    Converter() = default;
    Converter(Converter const&) = delete;
    Converter& operator=(Converter const&) = delete;
    ~Converter() { close(); }

    /// In its initial state; `NO_CONVERTER` if there is no such set.
    iconv_t get(char const* to, char const* from, char const* charset) {
        if (handle_ != NO_CONVERTER && std::strcmp(charset_.text, charset) == 0) {
            iconv(handle_, nullptr, nullptr, nullptr, nullptr);
            return handle_;
        }
        close();
        charset_.set(charset, std::strlen(charset));
        return handle_ = iconv_open(to, from);
    }

private:
    void close() {
        if (handle_ != NO_CONVERTER) iconv_close(handle_);
    }

    iconv_t handle_ = NO_CONVERTER;
    Name charset_;
};

thread_local Converter decoder;
thread_local Converter encoder;

/// Where a conversion writes: nowhere first, to learn the size, then into the output's own buffer.
class Sink {
public:
    Sink() = default;
    Sink(char* out, std::size_t size) : out_(out), room_(size), counting_(false) {}

    std::uint64_t total() const { return total_; }

    /// One call of the system's converter with the room that there is. \return its result, errno as it left it
    std::size_t step(iconv_t converter, char** text, std::size_t* left) {
        if (counting_) {
            out_ = scratch_;
            room_ = sizeof scratch_;
        }
        std::size_t const before = room_;
        std::size_t const result = iconv(converter, text, left, &out_, &room_);
        total_ += before - room_;
        return result;
    }

    bool isCounting() const { return counting_; }

private:
    char scratch_[512];
    char* out_ = nullptr;
    std::size_t room_ = 0;
    std::uint64_t total_ = 0;
    bool counting_ = true;
};

constexpr auto FAILED = static_cast<std::size_t>(-1);

/// Converts everything, or up to a fault that `mend` cannot pass. \return whether all of it was converted
template <class Mend>
bool run(iconv_t converter, char const* text, std::size_t left, Sink& sink, Mend mend) {
    char* position = const_cast<char*>(text);
    while (left > 0) {
        if (sink.step(converter, &position, &left) != FAILED) break;
        if (errno == E2BIG && sink.isCounting()) continue;
        if (!mend(position, left)) return false;
    }
    // The end of the text: back to the initial state, with what was held back written out.
    while (sink.step(converter, nullptr, nullptr) == FAILED) {
        if (errno != E2BIG || !sink.isCounting()) return false;
    }
    return true;
}

bool putUnit(iconv_t converter, Sink& sink, WChar unit) {
    char* position = reinterpret_cast<char*>(&unit);
    std::size_t left = sizeof unit;
    while (sink.step(converter, &position, &left) == FAILED) {
        if (errno != E2BIG || !sink.isCounting()) return false;
    }
    return true;
}

/// Puts something for the character at `position`: U+FFFD for half a surrogate pair, "?" for what the set lacks.
bool putDefault(iconv_t converter, Sink& sink, char*& position, std::size_t& left) {
    WChar units[2] = {};
    std::memcpy(units, position, left < sizeof units ? left : sizeof units);
    bool const pair = left >= sizeof units && Utf::isHighSurrogate(units[0]) && Utf::isLowSurrogate(units[1]);
    std::size_t const skipped = pair ? 2 * sizeof(WChar) : sizeof(WChar);
    position += skipped;
    left -= skipped;
    bool const unpaired = !pair && Utf::isSurrogate(units[0]);
    return (unpaired && putUnit(converter, sink, u'\xFFFD')) || putUnit(converter, sink, u'?');
}

bool encode(iconv_t converter, WChar const* text, std::uint64_t size, Sink& sink) {
    iconv(converter, nullptr, nullptr, nullptr, nullptr);
    return run(converter, reinterpret_cast<char const*>(text), size * sizeof(WChar), sink,
               [&](char*& position, std::size_t& left) { return putDefault(converter, sink, position, left); });
}

bool decode(iconv_t converter, char const* text, std::uint64_t size, Sink& sink) {
    iconv(converter, nullptr, nullptr, nullptr, nullptr);
    return run(converter, text, size, sink, [](char*&, std::size_t&) { return false; });
}

} // namespace

char const* local() {
    if (char const* const name = replacement.load(std::memory_order_acquire)) return name;
    static Name const name = setOfEnvironment();
    return name.text;
}

void setLocal(char const* name) { replacement.store(name, std::memory_order_release); }

bool isUtf8(char const* charset) { return strcasecmp(charset, "UTF-8") == 0 || strcasecmp(charset, "UTF8") == 0; }

bool toWide(char const* charset, char const* text, std::uint64_t size, WBStr& out) {
    iconv_t const converter = decoder.get(WIDE, charset, charset);
    Sink counter;
    if (converter == NO_CONVERTER || !decode(converter, text, size, counter)) return false;
    std::uint64_t const units = counter.total() / sizeof(WChar);
    out.extendBuf(units + 1);
    Sink writer(reinterpret_cast<char*>(out.getBuf()), counter.total());
    bool const good = decode(converter, text, size, writer) && units > 0;
    out.setSize(good ? units : 0);
    return good;
}

bool fromWide(char const* charset, WChar const* text, std::uint64_t size, BufStr<255>& out) {
    iconv_t const converter = encoder.get(charset, WIDE, charset);
    Sink counter;
    if (converter == NO_CONVERTER || !encode(converter, text, size, counter)) return false;
    out.extendBuf(counter.total() + 1);
    Sink writer(out.getBuf(), counter.total());
    bool const good = encode(converter, text, size, writer) && counter.total() > 0;
    if (good) {
        out.resize(counter.total());
    } else {
        out.clear();
    }
    return good;
}

} // namespace ZOR_Basis::Charset
