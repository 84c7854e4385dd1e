#include "host/xos_basics/control/call_texts.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <thread>

namespace {

using host::CallTexts;
using host::NULL_TEXT;

/// Exactly as large as the text, so that a sanitizer sees what is read behind it.
std::unique_ptr<char[]> exactCopy(std::string const& text) {
    auto copy = std::make_unique<char[]>(text.size() + 1);
    std::copy_n(text.c_str(), text.size() + 1, copy.get());
    return copy;
}

std::string textOf(std::size_t length) {
    std::string text(length, ' ');
    for (std::size_t i = 0; i < length; ++i) { text[i] = static_cast<char>('!' + i % 90); }
    return text;
}

TEST(CallTexts, keeps_texts_until_the_next_call) {
    CallTexts texts;
    texts.begin();
    std::uint64_t const place = texts.add("ticket");
    texts.end();
    std::lock_guard const lock{texts};
    EXPECT_STREQ(texts.text(place), "ticket");
}

TEST(CallTexts, copies_texts_of_every_length_side_by_side) {
    CallTexts texts;
    for (std::size_t length = 0; length < 600; ++length) {
        SCOPED_TRACE(length);
        std::string const first = textOf(length);
        std::string const second = textOf(length % 37);
        texts.begin();
        std::uint64_t const places[] = {texts.add(exactCopy(first).get()), texts.add(nullptr),
                                        texts.add(exactCopy(second).get()), texts.add(exactCopy(first).get())};
        texts.end();
        std::lock_guard const lock{texts};
        EXPECT_EQ(texts.text(places[0]), first);
        EXPECT_EQ(places[1], NULL_TEXT);
        EXPECT_EQ(texts.text(places[2]), second);
        EXPECT_EQ(texts.text(places[3]), first);
    }
}

TEST(CallTexts, keeps_the_texts_of_one_call_while_they_are_read) {
    constexpr int READINGS = 200;
    CallTexts texts;
    std::atomic<bool> isOver{false};
    std::atomic<bool> hasBegun{false};
    std::thread caller([&] {
        for (std::size_t i = 0; !isOver; ++i) {
            std::string const text = std::to_string(i % 10) + std::string(40, static_cast<char>('a' + i % 26));
            std::string const longText(i % 5'000, 'x');
            texts.begin();
            texts.add(text.c_str());
            texts.add(text.c_str());
            texts.add(longText.c_str());
            texts.end();
            hasBegun = true;
        }
    });
    while (!hasBegun) { std::this_thread::yield(); }
    int torn = 0;
    for (int i = 0; i < READINGS; ++i) {
        std::lock_guard const lock{texts};
        std::string const first = texts.text(0);
        std::this_thread::yield();
        torn += first.size() != 41 || first != texts.text(42);
    }
    isOver = true;
    caller.join();
    EXPECT_EQ(torn, 0);
}

} // namespace
