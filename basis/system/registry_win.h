/// \file
/// Keys of the registry, opened for queries only, and the texts in them.

#ifndef BASIS_SYSTEM_REGISTRY_WIN_H
#define BASIS_SYSTEM_REGISTRY_WIN_H

#include "basis/platform/windows_api_win.h"
#include "basis/system/text_parts.h"
#include "zor_basis/store/blob.h"
#include "zor_basis/text/buf_str.h"

#include <cstdint>

namespace ZOR_Basis {

/// Bytes with which a value is asked for.
inline constexpr std::uint64_t VALUE_ROOM = 512;

/// Makes the result of a call of the registry, which comes without, the last error if it is one.
/// \return whether it is none
bool told(LSTATUS result);

/// Makes room for what did not fit: as much as was reported, or twice as much where that is no more. The old bytes go.
/// \return false where that is more than any entry of the registry has
bool growBuffer(Blob& buffer, std::uint64_t reported);

/// Whether values of a type are texts.
bool isText(DWORD type);

class RegistryKey {
public:
    RegistryKey(HKEY parent, char const* path, REGSAM access = KEY_QUERY_VALUE);
    RegistryKey(RegistryKey const&) = delete;
    RegistryKey& operator=(RegistryKey const&) = delete;
    ~RegistryKey();

    bool isOpen() const { return key_ != nullptr; }
    operator HKEY() const { return key_; }

    bool has(char const* value) const;
    enum Growth { FIXED, ONCE };
    /// Reads a text. The size of the buffer becomes that of the value, in which the text may end earlier or lack its
    /// terminator.
    /// \param growth  whether a text longer than the buffer is asked for again
    bool read(char const* value, Blob& buffer, Growth growth) const;
    /// The same with a buffer of its own.
    /// \return false, with `out` as it was, where there is no such text
    template <std::uint64_t N>
    bool read(char const* value, BufStr<N>& out) const {
        Blob buffer;
        if (!read(value, buffer, FIXED)) return false;
        setBounded(out, buffer.val(), buffer.size());
        return true;
    }

private:
    HKEY key_ = nullptr;
};

} // namespace ZOR_Basis

#endif
