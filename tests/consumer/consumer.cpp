// A module that links the installed library: types with inline members, an instantiation, static data.

#include <zor_basis/store/blob.h>
#include <zor_basis/text.h>

#include <cstdio>
#include <cstring>

using namespace ZOR_Basis;

static HeapStr const atStartUp; // static data of the library is there before any constructor runs

int main() {
    BufStr<15> name("page");
    name += "-0001.pdl";
    name.add("-and-more-than-fits-inline");
    HeapStr const stored(name);
    WBStr wide;
    Blob const blob(6, "ticket");
    bool const good = name == "page-0001.pdl-and-more-than-fits-inline" && stored == name &&
                      Convert::Utf8ToWide(name, wide) && wide.size() == name.size() && blob == Blob(6, "ticket") &&
                      atStartUp.c_str() == Str::StrEmpty && std::strlen(stored.c_str()) == stored.size();
    std::puts(good ? "consumer_cpp: good" : "consumer_cpp: bad");
    return good ? 0 : 1;
}
