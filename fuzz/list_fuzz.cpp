// Any bytes as operations on a list, after each of which it contains what a plain vector contains.

#include "fuzz/target.h"
#include "tests/containers/sng_list_steps.h"

namespace {

void runList(unsigned char const* data, std::size_t size) {
    {
        sng_list::ListBesideVector<RandomBytes> both(RandomBytes(data, size));
        while (!both.random.isUsedUp()) {
            drawn(sng_list::OPERATIONS<decltype(both)>, both.random).act(both);
            require(both.agree());
        }
    }
    require(Item::living == 0);
}

FuzzTarget const LIST("list", runList);

} // namespace
