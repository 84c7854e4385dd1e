#include "host/xos_url/reason.h"

namespace host {

bool failForStatus(long status) {
    switch (status) {
    case 401:
    case 403:
    case 407:
        return failFor(Reason::forbidden);
    case 404:
    case 410:
        return failFor(Reason::notFound);
    default:
        return failFor(Reason::badAnswer);
    }
}

} // namespace host
