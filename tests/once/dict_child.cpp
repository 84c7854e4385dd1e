// dict_child FILE: saves one of two contents after the other until it is ended, a minute at most.

#include "tests/once/dict_contents.h"

#include <chrono>

int main(int count, char** arguments) {
    if (count != 2) return 2;
    auto const end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
    BlobDict dict;
    dict.setPath(arguments[1]);
    while (std::chrono::steady_clock::now() < end) {
        for (int n : {0, 1}) {
            fill(dict, twoContents(n));
            if (!dict.save()) return 1;
        }
    }
    return 0;
}
