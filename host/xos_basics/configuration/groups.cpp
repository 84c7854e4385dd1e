#include "host/include/xos_host.h"
#include "host/xos_basics/configuration/group_text.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/system/root_setting.h"
#include "host/xos_basics/system/setting.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include "basis/platform/xos_basics.h"

#include <cstdio>
#include <memory>
#include <mutex>
#include <set>
#include <string>

struct cfg_Group {
    std::string path;
    host::GroupText text;
};

namespace {

constinit host::Setting directory{"XOS_CONFIG"};

std::string configurationDirectory() {
    std::string set = directory.get();
    if (!set.empty()) return set;
    std::string root = host::configuredRoot();
    if (root.empty()) return "config";
    bool const endsInSlash = root.back() == '/' || root.back() == '\\';
    return root + (endsInSlash ? "config" : "/config");
}

/// A group is a name and not a path, so that it cannot lead out of the folder.
bool isName(char const* name) {
    return name != nullptr && *name != '\0' && std::string(name).find_first_of("/\\:") == std::string::npos;
}

bool readFile(std::string const& path, std::string& text) {
    std::unique_ptr<std::FILE, int (*)(std::FILE*)> const file{std::fopen(path.c_str(), "rb"), std::fclose};
    if (file == nullptr) return false;
    char piece[4096];
    std::size_t count = 0;
    while ((count = std::fread(piece, 1, sizeof piece, file.get())) != 0) { text.append(piece, count); }
    return std::ferror(file.get()) == 0;
}

/// Groups are read again and again; each mistake is reported the first time only.
void report(cfg_Group const& group, int line, char const* mistake) {
    static constinit host::QuickMutex mutex;
    std::string const place = group.path + ":" + std::to_string(line);
    std::lock_guard const lock{mutex};
    static auto& reported = *new std::set<std::string>;
    if (reported.insert(place).second) std::fprintf(stderr, "%s: %s\n", place.c_str(), mistake);
}

/// The last line of several with one key counts.
host::GroupEntry const* findEntry(cfg_Group const& group, char const* key) {
    auto const& entries = group.text.entries;
    for (auto entry = entries.rbegin(); entry != entries.rend(); ++entry) {
        if (entry->key == key) return &*entry;
    }
    return nullptr;
}

int switchOf(cfg_Group const& group, char const* key, int fallback) {
    host::GroupEntry const* const entry = findEntry(group, key);
    if (entry == nullptr) return fallback;
    auto const value = host::switchValue(entry->value);
    if (!value.has_value()) {
        report(group, entry->line, "the value is none of true, yes, on, 1, false, no, off, 0; left out");
        return fallback;
    }
    return *value ? 1 : 0;
}

cfg_Group* loadGroup(char const* name) {
    if (!isName(name)) {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return nullptr;
    }
    auto group = std::make_unique<cfg_Group>();
    group->path = configurationDirectory() + "/" + name + ".cfg";
    std::string text;
    if (!readFile(group->path, text)) {
        host::setLastError(host::Error::NOT_FOUND);
        return nullptr;
    }
    group->text = host::parseGroup(text);
    for (int const line : group->text.malformedLines) {
        report(*group, line, "neither \"key = value\" nor a comment; left out");
    }
    return group.release();
}

} // namespace

extern "C" {

void xos_HostSetConfigDir(char const* path) { directory.set(path); }

cfg_Group* cfg_GroupLoadFromFile(char const* name, int reserved1, int reserved2, int reserved3) {
    return host::call<cfg_Group*>(
        host::Function::cfg_GroupLoadFromFile, nullptr, [=] { return loadGroup(name); }, name, reserved1, reserved2,
        reserved3);
}

int cfg_KeyGetOpt_Bool(cfg_Group* group, char const* key, int fallback) {
    auto const get = [=] { return group == nullptr || key == nullptr ? fallback : switchOf(*group, key, fallback); };
    return host::call(host::Function::cfg_KeyGetOpt_Bool, fallback, get, group, key, fallback);
}

void cfg_GroupDelete(cfg_Group* group, int reserved) {
    auto const remove = [=] {
        delete group;
        return host::NEVER_FAILS;
    };
    host::call(host::Function::cfg_GroupDelete, host::NEVER_FAILS, remove, group, reserved);
}

} // extern "C"
