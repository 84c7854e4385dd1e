/// \file
/// The one kind of `Logger`: lines in memory, files on the alert's thread.

#ifndef BASIS_LOG_LOGGER_IMPL_H
#define BASIS_LOG_LOGGER_IMPL_H

#include "basis/containers/linked_list.h"
#include "basis/ground/choices.h"
#include "basis/platform/hq_basis.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/log/logger.h"
#include "zor_basis/sync/lock.h"
#include "zor_basis/text/heap_str.h"

#include <cstdint>

namespace ZOR_Basis {

class MemMgr;

class LoggerImpl;

/// The neighbours among all loggers.
struct LoggerLinks {
    LoggerImpl* previous = nullptr;
    LoggerImpl* next = nullptr;
};

class LoggerImpl final : public LoggerLinks, public Logger {
public:
    static constexpr std::size_t BLOCK_SIZE = 4096;
    /// Milliseconds between checks for text to write, and of silence before an incomplete block is written.
    static constexpr std::uint32_t PERIOD_MS = 8192;
    /// Bytes that `out` needs behind a line's terminator, whose place the line feed takes.
    static constexpr std::size_t RESERVED = 1;

    /// Starts a logger with its alert and its folders.
    /// \return a logger that deletes itself some time after `close`; null if memory is short or no alert can be made
    static LoggerImpl* start(char const* name);

    void newSession() override;
    void out(char* line) override;
    /// The same for a line whose terminator is known.
    void out(char* line, char* end);
    void close() override;
    /// Unwritten text is lost.
    ~LoggerImpl() override;

    /// Writes the text that exists at the time of the call.
    /// \return false if not all of it was written; the rest is kept, and the last error says why
    bool flush();

    /// Hands over the text that has not been written, without a lock.
    /// \pre no other thread exists
    void writeRest(void (*write)(char const* path, char const* text, std::uint64_t size)) const;

    std::uint32_t alertId() const { return alertId_; }
    /// Tells whether this is a copy in a forked process; the original process writes its lines.
    bool isCopy() const { return isCopy_; }
    void becomeCopy() { isCopy_ = true; }

private:
    struct Buffer {
        Buffer* previous;
        Buffer* next;
        std::uint64_t session;
        std::uint64_t used;
        std::uint64_t flushed;
        char* data;
    };

    /// Text that a thread is writing to its file, without the lock.
    struct Claim {
        Buffer* buffer = nullptr;
        std::uint64_t from = 0;
    };

    explicit LoggerImpl(char const* name);

    static LoggerImpl* ownerOf(HQ_Basis::AlertTimer::Alert const& alert);
    static std::uint32_t tick(HQ_Basis::AlertTimer::Alert const& alert);
    bool writeWhatIsDue();
    bool mustWait(Buffer const* buffer) const;
    void awaitWriter();
    bool writeOut(Buffer& buffer);
    Buffer* firstUnwritten() const;
    std::uint64_t unwritten() const;
    void append(char const* text, std::uint64_t size);
    void newBuffer();
    Buffer* makeBuffer();
    void deleteBuffer(Buffer* buffer);

    LinkedList<Buffer> buffers_;
    MemMgr* nodeMgr_ = nullptr;
    Buffer* current_ = nullptr;
    std::uint64_t session_ = 0;
    HeapStr name_;
    Lock lock_{Lock::Mutex, UNLOCKED};
    bool closing_ = false;
    std::uint32_t alertId_ = 0;
    std::uint32_t lastWrite_ = 0;
    Claim claim_;
    bool isCopy_ = false;
    /// Found at the start, because it cannot be requested at the end of the process.
    FPath folder_;
};

} // namespace ZOR_Basis

#endif
