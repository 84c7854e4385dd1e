// Reasons that take another user, a full disk or a second file system, and those of logging on by PAM.

#include "tests/system/reasons_test.h"

#include <zor_basis/files.h>
#include <zor_basis/store/dict.h>
#include <zor_basis/system.h>
#include <zor_basis/walk.h>

#include "tests/support/http_server.h"
#include "tests/support/skip.h"
#include "tests/system/query_calls_test_posix.h"

#include <sys/fsuid.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

#include <memory>

using namespace ZOR_Basis;

namespace {

constexpr bool RECURSIVE = true;

/// Access to files as nobody's, on the calling thread alone.
class AsNobody {
public:
    AsNobody() : own_(setfsuid(NOBODY)) {}
    ~AsNobody() { setfsuid(static_cast<uid_t>(own_)); }
    AsNobody(AsNobody const&) = delete;
    AsNobody& operator=(AsNobody const&) = delete;

private:
    static constexpr uid_t NOBODY = 65534;
    int const own_;
};

/// The same call by somebody who may not. What that leaves is not disturbed by becoming oneself again.
std::function<bool(Place const&)> asNobody(std::function<bool(Place const&)> call) {
    return [=](Place const& in) {
        ::chmod(in.at("full").c_str(), 0700);
        bool succeeded = false;
        int error = 0;
        {
            AsNobody const nobody;
            clearSystemError();
            succeeded = call(in);
            error = errno;
        }
        errno = error;
        return succeeded;
    };
}

/// A file system of 64 KiB, where mounting is permitted.
class SmallDisk {
public:
    explicit SmallDisk(std::string const& path) : path_(path) {
        isMounted_ = ::mount("tmpfs", path_.c_str(), "tmpfs", 0, "size=64k") == 0;
    }
    ~SmallDisk() {
        if (isMounted_) ::umount2(path_.c_str(), MNT_DETACH);
    }
    SmallDisk(SmallDisk const&) = delete;
    SmallDisk& operator=(SmallDisk const&) = delete;
    bool isMounted() const { return isMounted_; }

private:
    std::string path_;
    bool isMounted_;
};

bool isPrivileged() { return ::geteuid() == 0; }

bool saves(std::string const& path) {
    Dict<Blob, Blob> dict;
    dict.setPath(path);
    dict.set(Blob(3, "key"), Blob(5, "value"));
    return dict.write();
}

} // namespace

TEST(ReasonsPosix, of_those_who_may_not) {
    if (!isPrivileged()) CASE_CANNOT_HOLD("only root becomes another user");
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))}}};
    using In = Place const&;
    expectReasons({
        Failure{{}, EACCES, 0, asNobody([](In in) { return File::New(in.at("new").c_str(), false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return File::New(in.at("a/new").c_str(), true); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return File::New(in.at("full/file").c_str(), false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return File::Rem(in.at("file").c_str(), true, false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return File::Copy(in.at("new").c_str(), in.at("file").c_str(), true, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return File::Copy(in.at("new").c_str(), in.at("full/file").c_str(), true, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return File::Move(in.at("new").c_str(), in.at("file").c_str(), true, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return File::LinkOrCopy(in.at("other").c_str(), in.at("file").c_str(), true, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return File(in.at("file").c_str(), File::FILE_WRITE).isOpen(); })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return File(in.at("file").c_str(), File::FILE_WRITE | File::FILE_CRT, true).isOpen();
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return Dir::New(in.at("new").c_str(), false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return Dir::NewFor(in.at("a/b/c").c_str()); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return Dir::Rem(in.at("full").c_str(), RECURSIVE, false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return Dir::Rem(in.at("empty").c_str(), false, false); })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return Dir::Copy(in.at("new").c_str(), in.at("full").c_str(), true, false, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return Dir::Move(in.at("new").c_str(), in.at("empty").c_str(), false, false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return Dir::Exist(in.at("full/file").c_str()); })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return FStat(in.at("full/file").c_str(), false).exist(); })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    return FileIterator(in.at("full"), LOOK_ALL, nullptr, nullptr).start(false);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) {
                    FileDeleteVisitor remove;
                    return FileIterator(in.scratch.path(), LOOK_FILES, nullptr, nullptr).doIt(&remove, false, true);
                })},
        Failure{{}, EACCES, 0, asNobody([](In in) { return saves(in.at("new")); })},
        Failure{{}, EACCES, 0, asNobody([&](In in) {
                    return Url::Get(in.at("new").c_str(), server.url("/page").c_str(), nullptr, nullptr, false, false);
                })},
        Failure{{}, EACCES, 0, [](In in) { return Process::Create(in.at("file").c_str(), nullptr, nullptr, nullptr); }},
    });
}

TEST(ReasonsPosix, of_a_full_device) {
    std::string const text(1 << 20, 'x');
    expectReasons({
        Failure{{}, ENOSPC, 0, [&](auto&) { return File("/dev/full", File::FILE_WRITE)->write("x", 1) == 1; }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto&) { return File("/dev/full", File::FILE_WRITE | File::FILE_CRT)->write("x", 1) == 1; }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto&) {
                    File const file("/dev/full", File::FILE_WRITE | File::FILE_CRT, true);
                    return file->write(text.data(), text.size()) == text.size();
                }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto&) {
                    File const file("/dev/full", File::FILE_WRITE | File::FILE_CRT, true);
                    return file->write("x", 1) == 1 && file->flush();
                }},
        Failure{{}, ENOSPC, 0, [](auto&) { return saves("/dev/full"); }},
        // Closing fails, too.
        Failure{{}, ENOSPC, 0, [](auto&) { return saves("/dev/full"); }, "xos_FileCloseEx"},
        Failure{{},
                ENOSPC,
                0,
                [](auto&) { return File("/dev/full", File::FILE_WRITE)->write("x", 1) == 1; },
                "xos_FileCloseEx"},
    });
}

TEST(ReasonsPosix, of_a_disk_that_becomes_full) {
    Scratch const disk;
    SmallDisk const small(disk.path());
    if (!small.isMounted()) CASE_CANNOT_HOLD("mounting a file system needs privilege");
    std::string const text(1 << 20, 'x');
    HttpServer const server{{{"/page", always(answer("200 OK", text))}}};
    put(disk / "old", "");
    auto const writes = [&](int mode, bool flag) {
        File const file((disk / "large").c_str(), mode | File::FILE_WRITE, flag);
        return file->write(text.data(), text.size()) == text.size();
    };
    expectReasons({
        Failure{{}, ENOSPC, 0, [&](auto&) { return writes(0, false); }},
        Failure{{}, ENOSPC, 0, [&](auto&) { return writes(File::FILE_CRT, false); }},
        Failure{{}, ENOSPC, 0, [&](auto&) { return writes(File::FILE_CRT, true); }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto& in) {
                    put(in.at("large"), text);
                    return File::Copy((disk / "copy").c_str(), in.at("large").c_str(), true, false);
                }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto& in) {
                    put(in.at("full/large"), text);
                    return Dir::Move((disk / "copy").c_str(), in.at("full").c_str(), true, false);
                }},
        Failure{{},
                ENOSPC,
                0,
                [&](auto&) {
                    return Url::Get((disk / "page").c_str(), server.url("/page").c_str(), nullptr, nullptr, true,
                                    false);
                }},
        Failure{{}, EXDEV, 0, [&](auto& in) { return Dir::Link((disk / "link").c_str(), in.at("file").c_str()); }},
    });
}

TEST(ReasonsPosix, of_what_only_linux_has_or_tells) {
    char buffer[8];
    expectReasons({
        // Wine reads from such a stream.
        Failure{{},
                EBADF,
                0,
                [&](auto& in) {
                    int const mode = File::FILE_WRITE | File::FILE_CRT;
                    return File(in.at("file").c_str(), mode, true)->read(buffer, 8) == 8;
                }},
        Failure{{},
                EEXIST,
                0,
                [](auto& in) {
                    ::mkfifo(in.at("pipe").c_str(), 0600);
                    // Somebody reads, so that it can be opened.
                    File const reader(in.at("pipe").c_str(), File::FILE_READ | File::FILE_WRITE | File::FILE_CRT);
                    return File::New(in.at("pipe").c_str(), false);
                }},
        Failure{{},
                EINVAL,
                0,
                [](auto& in) {
                    return File(in.at("file").c_str(), File::FILE_READ | File::FILE_CRT)->seek(SEEK_END + 1, 0) != -1;
                }},
        Failure{{},
                ENOENT,
                0,
                [](auto&) { return Process::ptrFunc("zb_nothing", Process::loadLib("libc.so.6")) != nullptr; }},
        Failure{{},
                ENOTSUP,
                0,
                [](auto&) {
                    BufStr<15> login;
                    return Sys::DefaultLogin(login);
                }},
        Failure{{},
                ENOTSUP,
                0,
                [](auto&) {
                    BufStr<255> domain;
                    return Sys::FullDomain("SALES", domain);
                }},
        Failure{{},
                ENOENT,
                0,
                [](auto& in) {
                    FPath share;
                    return Sys::UnMap(in.at("file"), share);
                }},
    });
}

namespace {

std::string services;

int startWithServices(char const* service, char const* user, pam_conv const* conversation, pam_handle_t** handle) {
    return pam_start_confdir(service, user, conversation, services.c_str(), handle);
}
int lackMemory(char const*, char const*, pam_conv const*, pam_handle_t**) { return PAM_BUF_ERR; }

int failToFind(uid_t, passwd*, char*, std::size_t, passwd** found) {
    *found = nullptr;
    errno = 0;
    return EMFILE;
}
int findNobody(uid_t, passwd*, char*, std::size_t, passwd** found) {
    *found = nullptr;
    return 0;
}
int findNoName(char const*, passwd*, char*, std::size_t, passwd** found) {
    *found = nullptr;
    return 0;
}

int oneAccount(char const* name, passwd* record, char* buffer, std::size_t, passwd** found) {
    *record = {};
    record->pw_name = buffer;
    std::snprintf(buffer, 20, "%s", name);
    *found = record;
    return 0;
}
int oneGroup(char const*, gid_t group, gid_t* groups, int* n) {
    groups[0] = group;
    *n = 1;
    return 1;
}

bool refuseGroups(std::size_t, gid_t const*) {
    errno = EPERM;
    return false;
}
/// The first group is taken, the user refused; what puts the old ones back fails for another reason.
bool takeGroups(std::size_t, gid_t const*) {
    errno = EINVAL;
    return true;
}
bool takeGroup(gid_t) {
    errno = EINVAL;
    return true;
}
bool refuseUser(uid_t) {
    errno = EPERM;
    return false;
}

struct ReasonsOfLogonPosix : QueryCallsTest {
    ReasonsOfLogonPosix() {
        services = rules.path();
        queryCalls.pamStart = startWithServices;
        queryCalls.userByName = oneAccount;
        queryCalls.groupsOf = oneGroup;
        admitWith("auth required pam_permit.so\naccount required pam_permit.so\n");
    }

    void admitWith(std::string const& text) { put(rules / "zor_basis", text); }
    static bool logsOn() { return std::unique_ptr<SysHdl>(Sys::loginUser("jane", "secret", true)) != nullptr; }

    Scratch const rules;
};

} // namespace

TEST_F(ReasonsOfLogonPosix, are_the_refusal_or_what_the_system_says) {
    expectReasons({
        Failure{{},
                EKEYREJECTED,
                0,
                [this](auto&) {
                    admitWith("auth required pam_deny.so\naccount required pam_permit.so\n");
                    return logsOn();
                }},
        Failure{{},
                EKEYREJECTED,
                0,
                [this](auto&) {
                    admitWith("auth required pam_permit.so\naccount required pam_deny.so\n");
                    return logsOn();
                }},
        Failure{{},
                ENOMEM,
                0,
                [](auto&) {
                    queryCalls.pamStart = lackMemory;
                    return logsOn();
                }},
        Failure{{},
                ENOENT,
                0,
                [this](auto&) {
                    queryCalls.pamStart = startWithServices;
                    admitWith("auth required pam_permit.so\naccount required pam_permit.so\n");
                    queryCalls.userByName = findNoName;
                    return logsOn();
                }},
        Failure{{},
                EMFILE,
                0,
                [](auto&) {
                    BufStr<15> user;
                    queryCalls.userById = failToFind;
                    return Sys::CurrentUser(user, false);
                }},
        Failure{{},
                ENOENT,
                0,
                [](auto&) {
                    BufStr<15> user;
                    queryCalls.userById = findNobody;
                    return Sys::CurrentUser(user, false);
                }},
    });
}

TEST_F(ReasonsOfLogonPosix, are_those_of_the_first_refusal_where_acting_fails) {
    std::unique_ptr<SysHdl> const jane(Sys::loginUser("jane", "secret", true));
    ASSERT_NE(jane, nullptr);
    expectReasons({
        Failure{{},
                EPERM,
                0,
                [&](auto&) {
                    queryCalls.setGroups = refuseGroups;
                    return Sys::impersonate(jane.get());
                }},
        Failure{{},
                EPERM,
                0,
                [&](auto&) {
                    queryCalls.setGroups = takeGroups;
                    queryCalls.setEffectiveGroup = takeGroup;
                    queryCalls.setEffectiveUser = refuseUser;
                    return Sys::impersonate(jane.get());
                }},
    });
}
