/// \file
/// The command `move`.

#ifndef TOOLS_ZBTOOL_MOVE_H
#define TOOLS_ZBTOOL_MOVE_H

#include "tools/zbtool/copy.h"

namespace zbtool {

int move(CopyOptions const& options);

} // namespace zbtool

#endif
