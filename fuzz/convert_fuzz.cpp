// Any bytes as UTF-8 and as UTF-16: the results are those of the second reading, and valid text survives a round trip.

#include "fuzz/target.h"

#include <zor_basis/text/convert.h>

#include "tests/text/reference_utf.h"

#include <cstring>

using namespace ZOR_Basis;

namespace {

void readAsUtf8(std::string const& text) {
    auto const expected = reference::characters(text);
    WBStr wide;
    require(Convert::Utf8ToWide(text.c_str(), wide, text.size()) == expected.has_value());
    require(reference::WideText(wide.wstr(), wide.size()) ==
            (expected ? reference::utf16(*expected) : reference::WideText()));
    if (!expected) return;
    BufStr<255> back;
    require(Convert::WideToUtf8(wide, back));
    require(std::strcmp(back.c_str(), text.c_str()) == 0);
}

void readAsUtf16(std::string const& text) {
    reference::WideText units(text.size() / sizeof(WChar), WChar{});
    std::memcpy(units.data(), text.data(), units.size() * sizeof(WChar));
    units = units.substr(0, units.find(WChar{}));
    if (units.empty()) return;
    BufStr<255> narrow;
    require(Convert::WideToUtf8(units.c_str(), narrow, units.size()));
    require(std::string(narrow.c_str(), narrow.size()) == reference::utf8(reference::characters(units)));
}

void runConvert(unsigned char const* data, std::size_t size) {
    if (size == 0) return;
    std::string const text(reinterpret_cast<char const*>(data), size);
    readAsUtf8(text);
    readAsUtf16(text);
}

FuzzTarget const CONVERT("convert", runConvert);

} // namespace
