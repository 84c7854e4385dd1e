// Threads that use everything that threads may share, at random. What each operation promises is counted beside it.

#include "tests/stress/campaign.h"

#include <zor_basis/files.h>
#include <zor_basis/log.h>
#include <zor_basis/sync.h>
#include <zor_basis/system.h>
#include <zor_basis/text/convert.h>
#include <zor_basis/timers.h>

#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

#include <atomic>
#include <chrono>
#include <cstdlib>
#include <iterator>
#include <memory>
#include <random>
#include <sstream>
#include <thread>

using namespace ZOR_Basis;

namespace stress {
namespace {

constexpr unsigned THREADS = 64;
constexpr std::uint64_t KEYS = 100;
constexpr std::uint64_t TIMERS = 8;
constexpr int MUTEX_ID = 77'001;
/// A thread that takes longer for one step counts as hanging. On a busy machine a thread may get no time for minutes.
constexpr auto LONGEST_STEP = std::chrono::minutes(8);

/// What the threads share, and beside it what has to be found in the end.
class Shared {
public:
    explicit Shared(Findings& all) : findings(all) {
        timers->setActive(true);
        for (std::uint64_t id = 1; id <= TIMERS; ++id) TimerMgr::create(timers, "stage", id, true);
    }

    Findings& findings;
    Lock mutex{Lock::Mutex, false};
    Lock binary{Lock::Binary, false};
    xos_Sem named = xos_SemNamedMutexCreate(MUTEX_ID, 0, 0, nullptr);
    SemSet keys{16};
    Log log{"stress"};
    TimerMgr* timers = TimerMgr::New("stress", TIMERS);

    // Guarded by what stands beside them in the name alone, so that a thread sanitizer sees a lock that does not lock.
    std::uint64_t underMutex = 0, underBinary = 0, underNamed = 0, underKey[KEYS] = {};
    std::atomic<std::uint64_t> takenMutex{0}, takenBinary{0}, takenNamed{0}, takenKeys{0};
    std::atomic<std::uint64_t> measured[TIMERS + 1] = {};
    std::atomic<std::uint64_t> lines{0}, alerts{0}, sessions{1};

    std::mutex foldersMutex;
    std::set<std::string> folders;
};

struct Worker {
    explicit Worker(unsigned i) : number(i), random(i) {}

    unsigned number;
    std::mt19937_64 random;
    std::uint64_t lines = 0;
    std::atomic<std::uint64_t> steps{0};
    /// The index of the present step.
    std::atomic<std::size_t> step{0};

    std::uint64_t below(std::uint64_t limit) { return random() % limit; }
};

void lockAll(Shared& shared, Worker& worker) {
    shared.mutex.lock();
    shared.mutex.lock();
    ++shared.underMutex;
    shared.mutex.unlock();
    shared.mutex.unlock();
    ++shared.takenMutex;
    shared.binary.lock();
    ++shared.underBinary;
    shared.binary.unlock();
    ++shared.takenBinary;
    if (worker.below(8) != 0) return;
    xos_SemTake(shared.named);
    ++shared.underNamed;
    xos_SemGive(shared.named);
    ++shared.takenNamed;
}

void lockKeys(Shared& shared, Worker& worker) {
    for (int i = 0; i < 10; ++i) {
        std::uint64_t const key = worker.below(KEYS);
        shared.findings.expect(shared.keys->take(key), "a key cannot be taken");
        ++shared.underKey[key];
        shared.findings.expect(shared.keys->give(key), "a key cannot be given");
        ++shared.takenKeys;
    }
}

/// Counts its deletions.
class Argument : public MTQ_Arg {
public:
    explicit Argument(std::atomic<int>& living) : living_(living) { ++living_; }
    ~Argument() override { --living_; }

private:
    std::atomic<int>& living_;
};

/// \return how many jobs are listed, all of them finished; -1: not all are
int finishedJobs(MultiTaskQueue& queue) {
    int jobs = 0;
    for (MTQ_Dat const* job = queue.first(); job != nullptr; job = queue.next(), ++jobs) {
        if (!job->finished() || !job->result()) return -1;
    }
    return jobs;
}

void queueJobs(Shared& shared, Worker& worker) {
    std::atomic<int> living{0};
    {
        std::unique_ptr<MultiTaskQueue> const queue(
            MultiTaskQueue::New(MultiTaskQueue::Continue, static_cast<int>(1 + worker.below(3))));
        auto const add = [&](MTQ_Dat::Function function, bool startsNow) {
            MTQ_Arg* const argument = new Argument(living);
            shared.findings.expect(queue->add(function, argument, true, startsNow, false), "a job is refused");
        };
        auto* const succeed = +[](void*) { return true; };
        auto* const succeedLater = +[](void*) {
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
            return true;
        };
        int jobs = 0;
        for (; jobs < 4; ++jobs) add(succeed, worker.below(2) == 0);
        // What waits is started when another job ends during `wait`; one that is quick may end before.
        do {
            add(succeedLater, true);
            ++jobs;
            queue->wait();
        } while (finishedJobs(*queue) < 0 && jobs < 1000);
        int const finished = finishedJobs(*queue);
        shared.findings.expect(finished == jobs && !queue->failed(),
                               "a queue has " + std::to_string(jobs) + " jobs, of which " + std::to_string(finished) +
                                   " have succeeded" + (queue->failed() ? "; it has failed" : ""));
    }
    shared.findings.expect(living == 0, "an argument of a job was not deleted");
}

void logLines(Shared& shared, Worker& worker) {
    for (std::uint64_t i = worker.below(4); i > 0; --i) {
        shared.log.out("%u %llu %s.", worker.number, static_cast<unsigned long long>(worker.lines++),
                       std::string(worker.below(60), 'x').c_str());
        ++shared.lines;
    }
    if (worker.below(500) == 0) shared.findings.expect(shared.log.flush(), "a log cannot be written");
    if (worker.below(50'000) != 0) return;
    shared.log.newSession();
    ++shared.sessions;
}

void measure(Shared& shared, Worker& worker) {
    std::uint64_t const id = 1 + worker.below(TIMERS);
    {
        BaseTimerAuto timer(TimerMgr::get(shared.timers, id), shared.timers, true, false);
        if (worker.below(2) == 0) {
            timer.suspend();
            timer.resume();
        }
    }
    ++shared.measured[id];
    shared.findings.expect(TimerMgr::Get("stress") == shared.timers, "a manager is not found");
}

void useFolder(Shared& shared, Worker&) {
    std::string path;
    {
        VDPTempDir const folder;
        path = folder.path().c_str();
        {
            std::lock_guard const held(shared.foldersMutex);
            shared.findings.expect(shared.folders.insert(path).second, "a folder was handed out twice: " + path);
        }
        put(path + "/file", path);
        shared.findings.expect(textOf(path + "/file") == path, "a file of another job: " + path);
        std::lock_guard const held(shared.foldersMutex);
        shared.folders.erase(path);
    }
    // Names are not used twice.
    shared.findings.expect(!exists(path), "a folder was left: " + path);
}

void askForRoots(Shared& shared, Worker&) {
    FPath translated;
    translated.translateRoot("/scsi0/tmp");
    shared.findings.expect(translated == Sys::temp(), "another folder for temporary files");
    WcPath wide;
    wide.translateRoot(ZB_W("/scsi0"));
    BufStr<255> narrow;
    Convert::WideToUtf8(wide, narrow);
    shared.findings.expect(narrow == Sys::root(), "another root");
    BufStr<255> local;
    shared.findings.expect(Convert::Utf8ToLocal("abc", local) && local == Str("abc"), "another conversion");
}

void useAlert(Shared& shared, Worker& worker) {
    if (worker.below(20) != 0) return;
    std::atomic<std::uint64_t> calls{0};
    std::uint32_t const id = HQ_Basis::AlertTimer::New(
        1,
        [](HQ_Basis::AlertTimer::Alert const& alert) -> std::uint32_t {
            ++*static_cast<std::atomic<std::uint64_t>*>(alert.context);
            return 1;
        },
        &calls);
    shared.findings.expect(id != 0, "no alert can be made");
    auto const end = std::chrono::steady_clock::now() + LONGEST_STEP;
    while (calls == 0 && std::chrono::steady_clock::now() < end) {
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    shared.findings.expect(calls != 0, "an alert was never called");
    HQ_Basis::AlertTimer::Delete(id);
    ++shared.alerts;
}

struct Step {
    char const* name;
    void (*perform)(Shared& shared, Worker& worker);
};
constexpr Step STEPS[] = {{"locks", lockAll},  {"keys", lockKeys},    {"queue", queueJobs},   {"log", logLines},
                          {"timers", measure}, {"folder", useFolder}, {"roots", askForRoots}, {"alert", useAlert}};

void performOne(Shared& shared, Worker& worker) {
    worker.step = worker.below(std::size(STEPS));
    STEPS[worker.step].perform(shared, worker);
    ++worker.steps;
}

/// Each thread's lines are there, whole and in their order. \return how many there are
std::uint64_t countLines(Shared& shared) {
    std::vector<std::uint64_t> next(THREADS, 0);
    std::uint64_t count = 0;
    for (std::uint64_t session = 0; session < shared.sessions; ++session) {
        std::string const name = std::to_string(session) + ".log";
        std::ifstream text(std::string(FPath(Sys::temp(), "zb_log/stress").c_str()) + "/" + name);
        for (std::string line; std::getline(text, line); ++count) {
            unsigned thread = THREADS;
            unsigned long long number = 0;
            std::istringstream(line) >> thread >> number;
            bool const isWhole = thread < THREADS && line.find('.') != std::string::npos;
            if (!shared.findings.expect(isWhole, name + ": " + line)) continue;
            shared.findings.expect(number == next[thread]++, name + ", another order: " + line);
        }
    }
    return count;
}

std::uint64_t measuredBy(PileTimer& timer) {
    constexpr std::size_t COUNT_ENDS = 49;
    constexpr std::size_t COUNT_BEGINS = 34;
    BufStr<255> row;
    timer.print(row, 1'000'000);
    return std::stoull(std::string(row.c_str()).substr(COUNT_BEGINS, COUNT_ENDS - COUNT_BEGINS));
}

void judge(Shared& shared) {
    std::uint64_t keys = 0;
    for (std::uint64_t const count : shared.underKey) keys += count;
    shared.findings.expect(shared.underMutex == shared.takenMutex, "a mutex let two threads in");
    shared.findings.expect(shared.underBinary == shared.takenBinary, "a binary semaphore let two threads in");
    shared.findings.expect(shared.underNamed == shared.takenNamed, "a named mutex let two threads in");
    shared.findings.expect(keys == shared.takenKeys, "a key let two threads in");
    for (std::uint64_t id = 1; id <= TIMERS; ++id) {
        std::uint64_t const counted = measuredBy(*TimerMgr::get(shared.timers, id));
        shared.findings.expect(counted == shared.measured[id], "a timer counted " + std::to_string(counted) +
                                                                   " instead of " +
                                                                   std::to_string(shared.measured[id]));
    }
    shared.findings.expect(shared.log.flush(), "the log cannot be written");
    shared.findings.expect(countLines(shared) == shared.lines, "lines are missing");
}

/// Ends the program if a thread hangs, as it could not be joined.
void watch(std::vector<std::unique_ptr<Worker>> const& workers, Findings& findings,
           std::chrono::steady_clock::time_point end) {
    using Clock = std::chrono::steady_clock;
    std::vector<std::uint64_t> steps(workers.size(), 0);
    std::vector<Clock::time_point> since(workers.size(), Clock::now());
    while (Clock::now() < end) {
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        for (std::size_t i = 0; i < workers.size(); ++i) {
            std::uint64_t const now = workers[i]->steps;
            if (now != steps[i]) since[i] = Clock::now();
            steps[i] = now;
            if (Clock::now() - since[i] < LONGEST_STEP) continue;
            findings.problem(std::string("a thread hangs: ") + STEPS[workers[i]->step].name);
            std::_Exit(1);
        }
    }
}

} // namespace

void stressThreads(std::uint64_t seconds, Findings& findings) {
    setThousandsSeparator('\0');
    // A log that is destroyed is closed some time later.
    static Shared* const kept = new Shared(findings);
    Shared& shared = *kept;
    std::atomic<bool> mustEnd{false};
    std::vector<std::unique_ptr<Worker>> workers;
    std::vector<std::thread> threads;
    for (unsigned i = 0; i < THREADS; ++i) workers.push_back(std::make_unique<Worker>(i));
    for (auto const& worker : workers) {
        threads.emplace_back([&shared, &mustEnd, &worker = *worker] {
            while (!mustEnd) performOne(shared, worker);
        });
    }
    watch(workers, findings, std::chrono::steady_clock::now() + std::chrono::seconds(seconds));
    mustEnd = true;
    for (std::thread& thread : threads) thread.join();
    judge(shared);
    std::uint64_t steps = 0;
    for (auto const& worker : workers) steps += worker->steps;
    findings.note(std::to_string(THREADS) + " threads, " + std::to_string(steps) + " steps, " +
                  std::to_string(shared.lines) + " lines in " + std::to_string(shared.sessions) + " sessions, " +
                  std::to_string(shared.alerts) + " alerts");
}

} // namespace stress
