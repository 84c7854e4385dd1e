// The sibling is logon_win.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/system/identity_posix.h"
#include "basis/system/query_calls_posix.h"
#include "basis/system/secret_text.h"
#include "basis/text/wipe.h"

#include <security/pam_appl.h>

#include <cstdlib>
#include <cstring>
#include <memory>
#include <new>

namespace ZOR_Basis {
namespace {

constexpr char SERVICE[] = "zor_basis";

/// Always names a user: one that cannot be read is not logged on.
class PosixHdl final : public SysHdl {
public:
    explicit PosixHdl(Account const& account) : valid_(identity_.read(account)) {}
    bool isValid() override { return valid_; }
    Identity const& identity() const { return identity_; }

private:
    Identity identity_;
    bool valid_;
};

/// The identity to which an acting thread returns; none while it is itself.
thread_local std::unique_ptr<Identity> ownIdentity;

void release(pam_response* answers, int n) {
    for (int i = 0; i < n; ++i) {
        if (answers[i].resp != nullptr) wipe(answers[i].resp, std::strlen(answers[i].resp));
        std::free(answers[i].resp);
    }
    std::free(answers);
}

/// Answers the questions of the modules: with the password those whose answer is not shown, and no others.
int converse(int n, pam_message const** messages, pam_response** out, void* password) {
    if (n <= 0 || n > PAM_MAX_NUM_MSG) return PAM_CONV_ERR;
    auto* const answers = static_cast<pam_response*>(std::calloc(static_cast<std::size_t>(n), sizeof(pam_response)));
    if (answers == nullptr) return PAM_BUF_ERR;
    for (int i = 0; i < n; ++i) {
        if (messages[i]->msg_style != PAM_PROMPT_ECHO_OFF) continue;
        answers[i].resp = strdup(static_cast<char const*>(password));
        if (answers[i].resp != nullptr) continue;
        release(answers, n);
        return PAM_BUF_ERR;
    }
    // Modules that only display a message may expect no answer.
    if (out != nullptr) {
        *out = answers;
    } else {
        release(answers, n);
    }
    return PAM_SUCCESS;
}

/// One conversation with the modules.
class Pam {
public:
    Pam(char const* user, SecretText const& password)
        : conversation_{converse, const_cast<char*>(static_cast<char const*>(password))},
          result_(queryCalls.pamStart(SERVICE, user, &conversation_, &handle_)) {}
    Pam(Pam const&) = delete;
    Pam& operator=(Pam const&) = delete;
    ~Pam() {
        if (handle_ == nullptr) return;
        KeepLastError const keep;
        pam_end(handle_, result_);
    }

    bool admits() {
        if (handle_ != nullptr && result_ == PAM_SUCCESS) {
            result_ = pam_authenticate(handle_, PAM_SILENT | PAM_DISALLOW_NULL_AUTHTOK);
            if (result_ == PAM_SUCCESS) result_ = pam_acct_mgmt(handle_, PAM_SILENT);
            if (result_ == PAM_SUCCESS) return true;
        }
        // The codes of the modules say no more than this.
        return refuse(result_ == PAM_BUF_ERR ? Reason::NO_MEMORY : Reason::LOGON_REFUSED);
    }

    /// The account's name, which modules may have changed.
    char const* user() const {
        void const* name = nullptr;
        return pam_get_item(handle_, PAM_USER, &name) == PAM_SUCCESS && name != nullptr ? static_cast<char const*>(name)
                                                                                        : "";
    }

private:
    pam_handle_t* handle_ = nullptr;
    pam_conv conversation_;
    int result_;
};

} // namespace

SysHdl* Sys::loginUser(Str const& user, Str const& password, bool) {
    if (user.empty()) {
        refuse(Reason::BAD_ARGUMENT);
        return nullptr;
    }
    revertToSelf();
    BufStr<15> name, domain;
    if (ParseUser(user, name, domain) && !domain.empty()) name.add("@").add(domain);
    SecretText const secret(password);
    Pam pam(name, secret);
    Account account;
    if (!pam.admits() || !findAccount(pam.user(), account)) return nullptr;
    std::unique_ptr<PosixHdl> handle(new (std::nothrow) PosixHdl(account));
    return handle != nullptr && handle->isValid() ? handle.release() : nullptr;
}

bool Sys::impersonate(SysHdl* handle) {
    if (!revertToSelf()) return false;
    if (handle == nullptr) return true;
    if (!handle->isValid()) return refuse(Reason::NOT_OPEN);
    std::unique_ptr<Identity> own(new (std::nothrow) Identity);
    if (own == nullptr) return refuse(Reason::NO_MEMORY);
    if (!own->readOwn() || !static_cast<PosixHdl*>(handle)->identity().take(*own)) return false;
    ownIdentity = std::move(own);
    return true;
}

bool Sys::revertToSelf() {
    if (ownIdentity == nullptr) return true;
    if (!ownIdentity->takeBack()) return false;
    ownIdentity.reset();
    return true;
}

} // namespace ZOR_Basis
