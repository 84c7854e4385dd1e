// The sibling is campaigns_posix.cpp. A process costs a hundred times more under Wine, and a file ten times more.

#include "tests/stress/campaign.h"

namespace stress {

std::vector<Campaign> campaigns() {
    return {
        {"kills", "writers killed", 200, 8, killWriters},
        {"holders", "holders of a mutex killed", 100, 1, killHolders},
        {"loads", "cycles of loading and unloading", 2'000, 20, loadAndUnload},
        {"first", "processes for each first use", 20, 0, raceFirstUses},
        {"operations", "calls of each operation", 1'000, 1, repeatOperations},
        {"threads", "seconds", 300, 1, stressThreads},
    };
}

} // namespace stress
