#include "tests/faults/scenario.h"

#include <zor_basis/walk.h>

using namespace ZOR_Basis;

namespace {

bool walks(Place const& place, FileVisitor& visitor) {
    return FileIterator((place / "d").c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&visitor, false, true);
}

bool copies(Place const& place) {
    FileCopyVisitor visitor(Str(place / "empty"), true, true);
    return walks(place, visitor);
}
bool moves(Place const& place) {
    FileMoveVisitor visitor(Str(place / "empty"), true);
    return walks(place, visitor);
}
bool removes(Place const& place) {
    FileDeleteVisitor visitor;
    return walks(place, visitor);
}
bool counts(Place const& place) { return FileCountVisitor::Get(Str(place.path), LOOK_BOTH, 0) == 4; }
bool sums(Place const& place) { return FileSizeVisitor::Get(Str(place.path), true) == 170'016; }
bool finds(Place const& place) {
    FPath found;
    FindFileVisit visitor(true, 10);
    visitor.searchName(Str("f"));
    FileIterator(place.path.c_str(), LOOK_FILES, nullptr, nullptr).doIt(&visitor, true, false);
    return visitor.getNum() == 1 && visitor.getPath() == Str(place / "d/e/f");
}
bool lists(Place const& place) {
    FileIterator it(place.path.c_str(), LOOK_ALL | LOOK_ANYCASE, "*", nullptr);
    int names = 0;
    while (it.next() != nullptr) ++names;
    return names == 4;
}
bool linksOrCopies(Place const& place) {
    return zbLinkOrCopy((place / "a").c_str(), (place / "linked").c_str(), false) &&
           FStat::isFile((place / "linked").c_str());
}
bool checksAndRemoves(Place const& place) {
    return zbCheckRemoveFileDir(FPath((place / "d").c_str()), true) &&
           zbCheckRemoveFileDir(FPath((place / "a").c_str()), true);
}

} // namespace

Scenarios walkScenarios() {
    return {
        {"FileCopyVisitor", prepareTree, copies, Scenario::WHAT_IS_LISTED},
        {"FileMoveVisitor", prepareTree, moves, Scenario::WHAT_IS_LISTED},
        {"FileDeleteVisitor", prepareTree, removes, Scenario::WHAT_IS_LISTED},
        {"FileCountVisitor::Get", prepareTree, counts},
        {"FileSizeVisitor::Get", prepareTree, sums},
        {"FindFileVisit", prepareTree, finds},
        {"FileIterator::next", prepareTree, lists},
        {"zbLinkOrCopy", prepareTree, linksOrCopies},
        {"zbCheckRemoveFileDir", prepareTree, checksAndRemoves},
    };
}
