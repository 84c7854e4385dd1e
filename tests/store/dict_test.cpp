#include <zor_basis/containers/dict.h>

#include "tests/store/stored_dict.h"

#include <gtest/gtest.h>

#include <map>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

struct DictOnDisk : StoredDict {};

} // namespace

TEST_F(DictOnDisk, breathes) {
    BlobDict dict;
    dict.setPath(Str(path));
    dict.set(blob("key"), blob("value"));
    EXPECT_TRUE(dict.write());
    BlobDict other{Str(path)};
    Blob value;
    EXPECT_TRUE(other.get(blob("key"), value));
    EXPECT_EQ(text(value), "value");
}

TEST_F(DictOnDisk, is_not_copied) {
    static_assert(!std::is_copy_constructible_v<BlobDict>);
    static_assert(!std::is_copy_assignable_v<BlobDict>);
    static_assert(std::is_base_of_v<SngList<BlobEntry>, BlobDict>);
}

TEST_F(DictOnDisk, stores_finds_and_removes) {
    BlobDict dict;
    Blob value = blob("before");
    EXPECT_FALSE(dict.get(blob("a"), value));
    EXPECT_EQ(text(value), "before");
    dict.set(blob("a"), blob("1"));
    dict.set(blob(""), blob(""));
    dict.set(blob(std::string("a\0", 2)), blob("zero"));
    dict.set(blob("b"), blob("2"));
    EXPECT_EQ(content(dict), (Pairs{{"b", "2"}, {std::string("a\0", 2), "zero"}, {"", ""}, {"a", "1"}}));
    EXPECT_EQ(dict.size(), 4u);
    EXPECT_TRUE(dict.get(blob(""), value));
    EXPECT_EQ(text(value), "");
    EXPECT_TRUE(dict.get(blob(std::string("a\0", 2)), value));
    EXPECT_EQ(text(value), "zero");
    dict.set(blob("a"), blob("a longer value"));
    EXPECT_EQ(dict.size(), 4u);
    EXPECT_EQ(content(dict).back(), Pair("a", "a longer value")) << "in its place";
    dict.rm(blob("a"));
    dict.rm(blob("b"));
    dict.rm(blob("c"));
    EXPECT_EQ(content(dict), (Pairs{{std::string("a\0", 2), "zero"}, {"", ""}}));
    dict.clean();
    EXPECT_EQ(content(dict), Pairs{});
    dict.set(blob("x"), blob("y"));
    EXPECT_EQ(content(dict), (Pairs{{"x", "y"}}));
}

TEST_F(DictOnDisk, takes_its_own_keys_and_values) {
    BlobDict dict;
    dict.set(blob("a"), blob("1"));
    dict.set(blob("b"), blob("2"));
    BlobEntry& entry = dict.first()->value;
    dict.set(entry.key, entry.value);
    dict.set(entry.value, entry.key);
    EXPECT_EQ(content(dict), (Pairs{{"2", "b"}, {"b", "2"}, {"a", "1"}}));
    EXPECT_TRUE(dict.get(blob("b"), entry.value));
    EXPECT_EQ(text(entry.value), "2");
    dict.set(blob("a"), entry.value);
    EXPECT_EQ(content(dict), (Pairs{{"2", "b"}, {"b", "2"}, {"a", "2"}}));
    dict.rm(entry.key);
    EXPECT_EQ(content(dict), (Pairs{{"2", "b"}, {"a", "2"}}));
}

TEST_F(DictOnDisk, knows_when_it_needs_saving) {
    BlobDict dict;
    EXPECT_FALSE(needsSaving(dict)) << "at first";
    dict.setPath(Str(path));
    EXPECT_FALSE(needsSaving(dict)) << "another path";
    dict.rm(blob("a"));
    dict.clean();
    EXPECT_FALSE(needsSaving(dict)) << "nothing was there";
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(needsSaving(dict)) << "a new key";
    EXPECT_TRUE(dict.write());
    EXPECT_FALSE(needsSaving(dict)) << "saved";
    dict.set(blob("a"), blob("2"));
    EXPECT_TRUE(needsSaving(dict)) << "another value";
    EXPECT_TRUE(dict.write());
    dict.rm(blob("b"));
    EXPECT_FALSE(needsSaving(dict)) << "no such key";
    dict.rm(blob("a"));
    EXPECT_TRUE(needsSaving(dict)) << "removed";
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), "");
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.write());
    dict.clean();
    EXPECT_TRUE(needsSaving(dict)) << "emptied";
}

TEST_F(DictOnDisk, Kept_dict_01_counts_as_saved_once_a_value_is_stored_again) {
    BlobDict dict;
    dict.setPath(Str(path));
    dict.set(blob("a"), blob("1"));
    dict.set(blob("b"), blob("2"));
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.write());
    EXPECT_FALSE(exists(path)) << "nothing was written";
    dict.set(blob("a"), blob("3"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), fileOf({{"b", "2"}, {"a", "3"}}));
}

TEST_F(DictOnDisk, Kept_dict_02_does_not_need_saving_for_an_intersection) {
    BlobDict dict;
    BlobDict other;
    dict.setPath(Str(path));
    for (char const* key : {"a", "b", "c", "d"}) dict.set(blob(key), blob("1"));
    for (char const* key : {"b", "x", "d"}) other.set(blob(key), blob("another value"));
    EXPECT_TRUE(dict.write());
    dict.intersect(other);
    EXPECT_EQ(content(dict), (Pairs{{"d", "1"}, {"b", "1"}}));
    EXPECT_EQ(content(other).size(), 3u);
    EXPECT_FALSE(needsSaving(dict));
    dict.set(blob("e"), blob(""));
    dict.intersect(dict);
    EXPECT_EQ(dict.size(), 3u);
    EXPECT_TRUE(needsSaving(dict)) << "nor does it count as saved";
    dict.intersect(BlobDict());
    EXPECT_EQ(content(dict), Pairs{});
}

TEST_F(DictOnDisk, asks_for_its_file_with_fixed_flags) {
    put(path, "");
    BlobDict dict{Str(path)};
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileOpen")), "\"" + path + "\", 0x2");
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileOpen")), "\"" + path + "\", 0x15");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 2u);
}

TEST_F(DictOnDisk, writes_golden_bytes) {
    BlobDict dict;
    dict.setPath(Str(path));
    dict.set(blob(""), blob(std::string(258, 'v')));
    dict.set(blob(std::string("k\0", 2)), blob("\r\n"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), std::string("\x02\0\0\0k\0\x02\0\0\0\r\n\0\0\0\0\x02\x01\0\0", 20) + std::string(258, 'v'));
}

TEST_F(DictOnDisk, needs_saving_where_there_is_no_file) {
    BlobDict dict{Str(path)};
    EXPECT_EQ(content(dict), Pairs{});
    EXPECT_FALSE(exists(path)) << "reading makes none";
    EXPECT_TRUE(dict.write());
    EXPECT_TRUE(exists(path));
    EXPECT_EQ(textOf(path), "");

    BlobDict saved;
    saved.setPath(Str(scratch / "missing"));
    EXPECT_FALSE(saved.read());
    EXPECT_FALSE(needsSaving(saved)) << "an empty one that was not";
    saved.set(blob("a"), blob("1"));
    saved.setPath(Str(path));
    EXPECT_TRUE(saved.write());
    saved.setPath(Str(scratch / "missing"));
    EXPECT_FALSE(saved.read());
    EXPECT_EQ(content(saved), Pairs{}) << "the entries go first";
    EXPECT_TRUE(needsSaving(saved));
}

TEST_F(DictOnDisk, replaces_its_entries_by_those_of_the_file) {
    put(path, fileOf({{"A", "1"}}));
    BlobDict dict;
    dict.set(blob("B"), blob("2"));
    dict.setPath(Str(path));
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(content(dict), (Pairs{{"A", "1"}}));
    EXPECT_FALSE(needsSaving(dict));
}

TEST_F(DictOnDisk, fails_without_a_path_or_a_folder) {
    BlobDict dict;
    EXPECT_FALSE(dict.read());
    EXPECT_TRUE(dict.write()) << "nothing to save";
    dict.set(blob("a"), blob("1"));
    EXPECT_FALSE(dict.write());
    dict.setPath(Str(scratch / "no/folder"));
    EXPECT_FALSE(dict.write());
    dict.setPath(Str(scratch.path()));
    EXPECT_FALSE(dict.write());
    EXPECT_FALSE(dict.read());
}

TEST_F(DictOnDisk, still_needs_saving_after_each_failure_to_write) {
    BlobDict dict;
    dict.setPath(Str(path));
    std::string const large(200'000, 'L');
    dict.set(blob("small"), blob("1"));
    dict.set(blob("large"), blob(large));
    dict.set(blob("other"), blob("2"));
    std::string const whole = fileOf({{"other", "2"}, {"large", large}, {"small", "1"}});
    for (std::uint32_t skip = 0;; ++skip) {
        SCOPED_TRACE(skip);
        ASSERT_LT(skip, 10u);
        xos_HostCallsReset();
        ASSERT_EQ(xos_HostFail("xos_FileWriteEx", skip, 1), 0);
        bool const done = dict.write();
        xos_HostFailClear();
        EXPECT_EQ(whole.substr(0, textOf(path).size()), textOf(path)) << "cut, but never wrong";
        EXPECT_EQ(textOf(path) == whole, done);
        EXPECT_EQ(xos_HostCalls("xos_FileOpen"), xos_HostCalls("xos_FileCloseEx"));
        if (done) break;
        EXPECT_EQ(xos_HostCalls("xos_FileWriteEx"), skip + 1) << "nothing more is tried";
    }
    EXPECT_FALSE(needsSaving(dict));
}
