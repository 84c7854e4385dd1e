#include "host/xos_basics/files/raw_file.h"

namespace host {

std::size_t RawFile::read(char* to, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        std::ptrdiff_t const got = readSome(to + done, size - done);
        if (got <= 0) break;
        done += static_cast<std::size_t>(got);
    }
    return done;
}

} // namespace host
