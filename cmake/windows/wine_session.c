/* Stays alive for at most 30 minutes, so that Wine's background processes do; with an argument it ends at once. */
#include <windows.h>

int main(int argc, char** argv) {
    (void)argv;
    if (argc == 1) Sleep(30 * 60 * 1000);
    return 0;
}
