// Any bytes as operations on strings, after each of which the string is what its model is. The first byte says which
// kind of string.

#include "fuzz/target.h"
#include "tests/text/inline_text_steps.h"

using namespace ZOR_Basis;

namespace {

constexpr std::size_t LONGEST = 4000;

template <class String>
void change(RandomBytes const& bytes) {
    inline_text::InlineTextBesideModel<String, RandomBytes> both(bytes);
    while (!both.random.isUsedUp()) {
        drawnFor(both).act(both);
        require(both.agree());
        // A text that is added to itself over and over takes minutes.
        if (both.model->content.size() > LONGEST) both.makeEmpty();
    }
}

void runTexts(unsigned char const* data, std::size_t size) {
    RandomBytes bytes(data, size);
    switch (bytes.byte() % 3) {
    case 0:
        return change<BufStr<15>>(bytes);
    case 1:
        return change<BufStr<255>>(bytes);
    default:
        return change<WBStr>(bytes);
    }
}

FuzzTarget const TEXTS("texts", runTexts);

} // namespace
