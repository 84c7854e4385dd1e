// zbtool beside the system's own programs: whole processes over a tree of 20,000 files.

#include "bench/support/tree.h"

namespace {

std::string copyPath() { return workplace() / "copy"; }

void copyOurs(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        return run({ZBTOOL, "copy", from.c_str(), to.c_str()});
    });
}
void copyPeer(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        return run({"cp", "-r", from.c_str(), to.c_str()});
    });
}

template <class Remove>
void removeTree(benchmark::State& state, Remove remove) {
    auto const makeCopy = [] { run({"cp", "-r", sourceTree().c_str(), copyPath().c_str()}); };
    timed(state, makeCopy, remove, NOTHING);
}

void deleteOurs(benchmark::State& state) {
    removeTree(state, [] { return run({ZBTOOL, "delete", "--yes", copyPath().c_str()}); });
}
void deletePeer(benchmark::State& state) {
    removeTree(state, [] { return run({"rm", "-rf", copyPath().c_str()}); });
}

void sizeOurs(benchmark::State& state) {
    timed(
        state, NOTHING,
        [] {
            return run({ZBTOOL, "size", sourceTree().c_str()});
        },
        NOTHING);
}
void sizePeer(benchmark::State& state) {
    timed(
        state, NOTHING,
        [] {
            return run({"du", "-s", "--apparent-size", sourceTree().c_str()});
        },
        NOTHING);
}

} // namespace

BENCHMARK(copyOurs)->Name("copy/ours")->UseManualTime()->Iterations(1);
BENCHMARK(copyPeer)->Name("copy/cp")->UseManualTime()->Iterations(1);
BENCHMARK(deleteOurs)->Name("delete/ours")->UseManualTime()->Iterations(1);
BENCHMARK(deletePeer)->Name("delete/rm")->UseManualTime()->Iterations(1);
BENCHMARK(sizeOurs)->Name("size/ours")->UseManualTime();
BENCHMARK(sizePeer)->Name("size/du")->UseManualTime();
