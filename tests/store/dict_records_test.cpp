// What the file of a dictionary holds, and how far it is understood.

#include "tests/store/stored_dict.h"
#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct DictRecordsOfAFile : StoredDict {};

} // namespace

TEST_F(DictRecordsOfAFile, loads_all_complete_records_of_a_cut_file) {
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

TEST_F(DictRecordsOfAFile, tells_what_it_found) {
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

TEST_F(DictRecordsOfAFile, tells_what_the_last_reading_found) {
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

TEST_F(DictRecordsOfAFile, tells_a_file_that_could_not_be_opened_from_a_missing_one) {
    put(path, fileOf({{"A", "1"}}));
    BlobDict dict;
    dict.setPath(Str(path));
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(dict.read());
    EXPECT_EQ(dict.found(), DICT_NOT_READ);
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(dict.found(), DICT_WHOLE);
}

TEST_F(DictRecordsOfAFile, tells_a_failure_to_read_from_the_end) {
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

TEST_F(DictRecordsOfAFile, asks_the_platform_for_nothing_more_to_tell_it) {
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

TEST_F(DictRecordsOfAFile, takes_a_failure_to_read_for_the_end) {
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

TEST_F(DictRecordsOfAFile, keeps_records_of_every_size) {
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

TEST_F(DictRecordsOfAFile, believes_no_length_before_the_bytes_have_come) {
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

TEST_F(DictRecordsOfAFile, survives_damaged_files) {
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
