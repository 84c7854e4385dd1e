#include "basis/log/log_path.h"

#include "zor_basis/files/dir.h"

#include <charconv>
#include <iterator>

namespace ZOR_Basis {
namespace {

constexpr char FOLDER[] = "/scsi0/tmp/zb_log";
constexpr bool WITH_PARENTS = true;
constexpr bool WITH_DOT = true;
constexpr int MOST_DIGITS = 20;

} // namespace

FPath logPath(Str const& log, std::uint64_t session, bool makeFolders) {
    FPath path(FOLDER, TranslPath());
    if (makeFolders) Dir::New(path.c_str(), WITH_PARENTS);
    path.add(log);
    if (makeFolders) Dir::New(path.c_str(), WITH_PARENTS);
    char digits[MOST_DIGITS];
    char const* const end = std::to_chars(std::begin(digits), std::end(digits), session).ptr;
    path.add(digits, static_cast<std::uint64_t>(end - digits));
    path.addExt("log", WITH_DOT);
    return path;
}

} // namespace ZOR_Basis
