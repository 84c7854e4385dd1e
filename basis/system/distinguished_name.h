/// \file
/// The distinguished names of a directory service: "CN=Jane Doe,OU=Print,DC=sales,DC=example".

#ifndef BASIS_SYSTEM_DISTINGUISHED_NAME_H
#define BASIS_SYSTEM_DISTINGUISHED_NAME_H

#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis {

/// The DNS domain of a distinguished name, made of its domain components: "sales.example"; empty without any.
inline BufStr<255> domainOfDistinguishedName(char const* name) {
    BufStr<255> domain;
    for (char const* part = name; *part != '\0';) {
        while (*part == ' ') ++part;
        char const* end = part;
        for (; *end != '\0' && *end != ','; ++end) {
            if (end[0] == '\\' && end[1] != '\0') ++end; // an escaped comma is part of the value
        }
        bool const isComponent = (part[0] | 0x20) == 'd' && (part[1] | 0x20) == 'c' && part[2] == '=';
        if (isComponent && end != part + 3) {
            if (!domain.empty()) domain += '.';
            domain.add(part + 3, static_cast<std::uint64_t>(end - part - 3));
        }
        part = *end == ',' ? end + 1 : end;
    }
    return domain;
}

} // namespace ZOR_Basis

#endif
