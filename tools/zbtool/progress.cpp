#include "tools/zbtool/progress.h"

#include "tools/zbtool/terminal.h"

#include <cstdarg>
#include <cstdio>

namespace zbtool {
namespace {

// Showing every entry of thousands a second would take longer than the work.
constexpr std::chrono::milliseconds BETWEEN_SHOWS(100);

std::string formatted(char const* format, ...) {
    char text[128];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    return text;
}

unsigned long long shown(std::uint64_t number) { return number; }

/// The part of the work that is done. Bytes tell it better, unless there are none.
double shareOf(Amount done, Amount total) {
    std::uint64_t const all = total.bytes != 0 ? total.bytes : total.entries;
    std::uint64_t const ready = total.bytes != 0 ? done.bytes : done.entries;
    return all == 0 ? 0 : static_cast<double>(ready) / static_cast<double>(all);
}

std::string timeLeft(double share, double seconds) {
    if (share <= 0 || share > 1) return "";
    auto const left = static_cast<std::uint64_t>(seconds / share * (1 - share) + 0.5);
    return formatted(", %llu:%02llu left", shown(left / 60), shown(left % 60));
}

} // namespace

std::string sizeText(std::uint64_t bytes) {
    constexpr char const* UNITS[] = {"bytes", "KiB", "MiB", "GiB", "TiB", "PiB", "EiB"};
    if (bytes < 1024) return formatted("%llu %s", shown(bytes), UNITS[0]);
    double number = static_cast<double>(bytes);
    std::size_t unit = 0;
    for (; number >= 1024 && unit < 6; ++unit) number /= 1024;
    return formatted("%.1f %s", number, UNITS[unit]);
}

std::string progressText(char const* what, Amount done, Amount total, double seconds) {
    bool const known = total.entries != 0;
    std::string text = formatted("%s  %llu", what, shown(done.entries));
    if (known) text += formatted(" of %llu", shown(total.entries));
    text += " entries, " + sizeText(done.bytes);
    if (known) text += " of " + sizeText(total.bytes);
    if (seconds > 0)
        text += ", " + sizeText(static_cast<std::uint64_t>(static_cast<double>(done.bytes) / seconds)) + "/s";
    if (known) text += timeLeft(shareOf(done, total), seconds);
    return text;
}

Progress::Progress(char const* what) : what_(what), visible_(isVisible()) {}

Progress::~Progress() { hide(); }

bool Progress::isVisible() {
    static bool const visible = errorsAreTerminal();
    return visible;
}

void Progress::hide() {
    if (isVisible()) std::fputs("\r\033[K", stderr);
}

double Progress::seconds() const { return std::chrono::duration<double>(Clock::now() - start_).count(); }

void Progress::add(Amount amount) {
    entries_.fetch_add(amount.entries, std::memory_order_relaxed);
    bytes_.fetch_add(amount.bytes, std::memory_order_relaxed);
    if (!visible_) return;
    std::unique_lock const alone(showing_, std::try_to_lock);
    if (alone.owns_lock()) show();
}

void Progress::show() {
    Clock::time_point const now = Clock::now();
    if (now < nextShow_) return;
    nextShow_ = now + BETWEEN_SHOWS;
    std::fprintf(stderr, "\r%s\033[K", progressText(what_, done(), total_, seconds()).c_str());
}

} // namespace zbtool
