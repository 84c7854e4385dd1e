// Writers are killed at random moments.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"
#include "tests/stress/writers.h"

#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/wait_for.h"

#include <map>
#include <random>

namespace stress {
namespace {

/// write NUMBER FOLDER ELSEWHERE SIZE: one of the writers. It says by a file that it has begun.
int write(std::vector<std::string> const& arguments) {
    Writer const& writer = writers()[std::stoul(arguments.at(0))];
    Desk const desk{arguments.at(1), arguments.at(2), std::stoull(arguments.at(3))};
    put(desk.folder + ".begun", "begun");
    auto const end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
    for (std::uint64_t round = 0; std::chrono::steady_clock::now() < end; ++round) {
        if (writer.writeOnce(desk, round)) continue;
        put(desk.folder + ".failed", writer.name);
        return 1;
    }
    return 0;
}

bool isTemporary(std::string const& name) {
    std::string const file = name.substr(name.rfind('/') + 1);
    bool const isMarked = file.rfind(".xos-", 0) == 0 || file.rfind(".zb-", 0) == 0;
    return isMarked && file.size() > 4 && file.compare(file.size() - 4, 4, ".tmp") == 0;
}

class Killer {
public:
    explicit Killer(Findings& findings) : findings_(findings), scratch_(stressFolder()) {}

    void killOne(std::uint64_t kill);
    void tell() const {
        for (auto const& [name, count] : kills_) {
            findings_.note(name + ": " + std::to_string(count) + " killed, " + std::to_string(leftOvers_.at(name)) +
                           " temporary files");
        }
    }

private:
    void judge(Writer const& writer, Desk const& desk, std::uint64_t kill);

    Findings& findings_;
    Scratch const scratch_;
    Scratch const elsewhere_;
    std::mt19937_64 random_{4'711};
    std::map<std::string, std::uint64_t> kills_, leftOvers_;
};

void Killer::judge(Writer const& writer, Desk const& desk, std::uint64_t kill) {
    std::string const where = std::string(writer.name) + ", kill " + std::to_string(kill) + ": ";
    findings_.expect(!exists(desk.folder + ".failed"), where + "an operation failed before");
    std::string const complaint = writer.complaint(desk);
    findings_.expect(complaint.empty(), where + complaint);
    std::uint64_t& leftOvers = leftOvers_[writer.name];
    for (std::string const& folder : {desk.folder, desk.elsewhere}) {
        for (auto const& entry : std::filesystem::recursive_directory_iterator(folder)) {
            std::string const name = entry.path().filename().generic_string();
            if (name.find(".tmp") == std::string::npos) continue;
            findings_.expect(isTemporary(name), where + "a left-over with another name: " + name);
            ++leftOvers;
        }
    }
    ++kills_[writer.name];
}

void Killer::killOne(std::uint64_t kill) {
    constexpr std::uint64_t SIZES[] = {10, 5'000, 70'000, 600'000};
    std::uint64_t const number = kill % writers().size();
    Writer const& writer = writers()[number];
    Desk const desk{scratch_ / std::to_string(kill), elsewhere_ / std::to_string(kill), SIZES[random_() % 4]};
    makeFolder(desk.folder);
    makeFolder(desk.elsewhere);
    writer.prepare(desk);
    {
        Child child{programBeside("stress"),
                    {"--as", "write", std::to_string(number), desk.folder, desk.elsewhere, std::to_string(desk.size)}};
        if (!findings_.expect(child.isStarted(), "a process does not start")) return;
        findings_.expect(waitFor([&] { return exists(desk.folder + ".begun"); }), "a process does not begin");
        std::uint64_t const longest = random_() % 8 == 0 ? 30'000 : 3'000;
        std::this_thread::sleep_for(std::chrono::microseconds(random_() % longest));
        child.kill();
        child.wait();
    }
    judge(writer, desk, kill);
    std::error_code ignored;
    for (std::string const& folder : {desk.folder, desk.elsewhere, desk.folder + ".begun"}) {
        std::filesystem::remove_all(folder, ignored);
    }
}

} // namespace

void killWriters(std::uint64_t kills, Findings& findings) {
    Killer killer(findings);
    for (std::uint64_t kill = 0; kill < kills; ++kill) killer.killOne(kill);
    killer.tell();
}

Roles writerRoles() { return {{"write", write}}; }

} // namespace stress
