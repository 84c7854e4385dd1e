#include "tools/zbtool/tree_work.h"

#include "tools/zbtool/interruption.h"

#include <algorithm>

using namespace ZOR_Basis;

namespace zbtool {

unsigned TreeWork::severalWorkers() { return std::clamp(std::thread::hardware_concurrency(), 1u, 4u); }

bool TreeWork::run(FPath const& top) {
    waiting_.push_back(top);
    work();
    // No folder waits and none is being handled, so no thread starts another.
    for (std::thread& thread : threads_) thread.join();
    return !ended_;
}

void TreeWork::work() {
    std::unique_lock lock(mutex_);
    while (true) {
        changed_.wait(lock, [&] { return !waiting_.empty() || busy_ == 0; });
        if (waiting_.empty()) return;
        FPath const folder = waiting_.back();
        waiting_.pop_back();
        ++busy_;
        lock.unlock();
        Folders below;
        bool const good = !isInterrupted() && handle_(folder, below);
        lock.lock();
        --busy_;
        ended_ = ended_ || !good;
        if (ended_)
            waiting_.clear();
        else
            add(below);
        changed_.notify_all();
    }
}

void TreeWork::add(Folders& folders) {
    waiting_.insert(waiting_.end(), folders.rbegin(), folders.rend());
    // This thread takes one of them itself.
    while (threads_.size() + 1 < most_ && threads_.size() + 1 < waiting_.size())
        threads_.emplace_back([this] { work(); });
}

} // namespace zbtool
