#include <zor_basis/containers/dict.h>

#include "tests/store/dict_files.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <cstring>
#include <map>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

/// A plain reading of a file: the complete records, as the list then has them.
Pairs plainReading(std::string const& bytes) {
    Pairs pairs;
    std::size_t at = 0;
    auto const next = [&](std::string& out) {
        std::uint32_t n = 0;
        if (bytes.size() - at < 4) return false;
        std::memcpy(&n, bytes.data() + at, 4);
        at += 4;
        if (bytes.size() - at < n) return false;
        out = bytes.substr(at, n);
        at += n;
        return true;
    };
    Pair pair;
    while (next(pair.first) && next(pair.second)) {
        auto const found =
            std::find_if(pairs.begin(), pairs.end(), [&](Pair const& known) { return known.first == pair.first; });
        if (found != pairs.end()) {
            found->second = pair.second;
        } else {
            pairs.insert(pairs.begin(), pair);
        }
    }
    return pairs;
}

/// How far a file is understood, read plainly.
std::size_t plainEnd(std::string const& bytes) {
    std::size_t end = 0;
    for (std::size_t at = 0, fields = 1;; ++fields) {
        std::uint32_t n = 0;
        if (bytes.size() - at < 4) return end;
        std::memcpy(&n, bytes.data() + at, 4);
        if (bytes.size() - at - 4 < n) return end;
        at += 4 + n;
        if (fields % 2 == 0) end = at;
    }
}

void expectFound(BlobDict const& dict, std::string const& bytes) {
    EXPECT_EQ(dict.understood(), plainEnd(bytes));
    EXPECT_EQ(dict.found(), plainEnd(bytes) == bytes.size() ? DICT_WHOLE : DICT_PART);
}

Pairs content(BlobDict& dict) {
    EXPECT_TRUE(dict.isConsistent());
    Pairs pairs;
    for (BlobEntry const& entry : dict) pairs.emplace_back(text(entry.key), text(entry.value));
    return pairs;
}

struct DictTest : testing::Test {
    DictTest() { xos_HostCallsReset(); }
    ~DictTest() override { xos_HostFailClear(); }

    /// Whether `write` would write: it then opens the file.
    static bool needsSaving(BlobDict& dict) {
        std::uint64_t const opened = xos_HostCalls("xos_FileOpen");
        xos_HostFail("xos_FileOpen", 0, 1);
        dict.write();
        xos_HostFail("xos_FileOpen", 0, 0);
        return xos_HostCalls("xos_FileOpen") != opened;
    }

    Scratch scratch;
    std::string const path = scratch / "a dictionary";
};

} // namespace

TEST_F(DictTest, breathes) {
    BlobDict dict;
    dict.setPath(Str(path));
    dict.set(blob("key"), blob("value"));
    EXPECT_TRUE(dict.write());
    BlobDict other{Str(path)};
    Blob value;
    EXPECT_TRUE(other.get(blob("key"), value));
    EXPECT_EQ(text(value), "value");
}

TEST_F(DictTest, is_not_copied) {
    static_assert(!std::is_copy_constructible_v<BlobDict>);
    static_assert(!std::is_copy_assignable_v<BlobDict>);
    static_assert(std::is_base_of_v<SngList<BlobEntry>, BlobDict>);
}

TEST_F(DictTest, stores_finds_and_removes) {
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

TEST_F(DictTest, takes_its_own_keys_and_values) {
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

TEST_F(DictTest, knows_when_it_needs_saving) {
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

TEST_F(DictTest, Kept_dict_01_counts_as_saved_once_a_value_is_stored_again) {
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

TEST_F(DictTest, Kept_dict_02_does_not_need_saving_for_an_intersection) {
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

TEST_F(DictTest, asks_for_its_file_with_fixed_flags) {
    put(path, "");
    BlobDict dict{Str(path)};
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileOpen")), "\"" + path + "\", 0x2");
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileOpen")), "\"" + path + "\", 0x15");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 2u);
}

TEST_F(DictTest, writes_golden_bytes) {
    BlobDict dict;
    dict.setPath(Str(path));
    dict.set(blob(""), blob(std::string(258, 'v')));
    dict.set(blob(std::string("k\0", 2)), blob("\r\n"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), std::string("\x02\0\0\0k\0\x02\0\0\0\r\n\0\0\0\0\x02\x01\0\0", 20) + std::string(258, 'v'));
}

TEST_F(DictTest, Kept_dict_03_reverses_the_order_with_every_load) {
    put(path, fileOf({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    BlobDict dict{Str(path)};
    EXPECT_EQ(content(dict), (Pairs{{"C", "3"}, {"B", "2"}, {"A", "1"}}));
    EXPECT_TRUE(dict.write()) << "nothing to do";
    EXPECT_EQ(textOf(path), fileOf({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    dict.set(blob("D"), blob("4"));
    dict.rm(blob("D"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), fileOf({{"C", "3"}, {"B", "2"}, {"A", "1"}}));
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(content(dict), (Pairs{{"A", "1"}, {"B", "2"}, {"C", "3"}}));
}

TEST_F(DictTest, keeps_the_last_value_of_a_key_at_its_first_place) {
    put(path,
        fileOf({{"A", "1"}, {"B", "2"}, {"A", "first"}, {"C", "3"}, {"B", "2"}, {"A", "last"}, {"", "x"}, {"", ""}}));
    BlobDict dict{Str(path)};
    EXPECT_EQ(content(dict), (Pairs{{"", ""}, {"C", "3"}, {"B", "2"}, {"A", "last"}}));
    EXPECT_FALSE(needsSaving(dict));
}

TEST_F(DictTest, loads_all_complete_records_of_a_cut_file) {
    std::string const whole = fileOf({{"A", "1"}, {"", ""}, {"BB", std::string(9, 'b')}, {"A", "2"}});
    for (std::size_t n = 0; n <= whole.size(); ++n) {
        SCOPED_TRACE(n);
        put(path, whole.substr(0, n));
        BlobDict dict{Str(path)};
        EXPECT_EQ(content(dict), plainReading(whole.substr(0, n)));
        EXPECT_TRUE(dict.read());
        expectFound(dict, whole.substr(0, n));
        EXPECT_FALSE(needsSaving(dict));
    }
}

TEST_F(DictTest, needs_saving_where_there_is_no_file) {
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

TEST_F(DictTest, replaces_its_entries_by_those_of_the_file) {
    put(path, fileOf({{"A", "1"}}));
    BlobDict dict;
    dict.set(blob("B"), blob("2"));
    dict.setPath(Str(path));
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(content(dict), (Pairs{{"A", "1"}}));
    EXPECT_FALSE(needsSaving(dict));
}

TEST_F(DictTest, fails_without_a_path_or_a_folder) {
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

TEST_F(DictTest, still_needs_saving_after_each_failure_to_write) {
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

TEST_F(DictTest, tells_what_it_found) {
    struct Case {
        Row row;
        std::string bytes;
        DictFile found;
        std::uint64_t understood;
    };
    for (Case const& c : {
             Case{{}, "", DICT_WHOLE, 0},
             Case{{}, fileOf({{"A", "1"}}), DICT_WHOLE, 10},
             Case{{}, fileOf({{"", ""}}), DICT_WHOLE, 8},
             Case{{}, fileOf({{"A", "1"}, {"A", "2"}}), DICT_WHOLE, 20},
             Case{{}, "x", DICT_PART, 0},
             Case{{}, std::string(3, '\0'), DICT_PART, 0},
             Case{{}, std::string(4, '\0'), DICT_PART, 0},
             Case{{}, std::string(12, '\0'), DICT_PART, 8},
             Case{{}, fileOf({{"A", "1"}}) + "x", DICT_PART, 10},
             Case{{}, fileOf({{"A", "1"}}) + length(0xFFFFFFFF), DICT_PART, 10},
             Case{{}, fileOf({{"A", "1"}}) + field("B") + length(2) + "1", DICT_PART, 10},
             Case{{}, "PK\x03\x04 is no dictionary, but much longer than the lengths in it\n", DICT_PART, 0},
         }) {
        SCOPED_TRACE(c.row);
        put(path, c.bytes);
        BlobDict dict{Str(path)};
        EXPECT_EQ(dict.found(), c.found);
        EXPECT_EQ(dict.understood(), c.understood);
        EXPECT_EQ(dict.size() != 0, c.understood != 0);
        EXPECT_FALSE(needsSaving(dict)) << "as ever";
        expectFound(dict, c.bytes);
    }
}

TEST_F(DictTest, tells_what_the_last_reading_found) {
    BlobDict dict;
    EXPECT_EQ(dict.found(), DICT_NOT_READ);
    EXPECT_EQ(dict.understood(), 0u);
    EXPECT_FALSE(dict.read());
    EXPECT_EQ(dict.found(), DICT_NOT_READ);
    put(path, fileOf({{"A", "1"}}) + "x");
    dict.setPath(Str(path));
    EXPECT_EQ(dict.found(), DICT_NOT_READ) << "another path is not read yet";
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(dict.found(), DICT_PART);
    dict.set(blob("B"), blob("2"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(dict.found(), DICT_PART) << "writing reads nothing";
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(dict.found(), DICT_WHOLE);
    EXPECT_EQ(dict.understood(), 20u);
    dict.clean();
    EXPECT_EQ(dict.understood(), 20u);
    dict.setPath(Str(scratch / "missing"));
    EXPECT_FALSE(dict.read());
    EXPECT_EQ(dict.found(), DICT_MISSING);
    EXPECT_EQ(dict.understood(), 0u);
    EXPECT_EQ(BlobDict(Str(scratch / "missing")).found(), DICT_MISSING);
}

TEST_F(DictTest, tells_a_file_that_could_not_be_opened_from_a_missing_one) {
    put(path, fileOf({{"A", "1"}}));
    BlobDict dict;
    dict.setPath(Str(path));
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(dict.read());
    EXPECT_EQ(dict.found(), DICT_NOT_READ);
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(dict.found(), DICT_WHOLE);
}

TEST_F(DictTest, tells_a_failure_to_read_from_the_end) {
    // Records that end where pieces do: what has come looks like a whole file.
    Pairs pairs;
    for (std::uint32_t i = 0; i < 12'288; ++i) pairs.emplace_back(length(i), "1234");
    std::string const whole = fileOf(pairs);
    ASSERT_EQ(whole.size(), 3u * 65'536);
    put(path, whole);
    for (std::uint32_t skip : {0u, 1u, 2u, 3u, 4u}) {
        SCOPED_TRACE(skip);
        xos_HostFail("xos_FileReadEx", skip, 1);
        BlobDict dict{Str(path)};
        xos_HostFailClear();
        EXPECT_EQ(dict.understood(), std::min(whole.size(), std::size_t{65'536} * skip));
        EXPECT_EQ(dict.size(), dict.understood() / 16);
        EXPECT_EQ(dict.found(), skip < 3 ? DICT_PART : DICT_WHOLE);
    }
}

TEST_F(DictTest, asks_the_platform_for_nothing_more_to_tell_it) {
    put(path, std::string(100'000, 'x'));
    xos_HostCallsReset();
    BlobDict const dict{Str(path)};
    EXPECT_EQ(dict.found(), DICT_PART);
    for (char const* function : {"xos_FileSeekEx", "xos_FileTellEx", "xos_FileStatByNameEx", "xos_FileGetsEx"}) {
        EXPECT_EQ(xos_HostCalls(function), 0u) << function;
    }
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_FileReadEx"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 1u);
}

TEST_F(DictTest, takes_a_failure_to_read_for_the_end) {
    std::string const large(200'000, 'L');
    put(path, fileOf({{"A", "1"}, {"B", large}, {"C", "3"}}));
    for (std::uint32_t skip = 0; skip < 3; ++skip) {
        xos_HostFail("xos_FileReadEx", skip, 1);
        BlobDict dict{Str(path)};
        xos_HostFailClear();
        EXPECT_EQ(content(dict), skip == 0 ? Pairs{} : (Pairs{{"A", "1"}})) << skip;
        EXPECT_FALSE(needsSaving(dict));
    }
}

TEST_F(DictTest, keeps_records_of_every_size) {
    Pairs pairs;
    for (std::size_t size : {0u, 1u, 7u, 65'523u, 65'524u, 65'525u, 65'536u, 65'537u, 131'072u, 500'000u, 3u}) {
        pairs.emplace_back(std::to_string(size) + std::string(size % 9, 'k'),
                           std::string(size, static_cast<char>(size)));
        pairs.emplace_back(std::string(size, 'K') + "!", "value");
    }
    BlobDict dict;
    dict.setPath(Str(path));
    for (Pair const& pair : pairs) dict.set(blob(pair.first), blob(pair.second));
    EXPECT_TRUE(dict.write());
    std::reverse(pairs.begin(), pairs.end());
    EXPECT_EQ(textOf(path), fileOf(pairs));
    BlobDict other{Str(path)};
    std::reverse(pairs.begin(), pairs.end());
    EXPECT_EQ(content(other), pairs);
}

TEST_F(DictTest, believes_no_length_before_the_bytes_have_come) {
    // Ten bytes that announce four gigabytes: what is read is what is there.
    struct Case {
        Row row;
        std::string bytes;
    };
    for (Case const& c : {
             Case{{}, length(0xFFFFFFFF) + "abcdef"},
             Case{{}, field("k") + length(0xFFFFFFFF) + "x"},
             Case{{}, field("k") + length(0x80000000)},
         }) {
        SCOPED_TRACE(c.row);
        put(path, fileOf({{"A", "1"}}) + c.bytes);
        auto const start = std::chrono::steady_clock::now();
        xos_HostCallsReset();
        BlobDict dict{Str(path)};
        EXPECT_EQ(content(dict), (Pairs{{"A", "1"}}));
        EXPECT_LE(xos_HostCalls("xos_FileReadEx"), 2u);
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(2));
        std::string const call = xos_HostLastCall("xos_FileReadEx");
        EXPECT_NE(call.find(", 65536, 0, 0"), std::string::npos) << call;
    }
}

TEST_F(DictTest, loads_many_keys_in_linear_time) {
    std::string bytes;
    constexpr std::uint32_t COUNT = 200'000;
    for (std::uint32_t i = 0; i < COUNT; ++i) bytes += field(length(i)) + field("v");
    put(path, bytes + bytes);
    auto const start = std::chrono::steady_clock::now();
    BlobDict dict{Str(path)};
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(20)) << "a search each takes minutes";
    EXPECT_EQ(dict.size(), COUNT);
    EXPECT_EQ(text(dict.last()->value.key), length(0));
    EXPECT_EQ(text(dict.first()->value.key), length(COUNT - 1));
}

TEST_F(DictTest, survives_damaged_files) {
    auto random = randomSource();
    std::string whole;
    for (int i = 0; i < 12; ++i)
        whole += field(std::string(random() % 9, 'k') + std::to_string(i)) + field(std::string(random() % 30, 'v'));
    std::uint64_t const steps = randomSteps(1'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        std::string bytes = whole;
        for (std::uint64_t n = 1 + random() % 4; n > 0; --n) {
            std::size_t const at = random() % bytes.size();
            switch (random() % 5) {
            case 0:
                bytes[at] = static_cast<char>(random());
                break;
            case 1:
                bytes[at] = static_cast<char>(bytes[at] ^ 1 << random() % 8);
                break;
            case 2:
                bytes.insert(at, 1 + random() % 5, static_cast<char>(random()));
                break;
            case 3:
                bytes.erase(at, random() % 6);
                break;
            default:
                bytes.resize(at + 1);
            }
            if (bytes.empty()) bytes = "x";
        }
        put(path, bytes);
        BlobDict dict{Str(path)};
        ASSERT_EQ(content(dict), plainReading(bytes)) << "step " << step;
        expectFound(dict, bytes);
    }
}

TEST_F(DictTest, behaves_as_a_plain_list_of_pairs) {
    auto random = randomSource();
    BlobDict dict;
    dict.setPath(Str(path));
    put(path, "");
    Pairs model;
    std::string file;
    bool modified = false;
    auto const find = [&](std::string const& key) {
        return std::find_if(model.begin(), model.end(), [&](Pair const& pair) { return pair.first == key; });
    };
    for (std::uint64_t step = randomSteps(6'000); step > 0; --step) {
        std::string const key(random() % 4, static_cast<char>('a' + random() % 4));
        std::string const value = std::to_string(random() % 3);
        auto const found = find(key);
        switch (random() % 16) {
        default:
            dict.set(blob(key), blob(value));
            modified = found == model.end() || found->second != value;
            if (found == model.end()) {
                model.insert(model.begin(), {key, value});
            } else {
                found->second = value;
            }
            break;
        case 0:
        case 1:
        case 2:
            dict.rm(blob(key));
            if (found != model.end()) {
                model.erase(found);
                modified = true;
            }
            break;
        case 3:
        case 4: {
            ASSERT_TRUE(dict.write());
            if (modified) file = fileOf(model);
            modified = false;
            ASSERT_EQ(textOf(path), file);
            break;
        }
        case 5:
            ASSERT_TRUE(dict.read());
            model = plainReading(file);
            modified = false;
            break;
        case 6:
            if (random() % 10 != 0) break;
            dict.clean();
            modified |= !model.empty();
            model.clear();
            break;
        case 7: {
            BlobDict other;
            for (char c : {'a', 'b', 'c'}) {
                for (std::size_t n = 0; n < 4; ++n) other.set(blob(std::string(n, c)), blob(""));
            }
            dict.intersect(other);
            model.erase(std::remove_if(model.begin(), model.end(),
                                       [](Pair const& pair) { return pair.first.find('d') != std::string::npos; }),
                        model.end());
            break;
        }
        }
        Blob out = blob("?");
        auto const now = find(key);
        ASSERT_EQ(dict.get(blob(key), out), now != model.end());
        ASSERT_EQ(text(out), now != model.end() ? now->second : "?");
        ASSERT_EQ(content(dict), model);
    }
}

TEST(DictEntry, breathes) {
    BlobEntry entry(blob("key"));
    EXPECT_TRUE(entry.eq(blob("key")));
    EXPECT_FALSE(entry.eq(blob("ke")));
    EXPECT_EQ(entry.value.size(), 0u);
    entry.set(blob("value"));
    entry.set(entry.value);
    EXPECT_EQ(text(entry.value), "value");
    BlobEntry const copy(entry);
    BlobEntry const moved(std::move(entry));
    EXPECT_EQ(text(copy.key), "key");
    EXPECT_EQ(text(moved.value), "value");
    BlobEntry assigned(blob("x"), blob("y"));
    assigned = copy;
    EXPECT_EQ(text(assigned.key), "key");
    assigned = BlobEntry(blob("1"), blob("2"));
    EXPECT_EQ(text(assigned.value), "2");
}

TEST(DictEntry, differs_by_key_or_value_and_is_ordered_by_key_alone) {
    BlobEntry const a1(blob("a"), blob("1"));
    BlobEntry const a2(blob("a"), blob("2"));
    BlobEntry const ab(blob("ab"), blob("0"));
    EXPECT_FALSE(a1 != BlobEntry(a1));
    EXPECT_TRUE(a1 != a2);
    EXPECT_TRUE(a1 != BlobEntry(blob("b"), blob("1")));
    EXPECT_FALSE(a1 < a2);
    EXPECT_FALSE(a2 < a1);
    EXPECT_TRUE(a2 < ab) << "the shorter key first";
    EXPECT_TRUE(BlobEntry(blob("\x7F")) < BlobEntry(blob("\x80")));
}

TEST(DictEntry, sorts_in_the_list_of_a_dictionary) {
    BlobDict dict;
    for (char const* key : {"b", "c", "a", "d"}) dict.set(blob(key), blob(key));
    dict.sort(true);
    EXPECT_EQ(content(dict), (Pairs{{"a", "a"}, {"b", "b"}, {"c", "c"}, {"d", "d"}}));
}
