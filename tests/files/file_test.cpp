// One suite over the three backends, then what each hands on, then whole files.

#include <zor_basis/files/dir.h>
#include <zor_basis/files/f_stat.h>
#include <zor_basis/files/file.h>
#include <zor_basis/store/blob.h>

#include "basis/files/file_backends.h"
#include "basis/files/system_calls.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <memory>
#include <type_traits>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct Platform {
    static constexpr int mode = 0;
    static constexpr bool flag = false;
    static constexpr bool readsLines = true;
    static std::int64_t position(std::int64_t at) { return at; }
    static constexpr std::int64_t badSeek = 0;
};
struct Stream {
    static constexpr int mode = File::FILE_CRT;
    static constexpr bool flag = true;
    static constexpr bool readsLines = true;
    static std::int64_t position(std::int64_t) { return 0; }
    static constexpr std::int64_t badSeek = -1;
};
struct Descriptor {
    static constexpr int mode = File::FILE_CRT;
    static constexpr bool flag = false;
    static constexpr bool readsLines = false;
    static std::int64_t position(std::int64_t at) { return at; }
    static constexpr std::int64_t badSeek = -1;
};

constexpr int BINARY = File::FILE_BINARY | File::FILE_SEQUENTIAL;
constexpr int READ = File::FILE_READ | BINARY;
constexpr int WRITE = File::FILE_WRITE | File::FILE_TRUNC | BINARY;
constexpr int UPDATE = File::FILE_READ | File::FILE_WRITE | BINARY;

template <class Backend>
struct FileTest : testing::Test {
    bool open(File& file, std::string const& name, int mode) const {
        return file.open((scratch / name).c_str(), mode | Backend::mode, Backend::flag);
    }
    static std::string read(File& file, std::uint64_t n) {
        std::string text(n, '?');
        std::uint64_t const bytes = file->read(text.data(), n);
        EXPECT_LE(bytes, n);
        return text.substr(0, bytes);
    }
    static bool write(File& file, std::string const& text) {
        return file->write(text.data(), text.size()) == text.size();
    }

    Scratch scratch;
};

using Backends = testing::Types<Platform, Stream, Descriptor>;
TYPED_TEST_SUITE(FileTest, Backends);

} // namespace

TYPED_TEST(FileTest, breathes) {
    File file;
    ASSERT_TRUE(this->open(file, "a b", WRITE));
    EXPECT_TRUE(this->write(file, "12345"));
    file.close();
    ASSERT_TRUE(this->open(file, "a b", READ));
    EXPECT_EQ(this->read(file, 10), "12345");
}

TYPED_TEST(FileTest, keeps_every_byte) {
    std::string bytes;
    for (int i = 0; i < 1024; ++i) bytes.push_back(static_cast<char>(i * 7));
    bytes += "\r\n\n\x1A\r";
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_TRUE(this->write(file, bytes));
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), bytes);
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(this->read(file, bytes.size() + 5), bytes);
    EXPECT_EQ(this->read(file, 5), "");
}

TYPED_TEST(FileTest, reads_and_writes_nothing_when_asked_for_nothing) {
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_EQ(file->write("x", 0), 0u);
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), "");
    ASSERT_TRUE(this->open(file, "f", READ));
    char c = 'x';
    EXPECT_EQ(file->read(&c, 0), 0u);
}

TYPED_TEST(FileTest, goes_on_where_it_stopped) {
    put(this->scratch / "f", "abcdefg");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(this->read(file, 3), "abc");
    EXPECT_EQ(this->read(file, 3), "def");
    EXPECT_EQ(this->read(file, 3), "g");
}

TYPED_TEST(FileTest, Kept_file_02_gives_three_kinds_of_results_of_seeking) {
    put(this->scratch / "f", "abcdefgh");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(file->seek(2, 0), TypeParam::position(8));
    EXPECT_EQ(file->seek(0, 2), TypeParam::position(2));
    EXPECT_EQ(this->read(file, 2), "cd");
    EXPECT_EQ(file->seek(1, 1), TypeParam::position(5));
    EXPECT_EQ(this->read(file, 1), "f");
    EXPECT_EQ(file->seek(1, -3), TypeParam::position(3));
    EXPECT_EQ(this->read(file, 1), "d");
    EXPECT_EQ(file->seek(2, -1), TypeParam::position(7));
    EXPECT_EQ(this->read(file, 5), "h");
    EXPECT_EQ(file->seek(0, -1), TypeParam::badSeek);
    for (int origin : {3, 4, 5}) EXPECT_EQ(file->seek(origin, 0), TypeParam::badSeek) << "there are three origins";
    EXPECT_EQ(file->seek(0, 0), 0);
    EXPECT_EQ(this->read(file, 1), "a");
}

TYPED_TEST(FileTest, replaces_bytes_of_a_file_open_for_both) {
    put(this->scratch / "f", "abcdef");
    File file;
    ASSERT_TRUE(this->open(file, "f", UPDATE));
    EXPECT_EQ(this->read(file, 2), "ab");
    file->seek(0, 2);
    EXPECT_TRUE(this->write(file, "XY"));
    file->seek(0, 0);
    EXPECT_EQ(this->read(file, 9), "abXYef");
}

TYPED_TEST(FileTest, begins_anew_when_truncating) {
    put(this->scratch / "f", "abcdef");
    File file;
    ASSERT_TRUE(this->open(file, "f", UPDATE | File::FILE_TRUNC));
    EXPECT_EQ(this->read(file, 9), "");
    EXPECT_TRUE(this->write(file, "12"));
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
}

TYPED_TEST(FileTest, shows_others_what_was_flushed) {
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_TRUE(this->write(file, "12"));
    EXPECT_TRUE(file->flush());
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
}

TYPED_TEST(FileTest, reads_lines_where_it_can) {
    put(this->scratch / "f", "one\n\nthree is long\nlast");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    char line[8];
    std::vector<std::string> lines;
    for (;;) {
        std::fill(line, line + sizeof line, '#');
        std::uint64_t const n = file->getline(line, sizeof line);
        if (!TypeParam::readsLines) {
            EXPECT_EQ(n, 0u);
            EXPECT_EQ(line[0], '#') << "untouched";
            return;
        }
        EXPECT_EQ(line[sizeof line - 1], '\0');
        if (n == 0) break;
        lines.emplace_back(line, n);
        EXPECT_EQ(std::strlen(line), n);
    }
    EXPECT_EQ(lines, (std::vector<std::string>{"one\n", "\n", "three i", "s long\n", "last"}));
    EXPECT_EQ(file->getline(line, sizeof line), 0u);
    EXPECT_EQ(file->getline(line, 0), 0u);
}

TYPED_TEST(FileTest, measures_a_line_up_to_its_first_zero) {
    if (!TypeParam::readsLines) return;
    put(this->scratch / "f", std::string("ab\0cd\nnext\n", 11));
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    char line[32];
    EXPECT_EQ(file->getline(line, sizeof line), 2u);
    EXPECT_EQ(file->getline(line, sizeof line), 5u);
}

TYPED_TEST(FileTest, keeps_a_closed_backend_when_opening_fails) {
    File file;
    EXPECT_FALSE(this->open(file, "missing/f", READ));
    ASSERT_NE(file.ptr(), nullptr);
    EXPECT_FALSE(file.isOpen());
    EXPECT_FALSE(file->isOpen());
    EXPECT_TRUE(!*file.ptr());
    char c;
    EXPECT_NE(file->read(&c, 1), 1u);
    EXPECT_NE(file->write("x", 1), 1u);
    EXPECT_FALSE(file->flush());
    EXPECT_EQ(file->seek(0, 0), TypeParam::badSeek);
    EXPECT_EQ(file->getline(&c, 1), 0u);
    EXPECT_FALSE(this->open(file, "missing", READ));
    EXPECT_FALSE(file.open(nullptr, READ | TypeParam::mode, TypeParam::flag));
    EXPECT_FALSE(file.open("", READ | TypeParam::mode, TypeParam::flag));
    EXPECT_TRUE(this->open(file, "f", WRITE));
    EXPECT_FALSE(!*file.ptr());
}

TYPED_TEST(FileTest, closes_the_file_that_was_open_before) {
    File file;
    ASSERT_TRUE(this->open(file, "one", WRITE));
    EXPECT_TRUE(this->write(file, "first"));
    ASSERT_TRUE(this->open(file, "two", WRITE));
    EXPECT_EQ(textOf(this->scratch / "one"), "first") << "what a stream had buffered is written";
    EXPECT_TRUE(this->write(file, "second"));
    EXPECT_FALSE(this->open(file, "missing/f", READ));
    EXPECT_EQ(textOf(this->scratch / "two"), "second");
}

TYPED_TEST(FileTest, is_closed_at_the_end_of_its_life_and_as_often_as_one_likes) {
    {
        File file((this->scratch / "f").c_str(), WRITE | TypeParam::mode, TypeParam::flag);
        ASSERT_TRUE(file.isOpen());
        EXPECT_TRUE(this->write(file, "12"));
    }
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
    File file((this->scratch / "f").c_str(), READ | TypeParam::mode, TypeParam::flag);
    EXPECT_TRUE(file.isOpen());
    file.close();
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_FALSE(file.isOpen());
    file.close();
}

TYPED_TEST(FileTest, is_true_in_a_condition_only_while_it_is_open) {
    File file;
    File other;
    File const& constant = file;
    auto const expect = [&](bool open) {
        EXPECT_EQ(file.isOpen(), open);
        EXPECT_EQ(file ? 1 : 0, open ? 1 : 0);
        EXPECT_EQ(constant ? 1 : 0, open ? 1 : 0);
        EXPECT_EQ(!file, !open);
        EXPECT_EQ(!constant, !open);
        EXPECT_EQ(static_cast<bool>(file), open);
        EXPECT_EQ(file && constant, open);
        EXPECT_EQ(file || other, open);
        EXPECT_EQ(constant || !file, true);
        int taken = 0;
        if (file) taken |= 1;
        if (!file) taken |= 2;
        if (constant) taken |= 4;
        while (!constant && (taken & 8) == 0) taken |= 8;
        for (; file && (taken & 16) == 0;) taken |= 16;
        EXPECT_EQ(taken, open ? 1 | 4 | 16 : 2 | 8);
    };
    expect(false);
    EXPECT_FALSE(this->open(file, "missing/f", READ));
    ASSERT_NE(file.ptr(), nullptr) << "a closed backend stays attached";
    expect(false);
    ASSERT_TRUE(this->open(file, "f", WRITE));
    expect(true);
    file.close();
    expect(false);
    if (!File((this->scratch / "no/f").c_str(), READ | TypeParam::mode, TypeParam::flag)) return;
    ADD_FAILURE() << "a file that could not be opened is false in the commonest check of all";
}

TYPED_TEST(FileTest, moves_what_it_holds) {
    File first;
    ASSERT_TRUE(this->open(first, "one", WRITE));
    IFile* const backend = first.ptr();
    File second(std::move(first));
    EXPECT_EQ(second.ptr(), backend);
    EXPECT_EQ(first.ptr(), nullptr);
    EXPECT_FALSE(first.isOpen());
    EXPECT_TRUE(this->write(second, "12"));

    ASSERT_TRUE(this->open(first, "two", WRITE)) << "one that was moved from can be opened again";
    EXPECT_TRUE(this->write(first, "second"));
    first = std::move(second);
    EXPECT_EQ(textOf(this->scratch / "two"), "second") << "what was held is closed";
    EXPECT_EQ(first.ptr(), backend);
    EXPECT_EQ(second.ptr(), nullptr);
    File& same = first;
    first = std::move(same);
    EXPECT_EQ(first.ptr(), backend);
    EXPECT_TRUE(this->write(first, "34"));
    second = File();
    first = std::move(second);
    EXPECT_EQ(first.ptr(), nullptr);
    EXPECT_EQ(textOf(this->scratch / "one"), "1234");

    EXPECT_FALSE(this->open(first, "missing/f", READ));
    File const closed = std::move(first);
    EXPECT_NE(closed.ptr(), nullptr) << "a closed backend moves too";
    EXPECT_FALSE(closed);
}

TYPED_TEST(FileTest, can_be_returned_and_kept_in_containers) {
    auto const opened = [this](std::string const& name) {
        File file;
        EXPECT_TRUE(this->open(file, name, WRITE));
        return file;
    };
    {
        std::vector<File> files;
        for (char const* name : {"a", "b", "c", "d", "e"}) files.push_back(opened(name));
        for (File& file : files) EXPECT_TRUE(this->write(file, "x"));
        std::swap(files.front(), files.back());
        EXPECT_TRUE(this->write(files.front(), "last"));
        files.erase(files.begin() + 1);
        EXPECT_EQ(textOf(this->scratch / "b"), "x") << "removed, so closed";
    }
    EXPECT_EQ(textOf(this->scratch / "e"), "xlast");
    EXPECT_EQ(textOf(this->scratch / "a"), "x");
}

TYPED_TEST(FileTest, reaches_beyond_four_gigabytes) {
    put(this->scratch / "large", "x");
    std::uint64_t const size = std::uint64_t{5} << 30;
    std::filesystem::resize_file(this->scratch / "large", size);
    File file;
    ASSERT_TRUE(this->open(file, "large", UPDATE));
    EXPECT_EQ(file->seek(2, 0), TypeParam::position(static_cast<std::int64_t>(size)));
    EXPECT_TRUE(this->write(file, "end"));
    file->seek(2, -3);
    EXPECT_EQ(this->read(file, 9), "end");
    file.close();
    EXPECT_EQ(FStat::size((this->scratch / "large").c_str()), size + 3);
}

TYPED_TEST(FileTest, takes_both_slash_kinds) {
    makeFolder(this->scratch / "a b");
    File file;
    ASSERT_TRUE(file.open((this->scratch.path() + "\\a b/f").c_str(), WRITE | TypeParam::mode, TypeParam::flag));
    EXPECT_TRUE(exists(this->scratch / "a b/f"));
}

namespace {

struct FileCalls : testing::Test {
    FileCalls() { xos_HostCallsReset(); }
    ~FileCalls() override {
        systemCalls = real_;
        xos_HostFailClear();
    }

    std::string at(std::string const& name) const { return scratch / name; }
    /// The last call of a function, without the scratch folder's path.
    std::string last(char const* function) const {
        char const* const call = xos_HostLastCall(function);
        if (call == nullptr) return "none";
        std::string text = call;
        std::string const own = scratch.path() + "/";
        for (std::size_t i = text.find(own); i != std::string::npos; i = text.find(own)) text.erase(i, own.size());
        return text;
    }
    static std::basic_string<WChar> wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

    Scratch scratch;
    SystemCalls const real_ = systemCalls;
};

} // namespace

TEST_F(FileCalls, hold_nothing_at_first) {
    File file;
    EXPECT_FALSE(file.isOpen());
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_EQ(static_cast<IFile*>(file), nullptr);
    EXPECT_EQ(file.operator->(), nullptr);
    file.close();
}

TEST_F(FileCalls, give_the_same_backend_in_three_ways) {
    File file(at("f").c_str(), WRITE);
    EXPECT_NE(file.ptr(), nullptr);
    EXPECT_EQ(static_cast<IFile*>(file), file.ptr());
    EXPECT_EQ(file.operator->(), file.ptr());
}

namespace {

enum class Chosen { POINTER, CONSTANT, NUMBER };
struct Takes {
    static Chosen plain(IFile*) { return Chosen::POINTER; }
    static Chosen plain(bool) { return Chosen::NUMBER; }
    static Chosen constant(IFile const*) { return Chosen::CONSTANT; }
    static Chosen constant(bool) { return Chosen::NUMBER; }
};
std::uint64_t bytesThrough(IFile* file, char const* text) { return file->write(text, 1); }

static_assert(std::is_convertible_v<File, IFile*>);
static_assert(std::is_convertible_v<File const&, IFile*>);
static_assert(std::is_convertible_v<File&, IFile const*>);
static_assert(!std::is_convertible_v<File, int>);
static_assert(!std::is_constructible_v<int, File>);
static_assert(std::is_constructible_v<bool, File const&>);
static_assert(!std::is_copy_constructible_v<File>);
static_assert(!std::is_copy_assignable_v<File>);
static_assert(std::is_nothrow_move_constructible_v<File>);
static_assert(std::is_nothrow_move_assignable_v<File>);
static_assert(sizeof(File) == sizeof(IFile*));

} // namespace

TEST_F(FileCalls, become_a_pointer_wherever_one_is_asked_for) {
    File file(at("f").c_str(), WRITE);
    File const& constant = file;
    IFile* pointer = file;
    EXPECT_EQ(pointer, file.ptr());
    pointer = constant;
    EXPECT_EQ(pointer, file.ptr());
    IFile const* const constantPointer = file;
    EXPECT_EQ(constantPointer, file.ptr());
    IFile* const direct(file);
    EXPECT_EQ(direct, file.ptr());
    EXPECT_EQ(bytesThrough(file, "x"), 1u);
    EXPECT_EQ(bytesThrough(constant, "y"), 1u);
    EXPECT_EQ(Takes::plain(file), Chosen::POINTER);
    EXPECT_EQ(Takes::plain(constant), Chosen::POINTER);
    EXPECT_EQ(Takes::constant(file), Chosen::CONSTANT);
    EXPECT_TRUE(file == file.ptr());
    EXPECT_TRUE(file.ptr() == constant);
    EXPECT_TRUE(file == constant);
    EXPECT_TRUE(file != nullptr);
    EXPECT_FALSE(nullptr == file);
    EXPECT_EQ(&*file, file.ptr());
    File const none;
    EXPECT_TRUE(none == nullptr);
    Blob blob(3, "abc");
    EXPECT_TRUE(blob.write(file));
    file.open(at("f").c_str(), READ);
    Blob back;
    file->seek(0, 2);
    EXPECT_TRUE(back.read(constant));
    EXPECT_EQ(back, blob);
}

TEST_F(FileCalls, are_held_or_not_where_a_truth_value_is_made_of_the_pointer) {
    File file(at("no/f").c_str(), READ);
    bool const held = file;
    EXPECT_TRUE(held) << "as without the conditions: initialising goes by the pointer";
    EXPECT_FALSE(file);
}

TEST_F(FileCalls, choose_the_backend_by_mode_and_flag) {
    File file;
    for (bool flag : {false, true}) {
        file.open(at("f").c_str(), WRITE, flag);
        EXPECT_NE(dynamic_cast<FileXosBasics*>(file.ptr()), nullptr);
    }
    file.open(at("f").c_str(), WRITE | File::FILE_CRT, true);
    EXPECT_NE(dynamic_cast<FileStdBuf*>(file.ptr()), nullptr);
    file.open(at("f").c_str(), WRITE | File::FILE_CRT, false);
    EXPECT_NE(dynamic_cast<FileStdDir*>(file.ptr()), nullptr);
    file.open(at("f").c_str(), WRITE | File::FILE_CRT);
    EXPECT_NE(dynamic_cast<FileStdDir*>(file.ptr()), nullptr);
}

TEST_F(FileCalls, translate_the_mode_for_the_platform) {
    struct Case {
        Row row;
        int mode;
        bool flag;
        char const* flags;
    };
    for (Case const& c : {
             Case{{}, 0x000, false, "0x40"},
             Case{{}, 0x001, false, "0x42"},
             Case{{}, 0x002, false, "0x54"},
             Case{{}, 0x004, false, "0x48"},
             Case{{}, 0x008, false, "0x41"},
             Case{{}, 0x010, false, "0x40"},
             Case{{}, 0x020, false, "0x40"},
             Case{{}, 0x080, false, "0x0"},
             Case{{}, 0x200, false, "0x4000040"},
             Case{{}, 0x001, true, "0x2"},
             Case{{}, 0x081, true, "0x2"},
             Case{{}, 0x00F, false, "0x5f"},
             Case{{}, 0x31, true, "0x2"},
             Case{{}, 0x3A, true, "0x15"},
             Case{{}, 0x226, false, "0x400005c"},
             Case{{}, 0x226, true, "0x400001c"},
             Case{{}, 0x2BF, true, "0x400001f"},
         }) {
        SCOPED_TRACE(c.row);
        File file(at("f").c_str(), c.mode, c.flag);
        EXPECT_EQ(last("xos_FileOpen"), std::string("\"f\", ") + c.flags);
    }
}

TEST_F(FileCalls, build_the_mode_text_of_a_stream) {
    struct Case {
        Row row;
        int mode;
        char const* text;
    };
    for (Case const& c : {
             Case{{}, 0x001, "rR"},
             Case{{}, 0x002, "wR"},
             Case{{}, 0x004, "a+R"},
             Case{{}, 0x003, "r+R"},
             Case{{}, 0x00B, "w+R"},
             Case{{}, 0x009, "rR"},
             Case{{}, 0x005, "rR"},
             Case{{}, 0x007, "r+R"},
             Case{{}, 0x006, "wR"},
             Case{{}, 0x00A, "wR"},
             Case{{}, 0x00C, "a+R"},
             Case{{}, 0x021, "rS"},
             Case{{}, 0x031, "rSb"},
             Case{{}, 0x011, "rRb"},
             Case{{}, 0x3A, "wSb"},
             Case{{}, 0x3B, "w+Sb"},
             Case{{}, 0x33, "r+Sb"},
             Case{{}, 0x34, "a+Sb"},
         }) {
        SCOPED_TRACE(c.row);
        static std::string handed;
        handed.clear();
        systemCalls.openStream = [](char const*, char const* mode) -> std::FILE* {
            handed = mode;
            return nullptr;
        };
        systemCalls.openStreamWide = [](WChar const*, char const* mode) -> std::FILE* {
            handed = mode;
            return nullptr;
        };
        File file;
        EXPECT_FALSE(file.open("x", c.mode | File::FILE_CRT, true));
        EXPECT_EQ(handed, c.text);
        handed.clear();
        File wideFile;
        EXPECT_FALSE(wideFile.openW(ZB_W("x"), c.mode));
        EXPECT_EQ(handed, c.text);
    }
}

TEST_F(FileCalls, open_no_stream_without_any_access) {
    for (int mode : {0, 0x008, 0x010, 0x020, 0x038, 0x080, 0x200}) {
        File file;
        EXPECT_FALSE(file.open(at("f").c_str(), mode | File::FILE_CRT, true)) << mode;
        ASSERT_NE(file.ptr(), nullptr);
        EXPECT_TRUE(!*file.ptr());
        EXPECT_FALSE(File(wide(at("f")).c_str(), mode).isOpen()) << mode;
    }
    EXPECT_FALSE(exists(at("f")));
}

TEST_F(FileCalls, Kept_file_03_truncate_with_every_stream_for_writing_alone) {
    put(at("f"), "before");
    File file;
    ASSERT_TRUE(file.open(at("f").c_str(), 0x36 | File::FILE_CRT, true));
    file.close();
    EXPECT_EQ(textOf(at("f")), "");
    put(at("f"), "before");
    ASSERT_TRUE(file.open(at("f").c_str(), 0x34 | File::FILE_CRT, true)) << "append alone";
    file->write("+", 1);
    file.close();
    EXPECT_EQ(textOf(at("f")), "before+");
}

TEST_F(FileCalls, append_at_the_end_whatever_the_position) {
    for (bool platform : {true, false}) {
        put(at("f"), "abc");
        File file;
        ASSERT_TRUE(file.open(at("f").c_str(), 0x36 | (platform ? 0 : File::FILE_CRT), false));
        file->seek(0, 0);
        EXPECT_EQ(file->write("+", 1), 1u);
        file.close();
        EXPECT_EQ(textOf(at("f")), "abc+");
    }
}

TEST_F(FileCalls, let_a_descriptor_for_writing_read_too_and_keep_what_is_there) {
    put(at("f"), "abc");
    File file;
    ASSERT_TRUE(file.open(at("f").c_str(), 0x32 | File::FILE_CRT, false));
    char text[4] = {};
    EXPECT_EQ(file->read(text, 3), 3u);
    EXPECT_STREQ(text, "abc");
    File reader;
    ASSERT_TRUE(reader.open(at("f").c_str(), READ | File::FILE_CRT, false));
    EXPECT_EQ(reader->write("x", 1), ~std::uint64_t{0});
    EXPECT_EQ(textOf(at("f")), "abc");
}

TEST_F(FileCalls, Kept_file_01_give_all_ones_for_a_failure_of_a_descriptor) {
    File file;
    EXPECT_FALSE(file.open(at("missing").c_str(), READ | File::FILE_CRT, false));
    char c;
    EXPECT_EQ(file->read(&c, 1), ~std::uint64_t{0});
    EXPECT_EQ(file->write(&c, 1), ~std::uint64_t{0});
    ASSERT_FALSE(file.open(at("missing").c_str(), READ, false));
    EXPECT_EQ(file->read(&c, 1), 0u);
    EXPECT_EQ(file->write(&c, 1), 0u);
    ASSERT_FALSE(file.open(at("missing").c_str(), READ | File::FILE_CRT, true));
    EXPECT_EQ(file->read(&c, 1), 0u);
    EXPECT_EQ(file->write(&c, 1), 0u);
}

TEST_F(FileCalls, open_streams_by_wide_paths) {
    {
        File file(wide(at("f")).c_str(), WRITE);
        ASSERT_TRUE(file.isOpen());
        EXPECT_NE(dynamic_cast<FileStdBuf*>(file.ptr()), nullptr);
        EXPECT_EQ(file->write("12", 2), 2u);
    }
    EXPECT_EQ(textOf(at("f")), "12");
    File file;
    EXPECT_TRUE(file.openW(wide(at("f")).c_str(), READ));
    file.close();
    EXPECT_FALSE(file.openW(wide(at("missing")).c_str(), READ));
    EXPECT_NE(file.ptr(), nullptr);
    file.close();
    EXPECT_FALSE(file.openW(nullptr, READ));
}

TEST_F(FileCalls, Kept_file_05_leave_open_what_is_held_when_a_wide_path_is_opened) {
    File file(wide(at("f")).c_str(), WRITE);
    std::unique_ptr<IFile> const before(file.ptr());
    ASSERT_TRUE(file.openW(wide(at("g")).c_str(), WRITE));
    EXPECT_NE(file.ptr(), before.get());
    EXPECT_TRUE(before->isOpen());
    EXPECT_EQ(before->write("1", 1), 1u);
}

TEST_F(FileCalls, hand_every_argument_to_the_platform) {
    put(at("f"), "one\ntwo\n");
    File file(at("f").c_str(), 0x13);
    char text[64];
    auto const rest = [this](char const* function) {
        std::string const call = last(function);
        return call.substr(call.find(", "));
    };
    auto const behindBuffer = [&](char const* function) {
        std::string const call = rest(function);
        return call.substr(call.find(", ", 2));
    };
    EXPECT_EQ(file->read(text, 3), 3u);
    EXPECT_EQ(behindBuffer("xos_FileReadEx"), ", 3, 0, 0");
    EXPECT_EQ(file->getline(text, sizeof text), 1u);
    EXPECT_EQ(behindBuffer("xos_FileGetsEx"), ", 64, 0");
    EXPECT_EQ(file->seek(2, -4), 4);
    EXPECT_EQ(rest("xos_FileSeekEx"), ", -4, 2, 0");
    EXPECT_EQ(rest("xos_FileTellEx"), ", 0");
    EXPECT_EQ(file->write("TW", 2), 2u);
    EXPECT_EQ(behindBuffer("xos_FileWriteEx"), ", 2, 0, 0");
    EXPECT_TRUE(file->flush());
    EXPECT_EQ(xos_HostCalls("xos_FileFlush"), 1u);
    file.close();
    EXPECT_EQ(rest("xos_FileCloseEx"), ", 0");
    EXPECT_EQ(textOf(at("f")), "one\nTWo\n");
}

TEST_F(FileCalls, report_what_the_platform_fails_at) {
    put(at("f"), "one\ntwo\n");
    File file;
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(file.open(at("f").c_str(), 0x13));
    EXPECT_TRUE(!*file.ptr());
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 0u);
    ASSERT_TRUE(file.open(at("f").c_str(), 0x13));
    char text[64] = {};
    xos_HostFail("xos_FileReadEx", 0, 1);
    EXPECT_EQ(file->read(text, 1), 0u);
    xos_HostFail("xos_FileGetsEx", 0, 1);
    text[63] = 'x';
    EXPECT_EQ(file->getline(text, sizeof text), 0u);
    EXPECT_EQ(text[63], '\0');
    xos_HostFail("xos_FileWriteEx", 0, 1);
    EXPECT_EQ(file->write("x", 1), 0u);
    xos_HostFail("xos_FileFlush", 0, 1);
    EXPECT_FALSE(file->flush());
    std::uint64_t const told = xos_HostCalls("xos_FileTellEx");
    xos_HostFail("xos_FileSeekEx", 0, 1);
    EXPECT_EQ(file->seek(0, 3), 0);
    EXPECT_EQ(xos_HostCalls("xos_FileTellEx"), told);
    xos_HostFail("xos_FileTellEx", 0, 1);
    EXPECT_EQ(file->seek(0, 3), -1);
    xos_HostFail("xos_FileCloseEx", 0, 1);
    file.close();
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_EQ(textOf(at("f")), "one\ntwo\n");
}

TEST_F(FileCalls, make_a_new_file_with_its_folders) {
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_EQ(last("xos_FileOpen"), "\"f\", 0x54");
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 0u);
    EXPECT_FALSE(File::New(at("a/b/f").c_str(), false));
    EXPECT_FALSE(exists(at("a")));
    EXPECT_TRUE(File::New(at("a/b/f").c_str(), true));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/f", "f"}));
}

TEST_F(FileCalls, make_no_new_file_where_something_is) {
    put(at("f"), "text");
    makeFolder(at("d"));
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_TRUE(File::New(at("f").c_str(), true));
    EXPECT_FALSE(File::New(at("d").c_str(), false));
    EXPECT_FALSE(File::New(at("d").c_str(), true));
    EXPECT_EQ(textOf(at("f")), "text");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 0u);
    EXPECT_FALSE(File::New("zb-bare-name", true)) << "it has no directory that could be made";
    EXPECT_FALSE(exists("zb-bare-name"));
    EXPECT_FALSE(File::New(nullptr, true));
}

TEST_F(FileCalls, make_no_new_file_where_the_platform_fails) {
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(File::New(at("f").c_str(), false));
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 0u);
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::New(at("a/f").c_str(), true));
    EXPECT_EQ(scratch.content(), Names{});
    xos_HostFail("xos_FileCloseEx", 0, 1);
    EXPECT_TRUE(File::New(at("f").c_str(), false)) << "the file is there, and that counts";
}

TEST_F(FileCalls, remove_with_the_flags_of_their_arguments) {
    struct Case {
        Row row;
        bool flagA;
        bool flagB;
        char const* flags;
    };
    for (Case const& c : {
             Case{{}, false, false, "0x0"},
             Case{{}, true, false, "0x400"},
             Case{{}, false, true, "0x800"},
             Case{{}, true, true, "0xc00"},
         }) {
        SCOPED_TRACE(c.row);
        put(at("f"), "");
        EXPECT_TRUE(File::Rem(at("f").c_str(), c.flagA, c.flagB));
        EXPECT_EQ(last("xos_FileRemove"), std::string("\"f\", ") + c.flags);
        EXPECT_FALSE(exists(at("f")));
        EXPECT_FALSE(File::Rem(at("f").c_str(), c.flagA, c.flagB));
    }
}

TEST_F(FileCalls, copy_with_one_call) {
    put(at("f"), "text");
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"g\", \"f\", 0");
    EXPECT_FALSE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    put(at("f"), "more");
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"g\", \"f\", 1");
    EXPECT_EQ(textOf(at("g")), "more");
    EXPECT_FALSE(File::Copy(at("a/b/g").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(File::Copy(at("a/b/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(textOf(at("a/b/g")), "more");
    std::uint64_t const copies = xos_HostCalls("xos_FileCopy");
    EXPECT_FALSE(File::Copy("zb-bare", at("f").c_str(), true, true));
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::Copy(at("c/d/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), copies) << "no directory, no copy";
}

TEST_F(FileCalls, move_by_the_platform_if_that_can) {
    put(at("f"), "text");
    EXPECT_TRUE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileMove"), "\"g\", \"f\", 0");
    EXPECT_TRUE(File::Move(at("a/b/g").c_str(), at("g").c_str(), true, true));
    EXPECT_EQ(last("xos_FileMove"), "\"a/b/g\", \"g\", 1");
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/g"}));
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    EXPECT_EQ(xos_HostCalls("xos_FileRemove"), 0u);
}

TEST_F(FileCalls, move_by_copying_where_the_platform_cannot_move) {
    for (bool overwrite : {false, true}) {
        put(at("f"), "text");
        xos_HostFail("xos_FileMove", 0, 1);
        EXPECT_TRUE(File::Move(at("a/g").c_str(), at("f").c_str(), overwrite, true));
        EXPECT_EQ(last("xos_FileCopy"), std::string("\"a/g\", \"f\", ") + (overwrite ? "1" : "0"));
        EXPECT_EQ(last("xos_FileRemove"), "\"f\", 0x400");
        EXPECT_EQ(scratch.content(), (Names{"a/", "a/g"}));
        EXPECT_TRUE(File::Rem(at("a/g").c_str(), true, false));
        EXPECT_TRUE(Dir::Rem(at("a").c_str(), false, false));
    }
}

TEST_F(FileCalls, move_nothing_when_the_first_directories_cannot_be_made) {
    put(at("f"), "text");
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::Move(at("a/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(scratch.content(), Names{"f"});
    EXPECT_EQ(xos_HostCalls("xos_FileMove"), 0u);
    EXPECT_FALSE(File::Move("zb-bare", at("f").c_str(), true, true));
    EXPECT_EQ(scratch.content(), Names{"f"});
}

TEST_F(FileCalls, count_as_moved_although_the_source_could_not_be_removed) {
    put(at("f"), "text");
    xos_HostFail("xos_FileMove", 0, 1);
    xos_HostFail("xos_FileRemove", 0, 1);
    EXPECT_TRUE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"f", "g"}));
}

TEST_F(FileCalls, Kept_file_04_lose_the_source_when_neither_moving_nor_copying_works) {
    put(at("f"), "text");
    xos_HostFail("xos_FileMove", 0, 1);
    xos_HostFail("xos_FileCopy", 0, 1);
    EXPECT_FALSE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), Names{});
    // The directories vanish between the two attempts to make them.
    put(at("f"), "text");
    static std::string folder;
    static int looks;
    folder = at("d");
    looks = 0;
    systemCalls.status = [](char const* path, xos_Stat& record) {
        record.st_mode_ = MODE_DIRECTORY;
        return folder == path && ++looks == 1;
    };
    xos_HostFail("xos_DirCreateEx", 0, 99);
    xos_HostFail("xos_FileStatByNameEx", 0, 99);
    xos_HostCallsReset();
    EXPECT_FALSE(File::Move(at("d/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(xos_HostCalls("xos_FileMove"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    EXPECT_EQ(last("xos_FileRemove"), "\"f\", 0x400");
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(FileCalls, link_or_copy) {
    put(at("f"), "text");
    EXPECT_TRUE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileHardLink"), "\"f\", \"g\"");
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    put(at("f"), "both");
    EXPECT_EQ(textOf(at("g")), "both");

    xos_HostFail("xos_FileHardLink", 0, 1);
    EXPECT_TRUE(File::LinkOrCopy(at("h").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"h\", \"f\", 1");
    xos_HostFail("xos_FileHardLink", 0, 1);
    xos_HostFail("xos_FileCopy", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("i").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"f", "g", "h"}));
}

TEST_F(FileCalls, link_or_copy_onto_something_only_when_told) {
    put(at("f"), "text");
    put(at("g"), "old");
    makeFolder(at("d/e"));
    put(at("d/e/x"), "");
    EXPECT_FALSE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), false, true));
    EXPECT_FALSE(File::LinkOrCopy(at("d").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(textOf(at("g")), "old");
    EXPECT_TRUE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_FileRemove"), "\"g\", 0x400");
    EXPECT_TRUE(File::LinkOrCopy(at("d").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_DirRemove"), "\"d\", 0x600");
    EXPECT_EQ(scratch.content(), (Names{"d", "f", "g"}));
    EXPECT_EQ(textOf(at("d")), "text");

    xos_HostFail("xos_FileRemove", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), true, false));
    makeFolder(at("k"));
    xos_HostFail("xos_DirRemove", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("k").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(exists(at("k")));
}

TEST_F(FileCalls, link_or_copy_with_the_folders_where_nothing_is) {
    put(at("f"), "text");
    EXPECT_FALSE(File::LinkOrCopy(at("a/b/g").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(File::LinkOrCopy(at("a/b/g").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(textOf(at("a/b/g")), "text");
    xos_HostFail("xos_DirCreateEx", 0, 9);
    std::uint64_t const links = xos_HostCalls("xos_FileHardLink");
    EXPECT_FALSE(File::LinkOrCopy(at("c/d/g").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(xos_HostCalls("xos_FileHardLink"), links);
}

TEST_F(FileCalls, leave_read_only_files_as_the_platform_does) {
    put(at("f"), "text");
    std::filesystem::permissions(at("f"),
                                 std::filesystem::perms::owner_write | std::filesystem::perms::group_write |
                                     std::filesystem::perms::others_write,
                                 std::filesystem::perm_options::remove);
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(textOf(at("g")), "text");
    EXPECT_TRUE(File::Move(at("h").c_str(), at("g").c_str(), false, false));
    EXPECT_TRUE(File::Rem(at("h").c_str(), true, false));
    EXPECT_TRUE(File::Rem(at("f").c_str(), true, false));
    EXPECT_EQ(scratch.content(), Names{});
}
