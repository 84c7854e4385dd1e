/// \file
/// Sets the thousands separator of all rows for a scope.

#ifndef TESTS_TIMERS_SEPARATOR_H
#define TESTS_TIMERS_SEPARATOR_H

#include <zor_basis/timers.h>

class Separator {
public:
    explicit Separator(char now) { ZOR_Basis::setThousandsSeparator(now); }
    Separator(Separator const&) = delete;
    Separator& operator=(Separator const&) = delete;
    ~Separator() { ZOR_Basis::setThousandsSeparator(','); }
};

#endif
