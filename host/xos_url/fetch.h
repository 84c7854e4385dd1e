/// \file
/// Fetching over HTTP. Twins: fetch_posix.cpp (libcurl), fetch_win.cpp (WinHTTP).

#ifndef HOST_XOS_URL_FETCH_H
#define HOST_XOS_URL_FETCH_H

#include <cstddef>
#include <cstdint>
#include <string>

namespace host {

/// Takes a body as it arrives.
class BodySink {
public:
    BodySink() = default;
    BodySink(BodySink const&) = delete;
    BodySink& operator=(BodySink const&) = delete;
    virtual ~BodySink() = default;
    /// \return false ends the fetch
    virtual bool take(void const* data, std::size_t size) = 0;
};

struct FetchRequest {
    /// `http` or `https`.
    std::string url;
    /// Null: none but those that the URL names.
    char const* user;
    char const* password;
    std::uint32_t connectSeconds;
    /// The longest time without a byte.
    std::uint32_t stallSeconds;
};

constexpr std::uint32_t MOST_REDIRECTS = 10;

/// Hands the body of the answer to the sink; not that of an answer which leads on, or asks for a password that we have.
/// \return whether the status of the answer is 200 to 299 and all of it has arrived
bool fetch(FetchRequest const& request, BodySink& sink);

} // namespace host

#endif
