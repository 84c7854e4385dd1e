/// \file
/// What the examples in the public headers take for granted: things of the program that uses the library. They are
/// declared only, as the examples are compiled and never run.

#ifndef TESTS_SUPPORT_EXAMPLE_CALLERS_H
#define TESTS_SUPPORT_EXAMPLE_CALLERS_H

#include "zor_basis/store/blob.h"
#include "zor_basis/sync/multi_task_queue.h"
#include "zor_basis/timers.h"

#include <atomic>
#include <cstdint>
#include <cstdio>
#include <map>
#include <memory>
#include <new>
#include <vector>

namespace callers {

struct Page {
    bool render();
};
struct Node {
    Node* next;
    int number;
};

extern Page cover;
extern char const *path, *folder, *name, *password, *data, *bytes;
extern std::uint64_t size, jobNumber;
extern int page, number, shared;
extern double seconds;
extern ZOR_Basis::Blob key, value, plain, encrypted;
extern ZOR_Basis::MultiTaskQueue* queue;
extern ZOR_Basis::PileTimer* pile;
extern ZOR_Basis::TimerMgr* manager;

std::uint64_t fill(char* buffer, std::uint64_t room);
void readName(char* buffer, std::uint64_t length);
template <class... Things>
bool report(Things const&... things);
template <class... Things>
void use(Things const&... things);
template <class... Things>
void render(Things const&... things);
template <class Thing>
void print(Thing const& thing);
template <class Thing>
void read(Thing const& thing);
template <class Thing>
void open(Thing const& thing);

} // namespace callers

#endif
