/// \file
/// Hears the assertions of the platform layer instead of having them on standard error.

#ifndef TESTS_TIMERS_ASSERTIONS_H
#define TESTS_TIMERS_ASSERTIONS_H

#include <xos_host.h>

#include <string>

class Assertions {
public:
    Assertions() { xos_HostSetAssertHandler(hear, this); }
    Assertions(Assertions const&) = delete;
    Assertions& operator=(Assertions const&) = delete;
    ~Assertions() { xos_HostSetAssertHandler(nullptr, nullptr); }

    /// What was heard since the last call, as "LINE MODULE MESSAGE;" for each.
    std::string take() {
        std::string heard;
        heard.swap(heard_);
        return heard;
    }

private:
    static void hear(int line, char const* module, char const* message, void* context) {
        static_cast<Assertions*>(context)->heard_ += std::to_string(line) + " " + module + " " + message + ";";
    }

    std::string heard_;
};

#endif
