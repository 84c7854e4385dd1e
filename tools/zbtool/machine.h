/// \file
/// The command `sys`.

#ifndef TOOLS_ZBTOOL_MACHINE_H
#define TOOLS_ZBTOOL_MACHINE_H

namespace zbtool {

struct MachineOptions {
    bool json = false;
};

/// Prints what the library's queries tell about this machine.
int describeMachine(MachineOptions const& options);

} // namespace zbtool

#endif
