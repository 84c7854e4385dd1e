// A tree is removed while its directories are exchanged, in one step each, for links that lead out of it.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"
#include "tests/support/scratch.h"

#include <zor_basis/files.h>

#include <atomic>
#include <fcntl.h>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

using namespace ZOR_Basis;

namespace stress {
namespace {

constexpr char const* const FOLDERS[] = {"", "/a", "/a/b", "/a/b/x", "/c", "/c/d"};

void makeTree(std::string const& top) {
    for (char const* const folder : FOLDERS) {
        ::mkdir((top + folder).c_str(), 0755);
        for (char const* const file : {"/f", "/g"}) {
            ::close(::open((top + folder + file).c_str(), O_CREAT | O_WRONLY, 0644));
        }
    }
}

/// Exchanges directories of the tree for links to the folder outside and back.
class Swapper {
public:
    Swapper(std::string const& top, std::string const& outside, std::string const& links)
        : thread_([this, top, outside, links] {
              for (char const* const name : {"/0", "/1", "/2"}) ::symlink(outside.c_str(), (links + name).c_str());
              constexpr char const* const VICTIMS[] = {"/a", "/a/b", "/c"};
              for (unsigned round = 0; !stop_; ++round) {
                  std::string const victim = top + VICTIMS[round % 3];
                  std::string const link = links + "/" + std::to_string(round % 3);
                  for (int i = 0; i < 2; ++i) {
                      if (::renameat2(AT_FDCWD, victim.c_str(), AT_FDCWD, link.c_str(), RENAME_EXCHANGE) == 0) ++swaps_;
                  }
                  restore(outside, link);
              }
          }) {}
    ~Swapper() { stop(); }

    void stop() {
        stop_ = true;
        if (thread_.joinable()) thread_.join();
    }
    std::uint64_t swaps() const { return swaps_; }

private:
    /// When the removal came between the two exchanges, the directory stays where the link was.
    static void restore(std::string const& outside, std::string const& link) {
        struct stat status {};
        if (::lstat(link.c_str(), &status) == 0 && S_ISLNK(status.st_mode)) return;
        if (S_ISDIR(status.st_mode)) Dir::Rem(link.c_str(), true, false);
        ::symlink(outside.c_str(), link.c_str());
    }

    std::atomic<bool> stop_{false};
    std::atomic<std::uint64_t> swaps_{0};
    std::thread thread_;
};

} // namespace

void swapLinks(std::uint64_t swaps, Findings& findings) {
    Scratch const scratch(stressFolder());
    makeTree(scratch / "outside");
    makeFolder(scratch / "links");
    Names const before = scratch.content("outside");
    Swapper swapper(scratch / "top", scratch / "outside", scratch / "links");
    std::uint64_t rounds = 0;
    std::uint64_t removed = 0;
    for (; swapper.swaps() < swaps; ++rounds) {
        // Made under another name, as making it could follow the links.
        makeTree(scratch / "new");
        ::rename((scratch / "new").c_str(), (scratch / "top").c_str());
        removed += Dir::Rem((scratch / "top").c_str(), true, false) ? 1 : 0;
        if (rounds % 1000 == 0) findings.expect(scratch.content("outside") == before, "something outside is gone");
    }
    swapper.stop();
    findings.expect(scratch.content("outside") == before, "something outside is gone");
    findings.expect(removed > 0, "no tree was removed");
    findings.note(std::to_string(swapper.swaps()) + " exchanges, " + std::to_string(rounds) + " trees, " +
                  std::to_string(removed) + " removed at the first attempt");
}

} // namespace stress
