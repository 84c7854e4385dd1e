#include "basis/log/logger_impl.h"

#include "basis/files/system_calls.h"
#include "basis/log/log_path.h"
#include "basis/memory/node_memory.h"
#include "basis/platform/xos_basics.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <new>

namespace ZOR_Basis {
namespace {

using HQ_Basis::AlertTimer;

/// Deleting an alert reports no failure: one may come once more when its logger is gone.
struct Loggers {
    std::mutex mutex;
    LinkedList<LoggerImpl> list;

    static Loggers& all() {
        // Never destroyed: alerts go on while the process ends.
        alignas(Loggers) static unsigned char memory[sizeof(Loggers)];
        static auto* const kept = new (memory) Loggers;
        return *kept;
    }
};

/// \error what cannot be written is lost
void appendToFile(char const* path, char const* text, std::uint64_t size) {
    std::FILE* const file = systemCalls.openStream(path, "a");
    if (file == nullptr) return;
    std::fwrite(text, 1, size, file);
    std::fclose(file);
}

} // namespace

Logger::~Logger() = default;

LoggerImpl::LoggerImpl(char const* name) : name_(name) {
    Loggers& all = Loggers::all();
    std::lock_guard const held(all.mutex);
    all.list.append(this);
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
        std::lock_guard const held(Loggers::all().mutex);
        logger->alertId_ = id;
    }
    logPath(logger->name_, logger->session_, true);
    return logger;
}

LoggerImpl::~LoggerImpl() {
    {
        Loggers& all = Loggers::all();
        std::lock_guard const held(all.mutex);
        all.list.unlink(this);
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
    current_->used += here;
    if (room > size) return;
    newBuffer();
    if (current_ != nullptr) append(text + here, size - here);
}

/// Begins a buffer of the present session, or leaves none current where memory is short.
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

/// \return null when the alert's logger is gone, also where another one lies in its place
LoggerImpl* LoggerImpl::ownerOf(AlertTimer::Alert const& alert) {
    Loggers& all = Loggers::all();
    std::lock_guard const held(all.mutex);
    LoggerImpl* logger = all.list.first();
    while (logger != nullptr && logger != alert.context) logger = logger->next;
    // An alert may come before the logger knows its id.
    bool const isOwner = logger != nullptr && (logger->alertId_ == alert.id || logger->alertId_ == 0);
    return isOwner ? logger : nullptr;
}

std::uint32_t LoggerImpl::tick(AlertTimer::Alert const& alert) {
    LoggerImpl* const logger = ownerOf(alert);
    if (logger == nullptr || logger->flush()) {
        delete logger;
        AlertTimer::Delete(alert.id);
    }
    return PERIOD_MS;
}

/// \return whether the logger has come to its end
bool LoggerImpl::flush() {
    std::lock_guard const held(lock_);
    bool const ends = closing_;
    // kept log-01: nothing keeps back the current buffer of a closed logger, so it is always the next to be written.
    for (Buffer* buffer = buffers_.first(); buffer != nullptr && !mustWait(buffer);) {
        writeOut(*buffer);
        // Lines may have come meanwhile, and this may have become or ceased to be the current buffer.
        if (buffer == current_ || buffer->flushed < buffer->used) continue;
        Buffer* const written = buffer;
        buffer = buffer->next;
        buffers_.unlink(written);
        deleteBuffer(written);
    }
    return ends;
}

/// Whether the buffer is still being filled.
bool LoggerImpl::mustWait(Buffer const* buffer) const {
    // The count wraps; the difference does not mind.
    return buffer == current_ && !closing_ && xos_MsCount() - lastWrite_ < PERIOD_MS;
}

/// Releases the lock while it writes.
// kept log-02: also where there is nothing to write.
void LoggerImpl::writeOut(Buffer& buffer) {
    char const* const text = buffer.data + buffer.flushed;
    std::uint64_t const size = buffer.used - buffer.flushed;
    std::uint64_t const session = buffer.session;
    buffer.flushed = buffer.used;
    lock_.unlock();
    appendToFile(logPath(name_, session, false).c_str(), text, size);
    lock_.lock();
    lastWrite_ = xos_MsCount();
}

} // namespace ZOR_Basis
