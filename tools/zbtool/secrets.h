/// \file
/// The command `crypt`.

#ifndef TOOLS_ZBTOOL_SECRETS_H
#define TOOLS_ZBTOOL_SECRETS_H

#include <string>

namespace zbtool {

struct CryptOptions {
    std::string source;
    std::string target;
    std::string secretFile;
    bool overwrite = false;
};

int encrypt(CryptOptions const& options);
int decrypt(CryptOptions const& options);

} // namespace zbtool

#endif
