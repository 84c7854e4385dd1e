/// \file
/// A naive model of the strings with an inside area: their content, their capacity, and whether they are on the heap.
/// Every rule is written out over plain standard strings.

#ifndef TESTS_TEXT_TEXT_MODEL_H
#define TESTS_TEXT_TEXT_MODEL_H

#include <algorithm>
#include <cstdint>
#include <string>

/// A source: its units, which a zero follows, and the length that the caller gives.
template <class Char>
struct ModelSource {
    std::basic_string<Char> units;
    std::uint64_t length;

    bool empty() const { return units.empty() || units[0] == Char(); }
    std::uint64_t taken() const {
        if (empty()) return 0;
        return length != 0 ? length : std::min(units.find(Char()), units.size());
    }
};

template <class Char>
class TextModel {
public:
    using Text = std::basic_string<Char>;

    explicit TextModel(std::uint64_t inside) : capacity(inside) {}

    /// At most n units of a text up to its first zero, then zeros up to n units.
    static Text stopAndPad(Text const& units, std::uint64_t n) {
        Text result;
        for (std::uint64_t i = 0; i < n && i < units.size() && units[i] != Char(); ++i) result += units[i];
        result.resize(n);
        return result;
    }
    static Text copied(ModelSource<Char> const& source) { return stopAndPad(source.units, source.taken()); }

    void grow(std::uint64_t need, std::uint64_t keep) {
        std::uint64_t const required = std::max(need, keep + 1);
        if (required <= capacity) return;
        content = stopAndPad(content, keep);
        capacity = required;
        onHeap = true;
    }
    void assign(ModelSource<Char> const& source) {
        std::uint64_t const length = source.taken();
        Text const text = copied(source);
        if (length != 0) grow(length, length);
        content = text;
    }
    void append(ModelSource<Char> const& source) {
        if (source.empty()) return;
        Text const text = copied(source);
        grow(content.size() + text.size(), content.size());
        content += text;
    }
    void append(Char unit) {
        if (unit != Char()) append({Text(1, unit), 1});
    }
    void replace(std::uint64_t position, std::uint64_t count, ModelSource<Char> const& source) {
        if (position > content.size()) return;
        if (position == content.size()) return append(source);
        Text const text = copied(source);
        content.replace(position, count, text);
        if (content.size() > capacity) {
            capacity = content.size();
            onHeap = true;
        }
    }
    void insert(std::uint64_t position, ModelSource<Char> const& source) { replace(position, 0, source); }
    void replaceTail(std::uint64_t position, ModelSource<Char> const& source) {
        if (position < content.size()) content.resize(position);
        append(source);
    }
    void extend(std::uint64_t n) { grow(n, content.size()); }
    void cut(std::uint64_t n) {
        if (n < content.size()) content.resize(n);
    }
    /// Follows a direct write into the buffer, with a zero behind the units where there is room.
    void written(Text const& units, std::uint64_t n) {
        std::uint64_t length = std::min<std::uint64_t>(units.find(Char()), units.size());
        length = std::min(length, capacity);
        content = units.substr(0, n != 0 ? std::min(n, length) : length);
    }
    void nextLatin() {
        if (content.empty()) return append(Char('a'));
        std::uint64_t place = content.size();
        while (place > 0 && content[place - 1] == Char('z')) content[--place] = Char('a');
        if (place == 0) {
            append(Char('a'));
        } else {
            content[place - 1] = static_cast<Char>(content[place - 1] + 1);
        }
    }

    Text content;
    std::uint64_t capacity;
    bool onHeap = false;
};

#endif
