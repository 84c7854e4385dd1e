// stress_loader MODULE CYCLES REPORT: loads a module that uses the library, has it do so, and unloads both, again and
// again. Nothing else here needs the library. Writes what the process has after a tenth of the cycles, and at the end.

#include "tests/once/loaded_module.h"
#include "tests/stress/places.h"
#include "tests/stress/stress_module.h"
#include "tests/support/scratch.h"

#include <xos_host.h>

#include <cstdlib>

namespace {

/// \return 0, or which step failed
int cycle(char const* path) {
    void* const module = loadModule(path);
    if (module == nullptr) return 3;
    auto* const use = reinterpret_cast<UseLibrary>(addressIn(module, "useLibrary"));
    if (use == nullptr) return 4;
    if (use() != 1) return 5;
    return unloadModule(module) ? 0 : 6;
}

std::string line(stress::Holdings const& held) { return stress::countsOf(held) + "\n"; }

} // namespace

int main(int argc, char** argv) {
    if (argc != 4) return 2;
    unsigned long const cycles = std::strtoul(argv[2], nullptr, 10);
    std::string report;
    for (unsigned long i = 0; i < cycles; ++i) {
        int const failed = cycle(argv[1]);
        if (failed != 0) return failed;
        if (i == cycles / 10) report = line(stress::holdings());
    }
    put(argv[3], report + line(stress::holdings()));
    return 0;
}
