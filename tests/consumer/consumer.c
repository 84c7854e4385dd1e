/* A module written in C: the plain functions. */

#include <zor_basis/flat.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

int main(void) {
    char* copy = ZB_StrDup("ticket");
    int good = copy != NULL && strcmp(copy, "ticket") == 0 && ZB_StrDup(NULL) == NULL;
    free(copy);
    puts(good ? "consumer_c: good" : "consumer_c: bad");
    return good ? 0 : 1;
}
