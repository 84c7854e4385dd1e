// Each public operation is repeated, in a folder of its own each time. What the process has must not become more.

#include "tests/faults/scenario.h"
#include "tests/stress/campaign.h"
#include "tests/stress/places.h"

namespace stress {
namespace {

bool repeatOnce(Scenario const& scenario, std::string const& folder) {
    Place const place{folder};
    makeFolder(folder);
    scenario.prepare(place);
    bool const succeeded = scenario.act(place);
    std::error_code ignored;
    std::filesystem::remove_all(folder, ignored);
    return succeeded;
}

void repeat(Scenario const& scenario, std::string const& folder, std::uint64_t times, Findings& findings) {
    std::string const name = scenario.name;
    std::uint64_t const warmUp = times / 10 + 1;
    Holdings early{};
    for (std::uint64_t i = 0; i < times; ++i) {
        if (!findings.expect(repeatOnce(scenario, folder), name + " fails, time " + std::to_string(i))) return;
        if (i == warmUp) early = holdings();
    }
    Holdings const late = holdings();
    findings.expect(times <= warmUp || isSteady(early, late),
                    name + " loses something: " + countsOf(early) + ", then " + countsOf(late));
}

} // namespace

void repeatOperations(std::uint64_t times, Findings& findings) {
    Scratch const scratch(stressFolder());
    Holdings const before = holdings();
    std::size_t count = 0;
    for (Scenarios const& group :
         {textScenarios(), storeScenarios(), fileScenarios(), walkScenarios(), threadScenarios(), systemScenarios()}) {
        for (Scenario const& scenario : group) repeat(scenario, scratch / "place", times, findings);
        count += group.size();
    }
    findings.note(std::to_string(count) + " operations; handles, threads, mappings: " + countsOf(before) + " before, " +
                  countsOf(holdings()) + " after");
}

} // namespace stress
