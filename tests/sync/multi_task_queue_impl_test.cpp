#include "basis/sync/multi_task_queue_impl.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"
#include "tests/sync/gated_job.h"

#include <xos_host.h>

#include <gtest/gtest.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

class MTQ_ImplCalls : public testing::Test {
protected:
    ~MTQ_ImplCalls() override { xos_HostFailClear(); }
};

bool add(MultiTaskQueue& queue, GatedJob& job, bool startNow = true) {
    return queue.add(GatedJob::run, job.argument(), false, startNow, false);
}

bool isQuiet(MTQ_Impl const& queue, std::int32_t running) {
    return waitFor([&] { return queue.running() == running && queue.ending() == 0; });
}

bool succeed(void*) { return true; }

/// What became of the arguments that a queue owned.
struct Ends {
    std::atomic<int> onOwnTask{0};
    std::atomic<int> elsewhere{0};
};

/// Knows the thread of its job.
class TaskArgument : public MTQ_Arg {
public:
    explicit TaskArgument(Ends& ends) : ends_(ends) {}
    ~TaskArgument() override {
        ++(std::this_thread::get_id() == task_ ? ends_.onOwnTask : ends_.elsewhere);
        if (gate_ != nullptr) gate_->run(gate_->argument());
    }
    TaskArgument(TaskArgument const&) = delete;
    TaskArgument& operator=(TaskArgument const&) = delete;

    /// Keeps the destructor, and with it the queue's mutex, until the gate opens.
    void endBehind(GatedJob& gate) { gate_ = &gate; }
    void* argument() { return static_cast<MTQ_Arg*>(this); }

    static bool run(void* argument) {
        static_cast<TaskArgument*>(static_cast<MTQ_Arg*>(argument))->task_ = std::this_thread::get_id();
        return true;
    }

private:
    Ends& ends_;
    GatedJob* gate_ = nullptr;
    std::thread::id task_;
};

bool addOwned(MultiTaskQueue& queue, TaskArgument* argument) {
    return queue.add(TaskArgument::run, argument->argument(), true, true, true);
}

} // namespace

TEST_F(MTQ_ImplCalls, makes_a_mutex_and_an_empty_signal_and_destroys_them) {
    xos_HostCallsReset();
    std::unique_ptr<MultiTaskQueue> queue(MultiTaskQueue::New(MultiTaskQueue::Continue, 1));
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 1u);
    EXPECT_STREQ(xos_HostLastCall("xos_SemBCreate"), "0");
    EXPECT_EQ(xos_HostCalls("xos_SemBCreate"), 1u);
    queue.reset();
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 2u);
}

TEST_F(MTQ_ImplCalls, is_destroyed_only_after_the_jobs_that_are_ending_have_left_it) {
    Ends ends;
    GatedJob gate;
    auto* const argument = new TaskArgument(ends);
    argument->endBehind(gate);
    auto* const queue = new MTQ_Impl(MultiTaskQueue::Continue, 1);
    EXPECT_EQ(queue->ending(), 0u);
    ASSERT_TRUE(addOwned(*queue, argument));
    ASSERT_TRUE(waitFor([&] { return gate.runs(); }));
    EXPECT_EQ(queue->ending(), 1u) << "its function has returned, its end is not reported yet";
    std::atomic<bool> isDestroyed{false};
    std::thread destroyer([&] {
        delete queue;
        isDestroyed = true;
    });
    EXPECT_TRUE(notInAMoment([&] { return isDestroyed.load(); }));
    gate.open();
    destroyer.join();
    EXPECT_TRUE(isDestroyed);
    EXPECT_EQ(ends.onOwnTask, 1);
}

TEST_F(MTQ_ImplCalls, makes_tasks_with_the_same_parameters_always) {
    MTQ_Impl queue(MultiTaskQueue::Continue, 0);
    for (bool byRecord : {false, true}) {
        SCOPED_TRACE(byRecord);
        queue.add(succeed, nullptr, false, !byRecord, false);
        MTQ_Dat* record = queue.first();
        while (MTQ_Dat* const next = queue.next()) record = next;
        if (byRecord) { EXPECT_TRUE(record->start()); }
        char expected[100];
        std::snprintf(expected, sizeof expected, ", 0x%llx, 0x0, -9, 0, \"MTQ_Dat::start\", 0",
                      static_cast<unsigned long long>(reinterpret_cast<std::uintptr_t>(record)));
        std::string const call = xos_HostLastCall("xos_TaskCreate");
        EXPECT_EQ(call.substr(call.find(',')), expected);
        EXPECT_TRUE(waitFor([&] { return record->finished(); }));
    }
}

TEST_F(MTQ_ImplCalls, walks_under_its_mutex_but_not_at_the_end) {
    MTQ_Impl queue(MultiTaskQueue::Continue, 0);
    queue.add(succeed, nullptr, false, false, false);
    xos_HostCallsReset();
    queue.first();
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 1u);
    queue.next();
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    queue.next();
    queue.current();
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 2u);
}

TEST_F(MTQ_ImplCalls, Kept_queue_01_a_task_that_cannot_be_made_counts_as_running_for_ever) {
    for (bool forced : {false, true}) {
        std::atomic<int> deletions{0};
        {
            MTQ_Impl queue(MultiTaskQueue::Continue, 1);
            xos_HostFail("xos_TaskCreate", 0, 1);
            EXPECT_FALSE(queue.add(GatedJob::run, (new GatedJob(&deletions))->argument(), true, forced, true));
            MTQ_Dat* const record = queue.first();
            ASSERT_NE(record, nullptr) << "it is listed all the same";
            EXPECT_TRUE(record->started() && record->finished() && !record->result());
            EXPECT_TRUE(queue.failed());
            EXPECT_EQ(queue.running(), 1);
            EXPECT_EQ(deletions, 0);
            EXPECT_TRUE(queue.add(succeed, nullptr, false, false, false)) << "waits, as the limit is reached";
            EXPECT_TRUE(queue.add(succeed, nullptr, false, true, false));
            std::atomic<bool> hasWaited{false};
            std::thread waiter([&] {
                queue.wait();
                hasWaited = true;
            });
            EXPECT_TRUE(isQuiet(queue, 1)) << "the others have run";
            EXPECT_TRUE(notInAMoment([&] { return hasWaited.load(); }));
            queue.done(*record); // what no task will do
            waiter.join();
            EXPECT_EQ(deletions, 1) << "it was to be removed when done";
        }
        EXPECT_EQ(deletions, 1);
    }
}

TEST_F(MTQ_ImplCalls, keeps_the_argument_of_a_task_that_could_not_be_made_and_deletes_it_later) {
    std::atomic<int> deletions{0};
    {
        MTQ_Impl queue(MultiTaskQueue::StopOnError, 1);
        xos_HostFail("xos_TaskCreate", 0, 1);
        EXPECT_FALSE(queue.add(GatedJob::run, (new GatedJob(&deletions))->argument(), true, true, false));
        EXPECT_FALSE(queue.add(succeed, nullptr, false, true, false)) << "the queue has failed";
        EXPECT_EQ(deletions, 0);
    }
    EXPECT_EQ(deletions, 1);
}

TEST_F(MTQ_ImplCalls, starts_no_more_where_a_task_fails_while_all_that_wait_are_started) {
    struct Case {
        Row row;
        MultiTaskQueue::ErrPolicy policy;
        bool lastOneRuns;
    };
    for (Case const& c : {Case{{}, MultiTaskQueue::Continue, true}, Case{{}, MultiTaskQueue::StopOnError, false}}) {
        SCOPED_TRACE(c.row);
        GatedJob keeper, first, second, third, fourth; // the keeper runs, so that there is something to wait for
        MTQ_Impl queue(c.policy, 2);
        for (GatedJob* job : {&keeper, &first, &second, &third, &fourth}) EXPECT_TRUE(add(queue, *job, false));
        xos_HostFail("xos_TaskCreate", 1, 1); // the third job's
        std::thread waiter([&] { queue.wait(); });
        first.open();
        EXPECT_TRUE(waitFor([&] { return second.runs() && queue.failed(); }));
        for (GatedJob* job : {&keeper, &second, &fourth}) job->open();
        EXPECT_TRUE(isQuiet(queue, 1));
        EXPECT_EQ(fourth.runs(), c.lastOneRuns);
        EXPECT_FALSE(third.runs());
        queue.first();
        for (int i = 0; i < 3; ++i) queue.next();
        MTQ_Dat* const record = queue.current();
        EXPECT_EQ(record->argument(), third.argument());
        EXPECT_TRUE(record->finished());
        queue.done(*record);
        waiter.join();
    }
}

TEST_F(MTQ_ImplCalls, Kept_queue_03_does_not_fail_where_a_record_cannot_start) {
    MTQ_Impl queue(MultiTaskQueue::StopOnError, 0);
    queue.add(succeed, nullptr, false, false, false);
    xos_HostFail("xos_TaskCreate", 0, 1);
    EXPECT_FALSE(queue.first()->start());
    EXPECT_TRUE(queue.first()->started() && queue.first()->finished());
    EXPECT_FALSE(queue.failed());
    EXPECT_EQ(queue.running(), 0);
    queue.add(succeed, nullptr, false, false, false);
    EXPECT_EQ(queue.first(), queue.current());
    MTQ_Dat* const second = queue.next();
    EXPECT_TRUE(second->start());
    EXPECT_TRUE(isQuiet(queue, -1));
}

TEST_F(MTQ_ImplCalls, goes_on_where_its_mutex_cannot_be_taken_and_gives_nothing_back_then) {
    for (std::uint32_t skip = 0; skip < 6; ++skip) {
        SCOPED_TRACE(skip);
        MTQ_Impl queue(MultiTaskQueue::Continue, 1);
        GatedJob job;
        xos_HostFail("xos_SemTake", skip, 1);
        EXPECT_TRUE(add(queue, job, false));                           // calls 0 and 1
        EXPECT_TRUE(queue.add(succeed, nullptr, false, false, false)); // 2
        EXPECT_EQ(queue.first()->argument(), job.argument());          // 3
        EXPECT_NE(queue.next(), nullptr);                              // 4
        xos_HostCallsReset();
        job.open();
        EXPECT_TRUE(isQuiet(queue, 0)); // 5: the end's report
        EXPECT_EQ(xos_HostCalls("xos_SemGive"), skip == 5 ? 1u : 2u);
        queue.add(succeed, nullptr, false, true, false);
        queue.wait();
        EXPECT_TRUE(isQuiet(queue, 0));
        xos_HostFailClear();
    }
}

TEST_F(MTQ_ImplCalls, goes_on_without_semaphores) {
    for (char const* function : {"xos_SemMCreate", "xos_SemBCreate"}) {
        SCOPED_TRACE(function);
        xos_HostFail(function, 0, 1);
        MTQ_Impl queue(MultiTaskQueue::Continue, 1);
        GatedJob first, second;
        EXPECT_TRUE(add(queue, first, false));
        EXPECT_TRUE(add(queue, second, false));
        std::uint64_t const sleeps = xos_HostCalls("xos_TaskSleep");
        first.open();
        EXPECT_TRUE(isQuiet(queue, 0));
        EXPECT_FALSE(second.runs());
        GatedJob third;
        EXPECT_TRUE(add(queue, third));
        std::thread opener([&] {
            EXPECT_TRUE(waitFor([&] { return second.runs(); }));
            second.open();
            third.open();
        });
        queue.wait();
        opener.join();
        EXPECT_TRUE(isQuiet(queue, 0));
        EXPECT_EQ(xos_HostCalls("xos_TaskSleep") > sleeps, std::string(function) == "xos_SemBCreate")
            << "rests where there is no signal to wait for";
    }
}

TEST_F(MTQ_ImplCalls, ends_each_job_under_its_mutex_on_the_jobs_own_task) {
    constexpr int JOBS = 400;
    constexpr int TAKES_OF_A_JOB = 3; // to add it, to start it, to report its end
    Ends ends;
    MTQ_Impl queue(MultiTaskQueue::Continue, 0);
    xos_HostCallsReset();
    for (int i = 0; i < JOBS; ++i) EXPECT_TRUE(addOwned(queue, new TaskArgument(ends)));
    EXPECT_TRUE(isQuiet(queue, 0));
    EXPECT_EQ(ends.onOwnTask, JOBS);
    EXPECT_EQ(ends.elsewhere, 0);
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), std::uint64_t{TAKES_OF_A_JOB} * JOBS);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), std::uint64_t{TAKES_OF_A_JOB + 1} * JOBS) << "the signal, too";
}

TEST_F(MTQ_ImplCalls, leaves_no_job_to_the_task_of_another_that_waits_for_the_mutex) {
    Ends ends;
    GatedJob gate;
    MTQ_Impl queue(MultiTaskQueue::Continue, 0);
    GatedJob first, second;
    struct Gated : TaskArgument {
        Gated(Ends& all, GatedJob& own) : TaskArgument(all), job(own) {}
        GatedJob& job;
        static bool run(void* argument) {
            TaskArgument::run(argument);
            return GatedJob::run(static_cast<Gated*>(static_cast<MTQ_Arg*>(argument))->job.argument());
        }
    };
    for (GatedJob* job : {&first, &second}) {
        EXPECT_TRUE(queue.add(Gated::run, (new Gated(ends, *job))->argument(), true, true, true));
    }
    auto* const keeper = new TaskArgument(ends);
    keeper->endBehind(gate);
    EXPECT_TRUE(addOwned(queue, keeper));
    EXPECT_TRUE(waitFor([&] { return gate.runs(); })) << "the mutex is held";
    first.open();
    EXPECT_TRUE(waitFor([&] { return queue.ending() == 2; }));
    second.open();
    EXPECT_TRUE(waitFor([&] { return queue.ending() == 3; }));
    EXPECT_TRUE(notInAMoment([&] { return queue.ending() != 3; })) << "each waits for the mutex itself";
    gate.open();
    EXPECT_TRUE(isQuiet(queue, 0));
    EXPECT_EQ(ends.onOwnTask, 3);
    EXPECT_EQ(ends.elsewhere, 0);
}

TEST_F(MTQ_ImplCalls, drops_its_jobs_where_its_semaphores_cannot_be_destroyed) {
    for (std::uint32_t skip : {0u, 1u}) {
        std::atomic<int> deletions{0};
        {
            MTQ_Impl queue(MultiTaskQueue::Continue, 0);
            queue.add(GatedJob::run, (new GatedJob(&deletions))->argument(), true, false, false);
            xos_HostFail("xos_SemDestroy", skip, 1);
        }
        EXPECT_EQ(deletions, 1);
    }
}
