/// \file
/// One parsed conversion of a format, such as "%-8.3f".

#ifndef BASIS_LOG_CONVERSION_H
#define BASIS_LOG_CONVERSION_H

#include <cstddef>

namespace ZOR_Basis {

struct Conversion {
    enum Length : unsigned char { NONE, CHAR, SHORT, LONG, LONG_LONG, SIZE, MAXIMUM, DIFFERENCE };
    /// No format has a width or precision with more digits.
    static constexpr int LARGEST_NUMBER = 9999;

    bool isLeft = false;
    bool hasZeros = false;
    bool hasPlus = false;
    bool hasBlank = false;
    std::size_t width = 0;
    /// -1: none given.
    int precision = -1;
    Length length = NONE;
    /// The character that follows all that; it may be any.
    char kind = '\0';

    /// Reads what follows a "%".
    /// \return behind the kind
    char const* read(char const* text) {
        text = readFlags(text);
        int number = 0;
        text = readNumber(text, number);
        width = static_cast<std::size_t>(number);
        if (*text == '.') {
            precision = 0;
            text = readNumber(text + 1, precision);
        }
        text = readLength(text);
        kind = *text;
        return text + (kind != '\0' ? 1 : 0);
    }

    bool hasSignFlag() const { return hasPlus || hasBlank; }

private:
    char const* readFlags(char const* text) {
        for (;; ++text) {
            switch (*text) {
            case '-':
                isLeft = true;
                break;
            case '0':
                hasZeros = true;
                break;
            case '+':
                hasPlus = true;
                break;
            case ' ':
                hasBlank = true;
                break;
            default:
                return text;
            }
        }
    }

    static char const* readNumber(char const* text, int& number) {
        while (*text >= '0' && *text <= '9' && number <= LARGEST_NUMBER) number = number * 10 + (*text++ - '0');
        return text;
    }

    char const* readLength(char const* text) {
        switch (*text) {
        case 'h':
            length = text[1] == 'h' ? CHAR : SHORT;
            break;
        case 'l':
            length = text[1] == 'l' ? LONG_LONG : LONG;
            break;
        case 'z':
            length = SIZE;
            break;
        case 'j':
            length = MAXIMUM;
            break;
        case 't':
            length = DIFFERENCE;
            break;
        default:
            return text;
        }
        return text + (length == CHAR || length == LONG_LONG ? 2 : 1);
    }
};

} // namespace ZOR_Basis

#endif
