/// \file
/// The system calls of `Process`: process_win.cpp, process_posix.cpp.

#ifndef BASIS_SYSTEM_PROCESS_IMPL_H
#define BASIS_SYSTEM_PROCESS_IMPL_H

namespace ZOR_Basis::ProcessImpl {

/// \param processId  null: awaits the end
/// \param exitCode  null or 0 beforehand
/// \pre there is an application or a command line
bool create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode);
bool wait(unsigned long processId);
bool terminate(unsigned long processId);
/// \pre neither is null
void* findFunction(void* module, char const* name);

} // namespace ZOR_Basis::ProcessImpl

#endif
