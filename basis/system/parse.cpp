#include "zor_basis/system/parse.h"

#include "basis/files/last_error.h"
#include "basis/system/line_length.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"

#include <algorithm>
#include <cctype>
#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr int LONGEST_EXPECTED = 256;
constexpr int LONGEST_FILE_NAME = 255;

/// In every locale the same characters of ASCII are printable, which are nearly all, and white space.
bool isBlank(char c) {
    if (c > ' ' && c <= '~') return false;
    return c == ' ' || (c >= '\t' && c <= '\r') || std::isspace(static_cast<unsigned char>(c)) != 0;
}

} // namespace

int ZB_Parse::skipBlanks() {
    char last = '\0';
    while (!isDataEnd()) {
        last = data_[position_];
        if (!isBlank(last)) break;
        ++position_;
    }
    return last;
}

ZB_Parse::Line ZB_Parse::readLine(int maximum) {
    skipBlanks();
    std::int32_t const limit = std::max(0, std::min(maximum, size_ - position_));
    if (limit == 0) return {"", 0};
    // kept parse-01: like a line end, the zero is not consumed, and it is not a blank to skip.
    Line const line{data_ + position_, lengthOfLine(data_ + position_, static_cast<std::uint64_t>(limit))};
    position_ += static_cast<std::int32_t>(line.size);
    return line;
}

bool ZB_Parse::getLine(int maximum, char* out, int* length) {
    Line const line = readLine(maximum);
    if (maximum >= 0) {
        std::memcpy(out, line.text, line.size);
        out[line.size] = '\0';
    }
    if (length != nullptr) *length = static_cast<int>(line.size);
    return !isDataEnd() && isEndOfLine(data_[position_]);
}

bool ZB_Parse::checkLine(char const* expected) {
    Line const line = readLine(LONGEST_EXPECTED);
    // kept parse-02: tickets are written by programs, and a line with something behind its keyword is another line.
    if (expected == nullptr) return line.size == 0;
    return std::strlen(expected) == line.size && std::memcmp(expected, line.text, line.size) == 0;
}

bool ZB_Parse::getCleanFileName(FPath& path, bool fileOnly, bool forwardSlashes) {
    skipBlanks();
    if (isDataEnd()) return refuse(Reason::NOT_FOUND);
    Line const line = readLine(LONGEST_FILE_NAME);
    path = Str(line.text, line.size);
    path.translateRoot();
    if (forwardSlashes) path.replaceBackSlashes();
    FStat const entry(path.c_str());
    if (entry.isFile() || (!fileOnly && entry.isDir())) return true;
    if (entry.exist()) refuse(entry.isDir() ? Reason::IS_DIRECTORY : Reason::ALREADY_THERE);
    return false;
}

} // namespace ZOR_Basis
