/// \file
/// Records the assertions of the platform layer, which then do not go to standard error.

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

    /// The assertions since the last call, each as "LINE MODULE MESSAGE;".
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
