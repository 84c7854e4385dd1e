// Local disks and mapped drives: by the volumes and the registry of the machine, and by answers of the tests' own.

#include <zor_basis/system.h>

#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"

#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

using LocalDisksWin = RegistryScratch;

UINT kind = DRIVE_UNKNOWN;
std::string askedVolume;
DWORD volumeRoom = 0;

BOOL WINAPI volumePath(char const* path, char* volume, DWORD n) {
    volumeRoom = n;
    askedVolume = path;
    std::strcpy(volume, "V:\\");
    return TRUE;
}
BOOL WINAPI noVolume(char const*, char*, DWORD) { return FALSE; }
UINT WINAPI driveType(char const* root) {
    EXPECT_STREQ(root, "V:\\");
    return kind;
}

/// What was asked of the system, in its order, and what it answers.
std::vector<std::string> steps;
bool admits = true, acts = true;
char const* connected = nullptr;

BOOL WINAPI logonUser(char const* user, char const* domain, char const* password, DWORD, DWORD, HANDLE* token) {
    steps.push_back(std::string("logon ") + user + " " + (domain != nullptr ? domain : "-") + " " + password);
    *token = reinterpret_cast<HANDLE>(77);
    return admits;
}
BOOL WINAPI impersonate(HANDLE token) {
    EXPECT_EQ(token, reinterpret_cast<HANDLE>(77));
    steps.push_back("act");
    return acts;
}
BOOL WINAPI revert() {
    steps.push_back("revert");
    return TRUE;
}
BOOL WINAPI closeHandle(HANDLE) {
    steps.push_back("close");
    return TRUE;
}
DWORD WINAPI connection(char const* drive, char* remote, DWORD* n) {
    steps.push_back(std::string("connection ") + drive);
    if (connected == nullptr) return ERROR_NOT_CONNECTED;
    if (*n <= std::strlen(connected)) {
        *n = static_cast<DWORD>(std::strlen(connected) + 1);
        return ERROR_MORE_DATA;
    }
    std::strcpy(remote, connected);
    return NO_ERROR;
}

using Steps = std::vector<std::string>;

struct MappedDrivesWin : RegistryScratch {
    MappedDrivesWin() {
        steps.clear();
        admits = acts = true;
        connected = nullptr;
        queryCalls.logonUser = logonUser;
        queryCalls.impersonate = impersonate;
        queryCalls.revertToSelf = revert;
        queryCalls.closeHandle = closeHandle;
        queryCalls.connection = connection;
        removeValue(HKEY_CURRENT_USER, EXPLORER, "Logon User Name");
    }
    void makeProfile(std::string const& name, std::string const& user, std::string const& domain) {
        set(HKEY_USERS, name + "\\" + VOLATILE, "USERDOMAIN", domain);
        set(HKEY_USERS, name + "\\" + EXPLORER, "Logon User Name", user);
    }
    void map(std::string const& profile, char letter, std::string const& remote) {
        set(HKEY_USERS, profile + "\\Network\\" + letter, "RemotePath", remote);
    }
};

template <class... Arguments>
std::string unmapped(char const* path, Arguments... users) {
    FPath unc("before");
    bool const found = Sys::UnMap(path, users..., unc);
    EXPECT_EQ(found, unc != Str("before"));
    return unc.c_str();
}

std::string unmappedLogin(char const* path) {
    FPath unc("before");
    bool const found = Sys::UnMapLogin(path, unc);
    EXPECT_EQ(found, unc != Str("before"));
    return unc.c_str();
}

} // namespace

TEST_F(LocalDisksWin, are_fixed_optical_or_in_memory) {
    queryCalls.volumePath = volumePath;
    queryCalls.driveType = driveType;
    for (UINT k = 0; k <= 8; ++k) {
        kind = k;
        bool const local = k == DRIVE_FIXED || k == DRIVE_CDROM || k == DRIVE_RAMDISK;
        EXPECT_EQ(Sys::isLocalDisk("V:\\x\\y"), local) << k;
        EXPECT_EQ(askedVolume, "V:\\x\\y");
        EXPECT_EQ(volumeRoom, 256u);
    }
    kind = DRIVE_FIXED;
    for (std::size_t size : {3u, 254u, 255u, 256u, 257u, 300u, 1000u, 40'000u}) {
        std::string const longPath = "V:\\" + std::string(size - 3, 'x');
        EXPECT_TRUE(Sys::isLocalDisk(longPath));
        EXPECT_EQ(volumeRoom, std::max<std::size_t>(256, size + 1))
            << "the path with its terminator, 256 bytes at least";
        EXPECT_EQ(askedVolume, longPath);
    }
    EXPECT_TRUE(Sys::isLocalDisk(Str("V:\\x\\y", 4)));
    EXPECT_EQ(askedVolume, "V:\\x") << "a view ends where it ends";
}

TEST_F(LocalDisksWin, Kept_sys_05_may_be_listed_as_devices) {
    setBytes(HKEY_LOCAL_MACHINE, MOUNTED_DEVICES, "\\DosDevices\\Q:", REG_BINARY, "device");
    setBytes(HKEY_LOCAL_MACHINE, MOUNTED_DEVICES, "\\DosDevices\\R", REG_BINARY, "device");
    for (bool known : {true, false}) {
        queryCalls.volumePath = known ? volumePath : noVolume;
        queryCalls.driveType = driveType;
        kind = DRIVE_REMOVABLE;
        EXPECT_TRUE(Sys::isLocalDisk("Q:\\x"));
        EXPECT_TRUE(Sys::isLocalDisk("Q:"));
        EXPECT_TRUE(Sys::isLocalDisk("Q:x"));
        EXPECT_TRUE(Sys::isLocalDisk("R")) << "as much as there is of a path";
        EXPECT_FALSE(Sys::isLocalDisk("R:\\x"));
        EXPECT_FALSE(Sys::isLocalDisk("Q"));
        EXPECT_FALSE(Sys::isLocalDisk("W:\\x"));
        EXPECT_FALSE(Sys::isLocalDisk("\\\\srv\\share"));
    }
    queryCalls.openKey = [](HKEY, char const*, DWORD, REGSAM, HKEY*) -> LSTATUS { return ERROR_ACCESS_DENIED; };
    EXPECT_FALSE(Sys::isLocalDisk("Q:\\x"));
}

TEST_F(LocalDisksWin, of_this_machine_can_be_asked) {
    EXPECT_TRUE(Sys::isLocalDisk("C:\\"));
    EXPECT_TRUE(Sys::isLocalDisk("C:\\no\\such\\path"));
    EXPECT_TRUE(Sys::isLocalDisk("C:/windows"));
    EXPECT_FALSE(Sys::isLocalDisk("Q:\\x"));
    EXPECT_FALSE(Sys::isLocalDisk(""));
}

TEST_F(MappedDrivesWin, Kept_sys_06_give_three_characters_for_the_share) {
    set(HKEY_CURRENT_USER, "Network\\P", "RemotePath", "\\\\srv\\share");
    set(HKEY_CURRENT_USER, "Network\\R", "RemotePath", "\\\\srv\\share\\");
    set(HKEY_CURRENT_USER, "Network\\S", "RemotePath", "//srv/share/");
    makeKey(HKEY_CURRENT_USER, "Network\\T");
    struct Case {
        Row row;
        char const *path, *unc;
    };
    for (Case const& c : {
             Case{{}, "P:\\jobs\\1", "\\\\srv\\share/jobs\\1"},
             Case{{}, "p:\\jobs\\1", "\\\\srv\\share/jobs\\1"},
             Case{{}, "P:/jobs/1", "\\\\srv\\share/jobs/1"},
             Case{{}, "P:\\\\/jobs", "\\\\srv\\share/jobs"},
             Case{{}, "P:\\", "\\\\srv\\share"},
             Case{{}, "P:", "\\\\srv\\share"},
             Case{{}, "P", "\\\\srv\\share"},
             Case{{}, "P:jobs", "\\\\srv\\share/obs"}, // the third one goes, whatever it is
             Case{{}, "Pxyz", "\\\\srv\\share/z"},
             Case{{}, "R:\\jobs", "\\\\srv\\share\\/jobs"},
             Case{{}, "S:\\jobs", "//srv/share/jobs"},
             Case{{}, "T:\\jobs", "before"},
             Case{{}, "Q:\\jobs", "before"},
             Case{{}, "\\P:\\jobs", "before"},
             Case{{}, "", "before"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(unmapped(c.path), c.unc);
        EXPECT_EQ(unmapped(c.path, ""), c.unc) << "an empty user is the current one";
    }
    FPath unc;
    EXPECT_TRUE(Sys::UnMap(Str("P:\\jobs\\1", 7), unc));
    EXPECT_STREQ(unc.c_str(), "\\\\srv\\share/jobs");
    EXPECT_EQ(steps, Steps{}) << "nobody is logged on";
}

TEST_F(MappedDrivesWin, survive_values_that_are_no_texts) {
    setRaw(HKEY_CURRENT_USER, "Network\\P", "RemotePath", "\\\\srv\\open");
    setRaw(HKEY_CURRENT_USER, "Network\\R", "RemotePath", "ab", REG_DWORD);
    set(HKEY_CURRENT_USER, "Network\\S", "RemotePath", "\\\\srv\\" + std::string(505, 's'));
    set(HKEY_CURRENT_USER, "Network\\T", "RemotePath", "\\\\srv\\" + std::string(506, 's'));
    EXPECT_EQ(unmapped("P:\\x"), "\\\\srv\\open/x");
    EXPECT_EQ(unmapped("R:\\x"), "before");
    EXPECT_EQ(unmapped("S:\\x"), "\\\\srv\\" + std::string(505, 's') + "/x");
    EXPECT_EQ(unmapped("T:\\x"), "before") << "longer than 512 bytes";
}

TEST_F(MappedDrivesWin, are_those_of_a_users_profile) {
    set(HKEY_CURRENT_USER, "Network\\P", "RemotePath", "\\\\srv\\current");
    makeProfile("zb_a", "jane", "SALES");
    makeProfile("zb_b", "john", "SALES");
    makeProfile("zb_c", "jane", "PRINT");
    map("zb_a", 'P', "\\\\srv\\jane");
    map("zb_b", 'P', "\\\\srv\\john");
    map("zb_c", 'P', "\\\\srv\\printing jane");
    map("zb_c", 'R', "\\\\srv\\only printing");
    struct Case {
        Row row;
        char const *path, *user, *unc;
    };
    for (Case const& c : {
             Case{{}, "P:\\x", "jane", "\\\\srv\\jane/x"},
             Case{{}, "P:\\x", "JANE", "\\\\srv\\jane/x"},
             Case{{}, "P:\\x", "john", "\\\\srv\\john/x"},
             Case{{}, "P:\\x", "jane@SALES", "\\\\srv\\jane/x"},
             Case{{}, "P:\\x", "print\\jane", "\\\\srv\\printing jane/x"},
             Case{{}, "P:\\x", "PRINT/jane", "\\\\srv\\printing jane/x"},
             Case{{}, "P:\\x", "jane@", "\\\\srv\\jane/x"},
             Case{{}, "P:\\x", "jane@nowhere", "before"},
             Case{{}, "P:\\x", "jim", "before"},
             Case{{}, "R:\\x", "jane", "\\\\srv\\only printing/x"}, // the first profile with the drive
             Case{{}, "R:\\x", "jane@SALES", "before"},
             Case{{}, "Q:\\x", "jane", "before"},
             Case{{}, "", "jane", "before"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(unmapped(c.path, c.user), c.unc);
    }
    EXPECT_EQ(steps, Steps{});
}

TEST_F(MappedDrivesWin, are_asked_of_the_user_who_is_logged_on_for_it) {
    makeProfile("zb_a", "jane", "SALES");
    map("zb_a", 'P', "\\\\srv\\jane");
    EXPECT_EQ(unmapped("P:\\x", "jane@SALES", "secret"), "\\\\srv\\jane/x");
    EXPECT_EQ(steps, Steps{}) << "the profile is there already";

    connected = "\\\\srv\\live";
    EXPECT_EQ(unmapped("r:\\x", "jane@SALES", "secret"), "\\\\srv\\live/x");
    EXPECT_EQ(steps, (Steps{"revert", "logon jane SALES secret", "revert", "act", "connection R:", "revert", "close"}));

    steps.clear();
    connected = nullptr;
    EXPECT_EQ(unmapped("R:\\x", "jim", "secret"), "before");
    EXPECT_EQ(steps, (Steps{"revert", "logon jim - secret", "revert", "act", "connection R:", "revert", "close"}));

    steps.clear();
    acts = false;
    EXPECT_EQ(unmapped("R:\\x", "jim", "secret"), "before");
    EXPECT_EQ(steps, (Steps{"revert", "logon jim - secret", "revert", "act", "revert", "close"}));

    steps.clear();
    admits = false;
    EXPECT_EQ(unmapped("R:\\x", "jim", "wrong"), "before");
    EXPECT_EQ(steps, (Steps{"revert", "logon jim - wrong"}));

    steps.clear();
    EXPECT_EQ(unmapped("R:\\x", "", ""), "before");
    EXPECT_EQ(steps, Steps{}) << "nobody is no user";
}

TEST_F(MappedDrivesWin, are_those_of_whoever_is_logged_on) {
    set(HKEY_CURRENT_USER, "Network\\P", "RemotePath", "\\\\srv\\current");
    makeProfile("zb_a", "jane", "SALES");
    makeProfile("zb_b", "john", "SALES");
    map("zb_a", 'R', "\\\\srv\\jane");
    map("zb_b", 'P', "\\\\srv\\john");
    map("zb_b", 'R', "\\\\srv\\john");
    EXPECT_EQ(unmappedLogin("R:\\x"), "\\\\srv\\jane/x");
    EXPECT_EQ(unmappedLogin("p:\\x"), "\\\\srv\\john/x");
    EXPECT_EQ(steps, Steps{});
    EXPECT_EQ(unmappedLogin("s:\\x"), "before");
    EXPECT_EQ(steps, Steps{"connection S:"});
    connected = "\\\\srv\\live";
    EXPECT_EQ(unmappedLogin("S:\\x"), "\\\\srv\\live/x");
    std::string const longShare = "\\\\srv\\" + std::string(5000, 's');
    connected = longShare.c_str();
    EXPECT_EQ(unmappedLogin("S:\\x"), longShare + "/x") << "beyond the first buffer";
    EXPECT_EQ(unmappedLogin(""), "before");
}

TEST_F(MappedDrivesWin, of_this_machine_can_be_asked) {
    queryCalls.connection = realCalls.connection;
    EXPECT_EQ(unmappedLogin("Q:\\x"), "before");
}

namespace {

/// Fails the n-th call of one kind, counted over all queries.
int untilFailure = -1;
bool failsNow() { return untilFailure >= 0 && untilFailure-- == 0; }

void askEverything() {
    BufStr<15> user, domain;
    BufStr<255> fullDomain;
    FPath unc;
    Sys::CurrentUser(user, true);
    Sys::CurrentDomain(domain, true);
    Sys::DefaultLogin(user);
    Sys::CurHumanUser(user);
    Sys::FullDomain("SALES", fullDomain);
    Sys::isLocalDisk("Q:\\x");
    Sys::UnMap("P:\\x", unc);
    Sys::UnMap("P:\\x", "jane@SALES", unc);
    Sys::UnMap("Q:\\x", "jane", "secret", unc);
    Sys::UnMapLogin("P:\\x", unc);
}

} // namespace

TEST_F(MappedDrivesWin, and_all_other_queries_close_what_they_open_whichever_call_fails) {
    set(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "SALES", "sales.example");
    makeProfile("zb_a", "jane", "SALES");
    map("zb_a", 'P', "\\\\srv\\jane");
    void (*const faults[])() = {
        [] {
            queryCalls.openKey = [](HKEY parent, char const* path, DWORD options, REGSAM access, HKEY* key) {
                return failsNow() ? LSTATUS{ERROR_ACCESS_DENIED} : openCounted(parent, path, options, access, key);
            };
        },
        [] {
            queryCalls.queryValue = [](HKEY key, char const* value, DWORD* reserved, DWORD* type, BYTE* data,
                                       DWORD* n) {
                return failsNow() ? LSTATUS{ERROR_ACCESS_DENIED}
                                  : realCalls.queryValue(key, value, reserved, type, data, n);
            };
        },
        [] {
            queryCalls.enumKey = [](HKEY key, DWORD index, char* name, DWORD* n, DWORD* a, char* b, DWORD* c,
                                    FILETIME* d) {
                return failsNow() ? LSTATUS{ERROR_ACCESS_DENIED} : realCalls.enumKey(key, index, name, n, a, b, c, d);
            };
        },
        [] {
            queryCalls.enumValue = [](HKEY key, DWORD index, char* name, DWORD* n, DWORD* a, DWORD* type, BYTE* data,
                                      DWORD* size) {
                return failsNow() ? LSTATUS{ERROR_ACCESS_DENIED}
                                  : realCalls.enumValue(key, index, name, n, a, type, data, size);
            };
        },
    };
    QueryCalls const sound = queryCalls;
    for (auto const fault : faults) {
        bool failed = true;
        for (int n = 0; failed; ++n) {
            ASSERT_LT(n, 10'000);
            queryCalls = sound;
            fault();
            untilFailure = n;
            keysOpened = keysClosed = 0;
            steps.clear();
            askEverything();
            failed = untilFailure < 0;
            EXPECT_EQ(keysOpened, keysClosed) << n;
            EXPECT_EQ(std::count(steps.begin(), steps.end(), "close"), 1) << "the token";
        }
        queryCalls = sound;
    }
}
