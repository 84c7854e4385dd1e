// A tour of the text types: which one to take for what, and what each does that others do not.

#include <zor_basis/text.h>

#include <cstdio>

using namespace ZOR_Basis;

namespace {

// Interfaces take a view: any of the text types, a literal or a std::string goes in, and nothing is copied.
void show(char const* what, Str const& text) {
    std::printf("  %-34s \"%s\" (%d bytes)\n", what, text.c_str(), int(text.size()));
}

void shortText() {
    std::puts("BufStr<15> keeps short text inside the object:");
    BufStr<15> name("job");
    name << "-" << 42;
    show("built by appending", name);
    std::printf("  %-34s %d bytes inline\n", "its room", int(name.sizeBuf()));
    name += "-with-a-longer-name";
    std::printf("  %-34s %d bytes on the heap\n", "once it has outgrown that", int(name.sizeBuf()));
    show("nothing is ever cut", name);
}

void editing() {
    std::puts("BufStr<255> is for paths and lines:");
    BufStr<255> line("page.tif");
    line.insert(4, "-0001");
    show("insert", line);
    line.replace(0, 4, "cover");
    show("replace", line);
    line.replaceTail(line.size() - 3, "pdl");
    show("replaceTail", line);
    BufStr<15> counter("az");
    counter.NextLatin();
    show("NextLatin counts in letters", counter);
}

void storing() {
    std::puts("HeapStr stores text for long, without a byte to spare:");
    HeapStr const owner(Str("operator", 8));
    show("from a view", owner);
}

bool converting() {
    std::puts("Convert goes between the narrow encodings and wide text:");
    WBStr wide;
    BufStr<255> narrow;
    bool const good = Convert::Utf8ToWide("Gr\xC3\xBC\xC3\x9F"
                                          "e",
                                          wide) &&
                      Convert::WideToUtf8(wide, narrow);
    std::printf("  %-34s %d code units\n", "wide", int(wide.size()));
    show("and back", narrow);
    bool const refused = !Convert::Utf8ToWide("cut \xC3", wide);
    std::printf("  %-34s %s\n", "text that is cut in a character", refused ? "is refused" : "is taken");
    return good && refused;
}

} // namespace

int main() {
    shortText();
    editing();
    storing();
    return converting() ? 0 : 1;
}
