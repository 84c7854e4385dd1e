#include <zor_basis/files/file.h>

#include <zor_basis/store/blob.h>

#include "basis/files/file_backends.h"

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct FileAsPointer : CallsOfFiles {};
template <class Backend>
struct FileHeld : FileOverBackend<Backend> {};
TYPED_TEST_SUITE(FileHeld, Backends);

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

TYPED_TEST(FileHeld, keeps_a_closed_backend_when_opening_fails) {
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
    EXPECT_EQ(file->seek(0, 0), TypeParam::BAD_SEEK);
    EXPECT_EQ(file->getline(&c, 1), 0u);
    EXPECT_FALSE(this->open(file, "missing", READ));
    EXPECT_FALSE(file.open(nullptr, READ | TypeParam::MODE, TypeParam::FLAG));
    EXPECT_FALSE(file.open("", READ | TypeParam::MODE, TypeParam::FLAG));
    EXPECT_TRUE(this->open(file, "f", WRITE));
    EXPECT_FALSE(!*file.ptr());
}

TYPED_TEST(FileHeld, closes_the_file_that_was_open_before) {
    File file;
    ASSERT_TRUE(this->open(file, "one", WRITE));
    EXPECT_TRUE(this->write(file, "first"));
    ASSERT_TRUE(this->open(file, "two", WRITE));
    EXPECT_EQ(textOf(this->scratch / "one"), "first") << "what a stream had buffered is written";
    EXPECT_TRUE(this->write(file, "second"));
    EXPECT_FALSE(this->open(file, "missing/f", READ));
    EXPECT_EQ(textOf(this->scratch / "two"), "second");
}

TYPED_TEST(FileHeld, is_closed_at_the_end_of_its_life_and_as_often_as_one_likes) {
    {
        File file((this->scratch / "f").c_str(), WRITE | TypeParam::MODE, TypeParam::FLAG);
        ASSERT_TRUE(file.isOpen());
        EXPECT_TRUE(this->write(file, "12"));
    }
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
    File file((this->scratch / "f").c_str(), READ | TypeParam::MODE, TypeParam::FLAG);
    EXPECT_TRUE(file.isOpen());
    file.close();
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_FALSE(file.isOpen());
    file.close();
}

TYPED_TEST(FileHeld, is_true_in_a_condition_only_while_it_is_open) {
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
    if (!File((this->scratch / "no/f").c_str(), READ | TypeParam::MODE, TypeParam::FLAG)) return;
    ADD_FAILURE() << "a file that could not be opened is false in the commonest check of all";
}

TYPED_TEST(FileHeld, moves_what_it_holds) {
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

TYPED_TEST(FileHeld, can_be_returned_and_kept_in_containers) {
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

TEST_F(FileAsPointer, hold_nothing_at_first) {
    File file;
    EXPECT_FALSE(file.isOpen());
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_EQ(static_cast<IFile*>(file), nullptr);
    EXPECT_EQ(file.operator->(), nullptr);
    file.close();
}

TEST_F(FileAsPointer, give_the_same_backend_in_three_ways) {
    File file(at("f").c_str(), WRITE);
    EXPECT_NE(file.ptr(), nullptr);
    EXPECT_EQ(static_cast<IFile*>(file), file.ptr());
    EXPECT_EQ(file.operator->(), file.ptr());
}

TEST_F(FileAsPointer, become_a_pointer_wherever_one_is_asked_for) {
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

TEST_F(FileAsPointer, are_held_or_not_where_a_truth_value_is_made_of_the_pointer) {
    File file(at("no/f").c_str(), READ);
    bool const held = file;
    EXPECT_TRUE(held) << "as without the conditions: initialising goes by the pointer";
    EXPECT_FALSE(file);
}

TEST_F(FileAsPointer, choose_the_backend_by_mode_and_flag) {
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
