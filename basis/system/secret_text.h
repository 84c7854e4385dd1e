/// \file
/// A terminated copy of a secret, for the system; wiped at its end.

#ifndef BASIS_SYSTEM_SECRET_TEXT_H
#define BASIS_SYSTEM_SECRET_TEXT_H

#include "basis/ground/choices.h"
#include "zor_basis/store/blob.h"
#include "zor_basis/text/str.h"

namespace ZOR_Basis {

class SecretText {
public:
    explicit SecretText(Str const& text) {
        bytes_.alloc(text.size() + 1, DISCARDING_BYTES);
        if (bytes_.sizeBuf() <= text.size()) return;
        bytes_.add(text.size(), text);
        bytes_.add(1, "");
    }
    SecretText(SecretText const&) = delete;
    SecretText& operator=(SecretText const&) = delete;

    /// The empty text where memory is short.
    operator char const*() const { return bytes_.size() != 0 ? bytes_.val() : ""; }

private:
    SecretBlob bytes_;
};

} // namespace ZOR_Basis

#endif
