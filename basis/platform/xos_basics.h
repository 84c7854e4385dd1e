/// \file
/// Module `xos_basics`: tasks, semaphores, files, directories, parameters, configuration groups, assertions. C-clean.
///
/// Results are 0 for success unless said otherwise. Handles are 64-bit numbers, 0 for none. Paths are zero-terminated
/// 8-bit text and take both slash kinds.

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

/// A mutex, recursive for its owning thread.
XOS_API xos_Sem xos_SemMCreate(void);
/// A binary semaphore. \param available  1: can be taken at once; 0: taken
XOS_API xos_Sem xos_SemBCreate(int available);
/// A mutex that all processes of one user share under `id`. `word` caches its handle in this process.
XOS_API xos_Sem xos_SemNamedMutexCreate(int id, int flags, int reserved, uint32_t* word);
XOS_API int xos_SemTake(xos_Sem sem);
XOS_API int xos_SemGive(xos_Sem sem);
XOS_API int xos_SemDestroy(xos_Sem sem);

/* Tasks */

typedef struct xos_TaskParams {
    void (*entry)(void*);
    void* argument;
    uint32_t options;
    int32_t priority;
    uint64_t stackSize;
    char const* name;
    uint64_t reserved;
} xos_TaskParams;

/// Starts a task. \return its handle; all ones when it could not be created
XOS_API xos_Task xos_TaskCreate(xos_TaskParams const* params);
XOS_API void xos_TaskSleep(uint32_t ms);
/// Milliseconds of an arbitrary start, wrapping at 32 bits.
XOS_API uint32_t xos_MsCount(void);

/* Files */

/// \param flags  0x01 truncate, 0x02 read, 0x14 write and create, 0x08 append, 0x20 text
XOS_API xos_File xos_FileOpen(char const* path, uint32_t flags);
XOS_API int xos_FileCloseEx(xos_File file, int reserved);
/// \return the bytes transferred
XOS_API uint64_t xos_FileReadEx(xos_File file, void* buffer, uint64_t size, int reserved1, int reserved2);
/// \return the bytes transferred
XOS_API uint64_t xos_FileWriteEx(xos_File file, void const* buffer, uint64_t size, int reserved1, int reserved2);
/// Reads one line, its end included, into a buffer of `size` bytes. \return `buffer`; null at the end of the file
XOS_API char* xos_FileGetsEx(xos_File file, char* buffer, uint64_t size, int reserved);
XOS_API int xos_FileFlush(xos_File file);
/// \param origin  0 the start, 1 the current position, 2 the end
XOS_API int xos_FileSeekEx(xos_File file, int64_t offset, int origin, int reserved);
/// \return the position; -1 on failure
XOS_API int64_t xos_FileTellEx(xos_File file, int reserved);
XOS_API int xos_FileRemove(char const* path, uint32_t flags);
XOS_API int xos_FileCopy(char const* dst, char const* src, int overwrite);
XOS_API int xos_FileMove(char const* dst, char const* src, int overwrite);
XOS_API int xos_FileHardLink(char const* src, char const* dst);

/// The 64-bit status record of Windows, the same on every target.
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

/// Status of an entry; of a link itself, not of what it leads to.
XOS_API int xos_FileStatByNameEx(char const* path, struct xos_Stat* record, uint32_t flags);

/* Directories */

XOS_API int xos_DirCreateEx(char const* path, int reserved);
/// \param flags  0x200 with its contents
XOS_API int xos_DirRemove(char const* path, uint32_t flags);
/// \param flags  0x001 overwrite, 0x200 recursive
XOS_API int xos_DirCopy(char const* dst, char const* src, uint32_t flags);
/// \param flags  0x001 overwrite
XOS_API int xos_DirMove(char const* dst, char const* src, uint32_t flags);
XOS_API xos_Dir xos_DirOpenEx(char const* path, char const* pattern, uint32_t flags);
/// Makes the listing match its pattern whatever the case of the letters (`on` not 0).
XOS_API void xos_DirForceCaseAny(xos_Dir dir, int on);
/// The next entry's name, never "." or "..". \param kind  0 all, 1 directories, 2 files \return null at the end
XOS_API char const* xos_DirNextEx(xos_Dir dir, int kind, int reserved, uint32_t flags);
XOS_API void xos_DirClose(xos_Dir dir);
XOS_API int xos_StrCmp(char const* a, char const* b);
/// The configured root of the file system, or an empty text.
XOS_API char const* xos_FileSystemRoot(void);

/* Shell, libraries, parameters, assertions */

/// Runs a command line. With a `result` slot: waits and stores the exit code there.
XOS_API int xos_ShellExecuteEx(char const* commandLine, int64_t* result);
XOS_API void* xos_LibraryLoad(char const* name);
/// \return the bytes stored at `out`; below 1: unknown
XOS_API int xos_BasicsParamLookup(uint32_t id, void* out, uint64_t size);
XOS_API void xos_Assert(int line, char const* module, char const* message);

/* Configuration groups */

struct cfg_Group;
XOS_API struct cfg_Group* cfg_GroupLoadFromFile(char const* name, int reserved1, int reserved2, int reserved3);
XOS_API int cfg_KeyGetOpt_Bool(struct cfg_Group* group, char const* key, int fallback);
XOS_API void cfg_GroupDelete(struct cfg_Group* group, int reserved);

ZB_PLATFORM_C_END

#endif
