/// \file
/// Campaigns: what is done thousands of times or for minutes, by processes and threads of its own, and what has to hold
/// all the while.

#ifndef TESTS_STRESS_CAMPAIGN_H
#define TESTS_STRESS_CAMPAIGN_H

#include <cstdint>
#include <mutex>
#include <string>
#include <vector>

namespace stress {

/// What a campaign finds.
/// \thread thread-safe
class Findings {
public:
    /// Something that must not be. The first ones are shown.
    void problem(std::string const& what);
    /// A problem unless the condition holds.
    /// \return the condition
    bool expect(bool condition, std::string const& what);
    /// A line for the record.
    void note(std::string const& line) const;
    std::uint64_t problems() const;

private:
    mutable std::mutex mutex_;
    std::uint64_t problems_ = 0;
};

struct Campaign {
    char const* name;
    /// What the amount counts.
    char const* unit;
    std::uint64_t usual;
    /// In the ordinary suites.
    std::uint64_t brief;
    void (*run)(std::uint64_t amount, Findings& findings);
};

/// What the program does as a child of a campaign.
/// \return its exit code
struct Role {
    char const* name;
    int (*play)(std::vector<std::string> const& arguments);
};

using Roles = std::vector<Role>;

/// Those that this system can run: campaigns_posix.cpp, campaigns_win.cpp.
std::vector<Campaign> campaigns();

void stressThreads(std::uint64_t seconds, Findings& findings);
void killWriters(std::uint64_t kills, Findings& findings);
void killHolders(std::uint64_t kills, Findings& findings);
void raceFirstUses(std::uint64_t processes, Findings& findings);
void loadAndUnload(std::uint64_t cycles, Findings& findings);
void repeatOperations(std::uint64_t times, Findings& findings);
/// Linux only.
void swapLinks(std::uint64_t swaps, Findings& findings);

Roles writerRoles();
Roles holderRoles();
Roles firstUseRoles();

} // namespace stress

#endif
