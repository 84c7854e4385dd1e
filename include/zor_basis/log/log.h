/// \file
/// `Log`: the log of one module.
///
///     Log log("render");
///     log.out("page %d of %s took %.3f s", page, name, seconds);
///
/// **Where.** A log has a folder of its name below "tmp/zb_log" in the installation's root folder, made together with
/// the log, and in that folder one file per session, "0.log" for the first. Lines are appended to existing files. A
/// file contains one text per line and nothing else: no time, no level. On Windows lines end as in every text file
/// there.
///
/// **When.** `out` stores a line in memory, in blocks of 4,096 bytes, and never waits for a disk. Every 8,192 ms an
/// alert of the platform layer writes the blocks that are full or belong to an earlier session. The block that is being
/// filled is written when no line has arrived for 8,192 ms, when the log is closed, and by `flush`. Files are open only
/// while they are being written, so they may be read, moved and removed in between;
/// their folder must stay, as only a new `Log` makes it.
///
/// **At the end of the process.** If a process ends normally, by a return from `main`, `exit` or on Windows
/// `ExitProcess`, all its lines are in the files, including those of static destructors. If it ends by a crash, a
/// signal, `TerminateProcess` or on Linux `_exit`, the lines since the alert last wrote are lost: those of the last
/// 8,192 ms, and earlier ones in a block that is not full if they followed each other within 8,192 ms. Call `flush` if
/// lines must survive that.
///
/// **Failures.** Only `flush` reports failures. Lines that the alert cannot write, or for which memory is short, are
/// lost. If no alert can be made, the log is off.
///
/// \thread `out`, `newSession` and `flush` are thread-safe; construction, `init` and destruction require that no other
///     thread uses the log

#ifndef ZOR_BASIS_LOG_LOG_H
#define ZOR_BASIS_LOG_LOG_H

#include "zor_basis/export.h"

/// Makes the compiler check arguments against a format text; the numbers count `this`.
#if defined(__clang__)
#define ZB_PRINTF_CHECK(text, first) __attribute__((format(printf, text, first)))
#elif defined(__GNUC__)
#define ZB_PRINTF_CHECK(text, first) __attribute__((format(gnu_printf, text, first)))
#else
#define ZB_PRINTF_CHECK(text, first)
#endif

namespace ZOR_Basis {

class LoggerImpl;

class ZB_API Log {
public:
    /// Constructs a log that is off: all functions do nothing.
    Log() : Log(nullptr) {}
    /// Constructs a log and calls `init`.
    Log(char const* name);
    Log(Log const&) = delete;
    Log& operator=(Log const&) = delete;
    /// Closes the log. The alert writes the remaining lines within 8,192 ms.
    /// \kept log-01: if a log never got a line or a new session, its logger then ends, and so does the alert. The
    ///     logger of any other log continues forever to open its file, write nothing and close it, on the alert's
    ///     thread
    ~Log();

    /// Closes the log and opens another, in session 0.
    /// \param name  names the folder and may have several components; it is copied. Null switches the log off
    void init(char const* name);

    /// Adds a line with the text that `printf` would print, for every format and in every locale.
    /// \param format  determines the text as for `printf`. The text is cut after 1,022 characters and at its first
    ///     zero. If `format` is null, nothing is added
    /// \cost formats on the caller's stack, then copies under one short lock; allocates a block for every 4,096 bytes
    void out(char const* format, ...) const ZB_PRINTF_CHECK(2, 3);

    /// Begins the next file for all lines that follow.
    /// \kept log-02: a session without a line also has a file, an empty one, unless it is the first session
    void newSession();

    /// Writes all lines added so far to their files and returns when the system has them. Lines that other threads add
    /// meanwhile may also be written.
    /// \return true also if there is nothing to write, and if the log is off. False if a file could not be written: its
    ///     lines stay in memory for the next attempt, after which some of them may be in the file twice
    /// \error the last error says why
    /// \cost waits for the files
    bool flush() const;

private:
    LoggerImpl* logger_ = nullptr;
};

static_assert(sizeof(Log) == sizeof(void*));

} // namespace ZOR_Basis

#endif
