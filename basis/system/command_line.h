/// \file
/// The words of a command line, as the runtime library of Windows finds them.
///
/// - Blanks and tabs outside of double quotes separate words.
/// - The first word is a program: a double quote in it begins or ends a quoted part, and nothing else is special.
/// - In the others a double quote does so, too. Inside a quoted part two of them are one that is meant. Backslashes are
///   special before a double quote only: two stand for one, and one makes the double quote a character.

#ifndef BASIS_SYSTEM_COMMAND_LINE_H
#define BASIS_SYSTEM_COMMAND_LINE_H

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace ZOR_Basis {

class CommandLine {
public:
    /// \param text  not null; an empty one has one empty word
    explicit CommandLine(char const* text) {
        std::size_t const length = std::strlen(text);
        // Each word behind the first takes a separator and a character at least; the list ends in a null.
        std::size_t const pointers = length / 2 + 2;
        block_.reset(static_cast<char**>(std::malloc(pointers * sizeof(char*) + length + 1)));
        if (block_ == nullptr) return;
        out_ = reinterpret_cast<char*>(block_.get() + pointers);
        split(text);
    }

    /// The words, with a null behind them, as programs get them; null where memory is short.
    char* const* words() const { return block_.get(); }
    std::size_t size() const { return size_; }

private:
    struct Free {
        void operator()(char** block) const { std::free(block); }
    };

    static bool isSeparator(char c) { return c == ' ' || c == '\t'; }

    void split(char const* text) {
        begin();
        text = copyProgram(text);
        for (;;) {
            while (isSeparator(*text)) ++text;
            if (*text == '\0') break;
            begin();
            text = copyWord(text);
        }
        block_.get()[size_] = nullptr;
    }

    void begin() { block_.get()[size_++] = out_; }

    char const* copyProgram(char const* text) {
        bool quoted = false;
        for (; *text != '\0' && (quoted || !isSeparator(*text)); ++text) {
            if (*text == '"') {
                quoted = !quoted;
            } else {
                *out_++ = *text;
            }
        }
        *out_++ = '\0';
        return text;
    }

    char const* copyWord(char const* text) {
        bool quoted = false;
        while (*text != '\0' && (quoted || !isSeparator(*text))) {
            std::size_t backslashes = std::strspn(text, "\\");
            text += backslashes;
            bool const beforeQuote = *text == '"';
            bool const literal = beforeQuote && backslashes % 2 != 0;
            if (beforeQuote) backslashes /= 2;
            std::memset(out_, '\\', backslashes);
            out_ += backslashes;
            if (!beforeQuote || literal) {
                // The loop handles separators and the end.
                if (*text != '\0' && (quoted || !isSeparator(*text))) *out_++ = *text++;
            } else if (quoted && text[1] == '"') {
                *out_++ = '"';
                text += 2;
            } else {
                quoted = !quoted;
                ++text;
            }
        }
        *out_++ = '\0';
        return text;
    }

    std::unique_ptr<char*, Free> block_;
    char* out_ = nullptr;
    std::size_t size_ = 0;
};

} // namespace ZOR_Basis

#endif
