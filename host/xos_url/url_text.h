/// \file
/// What is read out of a URL before the system's library sees it. No part of this touches a system.

#ifndef HOST_XOS_URL_URL_TEXT_H
#define HOST_XOS_URL_URL_TEXT_H

#include <optional>
#include <string>
#include <string_view>

namespace host {

enum class Scheme { HTTP, HTTPS, FILE, OTHER };

/// Letters of either case.
Scheme schemeOf(std::string_view url);

/// The URL with blanks, control characters and bytes above 126 as percent escapes, so that every library reads it
/// alike.
std::string escapedUrl(std::string_view url);

/// Where a `file:` URL leads.
struct FileUrl {
    /// Empty for this machine.
    std::string host;
    /// With its leading slash, escapes resolved.
    std::string path;
};

/// Takes `file:/path`, `file:///path` and `file://host/path`; a query or fragment is left out.
/// \return nothing when the URL is of another form, an escape in it is no number or stands for a byte 0
std::optional<FileUrl> parseFileUrl(std::string_view url);

} // namespace host

#endif
