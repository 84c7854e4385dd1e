#include "zor_basis/system/url.h"

#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
#include "basis/platform/xos_url.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/f_stat.h"

namespace ZOR_Basis {

bool Url::Get(char const* target, char const* url, char const* first, char const* second, bool overwrite,
              bool makeDirectory) {
    if (makeDirectory && !Dir::NewFor(target)) return false;
    if (FStat::exist(target) && !overwrite) return refuse(Reason::ALREADY_THERE);
    return xos_URLGet(url, PathRules::orEmpty(target), first, second) == 0;
}

} // namespace ZOR_Basis
