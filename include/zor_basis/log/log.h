/// \file
/// `Log`: the log of one module.
///
///     Log log("render");
///     log.out("page %d of %s took %.3f s", page, name, seconds);
///
/// **Where.** A log has a folder of its name beneath "tmp/zb_log" in the installation's root folder, made together with the
/// log, and in it a file for each session, "0.log" for the first. Files are appended to. They hold the texts, one a line,
/// and nothing else: no time, no level. On Windows lines end as in every text file there.
///
/// **When.** A line goes into memory, in blocks of 4,096 bytes; no caller of `out` ever waits for a disk. Every 8,192 ms an
/// alert of the platform layer writes out the blocks that are full or belong to an earlier session. The block that is being
/// filled is written once no line has come for 8,192 ms, when the log is closed, and by `flush`. Files are open only while
/// they are written, so they may be read, moved and removed meanwhile.
///
/// **At the end of the process.** A process that ends normally, by a return from `main`, `exit` or on Windows
/// `ExitProcess`, has all its lines in the files, those of static destructors included. A process that ends by a crash, a
/// signal, `TerminateProcess` or on Linux `_exit` loses what was added since the alert last wrote: the lines of the last 8,192 ms,
/// and those before them that still followed each other within 8,192 ms in a block that is not full. Call `flush` where
/// lines must survive that.
///
/// **Failures** are reported by `flush` alone. Lines that the alert cannot write, or that find no memory, are lost. Without
/// an alert a log is switched off.
///
/// \thread  `out`, `newSession` and `flush` are thread-safe; construction, `init` and destruction belong to one thread, while
///     no other uses the log

#ifndef ZOR_BASIS_LOG_LOG_H
#define ZOR_BASIS_LOG_LOG_H

#include "zor_basis/export.h"

/// Has the compiler check arguments against a format text; the numbers count `this`.
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
    /// Switched off: everything does nothing.
    Log() : Log(nullptr) {}
    /// As `init`.
    Log(char const* name);
    Log(Log const&) = delete;
    Log& operator=(Log const&) = delete;
    /// Closes the log: what it holds is written within 8,192 ms, by the alert.
    /// \kept log-01: a log that never got a line nor a new session then ends and takes its alert with it. Any other goes on
    ///     for ever opening its file, writing nothing and closing it, on the alert's thread
    ~Log();

    /// Closes the log and begins another one, in session 0.
    /// \param name  copied; the folder's name, may have several components; null switches the log off
    void init(char const* name);

    /// Adds a line of the text that `printf` would print, whatever the format and the locale.
    /// \param format  the text has at most 1,022 characters: the rest is cut off. It ends at its first zero. Null: nothing
    ///     is added
    /// \cost formatting on the caller's stack, then one short lock for a copy; a block of memory each 4,096 bytes
    void out(char const* format, ...) const ZB_PRINTF_CHECK(2, 3);

    /// What follows goes to the next file.
    /// \kept log-02: a session without a line has its file too, an empty one, unless it is the first
    void newSession();

    /// Writes all lines to their files that have been added so far, and returns when the system has them. Lines that other
    /// threads add meanwhile may be written, too.
    /// \return true also where there is nothing to write, and where the log is switched off. False: a file could not be
    ///     written; its lines stay in memory for the next attempt, part of them may then stand in the file twice
    /// \error the last error says why
    /// \cost the caller waits for the files
    bool flush() const;

private:
    LoggerImpl* logger_ = nullptr;
};

static_assert(sizeof(Log) == sizeof(void*));

} // namespace ZOR_Basis

#endif
