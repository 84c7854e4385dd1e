#include "host/xos_basics/system/kept_texts.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

namespace {

TEST(HostKeptTexts, stay_as_they_were_when_they_were_kept) {
    std::string text = "first";
    char const* const kept = host::keptText(text.c_str());
    text = "other";
    EXPECT_STREQ(kept, "first");
    for (int i = 0; i < 1000; ++i) { host::keptText(std::to_string(i).c_str()); }
    EXPECT_STREQ(kept, "first");
}

TEST(HostKeptTexts, share_one_copy_of_equal_texts) {
    std::string const text = "equal";
    EXPECT_EQ(host::keptText("equal"), host::keptText(text.c_str()));
    EXPECT_NE(host::keptText("equal"), host::keptText("Equal"));
}

TEST(HostKeptTexts, take_null_for_the_empty_text) {
    EXPECT_STREQ(host::keptText(nullptr), "");
    EXPECT_STREQ(host::keptText(""), "");
}

TEST(HostKeptTexts, are_shared_by_threads) {
    std::vector<char const*> kept(4);
    std::vector<std::thread> threads;
    for (char const*& place : kept) {
        threads.emplace_back([&place] {
            for (int i = 0; i < 500; ++i) { place = host::keptText(("shared " + std::to_string(i)).c_str()); }
        });
    }
    for (std::thread& thread : threads) { thread.join(); }
    for (char const* const text : kept) { EXPECT_EQ(text, kept.front()); }
}

} // namespace
