#include "basis/log/log_path.h"

#include "basis/ground/choices.h"
#include "zor_basis/files/dir.h"

#include <charconv>
#include <iterator>

namespace ZOR_Basis {
namespace {

constexpr char FOLDER[] = "/scsi0/tmp/zb_log";
constexpr int MOST_SESSION_DIGITS = 20;

} // namespace

FPath logFolder(Str const& log) {
    FPath path(FOLDER, TranslPath());
    path.add(log);
    return path;
}

FPath makeLogFolder(Str const& log) {
    FPath path(FOLDER, TranslPath());
    Dir::New(path.c_str(), WITH_PARENTS);
    path.add(log);
    Dir::New(path.c_str(), WITH_PARENTS);
    return path;
}

FPath sessionFile(FPath const& folder, std::uint64_t session) {
    char digits[MOST_SESSION_DIGITS];
    char const* const end = std::to_chars(std::begin(digits), std::end(digits), session).ptr;
    FPath path(folder);
    path.add(digits, static_cast<std::uint64_t>(end - digits));
    path.addExt("log", WITH_DOT);
    return path;
}

} // namespace ZOR_Basis
