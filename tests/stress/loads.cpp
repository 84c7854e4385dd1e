// The library is loaded and unloaded, in a process that does not need it otherwise.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"

#include "tests/host/support/child.h"
#include "tests/support/scratch.h"

#include <sstream>

namespace stress {

void loadAndUnload(std::uint64_t cycles, Findings& findings) {
    Scratch const scratch(stressFolder());
    makeFolder(scratch / "tmp");
    Child child{programBeside("stress_loader"),
                {programBeside("stress_module"), std::to_string(cycles), scratch / "report"},
                {{"XOS_ROOT", scratch.path()}}};
    if (!findings.expect(child.isStarted(), "the loader does not start")) return;
    constexpr int MOST_WAITS = 40;
    int code = child.wait();
    for (int i = 1; code < 0 && i < MOST_WAITS && !exists(scratch / "report"); ++i) code = child.wait();
    if (!findings.expect(code == 0, "step " + std::to_string(code) + " failed")) return;
    Holdings early{};
    Holdings late{};
    std::istringstream(textOf(scratch / "report")) >> early.handles >> early.threads >> early.mappings >>
        late.handles >> late.threads >> late.mappings;
    findings.note("handles, threads, mappings: " + countsOf(early) + ", then " + countsOf(late));
    findings.expect(early.mappings != 0 && isSteady(early, late), "something is lost with each cycle");
}

} // namespace stress
