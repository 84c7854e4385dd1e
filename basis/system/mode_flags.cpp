#include "basis/system/mode_flags.h"

#include "basis/platform/xos_basics.h"

#include <atomic>

namespace ZOR_Basis::ModeFlags {
namespace {

constexpr char GROUP[] = "vdp";

struct Key {
    char const* name;
    Mode mode;
};
constexpr Key KEYS[] = {{"vipp", VIPP}, {"ppml", PPML}, {"vps", VPS}, {"qdb", QDB}};

constinit std::atomic<std::uint32_t> on{0};
constinit std::atomic<bool> loaded{false};

void readKeys(cfg_Group* group) {
    for (Key const& key : KEYS) {
        if (cfg_KeyGetOpt_Bool(group, key.name, 0) != 0) {
            on |= key.mode;
        } else {
            on &= ~key.mode;
        }
    }
}

} // namespace

void load() {
    if (cfg_Group* const group = cfg_GroupLoadFromFile(GROUP, 0, 0, 0)) {
        readKeys(group);
        cfg_GroupDelete(group, 0);
    } else {
        // kept flat-05: an installation without a configuration accepts every kind; a configured one accepts the kinds
        // that it names.
        on |= ALL;
    }
    loaded = true;
}

bool isLoaded() { return loaded; }
bool isOn(Mode modes) { return (on & modes) != 0; }

} // namespace ZOR_Basis::ModeFlags
