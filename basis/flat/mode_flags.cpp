#include "basis/system/mode_flags.h"
#include "zor_basis/flat.h"

namespace ModeFlags = ZOR_Basis::ModeFlags;

namespace {

int isOnOnceLoaded(ModeFlags::Mode mode) {
    if (!ModeFlags::isLoaded()) ModeFlags::load();
    return ModeFlags::isOn(mode) ? 1 : 0;
}

} // namespace

int setVDPFlagsFromCFG() {
    ModeFlags::load();
    return 0;
}

int isVDPFlagsSetFromCFG() { return ModeFlags::isLoaded() ? 1 : 0; }

// kept flat-04: asked at every page, it is to read no file.
int isVDPON() { return ModeFlags::isOn(ModeFlags::ALL) ? 1 : 0; }

int isVPSON() { return isOnOnceLoaded(ModeFlags::VPS); }
int isQDBON() { return isOnOnceLoaded(ModeFlags::QDB); }
int isVIPPON() { return isOnOnceLoaded(ModeFlags::VIPP); }
int isPPMLON() { return isOnOnceLoaded(ModeFlags::PPML); }
