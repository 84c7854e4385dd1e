/// \file
/// `HashedStr<HeapStr>`: a stored text with its hash, which comparisons check first.
///
///     HashedStr<HeapStr> const tray("tray1");
///     bool const same = tray.eq(name, hashDjb2(name, 0));
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_CONTAINERS_HASHED_STR_H
#define ZOR_BASIS_CONTAINERS_HASHED_STR_H

#include "zor_basis/export.h"
#include "zor_basis/ground/hashing.h"
#include "zor_basis/text/heap_str.h"
#include "zor_basis/text/str.h"

#include <cstdint>
#include <functional>
#include <string>

namespace ZOR_Basis {

template <class Text>
class HashedStr {
public:
    /// Constructs the empty text, or a copy of another, by the rules of the text type.
    HashedStr() { calcHash(); }
    HashedStr(char const* text) : text_(text) { calcHash(); }
    HashedStr(char const* text, std::uint64_t n) : text_(text, n) { calcHash(); }
    HashedStr(Str const& text) : text_(text) { calcHash(); }
    HashedStr(std::string const& text) : text_(text) { calcHash(); }
    HashedStr(HashedStr const& other) : text_(other.text_), hash_(other.hash_) {}

    /// Assigns a copy and calculates its hash.
    HashedStr& operator=(char const* text) { return assign(text); }
    HashedStr& operator=(Str const& text) { return assign(text); }
    HashedStr& operator=(std::string const& text) { return assign(text); }
    HashedStr& operator=(HashedStr const& other) {
        text_ = other.text_;
        hash_ = other.hash_;
        return *this;
    }
    /// Calls the text's own `set`.
    HashedStr& set(char const* text) { return assign(text); }
    HashedStr& set(char const* text, std::uint64_t n) {
        text_.set(text, n);
        calcHash();
        return *this;
    }
    /// Empties the text.
    void clear() {
        text_.clear();
        calcHash();
    }

    /// The text and its size, as of `str()`.
    char const* c_str() const { return text_.c_str(); }
    bool empty() const { return text_.empty(); }
    std::uint64_t size() const { return text_.size(); }
    /// `hashDjb2` of the text.
    std::uint64_t hash() const { return hash_; }
    /// The text. A caller that changes it through this reference must call `calcHash` afterwards.
    Text& str() { return text_; }
    Text const& str() const { return text_; }
    /// Calculates the hash of the present text.
    void calcHash() { hash_ = text_.hash(); }

    /// Compares by the rule of `Str`, without the hash.
    bool eq(Str const& text) const { return text_ == text; }
    /// The same after comparing hashes.
    /// \param hash  is that of `text`
    bool eq(Str const& text, std::uint64_t hash) const { return hash_ == hash && text_ == text; }

    /// Compares hashes first and then texts, by the rule of `Str`.
    bool operator==(HashedStr const& other) const { return this == &other || eq(other.text_, other.hash_); }
    bool operator!=(HashedStr const& other) const { return !(*this == other); }
    /// \kept hash-03: the order is by hash, and only for equal hashes by the bytes of the texts; it is not alphabetical
    bool operator<(HashedStr const& other) const {
        if (this == &other) return false;
        // kept hash-03: lists of these are searched, not shown.
        return hash_ != other.hash_ ? hash_ < other.hash_ : text_ < static_cast<Str const&>(other.text_);
    }

private:
    template <class Source>
    HashedStr& assign(Source const& source) {
        text_ = source;
        calcHash();
        return *this;
    }

    Text text_;
    std::uint64_t hash_;
};

ZB_EXTERN_TEMPLATE HashedStr<HeapStr>;

static_assert(sizeof(HashedStr<HeapStr>) == sizeof(HeapStr) + 8);

} // namespace ZOR_Basis

template <class Text>
struct std::hash<ZOR_Basis::HashedStr<Text>> {
    std::size_t operator()(ZOR_Basis::HashedStr<Text> const& text) const noexcept { return text.hash(); }
};

#endif
