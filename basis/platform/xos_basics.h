/// \file
/// Module `xos_basics`: tasks, semaphores, files, directories, parameters, configuration groups, assertions. Valid C.
///
/// These are the server's functions as the library calls them, with the behaviour that the library relies on. The
/// stand-alone layer in host/ implements all of them; a remark "stand-alone" applies to that layer only, and the
/// server's own module decides otherwise.
///
/// `int` results are 0 for success and non-zero for failure unless a function says otherwise; the system's last error
/// (errno, `GetLastError`) then says why. Handles are 64-bit numbers, 0 for none. Texts are zero-terminated and
/// borrowed for the call. Paths are 8-bit text, on Windows in the process's ANSI code page, and take both slash kinds
/// on every target. Parameters called `reserved` are 0 in every call of the library. Flags without a meaning here are
/// accepted and ignored.
///
/// \thread every function may be called by any thread at any time; one open file, listing or configuration group
///     belongs to one thread at a time

#ifndef BASIS_PLATFORM_XOS_BASICS_H
#define BASIS_PLATFORM_XOS_BASICS_H

#include "basis/platform/platform_api.h"

#include <stdint.h>

ZB_PLATFORM_C_BEGIN

typedef uint64_t xos_Sem;
typedef uint64_t xos_File;
typedef uint64_t xos_Dir;
typedef uint64_t xos_Task;

/* Semaphores */

/// Makes a mutex that is free, and recursive for the thread that takes it.
/// \return 0 on failure
/// \cost stand-alone: no system call; about as much as allocating a small block
XOS_API xos_Sem xos_SemMCreate(void);

/// Makes a binary semaphore, which any thread may give.
/// \param available  says whether the semaphore is available at first; 0: it is taken
/// \return 0 on failure
XOS_API xos_Sem xos_SemBCreate(int available);

/// Opens the mutex that all processes of one user share under `id`, recursive for the thread that takes it. If the
/// thread or process that holds it ends, however it ends, the mutex becomes free: the next taker takes it over.
///
/// Stand-alone on Linux it is a locked file in `xos-UID`, a folder of that user alone (mode 0700) in /run/lock, or else
/// in /dev/shm or /tmp; on Windows a kernel mutex named after the user.
/// \param flags  0 in every call of the library; ignored
/// \param word  stores the handle between calls, so that a repeated call opens nothing: a word of the process, 0 before
///     the first call; may be null
/// \return the same handle for the same `id`, as long as the process lives; 0 on failure
XOS_API xos_Sem xos_SemNamedMutexCreate(int id, int flags, int reserved, uint32_t* word);

/// Waits without limit until the semaphore can be taken. A mutex that the thread already holds is taken once more.
/// \error no semaphore: 0, or one that was destroyed
/// \cost stand-alone, uncontended: no system call
XOS_API int xos_SemTake(xos_Sem sem);

/// Gives a semaphore. A mutex is free when it has been given as often as it was taken; a binary semaphore that is
/// available stays so, which is a success.
/// \error a mutex that the calling thread does not hold; no semaphore
XOS_API int xos_SemGive(xos_Sem sem);

/// Ends a semaphore, held or not. A named mutex stays for the life of the process: destroying it changes nothing.
/// \pre no thread waits for it
/// \error no semaphore: 0, or one that was destroyed already
XOS_API int xos_SemDestroy(xos_Sem sem);

/* Tasks */

/// The parameters of a task. The library passes options 0, priority -9, stack size 0 and reserved 0.
typedef struct xos_TaskParams {
    void (*entry)(void*);
    void* argument;
    uint32_t options;   /* stand-alone: ignored */
    int32_t priority;   /* stand-alone: ignored */
    uint64_t stackSize; /* bytes at least; 0: the system's usual size */
    char const* name;   /* what a debugger shows; copied; stand-alone: 15 bytes of it on Linux, 63 on Windows */
    uint64_t reserved;
} xos_TaskParams;

/// Starts a task: `entry(argument)` runs on its own thread, concurrently with everything else. No task waits for
/// another's end; a task that never returns occupies only its thread, and the process may end meanwhile. Later tasks
/// reuse threads, so a task may find what an earlier one left in its thread.
/// \return the task's number, not 0; all ones if it could not be created, also for a null block or entry
/// \cost stand-alone: most tasks start without a system call
XOS_API xos_Task xos_TaskCreate(xos_TaskParams const* params);

/// Suspends the calling thread for at least so many milliseconds.
XOS_API void xos_TaskSleep(uint32_t ms);

/// Milliseconds since an arbitrary start, on a clock that cannot be set. The count wraps at 32 bits, so differences
/// must be computed in 32 bits.
XOS_API uint32_t xos_MsCount(void);

/* Files */

/// Opens a file.
/// \param flags  0x02 read; 0x14 write, and create what is not there (0x04 without creating); 0x01 truncate; 0x08 write
///     at the end whatever the position; 0x20 text: on Windows line ends are translated
/// \return 0 on failure, also for a directory, for flags without any access, and if a handle that cannot write would
///     truncate or create
XOS_API xos_File xos_FileOpen(char const* path, uint32_t flags);

/// Closes the file; the file is closed whatever the result.
/// \error the system reports only now that data could not be written; no file
XOS_API int xos_FileCloseEx(xos_File file, int reserved);

/// \return the bytes read, fewer than `size` at the end of the file or on an error only; 0 for no file
XOS_API uint64_t xos_FileReadEx(xos_File file, void* buffer, uint64_t size, int reserved1, int reserved2);

/// Writes bytes, which other readers of the file see immediately. Discards data that was read ahead: the bytes go to
/// the position that `xos_FileTellEx` returns.
/// \return the bytes written, fewer than `size` on an error only; 0 for no file
XOS_API uint64_t xos_FileWriteEx(xos_File file, void const* buffer, uint64_t size, int reserved1, int reserved2);

/// Reads one line, including its end, or as much of it as fits into a buffer of `size` bytes with a terminator.
/// \return `buffer`; null at the end of the file, on an error, for no file
XOS_API char* xos_FileGetsEx(xos_File file, char* buffer, uint64_t size, int reserved);

/// Waits until everything written so far has reached the device. Does nothing for a handle that cannot write.
/// \cost a device's time: milliseconds on a disk
XOS_API int xos_FileFlush(xos_File file);

/// \param origin  0 the start, 1 the current position, 2 the end
XOS_API int xos_FileSeekEx(xos_File file, int64_t offset, int origin, int reserved);

/// \return the position in bytes from the start; -1 on failure
XOS_API int64_t xos_FileTellEx(xos_File file, int reserved);

/// Removes a file, or a link itself; never a directory.
XOS_API int xos_FileRemove(char const* path, uint32_t flags);

/// Copies a file, or the target file of a link, with its permissions and modification time. The destination appears
/// completely or not at all.
/// \param overwrite  0: the call fails if anything exists at the destination, and changes nothing; otherwise an
///     existing file or link is replaced, a directory is not
/// \error also when `src` and `dst` are one file
XOS_API int xos_FileCopy(char const* dst, char const* src, int overwrite);

/// Renames a file, or a link itself, but no directory. Renaming onto itself does nothing if it may overwrite.
/// \param overwrite  as for `xos_FileCopy`
/// \error also if `dst` is on another file system; the caller then copies
XOS_API int xos_FileMove(char const* dst, char const* src, int overwrite);

/// Gives the file `src` a second name `dst`, which must not exist.
XOS_API int xos_FileHardLink(char const* src, char const* dst);

/// The 64-bit status record of Windows, the same 56 bytes on every target. Times are seconds since 1970 UTC. A
/// number of links or id that does not fit is the largest one that does. The names end in "_" because the plain names
/// are macros in some systems' headers.
struct xos_Stat {
    uint32_t st_dev_;
    uint16_t st_ino_;
    uint16_t st_mode_;
    int16_t st_nlink_;
    int16_t st_uid_;
    int16_t st_gid_;
    uint32_t st_rdev_;
    int64_t st_size_;
    int64_t st_atime_;
    int64_t st_mtime_;
    int64_t st_ctime_;
};

/// Gets the status of an entry; for a link that of the link itself, not of its target.
XOS_API int xos_FileStatByNameEx(char const* path, struct xos_Stat* record, uint32_t flags);

/* Directories */

/// Makes one directory.
/// \error anything exists at the path, even a directory; the parent does not exist
XOS_API int xos_DirCreateEx(char const* path, int reserved);

/// Removes a directory, or a link itself.
/// \param flags  0x200 removes all contents, to any depth; links themselves, never their targets
/// \error without 0x200: the directory is not empty; nothing is removed then. With 0x200: an entry cannot be removed;
///     the rest is gone. A path that ends in "." or ".." or is a root
XOS_API int xos_DirRemove(char const* path, uint32_t flags);

/// Copies a directory and its files into `dst`, which is made or, if it exists, added to. A new `dst` appears when it
/// is complete; in an existing one each file appears when it is complete. Links and special entries are copied as such,
/// even if `src` is one. New directories also keep permissions and modification times.
/// \param flags  0x200 also copies sub-directories; 0x001 replaces existing files, which otherwise make the call fail
/// \error also if `dst` is `src` or lies in it; a file and a directory of the same name
XOS_API int xos_DirCopy(char const* dst, char const* src, uint32_t flags);

/// Renames a directory, or a link itself. Renaming onto itself does nothing with 0x001.
/// \param flags  0x001 removes an existing directory `dst` first, but only if the move can follow
/// \error anything exists at `dst`, without 0x001; `dst` is on another file system: the caller then copies
XOS_API int xos_DirMove(char const* dst, char const* src, uint32_t flags);

/// Opens a listing of a directory.
/// \param pattern  selects names by the library's wildcard rule; null: all names
/// \return 0 on failure
XOS_API xos_Dir xos_DirOpenEx(char const* path, char const* pattern, uint32_t flags);

/// Makes the listing match its pattern without regard to the case of ASCII letters (`on` not 0).
XOS_API void xos_DirForceCaseAny(xos_Dir dir, int on);

/// \param kind  selects 0 all entries, 1 directories, 2 everything else; a link is never a directory
/// \return the next entry's name, never "." or "..", valid until the listing's next call; null at the end
XOS_API char const* xos_DirNextEx(xos_Dir dir, int kind, int reserved, uint32_t flags);

/// Closes a listing; does nothing for 0.
XOS_API void xos_DirClose(xos_Dir dir);

/// Compares texts by unsigned bytes.
/// \return 0 if they are equal, otherwise less or greater than 0; null equals null and comes before every text
XOS_API int xos_StrCmp(char const* a, char const* b);

/// Returns the root of the file system exactly as configured, or an empty text. Stand-alone: the text that
/// `xos_HostSetRoot` set, otherwise the environment variable `XOS_ROOT`.
/// \return a text that stays valid forever
XOS_API char const* xos_FileSystemRoot(void);

/* Shell, libraries, parameters, assertions */

/// Runs a command line in the system's command interpreter: /bin/sh, or cmd.exe (`COMSPEC`).
///
/// A line of the form `cd DIRECTORY& COMMAND` runs the command in that directory, and not at all if the directory
/// cannot be entered. The first "& " ends the directory, which is used unchanged: both kinds of slash, double quotes
/// around it and any drive are allowed. An empty directory, between `cd ` and `& `, keeps the current one.
/// \param result  receives the exit code, for which the call waits (128 + the signal that ended the command; -1 if the
///     process ignores SIGCHLD); null: the call returns as soon as the interpreter has started
/// \return 0 once the interpreter has started, regardless of the command's result
XOS_API int xos_ShellExecuteEx(char const* commandLine, int64_t* result);

/// Loads a shared library for the life of the process, by path or along the system's search path.
/// \return the system's handle of the library; null on failure
XOS_API void* xos_LibraryLoad(char const* name);

/// Looks up a parameter of the platform. 0xFFFF8006 is its function resolver, `void* (*)(void* module, char const*
/// name)`, of 8 bytes; stand-alone it is the only one, once `xos_HostSetResolver` has set it.
/// \return the number of bytes stored at `out`; less than 1 if the parameter is unknown or `size` is too small, and
///     then nothing is stored
XOS_API int xos_BasicsParamLookup(uint32_t id, void* out, uint64_t size);

/// Reports a programming error and returns. Stand-alone: `module:line: message` on standard error, or a call of the
/// handler that `xos_HostSetAssertHandler` set.
XOS_API void xos_Assert(int line, char const* module, char const* message);

/* Configuration groups */

struct cfg_Group;

/// Loads the configuration group `name`. Stand-alone: the file `NAME.cfg` in the folder that `xos_HostSetConfigDir`
/// set, otherwise in that of `XOS_CONFIG`, otherwise in "config" below the root. Lines are `key = value`; of several
/// lines with one key the last counts. "#" at the start of a line or after white space begins a comment. Any other line
/// is reported once on standard error, with file and line, and ignored.
/// \param name  must be a name, not a path
/// \return the group, which the caller must release by `cfg_GroupDelete`; null if there is none
XOS_API struct cfg_Group* cfg_GroupLoadFromFile(char const* name, int reserved1, int reserved2, int reserved3);

/// Reads a switch: `true`, `yes`, `on`, `1` are 1 and `false`, `no`, `off`, `0` are 0, in any case.
/// \return `fallback` if `group` is null, lacks the key, or has another value, which is reported once on standard error
XOS_API int cfg_KeyGetOpt_Bool(struct cfg_Group* group, char const* key, int fallback);

/// Releases a group; does nothing for null.
XOS_API void cfg_GroupDelete(struct cfg_Group* group, int reserved);

ZB_PLATFORM_C_END

#endif
