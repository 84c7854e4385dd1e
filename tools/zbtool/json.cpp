#include "tools/zbtool/json.h"

#include "tools/zbtool/utf8.h"

#include <cstdio>

namespace zbtool {
namespace {

constexpr char REPLACEMENT[] = "\xEF\xBF\xBD";

std::string escaped(char c) {
    switch (c) {
    case '"':
        return "\\\"";
    case '\\':
        return "\\\\";
    case '\n':
        return "\\n";
    case '\r':
        return "\\r";
    case '\t':
        return "\\t";
    default:
        break;
    }
    if (static_cast<unsigned char>(c) >= 0x20) return {c};
    char text[8];
    std::snprintf(text, sizeof text, "\\u%04x", static_cast<unsigned>(c));
    return text;
}

class Reader {
public:
    Reader(std::string_view text, JsonMembers& members) : text_(text), members_(members) {}

    bool run() { return take('{') && (take('}') || readMembers()) && isAtEnd(); }
    std::size_t position() const { return at_; }

private:
    bool readMembers() {
        do {
            std::pair<std::string, std::string> member;
            if (!readText(member.first) || !take(':') || !readText(member.second)) return false;
            members_.push_back(std::move(member));
        } while (take(','));
        return take('}');
    }

    bool readText(std::string& out) {
        if (!take('"')) return false;
        while (at_ < text_.size() && text_[at_] != '"') {
            if (static_cast<unsigned char>(text_[at_]) < 0x20) return false;
            if (text_[at_] != '\\')
                out.push_back(text_[at_++]);
            else if (!readEscape(out))
                return false;
        }
        return at_ < text_.size() && text_[at_++] == '"';
    }

    bool readEscape(std::string& out) {
        if (++at_ == text_.size()) return false;
        constexpr std::string_view NAMES = "\"\\/bfnrt";
        constexpr std::string_view MEANT = "\"\\/\b\f\n\r\t";
        char const name = text_[at_++];
        if (name == 'u') return readCodePoint(out);
        std::size_t const index = NAMES.find(name);
        if (index == std::string_view::npos) return false;
        out.push_back(MEANT[index]);
        return true;
    }

    bool readCodePoint(std::string& out) {
        std::uint32_t unit = 0;
        if (!readUnit(unit)) return false;
        if (unit >= 0xDC00 && unit < 0xE000) return false;
        if (unit >= 0xD800 && unit < 0xDC00) {
            std::uint32_t low = 0;
            if (text_.substr(at_, 2) != "\\u") return false;
            at_ += 2;
            if (!readUnit(low) || low < 0xDC00 || low >= 0xE000) return false;
            unit = 0x10000 + ((unit - 0xD800) << 10) + (low - 0xDC00);
        }
        appendUtf8(out, unit);
        return true;
    }

    bool readUnit(std::uint32_t& unit) {
        for (int i = 0; i < 4; ++i, ++at_) {
            constexpr std::string_view DIGITS = "0123456789abcdef";
            if (at_ >= text_.size()) return false;
            char const c = text_[at_];
            std::size_t const digit = DIGITS.find(c >= 'A' && c <= 'F' ? static_cast<char>(c + ('a' - 'A')) : c);
            if (digit == std::string_view::npos) return false;
            unit = unit * 16 + static_cast<std::uint32_t>(digit);
        }
        return true;
    }

    void skipBlanks() {
        while (at_ < text_.size() && std::string_view(" \t\r\n").find(text_[at_]) != std::string_view::npos) ++at_;
    }

    bool take(char c) {
        skipBlanks();
        if (at_ >= text_.size() || text_[at_] != c) return false;
        ++at_;
        return true;
    }

    bool isAtEnd() {
        skipBlanks();
        return at_ == text_.size();
    }

    std::string_view text_;
    JsonMembers& members_;
    std::size_t at_ = 0;
};

} // namespace

std::string jsonText(std::string_view text) {
    std::string out = "\"";
    for (std::size_t i = 0; i < text.size();) {
        std::size_t const size = utf8Length(text.substr(i));
        if (size == 0)
            out += REPLACEMENT;
        else if (size == 1)
            out += escaped(text[i]);
        else
            out += text.substr(i, size);
        i += size == 0 ? 1 : size;
    }
    return out + "\"";
}

JsonObject& JsonObject::addRaw(std::string_view name, std::string_view value) {
    if (!members_.empty()) members_ += ", ";
    members_.append(jsonText(name)).append(": ").append(value);
    return *this;
}

bool readJsonTexts(std::string_view text, JsonMembers& members, std::string& reason) {
    Reader reader(text, members);
    if (reader.run()) return true;
    reason = "not an object of texts, at byte " + std::to_string(reader.position());
    return false;
}

} // namespace zbtool
