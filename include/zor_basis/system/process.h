/// \file
/// `Process`: starts, awaits and ends other programs, and finds functions of shared libraries by name.
///
/// A process is known by its identifier. Once it has ended the system may give that identifier to another process. The
/// library keeps nothing open between two calls.
///
/// | | Windows | Linux |
/// |---|---|---|
/// | the command line | the program's own runtime splits it | is split by the same rules, without a shell |
/// | no `application`: search | own, current, system folders, `PATH` | `PATH`, unless the word has a slash |
/// | inherited | environment, current folder; the console is a new one | the same, and descriptors 0 to 2 |
/// | the exit code | the program's | the program's, or 128 + the number of the signal that ended it |
/// | ended, not awaited | soon unknown: `Wait` and `Terminate` fail | can be awaited once (see below) |
///
/// On Linux the library remembers thousands of children that were never awaited; beyond that it forgets the oldest.
///
/// Two dangers. Without `application`, a path with blanks needs double quotes in the command line: Windows otherwise
/// tries each blank in turn as the end of the path ("C:\Program Files\x.exe" may start C:\Program.exe). And the caller
/// must quote any text from elsewhere that it puts into a command line.
///
///     unsigned long id = 0;
///     int code = 0;
///     Process::Create(nullptr, nullptr, "render \"page 1.ps\" 300", &code); // returns when it has ended
///     if (Process::Create("./viewer", &id, nullptr, nullptr)) Process::Wait(id); // viewer runs by itself
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread thread-safe

#ifndef ZOR_BASIS_SYSTEM_PROCESS_H
#define ZOR_BASIS_SYSTEM_PROCESS_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API Process {
public:
    /// Starts a program.
    /// \param application  names the program's file; null: the first word of the command line names it
    /// \param processId  receives the identifier, and the call returns as soon as the program runs; null: the call
    ///     returns when the program has ended
    /// \param commandLine  holds all words, the program's name first; null: the program gets no arguments
    /// \param exitCode  receives the exit code if the call awaited the program, otherwise 0, also on failure; may be
    ///     null
    /// \kept process-01: when the call does not await the program, it sets `*exitCode` to 0, whatever was in it
    /// \return whether the program was started; false if both `application` and `commandLine` are null
    static bool Create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode);

    /// Waits without limit until a process has ended. The process need not be a child. On Linux this leaves the exit
    /// status of a child that the application made without `Create` for the application to collect.
    /// \return false if there is no such process, or if it may not be awaited
    static bool Wait(unsigned long processId);

    /// Kills a process, which gets no chance to clean up: on Windows with exit code 0, on Linux by SIGKILL.
    /// \return false if there is no such process, if it has already ended, or if the caller may not end it
    static bool Terminate(unsigned long processId);

    /// Loads a shared library, which stays loaded for the life of the process.
    /// \param name  is a path, or a bare name that the system searches for; the search path may contain a folder that
    ///     others can write
    /// \return the system's handle of the library, for `ptrFunc`; null on failure
    static void* loadLib(char const* name);

    /// Finds an exported function by name.
    /// \param name  is the exported name; no module has a null or empty one
    /// \param module  comes from `loadLib`; null: the platform layer's resolver is asked, if there is one
    /// \return the function's address; null if there is no such function
    static void* ptrFunc(char const* name, void* module);
};

} // namespace ZOR_Basis

#endif
