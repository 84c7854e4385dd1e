/// \file
/// Fetches URLs into files of a scratch folder.

#ifndef TESTS_HOST_XOS_URL_FETCHED_FILES_H
#define TESTS_HOST_XOS_URL_FETCHED_FILES_H

#include "basis/platform/xos_url.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <string>

inline int get(std::string const& url, std::string const& target, char const* user = nullptr,
               char const* password = nullptr) {
    return xos_URLGet(url.c_str(), target.c_str(), user, password);
}

class FetchedFiles : public testing::Test {
protected:
    FetchedFiles() {
        for (char const* const proxy : {"http_proxy", "HTTP_PROXY", "all_proxy", "ALL_PROXY"}) {
            setVariable(proxy, "");
        }
    }

    /// The failure left what was there and nothing else.
    void expectFailure(std::string const& url, char const* user = nullptr, char const* password = nullptr) const {
        put(scratch / "target", "as before");
        EXPECT_NE(get(url, scratch / "target", user, password), 0);
        EXPECT_EQ(textOf(scratch / "target"), "as before");
        EXPECT_NE(get(url, scratch / "new", user, password), 0);
        EXPECT_EQ(scratch.content(), Names{"target"});
    }

    Scratch scratch;
};

#endif
