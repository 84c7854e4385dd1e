#include "basis/platform/xos_basics.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <vector>

namespace {

constexpr std::uint32_t TRUNCATE = 0x01;
constexpr std::uint32_t READ = 0x02;
constexpr std::uint32_t WRITE = 0x14;
constexpr std::uint32_t WRITE_EXISTING = 0x04;
constexpr std::uint32_t APPEND = 0x08;

struct OpenedFile {
    OpenedFile(std::string const& path, std::uint32_t flags) : handle(xos_FileOpen(path.c_str(), flags)) {}
    ~OpenedFile() {
        if (handle != 0) xos_FileCloseEx(handle, 0);
    }
    OpenedFile(OpenedFile const&) = delete;
    OpenedFile& operator=(OpenedFile const&) = delete;

    int close() { return xos_FileCloseEx(std::exchange(handle, 0), 0); }
    std::string read(std::size_t size) const {
        std::string text(size, '\0');
        text.resize(xos_FileReadEx(handle, text.data(), size, 0, 0));
        return text;
    }
    std::uint64_t write(std::string const& text) const {
        return xos_FileWriteEx(handle, text.data(), text.size(), 0, 0);
    }
    /// The next line; "(end)" at the end of the file.
    std::string gets(std::size_t size = 200) const {
        std::string line(size, '#');
        char* const result = xos_FileGetsEx(handle, line.data(), size, 0);
        return result == nullptr ? "(end)" : std::string{result};
    }
    int seek(std::int64_t offset, int origin) const { return xos_FileSeekEx(handle, offset, origin, 0); }
    std::int64_t tell() const { return xos_FileTellEx(handle, 0); }

    xos_File handle;
};

} // namespace

TEST(HostFile, keeps_what_was_written) {
    Scratch const scratch;
    OpenedFile file{scratch / "note", WRITE};
    ASSERT_NE(file.handle, 0U);
    EXPECT_EQ(file.write("hello"), 5U);
    EXPECT_EQ(file.close(), 0);
    EXPECT_EQ(textOf(scratch / "note"), "hello");
}

TEST(HostFile, opens_as_its_flags_say) {
    struct Case {
        Row row;
        std::uint32_t flags;
        bool present;
        bool opens;
        char const* afterwards;
    };
    // The file holds "old" where it is present; the handle writes "new" where it opens.
    for (Case const& c : {
             Case{{}, READ, true, true, "old"},
             Case{{}, READ, false, false, nullptr},
             Case{{}, WRITE, true, true, "new"},
             Case{{}, WRITE, false, true, "new"},
             Case{{}, WRITE_EXISTING, true, true, "new"},
             Case{{}, WRITE_EXISTING, false, false, nullptr},
             Case{{}, WRITE | TRUNCATE, true, true, "new"},
             Case{{}, WRITE | TRUNCATE, false, true, "new"},
             Case{{}, WRITE | APPEND, true, true, "oldnew"},
             Case{{}, WRITE | APPEND, false, true, "new"},
             Case{{}, WRITE | APPEND | TRUNCATE, true, true, "new"},
             Case{{}, APPEND, true, true, "oldnew"},
             Case{{}, APPEND, false, false, nullptr},
             Case{{}, READ | WRITE, true, true, "new"},
             Case{{}, READ | WRITE | TRUNCATE, true, true, "new"},
             Case{{}, READ | WRITE, false, true, "new"},
             // the flags without a meaning here
             Case{{}, WRITE | 0x40 | 0x4000000, true, true, "new"},
             Case{{}, READ | 0x40 | 0x4000000, false, false, nullptr},
             // what cannot write neither makes nor empties a file
             Case{{}, 0, true, false, "old"},
             Case{{}, 0x20, true, false, "old"},
             Case{{}, READ | TRUNCATE, true, false, "old"},
             Case{{}, READ | 0x10, false, false, nullptr},
         }) {
        SCOPED_TRACE(c.row);
        Scratch const scratch;
        if (c.present) put(scratch / "f", "old");
        clearSystemError();
        OpenedFile file{scratch / "f", c.flags};
        EXPECT_EQ(file.handle != 0, c.opens);
        if (!c.opens) {
            EXPECT_NE(systemError(), 0);
        } else {
            file.write("new");
            EXPECT_EQ(file.close(), 0);
        }
        EXPECT_EQ(exists(scratch / "f"), c.afterwards != nullptr);
        if (c.afterwards != nullptr) { EXPECT_EQ(textOf(scratch / "f"), c.afterwards); }
    }
}

TEST(HostFile, overwrites_in_place_and_keeps_the_rest) {
    Scratch const scratch;
    put(scratch / "f", "0123456789");
    OpenedFile file{scratch / "f", WRITE};
    EXPECT_EQ(file.seek(3, 0), 0);
    EXPECT_EQ(file.write("abc"), 3U);
    file.close();
    EXPECT_EQ(textOf(scratch / "f"), "012abc6789");
}

TEST(HostFile, appends_to_the_end_that_the_file_has_at_that_moment) {
    Scratch const scratch;
    put(scratch / "f", "start");
    OpenedFile one{scratch / "f", WRITE | APPEND};
    OpenedFile two{scratch / "f", WRITE | APPEND};
    EXPECT_EQ(one.write(" one"), 4U);
    EXPECT_EQ(one.tell(), 9);
    EXPECT_EQ(two.write(" two"), 4U);
    EXPECT_EQ(two.tell(), 13);
    EXPECT_EQ(one.seek(0, 0), 0);
    EXPECT_EQ(one.write(" three"), 6U);
    EXPECT_EQ(textOf(scratch / "f"), "start one two three");
}

TEST(HostFile, refuses_a_directory_a_missing_folder_and_no_path) {
    Scratch const scratch;
    for (std::uint32_t flags : {READ, WRITE, WRITE | READ, WRITE | APPEND}) {
        clearSystemError();
        EXPECT_EQ(xos_FileOpen(scratch.path().c_str(), flags), 0U) << flags;
        EXPECT_NE(systemError(), 0);
        clearSystemError();
        EXPECT_EQ(xos_FileOpen((scratch / "no/such").c_str(), flags), 0U) << flags;
        EXPECT_NE(systemError(), 0);
        clearSystemError();
        EXPECT_EQ(xos_FileOpen(nullptr, flags), 0U);
        EXPECT_NE(systemError(), 0);
        EXPECT_EQ(xos_FileOpen("", flags), 0U);
    }
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostFile, takes_backslashes_for_separators) {
    Scratch const scratch;
    makeFolder(scratch / "in");
    std::string path = scratch / "in/f";
    std::replace(path.begin(), path.end(), '/', '\\');
    {
        OpenedFile const file{path, WRITE};
        EXPECT_EQ(file.write("x"), 1U);
    }
    EXPECT_EQ(textOf(scratch / "in/f"), "x");
    xos_Stat record{};
    EXPECT_EQ(xos_FileStatByNameEx(path.c_str(), &record, 0x4000), 0);
    EXPECT_EQ(xos_FileRemove(path.c_str(), 0x400), 0);
    EXPECT_EQ(scratch.content(), Names{"in/"});
}

TEST(HostFile, transfers_nothing_on_no_handle) {
    char buffer[8] = "unread";
    clearSystemError();
    EXPECT_EQ(xos_FileReadEx(0, buffer, 4, 0, 0), 0U);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(xos_FileWriteEx(0, buffer, 4, 0, 0), 0U);
    EXPECT_EQ(xos_FileGetsEx(0, buffer, 4, 0), nullptr);
    EXPECT_STREQ(buffer, "unread");
    EXPECT_NE(xos_FileFlush(0), 0);
    EXPECT_NE(xos_FileSeekEx(0, 0, 0, 0), 0);
    EXPECT_EQ(xos_FileTellEx(0, 0), -1);
    EXPECT_NE(xos_FileCloseEx(0, 0), 0);
}

TEST(HostFile, transfers_nothing_to_or_from_nowhere) {
    Scratch const scratch;
    put(scratch / "f", "abc");
    OpenedFile const file{scratch / "f", READ | WRITE};
    EXPECT_EQ(xos_FileReadEx(file.handle, nullptr, 2, 0, 0), 0U);
    EXPECT_EQ(xos_FileWriteEx(file.handle, nullptr, 2, 0, 0), 0U);
    EXPECT_EQ(xos_FileGetsEx(file.handle, nullptr, 2, 0), nullptr);
    EXPECT_EQ(file.tell(), 0);
    EXPECT_EQ(file.read(0), "");
    EXPECT_EQ(file.write(""), 0U);
}

TEST(HostFile, neither_reads_what_is_for_writing_nor_writes_what_is_for_reading) {
    Scratch const scratch;
    put(scratch / "f", "abc");
    OpenedFile const reader{scratch / "f", READ};
    clearSystemError();
    EXPECT_EQ(reader.write("x"), 0U);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(reader.read(9), "abc");
    OpenedFile const writer{scratch / "f", WRITE};
    clearSystemError();
    EXPECT_EQ(writer.read(2), "");
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(writer.read(20000), "");
    EXPECT_EQ(writer.gets(), "(end)");
    EXPECT_EQ(textOf(scratch / "f"), "abc");
}

TEST(HostFile, reads_fewer_bytes_only_at_the_end) {
    Scratch const scratch;
    put(scratch / "f", std::string(100'000, 'x'));
    OpenedFile const file{scratch / "f", READ};
    EXPECT_EQ(file.read(1).size(), 1U);
    EXPECT_EQ(file.read(99'990).size(), 99'990U);
    EXPECT_EQ(file.read(50).size(), 9U);
    EXPECT_EQ(file.read(50).size(), 0U);
}

TEST(HostFile, sees_at_its_end_what_another_handle_adds) {
    Scratch const scratch;
    put(scratch / "f", "one\n");
    OpenedFile const reader{scratch / "f", READ};
    EXPECT_EQ(reader.gets(), "one\n");
    EXPECT_EQ(reader.gets(), "(end)");
    OpenedFile const writer{scratch / "f", WRITE | APPEND};
    EXPECT_EQ(writer.write("two\n"), 4U);
    EXPECT_EQ(reader.gets(), "two\n");
}

TEST(HostFile, shows_written_bytes_to_others_at_once) {
    Scratch const scratch;
    OpenedFile const writer{scratch / "f", WRITE};
    EXPECT_EQ(writer.write("now"), 3U);
    EXPECT_EQ(textOf(scratch / "f"), "now");
}

TEST(HostFile, gets_lines_with_their_ends) {
    struct Case {
        Row row;
        std::string text;
        std::size_t size;
        std::vector<std::string> lines;
    };
    for (Case const& c : {
             Case{{}, "", 10, {}},
             Case{{}, "a\n", 10, {"a\n"}},
             Case{{}, "a\nb", 10, {"a\n", "b"}},
             Case{{}, "\n\n", 10, {"\n", "\n"}},
             Case{{}, "a\r\nb\r\n", 10, {"a\r\n", "b\r\n"}},
             Case{{}, "a\rb", 10, {"a\rb"}},
             // a line longer than the buffer comes in pieces, its end with the last one
             Case{{}, "abcdef\ng\n", 4, {"abc", "def", "\n", "g\n"}},
             Case{{}, "abc\nd\n", 5, {"abc\n", "d\n"}},
             Case{{}, "ab\n", 3, {"ab", "\n"}},
             Case{{}, "ab\n", 2, {"a", "b", "\n"}},
             Case{{}, std::string(40'000, 'x') + "\ny\n", 100'000, {std::string(40'000, 'x') + "\n", "y\n"}},
         }) {
        SCOPED_TRACE(c.row);
        Scratch const scratch;
        put(scratch / "f", c.text);
        OpenedFile const file{scratch / "f", READ};
        for (std::string const& line : c.lines) { EXPECT_EQ(file.gets(c.size), line); }
        EXPECT_EQ(file.gets(c.size), "(end)");
        EXPECT_EQ(file.gets(c.size), "(end)");
    }
}

TEST(HostFile, gets_lines_that_hold_zero_bytes) {
    Scratch const scratch;
    put(scratch / "f", std::string("a\0b\nc", 5));
    OpenedFile const file{scratch / "f", READ};
    char line[16];
    std::fill(std::begin(line), std::end(line), '#');
    ASSERT_EQ(xos_FileGetsEx(file.handle, line, sizeof line, 0), line);
    EXPECT_EQ(std::string(line, 5), std::string("a\0b\n\0", 5));
    EXPECT_EQ(file.tell(), 4);
}

TEST(HostFile, gets_into_a_buffer_of_one_byte_no_text_and_into_none_nothing) {
    Scratch const scratch;
    put(scratch / "f", "ab");
    OpenedFile const file{scratch / "f", READ};
    char one = '#';
    EXPECT_EQ(xos_FileGetsEx(file.handle, &one, 1, 0), &one);
    EXPECT_EQ(one, '\0');
    one = '#';
    EXPECT_EQ(xos_FileGetsEx(file.handle, &one, 0, 0), nullptr);
    EXPECT_EQ(one, '#');
    EXPECT_EQ(file.tell(), 0);
}

TEST(HostFile, finds_its_position_after_lines) {
    Scratch const scratch;
    put(scratch / "f", "one\ntwo\nthree\nfour\n");
    OpenedFile const file{scratch / "f", READ | WRITE};
    EXPECT_EQ(file.gets(), "one\n");
    EXPECT_EQ(file.tell(), 4);
    EXPECT_EQ(file.seek(2, 1), 0);
    EXPECT_EQ(file.tell(), 6);
    EXPECT_EQ(file.read(2), "o\n");
    EXPECT_EQ(file.gets(), "three\n");
    EXPECT_EQ(file.write("FOUR"), 4U);
    EXPECT_EQ(file.tell(), 18);
    EXPECT_EQ(file.gets(), "\n");
    EXPECT_EQ(file.seek(0, 0), 0);
    EXPECT_EQ(file.read(100), "one\ntwo\nthree\nFOUR\n");
}

TEST(HostFile, seeks_from_the_start_the_position_and_the_end) {
    struct Case {
        Row row;
        std::int64_t offset;
        int origin;
        bool works;
        std::int64_t position;
    };
    Scratch const scratch;
    put(scratch / "f", "0123456789");
    // Each from position 4, behind a line read.
    for (Case const& c : {
             Case{{}, 0, 0, true, 0},
             Case{{}, 7, 0, true, 7},
             Case{{}, 70, 0, true, 70},
             Case{{}, -1, 0, false, 4},
             Case{{}, 0, 1, true, 4},
             Case{{}, 3, 1, true, 7},
             Case{{}, -4, 1, true, 0},
             Case{{}, -5, 1, false, 4},
             Case{{}, std::numeric_limits<std::int64_t>::min(), 1, false, 4},
             Case{{}, 0, 2, true, 10},
             Case{{}, -10, 2, true, 0},
             Case{{}, 5, 2, true, 15},
             Case{{}, -11, 2, false, 4},
             Case{{}, 0, 3, false, 4},
             Case{{}, 0, -1, false, 4},
         }) {
        SCOPED_TRACE(c.row);
        OpenedFile const file{scratch / "f", READ};
        EXPECT_EQ(file.gets(5), "0123");
        clearSystemError();
        EXPECT_EQ(file.seek(c.offset, c.origin) == 0, c.works);
        if (!c.works) { EXPECT_NE(systemError(), 0); }
        EXPECT_EQ(file.tell(), c.position);
        std::string const rest = c.position < 10 ? std::string{"0123456789"}.substr(c.position) : "";
        EXPECT_EQ(file.read(100), rest);
    }
}

TEST(HostFile, reaches_positions_beyond_four_gigabytes) {
    Scratch const scratch;
    std::int64_t const far = (std::int64_t{5} << 30) + 7;
    OpenedFile file{scratch / "f", READ | WRITE};
    ASSERT_EQ(file.seek(far, 0), 0);
    EXPECT_EQ(file.write("line\n"), 5U);
    EXPECT_EQ(file.tell(), far + 5);
    EXPECT_EQ(file.seek(-5, 2), 0);
    EXPECT_EQ(file.gets(), "line\n");
    EXPECT_EQ(file.tell(), far + 5);
    EXPECT_EQ(file.close(), 0);
    xos_Stat record{};
    EXPECT_EQ(xos_FileStatByNameEx((scratch / "f").c_str(), &record, 0), 0);
    EXPECT_EQ(record.st_size_, far + 5);
}

TEST(HostFile, flushes_what_can_be_written_and_what_cannot) {
    Scratch const scratch;
    OpenedFile const writer{scratch / "f", WRITE};
    EXPECT_EQ(writer.write("x"), 1U);
    EXPECT_EQ(xos_FileFlush(writer.handle), 0);
    OpenedFile const reader{scratch / "f", READ};
    EXPECT_EQ(xos_FileFlush(reader.handle), 0);
    EXPECT_EQ(reader.read(1), "x");
}

TEST(HostFile, can_be_removed_while_it_is_open) {
    Scratch const scratch;
    put(scratch / "f", "text");
    OpenedFile const file{scratch / "f", READ};
    EXPECT_EQ(xos_FileRemove((scratch / "f").c_str(), 0), 0);
    EXPECT_EQ(file.read(9), "text");
}

TEST(HostFile, does_what_a_text_in_memory_does_at_every_step) {
    Scratch const scratch;
    OpenedFile const file{scratch / "f", READ | WRITE};
    std::mt19937_64 random = randomSource();
    std::string model;
    std::size_t at = 0;
    std::uint64_t const steps = randomSteps(3'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        SCOPED_TRACE(step);
        std::size_t const size = random() % (random() % 8 == 0 ? 60'000 : 90);
        switch (random() % 6) {
        case 0: {
            std::string text(size, '\0');
            for (char& c : text) { c = "abcdefgh\n\r"[random() % 10]; }
            if (model.size() < 400'000 && !text.empty()) {
                ASSERT_EQ(file.write(text), text.size());
                if (model.size() < at) model.resize(at, '\0');
                model.replace(at, std::min(text.size(), model.size() - at), text);
                at += text.size();
            }
            break;
        }
        case 1:
        case 2: {
            std::string const expected = at < model.size() ? model.substr(at, size) : "";
            ASSERT_EQ(file.read(size), expected);
            at += expected.size();
            break;
        }
        case 3: {
            std::size_t const most = 2 + size;
            std::string expected = at < model.size() ? model.substr(at, most - 1) : "";
            expected = expected.substr(0, std::min(expected.find('\n'), expected.size() - 1) + 1);
            std::string line(most, '#');
            char* const got = xos_FileGetsEx(file.handle, line.data(), most, 0);
            ASSERT_EQ(got != nullptr, at < model.size());
            if (got != nullptr) { ASSERT_EQ(line.substr(0, expected.size() + 1), expected + '\0'); }
            at += expected.size();
            break;
        }
        case 4: {
            int const origin = static_cast<int>(random() % 3);
            std::size_t const target = random() % (model.size() + 100);
            std::size_t const base = origin == 0 ? 0 : origin == 1 ? at : model.size();
            ASSERT_EQ(file.seek(static_cast<std::int64_t>(target) - static_cast<std::int64_t>(base), origin), 0);
            at = target;
            break;
        }
        default:
            ASSERT_EQ(file.tell(), static_cast<std::int64_t>(at));
        }
    }
    EXPECT_EQ(textOf(scratch / "f"), model);
}
