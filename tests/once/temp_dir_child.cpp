// temp_dir_child STEP...: folders for jobs from the very first one, each case in a process of its own.
//   init=N           VDPTempDir::Init(N)
//   root             prints VDPTempDir::Root()
//   make             makes one that deletes and lives to the end: prints its path
//   keep             makes one that does not delete
//   create           VDPTempDir::Create: prints the path
//   drop             destroys the last one that was made
//   deletes=0|1      deleteOnDestroy of the last one
//   copy             makes a copy of the last one
//   assign           makes another and assigns the last one to it: prints the path that it had before
//   status           prints the status of the last one
//   put=NAME         puts a file into the last one's folder
//   replace          puts a file in place of the last one's folder
//   calls=FUNCTION   prints how often this function of the platform layer was called
//   last=FUNCTION    prints the arguments of its last call
//   fail=FUNCTION    lets its next call fail
//   touch=FILE       makes an empty file
//   wait=FILE        waits until there is such a file, 30 s at most
//   background       another thread makes one with Create
//   tried=COUNT      waits until that thread has tried so many more names
//   join             waits for that thread: prints its path
//   remove=FILE      removes a file
//   unblock=FILE     removes that file as soon as a hundred names have been tried in vain
//   threads=COUNT    each thread makes 25 folders, puts a file into each and keeps half of them until all threads are
//                    done: prints the paths

#include <zor_basis/system/vdp_temp_dir.h>

#include "tests/support/wait_for.h"

#include <xos_host.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <list>
#include <string>
#include <thread>
#include <vector>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

constexpr int EACH = 25;

std::list<VDPTempDir> folders;
std::thread helper;
FPath madeByHelper;

void print(char const* text) { std::printf("%s\n", text != nullptr ? text : "none"); }

void endUnless(bool done) {
    if (!done) std::_Exit(2);
}

void assign() {
    VDPTempDir other(false);
    FPath const before = other.path();
    other = folders.back();
    other.deleteOnDestroy(false);
    print(other.path() == folders.back().path() ? before.c_str() : "another path");
}

/// Each attempt asks the platform layer for the status of the new name.
bool awaitAttempts(std::uint64_t count) {
    return waitFor([count] { return xos_HostCalls("xos_FileStatByNameEx") >= count; });
}

void unblock(std::string const& path) {
    helper = std::thread([path] {
        if (!awaitAttempts(100)) std::abort();
        fs::remove(path);
    });
}

void joinHelper() {
    helper.join();
    print(madeByHelper.c_str());
}

void makeMany(std::vector<VDPTempDir>& kept, std::string& paths) {
    kept.reserve(EACH);
    for (int i = 0; i < EACH; ++i) {
        VDPTempDir folder;
        fs::path const file = fs::path(folder.path().c_str()) / "file";
        if (!fs::is_directory(folder.path().c_str()) || fs::exists(file)) std::abort();
        std::ofstream(file) << i;
        paths += std::string(folder.path().c_str()) + "\n";
        if (i % 2 != 0) continue;
        kept.push_back(folder);
        folder.deleteOnDestroy(false);
    }
}

void race(int count) {
    std::vector<std::vector<VDPTempDir>> kept(static_cast<std::size_t>(count));
    std::vector<std::string> paths(kept.size());
    std::vector<std::thread> threads;
    for (std::size_t i = 0; i < kept.size(); ++i) {
        threads.emplace_back([&kept, &paths, i] { makeMany(kept[i], paths[i]); });
    }
    for (std::thread& thread : threads) thread.join();
    for (std::string const& lines : paths) std::fputs(lines.c_str(), stdout);
}

void make(bool deletesOnDestroy) {
    folders.emplace_back(deletesOnDestroy);
    print(folders.back().path().c_str());
}

void create() {
    FPath path("before");
    VDPTempDir::Create(path);
    print(path.c_str());
}

void put(std::string const& name) { std::ofstream((folders.back().path().c_str() + ("/" + name)).c_str()) << "text"; }

void replaceByFile() {
    fs::remove_all(folders.back().path().c_str());
    std::ofstream(folders.back().path().c_str()) << "text";
}

/// What can be asked for on the command line, as "NAME" or "NAME=VALUE".
struct Step {
    char const* name;
    void (*perform)(std::string const& value);
};

constexpr Step STEPS[] = {
    {"init", [](std::string const& value) { VDPTempDir::Init(std::atoi(value.c_str())); }},
    {"root", [](std::string const&) { print(VDPTempDir::Root().c_str()); }},
    {"make", [](std::string const&) { make(true); }},
    {"keep", [](std::string const&) { make(false); }},
    {"create", [](std::string const&) { create(); }},
    {"drop", [](std::string const&) { folders.pop_back(); }},
    {"deletes", [](std::string const& value) { folders.back().deleteOnDestroy(value == "1"); }},
    {"copy", [](std::string const&) { folders.emplace_back(folders.back()); }},
    {"assign", [](std::string const&) { assign(); }},
    {"status", [](std::string const&) { print(folders.back().status() ? "there" : "gone"); }},
    {"put", put},
    {"replace", [](std::string const&) { replaceByFile(); }},
    {"calls", [](std::string const& value) { print(std::to_string(xos_HostCalls(value.c_str())).c_str()); }},
    {"last", [](std::string const& value) { print(xos_HostLastCall(value.c_str())); }},
    {"fail", [](std::string const& value) { xos_HostFail(value.c_str(), 0, 1); }},
    {"touch", [](std::string const& value) { std::ofstream(value.c_str()).flush(); }},
    {"wait", [](std::string const& value) { endUnless(waitFor([&value] { return fs::exists(value); })); }},
    {"background", [](std::string const&) { helper = std::thread([] { VDPTempDir::Create(madeByHelper); }); }},
    {"tried",
     [](std::string const& value) {
         endUnless(awaitAttempts(xos_HostCalls("xos_FileStatByNameEx") + std::stoul(value)));
     }},
    {"join", [](std::string const&) { joinHelper(); }},
    {"remove", [](std::string const& value) { fs::remove(value); }},
    {"unblock", unblock},
    {"threads", [](std::string const& value) { race(std::atoi(value.c_str())); }},
};

bool perform(std::string const& name, std::string const& value) {
    for (Step const& step : STEPS) {
        if (name != step.name) continue;
        step.perform(value);
        return true;
    }
    return false;
}

} // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        std::string const step = argv[i];
        std::size_t const equals = std::min(step.find('='), step.size());
        std::string const value = equals < step.size() ? step.substr(equals + 1) : "";
        if (!perform(step.substr(0, equals), value)) return 2;
    }
    if (helper.joinable()) helper.join();
    folders.clear();
    return 0;
}
