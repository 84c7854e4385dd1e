#include "tests/support/scratch_root.h"

#include <xos_host.h>

#include <gtest/gtest.h>

#include <random>
#include <string>

namespace fs = std::filesystem;

namespace {

class ScratchRoot : public testing::Environment {
public:
    void SetUp() override {
        fs::create_directories(scratchRoot());
        xos_HostSetRoot(scratchRoot().generic_string().c_str());
    }
    void TearDown() override {
        std::error_code ignored;
        fs::remove_all(scratchRoot(), ignored);
    }
};

testing::Environment* const environment = testing::AddGlobalTestEnvironment(new ScratchRoot);

} // namespace

fs::path const& scratchRoot() {
    static fs::path const root =
        fs::canonical(fs::temp_directory_path()) / ("zb_tests_" + std::to_string(std::random_device()()));
    return root;
}
