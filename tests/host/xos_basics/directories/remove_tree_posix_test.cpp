// Removal while somebody exchanges directories for links that lead out of the tree.

#include "basis/platform/xos_basics.h"
#include "tests/support/memory_folder_posix.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <atomic>
#include <fcntl.h>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

namespace {

/// Makes directories and links without looking at what becomes of them.
class Swapper {
public:
    Swapper(std::string const& top, std::string const& outside)
        : thread_([this, top, outside] {
              unsigned round = 0;
              while (!stop_) {
                  std::string const victim = top + (++round % 3 == 0 ? "/a" : round % 3 == 1 ? "/a/b" : "/c");
                  std::string const aside = top + "-aside";
                  if (::rename(victim.c_str(), aside.c_str()) != 0) continue;
                  if (::symlink(outside.c_str(), victim.c_str()) == 0) {
                      ++swaps_;
                      std::this_thread::yield();
                      ::unlink(victim.c_str());
                  }
                  ::rename(aside.c_str(), victim.c_str());
                  xos_DirRemove(aside.c_str(), 0x600);
              }
          }) {}
    ~Swapper() { stop(); }

    unsigned stop() {
        stop_ = true;
        if (thread_.joinable()) thread_.join();
        return swaps_;
    }

private:
    std::atomic<bool> stop_{false};
    std::atomic<unsigned> swaps_{0};
    std::thread thread_;
};

void makeTree(std::string const& top) {
    for (char const* folder : {"", "/a", "/a/b", "/a/b/x", "/c", "/c/d"}) {
        ::mkdir((top + folder).c_str(), 0755);
        for (char const* file : {"/f", "/g"}) {
            ::close(::open((top + folder + file).c_str(), O_CREAT | O_WRONLY, 0644));
        }
    }
}

} // namespace

TEST(HostRemovalPosix, never_touches_anything_outside_whatever_is_exchanged) {
    // In memory, where the exchanges come thick and fast.
    Scratch const scratch{memoryFolder()};
    makeTree(scratch / "outside");
    for (char const* name : {"a", "a/b", "x", "d"}) { makeFolder(scratch / (std::string{"outside/"} + name)); }
    Names const before = scratch.content("outside");
    Swapper swapper{scratch / "top", scratch / "outside"};
    int removed = 0;
    int const rounds = static_cast<int>(randomSteps(4'000));
    for (int round = 0; round < rounds; ++round) {
        // Made under another name, as making it could follow the links.
        makeTree(scratch / "new");
        ::rename((scratch / "new").c_str(), (scratch / "top").c_str());
        removed += xos_DirRemove((scratch / "top").c_str(), 0x600) == 0 ? 1 : 0;
    }
    unsigned const swaps = swapper.stop();
    EXPECT_EQ(scratch.content("outside"), before);
    // There was something to fear, and still most removals came through.
    EXPECT_GT(swaps, 10U);
    EXPECT_GT(removed, rounds / 4);
    xos_DirRemove((scratch / "top").c_str(), 0x600);
    xos_DirRemove((scratch / "top-aside").c_str(), 0x600);
    EXPECT_EQ(scratch.content("outside"), before);
}
