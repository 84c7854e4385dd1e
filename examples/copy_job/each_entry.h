/// \file
/// A visitor made of a function.

#ifndef EXAMPLES_COPY_JOB_EACH_ENTRY_H
#define EXAMPLES_COPY_JOB_EACH_ENTRY_H

#include "examples/copy_job/choices.h"

#include <zor_basis/walk.h>

#include <utility>

/// Calls `bool handle(ZOR_Basis::FileEntry&)` for every entry of a walk.
template <class Handle>
class EachEntry : public ZOR_Basis::FileVisitor {
public:
    explicit EachEntry(Handle handle) : handle_(std::move(handle)) {}
    bool perform(ZOR_Basis::FileEntry* entry) override { return handle_(*entry); }

private:
    Handle handle_;
};

/// Walks one folder, not its sub-folders, up to the first entry whose handling fails.
/// \return whether none did
template <class Handle>
bool forEachEntry(ZOR_Basis::FPath const& folder, ZOR_Basis::LookForType type, Handle handle) {
    EachEntry<Handle> visitor(std::move(handle));
    return ZOR_Basis::FileIterator(folder, type, nullptr, nullptr).doIt(&visitor, ONE_LEVEL, STOPPING_ON_FAILURE);
}

#endif
