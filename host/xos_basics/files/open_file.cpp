#include "host/xos_basics/files/open_file.h"

#include "host/xos_basics/last_error.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <new>

namespace host {

namespace {

constexpr std::uint32_t TRUNCATE = 0x01;
constexpr std::uint32_t READ = 0x02;
constexpr std::uint32_t WRITE = 0x04;
constexpr std::uint32_t APPEND = 0x08;
constexpr std::uint32_t CREATE = 0x10;
constexpr std::uint32_t TEXT = 0x20;

constexpr std::size_t BUFFER_SIZE = 32 * 1024;
/// From this size on a read gains nothing from the buffer.
constexpr std::size_t DIRECT_READ = 2048;

} // namespace

bool OpenFile::open(char const* path, std::uint32_t flags) {
    OpenMode mode{};
    mode.read = (flags & READ) != 0;
    mode.append = (flags & APPEND) != 0;
    mode.write = mode.append || (flags & WRITE) != 0;
    mode.create = (flags & CREATE) != 0;
    mode.truncate = (flags & TRUNCATE) != 0;
    // Nothing is emptied or made by a handle that cannot write.
    if (!mode.write && (!mode.read || mode.truncate || mode.create)) {
        setLastError(Error::BAD_ARGUMENT);
        return false;
    }
    text_ = TEXT_LINES_END_IN_CR_LF && (flags & TEXT) != 0;
    return file_.open(path, mode);
}

bool OpenFile::fill() {
    if (buffer_ == nullptr) {
        buffer_.reset(new (std::nothrow) char[BUFFER_SIZE]);
        if (buffer_ == nullptr) {
            setLastError(Error::NO_MEMORY);
            return false;
        }
    }
    std::ptrdiff_t const got = file_.readSome(buffer_.get(), BUFFER_SIZE);
    next_ = 0;
    end_ = got > 0 ? static_cast<std::size_t>(got) : 0;
    return got > 0;
}

std::size_t OpenFile::take(char* to, std::size_t size) {
    std::size_t const count = std::min(size, unread());
    if (count != 0) std::memcpy(to, buffer_.get() + next_, count);
    next_ += count;
    return count;
}

std::size_t OpenFile::read(char* to, std::size_t size) {
    if (text_) return readText(to, size);
    std::size_t done = take(to, size);
    if (size - done >= DIRECT_READ) return done + file_.read(to + done, size - done);
    while (done < size && fill()) { done += take(to + done, size - done); }
    return done;
}

std::size_t OpenFile::write(char const* from, std::size_t size) {
    forgetUnread();
    return text_ ? writeText(from, size) : file_.write(from, size);
}

void OpenFile::forgetUnread() {
    if (unread() == 0) return;
    // A pipe has no position to put back: what was read ahead of it stays to be read.
    if (file_.seek(-static_cast<std::int64_t>(unread()), 1) >= 0) next_ = end_ = 0;
}

bool OpenFile::gets(char* to, std::size_t size) {
    if (size == 0) return false;
    std::size_t done = 0;
    bool ended = false;
    while (!ended && done + 1 < size) {
        if (text_) {
            int const character = nextOfText();
            if (character < 0) break;
            to[done++] = static_cast<char>(character);
            ended = character == '\n';
            continue;
        }
        if (unread() == 0 && !fill()) break;
        std::size_t const most = std::min(size - 1 - done, unread());
        char const* const from = buffer_.get() + next_;
        auto const* const lineEnd = static_cast<char const*>(std::memchr(from, '\n', most));
        ended = lineEnd != nullptr;
        done += take(to + done, ended ? static_cast<std::size_t>(lineEnd - from) + 1 : most);
    }
    to[done] = '\0';
    return done != 0 || size == 1;
}

bool OpenFile::seek(std::int64_t offset, int origin) {
    bool const relative = origin == 1;
    auto const ahead = static_cast<std::int64_t>(unread());
    if (origin < 0 || origin > 2 || (relative && offset < std::numeric_limits<std::int64_t>::min() + ahead)) {
        setLastError(Error::BAD_ARGUMENT);
        return false;
    }
    if (file_.seek(relative ? offset - ahead : offset, origin) < 0) return false;
    next_ = end_ = 0;
    return true;
}

std::int64_t OpenFile::tell() {
    std::int64_t const position = file_.seek(0, 1);
    return position < 0 ? -1 : position - static_cast<std::int64_t>(unread());
}

int OpenFile::nextOfText() {
    if (unread() == 0 && !fill()) return -1;
    char const character = buffer_[next_++];
    if (character == '\r' && (unread() != 0 || fill()) && buffer_[next_] == '\n') {
        ++next_;
        return '\n';
    }
    return static_cast<unsigned char>(character);
}

std::size_t OpenFile::readText(char* to, std::size_t size) {
    std::size_t done = 0;
    for (int character = 0; done < size && (character = nextOfText()) >= 0; ++done) {
        to[done] = static_cast<char>(character);
    }
    return done;
}

std::size_t OpenFile::writeText(char const* from, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        auto const* const lineEnd = static_cast<char const*>(std::memchr(from + done, '\n', size - done));
        std::size_t const line = lineEnd != nullptr ? static_cast<std::size_t>(lineEnd - from) - done : size - done;
        std::size_t const put = file_.write(from + done, line);
        done += put;
        if (put < line) break;
        if (lineEnd == nullptr) continue;
        if (file_.write("\r\n", 2) < 2) break;
        ++done;
    }
    return done;
}

} // namespace host
