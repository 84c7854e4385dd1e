// The cache of domain names, in the registry itself.

#include <zor_basis/system.h>

#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"
#include "tests/system/wanted_room_win.h"

#include <cstring>

using namespace ZOR_Basis;

namespace {

struct DomainCacheRoomWin : RegistryScratch {};

/// A cache with names of every length.
struct DomainCacheWin : RegistryScratch {
    DomainCacheWin() {
        for (auto const& [shortName, fullName] : names) set(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, shortName, fullName);
    }

    std::vector<std::pair<std::string, std::string>> const names = {
        {"SALES", "sales.example.com"},
        {"PRINT", "print.example.com"},
        {"NAMELESS", ""},
        {std::string(511, 'S'), std::string(511, 'f')},
        {std::string(512, 'S'), std::string(512, 'f')},
        {std::string(513, 'S'), std::string(20, 'f')},
        {std::string(2000, 'S'), std::string(3000, 'f')},
        {"LONG", std::string(10'000, 'l')},
        {"LAST", "last.example.com"},
    };
};

/// A cache of one value, which wants more room than it says.
DWORD nameWanted, dataWanted;
int enumerations;

LSTATUS WINAPI enumValue(HKEY, DWORD index, char* name, DWORD* nameLength, DWORD*, DWORD* type, BYTE* data,
                         DWORD* dataLength) {
    ++enumerations;
    if (index != 0) return ERROR_NO_MORE_ITEMS;
    rooms.push_back({*nameLength, *dataLength});
    if (*nameLength < nameWanted || *dataLength < dataWanted) {
        if (reports) {
            *nameLength = nameWanted;
            *dataLength = dataWanted;
        }
        return ERROR_MORE_DATA;
    }
    *type = REG_SZ;
    std::memset(name, 'n', *nameLength);
    std::memcpy(name, "SALES", 6);
    *nameLength = 5;
    std::memset(data, 'd', *dataLength); // and no terminator
    std::memcpy(data, "sales.example", 13);
    *dataLength = 13;
    return ERROR_SUCCESS;
}

} // namespace

TEST_F(DomainCacheWin, translates_both_ways) {
    for (auto const& [shortName, fullName] : names) {
        BufStr<255> domain("before");
        EXPECT_TRUE(Sys::FullDomain(shortName, domain)) << shortName;
        EXPECT_EQ(domain.c_str(), fullName);
        domain = "before";
        EXPECT_TRUE(Sys::ShortDomain(fullName, domain)) << fullName;
        EXPECT_EQ(domain.c_str(), shortName);
    }
    EXPECT_EQ(keysOpened, 18);
}

TEST_F(DomainCacheWin, Kept_sys_04_compares_every_byte) {
    BufStr<255> domain("before");
    for (char const* name : {"sales", "SALE", "SALES ", "SALESX", "Sales", "sales.example.com", "no such"})
        EXPECT_FALSE(Sys::FullDomain(name, domain)) << name;
    for (char const* name : {"SALES.EXAMPLE.COM", "sales.example.co", "sales.example.com.", "SALES"})
        EXPECT_FALSE(Sys::ShortDomain(name, domain)) << name;
    EXPECT_STREQ(domain.c_str(), "before");
    EXPECT_TRUE(Sys::FullDomain(Str("SALES and more", 5), domain)) << "a view ends where it ends";
    EXPECT_FALSE(Sys::FullDomain(Str("SALES", 4), domain));
}

TEST_F(DomainCacheWin, may_hold_what_is_no_text) {
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "BINARY", "text", REG_BINARY);
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "NUMBER", "ab", REG_DWORD);
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "OPEN", "open.example.com"); // without a terminator
    setBytes(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "NOTHING", REG_SZ, "");
    BufStr<255> domain("before");
    EXPECT_FALSE(Sys::FullDomain("BINARY", domain));
    EXPECT_FALSE(Sys::FullDomain("NUMBER", domain));
    EXPECT_STREQ(domain.c_str(), "before");
    EXPECT_TRUE(Sys::FullDomain("OPEN", domain));
    EXPECT_STREQ(domain.c_str(), "open.example.com");
    EXPECT_TRUE(Sys::ShortDomain("open.example.com", domain));
    EXPECT_STREQ(domain.c_str(), "OPEN");
    EXPECT_TRUE(Sys::FullDomain("NOTHING", domain));
    EXPECT_STREQ(domain.c_str(), "");
    EXPECT_TRUE(Sys::FullDomain("LAST", domain)) << "what is no text ends nothing";
}

TEST_F(DomainCacheRoomWin, are_not_translated_without_a_cache) {
    BufStr<255> domain("before");
    queryCalls.openKey = [](HKEY, char const* path, DWORD, REGSAM, HKEY*) -> LSTATUS {
        EXPECT_STREQ(path, DOMAIN_CACHE);
        return ERROR_FILE_NOT_FOUND;
    };
    EXPECT_FALSE(Sys::FullDomain("SALES", domain));
    EXPECT_FALSE(Sys::ShortDomain("sales.example.com", domain));
    EXPECT_STREQ(domain.c_str(), "before");
}

TEST_F(DomainCacheRoomWin, are_read_again_with_more_room_until_they_fit) {
    makeKey(HKEY_LOCAL_MACHINE, DOMAIN_CACHE);
    queryCalls.enumValue = enumValue;
    struct Case {
        Row row;
        bool reports;
        DWORD name, data;
        std::vector<std::pair<DWORD, DWORD>> rooms;
    };
    for (Case const& c : {
             Case{{}, true, 6, 100, {{512, 512}}},
             Case{{}, true, 6, 513, {{512, 512}, {512, 513}}},
             Case{{}, true, 700, 100, {{512, 512}, {700, 512}}},
             Case{{}, true, 700, 9000, {{512, 512}, {700, 9000}}},
             Case{{}, false, 700, 100, {{512, 512}, {1024, 1024}}},
             Case{{}, false, 6, 3000, {{512, 512}, {1024, 1024}, {2048, 2048}, {4096, 4096}}},
         }) {
        SCOPED_TRACE(c.row);
        reports = c.reports;
        nameWanted = c.name;
        dataWanted = c.data;
        rooms.clear();
        BufStr<255> domain;
        EXPECT_TRUE(Sys::FullDomain("SALES", domain));
        EXPECT_STREQ(domain.c_str(), "sales.example");
        EXPECT_EQ(rooms, c.rooms);
    }
}

TEST_F(DomainCacheRoomWin, are_given_up_where_no_room_is_ever_enough) {
    makeKey(HKEY_LOCAL_MACHINE, DOMAIN_CACHE);
    queryCalls.enumValue = enumValue;
    enumerations = 0;
    BufStr<255> domain("before");
    for (bool says : {false, true}) {
        reports = says;
        nameWanted = dataWanted = ~DWORD{0};
        EXPECT_FALSE(Sys::FullDomain("SALES", domain));
        EXPECT_FALSE(Sys::ShortDomain("sales.example", domain));
    }
    EXPECT_LT(enumerations, 100);
    queryCalls.enumValue = [](HKEY, DWORD, char*, DWORD*, DWORD*, DWORD*, BYTE*, DWORD*) -> LSTATUS {
        return ERROR_ACCESS_DENIED;
    };
    EXPECT_FALSE(Sys::FullDomain("SALES", domain));
    EXPECT_STREQ(domain.c_str(), "before");
}
