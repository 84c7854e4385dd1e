#include "examples/copy_job/scratch_root.h"

#include "examples/copy_job/choices.h"

#include <xos_host.h>

#include <filesystem>
#include <random>

using namespace ZOR_Basis;

namespace {

FPath freshPath() {
    std::string const name = "copy_job-" + std::to_string(std::random_device()());
    return FPath((std::filesystem::temp_directory_path() / name).generic_string().c_str());
}

} // namespace

ScratchRoot::ScratchRoot() : path_(freshPath()), made_(Dir::New(path_, WITHOUT_PARENTS)) {
    xos_HostSetRoot(path_.c_str());
}

ScratchRoot::~ScratchRoot() {
    if (made_) Dir::Rem(path_, WITH_CONTENTS, WITHOUT_SECOND_FLAG);
}
