// Any bytes as a text that is read line by line. The first byte says how much is asked for at a time, the next ones by
// which calls; what they give is what reading a character at a time gives.

#include "fuzz/target.h"

#include <zor_basis/system/parse.h>

#include <algorithm>
#include <cctype>
#include <cstring>
#include <memory>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::size_t CALLS = 8;
constexpr std::size_t LONGEST_COMPARED = 256;

bool endsLine(char c) { return c == '\n' || c == '\r'; }

class Model {
public:
    explicit Model(std::string const& text) : text_(text) {}

    bool isEnd() const { return at_ == text_.size(); }
    char skipBlanks() {
        char last = '\0';
        for (; !isEnd(); ++at_) {
            last = text_[at_];
            if (std::isspace(static_cast<unsigned char>(last)) == 0) break;
        }
        return last;
    }
    std::string line(std::size_t maximum) {
        skipBlanks();
        std::size_t const start = at_;
        while (!isEnd() && at_ - start < maximum && text_[at_] != '\0' && !endsLine(text_[at_])) ++at_;
        return text_.substr(start, at_ - start);
    }
    bool isAtLineEnd() const { return !isEnd() && endsLine(text_[at_]); }

private:
    std::string text_;
    std::size_t at_ = 0;
};

void requireLine(ZB_Parse& parse, Model& model, int maximum) {
    auto const room = static_cast<std::size_t>(maximum) + 1;
    std::unique_ptr<char[]> const out(new char[room]);
    int length = -1;
    bool const whole = parse.getLine(maximum, out.get(), &length);
    std::string const line = model.line(room - 1);
    require(line == out.get());
    require(line.size() == static_cast<std::size_t>(length));
    require(whole == model.isAtLineEnd());
}

void runParse(unsigned char const* data, std::size_t size) {
    if (size <= CALLS) return;
    int const maximum = data[0];
    std::string const text(reinterpret_cast<char const*>(data) + 1 + CALLS, size - 1 - CALLS);
    // A block of its own: nothing behind it may be read.
    std::unique_ptr<char[]> const own(new char[text.size()]);
    std::copy(text.begin(), text.end(), own.get());
    ZB_Parse parse(own.get(), static_cast<int>(text.size()));
    Model model(text);
    for (std::size_t i = 0; i < 3 * CALLS; ++i) {
        require(parse.isDataEnd() == model.isEnd());
        unsigned const call = data[1 + i % CALLS];
        if (call % 3 == 0) {
            requireLine(parse, model, maximum);
        } else if (call % 3 == 1) {
            require(parse.skipBlanks() == model.skipBlanks());
        } else {
            std::string expected = model.line(LONGEST_COMPARED);
            if (call % 2 == 0) expected += 'x';
            require(parse.checkLine(expected.c_str()) == (call % 2 != 0));
        }
    }
}

FuzzTarget const PARSE("parse", runParse);

} // namespace
