// tree_size_program FOLDER: prints the size of a tree, as a whole process beside others.

#include <zor_basis/walk.h>

#include <cstdio>

int main(int count, char** arguments) {
    if (count != 2) return 2;
    auto const size = ZOR_Basis::FileSizeVisitor::Get(ZOR_Basis::Str(arguments[1]), true);
    std::printf("%lld\t%s\n", static_cast<long long>(size), arguments[1]);
    return 0;
}
