#include "tools/zbtool/fetch.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/staging.h"
#include "tools/zbtool/whole_file.h"

#include <zor_basis/files.h>
#include <zor_basis/system.h>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

/// A URL without the user and password in it, which do not belong on a screen.
std::string publicPart(std::string url) {
    std::size_t const scheme = url.find("://");
    if (scheme == std::string::npos) return url;
    std::size_t const host = scheme + 3;
    std::size_t const at = url.substr(0, url.find_first_of("/?#", host)).rfind('@');
    if (at != std::string::npos && at >= host) url.erase(host, at + 1 - host);
    return url;
}

/// Complains if the target is the password's file, or any other file without being told to replace it.
bool mayWriteTarget(FetchOptions const& options) {
    if (!options.overwrite) return !FStat::exist(options.target.c_str()) || complain(options.target, "exists already");
    return !isSameFile(options.passwordFile, options.target) || complain(options.target, "is the password's file");
}

} // namespace

int fetch(FetchOptions const& options) {
    std::string password;
    std::string reason;
    if (!options.passwordFile.empty() && !readWhole(options.passwordFile, password, reason))
        return exitCodeOf(complain(options.passwordFile, reason));
    password.erase(password.find_last_not_of("\r\n") + 1);
    if (!mayWriteTarget(options)) return FAILED;
    bool const hasUser = !options.user.empty();
    auto const get = [&](FPath const& staged) {
        return Url::Get(staged.c_str(), options.url.c_str(), hasUser ? options.user.c_str() : nullptr,
                        hasUser ? password.c_str() : nullptr, SPARING, WITHOUT_PARENTS);
    };
    if (writeStaged(options.target.c_str(), get, options.overwrite, reason)) return DONE;
    return exitCodeOf(complain("cannot fetch '" + publicPart(options.url) + "' to '" + options.target + "'", reason));
}

} // namespace zbtool
