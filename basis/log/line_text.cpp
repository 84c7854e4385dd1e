#include "basis/log/line_text.h"

#include "basis/log/conversion.h"
#include "basis/log/decimal_point.h"
#include "basis/log/fixed_decimal.h"

#include <algorithm>
#include <cfenv>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <iterator>

namespace ZOR_Basis {
namespace {

constexpr int USUAL_DECIMALS = 6;
/// Digits of a 64-bit number to the base 8, the smallest that there is.
constexpr int MOST_DIGITS = 22;

/// Writes a line by the short way. Each step is false where the way ends: at a conversion that is not its business, or
/// where the room does.
class QuickLine {
public:
    QuickLine(char* line, std::size_t room, std::va_list arguments) : at_(line), end_(line + room - 1) {
        va_copy(arguments_, arguments);
    }
    QuickLine(QuickLine const&) = delete;
    QuickLine& operator=(QuickLine const&) = delete;
    ~QuickLine() { va_end(arguments_); }

    bool write(char const* format);

private:
    std::size_t room() const { return static_cast<std::size_t>(end_ - at_); }
    void put(char const* text, std::size_t size) {
        std::memcpy(at_, text, size);
        at_ += size;
    }
    void fill(char with, std::size_t count) {
        std::memset(at_, with, count);
        at_ += count;
    }

    bool writeConversion(Conversion const& how);
    bool writePadded(char const* text, std::size_t size, Conversion const& how);
    bool writeText(Conversion const& how);
    bool writeCharacter(Conversion const& how);
    bool writeSigned(Conversion const& how);
    bool writeUnsigned(Conversion const& how, int base);
    bool writeNumber(std::uint64_t number, int base, char sign, Conversion const& how);
    bool writeFixed(Conversion const& how);
    bool writeSignedDigits(char const* digits, std::size_t size, char sign, Conversion const& how);

    std::int64_t nextSigned(Conversion::Length length);
    std::uint64_t nextUnsigned(Conversion::Length length);

    char* at_;
    char* const end_;
    std::va_list arguments_;
};

bool QuickLine::write(char const* format) {
    while (char const c = *format++) {
        if (c != '%' || *format == '%') {
            if (at_ == end_) return false;
            *at_++ = c;
            format += c == '%' ? 1 : 0;
            continue;
        }
        Conversion how;
        format = how.read(format);
        if (!writeConversion(how)) return false;
    }
    *at_ = '\0';
    return true;
}

bool QuickLine::writeConversion(Conversion const& how) {
    switch (how.kind) {
    case 's':
        return writeText(how);
    case 'd':
    case 'i':
        return writeSigned(how);
    case 'u':
        return writeUnsigned(how, 10);
    case 'x':
        return writeUnsigned(how, 16);
    case 'o':
        return writeUnsigned(how, 8);
    case 'c':
        return writeCharacter(how);
    case 'f':
        return writeFixed(how);
    default:
        return false;
    }
}

bool QuickLine::writePadded(char const* text, std::size_t size, Conversion const& how) {
    std::size_t const blanks = how.width > size ? how.width - size : 0;
    if (size + blanks > room()) return false;
    if (!how.isLeft) fill(' ', blanks);
    put(text, size);
    if (how.isLeft) fill(' ', blanks);
    return true;
}

bool QuickLine::writeText(Conversion const& how) {
    if (how.length != Conversion::NONE || how.hasZeros || how.hasSignFlag()) return false;
    char const* const text = va_arg(arguments_, char const*);
    if (text == nullptr) return false;
    std::size_t const size =
        how.precision < 0 ? std::strlen(text) : strnlen(text, static_cast<std::size_t>(how.precision));
    return writePadded(text, size, how);
}

bool QuickLine::writeCharacter(Conversion const& how) {
    if (how.length != Conversion::NONE || how.precision >= 0 || how.hasZeros || how.hasSignFlag()) return false;
    char const c = static_cast<char>(va_arg(arguments_, int));
    return writePadded(&c, 1, how);
}

std::int64_t QuickLine::nextSigned(Conversion::Length length) {
    switch (length) {
    case Conversion::CHAR:
        return static_cast<signed char>(va_arg(arguments_, int));
    case Conversion::SHORT:
        return static_cast<short>(va_arg(arguments_, int));
    case Conversion::LONG:
        return va_arg(arguments_, long);
    case Conversion::LONG_LONG:
        return va_arg(arguments_, long long);
    case Conversion::SIZE:
    case Conversion::DIFFERENCE:
        return va_arg(arguments_, std::ptrdiff_t);
    case Conversion::MAXIMUM:
        return va_arg(arguments_, std::intmax_t);
    default:
        return va_arg(arguments_, int);
    }
}

std::uint64_t QuickLine::nextUnsigned(Conversion::Length length) {
    switch (length) {
    case Conversion::CHAR:
        return static_cast<unsigned char>(va_arg(arguments_, unsigned));
    case Conversion::SHORT:
        return static_cast<unsigned short>(va_arg(arguments_, unsigned));
    case Conversion::LONG:
        return va_arg(arguments_, unsigned long);
    case Conversion::LONG_LONG:
        return va_arg(arguments_, unsigned long long);
    case Conversion::SIZE:
    case Conversion::DIFFERENCE:
        return va_arg(arguments_, std::size_t);
    case Conversion::MAXIMUM:
        return va_arg(arguments_, std::uintmax_t);
    default:
        return va_arg(arguments_, unsigned);
    }
}

char signOf(bool isNegative, Conversion const& how) {
    if (isNegative) return '-';
    if (how.hasPlus) return '+';
    return how.hasBlank ? ' ' : '\0';
}

bool QuickLine::writeSigned(Conversion const& how) {
    if (how.precision >= 0) return false;
    std::int64_t const number = nextSigned(how.length);
    auto const magnitude = static_cast<std::uint64_t>(number);
    return writeNumber(number < 0 ? 0 - magnitude : magnitude, 10, signOf(number < 0, how), how);
}

bool QuickLine::writeUnsigned(Conversion const& how, int base) {
    if (how.precision >= 0 || how.hasSignFlag()) return false;
    return writeNumber(nextUnsigned(how.length), base, '\0', how);
}

bool QuickLine::writeNumber(std::uint64_t number, int base, char sign, Conversion const& how) {
    char digits[MOST_DIGITS];
    char const* const end = std::to_chars(std::begin(digits), std::end(digits), number, base).ptr;
    return writeSignedDigits(digits, static_cast<std::size_t>(end - digits), sign, how);
}

bool QuickLine::writeSignedDigits(char const* digits, std::size_t size, char sign, Conversion const& how) {
    std::size_t const signSize = sign != '\0' ? 1 : 0;
    std::size_t const all = size + signSize;
    std::size_t const padding = how.width > all ? how.width - all : 0;
    if (all + padding > room()) return false;
    bool const hasZeros = how.hasZeros && !how.isLeft;
    if (!how.isLeft && !hasZeros) fill(' ', padding);
    put(&sign, signSize);
    if (hasZeros) fill('0', padding);
    put(digits, size);
    if (how.isLeft) fill(' ', padding);
    return true;
}

/// Numbers too large or none at all, rounding of another kind and decimal points of several bytes go the long way.
bool QuickLine::writeFixed(Conversion const& how) {
    int const decimals = how.precision < 0 ? USUAL_DECIMALS : how.precision;
    bool const isDouble = how.length == Conversion::NONE || how.length == Conversion::LONG;
    char const* const point = decimalPoint();
    if (!isDouble || decimals > MOST_DECIMALS || std::strlen(point) != 1 || std::fegetround() != FE_TONEAREST) {
        return false;
    }
    double const number = va_arg(arguments_, double);
    FixedDecimal parts;
    if (!takeApart(number, decimals, parts)) return false;
    char text[MOST_DIGITS + 1 + MOST_DECIMALS];
    char* end = std::to_chars(std::begin(text), std::end(text), parts.whole).ptr;
    if (decimals > 0) {
        *end++ = *point;
        end += decimals;
        char* digit = end;
        for (int i = 0; i < decimals; ++i, parts.decimals /= 10) *--digit = static_cast<char>('0' + parts.decimals % 10);
    }
    return writeSignedDigits(text, static_cast<std::size_t>(end - text), signOf(std::signbit(number), how), how);
}

} // namespace

bool writeLineTextQuickly(char* line, std::size_t room, char const* format, std::va_list arguments) {
    return QuickLine(line, room, arguments).write(format);
}

void writeLineText(char* line, std::size_t room, char const* format, std::va_list arguments) {
    if (writeLineTextQuickly(line, room, format, arguments)) return;
    // Where the runtime refuses the format, what it has written so far is the text.
    line[0] = '\0';
    std::vsnprintf(line, room, format, arguments);
    line[room - 1] = '\0';
}

} // namespace ZOR_Basis
