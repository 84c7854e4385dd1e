// locale_child HEX: converts a local text, given in hex digits, to UTF-8 and prints that in hex, or "invalid".
// It first selects another locale for itself, which must not matter.

#include <zor_basis/text.h>

#include <clocale>
#include <cstdio>

using namespace ZOR_Basis;

int main(int argc, char** argv) {
    if (argc != 2) return 2;
    std::setlocale(LC_ALL, "C");
    BufStr<255> local;
    local.fromHex(argv[1]);
    BufStr<255> utf8;
    BufStr<255> hex;
    if (Convert::LocalToUtf8(local, utf8)) {
        hex.toHex(utf8);
    } else {
        hex = "invalid";
    }
    std::fputs(hex.c_str(), stdout);
    return 0;
}
