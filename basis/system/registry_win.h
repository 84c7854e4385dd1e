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

/// The size of the first buffer for a value, in bytes.
inline constexpr std::uint64_t VALUE_ROOM = 512;

/// Makes the result of a registry call the last error if the call failed; these calls do not set it themselves.
/// \return whether the call succeeded
bool told(LSTATUS result);

/// Enlarges the buffer to the reported size, or to twice its size if the report is no larger. The bytes are lost.
/// \return false if no entry of the registry can be so large
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
    /// \param growth  decides whether a text longer than the buffer is read again into a larger one
    bool read(char const* value, Blob& buffer, Growth growth) const;
    /// The same with a buffer of its own.
    /// \return false if there is no such text; `out` is then unchanged
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
