#include "zor_basis/files/f_stat.h"

#include "basis/files/path_rules.h"
#include "basis/files/platform_flags.h"
#include "basis/files/system_calls.h"

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t LONGEST_LOGON_MS = 120'000;
constexpr std::uint32_t PAUSE_MS = 1000;
constexpr std::int32_t MOST_ATTEMPTS = 5;
constexpr std::int32_t MOST_LOGON_FAILURES = 100;
constexpr std::int32_t MOST_DENIALS = 5;

FStat::StatMode kindOf(std::uint32_t mode) {
    switch (mode & MODE_TYPE) {
    case MODE_FILE:
        return FStat::ST_FILE;
    case MODE_DIRECTORY:
        return FStat::ST_DIR;
    case MODE_LINK:
        return FStat::ST_LINK;
    default:
        return FStat::ST_OTHER;
    }
}

/// Counts the failures of a retried query and decides when to give up.
class Retries {
public:
    bool mayGoOn(std::uint32_t error) {
        switch (error) {
        case NETWORK_NAME_GONE:
            break;
        case LOGON_FAILURE:
            ++logonFailures_;
            if (systemCalls.tick() - start_ > LONGEST_LOGON_MS) return false;
            break;
        case ACCESS_DENIED:
            ++denials_;
            break;
        default:
            return false;
        }
        return attempts_ - denials_ - logonFailures_ <= MOST_ATTEMPTS && logonFailures_ <= MOST_LOGON_FAILURES &&
               denials_ <= MOST_DENIALS;
    }

    void countAttempt() { ++attempts_; }

private:
    std::uint64_t start_ = systemCalls.tick();
    // Signed: failures are counted before the attempt that they belong to.
    std::int32_t attempts_ = 0;
    std::int32_t logonFailures_ = 0;
    std::int32_t denials_ = 0;
};

} // namespace

bool FStat::update(char const* path, bool platformFallback) {
    *this = FStat();
    path = PathRules::orEmpty(path);
    xos_Stat record{};
    if (!systemCalls.status(path, record)) {
        if (!platformFallback || xos_FileStatByNameEx(path, &record, NAMES_AS_STORED) != 0) return false;
    }
    type_ = kindOf(record.st_mode_);
    modified_ = record.st_mtime_;
    created_ = record.st_ctime_;
    accessed_ = record.st_atime_;
    size_ = static_cast<std::uint64_t>(record.st_size_);
    return true;
}

bool FStat::updateW(WChar const* path) {
    *this = FStat();
    xos_Stat record{};
    if (!systemCalls.statusWide(PathRules::orEmpty(path), record)) return false;
    // kept stat-02: wide callers list directories and take everything else for something to open. The type bits are a
    // number: those of a socket contain the directory's bit, although a socket is no directory.
    type_ = (record.st_mode_ & MODE_TYPE) == MODE_DIRECTORY ? ST_DIR : ST_FILE;
    modified_ = record.st_mtime_;
    created_ = record.st_ctime_;
    accessed_ = record.st_atime_;
    size_ = static_cast<std::uint64_t>(record.st_size_);
    return true;
}

bool FStat::updateMultiRetryNetwork(char const* path, bool platformFallback) {
    if (update(path, platformFallback)) return true;
    // Read before anything else can change it.
    std::uint32_t error = systemCalls.lastError();
    Retries retries;
    while (retries.mayGoOn(error)) {
        systemCalls.sleep(PAUSE_MS);
        bool const found = update(path, platformFallback);
        error = systemCalls.lastError();
        retries.countAttempt();
        if (found) return true;
    }
    return false;
}

} // namespace ZOR_Basis
