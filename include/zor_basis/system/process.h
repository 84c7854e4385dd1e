/// \file
/// `Process`: starting, awaiting and ending other programs, and functions of libraries found by name.
///
/// A process is known by its identifier, which the system may give to another one once it has ended. The library keeps
/// nothing open between two calls.
///
/// | | Windows | Linux |
/// |---|---|---|
/// | the command line | the program's own runtime takes it apart | taken apart by the same rules, without a shell |
/// | no `application` | the first word is searched for in the program's folder, the current one, the system's and `PATH` | in `PATH`, unless it has a slash |
/// | what is inherited | environment and current folder; the program gets a console of its own | the same, and descriptors 0 to 2 |
/// | the exit code | the program's | the program's; of one that a signal ended 128 + the signal |
/// | ended and not awaited | its identifier is soon unknown: `Wait` and `Terminate` fail | can be awaited once; of those that nobody awaits the oldest are forgotten when there are thousands |
///
/// Two dangers: a path with blanks needs double quotes in a command line without `application`, as Windows else takes each
/// blank for its end in turn ("C:\Program Files\x.exe" may start C:\Program.exe); and text from elsewhere that goes into a
/// command line has to be quoted by whoever builds it.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  thread-safe

#ifndef ZOR_BASIS_SYSTEM_PROCESS_H
#define ZOR_BASIS_SYSTEM_PROCESS_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API Process {
public:
    /// Starts a program.
    /// \param application  the program's file; null: the first word of the command line names it
    /// \param processId  receives the identifier, and the program runs on by itself; null: the call returns when the program
    ///        has ended
    /// \param commandLine  all words, the program's name first; null: just the program
    /// \param exitCode  null, or receives the exit code of a program that was awaited; 0 where there is none, also on
    ///        failure
    /// \kept process-01: a program that runs on by itself leaves an exit code of 0, whatever it was before
    /// \return whether the program was started; false with neither a program nor a command line
    static bool Create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode);

    /// Waits without limit until a process has ended, a child or any other. On Linux the exit status of a child that the
    /// application made without `Create` stays for the application to take.
    /// \return false where there is no such process, or none that may be awaited
    static bool Wait(unsigned long processId);

    /// Ends a process at once, without giving it a chance to clean up: on Windows with exit code 0, on Linux by SIGKILL.
    /// \return false where there is no such process, where it has ended already, or where that is not allowed
    static bool Terminate(unsigned long processId);

    /// Loads a shared library, for the life of the process.
    /// \param name  a path; a bare name is searched for in the system's order, of which others may be able to write a folder
    /// \return the system's handle of it, for `ptrFunc`; null on failure
    static void* loadLib(char const* name);

    /// Finds an exported function by name.
    /// \param name  null and empty names are nowhere found in a module
    /// \param module  from `loadLib`; null: the resolver of the platform layer is asked, where there is one
    /// \return null where there is no such function
    static void* ptrFunc(char const* name, void* module);
};

} // namespace ZOR_Basis

#endif
