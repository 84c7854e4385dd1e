/// \file
/// What the stand-alone platform layer offers beyond the platform interface: the location of its root and its
/// configuration, a handler for assertions, failures on demand, and a record of every call. Valid C; module
/// `xos_basics`.
///
/// The stand-alone layer replaces the server's modules for tests, tools and demonstrations. Everything here is
/// thread-safe, always compiled in and always on: counting a call and storing its arguments costs about a nanosecond,
/// and copying each text among them about four more.
///
///     xos_HostFail("xos_FileMove", 0, 1); // the next move fails
///     File::Move("new", "old", true, false);
///     puts(xos_HostLastCall("xos_FileMove")); // "new", "old", 1
///
/// The library reads these environment variables: `XOS_ROOT` (the root of the file system), `XOS_CONFIG` (the folder of
/// the configuration groups), `XOS_FAULTS` (failures to inject from the start), `XOS_TRACE` (the file to which all
/// calls are written).
///
/// `XOS_TRACE` is read when the library is loaded. It names a file, to which lines are appended, or is "-" for standard
/// error. Every call of a platform function writes one line when it returns; a call that never returns has none:
///
///     2026-11-22T19:47:08.123456Z 1234/1240 xos_FileMove("new", "old", 1) = -1, error 2, 13.0 us
///
/// The line contains the time of the call (UTC), the process, the thread, the arguments in the form of
/// `xos_HostLastCall`, the result ("void" if there is none) and the duration. A failed call adds the last error that it
/// set. In texts, control characters become `\x0a`. Asterisks replace passwords in the last argument of `xos_URLGet`
/// and in URLs; those in command lines remain. The file belongs to its user alone. Threads and processes may share it,
/// as each line is written in one step. If it cannot be opened, standard error gets a line and nothing is traced.
///
/// A function is identified by its C name (`"xos_FileMove"`, `"cfg_GroupDelete"`); the two of module `hq_basis` are
/// `"HQ_Basis::AlertTimer::New"` and `"HQ_Basis::AlertTimer::Delete"`.

#ifndef XOS_HOST_H
#define XOS_HOST_H

#include <stdint.h>

#if defined(_MSC_VER) && defined(XOS_BUILDING)
#define XOS_HOST_API __declspec(dllexport)
#elif defined(_MSC_VER)
#define XOS_HOST_API __declspec(dllimport)
#elif defined(_WIN32)
#define XOS_HOST_API
#else
#define XOS_HOST_API __attribute__((visibility("default")))
#endif

#ifdef __cplusplus
extern "C" {
#endif

/* Root and configuration */

/// Sets the root that `xos_FileSystemRoot` returns.
/// \param path  is copied unchanged; null or empty restores `XOS_ROOT`, or the empty text if that is not set
XOS_HOST_API void xos_HostSetRoot(char const* path);

/// Sets the folder in which `cfg_GroupLoadFromFile` looks for `NAME.cfg`.
/// \param path  is copied unchanged; null or empty restores `XOS_CONFIG`, or the root's folder "config" if that is not
///     set
XOS_HOST_API void xos_HostSetConfigDir(char const* path);

/* Assertions */

/// Handles an assertion, on the thread that raised it. The texts are borrowed for the call.
typedef void (*xos_HostAssertHandler)(int line, char const* module, char const* message, void* context);

/// Makes `xos_Assert` call `handler` instead of writing a line to standard error; null restores the line.
/// \pre handler and context live until the handler has been replaced and every assertion that began before has returned
XOS_HOST_API void xos_HostSetAssertHandler(xos_HostAssertHandler handler, void* context);

/* Failures on demand */

/// Makes a function fail: its next `skip` calls succeed, the following `times` calls fail, and later ones succeed
/// again. A call that fails this way does nothing (except that a failed close still closes) and returns its function's
/// failure value: non-zero for `int` results (below 1 for `xos_BasicsParamLookup`), 0 for handles, counts and pointers,
/// all ones for `xos_TaskCreate`, -1 for `xos_FileTellEx`, the fallback for `cfg_KeyGetOpt_Bool`, the empty text for
/// `xos_FileSystemRoot`; `HQ_Basis::AlertTimer::Delete` leaves the alert unchanged. The last error is EIO (errno), on
/// Windows 31 (GetLastError).
/// \param skip  counts calls by all threads
/// \param times  sets the number of failures; 0: the function no longer fails. A later request replaces an earlier one
///     for the same function
/// \return 0; -1 if there is no such function, or if it cannot fail: `xos_MsCount`, `xos_StrCmp`, `xos_TaskSleep`,
///     `xos_Assert`, `xos_DirForceCaseAny`, `xos_DirClose`, `cfg_GroupDelete`
XOS_HOST_API int xos_HostFail(char const* function, uint32_t skip, uint32_t times);

/// Cancels all requests, including those of `XOS_FAULTS`. That variable, `NAME:SKIP:TIMES,NAME:SKIP:TIMES,...`, is read
/// once, when the library is loaded; an entry of another form or name is reported on standard error and ignored.
XOS_HOST_API void xos_HostFailClear(void);

/* The record of calls */

/// Counts the calls of a function since the start or the last reset, by all threads, including failed calls.
/// \return the number of calls; 0 also if there is no such function
/// \thread the count is exact for every call that ended before this one began
XOS_HOST_API uint64_t xos_HostCalls(char const* function);

/// Forgets all calls: every count becomes 0, and no function has a last call.
XOS_HOST_API void xos_HostCallsReset(void);

/// Returns the arguments of a function's last call by any thread, in the order of its parameters, separated by ", ":
///
/// - texts in double quotes, their bytes unchanged, nothing escaped: `"a/b", "c\d", 1`
/// - numbers, switches and kinds in decimal, with "-" if negative: `0`, `-9`
/// - flags, handles and parameter identifiers in lower-case hexadecimal without leading zeros: `0x600`, `0x0`
/// - addresses of data and of functions in the same form: `0x7ffd12345678`
/// - a null text or address: `null`
///
/// Flags are the `uint32_t flags` of the file and directory functions, the `flags` of `xos_SemNamedMutexCreate` and the
/// `options` of a task. For `xos_TaskCreate` the text contains the seven fields of the parameter block in order (all
/// null and 0 for a null block). For a function without parameters it is empty.
///
///     xos_FileMove("new", "old", 1)        "new", "old", 1
///     xos_DirRemove("tmp/7.r", 1536)       "tmp/7.r", 0x600
///     xos_DirOpenEx("tmp", NULL, 0)        "tmp", null, 0x0
///     xos_SemNamedMutexCreate(264,0,0,&w)  264, 0x0, 0, 0x55d0c0ffee10
///
/// \return null if there is no such function, or if it has not been called since the start or the last reset; otherwise
///     a text that is valid until the calling thread's next `xos_HostLastCall`
/// \thread of calls by different threads, one that happened after another, however the threads synchronised, is the
///     later one. `xos_SemBCreate`, `xos_SemTake`, `xos_SemGive`, `xos_SemDestroy`, `xos_FileReadEx`, `xos_FileGetsEx`,
///     `xos_DirNextEx`, `xos_StrCmp` and `cfg_KeyGetOpt_Bool`, which usually need no system call, are an exception:
///     their calls are ordered only if, between them, a thread or task began or ended, or a last call was queried.
///     Otherwise a call by the querying thread itself counts as the later one
XOS_HOST_API char const* xos_HostLastCall(char const* function);

/* Functions by name */

/// Finds a function by name.
/// \param module  limits the search to one library; null: any
typedef void* (*xos_HostResolver)(void* module, char const* name);

/// Sets the resolver that `xos_BasicsParamLookup` returns for parameter 0xFFFF8006; null makes the parameter unknown,
/// as at the start.
XOS_HOST_API void xos_HostSetResolver(xos_HostResolver resolver);

/* Alerts */

/// Runs the callback of one alert now, on the calling thread, as if it were due. Afterwards the alert waits for the
/// period that the callback returned.
/// \return 0 after the callback has returned; -1 if there is no such alert, or if module `hq_basis` is not the
///     stand-alone one
/// \thread if the callback is running on another thread, the call waits for it first
XOS_HOST_API int xos_HostAlertFire(uint32_t id);

/* Between the stand-alone modules */

/// Records a call on behalf of another module: counts it and stores its arguments.
/// \param arguments  holds one word for each argument; for a text its address
/// \return 1 if the call must fail (the last error is then set), otherwise 0; 0 also if there is no such function
XOS_HOST_API int xos_HostEnter(char const* function, uint64_t const* arguments, uint32_t count);

/// Begins a call of another module in the trace.
/// \param arguments  holds one word for each argument; for a text its address
/// \return what `xos_HostTraceEnd` takes; null without a trace
XOS_HOST_API void* xos_HostTraceBegin(char const* function, uint64_t const* arguments, uint32_t count);

/// Writes a call of another module to the trace.
/// \param traced  is released; null: nothing happens
/// \param hasFailed  tells that the call failed: its line then contains the last error
XOS_HOST_API void xos_HostTraceEnd(void* traced, uint64_t result, int hasFailed);

/// Sets the function that `xos_HostAlertFire` calls; null: none.
XOS_HOST_API void xos_HostOfferAlertFire(int (*fire)(uint32_t id));

#ifdef __cplusplus
}
#endif

#endif
