// The sibling is process_end_posix.cpp. What the logs hold is written when the process ends.

#include "basis/log/logger_impl.h"
#include "basis/log/loggers.h"
#include "basis/platform/windows_api_win.h"

namespace ZOR_Basis {
namespace {

/// Where text files have CR LF. \return the end of what was stored
char* storeLines(char* to, char const* text, std::uint64_t size) {
    for (char const* const end = text + size; text != end; ++text) {
        if (*text == '\n') *to++ = '\r';
        *to++ = *text;
    }
    return to;
}

/// Uses the system alone: the runtime library's locks may be held by threads that are gone.
void append(char const* path, char const* text, std::uint64_t size) {
    HANDLE const file = CreateFileA(path, FILE_APPEND_DATA, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE,
                                    nullptr, OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) return;
    char lines[2 * LoggerImpl::BLOCK_SIZE];
    DWORD written = 0;
    WriteFile(file, lines, static_cast<DWORD>(storeLines(lines, text, size) - lines), &written, nullptr);
    CloseHandle(file);
}

/// When the library ends, the other threads of the process have ended already, and the locks that they held stay taken.
struct AtEnd {
    ~AtEnd() {
        for (LoggerImpl const* logger = loggers().list.first(); logger != nullptr; logger = logger->next) {
            logger->writeRest(append);
        }
    }
} const atEnd;

} // namespace
} // namespace ZOR_Basis
