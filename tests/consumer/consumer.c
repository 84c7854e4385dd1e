/* A module written in C: the plain functions. */

#include <zor_basis/flat.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

/* What a module does with the timers: one pile, fed by a record of its own and directly. */
static int measures(void) {
    zbTimerDat record;
    zbTimerMgr* manager = zbTimerMgrNew("consumer", 3);
    zbPileTimer* pile = zbTimerMgrCreateMT(manager, "pages", 3);
    int good = pile != NULL && zbTimerMgrGet(manager, 3) == pile && zbTimerMgrGetMgr("consumer") == manager;
    zbTimerBaseStart(&record, 1);
    good = good && record.start > 0 && record.suspendStart >= record.start;
    zbTimerBaseResume(&record);
    zbTimerBaseStop(&record, pile);
    good = good && record.start == 0 && record.suspended == 0;
    zbTimerMgrSetActive(manager, 1);
    zbTimerMgrStart(manager, pile);
    zbTimerMgrStop(manager, pile);
    zbTimerMgrReset(manager, 1);
    return good;
}

int main(void) {
    char* copy = ZB_StrDup("ticket");
    int good = copy != NULL && strcmp(copy, "ticket") == 0 && ZB_StrDup(NULL) == NULL && measures();
    free(copy);
    puts(good ? "consumer_c: good" : "consumer_c: bad");
    return good ? 0 : 1;
}
