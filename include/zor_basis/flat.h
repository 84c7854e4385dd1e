/// \file
/// The plain functions, for callers that do not use the classes. C-clean, C linkage.

#ifndef ZOR_BASIS_FLAT_H
#define ZOR_BASIS_FLAT_H

#include "zor_basis/export.h"
#include "zor_basis/timers/timer_dat.h"

#include <stdbool.h>
#include <stdint.h>

/// A copy of a zero-terminated text in a block of its own.
/// \return the copy, owned by the caller, who releases it with the runtime's `free`; null for null, and where memory
///         is short
/// \thread any
ZB_EXTERN_C ZB_API char* ZB_StrDup(char const* text);

/// The place behind the last slash, of either kind.
/// \return a pointer into the text; null without a slash and for null
/// \thread any
ZB_EXTERN_C ZB_API char const* ZB_baseNamePosition(char const* text);

/// Turns every "\" into "/", in place. Null does nothing.
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes(char* text);

/// Copies a text with every "\" turned into "/", terminator included.
/// \pre neither is null; `target` has room for the whole text and may be the source itself
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes2(char const* source, char* target);

/// Writes a text with its percent escapes decoded, terminator included. The two characters behind a "%" are always
/// taken, one that is no hexadecimal digit as 0: "%g1" gives the byte 1, and "%zz" a zero, which ends the text for
/// whoever reads it as one. "+" stays "+".
/// \param out  room for as many bytes as the source has; may be the source itself
/// \pre a "%" has two characters behind it: where it is among the last two bytes of the text, the terminator is taken
///      for a digit and what lies behind it is read and decoded
/// \return 0, without a meaning
/// \thread any
ZB_EXTERN_C ZB_API int ZB_resolveURIEscapes(char const* in, char* out);

/// Runs a command in the system's command interpreter, in a directory: `cd DIRECTORY& COMMAND`. Where the interpreter cannot
/// be started it is tried again, five times in all with 500 ms after each.
/// \param command    taken as it stands, with all that is special to the interpreter; null and empty run nothing
/// \param directory  taken as it stands, up to the first "& " in it
/// \param noResult   true: the platform layer is asked for no exit code; stand-alone this does not wait for the command
/// \kept flat-03: a null or empty directory leaves a "cd" without an argument: "cd & COMMAND"
/// \return whether the interpreter was started, whatever became of the command
/// \error after a false the last error says why (docs/reasons.md)
/// \thread any; the calling one waits
ZB_EXTERN_C ZB_API bool ZB_runCommand(char const* command, char const* directory, bool noResult);

/* The kinds of variable-data input: VPS, QDB, VIPP and PPML, as the configuration group "vdp" switches them on by its keys
   "vps", "qdb", "vipp" and "ppml". All results are 1 or 0. Any thread may ask at any time. */

/// Reads the configuration, anew if it has been read before.
/// \kept flat-05: without the group every kind is on, while a key that the group lacks switches its kind off
/// \return 0, without a meaning
ZB_EXTERN_C ZB_API int setVDPFlagsFromCFG(void);
/// Whether the configuration has been read, or looked for at least.
ZB_EXTERN_C ZB_API int isVDPFlagsSetFromCFG(void);
/// Whether one kind is on; reads the configuration if that has not been done yet.
ZB_EXTERN_C ZB_API int isVPSON(void);
ZB_EXTERN_C ZB_API int isQDBON(void);
ZB_EXTERN_C ZB_API int isVIPPON(void);
ZB_EXTERN_C ZB_API int isPPMLON(void);
/// Whether any kind is on.
/// \kept flat-04: does not read the configuration: 0 until one of the others has
ZB_EXTERN_C ZB_API int isVDPON(void);

/* Timers. Null arguments do nothing, and give null where there is a result. Flags: 0 is false, all else true. */

/// Opaque here; the classes of `zor_basis/timers.h`.
#ifdef __cplusplus
namespace ZOR_Basis {
class PileTimer;
class TimerMgr;
} // namespace ZOR_Basis
typedef ZOR_Basis::PileTimer zbPileTimer;
typedef ZOR_Basis::TimerMgr zbTimerMgr;
#else
typedef struct zbPileTimer zbPileTimer;
typedef struct zbTimerMgr zbTimerMgr;
#endif

/// Starts a measurement in a record of the caller's, whatever the record held.
/// \kept flat-01: a measurement that runs is lost and starts anew, where `BaseTimer::start` keeps it
/// \param suspended  begins suspended
/// \thread one thread at a time for each record, here and below
ZB_EXTERN_C ZB_API void zbTimerBaseStart(zbTimerDat* measurement, int suspended);
/// Ends a started measurement, piles it and makes the record idle.
/// \kept flat-02: without a pile the measurement goes on
/// \thread many threads may stop records of their own into one pile of `zbTimerMgrCreateMT`
ZB_EXTERN_C ZB_API void zbTimerBaseStop(zbTimerDat* measurement, zbPileTimer* pile);
/// Opens a suspension, unless one is open.
ZB_EXTERN_C ZB_API void zbTimerBaseSuspend(zbTimerDat* measurement);
/// Ends the suspension, if one is open.
ZB_EXTERN_C ZB_API void zbTimerBaseResume(zbTimerDat* measurement);

/// `PileTimer::start(false)`, `stop()`, `suspend()` and `resume()`, with their complaints about misuse.
/// \thread one thread at a time for each timer
ZB_EXTERN_C ZB_API void zbTimerStart(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerStop(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerSuspend(zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerResume(zbPileTimer* timer);

/// Makes a manager, inactive at first; it lives as long as the process. Timers with ids of their own take those up to
/// `maxId`. \thread any
ZB_EXTERN_C ZB_API zbTimerMgr* zbTimerMgrNew(char const* name, uint64_t maxId);
/// The first manager of that name; null if there is none. \thread any
ZB_EXTERN_C ZB_API zbTimerMgr* zbTimerMgrGetMgr(char const* name);
/// Makes a timer, owned by its manager. \param id  0: the next behind the last \thread any, while nobody looks timers up
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrCreate(zbTimerMgr* manager, char const* name, uint64_t id);
/// The same for a pile that many threads feed.
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrCreateMT(zbTimerMgr* manager, char const* name, uint64_t id);
/// The timer of an id; null if there is none. \thread any, while nobody creates
ZB_EXTERN_C ZB_API zbPileTimer* zbTimerMgrGet(zbTimerMgr* manager, uint64_t id);
/// Switches a manager on or off. \thread any
ZB_EXTERN_C ZB_API void zbTimerMgrSetActive(zbTimerMgr* manager, int active);
/// Resets all timers of an active manager. \param print  writes their report first \thread any
ZB_EXTERN_C ZB_API void zbTimerMgrReset(zbTimerMgr* manager, int print);

/// `zbTimerStart` and the others, while the manager is active. The timer may be another manager's.
/// \thread one thread at a time for each timer
ZB_EXTERN_C ZB_API void zbTimerMgrStart(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrStop(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrSuspend(zbTimerMgr* manager, zbPileTimer* timer);
ZB_EXTERN_C ZB_API void zbTimerMgrResume(zbTimerMgr* manager, zbPileTimer* timer);

/* Further plain functions take paths and visitors: `zbFindFile`, `zbCheckRemoveFileDir`, `zbLinkOrCopy`. */
#ifdef __cplusplus
#include "zor_basis/walk/file_delete_visitor.h"
#include "zor_basis/walk/find_file_visit.h"
#include "zor_basis/walk/link_or_copy.h"
#endif

#endif
