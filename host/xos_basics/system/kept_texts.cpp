#include "host/xos_basics/system/kept_texts.h"

#include "host/xos_basics/wait/quick_mutex.h"

#include <mutex>
#include <set>
#include <string>

namespace host {

char const* keptText(char const* text) {
    if (text == nullptr || *text == '\0') return "";
    static constinit QuickMutex mutex;
    std::lock_guard const lock{mutex};
    static auto& texts = *new std::set<std::string, std::less<>>;
    auto found = texts.find(text);
    if (found == texts.end()) found = texts.insert(text).first;
    return found->c_str();
}

} // namespace host
