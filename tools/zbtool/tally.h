/// \file
/// What is in a file or a tree, and the commands `count` and `size`.

#ifndef TOOLS_ZBTOOL_TALLY_H
#define TOOLS_ZBTOOL_TALLY_H

#include "tools/zbtool/progress.h"

#include <zor_basis/files.h>

#include <cstdint>
#include <string>
#include <vector>

namespace zbtool {

struct Tally {
    std::uint64_t files = 0;
    std::uint64_t folders = 0;
    std::uint64_t others = 0; ///< links, devices and the like
    std::uint64_t bytes = 0;  ///< of the files

    void add(ZOR_Basis::FStat const& status);
    void add(Tally const& other);
    std::uint64_t entries() const { return files + folders + others; }
    Amount amount() const { return {entries(), bytes}; }
};

/// Adds up the entries of a tree, its top included; of links it counts themselves.
/// \param deep  includes the folders below the top
/// \param progress  is told of each folder; may be null
/// \return false, with complaints, if some of it could not be read
bool tallyTree(ZOR_Basis::FPath const& top, bool deep, Progress* progress, Tally& tally);

struct TallyOptions {
    std::vector<std::string> paths;
    bool flat = false;
    bool kinds = false;
    bool json = false;
};

int count(TallyOptions const& options);
int size(TallyOptions const& options);

} // namespace zbtool

#endif
