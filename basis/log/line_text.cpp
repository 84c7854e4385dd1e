#include "basis/log/line_text.h"

#include "basis/log/conversion.h"
#include "basis/log/decimal_digits.h"
#include "basis/log/decimal_point.h"
#include "basis/log/fixed_decimal.h"
#include "zor_basis/ground/compiler.h"

#include <cfenv>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr int USUAL_DECIMALS = 6;
/// Digits of a 64-bit number to the base 8, the smallest that there is.
constexpr int MOST_DIGITS = 22;
constexpr std::size_t LONGEST_NUMBER = MOST_DIGITS + 1 + MOST_DECIMALS;

/// Writes a line without `vsnprintf`. Each step returns false if it cannot continue: at a conversion that it does not
/// handle, or at the end of the room.
class QuickLine {
public:
    QuickLine(char* line, std::size_t room, LineArguments& arguments)
        : at_(line), end_(line + room - 1), arguments_(arguments) {}

    bool write(char const* format);
    char* end() const { return at_; }

private:
    std::size_t room() const { return static_cast<std::size_t>(end_ - at_); }
    void put(char const* text, std::size_t size) {
        std::memcpy(at_, text, size);
        at_ += size;
    }
    void fill(char with, std::size_t count) {
        if (count != 0) std::memset(at_, with, count);
        at_ += count;
    }

    bool putPlain(char const*& format);
    bool writeConversion(char const*& format);
    bool writeParsed(Conversion const& how);
    bool writePadded(char const* text, std::size_t size, Conversion const& how);
    bool writeText(Conversion const& how);
    bool writeCharacter(Conversion const& how);
    bool writeSigned(Conversion const& how);
    template <int BASE>
    bool writeUnsigned(Conversion const& how);
    bool writeFixed(Conversion const& how);
    template <class Write>
    bool writeNumber(char sign, Conversion const& how, Write const& writeDigits);
    bool padNumber(char* number, std::size_t signSize, Conversion const& how);

    std::int64_t nextSigned(Conversion::Length length);
    std::uint64_t nextUnsigned(Conversion::Length length);

    char* at_;
    char* const end_;
    LineArguments& arguments_;
};

bool QuickLine::write(char const* format) {
    while (putPlain(format) && *format != '\0') {
        if (!writeConversion(++format)) return false;
    }
    *at_ = '\0';
    return *format == '\0';
}

/// Goes on to the next conversion, or to the end.
ZB_INLINE bool QuickLine::putPlain(char const*& format) {
    char* at = at_;
    char const* from = format;
    while (*from != '%' && *from != '\0' && at != end_) *at++ = *from++;
    at_ = at;
    format = from;
    return *from == '%' || *from == '\0';
}

bool QuickLine::writeConversion(char const*& format) {
    // The most frequent conversions: a kind alone, without flags, width or precision.
    constexpr Conversion PLAIN;
    switch (*format) {
    case 's':
        ++format;
        return writeText(PLAIN);
    case 'd':
        ++format;
        return writeSigned(PLAIN);
    case '%':
        ++format;
        return writePadded("%", 1, PLAIN);
    default:
        Conversion how;
        format = how.read(format);
        return writeParsed(how);
    }
}

bool QuickLine::writeParsed(Conversion const& how) {
    switch (how.kind) {
    case 's':
        return writeText(how);
    case 'd':
    case 'i':
        return writeSigned(how);
    case 'u':
        return writeUnsigned<10>(how);
    case 'x':
        return writeUnsigned<16>(how);
    case 'o':
        return writeUnsigned<8>(how);
    case 'c':
        return writeCharacter(how);
    case 'f':
        return writeFixed(how);
    default:
        return false;
    }
}

ZB_INLINE bool QuickLine::writePadded(char const* text, std::size_t size, Conversion const& how) {
    std::size_t const blanks = how.width > size ? how.width - size : 0;
    if (size + blanks > room()) return false;
    if (!how.isLeft) fill(' ', blanks);
    put(text, size);
    if (how.isLeft) fill(' ', blanks);
    return true;
}

ZB_INLINE bool QuickLine::writeText(Conversion const& how) {
    if (how.length != Conversion::NONE || how.hasZeros || how.hasSignFlag()) return false;
    char const* const text = va_arg(arguments_.list, char const*);
    if (text == nullptr) return false;
    std::size_t const size =
        how.precision < 0 ? std::strlen(text) : strnlen(text, static_cast<std::size_t>(how.precision));
    return writePadded(text, size, how);
}

bool QuickLine::writeCharacter(Conversion const& how) {
    if (how.length != Conversion::NONE || how.precision >= 0 || how.hasZeros || how.hasSignFlag()) return false;
    char const c = static_cast<char>(va_arg(arguments_.list, int));
    return c != '\0' && writePadded(&c, 1, how);
}

static_assert(sizeof(std::size_t) == sizeof(std::intmax_t) && sizeof(std::ptrdiff_t) == sizeof(std::intmax_t));

std::int64_t QuickLine::nextSigned(Conversion::Length length) {
    switch (length) {
    case Conversion::CHAR:
        return static_cast<signed char>(va_arg(arguments_.list, int));
    case Conversion::SHORT:
        return static_cast<short>(va_arg(arguments_.list, int));
    case Conversion::LONG:
        return va_arg(arguments_.list, long);
    case Conversion::LONG_LONG:
        return va_arg(arguments_.list, long long);
    case Conversion::SIZE:
    case Conversion::DIFFERENCE:
    case Conversion::MAXIMUM:
        return va_arg(arguments_.list, std::intmax_t);
    default:
        return va_arg(arguments_.list, int);
    }
}

std::uint64_t QuickLine::nextUnsigned(Conversion::Length length) {
    switch (length) {
    case Conversion::CHAR:
        return static_cast<unsigned char>(va_arg(arguments_.list, unsigned));
    case Conversion::SHORT:
        return static_cast<unsigned short>(va_arg(arguments_.list, unsigned));
    case Conversion::LONG:
        return va_arg(arguments_.list, unsigned long);
    case Conversion::LONG_LONG:
        return va_arg(arguments_.list, unsigned long long);
    case Conversion::SIZE:
    case Conversion::DIFFERENCE:
    case Conversion::MAXIMUM:
        return va_arg(arguments_.list, std::uintmax_t);
    default:
        return va_arg(arguments_.list, unsigned);
    }
}

char signOf(bool isNegative, Conversion const& how) {
    if (isNegative) return '-';
    if (how.hasPlus) return '+';
    return how.hasBlank ? ' ' : '\0';
}

ZB_INLINE bool QuickLine::writeSigned(Conversion const& how) {
    if (how.precision >= 0) return false;
    std::int64_t const number = nextSigned(how.length);
    auto const bits = static_cast<std::uint64_t>(number);
    std::uint64_t const magnitude = number < 0 ? 0 - bits : bits;
    return writeNumber(signOf(number < 0, how), how, [magnitude](char* to) { return writeDecimal(to, magnitude); });
}

template <int BASE>
bool QuickLine::writeUnsigned(Conversion const& how) {
    if (how.precision >= 0 || how.hasSignFlag()) return false;
    std::uint64_t const number = nextUnsigned(how.length);
    return writeNumber('\0', how, [number](char* to) {
        if constexpr (BASE == 10) return writeDecimal(to, number);
        return std::to_chars(to, to + MOST_DIGITS, number, BASE).ptr;
    });
}

/// Numbers too large or none at all, rounding of another kind and decimal points of several bytes go the long way.
bool QuickLine::writeFixed(Conversion const& how) {
    int const decimals = how.precision < 0 ? USUAL_DECIMALS : how.precision;
    bool const isDouble = how.length == Conversion::NONE || how.length == Conversion::LONG;
    char const* const point = decimalPoint();
    bool const isPointShort = point[0] != '\0' && point[1] == '\0';
    if (!isDouble || decimals > MOST_DECIMALS || !isPointShort || std::fegetround() != FE_TONEAREST) return false;
    double const number = va_arg(arguments_.list, double);
    FixedDecimal parts;
    if (!takeApart(number, decimals, parts)) return false;
    return writeNumber(signOf(std::signbit(number), how), how, [parts, decimals, point = *point](char* to) {
        to = writeDecimal(to, parts.whole);
        if (decimals == 0) return to;
        *to = point;
        return writeDigits(to + 1, parts.decimals, decimals);
    });
}

/// \param writeDigits  writes at most `LONGEST_NUMBER` characters. \return their end
template <class Write>
bool QuickLine::writeNumber(char sign, Conversion const& how, Write const& writeDigits) {
    if (room() < LONGEST_NUMBER + 1) return false;
    char* const number = at_;
    std::size_t const signSize = sign != '\0' ? 1 : 0;
    *number = sign;
    at_ = writeDigits(number + signSize);
    return how.width == 0 || padNumber(number, signSize, how);
}

/// Widens the number that has just been written.
bool QuickLine::padNumber(char* number, std::size_t signSize, Conversion const& how) {
    auto const size = static_cast<std::size_t>(at_ - number);
    if (size >= how.width) return true;
    std::size_t const padding = how.width - size;
    if (padding > room()) return false;
    if (how.isLeft) {
        fill(' ', padding);
        return true;
    }
    char* const moved = number + (how.hasZeros ? signSize : 0);
    std::memmove(moved + padding, moved, static_cast<std::size_t>(at_ - moved));
    std::memset(moved, how.hasZeros ? '0' : ' ', padding);
    at_ += padding;
    return true;
}

} // namespace

char* writeLineText(char* line, std::size_t room, char const* format, LineArguments& arguments) {
    QuickLine text(line, room, arguments);
    return text.write(format) ? text.end() : nullptr;
}

char* writeAnyLineText(char* line, std::size_t room, char const* format, LineArguments& arguments) {
    // Where the runtime refuses the format, what it has written so far is the text.
    line[0] = '\0';
    std::vsnprintf(line, room, format, arguments.list);
    line[room - 1] = '\0';
    return line + std::strlen(line);
}

} // namespace ZOR_Basis
