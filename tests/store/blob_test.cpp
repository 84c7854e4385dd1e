#include <zor_basis/text/blob.h>

#include "tests/support/memory_file.h"
#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

template <class B>
struct BlobOfEitherKind : testing::Test {
    static B make(std::string const& bytes) {
        B blob;
        blob.copy(bytes.size(), bytes.data());
        return blob;
    }
    static std::string bytes(Blob const& blob) {
        return blob.size() != 0 ? std::string(blob.val(), blob.size()) : std::string();
    }
};

using Blobs = testing::Types<Blob, SecretBlob>;
TYPED_TEST_SUITE(BlobOfEitherKind, Blobs);

std::string length(std::uint32_t n) { return std::string(reinterpret_cast<char const*>(&n), 4); }

} // namespace

TYPED_TEST(BlobOfEitherKind, breathes) {
    TypeParam blob;
    EXPECT_EQ(blob.size(), 0u);
    EXPECT_EQ(blob.sizeBuf(), 0u);
    EXPECT_EQ(blob.buf(), nullptr);
    EXPECT_EQ(blob.val(), nullptr);
    blob.copy(3, "abc");
    blob.add(2, "de");
    EXPECT_EQ(this->bytes(blob), "abcde");
    blob.buf()[0] = 'x';
    EXPECT_EQ(this->bytes(blob), "xbcde");
}

TEST(Blob, is_made_of_bytes) {
    Blob const blob(4, "a\0b\xFF");
    EXPECT_EQ(blob.size(), 4u);
    EXPECT_EQ(blob.sizeBuf(), 4u);
    EXPECT_EQ(std::memcmp(blob.val(), "a\0b\xFF", 4), 0);
    Blob const none(0, nullptr);
    EXPECT_EQ(none.val(), nullptr);
}

TEST(Blob, has_a_virtual_destructor_and_no_moves_of_its_own) {
    static_assert(std::has_virtual_destructor_v<Blob>);
    static_assert(std::is_base_of_v<Blob, SecretBlob>);
    Blob source(3, "abc");
    Blob const target(std::move(source));
    EXPECT_EQ(source.size(), 3u) << "a move copies";
    EXPECT_EQ(target.size(), 3u);
}

TEST(Blob, is_empty_while_a_block_is_released_whose_bytes_do_not_stay) {
    struct Watching : Blob {
        void freeBuf() override {
            sizeAtRelease = size();
            Blob::freeBuf();
        }
        std::uint64_t sizeAtRelease = 99;
    };
    Watching blob;
    blob.copy(3, "abc");
    blob.copy(5, "abcde");
    EXPECT_EQ(blob.sizeAtRelease, 0U);
    blob.alloc(8, true);
    EXPECT_EQ(blob.sizeAtRelease, 5U) << "these bytes stay";
    blob.alloc(9, false);
    EXPECT_EQ(blob.sizeAtRelease, 0U);
    blob.copy(2, "xy");
    MemoryFile file(std::string("\x0A\0\0\0", 4) + "0123456789");
    EXPECT_TRUE(blob.read(&file));
    EXPECT_EQ(blob.sizeAtRelease, 0U);
}

TYPED_TEST(BlobOfEitherKind, is_copied_with_blocks_of_their_own_of_exactly_the_size) {
    TypeParam blob = this->make("abcdef");
    blob.alloc(100, true);
    TypeParam const copy(blob);
    EXPECT_EQ(this->bytes(copy), "abcdef");
    EXPECT_EQ(copy.sizeBuf(), 6u);
    EXPECT_NE(copy.val(), blob.val());
    TypeParam assigned = this->make("x");
    assigned = blob;
    EXPECT_EQ(this->bytes(assigned), "abcdef");
    EXPECT_EQ(assigned.sizeBuf(), 6u);
    char const* const block = assigned.val();
    assigned = this->make("12");
    EXPECT_EQ(this->bytes(assigned), "12");
    EXPECT_EQ(assigned.val(), block) << "there was room";
    EXPECT_EQ(assigned.sizeBuf(), 6u);
    TypeParam& self = assigned;
    assigned = self;
    EXPECT_EQ(this->bytes(assigned), "12");
}

TYPED_TEST(BlobOfEitherKind, grows_exactly) {
    TypeParam blob;
    for (std::uint64_t n = 1; n < 40; ++n) {
        blob.add(1, "x");
        EXPECT_EQ(blob.size(), n);
        EXPECT_EQ(blob.sizeBuf(), n);
    }
    blob.copy(50, std::string(50, 'y').data());
    EXPECT_EQ(blob.sizeBuf(), 50u);
    blob.copy(51, std::string(51, 'y').data());
    EXPECT_EQ(blob.sizeBuf(), 51u);
}

TYPED_TEST(BlobOfEitherKind, adds_nothing_for_nothing) {
    TypeParam blob = this->make("ab");
    char const* const block = blob.val();
    blob.add(0, "xyz");
    blob.add(3, nullptr);
    blob.add(0, nullptr);
    EXPECT_EQ(this->bytes(blob), "ab");
    EXPECT_EQ(blob.val(), block);
    TypeParam empty;
    empty.add(3, nullptr);
    EXPECT_EQ(empty.val(), nullptr);
}

TYPED_TEST(BlobOfEitherKind, keeps_its_block_when_cleared) {
    TypeParam blob = this->make("abcdef");
    char const* const block = blob.val();
    blob.clear();
    EXPECT_EQ(blob.size(), 0u);
    EXPECT_EQ(blob.sizeBuf(), 6u);
    blob.copy(6, "123456");
    EXPECT_EQ(blob.val(), block);
    blob.clear();
    blob.add(6, "ABCDEF");
    EXPECT_EQ(blob.val(), block);
    EXPECT_EQ(this->bytes(blob), "ABCDEF");
    blob.copy(0, nullptr);
    EXPECT_EQ(blob.size(), 0u);
    EXPECT_EQ(blob.sizeBuf(), 6u);
}

TYPED_TEST(BlobOfEitherKind, makes_room) {
    TypeParam blob = this->make("abc");
    blob.alloc(10, true);
    EXPECT_EQ(blob.sizeBuf(), 10u);
    EXPECT_EQ(this->bytes(blob), "abc");
    blob.alloc(11, false);
    EXPECT_EQ(blob.sizeBuf(), 11u);
    EXPECT_EQ(blob.size(), 0u);
    TypeParam empty;
    empty.alloc(0, false);
    EXPECT_EQ(empty.buf(), nullptr);
    empty.alloc(5, true);
    std::memcpy(empty.buf(), "12345", 5);
    empty.setSize(4);
    EXPECT_EQ(this->bytes(empty), "1234");
}

TYPED_TEST(BlobOfEitherKind, Kept_blob_01_changes_nothing_where_there_is_room_already) {
    TypeParam blob = this->make("abc");
    char const* const block = blob.val();
    for (bool keep : {true, false}) {
        for (std::uint64_t n : {0u, 2u, 3u}) {
            blob.alloc(n, keep);
            EXPECT_EQ(this->bytes(blob), "abc");
            EXPECT_EQ(blob.val(), block);
        }
    }
}

TYPED_TEST(BlobOfEitherKind, takes_sizes_unchecked) {
    TypeParam blob;
    blob.setSize(1'000);
    EXPECT_EQ(blob.size(), 1'000u);
    EXPECT_EQ(blob.sizeBuf(), 0u);
    blob.setSize(0);
}

TYPED_TEST(BlobOfEitherKind, takes_sources_in_its_own_block) {
    TypeParam blob = this->make("abcdef");
    blob.add(blob.size(), blob.val());
    EXPECT_EQ(this->bytes(blob), "abcdefabcdef");
    blob.copy(4, blob.val() + 4);
    EXPECT_EQ(this->bytes(blob), "efab");
    EXPECT_EQ(blob.sizeBuf(), 12u);
    blob.copy(6, blob.val() + 1);
    EXPECT_EQ(this->bytes(blob), "fabefa") << "overlapping, the bytes behind the size included";
    blob.add(3, blob.val() + 1);
    EXPECT_EQ(this->bytes(blob), "fabefaabe");
}

TYPED_TEST(BlobOfEitherKind, compares_bytes_and_sizes) {
    struct Case {
        Row row;
        std::string a;
        std::string b;
        int order;
    };
    for (Case const& c : {
             Case{{}, "", "", 0},
             Case{{}, "", "a", -1},
             Case{{}, "abc", "abc", 0},
             Case{{}, std::string("\1\2"), std::string("\1\2\0", 3), -1},
             Case{{}, std::string("\2"), std::string("\1\xFF"), 1},
             Case{{}, std::string("a\0b", 3), std::string("a\0c", 3), -1},
             Case{{}, "\x7F", "\x80", -1},
         }) {
        SCOPED_TRACE(c.row);
        TypeParam const a = this->make(c.a);
        TypeParam const b = this->make(c.b);
        EXPECT_EQ(a == b, c.order == 0);
        EXPECT_EQ(a != b, c.order != 0);
        EXPECT_EQ(a < b, c.order < 0);
        EXPECT_EQ(b<a, c.order> 0);
    }
    TypeParam roomy = this->make("abcdef");
    roomy.copy(3, "abc");
    EXPECT_TRUE(roomy == this->make("abc")) << "what is behind the size does not count";
}

TYPED_TEST(BlobOfEitherKind, is_stored_as_length_and_bytes) {
    for (std::string const& text : {std::string(), std::string("a"), std::string("a\0b", 3), std::string(300, 'x')}) {
        MemoryFile file;
        EXPECT_TRUE(this->make(text).write(&file));
        EXPECT_EQ(file.content, length(static_cast<std::uint32_t>(text.size())) + text);
        EXPECT_EQ(file.writes, text.empty() ? 1 : 2);
        TypeParam back = this->make("before");
        EXPECT_TRUE(back.read(&file));
        EXPECT_EQ(this->bytes(back), text);
        EXPECT_EQ(file.reads, text.empty() ? 1 : 2);
        EXPECT_EQ(back.sizeBuf(), std::max<std::uint64_t>(text.size(), 6));
    }
}

TEST(Blob, has_golden_bytes) {
    MemoryFile file;
    EXPECT_TRUE(Blob(258, std::string(258, 'z').data()).write(&file));
    EXPECT_EQ(file.content.substr(0, 5), std::string("\x02\x01\x00\x00z", 5));
}

TYPED_TEST(BlobOfEitherKind, is_not_changed_by_a_length_that_is_cut) {
    for (std::uint64_t n = 0; n < 4; ++n) {
        MemoryFile file(length(2).substr(0, n));
        TypeParam blob = this->make("before");
        EXPECT_FALSE(blob.read(&file));
        EXPECT_EQ(this->bytes(blob), "before");
    }
    TypeParam blob = this->make("before");
    EXPECT_FALSE(blob.read(nullptr));
    EXPECT_FALSE(blob.write(nullptr));
    EXPECT_EQ(this->bytes(blob), "before");
}

TYPED_TEST(BlobOfEitherKind, Kept_blob_02_has_the_announced_size_after_a_short_read) {
    MemoryFile file(length(100) + "abc");
    TypeParam blob = this->make("x");
    EXPECT_FALSE(blob.read(&file));
    EXPECT_EQ(blob.size(), 100u);
    EXPECT_EQ(blob.sizeBuf(), 100u);
    EXPECT_EQ(std::memcmp(blob.val(), "abc", 3), 0);
}

TYPED_TEST(BlobOfEitherKind, reports_what_could_not_be_written) {
    for (std::uint64_t room = 0; room <= 7; ++room) {
        MemoryFile file;
        file.room = room;
        EXPECT_EQ(this->make("abc").write(&file), room == 7) << room;
        EXPECT_EQ(file.content, (length(3) + "abc").substr(0, room));
    }
}

TEST(Blob, Kept_blob_04_takes_the_size_before_the_bytes) {
    Blob blob(2, "abc");
    EXPECT_EQ(std::string(blob.val(), blob.size()), "ab");
    blob.add(1, "xyz");
    EXPECT_EQ(std::string(blob.val(), blob.size()), "abx");
    blob.copy(3, "12345");
    EXPECT_EQ(std::string(blob.val(), blob.size()), "123");
    EXPECT_FALSE((std::is_constructible_v<Blob, char const*, std::uint64_t>));
}

TEST(Blob, Kept_blob_03_stores_the_low_32_bits_of_a_size_beyond) {
    /// Takes every byte and remembers the first ones and how many there were.
    struct Sink : MemoryFile {
        std::uint64_t write(void const* buffer, std::uint64_t n) override {
            if (n == 4) content.assign(static_cast<char const*>(buffer), 4);
            total += n;
            return n;
        }
        std::uint64_t total = 0;
    } sink;
    Blob blob;
    std::uint64_t const size = (std::uint64_t{1} << 32) + 5;
    blob.setSize(size); // no byte of the block is looked at
    EXPECT_TRUE(blob.write(&sink));
    EXPECT_EQ(sink.content, length(5));
    EXPECT_EQ(sink.total, 4 + size);
    blob.setSize(0);
}

TYPED_TEST(BlobOfEitherKind, behaves_as_a_vector_of_bytes) {
    auto random = randomSource();
    TypeParam blob;
    std::string model;
    std::uint64_t capacity = 0;
    for (std::uint64_t step = randomSteps(20'000); step > 0; --step) {
        std::string text(random() % 20, '\0');
        for (char& c : text) c = static_cast<char>(random());
        bool const keep = random() % 2 != 0;
        switch (random() % 7) {
        case 0:
            blob.copy(text.size(), text.data());
            model = text;
            capacity = std::max<std::uint64_t>(capacity, text.size());
            break;
        case 1:
        case 2:
            if (model.size() > 200) break;
            blob.add(text.size(), text.data());
            model += text;
            capacity = std::max<std::uint64_t>(capacity, model.size());
            break;
        case 3:
            if (capacity < text.size() * 8 && !keep) model.clear();
            blob.alloc(text.size() * 8, keep);
            capacity = std::max<std::uint64_t>(capacity, text.size() * 8);
            break;
        case 4:
            if (random() % 20 != 0) break;
            blob = TypeParam();
            model.clear();
            break;
        case 5: {
            TypeParam other = this->make(text);
            EXPECT_EQ(blob == other, model == text);
            EXPECT_EQ(blob < other, model < text);
            MemoryFile file;
            ASSERT_TRUE(blob.write(&file));
            ASSERT_TRUE(other.read(&file));
            EXPECT_EQ(this->bytes(other), model);
            break;
        }
        default:
            if (model.empty()) break;
            std::uint64_t const at = random() % model.size();
            std::uint64_t const n = random() % (model.size() - at + 1);
            std::string const part = model.substr(at, n);
            if (keep || model.size() > 200) {
                blob.copy(n, blob.val() + at);
                model = part;
            } else {
                blob.add(n, blob.val() + at);
                model += part;
                capacity = std::max<std::uint64_t>(capacity, model.size());
            }
        }
        ASSERT_EQ(this->bytes(blob), model);
        ASSERT_EQ(blob.sizeBuf(), capacity);
    }
}
