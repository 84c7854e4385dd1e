// The sibling is logon_posix.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/system/query_calls_win.h"
#include "basis/system/secret_text.h"

#include <cstdint>
#include <new>

#ifndef LOGON32_LOGON_NEW_CREDENTIALS
#define LOGON32_LOGON_NEW_CREDENTIALS 9
#endif

namespace ZOR_Basis {
namespace {

/// The token of a user, or all ones.
class WinHdl final : public SysHdl {
public:
    explicit WinHdl(HANDLE token) : token_(reinterpret_cast<std::uint64_t>(token)) {}
    ~WinHdl() override {
        if (!isValid()) return;
        KeepLastError const keep;
        queryCalls.closeHandle(token());
    }
    bool isValid() override { return token_ != NONE; }
    HANDLE token() const { return reinterpret_cast<HANDLE>(token_); }

private:
    static constexpr std::uint64_t NONE = ~std::uint64_t{0};

    std::uint64_t token_;
};

static_assert(sizeof(WinHdl) == 16 && sizeof(HANDLE) == sizeof(std::uint64_t));

} // namespace

SysHdl* Sys::loginUser(Str const& user, Str const& password, bool interactive) {
    if (user.empty()) {
        refuse(Reason::BAD_ARGUMENT);
        return nullptr;
    }
    queryCalls.revertToSelf();
    BufStr<15> name, domain;
    bool const hasDomain = ParseUser(user, name, domain);
    SecretText const secret(password);
    HANDLE token = nullptr;
    DWORD const kind = interactive ? LOGON32_LOGON_INTERACTIVE : LOGON32_LOGON_NEW_CREDENTIALS;
    if (queryCalls.logonUser(name, hasDomain ? domain.c_str() : nullptr, secret, kind, LOGON32_PROVIDER_WINNT50,
                             &token) == FALSE) {
        return nullptr;
    }
    SysHdl* const handle = new (std::nothrow) WinHdl(token);
    if (handle != nullptr) return handle;
    queryCalls.closeHandle(token);
    refuse(Reason::NO_MEMORY);
    return nullptr;
}

bool Sys::impersonate(SysHdl* handle) {
    queryCalls.revertToSelf();
    if (handle == nullptr) return true;
    if (!handle->isValid()) return refuse(Reason::NOT_OPEN);
    return queryCalls.impersonate(static_cast<WinHdl*>(handle)->token()) != FALSE;
}

bool Sys::revertToSelf() { return queryCalls.revertToSelf() != FALSE; }

} // namespace ZOR_Basis
