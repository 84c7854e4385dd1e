#include "basis/system/accounts_posix.h"

#include "basis/files/last_error.h"
#include "basis/ground/choices.h"
#include "basis/system/query_calls_posix.h"
#include "zor_basis/store/blob.h"

#include <cerrno>

namespace ZOR_Basis {
namespace {

constexpr std::size_t ROOM = 1024;
constexpr std::uint64_t MOST_ROOM = 1024 * 1024;

/// \param ask  called with the record, a buffer for its texts and that buffer's size, until there is room
template <class Ask>
bool find(Account& account, Ask ask) {
    passwd record;
    passwd* found = nullptr;
    char first[ROOM];
    int result = ask(&record, first, sizeof first, &found);
    Blob larger;
    for (std::uint64_t room = 4 * ROOM; result == ERANGE && room <= MOST_ROOM; room *= 4) {
        larger.alloc(room, DISCARDING_BYTES);
        result = ask(&record, larger.buf(), larger.sizeBuf(), &found);
    }
    if (result != 0) errno = result;
    if (result != 0 || found == nullptr) return result == 0 && refuse(Reason::NOT_FOUND);
    account.name = found->pw_name;
    account.user = found->pw_uid;
    account.group = found->pw_gid;
    return true;
}

} // namespace

bool findAccount(uid_t user, Account& account) {
    return find(account, [=](passwd* record, char* buffer, std::size_t n, passwd** found) {
        return queryCalls.userById(user, record, buffer, n, found);
    });
}

bool findAccount(char const* name, Account& account) {
    return find(account, [=](passwd* record, char* buffer, std::size_t n, passwd** found) {
        return queryCalls.userByName(name, record, buffer, n, found);
    });
}

} // namespace ZOR_Basis
