// What is in each block at the moment when it is released. The linker leads every `malloc` and `free` of this program's
// objects here, the library's own ones included.

#include <zor_basis/store/blob.h>

#include "tests/support/memory_file.h"
#include "tests/support/watched_blocks.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

void begin() {
    watch = {};
    watch.on = true;
}

/// Ends watching. \return the blocks made, of which all must have been released, wiped or not
std::size_t end(bool wiped) {
    watch.on = false;
    for (std::size_t i = 0; i < watch.made; ++i) {
        EXPECT_TRUE(watch.blocks[i].released) << i;
        EXPECT_EQ(watch.blocks[i].wiped, wiped) << i;
    }
    return watch.made;
}

} // namespace

namespace {

constexpr char KEY[] = "0123456789ABCDEF";

/// Fills a blob and then releases its blocks in every way there is.
template <class B>
std::size_t everyWay(bool wiped) {
    MemoryFile file(std::string("\x28\0\0\0", 4) + std::string(40, 'k'));
    std::size_t blocks = 0;

    begin();
    {
        B blob;
        blob.copy(8, KEY);
        blob.copy(16, KEY); // replaced by copy
        blob.add(4, KEY);   // by add
        blob.alloc(30, true);
        blob.alloc(31, false);
        blob.copy(31, "a text that fills all the block");
        blob.read(&file);
        EXPECT_EQ(blob.size(), 40u);
        blob.clear(); // the end wipes what is behind the size, too
    }
    blocks += end(wiped);

    begin();
    {
        B blob;
        blob.copy(16, KEY);
        B copy(blob);
        B assigned;
        assigned.copy(3, KEY);
        assigned = blob;
    }
    blocks += end(wiped);

    begin();
    {
        B blob;
        blob.copy(16, KEY);
        blob.add(16, blob.val());
        blob.copy(8, blob.val() + 4);
    }
    blocks += end(wiped);
    return blocks;
}

} // namespace

TEST(SecretBlob, wipes_every_block_before_it_is_released) { EXPECT_EQ(everyWay<SecretBlob>(true), 12u); }

TEST(SecretBlob, is_what_wipes_as_a_plain_blob_does_not) { EXPECT_EQ(everyWay<Blob>(false), 12u); }

TEST(SecretBlob, wipes_when_it_is_deleted_as_a_blob) {
    Blob* const blob = new SecretBlob;
    blob->copy(0, nullptr);
    begin();
    blob->copy(16, KEY);
    watch.on = false;
    Watch const made = watch;
    watch.on = true;
    delete blob;
    EXPECT_EQ(made.made, 1u);
    EXPECT_EQ(end(true), 1u);
}

TEST(SecretBlob, wipes_when_it_grows_as_a_blob) {
    begin();
    {
        SecretBlob secret;
        Blob& blob = secret;
        blob.copy(8, KEY);
        blob.add(8, KEY);
    }
    EXPECT_EQ(end(true), 2u);
}

TEST(SecretBlob, reports_a_length_for_which_there_is_no_memory) {
    MemoryFile file(std::string("\xFF\xFF\xFF\xFF", 4) + "abc");
    SecretBlob secret;
    secret.copy(4, KEY);
    Blob blob(4, KEY);
    watch = {};
    watch.on = true;
    watch.hasMemory = false;
    EXPECT_FALSE(secret.read(&file));
    file.position = 0;
    EXPECT_FALSE(blob.read(&file));
    blob.copy(5, KEY);
    blob.add(1, KEY);
    blob.alloc(5, true);
    blob.alloc(5, false);
    blob.add(~std::uint64_t{0} - 1, KEY);
    watch.on = false;
    EXPECT_EQ(secret.size(), 4u);
    EXPECT_EQ(blob.size(), 4u);
    EXPECT_EQ(blob.sizeBuf(), 4u);
    EXPECT_EQ(std::memcmp(blob.val(), KEY, 4), 0);
}
