/// \file
/// What the stand-alone platform layer offers beyond the platform interface: where its root and its configuration lie,
/// who hears assertions, failures on demand, and a record of every call. C-clean; module `xos_basics`.
///
/// The stand-alone layer takes the place of the server's modules for tests, tools and demonstrations. Everything here is
/// thread-safe, always compiled in and always on: counting a call and keeping its arguments costs about a nanosecond.
///
/// Environment, read by the library: `XOS_ROOT` (the root of the file system), `XOS_CONFIG` (the folder of the
/// configuration groups), `XOS_FAULTS` (failures to inject from the start).
///
/// Functions are named by the text of their C name (`"xos_FileMove"`, `"cfg_GroupDelete"`), the two of module `hq_basis`
/// by `"HQ_Basis::AlertTimer::New"` and `"HQ_Basis::AlertTimer::Delete"`.

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

/// Sets what `xos_FileSystemRoot` answers.
/// \param path  copied as it is; null or empty: back to `XOS_ROOT`, and to the empty text where that is not set
XOS_HOST_API void xos_HostSetRoot(char const* path);

/// Sets the folder in which `cfg_GroupLoadFromFile` looks for `NAME.cfg`.
/// \param path  copied as it is; null or empty: back to `XOS_CONFIG`, and to the root's folder "config" where that is
///              not set
XOS_HOST_API void xos_HostSetConfigDir(char const* path);

/* Assertions */

/// Hears an assertion, on the thread that raised it. The texts are borrowed for the call.
typedef void (*xos_HostAssertHandler)(int line, char const* module, char const* message, void* context);

/// Replaces the line that `xos_Assert` writes to standard error by a call of `handler`; null: back to that line.
/// \pre the handler and its context live until it is replaced and no assertion that began before is still running
XOS_HOST_API void xos_HostSetAssertHandler(xos_HostAssertHandler handler, void* context);

/* Failures on demand */

/// Makes a function fail: its next `skip` calls are good, the `times` calls after them fail, and those after them are
/// good again. A call that fails so does nothing (only a failed close still closes) and returns its function's failure
/// value: non-zero for `int` results (for `xos_BasicsParamLookup` below 1), 0 for handles, counts and pointers, all ones
/// for `xos_TaskCreate`, -1 for `xos_FileTellEx`, the fallback for `cfg_KeyGetOpt_Bool`, the empty text for
/// `xos_FileSystemRoot`; `HQ_Basis::AlertTimer::Delete` leaves the alert as it is. The last error is EIO (errno), on
/// Windows 31 (GetLastError).
/// \param skip   calls are counted over all threads
/// \param times  0: the function no longer fails. A later request replaces an earlier one of the same function.
/// \return 0; -1: there is no such function, or it is one that cannot fail: `xos_MsCount`, `xos_StrCmp`,
///         `xos_TaskSleep`, `xos_Assert`, `xos_DirForceCaseAny`, `xos_DirClose`, `cfg_GroupDelete`
XOS_HOST_API int xos_HostFail(char const* function, uint32_t skip, uint32_t times);

/// Takes all requests back, those of `XOS_FAULTS` too. That variable, `NAME:SKIP:TIMES,NAME:SKIP:TIMES,...`, is read once,
/// when the library is loaded; an entry of another form or name is reported on standard error and left out.
XOS_HOST_API void xos_HostFailClear(void);

/* The record of calls */

/// The calls of a function since the start or the last reset, by all threads, failed ones included.
/// \return 0 also when there is no such function
/// \thread exact for every call that ended before this one began
XOS_HOST_API uint64_t xos_HostCalls(char const* function);

/// Forgets all calls: every count is 0 and no function has a last call.
XOS_HOST_API void xos_HostCallsReset(void);

/// The arguments of a function's last call, by whatever thread, in the order of its parameters, separated by ", ":
///
/// - texts in double quotes, their bytes as they are, nothing escaped: `"a/b", "c\d", 1`
/// - numbers, switches and kinds in decimal, with "-" where they are negative: `0`, `-9`
/// - flags, handles and parameter identifiers in hexadecimal, lower case, without leading zeros: `0x600`, `0x0`
/// - addresses of data and of functions likewise: `0x7ffd12345678`
/// - a null text or address: `null`
///
/// Flags are the `uint32_t flags` of the file and directory functions, the `flags` of `xos_SemNamedMutexCreate` and the
/// `options` of a task. The record of `xos_TaskCreate` gives the seven fields of its parameter block in their order (all
/// null and 0 for a null block). A function without parameters gives the empty text.
///
///     xos_FileMove("new", "old", 1)        "new", "old", 1
///     xos_DirRemove("tmp/7.r", 1536)       "tmp/7.r", 0x600
///     xos_DirOpenEx("tmp", NULL, 0)        "tmp", null, 0x0
///     xos_SemNamedMutexCreate(264,0,0,&w)  264, 0x0, 0, 0x55d0c0ffee10
///
/// \return null: no such function, or no call of it since the start or the last reset; else a text that is valid until
///         the calling thread's next `xos_HostLastCall`
/// \thread of calls that ended before this one began, the one that was made last. Only of `xos_SemTake` and `xos_SemGive`,
///         which cost less than reading a clock: calls of two threads have an order where a semaphore, a start or end of a
///         thread or task, a question for a last call, or another function that both call came between them.
XOS_HOST_API char const* xos_HostLastCall(char const* function);

/* Functions by name */

/// Finds a function by name. \param module  null: any
typedef void* (*xos_HostResolver)(void* module, char const* name);

/// Sets what `xos_BasicsParamLookup` answers for parameter 0xFFFF8006; null: the parameter is unknown, as at the start.
XOS_HOST_API void xos_HostSetResolver(xos_HostResolver resolver);

/* Alerts */

/// Runs the callback of one alert now, on the calling thread, as if its time had come: afterwards the alert waits for
/// the period that the callback returned.
/// \return 0 when the callback has returned; -1: no such alert, or module `hq_basis` is not the stand-alone one
/// \thread while the callback already runs elsewhere: waits for it first
XOS_HOST_API int xos_HostAlertFire(uint32_t id);

/* Between the stand-alone modules */

/// Counts a call of a function of another module and remembers its arguments; that module's own record, as it were.
/// \param arguments  one word an argument; a text by its address
/// \return 1 when the call is to fail (the last error is then set), else 0; 0 also when there is no such function
XOS_HOST_API int xos_HostEnter(char const* function, uint64_t const* arguments, uint32_t count);

/// Says what `xos_HostAlertFire` calls; null: nothing.
XOS_HOST_API void xos_HostOfferAlertFire(int (*fire)(uint32_t id));

#ifdef __cplusplus
}
#endif

#endif
