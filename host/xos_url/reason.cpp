#include "host/xos_url/reason.h"

namespace host {

bool failForStatus(long status) {
    switch (status) {
    case 401:
    case 403:
    case 407:
        return failFor(Reason::FORBIDDEN);
    case 404:
    case 410:
        return failFor(Reason::NOT_FOUND);
    default:
        return failFor(Reason::BAD_ANSWER);
    }
}

} // namespace host
