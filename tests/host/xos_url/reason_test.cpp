#include "host/xos_url/reason.h"

#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <set>

namespace {

using host::Reason;

int codeAfter(Reason reason) {
    clearSystemError();
    EXPECT_FALSE(host::failFor(reason));
    return systemError();
}

TEST(HostReason, of_an_answers_status_is_forbidden_missing_or_bad) {
    struct Case {
        Row row;
        long status;
        Reason expected;
    };
    for (Case const& c : {
             Case{{}, 401, Reason::FORBIDDEN},
             Case{{}, 403, Reason::FORBIDDEN},
             Case{{}, 407, Reason::FORBIDDEN},
             Case{{}, 404, Reason::NOT_FOUND},
             Case{{}, 410, Reason::NOT_FOUND},
             Case{{}, 400, Reason::BAD_ANSWER},
             Case{{}, 500, Reason::BAD_ANSWER},
             Case{{}, 204, Reason::BAD_ANSWER},
             Case{{}, 0, Reason::BAD_ANSWER},
         }) {
        SCOPED_TRACE(c.row);
        clearSystemError();
        EXPECT_FALSE(host::failForStatus(c.status));
        int const code = systemError();
        EXPECT_EQ(code, codeAfter(c.expected));
    }
}

TEST(HostReason, has_a_code_of_its_own_but_for_a_folder) {
    std::set<int> codes;
    for (Reason const reason : {Reason::BAD_ARGUMENT, Reason::UNKNOWN_SCHEME, Reason::NOT_FOUND, Reason::FORBIDDEN,
                                Reason::TOO_MANY_STEPS, Reason::BAD_ANSWER, Reason::NO_MEMORY}) {
        EXPECT_NE(codeAfter(reason), 0);
        codes.insert(codeAfter(reason));
    }
    EXPECT_EQ(codes.size(), 7u);
    EXPECT_NE(codeAfter(Reason::DIRECTORY), 0);
}

TEST(HostReason, is_kept_while_something_is_cleared_away) {
    int const code = codeAfter(Reason::NOT_FOUND);
    {
        host::KeepReason const keep;
        clearSystemError();
    }
    EXPECT_EQ(systemError(), code);
}

} // namespace
