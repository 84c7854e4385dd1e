// The parts of qualified user names and of names of domains.

#include "zor_basis/system/sys.h"

#include "basis/ground/choices.h"
#include "basis/system/text_parts.h"

#include <cstring>

namespace ZOR_Basis {

bool Sys::ParseUser(Str const& full, BufStr<15>& user, BufStr<15>& domain) {
    if (full.empty()) {
        bool const known = CurrentUser(user, OF_THE_THREAD);
        CurrentDomain(domain, OF_THE_COMPUTER);
        return known;
    }
    BufStr<255> const text(full);
    char const* const end = text.c_str() + text.size();
    if (char const* const at = std::strchr(text, '@')) {
        setPart(user, text, at);
        setPart(domain, at + 1, end);
        return true;
    }
    char const* separator = std::strchr(text, '\\');
    if (separator == nullptr) separator = std::strchr(text, '/');
    if (separator != nullptr) {
        setPart(domain, text, separator);
        setPart(user, separator + 1, end);
        return true;
    }
    // kept sys-03: callers preset the domain that applies if the text has none.
    user = text;
    return false;
}

bool Sys::isCompositeName(Str const& name) {
    return static_cast<std::string_view>(name).find('.') != std::string_view::npos;
}

} // namespace ZOR_Basis
