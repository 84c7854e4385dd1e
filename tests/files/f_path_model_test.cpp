// Paths beside plain texts, changed by random steps.

#include "tests/files/path_kinds.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

template <class Kind>
class FPathModel : public PathOfKind<Kind> {};
TYPED_TEST_SUITE(FPathModel, PathKinds);

} // namespace

TYPED_TEST(FPathModel, survives_random_changes_beside_a_plain_text) {
    std::mt19937_64 random = randomSource();
    typename TypeParam::Path path;
    std::string model;
    for (std::uint64_t step = randomSteps(50'000); step > 0; --step) {
        std::string piece;
        for (std::uint64_t n = random() % 12; n > 0; --n) piece.push_back("ab./\\%4"[random() % 7]);
        switch (random() % 6) {
        case 0:
            path.add(this->t(piece).c_str());
            if (!piece.empty()) {
                bool const ended =
                    !model.empty() && (model.back() == '/' || (TypeParam::IS_WIDE && model.back() == '\\'));
                model += (model.empty() || ended ? "" : "/") + piece;
            }
            break;
        case 1:
            path.assureTermSlash();
            if (model.empty() || (model.back() != '/' && model.back() != '\\')) model += '\\';
            break;
        case 2:
            path.remTermSlash();
            if (!model.empty() && (model.back() == '/' || model.back() == '\\')) model.pop_back();
            break;
        case 3:
            path.replaceBackSlashes();
            for (char& c : model) c = c == '\\' ? '/' : c;
            break;
        case 4: {
            auto const extension = this->t(piece);
            path.addExt(typename TypeParam::View(extension), true);
            if ((model.empty() || model.back() != '.') && (piece.empty() || piece[0] != '.')) model += '.';
            model += piece;
            break;
        }
        default:
            if (model.size() > 600 || random() % 50 == 0) {
                path.clear();
                model.clear();
            }
        }
        ASSERT_EQ(this->plain(path), model);
    }
}
