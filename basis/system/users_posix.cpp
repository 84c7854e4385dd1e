// The sibling is users_win.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/ground/choices.h"
#include "basis/system/accounts_posix.h"
#include "basis/system/query_calls_posix.h"
#include "basis/system/text_parts.h"

#include <utmpx.h>

#include <cstdio>
#include <cstring>
#include <memory>

namespace ZOR_Basis {
namespace {

bool readName(uid_t user, BufStr<15>& name) {
    Account account;
    if (!findAccount(user, account)) return false;
    name = account.name;
    return true;
}

/// Whether a record is that of a user at a text or a graphical terminal of this machine.
bool isAtMachine(utmpx const& record) {
    bool const isTerminal = std::strncmp(record.ut_line, "tty", 3) == 0 || record.ut_line[0] == ':';
    return record.ut_type == USER_PROCESS && record.ut_user[0] != '\0' && isTerminal;
}

struct Close {
    void operator()(std::FILE* file) const { std::fclose(file); }
};

bool readSessionUser(BufStr<15>& name) {
    std::unique_ptr<std::FILE, Close> const file(std::fopen(queryCalls.sessions, "rbe"));
    utmpx record;
    while (file != nullptr && std::fread(&record, sizeof record, 1, file.get()) == 1) {
        if (!isAtMachine(record)) continue;
        setBounded(name, record.ut_user, sizeof record.ut_user);
        return true;
    }
    return false;
}

} // namespace

bool Sys::CurrentUser(BufStr<15>& user, bool loggedOn) {
    user.clear();
    return readName(loggedOn ? queryCalls.realUser() : queryCalls.effectiveUser(), user);
}

bool Sys::CurrentDomain(BufStr<15>& domain, bool fromUser) {
    domain.clear();
    bool const known = queryCalls.resolverDomain(domain);
    if (!known) domain.clear();
    if (!fromUser) return known;
    domain.toLower();
    // kept sys-01: most users belong to no domain, which is no failure.
    return true;
}

bool Sys::DefaultLogin(BufStr<15>& login) {
    login.clear();
    return refuse(Reason::NOT_SUPPORTED);
}

bool Sys::CurHumanUser(BufStr<15>& user) {
    user.clear();
    return readSessionUser(user) || CurrentUser(user, OF_THE_THREAD);
}

} // namespace ZOR_Basis
