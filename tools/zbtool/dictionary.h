/// \file
/// The command `dict`.

#ifndef TOOLS_ZBTOOL_DICTIONARY_H
#define TOOLS_ZBTOOL_DICTIONARY_H

#include <string>

namespace zbtool {

struct DictOptions {
    std::string file;
    std::string key;
    std::string value;
    std::string source = "-"; ///< of an import
    bool hex = false;
    bool json = false;
    bool replace = false;
};

/// What `dict` can do with a file. Each is refused for a file that is not understood to its end.
int dictList(DictOptions const& options);
int dictGet(DictOptions const& options);
int dictSet(DictOptions const& options);
int dictRemove(DictOptions const& options);
int dictExport(DictOptions const& options);
int dictImport(DictOptions const& options);
int dictCheck(DictOptions const& options);

} // namespace zbtool

#endif
