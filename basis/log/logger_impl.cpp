#include "basis/log/logger_impl.h"

#include "basis/files/last_error.h"
#include "basis/files/system_calls.h"
#include "basis/log/log_path.h"
#include "basis/log/loggers.h"
#include "basis/memory/never_destroyed.h"
#include "basis/memory/node_memory.h"
#include "basis/platform/xos_basics.h"

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <new>
#include <thread>

namespace ZOR_Basis {
namespace {

using HQ_Basis::AlertTimer;

bool appendToFile(char const* path, char const* text, std::uint64_t size) {
    std::FILE* const file = systemCalls.openStream(path, "a");
    if (file == nullptr) return false;
    RuntimeCall const call;
    bool const isWritten = std::fwrite(text, 1, size, file) == size;
    if (!isWritten) call.fail();
    LastError const reason;
    bool const isClosed = std::fclose(file) == 0;
    if (!isWritten) reason.restore();
    if (isWritten && !isClosed) call.fail();
    return isWritten && isClosed;
}

} // namespace

Loggers& loggers() {
    static NeverDestroyed<Loggers> all;
    return *all;
}

LoggerImpl::LoggerImpl(char const* name) : name_(name) {
    std::lock_guard const held(loggers().mutex);
    loggers().list.append(this);
}

LoggerImpl* LoggerImpl::start(char const* name) {
    auto* const logger = new (std::nothrow) LoggerImpl(name);
    if (logger == nullptr) return nullptr;
    std::uint32_t const id = AlertTimer::New(PERIOD_MS, tick, logger);
    if (id == 0) {
        delete logger;
        return nullptr;
    }
    {
        std::lock_guard const held(loggers().mutex);
        logger->alertId_ = id;
    }
    logger->folder_ = makeLogFolder(logger->name_);
    return logger;
}

LoggerImpl::~LoggerImpl() {
    {
        std::lock_guard const held(loggers().mutex);
        loggers().list.unlink(this);
    }
    while (Buffer* const buffer = buffers_.takeFirst()) deleteBuffer(buffer);
}

void LoggerImpl::newSession() {
    std::lock_guard const held(lock_);
    ++session_;
    newBuffer();
}

void LoggerImpl::out(char* line) { out(line, line + std::strlen(line)); }

void LoggerImpl::out(char* line, char* end) {
    *end++ = '\n';
    *end = '\0';
    std::lock_guard const held(lock_);
    if (current_ == nullptr) newBuffer();
    if (current_ == nullptr) return;
    append(line, static_cast<std::uint64_t>(end - line));
    lastWrite_ = xos_MsCount();
}

void LoggerImpl::close() {
    std::lock_guard const held(lock_);
    closing_ = true;
}

/// \pre there is a current buffer
void LoggerImpl::append(char const* text, std::uint64_t size) {
    std::uint64_t const room = BLOCK_SIZE - current_->used;
    std::uint64_t const here = room <= size ? room : size;
    std::memcpy(current_->data + current_->used, text, here);
    // The end of the process may stop this thread anywhere; the bytes that `used` counts must exist by then.
    std::atomic_signal_fence(std::memory_order_release);
    current_->used += here;
    if (room > size) return;
    newBuffer();
    if (current_ != nullptr) append(text + here, size - here);
}

/// Begins a buffer of the current session; if memory is short, there is no current buffer.
void LoggerImpl::newBuffer() {
    current_ = makeBuffer();
    if (current_ != nullptr) buffers_.append(current_);
}

LoggerImpl::Buffer* LoggerImpl::makeBuffer() {
    auto* const data = static_cast<char*>(std::malloc(BLOCK_SIZE));
    if (data == nullptr) return nullptr;
    auto* const buffer = makeNode<Buffer>(nodeMgr_, nullptr, nullptr, session_, 0u, 0u, data);
    if (buffer == nullptr) std::free(data);
    return buffer;
}

void LoggerImpl::deleteBuffer(Buffer* buffer) {
    std::free(buffer->data);
    deleteNode(nodeMgr_, buffer);
}

/// Deleting an alert reports no failure: one may come once more when its logger is gone.
/// \return null when the alert's logger is gone, also where another one lies in its place
LoggerImpl* LoggerImpl::ownerOf(AlertTimer::Alert const& alert) {
    std::lock_guard const held(loggers().mutex);
    LoggerImpl* logger = loggers().list.first();
    while (logger != nullptr && logger != alert.context) logger = logger->next;
    // An alert may come before the logger knows its id.
    bool const isOwner = logger != nullptr && (logger->alertId_ == alert.id || logger->alertId_ == 0);
    return isOwner ? logger : nullptr;
}

std::uint32_t LoggerImpl::tick(AlertTimer::Alert const& alert) {
    LoggerImpl* const logger = ownerOf(alert);
    if (logger == nullptr || logger->writeWhatIsDue()) {
        delete logger;
        AlertTimer::Delete(alert.id);
    }
    return PERIOD_MS;
}

/// \return whether the logger has come to its end
bool LoggerImpl::writeWhatIsDue() {
    std::lock_guard const held(lock_);
    bool const ends = closing_;
    // kept log-01: nothing delays the current buffer of a closed logger, so it is always the next to be written.
    for (Buffer* buffer = buffers_.first(); buffer != nullptr && !mustWait(buffer);) {
        awaitWriter();
        // Text that cannot be written is lost.
        writeOut(*buffer);
        // Lines may have come meanwhile, this may have become or ceased to be the current buffer, and be written by
        // `flush`.
        if (buffer == current_ || buffer->flushed < buffer->used || buffer == claim_.buffer) continue;
        Buffer* const written = buffer;
        buffer = buffer->next;
        buffers_.unlink(written);
        deleteBuffer(written);
    }
    return ends;
}

bool LoggerImpl::flush() {
    std::unique_lock held(lock_);
    awaitWriter();
    for (std::uint64_t left = unwritten(); left != 0; awaitWriter()) {
        Buffer* const buffer = firstUnwritten();
        if (buffer == nullptr) break; // the alert was faster
        std::uint64_t const from = buffer->flushed;
        left -= std::min(left, buffer->used - from);
        if (writeOut(*buffer)) continue;
        buffer->flushed = from;
        KeepLastError const reason;
        held.unlock();
        return false;
    }
    return true;
}

/// Releases the lock while another thread writes.
/// \pre the lock is held
void LoggerImpl::awaitWriter() {
    while (claim_.buffer != nullptr) {
        lock_.unlock();
        std::this_thread::yield();
        lock_.lock();
    }
}

LoggerImpl::Buffer* LoggerImpl::firstUnwritten() const {
    Buffer* buffer = buffers_.first();
    while (buffer != nullptr && buffer->flushed == buffer->used) buffer = buffer->next;
    return buffer;
}

std::uint64_t LoggerImpl::unwritten() const {
    std::uint64_t size = 0;
    for (Buffer const* buffer = buffers_.first(); buffer != nullptr; buffer = buffer->next) {
        size += buffer->used - buffer->flushed;
    }
    return size;
}

/// Whether the buffer is still being filled.
bool LoggerImpl::mustWait(Buffer const* buffer) const {
    // The count wraps; the difference is correct all the same.
    return buffer == current_ && !closing_ && xos_MsCount() - lastWrite_ < PERIOD_MS;
}

/// Releases the lock while it writes.
/// \pre no other thread writes
// kept log-02: even if there is nothing to write.
bool LoggerImpl::writeOut(Buffer& buffer) {
    char const* const text = buffer.data + buffer.flushed;
    std::uint64_t const size = buffer.used - buffer.flushed;
    std::uint64_t const session = buffer.session;
    bool const claims = size != 0;
    if (claims) claim_ = {&buffer, buffer.flushed};
    buffer.flushed = buffer.used;
    lock_.unlock();
    bool const isWritten = appendToFile(sessionFile(logFolder(name_), session).c_str(), text, size);
    KeepLastError const reason;
    lock_.lock();
    if (claims) claim_ = {};
    lastWrite_ = xos_MsCount();
    return isWritten;
}

// Text that a thread was writing may be written twice, which is better than never.
void LoggerImpl::writeRest(void (*write)(char const* path, char const* text, std::uint64_t size)) const {
    for (Buffer const* buffer = buffers_.first(); buffer != nullptr; buffer = buffer->next) {
        std::uint64_t const from = buffer == claim_.buffer ? claim_.from : buffer->flushed;
        if (from == buffer->used) continue;
        write(sessionFile(folder_, buffer->session).c_str(), buffer->data + from, buffer->used - from);
    }
}

} // namespace ZOR_Basis
