#include <zor_basis/sync.h>

#include "tests/support/table.h"
#include "tests/sync/queue_records.h"

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

std::string startedOnes(Queue const& queue) {
    std::string text;
    for (MTQ_Dat const* record : records(queue)) text += record->started() ? 's' : '-';
    return text;
}

bool succeed(void*) { return true; }
bool fail(void*) { return false; }

} // namespace

TEST(MultiTaskQueue, breathes) {
    Queue const queue = make(MultiTaskQueue::Continue, 2);
    std::atomic<int> ran{0};
    for (int i = 0; i < 10; ++i) {
        EXPECT_TRUE(queue->add([](void* count) { return ++*static_cast<std::atomic<int>*>(count) > 0; }, &ran, false,
                               true, false));
    }
    queue->wait();
    EXPECT_EQ(ran, 10);
    EXPECT_FALSE(queue->failed());
    EXPECT_EQ(records(queue).size(), 10u);
    for (MTQ_Dat const* record : records(queue)) {
        EXPECT_TRUE(record->started() && record->finished() && record->result());
        EXPECT_EQ(record->argument(), &ran);
    }
}

TEST(MultiTaskQueue, that_is_empty_waits_for_nothing) {
    Queue const queue = make(MultiTaskQueue::StopOnError, 3);
    queue->wait();
    EXPECT_FALSE(queue->failed());
    EXPECT_EQ(queue->first(), nullptr);
    EXPECT_EQ(queue->next(), nullptr);
    EXPECT_EQ(queue->current(), nullptr);
}

TEST(MultiTaskQueue, starts_as_many_as_the_limit_says_and_all_that_are_forced) {
    struct Case {
        Row row;
        int limit;
        /// For each job: f forced, q not.
        char const* jobs;
        char const* started;
    };
    for (Case const& c : {
             Case{{}, 2, "qqqqq", "ss---"},
             Case{{}, 0, "qqq", "---"},
             Case{{}, -5, "qfq", "-s-"},
             Case{{}, 1, "fq", "s-"},
             Case{{}, 1, "qff", "sss"},
             Case{{}, 3, "fqqqq", "sss--"},
             Case{{}, 2, "ffqfq", "ss-s-"},
             Case{{}, 2147483647, "qqqq", "ssss"},
             Case{{}, -2147483647 - 1, "q", "-"},
         }) {
        SCOPED_TRACE(c.row);
        std::vector<GatedJob> jobs(std::strlen(c.jobs));
        {
            Queue const queue = make(MultiTaskQueue::Continue, c.limit);
            for (std::size_t i = 0; i < jobs.size(); ++i) EXPECT_TRUE(add(queue, jobs[i], c.jobs[i] == 'f'));
            EXPECT_EQ(startedOnes(queue), c.started);
            for (GatedJob& job : jobs) job.open();
            queue->wait();
        }
    }
}

TEST(MultiTaskQueue, counts_finished_jobs_no_longer_to_the_limit) {
    Queue const queue = make(MultiTaskQueue::Continue, 1);
    GatedJob first, second;
    EXPECT_TRUE(add(queue, first));
    EXPECT_TRUE(add(queue, second));
    EXPECT_EQ(startedOnes(queue), "s-");
    first.open();
    // The job counts until it has reported its end.
    GatedJob* last = nullptr;
    EXPECT_TRUE(waitFor([&] {
        last = new GatedJob;
        queue->add(GatedJob::run, last->argument(), true, false, false);
        return records(queue).back()->started();
    }));
    EXPECT_FALSE(second.runs()) << "what was queued before stays there until somebody waits";
    std::thread opener([&] {
        EXPECT_TRUE(waitFor([&] { return second.runs(); }));
        for (MTQ_Dat* record : records(queue)) {
            static_cast<GatedJob*>(static_cast<MTQ_Arg*>(record->argument()))->open();
        }
    });
    queue->wait();
    opener.join();
}

TEST(MultiTaskQueue, Kept_queue_02_waiting_starts_all_that_are_left_when_a_job_finishes) {
    Queue const queue = make(MultiTaskQueue::Continue, 2);
    std::vector<GatedJob> jobs(5);
    for (GatedJob& job : jobs) EXPECT_TRUE(add(queue, job));
    std::atomic<bool> hasWaited{false};
    std::thread waiter([&] {
        queue->wait();
        hasWaited = true;
    });
    EXPECT_TRUE(notInAMoment([&] { return jobs[2].runs() || hasWaited; }));
    jobs[1].open();
    EXPECT_TRUE(waitFor([&] { return jobs[2].runs() && jobs[3].runs() && jobs[4].runs(); })) << "together";
    EXPECT_FALSE(hasWaited);
    for (GatedJob& job : jobs) job.open();
    waiter.join();
    EXPECT_EQ(startedOnes(queue), "sssss");
}

/// What the header shows.
TEST(MultiTaskQueue, runs_no_more_at_a_time_than_jobs_that_share_the_work) {
    struct Page {
        std::atomic<int>* running;
        std::atomic<int>* most;
        bool render() const {
            int const now = ++*running;
            for (int before = *most; now > before && !most->compare_exchange_weak(before, now);) {}
            std::this_thread::sleep_for(std::chrono::microseconds(200));
            --*running;
            return true;
        }
    };
    struct Pages {
        std::vector<Page> all;
        std::atomic<std::size_t> next{0};
        static bool render(void* argument) {
            auto& pages = *static_cast<Pages*>(argument);
            bool good = true;
            for (std::size_t i; (i = pages.next++) < pages.all.size();) good = pages.all[i].render() && good;
            return good;
        }
    } pages;
    std::atomic<int> running{0}, most{0};
    pages.all.assign(74, Page{&running, &most});
    Queue const queue = make(MultiTaskQueue::Continue, 4);
    for (int i = 0; i < 4; ++i) queue->add(Pages::render, &pages, false, true, false);
    queue->wait();
    EXPECT_FALSE(queue->failed());
    EXPECT_GE(pages.next, 74u);
    EXPECT_LE(most, 4);
}

TEST(MultiTaskQueue, remembers_failures_and_results) {
    Queue const queue = make(MultiTaskQueue::Continue, 100);
    EXPECT_TRUE(queue->add(succeed, nullptr, false, false, false));
    EXPECT_TRUE(queue->add(fail, nullptr, false, false, false));
    queue->wait();
    EXPECT_TRUE(queue->failed());
    EXPECT_TRUE(queue->add(succeed, nullptr, false, false, false)) << "goes on";
    queue->wait();
    EXPECT_TRUE(queue->failed()) << "for good";
    std::vector<MTQ_Dat*> const all = records(queue);
    EXPECT_TRUE(all[0]->result() && !all[1]->result() && all[2]->result());
}

TEST(MultiTaskQueue, stops_on_error_where_it_is_told_to) {
    for (std::uint32_t policy : {1u, 2u, 0xFFFF'FFFFu}) {
        SCOPED_TRACE(policy);
        std::atomic<int> deletions{0};
        GatedJob* const refused = new GatedJob(&deletions);
        GatedJob first, second, queued, late;
        {
            Queue const queue = make(static_cast<MultiTaskQueue::ErrPolicy>(policy), 2);
            EXPECT_TRUE(add(queue, first));
            EXPECT_TRUE(add(queue, second));
            EXPECT_TRUE(add(queue, queued));
            first.open(false);
            EXPECT_TRUE(waitFor([&] { return queue->failed(); }));
            EXPECT_FALSE(add(queue, late));
            EXPECT_FALSE(add(queue, late, true)) << "forced or not";
            EXPECT_FALSE(queue->add(GatedJob::run, refused->argument(), true, true, false));
            EXPECT_EQ(startedOnes(queue), "ss-") << "what was refused is not listed";
            second.open();
            queue->wait();
            EXPECT_EQ(startedOnes(queue), "ss-");
            EXPECT_TRUE(records(queue)[1]->result()) << "what ran goes on to its end";
            EXPECT_FALSE(records(queue)[2]->finished());
        }
        EXPECT_EQ(deletions, 0) << "a refused argument stays the caller's";
        delete refused;
        EXPECT_FALSE(late.runs() || queued.runs());
    }
}

TEST(MultiTaskQueue, deletes_owned_arguments_once_when_it_drops_their_jobs) {
    std::atomic<int> deletions{0};
    GatedJob borrowed(&deletions);
    {
        Queue const queue = make(MultiTaskQueue::Continue, 10);
        std::vector<GatedJob*> owned;
        for (int i = 0; i < 3; ++i) {
            owned.push_back(new GatedJob(&deletions));
            EXPECT_TRUE(queue->add(GatedJob::run, owned.back()->argument(), true, false, i == 1));
        }
        EXPECT_TRUE(queue->add(GatedJob::run, (new GatedJob(&deletions))->argument(), true, false, true));
        EXPECT_TRUE(add(queue, borrowed));
        auto* const last = static_cast<GatedJob*>(static_cast<MTQ_Arg*>(records(queue)[3]->argument()));
        for (GatedJob* job : owned) job->open();
        last->open(false);
        borrowed.open();
        queue->wait();
        EXPECT_EQ(deletions, 2) << "those that go when they are done";
        EXPECT_EQ(records(queue).size(), 3u);
        EXPECT_TRUE(queue->failed());
        EXPECT_TRUE(queue->add(succeed, nullptr, true, false, false)) << "null is nothing to delete";
        queue->wait();
    }
    EXPECT_EQ(deletions, 4);
}

TEST(MultiTaskQueue, deletes_arguments_of_jobs_that_never_started) {
    std::atomic<int> deletions{0};
    {
        Queue const queue = make(MultiTaskQueue::Continue, 0);
        for (int i = 0; i < 5; ++i) {
            EXPECT_TRUE(queue->add(GatedJob::run, (new GatedJob(&deletions))->argument(), true, false, i % 2 == 0));
        }
    }
    EXPECT_EQ(deletions, 5);
}

TEST(MultiTaskQueue, lists_jobs_in_the_order_of_adding) {
    Queue const queue = make(MultiTaskQueue::Continue, 0);
    int numbers[4] = {};
    for (int& number : numbers) queue->add(succeed, &number, false, false, false);
    EXPECT_EQ(queue->current(), nullptr);
    EXPECT_EQ(queue->next(), nullptr) << "no walk yet";
    MTQ_Dat* record = queue->first();
    for (int& number : numbers) {
        ASSERT_NE(record, nullptr);
        EXPECT_EQ(record, queue->current());
        EXPECT_EQ(record->argument(), &number);
        record = queue->next();
    }
    EXPECT_EQ(record, nullptr);
    EXPECT_EQ(queue->current(), nullptr);
    EXPECT_EQ(queue->next(), nullptr);
    EXPECT_EQ(queue->first()->argument(), &numbers[0]);
}

TEST(MultiTaskQueue, goes_on_behind_a_record_that_was_dropped_under_the_walk) {
    for (std::size_t dropped : {0u, 1u, 2u}) {
        SCOPED_TRACE(dropped);
        Queue const queue = make(MultiTaskQueue::Continue, 10);
        std::vector<GatedJob> jobs(3);
        for (GatedJob& job : jobs) add(queue, job, true, true);
        queue->first();
        for (std::size_t i = 0; i < dropped; ++i) queue->next();
        ASSERT_NE(queue->current(), nullptr);
        jobs[dropped].open();
        EXPECT_TRUE(waitFor([&] { return queue->current() == nullptr; }));
        if (dropped < 2) {
            MTQ_Dat const* const following = queue->next();
            ASSERT_NE(following, nullptr);
            EXPECT_EQ(following->argument(), jobs[dropped + 1].argument());
            EXPECT_EQ(queue->current(), following);
        } else {
            EXPECT_EQ(queue->next(), nullptr);
        }
        for (GatedJob& job : jobs) job.open();
        queue->wait();
    }
}

TEST(MultiTaskQueue, runs_jobs_that_jobs_add) {
    struct Family {
        Queue queue = make(MultiTaskQueue::Continue, 1);
        std::atomic<int> left{50};
        static bool child(void* family) {
            auto& self = *static_cast<Family*>(family);
            return --self.left < 0 || self.queue->add(child, family, false, true, true);
        }
    } family;
    family.queue->add(Family::child, &family, false, true, true);
    family.queue->wait();
    EXPECT_LT(family.left, 0);
    EXPECT_FALSE(family.queue->failed());
    EXPECT_EQ(family.queue->first(), nullptr);
}

TEST(MultiTaskQueue, may_be_deleted_as_soon_as_waiting_ends) {
    for (int i = 0; i < 2000; ++i) {
        Queue const queue = make(MultiTaskQueue::Continue, 4);
        for (int job = 0; job < 3; ++job) queue->add(succeed, nullptr, false, false, job == 1);
        queue->wait();
    }
}

TEST(MultiTaskQueue, has_looked_at_every_end_when_waiting_ends) {
    struct Slow : MTQ_Arg {
        explicit Slow(std::atomic<bool>& flag) : isDeleted(flag) {}
        ~Slow() override {
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
            isDeleted = true;
        }
        std::atomic<bool>& isDeleted;
    };
    for (int i = 0; i < 20; ++i) {
        std::atomic<bool> isDeleted{false};
        Queue const queue = make(MultiTaskQueue::Continue, 1);
        queue->add(fail, static_cast<MTQ_Arg*>(new Slow(isDeleted)), true, true, true);
        queue->wait();
        EXPECT_TRUE(isDeleted);
        EXPECT_TRUE(queue->failed());
        EXPECT_EQ(queue->first(), nullptr);
    }
}
