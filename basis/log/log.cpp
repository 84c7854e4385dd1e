#include "zor_basis/log/log.h"

#include "basis/log/line_text.h"
#include "basis/log/logger_impl.h"

#include <cstddef>

namespace ZOR_Basis {
namespace {

constexpr std::size_t LINE_ROOM = 1024;
constexpr std::size_t TEXT_ROOM = LINE_ROOM - LoggerImpl::RESERVED;

} // namespace

Log::Log(char const* name) { init(name); }

Log::~Log() { init(nullptr); }

void Log::init(char const* name) {
    if (logger_ != nullptr) logger_->close();
    logger_ = name != nullptr ? LoggerImpl::start(name) : nullptr;
}

void Log::out(char const* format, ...) const {
    if (logger_ == nullptr || format == nullptr) return;
    char line[LINE_ROOM];
    LineArguments arguments;
    va_start(arguments.list, format);
    char* end = writeLineText(line, TEXT_ROOM, format, arguments);
    va_end(arguments.list);
    if (end == nullptr) {
        va_start(arguments.list, format);
        end = writeAnyLineText(line, TEXT_ROOM, format, arguments);
        va_end(arguments.list);
    }
    logger_->out(line, end);
}

void Log::newSession() {
    if (logger_ != nullptr) logger_->newSession();
}

bool Log::flush() const { return logger_ == nullptr || logger_->flush(); }

} // namespace ZOR_Basis
