// Paths beside plain texts, changed by random steps.

#include "tests/files/path_kinds.h"
#include "tests/support/operations.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::uint64_t LONGEST_PATH = 600;

bool isSlash(char c) { return c == '/' || c == '\\'; }

template <class Kind>
struct PathBesideModel {
    using Texts = PathOfKind<Kind>;

    typename Kind::Path path;
    std::string model;
    /// Drawn anew for every step.
    std::string piece;

    void add() {
        path.add(Texts::t(piece).c_str());
        if (piece.empty()) return;
        bool const ended = !model.empty() && (model.back() == '/' || (Kind::IS_WIDE && model.back() == '\\'));
        model += (model.empty() || ended ? "" : "/") + piece;
    }

    void assureTermSlash() {
        path.assureTermSlash();
        if (model.empty() || !isSlash(model.back())) model += '\\';
    }

    void remTermSlash() {
        path.remTermSlash();
        if (!model.empty() && isSlash(model.back())) model.pop_back();
    }

    void replaceBackSlashes() {
        path.replaceBackSlashes();
        std::replace(model.begin(), model.end(), '\\', '/');
    }

    void addExt() {
        auto const extension = Texts::t(piece);
        path.addExt(typename Kind::View(extension), true);
        bool const hasDot = (!model.empty() && model.back() == '.') || (!piece.empty() && piece[0] == '.');
        model += (hasDot ? "" : ".") + piece;
    }

    void clear() {
        path.clear();
        model.clear();
    }
};

template <class Kind, void (PathBesideModel<Kind>::*MEMBER)()>
void run(PathBesideModel<Kind>& both) {
    (both.*MEMBER)();
}

template <class Kind>
constexpr Operation<PathBesideModel<Kind>> PATH_OPERATIONS[] = {
    {"add", 50, run<Kind, &PathBesideModel<Kind>::add>},
    {"end in a slash", 50, run<Kind, &PathBesideModel<Kind>::assureTermSlash>},
    {"remove the slash at the end", 50, run<Kind, &PathBesideModel<Kind>::remTermSlash>},
    {"replace backslashes", 50, run<Kind, &PathBesideModel<Kind>::replaceBackSlashes>},
    {"add an extension", 50, run<Kind, &PathBesideModel<Kind>::addExt>},
    {"clear", 1, run<Kind, &PathBesideModel<Kind>::clear>},
};

template <class Kind>
class FPathModel : public testing::Test {};
TYPED_TEST_SUITE(FPathModel, PathKinds);

} // namespace

TYPED_TEST(FPathModel, survives_random_changes_beside_a_plain_text) {
    std::mt19937_64 random = randomSource();
    PathBesideModel<TypeParam> both;
    for (std::uint64_t step = randomSteps(50'000); step > 0; --step) {
        both.piece.clear();
        for (std::uint64_t n = random() % 12; n > 0; --n) both.piece.push_back("ab./\\%4"[random() % 7]);
        auto const& operation = drawn(PATH_OPERATIONS<TypeParam>, random);
        operation.act(both);
        ASSERT_EQ(PathOfKind<TypeParam>::plain(both.path), both.model) << operation.name;
        if (both.model.size() > LONGEST_PATH) both.clear();
    }
}
