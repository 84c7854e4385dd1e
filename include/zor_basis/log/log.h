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
/// **When.** A line goes into memory, in blocks of 4,096 bytes; no caller ever waits for a disk. Every 8,192 ms an alert of
/// the platform layer writes out the blocks that are full or belong to an earlier session. The block that is being filled is
/// written once no line has come for 8,192 ms, and when the log is closed. Files are open only while they are written, so
/// they may be read, moved and removed meanwhile.
///
/// **Failures** are not reported. What cannot be written, or finds no memory, is lost. Without an alert, which alone
/// could write, a log is switched off.
///
/// \thread  `out` and `newSession` are thread-safe; making, `init` and destruction belong to one thread, while nobody else
///     uses the log

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

class Logger;

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

private:
    Logger* logger_ = nullptr;
};

static_assert(sizeof(Log) == sizeof(void*));

} // namespace ZOR_Basis

#endif
