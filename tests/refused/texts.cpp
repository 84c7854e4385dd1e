// What must not compile. Each line marked `refused` is an error, and no other line is: `./dev lint refused` shows this
// to each compiler, with warnings as errors.

#include "zor_basis/crypto.h"
#include "zor_basis/files.h"
#include "zor_basis/memory.h"
#include "zor_basis/text.h"
#include "zor_basis/timers.h"

#include <functional>
#include <map>
#include <string>
#include <string_view>

using namespace ZOR_Basis;

void isNoPointerToDelete(Str view, BufStr<15>& name, HeapStr const& stored, FPath& path, WBStr& wide,
                         Auto_ptr_CStr& text) {
    delete view;   // refused
    delete name;   // refused
    delete stored; // refused
    delete path;   // refused
    delete[] name; // refused
    delete wide;   // refused
    delete text;   // refused
}

void handlesAreNotDeleted(File& file, MemMgrPtr& manager, CrHashPtr& hash, PileTimerAuto& pile, BaseTimerAuto& base) {
    delete file;    // refused
    delete manager; // refused
    delete hash;    // refused
    delete pile;    // refused
    delete base;    // refused
}

int isNoCondition(Str view, BufStr<15> const& name, HeapStr const& stored, FPath const& path, WcPath const& wide) {
    if (view) return 1;                  // refused
    if (!name) return 2;                 // refused
    if (name && *name != '\0') return 3; // refused
    while (stored) return 4;             // refused
    if (wide) return 5;                  // refused
    return path ? 6 : 7;                 // refused
}

int isNotComparedByAddress(Str view, BufStr<15> const& name, WStr wide, WBStr const& owned, void const* address) {
    int found = 0;
    found += view < address;                                   // refused
    found += address >= name;                                  // refused
    found += name == address;                                  // refused
    found += wide < ZB_W("a");                                 // refused
    found += ZB_W("a") > owned;                                // refused
    found += wide <= owned;                                    // refused
    found += owned >= wide;                                    // refused
    found += (wide <=> owned) == (owned <=> ZB_W("a"));        // refused
    found += wide == address;                                  // refused
    found += std::less<>()(owned, ZB_W("a"));                  // refused
    found += std::less_equal<>()(owned, owned);                // refused
    found += std::ranges::less()(owned, owned);                // refused
    found += std::ranges::greater()(wide, ZB_W("a"));          // refused
    found += std::is_eq(std::compare_three_way()(wide, wide)); // refused
    return found;
}

void isTerminated(std::string_view view) {
    Str text(view);                  // refused
    text = view;                     // refused
    static_cast<void>(text == view); // refused
}

void losesNoDigits(BufStr<15>& name, FPath& path) {
    name << 1.5;  // refused
    name << 1.5F; // refused
    path << 2.0;  // refused
}

// What compiles all the same.
bool isStillAPointer(Str view, BufStr<15> const& name, WBStr const& wide) {
    char const* const text = name;
    void const* const address = name;
    bool const known = std::map<BufStr<15>, int, std::less<>>{{"tray", 1}}.contains("tray");
    return known && text == address && *name == 'a' && name + 1 == &text[1] && view.find("b") - view == 1 &&
           view.c_str() != nullptr && name.some() && wide == ZB_W("a") && wide < WStr(ZB_W("b"));
}
