/// \file
/// A text that is set by the program, or else by the environment.

#ifndef HOST_XOS_BASICS_SYSTEM_SETTING_H
#define HOST_XOS_BASICS_SYSTEM_SETTING_H

#include "host/xos_basics/system/kept_texts.h"

#include <atomic>
#include <cstdlib>

namespace host {

class Setting {
public:
    /// \param variable  the environment variable that counts while nothing is set
    explicit constexpr Setting(char const* variable) : variable_(variable) {}

    /// Null or empty: back to the environment.
    void set(char const* text) {
        bool const isSet = text != nullptr && *text != '\0';
        text_.store(isSet ? keptText(text) : nullptr, std::memory_order_release);
    }

    /// The text, valid forever; empty if neither is set.
    char const* get() const {
        char const* const text = text_.load(std::memory_order_acquire);
        return text != nullptr ? text : keptText(std::getenv(variable_));
    }

private:
    char const* variable_;
    std::atomic<char const*> text_{nullptr};
};

} // namespace host

#endif
