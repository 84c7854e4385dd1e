// stress [CAMPAIGN [AMOUNT]]: runs all campaigns, or one, with its usual amount or another.
// stress --brief: runs all with small amounts. stress --list: shows them.
// stress --as ROLE [ARGUMENTS]: what campaigns start as a child.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"
#include "tests/support/scratch.h"

#include <xos_host.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace stress {

void Findings::problem(std::string const& what) {
    constexpr std::uint64_t MOST_SHOWN = 20;
    std::lock_guard const held(mutex_);
    if (++problems_ > MOST_SHOWN) return;
    std::printf("  PROBLEM %s\n", what.c_str());
    std::fflush(stdout);
}
bool Findings::expect(bool condition, std::string const& what) {
    if (!condition) problem(what);
    return condition;
}
void Findings::note(std::string const& line) const {
    std::lock_guard const held(mutex_);
    std::printf("  %s\n", line.c_str());
    std::fflush(stdout);
}
std::uint64_t Findings::problems() const {
    std::lock_guard const held(mutex_);
    return problems_;
}

namespace {

/// The root of this process, for which the library asks once.
class Root {
public:
    Root() : scratch_(stressFolder()) { xos_HostSetRoot(scratch_.path().c_str()); }
    ~Root() { xos_HostSetRoot(nullptr); }
    Root(Root const&) = delete;
    Root& operator=(Root const&) = delete;

private:
    Scratch const scratch_;
};

/// \return whether nothing was found
bool run(Campaign const& campaign, std::uint64_t amount) {
    std::printf("%s, %llu %s\n", campaign.name, static_cast<unsigned long long>(amount), campaign.unit);
    std::fflush(stdout);
    auto const start = std::chrono::steady_clock::now();
    Findings findings;
    campaign.run(amount, findings);
    std::chrono::duration<double> const taken = std::chrono::steady_clock::now() - start;
    std::printf("%s: %llu problems, %.1f s\n", campaign.name, static_cast<unsigned long long>(findings.problems()),
                taken.count());
    std::fflush(stdout);
    return findings.problems() == 0;
}

int list() {
    for (Campaign const& campaign : campaigns()) {
        std::printf("%-12s %llu %s\n", campaign.name, static_cast<unsigned long long>(campaign.usual), campaign.unit);
    }
    return 0;
}

int runAll(bool isBrief) {
    Root const root;
    bool isGood = true;
    for (Campaign const& campaign : campaigns()) {
        isGood = run(campaign, isBrief ? campaign.brief : campaign.usual) && isGood;
    }
    return isGood ? 0 : 1;
}

int runOne(char const* name, char const* amount) {
    for (Campaign const& campaign : campaigns()) {
        if (std::strcmp(campaign.name, name) != 0) continue;
        Root const root;
        std::uint64_t const given = amount != nullptr ? std::strtoull(amount, nullptr, 10) : 0;
        return run(campaign, given != 0 ? given : campaign.usual) ? 0 : 1;
    }
    std::printf("There is no campaign %s. There are:\n", name);
    list();
    return 2;
}

int play(char const* name, std::vector<std::string> const& arguments) {
    for (Roles const& roles : {writerRoles(), holderRoles(), firstUseRoles()}) {
        for (Role const& role : roles) {
            if (std::strcmp(role.name, name) == 0) return role.play(arguments);
        }
    }
    return 2;
}

} // namespace
} // namespace stress

int main(int argc, char** argv) {
    if (argc < 2) return stress::runAll(false);
    std::string const word = argv[1];
    if (word == "--brief") return stress::runAll(true);
    if (word == "--list") return stress::list();
    if (word == "--as" && argc > 2) return stress::play(argv[2], {argv + 3, argv + argc});
    return stress::runOne(argv[1], argc > 2 ? argv[2] : nullptr);
}
