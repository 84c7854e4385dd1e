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
    explicit constexpr Setting(char const* variable) : _variable(variable) {}

    /// Null or empty: back to the environment.
    void set(char const* text) {
        bool const isSet = text != nullptr && *text != '\0';
        _text.store(isSet ? keptText(text) : nullptr, std::memory_order_release);
    }

    /// The text, valid forever; empty if neither is set.
    char const* get() const {
        char const* const text = _text.load(std::memory_order_acquire);
        return text != nullptr ? text : keptText(std::getenv(_variable));
    }

private:
    char const* _variable;
    std::atomic<char const*> _text{nullptr};
};

} // namespace host

#endif
