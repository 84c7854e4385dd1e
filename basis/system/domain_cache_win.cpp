// The sibling is domain_cache_posix.cpp.

#include "zor_basis/system/sys.h"

#include "basis/ground/choices.h"
#include "basis/system/query_calls_win.h"
#include "basis/system/registry_win.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr char DOMAIN_CACHE[] = "SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion\\Winlogon\\DomainCache";

/// One domain of the cache; the blobs' sizes are those of the names.
struct Entry {
    Blob shortName;
    Blob fullName;
};

/// Makes room in the buffers that were reported too small, or in both where neither was.
bool grow(Entry& entry, std::uint64_t nameLength, std::uint64_t dataLength) {
    bool const nameFits = nameLength <= entry.shortName.sizeBuf();
    bool const dataFits = dataLength <= entry.fullName.sizeBuf();
    bool const unknown = nameFits && dataFits;
    if ((!nameFits || unknown) && !growBuffer(entry.shortName, nameLength)) return false;
    return (dataFits && !unknown) || growBuffer(entry.fullName, dataLength);
}

void setLength(Blob& name, std::uint64_t n) { name.setSize(n != 0 ? detail::textLengthUpTo(name.val(), n) : 0); }

/// Reads the value at an index. \return false where there are no more
bool read(HKEY key, DWORD index, Entry& entry, DWORD& type) {
    for (;;) {
        DWORD nameLength = static_cast<DWORD>(entry.shortName.sizeBuf());
        DWORD dataLength = static_cast<DWORD>(entry.fullName.sizeBuf());
        LSTATUS const result = queryCalls.enumValue(key, index, entry.shortName.buf(), &nameLength, nullptr, &type,
                                                    reinterpret_cast<BYTE*>(entry.fullName.buf()), &dataLength);
        if (result == ERROR_SUCCESS) {
            setLength(entry.shortName, nameLength);
            setLength(entry.fullName, dataLength);
            return true;
        }
        if (result != ERROR_MORE_DATA || !grow(entry, nameLength, dataLength)) return told(result);
    }
}

bool isSame(Blob const& a, Str const& b) {
    return a.size() == b.size() && (b.empty() || std::memcmp(a.val(), b, b.size()) == 0);
}

/// Finds an entry by one of its names and returns the other.
bool translate(Str const& given, BufStr<255>& domain, Blob Entry::*from, Blob Entry::*to) {
    RegistryKey const key(HKEY_LOCAL_MACHINE, DOMAIN_CACHE);
    if (!key.isOpen()) return false;
    Entry entry;
    entry.shortName.alloc(VALUE_ROOM, DISCARDING_BYTES);
    entry.fullName.alloc(VALUE_ROOM, DISCARDING_BYTES);
    DWORD type = REG_NONE;
    for (DWORD index = 0; read(key, index, entry, type); ++index) {
        // kept sys-04: compared byte by byte, because the names go on to services for which case may matter.
        if (!isText(type) || !isSame(entry.*from, given)) continue;
        setBounded(domain, (entry.*to).val(), (entry.*to).size());
        return true;
    }
    return false;
}

} // namespace

bool Sys::FullDomain(Str const& name, BufStr<255>& domain) {
    return translate(name, domain, &Entry::shortName, &Entry::fullName);
}

bool Sys::ShortDomain(Str const& name, BufStr<255>& domain) {
    return translate(name, domain, &Entry::fullName, &Entry::shortName);
}

} // namespace ZOR_Basis
