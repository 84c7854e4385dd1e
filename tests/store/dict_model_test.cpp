// A dictionary beside a plain list of pairs, changed by random steps.

#include "tests/store/stored_dict.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

using namespace ZOR_Basis;

namespace {

/// The dictionary, the pairs that it should hold, and the bytes that its file should have.
struct DictModel : StoredDict {
    using Random = std::mt19937_64;

    struct Step {
        char const* name;
        unsigned of16; ///< how many of 16 steps are of this kind
        void (DictModel::*take)(std::string const& key, std::string const& value);
    };
    static Step const STEPS[];

    DictModel() {
        dict.setPath(Str(path));
        put(path, "");
    }

    Pairs::iterator find(std::string const& key) {
        return std::find_if(model.begin(), model.end(), [&](Pair const& pair) { return pair.first == key; });
    }

    Step const& randomStep() {
        auto number = static_cast<unsigned>(random() % 16);
        Step const* step = STEPS;
        for (; number >= step->of16; ++step) number -= step->of16;
        return *step;
    }

    void set(std::string const& key, std::string const& value) {
        auto const found = find(key);
        dict.set(blob(key), blob(value));
        modified = found == model.end() || found->second != value;
        if (found == model.end()) {
            model.insert(model.begin(), {key, value});
        } else {
            found->second = value;
        }
    }

    void remove(std::string const& key, std::string const& /*value*/) {
        dict.rm(blob(key));
        auto const found = find(key);
        if (found == model.end()) return;
        model.erase(found);
        modified = true;
    }

    void write(std::string const& /*key*/, std::string const& /*value*/) {
        ASSERT_TRUE(dict.write());
        if (modified) file = fileOf(model);
        modified = false;
        ASSERT_EQ(textOf(path), file);
    }

    void read(std::string const& /*key*/, std::string const& /*value*/) {
        ASSERT_TRUE(dict.read());
        model = plainReading(file);
        modified = false;
    }

    void clean(std::string const& /*key*/, std::string const& /*value*/) {
        if (random() % 10 != 0) return;
        dict.clean();
        modified |= !model.empty();
        model.clear();
    }

    void intersect(std::string const& /*key*/, std::string const& /*value*/) {
        BlobDict other;
        for (unsigned i = 0; i < KEYS; ++i) {
            if (i % 4 != 0) other.set(blob(keyOf(i)), blob(""));
        }
        dict.intersect(other);
        auto const isOther = [&](Pair const& pair) { return std::stoul("0" + pair.first) % 4 == 0; };
        model.erase(std::remove_if(model.begin(), model.end(), isOther), model.end());
    }

    void expectSame(std::string const& key) {
        Blob out = blob("?");
        auto const now = find(key);
        ASSERT_EQ(dict.get(blob(key), out), now != model.end());
        ASSERT_EQ(text(out), now != model.end() ? now->second : "?");
        ASSERT_EQ(dict.size(), model.size());
        // Whoever looks at the list makes the dictionary search it from then on, until it has been empty.
        if (random() % 50 != 0) return;
        ASSERT_EQ(content(dict), model);
    }

    /// Decimal numbers, of which 0 is the empty key.
    static std::string keyOf(std::uint64_t i) { return i != 0 ? std::to_string(i) : ""; }
    static constexpr unsigned KEYS = 100;

    Random random = randomSource();
    BlobDict dict;
    Pairs model;
    std::string file;
    bool modified = false;
};

DictModel::Step const DictModel::STEPS[] = {
    {"remove a key", 3, &DictModel::remove}, {"write the file", 2, &DictModel::write},
    {"read the file", 1, &DictModel::read},  {"remove all keys", 1, &DictModel::clean},
    {"intersect", 1, &DictModel::intersect}, {"store a value", 8, &DictModel::set},
};

} // namespace

TEST_F(DictModel, behaves_as_a_plain_list_of_pairs) {
    for (std::uint64_t left = randomSteps(6'000); left > 0 && !HasFatalFailure(); --left) {
        std::string const key = keyOf(random() % KEYS);
        std::string const value = std::to_string(random() % 3);
        Step const& step = randomStep();
        SCOPED_TRACE(step.name);
        (this->*step.take)(key, value);
        expectSame(key);
        for (int i = 0; i < 3; ++i) expectSame(keyOf(random() % KEYS));
    }
}
