/// \file
/// The wildcard rule of paths and listings. Internal and header-only, so that the library and the stand-alone platform
/// layer apply one and the same.
///
/// Pattern and name are walked side by side. In this order: where both stand on a slash (either kind), the whole run of
/// slashes is passed in both; equal characters are passed, and "?" passes any one character; a "*" tries what follows
/// it here, then one character further on, and so on, but never at the end of the name. A "*" that ends the pattern
/// takes everything left. Where the name ends, only "*"s may be left of the pattern. Two results of this are easily
/// overlooked: a slash run in the pattern never takes a part of a run in the name, and a "*" that meets a "*" in the
/// name is an equal character, no wildcard: "*" does not match "*a".

#ifndef BASIS_GROUND_WILDCARD_H
#define BASIS_GROUND_WILDCARD_H

#include <cctype>
#include <cstddef>
#include <cstring>
#include <string>
#include <type_traits>

namespace ZOR_Basis {

/// How two characters are compared: as they are.
struct ExactCase {
    template <class Char>
    static Char fold(Char character) noexcept {
        return character;
    }
};

/// How two characters are compared: upper-cased byte by byte.
struct AnyCase {
    static char fold(char character) noexcept {
        return static_cast<char>(std::toupper(static_cast<unsigned char>(character)));
    }
};

namespace Detail {

/// Matches one name against one pattern. The time is at most proportional to the product of their lengths; no memory is
/// allocated.
///
/// The match goes back only to the last "*" that it took as a wildcard. That loses nothing: each step of the rule leads
/// from a later place in the name to a later or the same place, so the last "*" has already tried all that an earlier
/// one could still reach behind it.
template <class Case, class Char>
class WildcardMatch {
public:
    WildcardMatch(Char const* pattern, Char const* patternEnd, Char const* name, Char const* nameEnd) noexcept
        : pattern_(pattern), patternEnd_(patternEnd), name_(name), nameEnd_(nameEnd) {}

    bool run() noexcept {
        if (isSameText()) return true;
        if (!fixedTailFits()) return false;
        if (tail_ == pattern_) return patternEnd_ - pattern_ == nameEnd_ - name_;
        while (name_ != nameEnd_) {
            if (onSlashes()) {
                if (!passSlashes() && !retry()) return false;
            } else if (pattern_ != patternEnd_ && equal(*pattern_, *name_)) {
                ++pattern_;
                ++name_;
            } else if (pattern_ != patternEnd_ && *pattern_ == Char('*')) {
                // kept path-06: only here is a "*" a wildcard, so never where the name has ended or has one too.
                ++pattern_;
                if (pattern_ == patternEnd_) return true;
                if (pattern_ == tail_) return nameEnd_ - name_ >= patternEnd_ - tail_;
                rememberStar();
                if (!findStart()) return false;
            } else if (!retry()) {
                return false;
            }
        }
        while (pattern_ != patternEnd_ && *pattern_ == Char('*')) ++pattern_;
        return pattern_ == patternEnd_;
    }

private:
    static bool isSlash(Char character) noexcept { return character == Char('/') || character == Char('\\'); }

    static bool equal(Char wanted, Char found) noexcept {
        return wanted == Char('?') || wanted == found || Case::fold(wanted) == Case::fold(found);
    }

    /// Of two equal texts each step passes the same in both, whatever characters they have.
    bool isSameText() const noexcept {
        std::ptrdiff_t const size = nameEnd_ - name_;
        return patternEnd_ - pattern_ == size &&
               std::memcmp(pattern_, name_, static_cast<std::size_t>(size) * sizeof(Char)) == 0;
    }

    /// The pattern's last characters without "*" and slash take one character of the name each, its last ones.
    bool fixedTailFits() noexcept {
        tail_ = patternEnd_;
        Char const* last = nameEnd_;
        while (tail_ != pattern_ && tail_[-1] != Char('*') && !isSlash(tail_[-1])) {
            --tail_;
            if (last == name_ || !equal(*tail_, *--last)) return false;
        }
        return true;
    }

    bool onSlashes() const noexcept { return pattern_ != patternEnd_ && isSlash(*pattern_) && isSlash(*name_); }

    /// \return false when an earlier try went on from the end of this very run, in vain
    bool passSlashes() noexcept {
        if (firstSlash_ == nullptr) firstSlash_ = pattern_;
        bool const first = firstSlash_ == pattern_;
        if (first && runEnd_ != nullptr && name_ < runEnd_) return false;
        while (pattern_ != patternEnd_ && isSlash(*pattern_)) ++pattern_;
        while (name_ != nameEnd_ && isSlash(*name_)) ++name_;
        if (first) runEnd_ = name_;
        return true;
    }

    /// The "*" just passed becomes the one to go back to.
    void rememberStar() noexcept {
        behindStar_ = pattern_;
        start_ = name_;
        firstSlash_ = nullptr;
        runEnd_ = nullptr;
    }

    /// Goes back to the last "*", one character further on.
    /// \return false: there is no such "*", or the name ends
    bool retry() noexcept {
        if (behindStar_ == nullptr || ++start_ == nameEnd_) return false;
        pattern_ = behindStar_;
        return findStart();
    }

    /// Goes on to the next character that what follows the "*" can begin with.
    /// \return false: there is none
    bool findStart() noexcept {
        Char const wanted = *behindStar_;
        if (wanted != Char('?') && wanted != Char('*') && !isSlash(wanted)) {
            if constexpr (std::is_same_v<Case, ExactCase>) {
                start_ = std::char_traits<Char>::find(start_, static_cast<std::size_t>(nameEnd_ - start_), wanted);
                if (start_ == nullptr) return false;
            } else {
                while (start_ != nameEnd_ && !equal(wanted, *start_)) ++start_;
                if (start_ == nameEnd_) return false;
            }
        }
        name_ = start_;
        return true;
    }

    Char const* pattern_;
    Char const* patternEnd_;
    Char const* name_;
    Char const* nameEnd_;
    /// Where the fixed end of the pattern begins.
    Char const* tail_ = nullptr;
    /// What follows the last "*", and where in the name it was tried last.
    Char const* behindStar_ = nullptr;
    Char const* start_ = nullptr;
    /// The first slash run behind the last "*", and the end of the run in the name that it passed last. Every try that
    /// comes to the same run would go on from the same place, so a run is passed there once only.
    Char const* firstSlash_ = nullptr;
    Char const* runEnd_ = nullptr;
};

} // namespace Detail

/// Whether the name of `nameSize` characters matches the pattern of `patternSize` characters.
/// \cost at most the product of both lengths, mostly their sum
template <class Case = ExactCase, class Char>
bool matchesWildcard(Char const* pattern, std::size_t patternSize, Char const* name, std::size_t nameSize) noexcept {
    return Detail::WildcardMatch<Case, Char>(pattern, pattern + patternSize, name, name + nameSize).run();
}

/// The same for two zero-terminated texts.
template <class Case = ExactCase, class Char>
bool matchesWildcard(Char const* pattern, Char const* name) noexcept {
    using Traits = std::char_traits<Char>;
    return matchesWildcard<Case>(pattern, Traits::length(pattern), name, Traits::length(name));
}

} // namespace ZOR_Basis

#endif
