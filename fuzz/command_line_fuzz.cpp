// Any text as a command line: the words are those that a second reading finds, which looks at one character at a time
// and remembers the backslashes before it.

#include "fuzz/target.h"

#include "basis/system/command_line.h"

#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

bool isBlank(char c) { return c == ' ' || c == '\t'; }

using Words = std::vector<std::string>;

std::size_t readProgram(std::string const& text, Words& words) {
    std::string word;
    bool quoted = false;
    std::size_t i = 0;
    for (; i < text.size(); ++i) {
        if (text[i] == '"') {
            quoted = !quoted;
        } else if (isBlank(text[i]) && !quoted) {
            break;
        } else {
            word += text[i];
        }
    }
    words.push_back(word);
    return i;
}

Words expectedWords(std::string const& text) {
    Words words;
    std::size_t i = readProgram(text, words);
    bool inWord = false;
    bool quoted = false;
    std::size_t backslashes = 0;
    for (; i < text.size(); ++i) {
        char const c = text[i];
        if (isBlank(c) && !quoted) {
            inWord = false;
            backslashes = 0;
            continue;
        }
        if (!inWord) words.emplace_back();
        inWord = true;
        std::string& word = words.back();
        if (c != '"') {
            word += c;
            backslashes = c == '\\' ? backslashes + 1 : 0;
            continue;
        }
        // Half of the backslashes were meant for the double quote.
        word.resize(word.size() - (backslashes + 1) / 2);
        bool const literal = backslashes % 2 != 0;
        backslashes = 0;
        if (literal) {
            word += '"';
        } else if (quoted && i + 1 < text.size() && text[i + 1] == '"') {
            word += '"';
            ++i;
        } else {
            quoted = !quoted;
        }
    }
    return words;
}

void runCommandLine(unsigned char const* data, std::size_t size) {
    std::string text(reinterpret_cast<char const*>(data), size);
    text = text.c_str();
    CommandLine const line(text.c_str());
    require(line.words() != nullptr);
    Words const expected = expectedWords(text);
    require(line.size() == expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i) require(expected[i] == line.words()[i]);
    require(line.words()[expected.size()] == nullptr);
}

FuzzTarget const COMMAND_LINE("command_line", runCommandLine);

} // namespace
