/// \file
/// The plain functions, for callers that do not use the classes. Valid C, with C linkage.

#ifndef ZOR_BASIS_FLAT_H
#define ZOR_BASIS_FLAT_H

#include "zor_basis/export.h"
#include "zor_basis/timers/timer_dat.h"

#include <stdbool.h>
#include <stdint.h>

/// Copies a zero-terminated text into a block of its own.
/// \return the copy, which the caller owns and releases with the runtime's `free`; null for null, and if memory is
///     short
/// \thread any
ZB_EXTERN_C ZB_API char* ZB_StrDup(char const* text);

/// Finds the place after the last slash of either kind.
/// \return a pointer into the text; null without a slash and for null
/// \thread any
ZB_EXTERN_C ZB_API char const* ZB_baseNamePosition(char const* text);

/// Replaces every "\" by "/", in place. Null does nothing.
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes(char* text);

/// Copies a text, including its terminator, and replaces every "\" by "/".
/// \pre neither pointer is null; `target` has room for the whole text and may be the source itself
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes2(char const* source, char* target);

/// Writes a text, including its terminator, with its percent escapes decoded. The two characters after a "%" are always
/// consumed; one that is not a hexadecimal digit counts as 0: "%g1" gives the byte 1, and "%zz" a zero, which ends the
/// text for readers that expect a zero-terminated one. "+" stays "+".
/// \param out  has room for as many bytes as the source has; may be the source itself
/// \pre two characters follow every "%": if a "%" is among the last two bytes of the text, the terminator counts as a
///     digit, and the bytes behind it are read and decoded
/// \return 0, without a meaning
/// \thread any
ZB_EXTERN_C ZB_API int ZB_resolveURIEscapes(char const* in, char* out);

/// Runs a command in the system's command interpreter, in a directory: `cd DIRECTORY& COMMAND`. If the interpreter
/// cannot be started, the function tries five times in all and waits 500 ms after each try.
/// \param command  is passed unchanged, including characters that are special to the interpreter; null or empty runs
///     nothing
/// \param directory  is passed unchanged, up to the first "& " in it
/// \param noResult  tells the platform layer not to return an exit code; the stand-alone layer then does not wait for
///     the command
/// \kept flat-03: a null or empty directory leaves a "cd" without an argument: "cd & COMMAND"
/// \return whether the interpreter was started, regardless of the command's result
/// \error if the result is false the last error says why (docs/reasons.md)
/// \thread any; the calling thread waits
ZB_EXTERN_C ZB_API bool ZB_runCommand(char const* command, char const* directory, bool noResult);

/* The kinds of variable-data input: VPS, QDB, VIPP and PPML. The keys "vps", "qdb", "vipp" and "ppml" of the
   configuration group "vdp" switch them on. All results are 1 or 0. All functions are thread-safe. */

/// Reads the configuration, again if it has been read before.
/// \kept flat-05: if the group is missing every kind is on, but a key that is missing from an existing group switches
///     its kind off
/// \return 0, without a meaning
ZB_EXTERN_C ZB_API int setVDPFlagsFromCFG(void);
/// Tells whether the configuration has been read, or at least searched for.
ZB_EXTERN_C ZB_API int isVDPFlagsSetFromCFG(void);
/// Tell whether one kind is on; they read the configuration if that has not been done.
ZB_EXTERN_C ZB_API int isVPSON(void);
ZB_EXTERN_C ZB_API int isQDBON(void);
ZB_EXTERN_C ZB_API int isVIPPON(void);
ZB_EXTERN_C ZB_API int isPPMLON(void);
/// Tells whether any kind is on.
/// \kept flat-04: this function does not read the configuration: the result is 0 until another one has read it
ZB_EXTERN_C ZB_API int isVDPON(void);

/* Timers. A null argument makes a function do nothing and return null, if it returns anything. Flags: 0 is false, any
   other value true. */

// Opaque in C; in C++ the classes of `zor_basis/timers.h`.
#ifdef __cplusplus
namespace ZOR_Basis {
class PileTimer;
class TimerMgr;
} // namespace ZOR_Basis
/// A pile timer and a manager of timers; callers have only their addresses.
typedef ZOR_Basis::PileTimer zbPileTimer;
typedef ZOR_Basis::TimerMgr zbTimerMgr;
#else
typedef struct zbPileTimer zbPileTimer;
typedef struct zbTimerMgr zbTimerMgr;
#endif

/// Starts a measurement in the caller's record, whatever the record contained.
/// \kept flat-01: a running measurement is discarded and restarted, whereas `BaseTimer::start` keeps it
/// \param suspended  starts the measurement suspended
/// \thread one thread at a time for each record, here and below
ZB_EXTERN_C ZB_API void zbTimerBaseStart(zbTimerDat* measurement, int suspended);
/// Ends a started measurement, adds it to the pile and makes the record idle.
/// \kept flat-02: without a pile the measurement continues
/// \thread many threads may stop their own records into one pile of `zbTimerMgrCreateMT`
ZB_EXTERN_C ZB_API void zbTimerBaseStop(zbTimerDat* measurement, zbPileTimer* pile);
/// Opens a suspension, unless one is open.
ZB_EXTERN_C ZB_API void zbTimerBaseSuspend(zbTimerDat* measurement);
/// Ends the suspension, if one is open.
ZB_EXTERN_C ZB_API void zbTimerBaseResume(zbTimerDat* measurement);

/// Call `PileTimer::start(false)`, `stop()`, `suspend()` and `resume()`, which report misuse.
/// \thread one thread at a time for each timer
ZB_EXTERN_C ZB_API void zbTimerStart(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerStop(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerSuspend(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerResume(zbPileTimer* timer);

/// Makes a manager, which is inactive at first and lives as long as the process. Ids up to `maxId` are reserved for
/// timers with ids of their own.
/// \thread any
ZB_EXTERN_C ZB_API zbTimerMgr* zbTimerMgrNew(char const* name, uint64_t maxId);
/// Returns the first manager of that name; null if there is none.
/// \thread any
ZB_EXTERN_C ZB_API zbTimerMgr* zbTimerMgrGetMgr(char const* name);
/// Makes a timer, owned by its manager.
/// \param id  selects the slot; 0: the slot after the last
/// \thread any, while no thread looks timers up
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrCreate(zbTimerMgr* manager, char const* name, uint64_t id);
/// The same for a pile that many threads may feed.
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrCreateMT(zbTimerMgr* manager, char const* name, uint64_t id);
/// Returns the timer of an id; null if there is none.
/// \thread any, while no thread creates a timer
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrGet(zbTimerMgr* manager, uint64_t id);
/// Switches a manager on or off.
/// \thread any
ZB_EXTERN_C ZB_API void zbTimerMgrSetActive(zbTimerMgr* manager, int active);
/// Resets all timers of an active manager.
/// \param print  writes their report first
/// \thread any
ZB_EXTERN_C ZB_API void zbTimerMgrReset(zbTimerMgr* manager, int print);

/// Call `zbTimerStart` and the others if the manager is active. The timer may belong to another manager.
/// \thread one thread at a time for each timer
ZB_EXTERN_C ZB_API void zbTimerMgrStart(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrStop(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrSuspend(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrResume(zbTimerMgr* manager, zbPileTimer* timer);

/* Further plain functions use paths: `zbFindFile`, `zbCheckRemoveFileDir`, `zbLinkOrCopy`. */
#ifdef __cplusplus
#include "zor_basis/walk/file_delete_visitor.h"
#include "zor_basis/walk/find_file_visit.h"
#include "zor_basis/walk/link_or_copy.h"
#endif

#endif
