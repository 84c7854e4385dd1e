#include "host/xos_basics/this_thread.h"

namespace host {

constinit thread_local ThisThread thisThread{};

} // namespace host
