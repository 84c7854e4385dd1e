/// \file
/// `DirIteratorW`: lists one directory by wide names.
///
///     DirIteratorW list(LOOK_FILES, folder);
///     while (WChar const* name = list->next()) use(name, list->size());
///
/// Entries come in the order of the system, unsorted, hidden ones included, "." and ".." never. The wildcard is the
/// system's own under Windows (where "*.*" takes every name) and the one of `FPath::matchWildCard` on Linux, where a link
/// is what it leads to, and a byte of a name that is not UTF-8 becomes U+DC80 to U+DCFF, which every function of this
/// library that takes wide paths turns back.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time

#ifndef ZOR_BASIS_FILES_DIR_ITERATOR_H
#define ZOR_BASIS_FILES_DIR_ITERATOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/files/wc_path.h"
#include "zor_basis/text/wb_str.h"

#include <cstdint>

namespace ZOR_Basis {

/// What a listing is, whatever the system. Made by `Make`, or held by a `DirIteratorW`.
class ZB_API DirIterImplW {
public:
    virtual ~DirIterImplW() = default;
    DirIterImplW(DirIterImplW const&) = delete;
    DirIterImplW& operator=(DirIterImplW const&) = delete;

    /// Ends a listing, so that the next `next()` begins again in the same directory.
    virtual void finish() = 0;
    /// The name of the next entry, valid until the next call.
    /// \return null at the end, when `lastError()` tells why
    virtual WChar const* next() = 0;
    /// \name What `next()` gave last
    /// \pre it gave a name
    /// @{
    virtual bool isDir() = 0;
    virtual bool isFile() = 0;
    /// Last write, seconds since 1970 UTC.
    virtual std::int64_t time() = 0;
    /// Bytes; 0 for a directory.
    virtual std::uint64_t size() = 0;
    /// @}

    /// A listing of the system's kind. \return owned by the caller; null when memory runs out
    static DirIterImplW* Make(LookForType type, WChar const* path);

    void setPath(WStr const& path);
    void setPath(WChar const* path) { setPath(WStr(path)); }
    /// Which entries to report; `LOOK_ANYCASE` is ignored here.
    void setType(LookForType type) { type_ = type; }
    /// The names to report; empty means "*".
    void setWildCard(WStr const& wildcard) { wildcard_ = wildcard; }
    void setWildCard(WChar const* wildcard) { wildcard_ = wildcard; }
    /// The same in the local encoding; what cannot be converted means "*".
    void setWildCard(char const* wildcard);

    /// The directory.
    /// \kept list-dir-01: from the first `next()` to `finish()` with the wildcard behind it
    WcPath const& getPath() const { return path_; }
    /// Why the listing ended: 0 while it has not, 18 at its normal end, 2 where no name fits the wildcard, 3 where there is
    /// no such directory, else the system's own code for the failure.
    std::uint32_t lastError() const { return lastError_; }

protected:
    DirIterImplW(LookForType type, WChar const* path) : path_(path), type_(type) {}

    /// Appends the wildcard to the path for the length of a listing, and takes it away again.
    void appendWildCard();
    void removeWildCard();
    /// Whether entries of a kind are reported.
    bool isWanted(bool isDirectory) const;

    WcPath path_;
    LookForType type_;
    WBStr wildcard_;
    bool first_ = true;
    std::uint32_t lastError_ = 0;

private:
    static constexpr std::uint64_t NOT_APPENDED = ~std::uint64_t{0};
    std::uint64_t directoryLength_ = NOT_APPENDED;
};

/// Owns a listing.
class ZB_API DirIteratorW {
public:
    DirIteratorW(LookForType type, WChar const* path) : impl_(DirIterImplW::Make(type, path)) {}
    ~DirIteratorW() { delete impl_; }
    DirIteratorW(DirIteratorW const&) = delete;
    DirIteratorW& operator=(DirIteratorW const&) = delete;

    /// Null when memory ran out.
    DirIterImplW* operator->() const { return impl_; }

private:
    DirIterImplW* impl_;
};

} // namespace ZOR_Basis

#endif
