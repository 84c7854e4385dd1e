#include "tests/sync/queue_records.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(MTQ_DatOfAQueue, drops_a_job_that_is_told_so_while_it_runs) {
    Queue const queue = make(MultiTaskQueue::Continue, 10);
    GatedJob first, second;
    EXPECT_TRUE(add(queue, first));
    EXPECT_TRUE(add(queue, second));
    queue->first()->setRemoveWhenDone();
    first.open();
    second.open();
    queue->wait();
    ASSERT_EQ(records(queue).size(), 1u);
    EXPECT_EQ(records(queue)[0]->argument(), second.argument());
    records(queue)[0]->setRemoveWhenDone();
    EXPECT_EQ(records(queue).size(), 1u) << "too late";
}

TEST(MTQ_DatOfAQueue, Kept_queue_03_counts_only_the_end_of_a_job_that_is_started_by_its_record) {
    Queue const queue = make(MultiTaskQueue::StopOnError, 0);
    GatedJob direct, first, second;
    EXPECT_TRUE(add(queue, direct));
    EXPECT_TRUE(queue->first()->start());
    EXPECT_TRUE(queue->first()->started());
    EXPECT_TRUE(waitFor([&] { return direct.runs(); }));
    queue->wait(); // nothing that it knows of runs
    EXPECT_FALSE(queue->first()->finished());
    EXPECT_TRUE(add(queue, first, true)); // running: 1
    direct.open(false);
    EXPECT_TRUE(waitFor([&] { return queue->failed(); })) << "its end is reported all the same";
    queue->wait(); // the other's end counted for the one that still runs
    EXPECT_FALSE(records(queue)[1]->finished());
    first.open();
    EXPECT_TRUE(waitFor([&] { return records(queue)[1]->finished(); }));
}

TEST(MTQ_DatOfAQueue, drops_a_job_that_was_started_by_its_record) {
    for (int i = 0; i < 500; ++i) {
        std::atomic<int> deletions{0};
        Queue queue = make(MultiTaskQueue::Continue, 0);
        auto* const job = new GatedJob(&deletions);
        job->open();
        queue->add(GatedJob::run, job->argument(), true, false, true);
        EXPECT_TRUE(queue->first()->start());
        EXPECT_TRUE(waitFor([&] { return deletions == 1; }));
        queue.reset();
    }
}
