#include "basis/files/last_error.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cerrno>

using namespace ZOR_Basis;

TEST(LastErrorPosix, has_one_code_for_each_reason) {
    struct Case {
        Row row;
        Reason reason;
        int code;
    };
    for (Case const& c : {
             Case{{}, Reason::ALREADY_THERE, EEXIST},
             Case{{}, Reason::IS_DIRECTORY, EISDIR},
             Case{{}, Reason::NOT_DIRECTORY, ENOTDIR},
             Case{{}, Reason::NOT_FOUND, ENOENT},
             Case{{}, Reason::BAD_ARGUMENT, EINVAL},
             Case{{}, Reason::NOT_OPEN, EBADF},
             Case{{}, Reason::NO_MEMORY, ENOMEM},
             Case{{}, Reason::NO_PROCESS, ESRCH},
             Case{{}, Reason::NOT_SUPPORTED, ENOTSUP},
             Case{{}, Reason::LOGON_REFUSED, EKEYREJECTED},
             Case{{}, static_cast<Reason>(1000), EIO},
         }) {
        SCOPED_TRACE(c.row);
        errno = 0;
        EXPECT_FALSE(refuse(c.reason));
        EXPECT_EQ(errno, c.code);
    }
}

TEST(LastErrorPosix, is_kept_while_others_set_it) {
    errno = ENOSPC;
    {
        KeepLastError const keep;
        refuse(Reason::NOT_FOUND);
    }
    EXPECT_EQ(errno, ENOSPC);
    LastError const kept;
    errno = 0;
    kept.restore();
    EXPECT_EQ(errno, ENOSPC);
}
