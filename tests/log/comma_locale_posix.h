/// \file
/// A locale whose decimal point is a comma, compiled for the test and current during the object's lifetime.

#ifndef TESTS_LOG_COMMA_LOCALE_POSIX_H
#define TESTS_LOG_COMMA_LOCALE_POSIX_H

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

class CommaLocale {
public:
    CommaLocale() {
        ::setenv("LOCPATH", madeOnce().path().c_str(), 1);
        EXPECT_NE(std::setlocale(LC_NUMERIC, "zb_comma"), nullptr);
    }
    CommaLocale(CommaLocale const&) = delete;
    CommaLocale& operator=(CommaLocale const&) = delete;
    ~CommaLocale() {
        std::setlocale(LC_NUMERIC, "C");
        ::unsetenv("LOCPATH");
    }

private:
    static Scratch const& madeOnce() {
        static Scratch const scratch;
        static std::string const make = "localedef -f UTF-8 -i de_DE " + scratch / "zb_comma" + " 2>/dev/null";
        static int const result = std::system(make.c_str());
        EXPECT_EQ(result, 0) << "the package `locales` has the sources";
        return scratch;
    }
};

#endif
