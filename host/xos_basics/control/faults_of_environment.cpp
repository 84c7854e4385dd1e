#include "host/xos_basics/control/faults.h"

#include <charconv>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

namespace host {

namespace {

/// Takes the number behind the last ":" off the end of `text`.
bool takeNumber(std::string_view& text, std::uint32_t& number) {
    std::size_t const colon = text.rfind(':');
    if (colon == std::string_view::npos) return false;
    char const* const end = text.data() + text.size();
    auto const parsed = std::from_chars(text.data() + colon + 1, end, number);
    text = text.substr(0, colon);
    return parsed.ec == std::errc{} && parsed.ptr == end;
}

bool injectEntry(std::string_view entry) {
    std::uint32_t skip = 0;
    std::uint32_t times = 0;
    // From the end, as two of the names hold colons themselves.
    return takeNumber(entry, times) && takeNumber(entry, skip) &&
           injectFailure(std::string(entry).c_str(), skip, times);
}

struct ReadAtLoad {
    ReadAtLoad() { injectFailures(std::getenv("XOS_FAULTS")); }
};
ReadAtLoad const readAtLoad;

} // namespace

void injectFailures(char const* list) {
    std::string_view rest = list == nullptr ? "" : list;
    while (!rest.empty()) {
        std::size_t const comma = rest.find(',');
        std::string_view const entry = rest.substr(0, comma);
        rest = comma == std::string_view::npos ? std::string_view{} : rest.substr(comma + 1);
        if (!injectEntry(entry)) {
            std::fprintf(stderr, "XOS_FAULTS: \"%s\" is not NAME:SKIP:TIMES of a function that can fail\n",
                         std::string(entry).c_str());
        }
    }
}

} // namespace host
