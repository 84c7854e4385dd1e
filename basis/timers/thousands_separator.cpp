#include "zor_basis/timers/thousands_separator.h"

#include <atomic>

namespace ZOR_Basis {
namespace {

std::atomic<char> separatorNow{','};

} // namespace

char thousandsSeparator() { return separatorNow.load(std::memory_order_relaxed); }
void setThousandsSeparator(char separator) { separatorNow.store(separator, std::memory_order_relaxed); }

} // namespace ZOR_Basis
