// The sibling is campaigns_win.cpp.

#include "tests/stress/campaign.h"

namespace stress {

std::vector<Campaign> campaigns() {
    return {
        {"kills", "writers killed", 2'000, 16, killWriters},
        {"holders", "holders of a mutex killed", 1'000, 3, killHolders},
        {"links", "exchanges", 1'000'000, 3'000, swapLinks},
        {"loads", "cycles of loading and unloading", 2'000, 20, loadAndUnload},
        {"first", "processes for each first use", 200, 1, raceFirstUses},
        {"operations", "calls of each operation", 10'000, 3, repeatOperations},
        {"threads", "seconds", 300, 1, stressThreads},
    };
}

} // namespace stress
