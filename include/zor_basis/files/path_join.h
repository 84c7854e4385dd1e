/// \file
/// The step by which paths grow: a component with a separator before it. Not meant for users.

#ifndef ZOR_BASIS_FILES_PATH_JOIN_H
#define ZOR_BASIS_FILES_PATH_JOIN_H

#include "zor_basis/text/inline_text.h"

#include <cstdint>

namespace ZOR_Basis::detail {

/// Appends a component, with "/" before it if `separate` is true. Allocates one block at most, of exactly the new
/// length.
template <class String, class Char>
void joinPath(String& path, Char const* text, std::uint64_t len, bool separate) {
    using Text = InlineText<String, Char, 255>;
    if (isNothing(text)) return;
    bool const measured = len == 0;
    if (measured) len = textLength(text);
    std::uint64_t const oldSize = path.size();
    std::uint64_t const start = oldSize + (separate ? 1 : 0);
    if (start + len > path.sizeBuf()) {
        if (Text::holds(path, text)) {
            String const kept(text, len);
            joinPath(path, kept.operator Char const*(), kept.size(), separate);
            return;
        }
        path.extendBuf(start + len);
    }
    // The component first: it may lie in the path, whose terminator the separator then overwrites.
    if (measured) {
        MoveMeasured::copy(path.getBuf() + start, text, len);
    } else {
        StopAtTerminator::copy(path.getBuf() + start, text, len);
    }
    if (separate) path.getBuf()[oldSize] = Char('/');
    Text::setSize(path, start + len);
}

} // namespace ZOR_Basis::detail

#endif
