// The queue beside a naive model of its rules.

#include "basis/sync/multi_task_queue_impl.h"

#include "tests/support/random_steps.h"
#include "tests/sync/gated_job.h"

#include <xos_host.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <list>
#include <memory>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct ModelJob {
    int number;
    bool owns;
    bool removes;
    bool isStarted = false;
    bool isFinished = false;
    bool result = false;
    bool hasTask = false;
};

class QueueModel {
public:
    QueueModel(bool stops, int limit) : stops_(stops), limit_(limit) {}

    bool mayProceed() const { return !stops_ || !failed; }

    /// \return whether the queue is to return true
    bool add(ModelJob job, bool startNow, bool taskFails) {
        if (!mayProceed()) return false;
        jobs.push_back(job);
        return !(startNow || running < limit_) || start(jobs.back(), taskFails);
    }
    bool start(ModelJob& job, bool taskFails) {
        ++running;
        job.isStarted = true;
        job.hasTask = !taskFails;
        if (taskFails) job.isFinished = failed = true;
        return !taskFails;
    }
    void finish(std::list<ModelJob>::iterator job, bool result) {
        --running;
        job->isFinished = true;
        job->hasTask = false;
        job->result = result;
        failed = failed || !result;
        if (job->removes) jobs.erase(job);
    }
    void startAll() {
        for (ModelJob& job : jobs) {
            if (!job.isStarted && mayProceed()) start(job, false);
        }
    }

    std::list<ModelJob> jobs;
    int running = 0;
    bool failed = false;

private:
    bool const stops_;
    int const limit_;
};

/// One queue and its model, driven by random steps.
class QueueAndModel {
public:
    struct Step {
        char const* name;
        unsigned of8; ///< how many of eight steps are of this kind
        void (QueueAndModel::*take)();
    };
    static Step const STEPS[];

    QueueAndModel(std::uint64_t seed, bool failsTasks)
        : random_(seed),
          failsTasks_(failsTasks),
          stops_(random_() % 2 == 0),
          limit_(static_cast<int>(random_() % 6) - 1),
          model_(stops_, limit_),
          queue_(new MTQ_Impl(stops_ ? MultiTaskQueue::StopOnError : MultiTaskQueue::Continue, limit_)) {}

    void run(int steps) {
        for (int i = 0; i < steps && !testing::Test::HasFailure(); ++i) {
            step();
            compare();
        }
        for (auto const& job : withTask()) finish(job, true);
        compare();
        std::uint64_t const owned = static_cast<std::uint64_t>(
            std::count_if(model_.jobs.begin(), model_.jobs.end(), [](ModelJob const& job) { return job.owns; }));
        int const before = deletions_;
        queue_.reset();
        EXPECT_EQ(deletions_ - before, static_cast<int>(owned));
    }

private:
    void step() {
        auto number = static_cast<unsigned>(random_() % 8);
        Step const* chosen = STEPS;
        for (; number >= chosen->of8; ++chosen) number -= chosen->of8;
        SCOPED_TRACE(chosen->name);
        (this->*chosen->take)();
    }

    void addAny() { add(random_() % 3 == 0); }

    void add(bool startNow) {
        bool const owns = random_() % 2 == 0;
        bool const removes = random_() % 3 == 0;
        bool const taskFails = failsTasks_ && random_() % 40 == 0;
        arguments_.push_back(owns ? new GatedJob(&deletions_) : new GatedJob);
        GatedJob* const argument = arguments_.back();
        if (!owns) borrowed_.emplace_back(argument);
        if (taskFails) xos_HostFail("xos_TaskCreate", 0, 1);
        ModelJob const job{static_cast<int>(arguments_.size()) - 1, owns, removes};
        bool const wasRefused = !model_.mayProceed();
        bool const expected = model_.add(job, startNow, taskFails);
        EXPECT_EQ(queue_->add(GatedJob::run, argument->argument(), owns, startNow, removes), expected);
        if (taskFails) xos_HostFailClear();
        if (wasRefused && owns) {
            delete argument;
            --deletions_;
        }
    }

    /// Lets a running job come to its end, and waits until the queue knows.
    void finish(std::list<ModelJob>::iterator job, bool result) {
        argumentOf(*job)->open(result);
        model_.finish(job, result);
        settle();
    }
    void settle() {
        EXPECT_TRUE(waitFor([&] { return queue_->running() == model_.running && queue_->ending() == 0; }));
    }

    using Places = std::vector<std::list<ModelJob>::iterator>;
    using Records = std::vector<MTQ_Dat*>;

    Places withTask() {
        Places running;
        for (auto job = model_.jobs.begin(); job != model_.jobs.end(); ++job) {
            if (job->hasTask) running.push_back(job);
        }
        return running;
    }
    Records recordsThatWait() {
        Records waiting;
        for (MTQ_Dat* record = queue_->first(); record != nullptr; record = queue_->next()) {
            if (!record->started()) waiting.push_back(record);
        }
        return waiting;
    }
    GatedJob* argumentOf(ModelJob const& job) const { return arguments_[static_cast<std::size_t>(job.number)]; }

    void finishAny() {
        Places const running = withTask();
        if (!running.empty()) finish(running[random_() % running.size()], random_() % 12 != 0);
    }

    /// Walks to a running job, has it removed, ends it there and looks where the walk is then.
    void removeAny() {
        Places const running = withTask();
        if (running.empty()) return;
        auto const chosen = running[random_() % running.size()];
        MTQ_Dat* record = queue_->first();
        for (auto job = model_.jobs.begin(); job != chosen; ++job) record = queue_->next();
        ASSERT_EQ(record, queue_->current());
        record->setRemoveWhenDone();
        chosen->removes = true;
        auto const following = std::next(chosen);
        finish(chosen, true);
        EXPECT_EQ(queue_->current(), nullptr);
        MTQ_Dat const* const next = queue_->next();
        ASSERT_EQ(next != nullptr, following != model_.jobs.end());
        if (next != nullptr) { EXPECT_EQ(next->argument(), argumentOf(*following)->argument()); }
    }

    /// All jobs come to their end, with results such that their order does not matter.
    void wait() {
        // One ends, so that the others are started, and one runs until they are, so that there is something to wait
        // for.
        if (model_.running == 1 && model_.mayProceed()) add(true);
        if (model_.running != static_cast<int>(withTask().size())) return; // it would never end
        bool const result = stops_ || random_() % 4 != 0;
        std::vector<MTQ_Dat*> const waiting = model_.running > 0 && model_.mayProceed() ? recordsThatWait() : Records();
        std::vector<GatedJob*> left;
        if (model_.running > 0) {
            auto const first = withTask().front();
            argumentOf(*first)->open(result);
            model_.finish(first, result);
            model_.startAll();
            for (auto const& job : withTask()) {
                left.push_back(argumentOf(*job));
                model_.finish(job, result);
            }
        }
        std::thread opener([&] {
            for (MTQ_Dat const* record : waiting) EXPECT_TRUE(waitFor([&] { return record->started(); }));
            for (GatedJob* job : left) job->open(result);
        });
        queue_->wait();
        opener.join();
        settle();
    }

    void compare() {
        EXPECT_EQ(queue_->failed(), model_.failed);
        EXPECT_EQ(queue_->running(), model_.running);
        MTQ_Dat const* record = queue_->first();
        for (ModelJob const& job : model_.jobs) {
            ASSERT_NE(record, nullptr);
            EXPECT_EQ(record->argument(), argumentOf(job)->argument());
            EXPECT_EQ(record->started(), job.isStarted);
            EXPECT_EQ(record->finished(), job.isFinished);
            EXPECT_EQ(record->result(), job.result);
            record = queue_->next();
        }
        EXPECT_EQ(record, nullptr);
    }

    std::mt19937_64 random_;
    bool const failsTasks_;
    bool const stops_;
    int const limit_;
    std::atomic<int> deletions_{0};
    std::vector<GatedJob*> arguments_;
    std::vector<std::unique_ptr<GatedJob>> borrowed_;
    QueueModel model_;
    std::unique_ptr<MTQ_Impl> queue_;
};

QueueAndModel::Step const QueueAndModel::STEPS[] = {
    {"add a job", 3, &QueueAndModel::addAny},
    {"end a running job", 3, &QueueAndModel::finishAny},
    {"have a running job removed", 1, &QueueAndModel::removeAny},
    {"wait", 1, &QueueAndModel::wait},
};

} // namespace

TEST(MTQ_Model, agrees_with_the_queue_over_random_steps_and_failing_tasks) {
    std::mt19937_64 random = randomSource();
    std::uint64_t const rounds = randomSteps(60);
    for (std::uint64_t i = 0; i < rounds && !testing::Test::HasFailure(); ++i) QueueAndModel(random(), true).run(60);
}

TEST(MTQ_Model, agrees_with_eight_queues_on_eight_threads) {
    constexpr unsigned THREADS = 8;
    std::uint64_t const rounds = randomSteps(10);
    std::vector<std::thread> threads;
    for (unsigned t = 0; t < THREADS; ++t) {
        threads.emplace_back([t, rounds] {
            std::mt19937_64 random(randomSource()() + t);
            for (std::uint64_t i = 0; i < rounds; ++i) QueueAndModel(random(), false).run(60);
        });
    }
    for (std::thread& thread : threads) thread.join();
}

namespace {

class Counted : public MTQ_Arg {
public:
    Counted(std::atomic<int>& ran, std::atomic<int>& deleted, bool result)
        : ran_(ran), deleted_(deleted), result_(result) {}
    ~Counted() override { ++deleted_; }
    static bool run(void* argument) {
        auto& self = *static_cast<Counted*>(static_cast<MTQ_Arg*>(argument));
        ++self.ran_;
        return self.result_;
    }

private:
    std::atomic<int>& ran_;
    std::atomic<int>& deleted_;
    bool const result_;
};

} // namespace

TEST(MTQ_Stress, runs_every_job_of_eight_adding_threads_once) {
    constexpr unsigned THREADS = 8;
    for (MultiTaskQueue::ErrPolicy policy : {MultiTaskQueue::Continue, MultiTaskQueue::StopOnError}) {
        std::atomic<int> ran{0}, deleted{0}, accepted{0}, refused{0};
        std::uint64_t const jobs = randomSteps(300);
        GatedJob first, last;
        {
            MTQ_Impl queue(policy, 3);
            auto const add = [&](bool result, bool startNow, bool removeWhenDone) {
                auto argument = std::make_unique<Counted>(ran, deleted, result);
                if (queue.add(Counted::run, static_cast<MTQ_Arg*>(argument.get()), true, startNow, removeWhenDone)) {
                    static_cast<void>(argument.release()); // the queue's
                    ++accepted;
                } else {
                    ++refused;
                }
            };
            std::atomic<unsigned> adding{THREADS};
            std::vector<std::thread> threads;
            for (unsigned t = 0; t < THREADS; ++t) {
                threads.emplace_back([&, t] {
                    std::mt19937_64 random(t);
                    for (std::uint64_t i = 0; i < jobs; ++i) {
                        add(policy == MultiTaskQueue::Continue ? random() % 5 != 0 : i != jobs - 20,
                            random() % 8 == 0 || i == jobs - 20, random() % 2 == 0);
                    }
                    --adding;
                });
            }
            while (adding != 0) {
                queue.wait();
                std::this_thread::yield();
            }
            for (std::thread& thread : threads) thread.join();
            // One ends, so that all that wait are started, and one runs until they have.
            for (GatedJob* job : {&first, &last}) {
                EXPECT_EQ(queue.add(GatedJob::run, job->argument(), false, true, false),
                          policy == MultiTaskQueue::Continue);
            }
            first.open();
            std::thread opener([&] {
                EXPECT_TRUE(policy != MultiTaskQueue::Continue || waitFor([&] { return ran == accepted; }));
                last.open();
            });
            queue.wait();
            opener.join();
            EXPECT_EQ(queue.running(), 0);
            EXPECT_TRUE(queue.failed());
            EXPECT_EQ(refused > 0, policy == MultiTaskQueue::StopOnError);
            EXPECT_LE(ran, accepted);
        }
        EXPECT_EQ(deleted, accepted + refused);
    }
}
