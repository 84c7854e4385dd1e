/// \file
/// Calls as text, as `xos_HostLastCall` returns them and the trace writes them.

#ifndef HOST_XOS_BASICS_CONTROL_CALL_TEXT_H
#define HOST_XOS_BASICS_CONTROL_CALL_TEXT_H

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

namespace host {

/// \param kind  is that of an argument without text, in functions.h
std::string numberText(char kind, std::uint64_t word);

/// In double quotes; control characters, a line end among them, become `\xNN`, so that the text stays in its line.
/// \param text  may be null
std::string traceText(char const* text);

/// Like `traceText`, but asterisks replace the password in front of the host.
std::string traceUrl(char const* url);

/// Like `traceText`, but asterisks replace a text that is neither null nor empty.
std::string traceSecret(char const* text);

/// `2026-11-22T19:47:08.123456Z`
std::string utcText(std::chrono::sys_time<std::chrono::microseconds> time);

} // namespace host

#endif
