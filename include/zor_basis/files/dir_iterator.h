/// \file
/// `DirIteratorW`: lists the entries of one directory by wide name.
///
///     DirIteratorW list(LOOK_FILES, ZB_W("jobs"));
///     while (WChar const* name = list->next()) use(name, list->size());
///
/// Entries come in the system's order, unsorted; hidden ones are included, "." and ".." are not. On Windows the system
/// matches the wildcard ("*.*" matches every name), on Linux `FPath::matchWildCard` does. On Linux a link counts as its
/// target, and a byte of a name that is not UTF-8 becomes U+DC80 to U+DCFF, which every function of this library that
/// takes wide paths converts back.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time

#ifndef ZOR_BASIS_FILES_DIR_ITERATOR_H
#define ZOR_BASIS_FILES_DIR_ITERATOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/files/wc_path.h"
#include "zor_basis/text/wb_str.h"

#include <cstdint>

namespace ZOR_Basis {

/// The interface of a listing on either system. `Make` creates one; a `DirIteratorW` holds one.
class ZB_API DirIterImplW {
public:
    virtual ~DirIterImplW() = default;
    DirIterImplW(DirIterImplW const&) = delete;
    DirIterImplW& operator=(DirIterImplW const&) = delete;

    /// Ends the listing; the next `next()` begins again in the same directory.
    virtual void finish() = 0;
    /// Returns the name of the next entry, valid until the next call.
    /// \return null at the end; `lastError()` then tells why
    virtual WChar const* next() = 0;
    /// \name What `next()` gave last
    /// \pre the last `next()` returned a name
    /// @{
    virtual bool isDir() = 0;
    virtual bool isFile() = 0;
    /// The time of the last write, in seconds since 1970 UTC.
    virtual std::int64_t time() = 0;
    /// The size in bytes; 0 for a directory.
    virtual std::uint64_t size() = 0;
    /// @}

    /// Makes a listing for this system.
    /// \return owned by the caller; null if memory runs out
    static DirIterImplW* Make(LookForType type, WChar const* path);

    /// Sets the directory to list.
    void setPath(WStr const& path);
    void setPath(WChar const* path) { setPath(WStr(path)); }
    /// Sets which entries to report; `LOOK_ANYCASE` has no effect here.
    void setType(LookForType type) { type_ = type; }
    /// Sets the names to report; empty means "*".
    void setWildCard(WStr const& wildcard) { wildcard_ = wildcard; }
    void setWildCard(WChar const* wildcard) { wildcard_ = wildcard; }
    /// The same in the local encoding; a text that cannot be converted means "*".
    void setWildCard(char const* wildcard);

    /// The directory.
    /// \kept list-dir-01: between the first `next()` and `finish()` the wildcard follows the directory
    WcPath const& getPath() const { return path_; }
    /// Tells why the listing ended: 0 if it has not, 18 at its normal end, 2 if no name matches the wildcard, 3 if
    /// there is no such directory, otherwise the system's code for the failure.
    std::uint32_t lastError() const { return lastError_; }

protected:
    /// Stores what to list; nothing is opened.
    DirIterImplW(LookForType type, WChar const* path) : path_(path), type_(type) {}

    /// Append the wildcard to the path for the duration of a listing, and remove it again.
    void appendWildCard();
    void removeWildCard();
    /// Tells whether entries of a kind are reported.
    bool isWanted(bool isDirectory) const;

    /// The directory, what to report of it, and the state of the listing.
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
    /// Makes a listing by `DirIterImplW::Make`.
    DirIteratorW(LookForType type, WChar const* path) : impl_(DirIterImplW::Make(type, path)) {}
    ~DirIteratorW() { delete impl_; }
    DirIteratorW(DirIteratorW const&) = delete;
    DirIteratorW& operator=(DirIteratorW const&) = delete;

    /// The listing; null if memory ran out.
    DirIterImplW* operator->() const { return impl_; }

private:
    DirIterImplW* impl_;
};

} // namespace ZOR_Basis

#endif
