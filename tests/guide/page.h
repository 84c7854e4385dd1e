/// \file
/// Where a page of the guide runs: all pages share one root folder, and what a page prints is kept.

#ifndef TESTS_GUIDE_PAGE_H
#define TESTS_GUIDE_PAGE_H

#include "tests/support/scratch_root.h"

#include <gtest/gtest.h>

#include <iostream>
#include <string>
#include <xos_host.h>

class Page {
public:
    Page() {
        xos_HostSetRoot(scratchRoot().generic_string().c_str());
        testing::internal::CaptureStdout();
    }
    std::string printed() const {
        std::cout.flush();
        return testing::internal::GetCapturedStdout();
    }
};

#endif
