// root_child PLAN...: what depends on the root folder, each case in a process of its own. Prints one line a step.
//   root SEARCH     Sys::root(), between "<" and ">"
//   root2           the same again
//   temp            Sys::temp()
//   copy            Sys::root(out) and its result
//   fake PATH       whether the path is fake, and its translation, narrow
//   wide PATH       the same, wide
//   pathroot        WcPath::pathRoot

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>
#include <zor_basis/system/sys.h>
#include <zor_basis/text/convert.h>

#include <cstdio>
#include <cstring>

using namespace ZOR_Basis;

namespace {

void print(Str const& text) { std::printf("<%s>\n", text.c_str()); }

void print(WStr const& text) {
    BufStr<255> narrow;
    Convert::WideToUtf8(text, narrow);
    print(narrow);
}

void narrow(char const* text) {
    FPath inPlace(text);
    inPlace.translateRoot();
    FPath copied;
    copied.translateRoot(text);
    FPath const tagged(text, TranslPath());
    bool const same = inPlace == copied && copied == tagged;
    std::printf("%s %s ", FPath::isFake(text) ? "fake" : "plain", same ? "" : "DIFFERENT");
    print(inPlace);
}

void wide(char const* text) {
    WBStr units;
    Convert::Utf8ToWide(text, units);
    WcPath inPlace(units);
    inPlace.translateRoot();
    WcPath copied;
    copied.translateRoot(units);
    std::printf("%s %s ", WcPath::isFake(units) ? "fake" : "plain", inPlace == copied ? "" : "DIFFERENT");
    print(static_cast<WStr const&>(inPlace));
}

} // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "root") == 0) {
            print(static_cast<Str const&>(Sys::root()));
        } else if (std::strcmp(argv[i], "temp") == 0) {
            print(static_cast<Str const&>(Sys::temp()));
        } else if (std::strcmp(argv[i], "copy") == 0) {
            FPath out("old");
            std::printf("%s ", Sys::root(out) ? "true" : "false");
            print(static_cast<Str const&>(out));
        } else if (std::strcmp(argv[i], "fake") == 0 && ++i < argc) {
            narrow(argv[i]);
        } else if (std::strcmp(argv[i], "wide") == 0 && ++i < argc) {
            wide(argv[i]);
        } else if (std::strcmp(argv[i], "pathroot") == 0) {
            print(static_cast<WStr const&>(WcPath::pathRoot));
        } else {
            return 2;
        }
    }
    return 0;
}
