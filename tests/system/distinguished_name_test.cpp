#include "basis/system/distinguished_name.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

TEST(DistinguishedName, holds_a_domain_in_components) {
    struct Case {
        Row row;
        char const *name, *domain;
    };
    for (Case const& c : {
             Case{{}, "CN=Jane Doe,OU=Print,DC=sales,DC=example", "sales.example"},
             Case{{}, "dc=sales, Dc=example,dC=com", "sales.example.com"},
             Case{{}, "CN=Doe\\, DC=Jane,DC=sales", "sales"},
             Case{{}, "DC=sales,OU=Print,DC=example", "sales.example"},
             Case{{}, "CN=Jane", ""},
             Case{{}, "", ""},
             Case{{}, "DC=", ""},
             Case{{}, "DC=,DC=example", "example"},
             Case{{}, "DC", ""},
             Case{{}, "D", ""},
             Case{{}, ",,,", ""},
             Case{{}, "DC=sales\\", "sales\\"},
             Case{{}, "  DC=sales", "sales"},
             Case{{}, "XDC=sales", ""},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_STREQ(ZOR_Basis::domainOfDistinguishedName(c.name).c_str(), c.domain);
    }
}
